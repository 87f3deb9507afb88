#include "generation/Tsy_DesignGen.h"

#include "db/Tsy_WizData.h"
#include "hdl/Tsy_HdlNames.h"
#include "wiz/Port_Stream.h"
#include "wiz/Tsy_WizPage.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Family.h"
#include "wizard/Tsy_Vocabulary.h"

namespace {

bool is(const StringBase& value, const char* word)
{
    return value.EqualsNoCase(word);
}

} // namespace

std::unique_ptr<Tsy_DesignGen> Tsy_DesignGen::Create(Tsy_DCMwiz* wizard, int wizType)
{
    if (!wizard || !wizard->GetDesignData())
        return nullptr;
    return std::make_unique<Tsy_DesignGen>(wizard, wizType, wizard->GetDesignData());
}

Tsy_DesignGen::Tsy_DesignGen(Tsy_DCMwiz* wizard, int wizType, Tsy_WizData* data)
    : familyFlag_(Tsy_Family::IsGeneration45(wizard->GetFamilyName())), wizType_(wizType), data_(data),
      wizard_(wizard)
{
}

// ------------------------------------------------------------------ helpers

StringBase Tsy_DesignGen::P(const StringBase& name, int k) const
{
    return wizard_->AddDCMPrefix(name, k);
}

void Tsy_DesignGen::Report(const StringBase& text)
{
    failed_ = true;
    Tsy_WizPage::DoMessage(text, wizard_->IsBatch(), wizard_->GetStream(), true, wizard_->GetMessageFlag(), false);
}

bool Tsy_DesignGen::IsActiveSignal(const StringBase& name) const
{
    const Tsy_Signal* s = data_->GetNamedSignal(name);
    return s && s->IsActive();
}

StringBase Tsy_DesignGen::UniqueSignalName(const StringBase& name) const
{
    if (!IsActiveSignal(name))
        return name;
    for (int i = 1; i <= 99; ++i) {
        StringBase candidate = StringBase::Printf("%s%d", name.c_str(), i);
        if (!IsActiveSignal(candidate))
            return candidate;
    }
    return name;
}

StringBase Tsy_DesignGen::UniqueBlockName(const StringBase& name) const
{
    // A name is taken by an active block, and for good by a template.
    auto taken = [this](const StringBase& n) {
        for (const auto& b : data_->Blocks())
            if (b->GetName() == n && (b->active || b->IsTemplate()))
                return true;
        return false;
    };
    if (!taken(name))
        return name;
    for (int i = 1; i <= 99; ++i) {
        StringBase candidate = StringBase::Printf("%s%d", name.c_str(), i);
        if (!taken(candidate))
            return candidate;
    }
    return name;
}

Tsy_Block* Tsy_DesignGen::NewBlock(const StringBase& name, const StringBase& type)
{
    StringBase unique = UniqueBlockName(name);
    Tsy_Block* block = data_->AddBlock(unique, type);
    if (!block)
        Report(StringBase::Printf("Internal error: the block %s could not be added to the design.", unique.c_str()));
    return block;
}

Tsy_Pin* Tsy_DesignGen::Pin(Tsy_Block* block, const char* name, bool input)
{
    Tsy_Pin* pin = block->AddPin(name, input ? "IN" : "OUT");
    pin->SetIsActive(true);
    return pin;
}

StringBase Tsy_DesignGen::InputPort(const StringBase& name, int width)
{
    // Input ports of the same name are one port read in several places; a
    // name held by a net or an output port is not.
    StringBase port = name;
    const Tsy_Signal* s = data_->GetNamedSignal(name);
    if (s && s->IsActive() && !(s->IsExternal() && s->GetDirection() == "I"))
        port = UniqueSignalName(name);
    Tsy_Signal* sig = data_->AddSignal(port, true, "I");
    if (width > 1)
        sig->SetIsBus(true, width);
    return port;
}

