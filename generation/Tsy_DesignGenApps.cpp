// The application logic of the two-block wizards (clock forwarding,
// cascading, clock switching) and the PMCD path of design generation.

#include "generation/Tsy_DesignGen.h"

#include "db/Tsy_WizData.h"
#include "wiz/Tsy_WizPage.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_PageSets.h"
#include "wizard/Tsy_Vocabulary.h"

namespace {

bool is(const StringBase& value, const char* word)
{
    return value.EqualsNoCase(word);
}

// The logical page of that kind in the wizard's page slots, or null.
Tsy_WizPage* pageOfKind(Tsy_DCMwiz* wizard, Tsy_PageKind kind)
{
    int count = 0;
    const Tsy_PageSlot* set = Tsy_PageSetOf(wizard->GetWizTypeInt(), count);
    for (int i = 0; i < count; ++i) {
        if (set[i].kind != kind)
            continue;
        for (int slot = 0; slot < Tsy_WizMain::kPageSlots; ++slot)
            if (wizard->GetPage(slot) && wizard->GetPageName(slot) == set[i].name)
                return wizard->GetPage(slot);
    }
    return nullptr;
}

} // namespace

void Tsy_DesignGen::ApplicationLogic(Tsy_Block* dcm1, Tsy_Block* dcm2, int k)
{
    if ((wizType_ == Tsy_DCMwiz::TypeBoardDeskew && k == 1) || (wizType_ == Tsy_DCMwiz::TypeClockForwarding && k == 0))
        ClockForwarding(dcm1, k);
    else if (wizType_ == Tsy_DCMwiz::TypeCascading && k == 1)
        Cascading(dcm1, dcm2);
    else if (wizType_ == Tsy_DCMwiz::TypeClockSwitching && k == 1)
        ClockSwitching(dcm1, dcm2);
}

// The tristate kinds have T and drive O, the others Q; the CPE kinds have
// PRE and CLR, the RSE kinds S and R.
struct Tsy_DesignGen::ForwardingFlop {
    const char* type;
    bool tristate;
    bool presetClear;

    // ODDR takes one clock and D1/D2; the others two clocks and D0/D1.
    bool IsOddr() const { return StringBase(type) == "ODDR"; }
};

const Tsy_DesignGen::ForwardingFlop* Tsy_DesignGen::ForwardingFlopNamed(const StringBase& type)
{
    static const ForwardingFlop kinds[] = {
        {"ODDR", false, false},     {"OFDDRCPE", false, true}, {"OFDDRRSE", false, false},
        {"OFDDRTCPE", true, true}, {"OFDDRTRSE", true, false},
    };
    for (const auto& kind : kinds)
        if (is(type, kind.type))
            return &kind;
    return nullptr;
}

void Tsy_DesignGen::ClockForwarding(Tsy_Block* block, int k)
{
    if (!block)
        return;
    const StringBase fwd = ForwardedOutput(block);
    Tsy_Pin* source = OutputPinNamed(block, fwd, "forwarded clock");
    if (!source)
        return;
    StringBase ff = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_FLIPFLOP);
    ff.Trim();
    if (ff.IsEmpty() || is(ff, "NONE")) {
        OutputBuffer(source, k, 0);
        return;
    }
    const ForwardingFlop* kind = ForwardingFlopNamed(ff);
    if (!kind) {
        Report(StringBase::Printf("The forwarding flip-flop '%s' is not one the wizard can build.", ff.c_str()));
        return;
    }
    Tsy_Block* flop = ForwardingFlipFlop(*kind, fwd, k);
    if (!flop)
        return;
    if (kind->IsOddr())
        SetOddrAttributes(block, flop);
    ForwardingClocks(block, flop, *kind, source, fwd, k);
}

// The flip-flop with its data, control and output pins wired; its clocks
// are left to the caller.
Tsy_Block* Tsy_DesignGen::ForwardingFlipFlop(const ForwardingFlop& kind, const StringBase& fwd, int k)
{
    const bool oddr = kind.IsOddr();
    Tsy_Block* flop = NewBlock(StringBase::Printf("%s_INST", kind.type), kind.type);
    if (!flop)
        return nullptr;
    // A flip-flop that sends 1 on one edge and 0 on the other repeats its
    // clock on the pin, with the output delay of every other DDR output.
    Tie(Pin(flop, oddr ? "D1" : "D0", true), true);
    Tie(Pin(flop, oddr ? "D2" : "D1", true), false);
    Connect(Pin(flop, "CE", true), InputPort(P("CE_IN", k)));
    for (const char* pin : {kind.presetClear ? "PRE" : "S", kind.presetClear ? "CLR" : "R"})
        Connect(Pin(flop, pin, true), InputPort(P(StringBase::Printf("%s_IN", pin), k)));
    if (kind.tristate)
        Connect(Pin(flop, "T", true), InputPort(P("T_IN", k)));
    Connect(Pin(flop, kind.tristate ? "O" : "Q", false), OutputPort(StringBase::Printf("DDR_%s_OUT", fwd.c_str())));
    return flop;
}

