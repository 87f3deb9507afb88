// The buffer steps of design generation: input buffers, global buffers,
// the buffers recorded on the clock outputs, clock multiplexers and local
// routing.

#include "generation/Tsy_DesignGen.h"

#include "db/Tsy_WizData.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Vocabulary.h"

#include <vector>

namespace {

bool is(const StringBase& value, const char* word)
{
    return value.EqualsNoCase(word);
}

bool isMuxKind(const StringBase& kind)
{
    return is(kind, "BUFGMUX") || is(kind, "BUFGMUX_CTRL") || is(kind, "BUFGMUX_TALDOR4") || is(kind, "BUFGCTRL");
}

} // namespace

StringBase Tsy_DesignGen::InputBuffer(Tsy_Pin* target, const StringBase& base, int k, bool differential, bool mirror)
{
    const char* kind = differential ? "IBUFGDS" : "IBUFG";
    Tsy_Block* buf = NewBlock(P(StringBase::Printf("%s_%s_INST", base.c_str(), kind), k), kind);
    if (!buf)
        return StringBase();
    if (differential) {
        Connect(Pin(buf, "I", true), InputPort(P(StringBase::Printf("%s_P_IN", base.c_str()), k)));
        Connect(Pin(buf, "IB", true), InputPort(P(StringBase::Printf("%s_N_IN", base.c_str()), k)));
    } else {
        Connect(Pin(buf, "I", true), InputPort(P(StringBase::Printf("%s_IN", base.c_str()), k)));
    }
    StringBase net = NewNet(P(StringBase::Printf("%s_%s", base.c_str(), kind), k));
    Connect(Pin(buf, "O", false), net);
    Connect(target, net);
    if (mirror) {
        StringBase port = OutputPort(P(StringBase::Printf("%s_%s_OUT", base.c_str(), kind), k));
        data_->GetNamedSignal(net)->AddAttribute(Tsy_Attr::ASSOC_WITH, port);
    }
    return net;
}

StringBase Tsy_DesignGen::GlobalBuffer(Tsy_Pin* source, Tsy_Pin* target, int k, int n, bool enable, bool mirror,
                                       int targetK)
{
    if (!source)
        return StringBase();
    const char* kind = enable ? "BUFGCE" : "BUFG";
    const StringBase& src = source->GetName();
    Tsy_Block* buf = NewBlock(P(StringBase::Printf("%s_%s_INST", src.c_str(), kind), k), kind);
    if (!buf)
        return StringBase();
    StringBase in = NetOf(source, RecordedOr(source, n, "I", P(StringBase::Printf("%s_BUF", src.c_str()), k)));
    Connect(Pin(buf, "I", true), in);
    if (enable)
        Connect(Pin(buf, "CE", true),
                InputPort(RecordedOr(source, n, "CE", P(StringBase::Printf("%s_ENABLE_IN", src.c_str()), k))));
    Tsy_Pin* o = Pin(buf, "O", false);
    if (!target) {
        StringBase port = OutputPort(RecordedOr(source, n, "O", P(StringBase::Printf("%s_OUT", src.c_str()), k)));
        Connect(o, port);
        return port;
    }
    StringBase net = NewNet(P(StringBase::Printf("%s_IN", target->GetName().c_str()), targetK));
    Connect(o, net);
    Connect(target, net);
    // The clock that closes a loop or drives another block is also the one
    // the designer clocks logic with: mirror it on an output port.
    if (mirror) {
        StringBase port = OutputPort(P(StringBase::Printf("%s_OUT", src.c_str()), k));
        data_->GetNamedSignal(net)->AddAttribute(Tsy_Attr::ASSOC_WITH, port);
    }
    return net;
}

// An output buffer takes the clock off the chip on a device pin.
void Tsy_DesignGen::OutputBuffer(Tsy_Pin* source, int k, int n)
{
    const StringBase& src = source->GetName();
    Tsy_Block* buf = NewBlock(P(StringBase::Printf("%s_OBUF_INST", src.c_str()), k), "OBUF");
    if (!buf)
        return;
    Connect(Pin(buf, "I", true), NetOf(source, RecordedOr(source, n, "I", P(StringBase::Printf("%s_OBUF", src.c_str()), k))));
    Connect(Pin(buf, "O", false), OutputPort(RecordedOr(source, n, "O", P(StringBase::Printf("%s_OUT", src.c_str()), k))));
}