StringBase Tsy_DesignGen::OutputPort(const StringBase& name, int width)
{
    StringBase port = UniqueSignalName(name);
    Tsy_Signal* sig = data_->AddSignal(port, true, "O");
    if (width > 1)
        sig->SetIsBus(true, width);
    return port;
}

StringBase Tsy_DesignGen::NewNet(const StringBase& name)
{
    StringBase net = UniqueSignalName(name);
    data_->AddSignal(net, false, "");
    return net;
}

void Tsy_DesignGen::Connect(Tsy_Pin* pin, const StringBase& net)
{
    if (!pin)
        return;
    pin->SetIsActive(true);
    pin->SetSigName(net);
}

StringBase Tsy_DesignGen::NetOf(Tsy_Pin* pin, const StringBase& fallback)
{
    pin->SetIsActive(true);
    if (!pin->GetSigName().IsEmpty() && IsActiveSignal(pin->GetSigName()))
        return pin->GetSigName();
    StringBase net = NewNet(fallback);
    pin->SetSigName(net);
    return net;
}

void Tsy_DesignGen::Tie(Tsy_Pin* pin, bool high)
{
    if (!pin)
        return;
    if (high)
        pin->SetIsVcc(true);
    else
        pin->SetIsGrounded(true);
}

StringBase Tsy_DesignGen::Recorded(const Tsy_Pin* pin, int n, const char* port)
{
    if (!pin || n <= 0)
        return StringBase();
    StringBase name = pin->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_SIGNAME, n, port));
    name.Trim();
    if (name.IsEmpty())
        return name;
    std::string problem = Tsy_HdlNameProblem(name.str());
    if (problem.empty())
        return name;
    Report(StringBase::Printf("The signal name '%s' given to %s of buffer %d on %s is not a legal Verilog and VHDL "
                              "name: it %s.  Please change it on the Clock Buffers page.",
                              name.c_str(), port, n, pin->GetName().c_str(), problem.c_str()));
    return StringBase();
}

StringBase Tsy_DesignGen::RecordedOr(const Tsy_Pin* pin, int n, const char* port, const StringBase& fallback)
{
    StringBase name = Recorded(pin, n, port);
    return name.IsEmpty() ? fallback : name;
}

Tsy_Pin* Tsy_DesignGen::OutputPinNamed(Tsy_Block* block, const StringBase& name, const char* role)
{
    Tsy_Pin* pin = block ? block->GetNamedPin(name) : nullptr;
    if (!pin || pin->IsInput()) {
        Report(StringBase::Printf("The %s '%s' is not an output of %s.", role, name.c_str(),
                                  block ? block->GetName().c_str() : "the DCM"));
        return nullptr;
    }
    pin->SetIsActive(true);
    return pin;
}

// ------------------------------------------------------------------ the DCM design

bool Tsy_DesignGen::GenerateDCMDesign()
{
    failed_ = false;
    const bool twoDcms = !Tsy_DCMwiz::IsSingleDcmType(wizType_);
    RetireGeneratedBlocks();
    // Without its DCMs there is no design to write: a Finish that built
    // half a netlist must not pass for one that succeeded.
    if (!FindDcmBlocks(twoDcms))
        return false;
    StringBase pmcd = dcm1_->GetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD);
    const bool pmcdUse = !pmcd.IsEmpty() && !is(pmcd, "NONE");

    data_->SetAllSigsIsActive(false);
    Prepare();
    dcm1_->ClearAllPinSignals();
    BuildFirstDcm(twoDcms ? 1 : 0, pmcdUse);
    if (dcm2_)
        BuildSecondDcm();
    return !failed_;
}

// The netlist of an earlier Finish is built anew.
void Tsy_DesignGen::RetireGeneratedBlocks()
{
    for (const auto& b : data_->Blocks())
        if (b->IsGenerated())
            b->active = false;
}