void Tsy_DesignGen::SetOddrAttributes(const Tsy_Block* block, Tsy_Block* flop)
{
    StringBase init = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_INIT);
    flop->AddAttribute(Tsy_Attr::INIT, init.IsEmpty() ? StringBase("0") : init);
    flop->AddAttribute(Tsy_Attr::DDR_CLK_EDGE,
                       is(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_EDGEMODE), "SAME") ? "SAME_EDGE"
                                                                                              : "OPPOSITE_EDGE");
    flop->AddAttribute(Tsy_Attr::SRTYPE,
                       is(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_RESETTYPE), "SYNCHRONOUS") ? "SYNC"
                                                                                                    : "ASYNC");
}

// The forwarded output reaches the flip-flop's clock through a global
// buffer, which may close the DCM's feedback loop as well.
void Tsy_DesignGen::ForwardingClocks(Tsy_Block* block, Tsy_Block* flop, const ForwardingFlop& kind, Tsy_Pin* source,
                                     const StringBase& fwd, int k)
{
    Tsy_Pin* c0 = Pin(flop, kind.IsOddr() ? "C" : "C0", true);
    StringBase clock = GlobalBuffer(source, c0, k, 20, false, true, k);
    if (SharesFeedbackWithApplication(block, k))
        Connect(block->GetNamedPin("CLKFB"), clock);
    if (!kind.IsOddr())
        ForwardingSecondClock(block, flop, clock, fwd, k);
}

// C1 of the two-clock flip-flops: the forwarded clock inverted, or another
// output of the DCM through a global buffer of its own.
void Tsy_DesignGen::ForwardingSecondClock(Tsy_Block* block, Tsy_Block* flop, const StringBase& clock,
                                          const StringBase& fwd, int k)
{
    Tsy_Pin* c1 = Pin(flop, "C1", true);
    StringBase second = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_C1);
    second.Trim();
    if (second.IsEmpty() || is(second, "INVERSION")) {
        Tsy_Block* inv = NewBlock("INV_INST", "INV");
        if (!inv)
            return;
        Connect(Pin(inv, "I", true), clock);
        StringBase inverted = NewNet(P(StringBase::Printf("%s_INV_IN", fwd.c_str()), k));
        Connect(Pin(inv, "O", false), inverted);
        Connect(c1, inverted);
    } else if (Tsy_Pin* partner = OutputPinNamed(block, second.Upper(), "second forwarding clock")) {
        GlobalBuffer(partner, c1, k, 20, false, true, k);
    }
}

void Tsy_DesignGen::Cascading(Tsy_Block* dcm1, Tsy_Block* dcm2)
{
    if (!dcm1 || !dcm2)
        return;
    StringBase clk = dcm1->GetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK);
    clk.Trim();
    Tsy_Pin* source = OutputPinNamed(dcm1, clk.IsEmpty() ? StringBase("CLKDV") : clk.Upper(), "cascading clock");
    Tsy_Pin* clkin = dcm2->GetNamedPin("CLKIN");
    if (!source || !clkin)
        return;
    StringBase net = GlobalBuffer(source, clkin, 1, 20, false, true, 2);
    if (SharesFeedbackWithApplication(dcm1, 1))
        Connect(dcm1->GetNamedPin("CLKFB"), net);
}

