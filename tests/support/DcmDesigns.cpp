#include "support/DcmDesigns.h"

#include "wizard/Tsy_DCMwiz.h"

#include <sstream>
#include <stdexcept>

void Set(Tsy_Block* block, const char* attribute, const char* value)
{
    block->SetAttributeValue(attribute, value);
    block->SetAttributeIsActive(attribute, true);
}

void Use(Tsy_Block* block, const char* pin, bool on)
{
    Tsy_Pin* p = block->GetNamedPin(pin);
    if (!p)
        throw std::runtime_error(std::string("no pin ") + pin + " on " + block->GetName().str());
    p->SetIsActive(on);
}

void PinAttr(Tsy_Block* block, const char* pin, const char* attribute, const char* value)
{
    Tsy_Pin* p = block->GetNamedPin(pin);
    if (!p)
        throw std::runtime_error(std::string("no pin ") + pin + " on " + block->GetName().str());
    p->SetAttributeValue(attribute, value);
}

void Buffer(Tsy_Block* block, const char* pin, int n, const char* type, const char* state)
{
    Use(block, pin);
    PinAttr(block, pin, ("TSY_CLKBUFTYPE" + std::to_string(n)).c_str(), type);
    if (state)
        PinAttr(block, pin, ("TSY_CLKBUFTYPE" + std::to_string(n) + "_NOEDIT").c_str(), state);
}