Tsy_Block* Tsy_DesignGen::FindDcmBlock(int inst)
{
    Port::Stream* stream = wizard_->GetStream();
    int before = stream ? stream->ErrorCount() : 0;
    Tsy_Block* b = wizard_->GetActiveDCMBlk(inst, true);
    // The lookup names a missing primitive itself; a copy it could not
    // make it leaves unsaid.
    if (!b && (!stream || stream->ErrorCount() == before))
        Report("DCM block not found.");
    return b;
}

// Finds the design's DCMs and marks them active; false when one is missing.
bool Tsy_DesignGen::FindDcmBlocks(bool twoDcms)
{
    dcm1_ = FindDcmBlock(1);
    dcm2_ = nullptr;
    if (twoDcms) {
        dcm2_ = FindDcmBlock(2);
        if (dcm2_)
            dcm2_->ClearAllPinSignals();
    }
    if (!dcm1_ || (twoDcms && !dcm2_))
        return false;
    dcm1_->active = true;
    if (dcm2_)
        dcm2_->active = true;
    return true;
}

void Tsy_DesignGen::BuildFirstDcm(int k, bool pmcdUse)
{
    InputClock(dcm1_, k);
    if (!pmcdUse)
        Feedback(dcm1_, k, true);
    ApplicationLogic(dcm1_, dcm2_, k);
    if (pmcdUse)
        PmcdPath(dcm1_, k);
    else
        OutputBuffers(dcm1_, k);
    ResetLogic(dcm1_, k, nullptr);
    RemainingDcmPins(dcm1_, k);
    if (pmcdUse)
        PmcdConnections(dcm1_, k);
}

void Tsy_DesignGen::BuildSecondDcm()
{
    InputClock(dcm2_, 2);
    Feedback(dcm2_, 2, true);
    ApplicationLogic(dcm1_, dcm2_, 2);
    OutputBuffers(dcm2_, 2);
    ResetLogic(dcm2_, 2, dcm1_);
    RemainingDcmPins(dcm2_, 2);
}

// The PLL designs arrive with the PLL pages; until then their wizard types
// are not offered, and a Finish of one fails.
bool Tsy_DesignGen::GeneratePLLDesign()
{
    return false;
}

bool Tsy_DesignGen::GenerateDCMToPLLDesign()
{
    return false;
}

bool Tsy_DesignGen::GeneratePLLToDCMDesign()
{
    return false;
}

// ------------------------------------------------------------------ steps

void Tsy_DesignGen::Prepare()
{
    for (const auto& s : data_->Signals()) {
        s->RemoveAttribute(Tsy_Attr::USELOWSKEWLINES);
        s->RemoveAttribute(Tsy_Attr::USELOCALROUTING);
        s->RemoveAttribute("TESY_ONLY_ASSOC_FROM");
        s->RemoveAttribute(Tsy_Attr::ASSOC_WITH);
    }
}

void Tsy_DesignGen::InputClock(Tsy_Block* block, int k)
{
    if (!block)
        return;
    Tsy_Pin* clkin = block->GetNamedPin("CLKIN");
    if (!clkin)
        return;
    clkin->SetIsActive(true);
    if (wizType_ == Tsy_DCMwiz::TypeBoardDeskew && k == 2) {
        // Both DCMs of board deskew take the one input clock, after the
        // first DCM's input buffer.
        Tsy_Pin* first = dcm1_ ? dcm1_->GetNamedPin("CLKIN") : nullptr;
        StringBase net = first && !first->GetSigName().IsEmpty() ? first->GetSigName() : StringBase("U1_CLKIN_IBUFG");
        data_->AddSignal(net, false, "");
        Connect(clkin, net);
        return;
    }
    if (wizType_ == Tsy_DCMwiz::TypeCascading && k == 2)
        return;
    if (is(block->GetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE), "INTERNAL")) {
        Connect(clkin, InputPort(P("CLKIN_IN", k)));
        return;
    }
    bool differential = !is(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL), "SINGLE");
    InputBuffer(clkin, "CLKIN", k, differential, true);
}