void Tsy_DesignGen::ClockSwitching(Tsy_Block* dcm1, Tsy_Block* dcm2)
{
    if (!dcm1 || !dcm2)
        return;
    StringBase c1 = dcm1->GetAttributeValue(Tsy_Attr::TESY_ONLY_DCM_SWITCHING_CLK);
    StringBase c2 = dcm2->GetAttributeValue(Tsy_Attr::TESY_ONLY_DCM_SWITCHING_CLK);
    Tsy_Pin* i0 = OutputPinNamed(dcm1, c1.IsEmpty() ? StringBase("CLK0") : c1.Upper(), "switching clock");
    Tsy_Pin* i1 = OutputPinNamed(dcm2, c2.IsEmpty() ? StringBase("CLK0") : c2.Upper(), "switching clock");
    if (!i0 || !i1)
        return;
    // The multiplexer the clock switching page recorded on the first DCM's
    // switching output: BUFGCTRL where the family has it.
    StringBase kind = "BUFGMUX";
    for (int n = 1; n <= 15; ++n) {
        StringBase t = i0->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n));
        if (is(t, "BUFGMUX") || is(t, "BUFGCTRL") || is(t, "BUFGMUX_CTRL") || is(t, "BUFGMUX_TALDOR4")) {
            kind = t.Upper();
            break;
        }
    }
    MuxPorts ports;
    ports.select = "U1_U2_SELECT_IN";
    ports.s0 = "U1_U2_S0_IN";
    ports.s1 = "U1_U2_S1_IN";
    ports.ce0 = "U1_U2_CE0_IN";
    ports.ce1 = "U1_U2_CE1_IN";
    ports.ignore0 = "U1_U2_IGNORE0_IN";
    ports.ignore1 = "U1_U2_IGNORE1_IN";
    ports.out = "U1_U2_CLK_OUT";
    BuildMux(kind, "BUFGMUX_INST", i0, P(i0->GetName() + "_BUF", 1), i1, P(i1->GetName() + "_BUF", 2), ports);
}

// In PMCD designs the DCM's clocks feed the PMCD, whose outputs carry the
// buffers: the PMCD page wires the PMCD to the DCM and the page that keeps
// the PMCD outputs' buffer rows builds their buffers.
void Tsy_DesignGen::PmcdPath(Tsy_Block* dcm1, int k)
{
    if (Tsy_WizPage* pmcdPage = pageOfKind(wizard_, Tsy_PageKind::Pmcd)) {
        if (!pmcdPage->ApplySilently())
            failed_ = true;
    } else {
        Report("The PMCD cannot be generated: the wizard has no Phase-Matched Clock Divider page to configure it.");
    }
    auto* builder = dynamic_cast<Tsy_PmcdBufferBuilder*>(pageOfKind(wizard_, Tsy_PageKind::ClockBuffers));
    if (!builder)
        Report("The buffers of the PMCD outputs cannot be generated: the wizard has no Clock Buffers page that "
               "builds them.");
    else if (!builder->GenerateBuffers())
        failed_ = true;
    static const char* const kDcmClocks[] = {"CLK0", "CLK90",    "CLK180", "CLK270",  "CLKDV",
                                             "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"};
    for (const char* name : kDcmClocks)
        if (Tsy_Pin* pin = dcm1->GetNamedPin(name); pin && pin->IsActive())
            LocalRouting(pin, false, k, 0);
    // The feedback through a PMCD is closed by the buffer of the PMCD output
    // that carries it; an external or absent feedback is the DCM's own.
    Tsy_Pin* clkfb = dcm1->GetNamedPin("CLKFB");
    if (clkfb && clkfb->GetSigName().IsEmpty() && !clkfb->IsGrounded()) {
        StringBase source = dcm1->GetAttributeValue(Tsy_Attr::FB_SOURCE);
        if (is(source, "EXTERNAL") || is(source, "NONE"))
            Feedback(dcm1, k, false);
        else if (builder)
            Report("The DCM feedback is internal, but no buffer of a PMCD output closes the loop.");
    }
}

void Tsy_DesignGen::PmcdConnections(Tsy_Block* dcm1, int k)
{
    StringBase mode = dcm1->GetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD);
    if (is(mode, "SINGLE")) {
        Tsy_Block* pmcd = wizard_->GetActivePMCDBlk(0);
        if (!pmcd) {
            Report("The design uses a PMCD, but the part has none.");
            return;
        }
        Tsy_Pin* rel = Pin(pmcd, "REL", true);
        Tie(rel, false);
        return;
    }
    Tsy_Block* first = wizard_->GetActivePMCDBlk(1);
    Tsy_Block* second = wizard_->GetActivePMCDBlk(2);
    if (!first || !second) {
        Report("The design uses two PMCDs, but the part has none.");
        return;
    }
    // Both PMCDs are released together when the DCM locks, so their divided
    // clocks start in phase; LOCKED must then reach them even where the
    // designer did not ask for it as an output.
    Tsy_Pin* locked = dcm1->GetNamedPin("LOCKED");
    if (!locked)
        return;
    StringBase net = locked->GetSigName();
    if (net.IsEmpty()) {
        net = OutputPort(P("LOCKED_OUT", k));
        Connect(locked, net);
    }
    Connect(Pin(first, "REL", true), net);
    Connect(Pin(second, "REL", true), net);
}