namespace {

std::string trimmed(const std::string& s)
{
    size_t from = s.find_first_not_of(' '), to = s.find_last_not_of(' ');
    return from == std::string::npos ? "" : s.substr(from, to - from + 1);
}

// One step of a recipe on the current DCM block (see makeDesigns).
void apply(Tsy_Block* const dcms[], Tsy_Block*& b, const std::string& step)
{
    const size_t eq = step.find('='), hash = step.find('#'), dot = step.find('.');
    const std::string key = step.substr(0, eq), value = eq == std::string::npos ? "" : step.substr(eq + 1);
    if (step[0] == '@') {
        b = dcms[step[1] == '2' ? 1 : 0];
    } else if (step[0] == '+' || step[0] == '-') {
        Use(b, step.c_str() + 1, step[0] == '+');
    } else if (step.rfind("fb:", 0) == 0) {
        // What General Setup leaves for internal feedback: the loop's output
        // marked with its feedback buffer.
        const std::string multiple = step.substr(3, 2);
        Set(b, "FB_SOURCE", "INTERNAL");
        Set(b, "CLK_FEEDBACK", multiple.c_str());
        Buffer(b, multiple == "1X" ? "CLK0" : "CLK2X", hash == std::string::npos ? 1 : std::stoi(step.substr(hash + 1)),
               "BUFG", "FEEDBACK_BUF");
    } else if (step.rfind("ext:", 0) == 0) {
        Set(b, "FB_SOURCE", "EXTERNAL");
        Set(b, "TESY_ONLY_FB_EXTERNAL", step.c_str() + 4);
    } else if (step.rfind("fwd:", 0) == 0) {
        // What the clock forwarding and board deskew pages leave on the
        // forwarded outputs: buffers the generator builds itself.
        Buffer(b, key.c_str() + 4, 1, value.c_str(), "DISABLED_BUF");
    } else if (eq == std::string::npos) {
        throw std::runtime_error("unreadable design step '" + step + "'");
    } else if (hash < eq) {
        const size_t slash = value.find('/');
        Buffer(b, key.substr(0, hash).c_str(), std::stoi(key.substr(hash + 1)), value.substr(0, slash).c_str(),
               slash == std::string::npos ? nullptr : value.c_str() + slash + 1);
    } else if (dot < eq) {
        PinAttr(b, key.substr(0, dot).c_str(), key.c_str() + dot + 1, value.c_str());
    } else {
        Set(b, key.c_str(), value.c_str());
    }
}

DcmDesign design(const char* name, const char* keyword, const char* part, const std::string& recipe)
{
    return {name, keyword, part, [recipe](Tsy_DCMwiz& w) { ApplyRecipe(w, recipe); }};
}

// Recipes, step by step on the first DCM:
//   ATTR=VALUE          an attribute, made active
//   +PIN, -PIN          an output used or not
//   PIN#N=TYPE[/STATE]  buffer N of a pin, with its row state
//   PIN.ATTR=VALUE      a record on a pin
//   fb:1X, fb:2X#N      internal feedback, its buffer as buffer N
//   ext:KIND            external feedback, single or differential
//   fwd:PIN=TYPE        an output the application page forwards
//   @2                  on to the second DCM
std::vector<DcmDesign> makeDesigns()
{
    return {
        design("single_default", "dcm", "t5da1-1", "fb:1X"),
        design("single_internal_input", "dcm", "t2a250-4", "CLKIN_SRC_TYPE=INTERNAL; fb:1X; CLK90#1=BUFG/ENABLED_BUF"),
        design("single_differential_input", "dcm", "m3e100-4",
               "TESY_ONLY_CLKIN_EXTERNAL=DIFFERENTIAL; -CLK0; fb:2X; CLKFX#1=BUFGCE"),
        design("feedback_external_single", "dcm", "t4a25-10", "ext:SINGLE; CLK0#1=BUFG"),
        design("feedback_external_differential", "dcm", "t5da1-1", "ext:DIFFERENTIAL; CLK0#1=BUFG; CLK90#1=BUFG"),
        design("feedback_none", "dcm", "t2p7-5", "FB_SOURCE=NONE; CLK_FEEDBACK=NONE; -CLK0; CLKFX#1=BUFG"),
        design("mux_kinds", "dcm", "t4a25-10",
               "fb:1X; CLK90#1=BUFGMUX; CLK90.TSY_CLKBUF1_I1_PINNAME=CLK270; CLK180#1=BUFGMUX_TALDOR4; "
               "CLK180.TSY_CLKMUX_I1=CLKDV; CLKFX#1=BUFGCTRL; CLKFX.TSY_CLKBUF1_I1_PINNAME=CLKFX180; "
               "CLKFX.TSY_CLKBUF1_IGNORE0_PINNAME=CLKFX"),
        design("mux_on_feedback_clock", "dcm", "t5da1-1",
               "fb:1X; CLK90#1=BUFGMUX_CTRL; CLK90.TSY_CLKBUF1_I1_PINNAME=CLK0"),
        design("routing_and_output_buffers", "dcm", "m3s200-4",
               "fb:1X; CLK90#1=LOCALROUTING; CLK180#1=LOWSKEWLINE; CLK270#1=OBUF; CLKDV#1=BUFG; CLKDV#2=LOCALROUTING; "
               "CLK2X#1=BUFG/DISABLED_BUF"),
        design("second_buffer_on_feedback_clock", "dcm", "t5da1-1", "fb:1X; CLK0#2=BUFG/ENABLED_BUF"),
        design("typed_signal_names", "dcm", "t5da1-1",
               "fb:1X; CLK90#1=BUFGCE; CLK90.TSY_CLKBUF1_I_SIGNAME=fast_clk_src; "
               "CLK90.TSY_CLKBUF1_CE_SIGNAME=fast_clk_en; CLK90.TSY_CLKBUF1_O_SIGNAME=fast_clk; CLKIN#1=BUFG"),
        design("reset_logic_and_ports", "dcm", "t5da1-1",
               "fb:1X; TESY_ONLY_RESET_LOGIC=TRUE; +PSEN; +PSINCDEC; +PSCLK; +PSDONE; +DADDR; +DI; +DWE; +DEN; +DCLK; "
               "+DO; +DRDY"),
        design("reset_logic_status", "dcm", "t2a250-4", "fb:1X; TESY_ONLY_RESET_LOGIC=TRUE; +STATUS"),
        design("board_deskew_oddr", "dcm_bddeskew", "t5da1-1",
               "ext:SINGLE; TESY_ONLY_DDR_FLIPFLOP=ODDR; fwd:CLK0=BUFG; @2; CLKIN_SRC_TYPE=INTERNAL; fb:1X; "
               "CLK90#1=BUFG"),
        design("board_deskew_internal_feedback", "dcm_bddeskew", "t5da1-1",
               "TESY_ONLY_DDR_FLIPFLOP=None; fwd:CLK0=OBUF; fb:1X#2; @2; CLKIN_SRC_TYPE=INTERNAL; fb:1X"),
        design("board_deskew_ofddr", "dcm_bddeskew", "t2a250-4",
               "ext:SINGLE; TESY_ONLY_DDR_FLIPFLOP=OFDDRRSE; TESY_ONLY_DDR_C0=CLK2X; TESY_ONLY_DDR_C1=CLK2X180; "
               "fwd:CLK2X=BUFG; fwd:CLK2X180=BUFG; @2; CLKIN_SRC_TYPE=INTERNAL; fb:2X"),
        design("forwarding_ofddrcpe_shared_feedback", "dcm_clkfwd", "t2a250-4",
               "TESY_ONLY_DDR_FLIPFLOP=OFDDRCPE; TESY_ONLY_DDR_C0=CLK0; TESY_ONLY_DDR_C1=CLK180; FB_SOURCE=INTERNAL; "
               "CLK_FEEDBACK=1X; fwd:CLK0=BUFG; fwd:CLK180=BUFG"),
        design("forwarding_ofddrtcpe_inversion", "dcm_clkfwd", "m3s200-4",
               "TESY_ONLY_DDR_FLIPFLOP=OFDDRTCPE; TESY_ONLY_DDR_C0=CLKFX; TESY_ONLY_DDR_C1=INVERSION; fb:1X; "
               "fwd:CLKFX=BUFG"),
        design("forwarding_ofddrtrse", "dcm_clkfwd", "t2p7-5",
               "TESY_ONLY_DDR_FLIPFLOP=OFDDRTRSE; TESY_ONLY_DDR_C0=CLK2X; TESY_ONLY_DDR_C1=CLK2X180; fb:1X; "
               "fwd:CLK2X=BUFG; fwd:CLK2X180=BUFG"),
        design("forwarding_oddr", "dcm_clkfwd", "t5da1-1",
               "TESY_ONLY_DDR_FLIPFLOP=ODDR; TESY_ONLY_DDR_CLK=CLK90; TESY_ONLY_DDR_INIT=1; TESY_ONLY_DDR_EDGEMODE=SAME; "
               "TESY_ONLY_DDR_RESETTYPE=SYNCHRONOUS; fb:1X; fwd:CLK90=BUFG"),
        design("forwarding_oddr_shared_feedback", "dcm_clkfwd", "t4a25-10",
               "TESY_ONLY_DDR_FLIPFLOP=ODDR; TESY_ONLY_DDR_CLK=CLK0; FB_SOURCE=INTERNAL; CLK_FEEDBACK=1X; "
               "fwd:CLK0=BUFG"),
        design("forwarding_output_buffer", "dcm_clkfwd", "t2a250-4",
               "TESY_ONLY_DDR_FLIPFLOP=None; TESY_ONLY_DDR_C0=CLK0; TESY_ONLY_DDR_C1=INVERSION; fwd:CLK0=OBUF; "
               "fb:1X#2"),
        design("switching_bufgmux", "dcm_clkswitch", "t2a250-4",
               "TESY_ONLY_DCM_SWITCHING_CLK=CLK0; fb:1X; CLK0#2=BUFGMUX/DISABLED_BUF; "
               "CLK0.TSY_CLKMUX_I1=CLK90 From INST2; @2; TESY_ONLY_DCM_SWITCHING_CLK=CLK90; fb:1X; "
               "CLK90#1=BUFGMUX/DISABLED_BUF; CLK90.TSY_CLKMUX_I0=CLK0 From INST1"),
        design("switching_bufgctrl", "dcm_clkswitch", "t5da1-1",
               "TESY_ONLY_DCM_SWITCHING_CLK=CLKFX; FB_SOURCE=NONE; CLK_FEEDBACK=NONE; -CLK0; "
               "CLKFX#1=BUFGCTRL/DISABLED_BUF; CLKFX.TSY_CLKMUX_I1=CLK0 From INST2; @2; "
               "TESY_ONLY_DCM_SWITCHING_CLK=CLK0; fb:1X; CLK0#2=BUFGCTRL/DISABLED_BUF; "
               "CLK0.TSY_CLKMUX_I0=CLKFX From INST1"),
        design("cascading_clkdv", "dcm_cascading", "t5da1-1",
               "TESY_ONLY_CASCADING_CLK=CLKDV; TESY_ONLY_RESET_LOGIC=TRUE; fb:1X; fwd:CLKDV=BUFG; @2; "
               "CLKIN_SRC_TYPE=INTERNAL; fb:1X; CLKFX#1=BUFG; +DO"),
        design("cascading_clk0_shared_feedback", "dcm_cascading", "t2a250-4",
               "TESY_ONLY_CASCADING_CLK=CLK0; FB_SOURCE=INTERNAL; CLK_FEEDBACK=1X; fwd:CLK0=BUFG; @2; "
               "CLKIN_SRC_TYPE=INTERNAL; TESY_ONLY_RESET_LOGIC=TRUE; fb:1X"),
    };
}

} // namespace

void ApplyRecipe(Tsy_DCMwiz& w, const std::string& recipe)
{
    // Both DCMs are taken before either is edited, as the pages find them.
    Tsy_Block* const dcms[] = {w.GetActiveDCMBlk(1, true),
                               recipe.find("@2") == std::string::npos ? nullptr : w.GetActiveDCMBlk(2, true)};
    Tsy_Block* b = dcms[0];
    std::istringstream steps(recipe);
    for (std::string step; std::getline(steps, step, ';');) {
        if (!b)
            throw std::runtime_error("no DCM block");
        apply(dcms, b, trimmed(step));
    }
}

const std::vector<DcmDesign>& DcmDesigns()
{
    static const std::vector<DcmDesign> designs = makeDesigns();
    return designs;
}
