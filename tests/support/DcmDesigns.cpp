#include "support/DcmDesigns.h"

#include "wizard/Tsy_DCMwiz.h"

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

Tsy_Block* dcm(Tsy_DCMwiz& w, int inst = 1)
{
    Tsy_Block* b = w.GetActiveDCMBlk(inst, true);
    if (!b)
        throw std::runtime_error("no DCM block");
    return b;
}

// What General Setup leaves for internal feedback: the loop's output marked
// with its feedback buffer.
void internalFeedback(Tsy_Block* b, const char* multiple, int n = 1)
{
    Set(b, "FB_SOURCE", "INTERNAL");
    Set(b, "CLK_FEEDBACK", multiple);
    Buffer(b, std::string(multiple) == "1X" ? "CLK0" : "CLK2X", n, "BUFG", "FEEDBACK_BUF");
}

void externalFeedback(Tsy_Block* b, const char* kind)
{
    Set(b, "FB_SOURCE", "EXTERNAL");
    Set(b, "TESY_ONLY_FB_EXTERNAL", kind);
}

// What the clock forwarding and board deskew pages leave on the forwarded
// outputs: buffers the generator builds itself.
void forwarded(Tsy_Block* b, const char* pin, const char* type)
{
    Buffer(b, pin, 1, type, "DISABLED_BUF");
}