void Tsy_DesignGen::LocalRouting(Tsy_Pin* pin, bool lowSkew, int k, int n)
{
    const char* mark = lowSkew ? Tsy_Attr::USELOWSKEWLINES : Tsy_Attr::USELOCALROUTING;
    Tsy_Signal* net = pin->GetSigName().IsEmpty() ? nullptr : data_->GetNamedSignal(pin->GetSigName());
    if (net && !net->IsActive())
        net = nullptr;
    if (net && net->IsExternal()) {
        net->AddAttribute(mark, "TRUE");
        return;
    }
    StringBase port = OutputPort(RecordedOr(pin, n, "O", P(pin->GetName() + "_OUT", k)));
    data_->GetNamedSignal(port)->AddAttribute(mark, "TRUE");
    if (net)
        net->AddAttribute(Tsy_Attr::ASSOC_WITH, port);
    else
        Connect(pin, port);
}

// "CLK90", or "CLK0 From INST2" for an output of the other DCM.
Tsy_Pin* Tsy_DesignGen::ResolveMuxInput(Tsy_Block* block, const StringBase& text)
{
    StringBase name = text;
    name.Trim();
    int from = name.GetIndexOfString(" From INST");
    if (from > 0) {
        int inst = name[static_cast<size_t>(from) + 10] - '0';
        block = inst == 1 ? dcm1_ : inst == 2 ? dcm2_ : nullptr;
        name.Truncate(static_cast<size_t>(from));
    }
    Tsy_Pin* pin = block ? block->GetNamedPin(name.Upper()) : nullptr;
    if (!pin || (pin->IsInput() && pin->GetName() != "CLKIN"))
        return nullptr;
    pin->SetIsActive(true);
    return pin;
}

void Tsy_DesignGen::BuildMux(const StringBase& kind, const StringBase& blockName, Tsy_Pin* i0, const StringBase& i0Net,
                             Tsy_Pin* i1, const StringBase& i1Net, const MuxPorts& ports)
{
    Tsy_Block* mux = NewBlock(blockName, kind);
    if (!mux)
        return;
    Connect(Pin(mux, "I0", true), NetOf(i0, i0Net));
    Connect(Pin(mux, "I1", true), NetOf(i1, i1Net));
    if (is(kind, "BUFGCTRL")) {
        Connect(Pin(mux, "S0", true), InputPort(ports.s0));
        Connect(Pin(mux, "S1", true), InputPort(ports.s1));
        Connect(Pin(mux, "CE0", true), InputPort(ports.ce0));
        Connect(Pin(mux, "CE1", true), InputPort(ports.ce1));
        Connect(Pin(mux, "IGNORE0", true), InputPort(ports.ignore0));
        Connect(Pin(mux, "IGNORE1", true), InputPort(ports.ignore1));
    } else if (mux->GetDef() && mux->GetDef()->FindPin("S")) {
        Connect(Pin(mux, "S", true), InputPort(ports.select));
    }
    Connect(Pin(mux, "O", false), OutputPort(ports.out));
}