StringBase Tsy_DesignGen::ForwardedOutput(const Tsy_Block* block) const
{
    StringBase out = block->GetAttributeValue(familyFlag_ ? Tsy_Attr::TESY_ONLY_DDR_CLK : Tsy_Attr::TESY_ONLY_DDR_C0);
    out.Trim();
    return out.IsEmpty() ? StringBase("CLK0") : out.Upper();
}

// Whether the application's own buffer already closes the feedback loop: the
// cascading buffer of the first DCM, or the forwarding buffer that clocks a
// flip-flop. A forwarded clock without flip-flop leaves through an output
// buffer only, so its feedback keeps its own global buffer.
bool Tsy_DesignGen::SharesFeedbackWithApplication(const Tsy_Block* block, int k) const
{
    if (!block || !is(block->GetAttributeValue(Tsy_Attr::FB_SOURCE), "INTERNAL"))
        return false;
    StringBase fbOut = is(block->GetAttributeValue(Tsy_Attr::CLK_FEEDBACK), "1X") ? "CLK0" : "CLK2X";
    const bool forwarding = wizType_ == Tsy_DCMwiz::TypeClockForwarding ||
                            (wizType_ == Tsy_DCMwiz::TypeBoardDeskew && k == 1);
    if (forwarding) {
        StringBase ff = block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_FLIPFLOP);
        return !ff.IsEmpty() && !is(ff, "NONE") && ForwardedOutput(block).EqualsNoCase(fbOut);
    }
    if (wizType_ == Tsy_DCMwiz::TypeCascading && k == 1)
        return block->GetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK).EqualsNoCase(fbOut);
    return false;
}

void Tsy_DesignGen::Feedback(Tsy_Block* block, int k, bool mirror)
{
    if (!block || SharesFeedbackWithApplication(block, k))
        return;
    Tsy_Pin* clkfb = block->GetNamedPin("CLKFB");
    if (!clkfb)
        return;
    StringBase source = block->GetAttributeValue(Tsy_Attr::FB_SOURCE);
    if (is(source, "INTERNAL")) {
        StringBase fbOut = is(block->GetAttributeValue(Tsy_Attr::CLK_FEEDBACK), "1X") ? "CLK0" : "CLK2X";
        Tsy_Pin* out = OutputPinNamed(block, fbOut, "feedback output");
        if (out)
            GlobalBuffer(out, clkfb, k, 0, false, mirror, k);
    } else if (is(source, "EXTERNAL")) {
        bool differential = !is(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_FB_EXTERNAL), "SINGLE");
        InputBuffer(clkfb, "CLKFB", k, differential, false);
    } else {
        clkfb->SetIsActive(true);
        Tie(clkfb, false);
    }
}

StringBase Tsy_DesignGen::LockedInverter(Tsy_Block* partner, int k)
{
    // The second DCM of a cascade stays in reset until the first has locked.
    Tsy_Pin* locked = partner ? partner->GetNamedPin("LOCKED") : nullptr;
    if (!locked) {
        Report("The first DCM has no LOCKED output to hold the second DCM in reset with.");
        return StringBase();
    }
    StringBase in = NetOf(locked, "U1_LOCKED_INV_IN");
    Tsy_Block* inv = NewBlock(P("INV_INST", k), "INV");
    StringBase out = NewNet("U2_LOCKED_INV_RST");
    if (inv) {
        Connect(Pin(inv, "I", true), in);
        Connect(Pin(inv, "O", false), out);
    }
    return out;
}