std::vector<DcmDesign> makeDesigns()
{
    return {
        {"single_default", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) { internalFeedback(dcm(w), "1X"); }},
        {"single_internal_input", "dcm", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "CLKIN_SRC_TYPE", "INTERNAL");
             internalFeedback(b, "1X");
             Buffer(b, "CLK90", 1, "BUFG", "ENABLED_BUF");
         }},
        {"single_differential_input", "dcm", "m3e100-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_CLKIN_EXTERNAL", "DIFFERENTIAL");
             Use(b, "CLK0", false);
             internalFeedback(b, "2X");
             Buffer(b, "CLKFX", 1, "BUFGCE");
         }},
        {"feedback_external_single", "dcm", "t4a25-10",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             externalFeedback(b, "SINGLE");
             Buffer(b, "CLK0", 1, "BUFG");
         }},
        {"feedback_external_differential", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             externalFeedback(b, "DIFFERENTIAL");
             Buffer(b, "CLK0", 1, "BUFG");
             Buffer(b, "CLK90", 1, "BUFG");
         }},
        {"feedback_none", "dcm", "t2p7-5",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "FB_SOURCE", "NONE");
             Set(b, "CLK_FEEDBACK", "NONE");
             Use(b, "CLK0", false);
             Buffer(b, "CLKFX", 1, "BUFG");
         }},
        {"mux_kinds", "dcm", "t4a25-10",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Buffer(b, "CLK90", 1, "BUFGMUX");
             PinAttr(b, "CLK90", "TSY_CLKBUF1_I1_PINNAME", "CLK270");
             Buffer(b, "CLK180", 1, "BUFGMUX_TALDOR4");
             PinAttr(b, "CLK180", "TSY_CLKMUX_I1", "CLKDV");
             Buffer(b, "CLKFX", 1, "BUFGCTRL");
             PinAttr(b, "CLKFX", "TSY_CLKBUF1_I1_PINNAME", "CLKFX180");
             PinAttr(b, "CLKFX", "TSY_CLKBUF1_IGNORE0_PINNAME", "CLKFX");
         }},
        {"mux_on_feedback_clock", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Buffer(b, "CLK90", 1, "BUFGMUX_CTRL");
             PinAttr(b, "CLK90", "TSY_CLKBUF1_I1_PINNAME", "CLK0");
         }},
        {"routing_and_output_buffers", "dcm", "m3s200-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Buffer(b, "CLK90", 1, "LOCALROUTING");
             Buffer(b, "CLK180", 1, "LOWSKEWLINE");
             Buffer(b, "CLK270", 1, "OBUF");
             Buffer(b, "CLKDV", 1, "BUFG");
             Buffer(b, "CLKDV", 2, "LOCALROUTING");
             Buffer(b, "CLK2X", 1, "BUFG", "DISABLED_BUF");
         }},
        {"second_buffer_on_feedback_clock", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Buffer(b, "CLK0", 2, "BUFG", "ENABLED_BUF");
         }},
        {"typed_signal_names", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Buffer(b, "CLK90", 1, "BUFGCE");
             PinAttr(b, "CLK90", "TSY_CLKBUF1_I_SIGNAME", "fast_clk_src");
             PinAttr(b, "CLK90", "TSY_CLKBUF1_CE_SIGNAME", "fast_clk_en");
             PinAttr(b, "CLK90", "TSY_CLKBUF1_O_SIGNAME", "fast_clk");
             Buffer(b, "CLKIN", 1, "BUFG");
         }},
        {"reset_logic_and_ports", "dcm", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Set(b, "TESY_ONLY_RESET_LOGIC", "TRUE");
             for (const char* p : {"PSEN", "PSINCDEC", "PSCLK", "PSDONE", "DADDR", "DI", "DWE", "DEN", "DCLK", "DO",
                                   "DRDY"})
                 Use(b, p);
         }},
        {"reset_logic_status", "dcm", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             internalFeedback(b, "1X");
             Set(b, "TESY_ONLY_RESET_LOGIC", "TRUE");
             Use(b, "STATUS");
         }},
        {"board_deskew_oddr", "dcm_bddeskew", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             externalFeedback(b1, "SINGLE");
             Set(b1, "TESY_ONLY_DDR_FLIPFLOP", "ODDR");
             forwarded(b1, "CLK0", "BUFG");
             Set(b2, "CLKIN_SRC_TYPE", "INTERNAL");
             internalFeedback(b2, "1X");
             Buffer(b2, "CLK90", 1, "BUFG");
         }},
        {"board_deskew_internal_feedback", "dcm_bddeskew", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             Set(b1, "TESY_ONLY_DDR_FLIPFLOP", "None");
             forwarded(b1, "CLK0", "OBUF");
             internalFeedback(b1, "1X", 2);
             Set(b2, "CLKIN_SRC_TYPE", "INTERNAL");
             internalFeedback(b2, "1X");
         }},
        {"board_deskew_ofddr", "dcm_bddeskew", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             externalFeedback(b1, "SINGLE");
             Set(b1, "TESY_ONLY_DDR_FLIPFLOP", "OFDDRRSE");
             Set(b1, "TESY_ONLY_DDR_C0", "CLK2X");
             Set(b1, "TESY_ONLY_DDR_C1", "CLK2X180");
             forwarded(b1, "CLK2X", "BUFG");
             forwarded(b1, "CLK2X180", "BUFG");
             Set(b2, "CLKIN_SRC_TYPE", "INTERNAL");
             internalFeedback(b2, "2X");
         }},
        {"forwarding_ofddrcpe_shared_feedback", "dcm_clkfwd", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "OFDDRCPE");
             Set(b, "TESY_ONLY_DDR_C0", "CLK0");
             Set(b, "TESY_ONLY_DDR_C1", "CLK180");
             Set(b, "FB_SOURCE", "INTERNAL");
             Set(b, "CLK_FEEDBACK", "1X");
             forwarded(b, "CLK0", "BUFG");
             forwarded(b, "CLK180", "BUFG");
         }},
        {"forwarding_ofddrtcpe_inversion", "dcm_clkfwd", "m3s200-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "OFDDRTCPE");
             Set(b, "TESY_ONLY_DDR_C0", "CLKFX");
             Set(b, "TESY_ONLY_DDR_C1", "INVERSION");
             internalFeedback(b, "1X");
             forwarded(b, "CLKFX", "BUFG");
         }},
        {"forwarding_ofddrtrse", "dcm_clkfwd", "t2p7-5",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "OFDDRTRSE");
             Set(b, "TESY_ONLY_DDR_C0", "CLK2X");
             Set(b, "TESY_ONLY_DDR_C1", "CLK2X180");
             internalFeedback(b, "1X");
             forwarded(b, "CLK2X", "BUFG");
             forwarded(b, "CLK2X180", "BUFG");
         }},
        {"forwarding_oddr", "dcm_clkfwd", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "ODDR");
             Set(b, "TESY_ONLY_DDR_CLK", "CLK90");
             Set(b, "TESY_ONLY_DDR_INIT", "1");
             Set(b, "TESY_ONLY_DDR_EDGEMODE", "SAME");
             Set(b, "TESY_ONLY_DDR_RESETTYPE", "SYNCHRONOUS");
             internalFeedback(b, "1X");
             forwarded(b, "CLK90", "BUFG");
         }},
        {"forwarding_oddr_shared_feedback", "dcm_clkfwd", "t4a25-10",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "ODDR");
             Set(b, "TESY_ONLY_DDR_CLK", "CLK0");
             Set(b, "FB_SOURCE", "INTERNAL");
             Set(b, "CLK_FEEDBACK", "1X");
             forwarded(b, "CLK0", "BUFG");
         }},
        {"forwarding_output_buffer", "dcm_clkfwd", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b = dcm(w);
             Set(b, "TESY_ONLY_DDR_FLIPFLOP", "None");
             Set(b, "TESY_ONLY_DDR_C0", "CLK0");
             Set(b, "TESY_ONLY_DDR_C1", "INVERSION");
             forwarded(b, "CLK0", "OBUF");
             internalFeedback(b, "1X", 2);
         }},
        {"switching_bufgmux", "dcm_clkswitch", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             Set(b1, "TESY_ONLY_DCM_SWITCHING_CLK", "CLK0");
             internalFeedback(b1, "1X");
             Buffer(b1, "CLK0", 2, "BUFGMUX", "DISABLED_BUF");
             PinAttr(b1, "CLK0", "TSY_CLKMUX_I1", "CLK90 From INST2");
             Set(b2, "TESY_ONLY_DCM_SWITCHING_CLK", "CLK90");
             internalFeedback(b2, "1X");
             Buffer(b2, "CLK90", 1, "BUFGMUX", "DISABLED_BUF");
             PinAttr(b2, "CLK90", "TSY_CLKMUX_I0", "CLK0 From INST1");
         }},
        {"switching_bufgctrl", "dcm_clkswitch", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             Set(b1, "TESY_ONLY_DCM_SWITCHING_CLK", "CLKFX");
             Set(b1, "FB_SOURCE", "NONE");
             Set(b1, "CLK_FEEDBACK", "NONE");
             Use(b1, "CLK0", false);
             Buffer(b1, "CLKFX", 1, "BUFGCTRL", "DISABLED_BUF");
             PinAttr(b1, "CLKFX", "TSY_CLKMUX_I1", "CLK0 From INST2");
             Set(b2, "TESY_ONLY_DCM_SWITCHING_CLK", "CLK0");
             internalFeedback(b2, "1X");
             Buffer(b2, "CLK0", 2, "BUFGCTRL", "DISABLED_BUF");
             PinAttr(b2, "CLK0", "TSY_CLKMUX_I0", "CLKFX From INST1");
         }},
        {"cascading_clkdv", "dcm_cascading", "t5da1-1",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             Set(b1, "TESY_ONLY_CASCADING_CLK", "CLKDV");
             Set(b1, "TESY_ONLY_RESET_LOGIC", "TRUE");
             internalFeedback(b1, "1X");
             forwarded(b1, "CLKDV", "BUFG");
             Set(b2, "CLKIN_SRC_TYPE", "INTERNAL");
             internalFeedback(b2, "1X");
             Buffer(b2, "CLKFX", 1, "BUFG");
             Use(b2, "DO");
         }},
        {"cascading_clk0_shared_feedback", "dcm_cascading", "t2a250-4",
         [](Tsy_DCMwiz& w) {
             Tsy_Block* b1 = dcm(w, 1);
             Tsy_Block* b2 = dcm(w, 2);
             Set(b1, "TESY_ONLY_CASCADING_CLK", "CLK0");
             Set(b1, "FB_SOURCE", "INTERNAL");
             Set(b1, "CLK_FEEDBACK", "1X");
             forwarded(b1, "CLK0", "BUFG");
             Set(b2, "CLKIN_SRC_TYPE", "INTERNAL");
             Set(b2, "TESY_ONLY_RESET_LOGIC", "TRUE");
             internalFeedback(b2, "1X");
         }},
    };
}

} // namespace

const std::vector<DcmDesign>& DcmDesigns()
{
    static const std::vector<DcmDesign> designs = makeDesigns();
    return designs;
}