void Tsy_DesignGen::OutputMux(Tsy_Block* block, Tsy_Pin* source, int k, int n, const StringBase& kind)
{
    StringBase i1Text = source->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_I1_PINNAME, n));
    if (i1Text.IsEmpty())
        i1Text = source->GetAttributeValue(Tsy_Attr::TSY_CLKMUX_I1);
    Tsy_Pin* i1 = ResolveMuxInput(block, i1Text);
    if (!i1) {
        Report(i1Text.IsEmpty()
                   ? StringBase::Printf("The clock multiplexer of buffer %d on %s has no input I1.", n,
                                        source->GetName().c_str())
                   : StringBase::Printf("The clock multiplexer of buffer %d on %s takes its input I1 from '%s', "
                                        "which is not an output of %s.",
                                        n, source->GetName().c_str(), i1Text.c_str(), block->GetName().c_str()));
        return;
    }
    const StringBase s = source->GetName();
    const StringBase t = i1->GetName();
    // Extra pins name the output that feeds them; by default the input they
    // belong with.
    StringBase ignore0 = source->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_PINNAME, n, "IGNORE0"));
    StringBase ignore1 = source->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_PINNAME, n, "IGNORE1"));
    ignore0 = ignore0.IsEmpty() ? s : ignore0.Upper();
    ignore1 = ignore1.IsEmpty() ? t : ignore1.Upper();
    auto dflt = [&](const StringBase& pin, const char* suffix) {
        return P(StringBase::Printf("%s_%s", pin.c_str(), suffix), k);
    };
    MuxPorts ports;
    if (is(kind, "BUFGCTRL")) {
        // The dialog records the first select and enable as S0 and CE0, or
        // as S and CE.
        StringBase s0 = Recorded(source, n, "S0"), ce0 = Recorded(source, n, "CE0");
        ports.s0 = !s0.IsEmpty() ? s0 : RecordedOr(source, n, "S", dflt(s, "S0_IN"));
        ports.ce0 = !ce0.IsEmpty() ? ce0 : RecordedOr(source, n, "CE", dflt(s, "CE0_IN"));
        ports.s1 = RecordedOr(source, n, "S1", dflt(t, "S1_IN"));
        ports.ce1 = RecordedOr(source, n, "CE1", dflt(t, "CE1_IN"));
        ports.ignore0 = RecordedOr(source, n, "IGNORE0", dflt(ignore0, "IGNORE0_IN"));
        ports.ignore1 = RecordedOr(source, n, "IGNORE1", dflt(ignore1, "IGNORE1_IN"));
    } else {
        ports.select = RecordedOr(source, n, "S", dflt(s, "SELECT_IN"));
    }
    ports.out = RecordedOr(source, n, "O", P(StringBase::Printf("%s_%s_OUT", s.c_str(), t.c_str()), k));
    StringBase i0 = Recorded(source, n, "I0");
    StringBase i0Net = !i0.IsEmpty() ? i0 : RecordedOr(source, n, "I", dflt(s, "BUF"));
    StringBase i1Net = RecordedOr(source, n, "I1", dflt(t, "BUF"));
    BuildMux(kind.Upper(), P(StringBase::Printf("%s_%s_INST", s.c_str(), kind.Upper().c_str()), k), source, i0Net,
             i1, i1Net, ports);
}

void Tsy_DesignGen::OutputBuffers(Tsy_Block* block, int k)
{
    if (!block)
        return;
    std::vector<std::pair<Tsy_Pin*, int>> localRouting, lowSkew;
    std::vector<Tsy_Pin*> sources;
    for (const auto& pin : block->Pins())
        if (!pin->IsInput() && pin->IsActive())
            sources.push_back(pin.get());
    // A buffer on the input clock takes it after the input buffer; an
    // internal input clock is the designer's own net already.
    Tsy_Pin* clkin = block->GetNamedPin("CLKIN");
    if (clkin && !clkin->GetSigName().IsEmpty() && is(block->GetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE), "EXTERNAL"))
        sources.push_back(clkin);

    for (Tsy_Pin* pin : sources) {
        for (int n = 1; n <= 15; ++n) {
            StringBase kind = pin->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n));
            kind.Trim();
            if (kind.IsEmpty())
                break;
            StringBase state = pin->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N_NOEDIT, n));
            // The feedback step and the application logic build these.
            if (is(state, Tsy_BufState::FEEDBACK) || is(state, Tsy_BufState::DISABLED))
                continue;
            if (is(kind, "BUFG"))
                GlobalBuffer(pin, nullptr, k, n, false, false, k);
            else if (is(kind, "BUFGCE"))
                GlobalBuffer(pin, nullptr, k, n, true, false, k);
            else if (is(kind, "LOCALROUTING"))
                localRouting.emplace_back(pin, n);
            else if (is(kind, "LOWSKEWLINE"))
                lowSkew.emplace_back(pin, n);
            else if (is(kind, "OBUF"))
                OutputBuffer(pin, k, n);
            else if (isMuxKind(kind))
                OutputMux(block, pin, k, n, kind);
            else if (!is(kind, "NONE"))
                Report(StringBase::Printf("The buffer type '%s' recorded for buffer %d on %s is not one the wizard "
                                          "can build.",
                                          kind.c_str(), n, pin->GetName().c_str()));
        }
    }
    for (const auto& [pin, n] : localRouting)
        LocalRouting(pin, false, k, n);
    for (const auto& [pin, n] : lowSkew)
        LocalRouting(pin, true, k, n);
}