void Tsy_DesignGen::ResetLogic(Tsy_Block* block, int k, Tsy_Block* partner)
{
    if (!block)
        return;
    Tsy_Pin* rst = block->GetNamedPin("RST");
    const bool cascadeSecond = wizType_ == Tsy_DCMwiz::TypeCascading && k == 2 && partner;
    if (!is(block->GetAttributeValue(Tsy_Attr::TESY_ONLY_RESET_LOGIC), "TRUE")) {
        // The second DCM of a cascade has no reset logic of its own, and its
        // RST is not given a port: the first DCM's lock releases it.
        if (cascadeSecond && rst) {
            StringBase net = LockedInverter(partner, k);
            if (!net.IsEmpty())
                Connect(rst, net);
        }
        return;
    }
    Tsy_Pin* clkin = block->GetNamedPin("CLKIN");
    StringBase clock = clkin ? clkin->GetSigName() : StringBase();
    if (!rst || clock.IsEmpty()) {
        Report(StringBase::Printf("The reset logic of %s cannot be built: %s.", block->GetName().c_str(),
                                  rst ? "its input clock is not connected" : "it has no RST input"));
        return;
    }
    Tsy_Block* or3 = NewBlock(P("OR3_INST", k), "OR3");
    Tsy_Block* fds = NewBlock(P("FDS_INST", k), "FDS");
    if (!or3 || !fds)
        return;
    Tie(Pin(fds, "S", true), false);
    Tie(Pin(fds, "D", true), false);
    Connect(Pin(fds, "C", true), clock);
    StringBase q = NewNet(P("FDS_Q_OUT", k));
    Connect(Pin(fds, "Q", false), q);
    // Three more stages stretch the pulse; each stage's output also feeds the OR.
    const char* const orInputs[] = {"I2", "I1", "I0"};
    for (int i = 1; i <= 3; ++i) {
        Tsy_Block* fd = NewBlock(P(StringBase::Printf("FD%d_INST", i), k), "FD");
        if (!fd)
            return;
        Connect(Pin(fd, "D", true), q);
        Connect(Pin(fd, "C", true), clock);
        q = NewNet(P(StringBase::Printf("FD%d_Q_OUT", i), k));
        Connect(Pin(fd, "Q", false), q);
        Connect(Pin(or3, orInputs[i - 1], true), q);
    }
    StringBase or3Out = NewNet(P("OR3_O_OUT", k));
    Connect(Pin(or3, "O", false), or3Out);

    Tsy_Block* or2 = NewBlock(P("OR2_INST", k), "OR2");
    if (!or2)
        return;
    Connect(Pin(or2, "I1", true), or3Out);
    StringBase i0 = cascadeSecond ? LockedInverter(partner, k) : InputPort(P("USER_RST_IN", k));
    if (!i0.IsEmpty())
        Connect(Pin(or2, "I0", true), i0);
    StringBase rstNet = NewNet(P("RST_IN", k));
    Connect(Pin(or2, "O", false), rstNet);
    Connect(rst, rstNet);
}

void Tsy_DesignGen::RemainingDcmPins(Tsy_Block* block, int k)
{
    if (!block)
        return;
    static const char* const kStatusOutputs[] = {"DRDY", "STATUS", "DO", "PSDONE", "LOCKED"};
    const bool cascade = wizType_ == Tsy_DCMwiz::TypeCascading;
    for (const auto& pinPtr : block->Pins()) {
        Tsy_Pin* pin = pinPtr.get();
        const StringBase& name = pin->GetName();
        if (pin->IsInput()) {
            if (name == "CLKIN" || name == "CLKFB" || (name == "RST" && cascade && k == 2))
                continue;
            if (!pin->IsActive())
                Tie(pin, false);
            else if (pin->GetSigName().IsEmpty() && !pin->IsGrounded() && !pin->IsVcc())
                Connect(pin, InputPort(P(name + "_IN", k), pin->GetWidth()));
            continue;
        }
        bool status = false;
        for (const char* s : kStatusOutputs)
            status = status || name == s;
        if (!status || (name == "LOCKED" && cascade && k == 1))
            continue;
        if (!pin->IsActive())
            pin->ClearAllConnections();
        else if (pin->GetSigName().IsEmpty())
            Connect(pin, OutputPort(P(name + "_OUT", k), pin->GetWidth()));
    }
}
