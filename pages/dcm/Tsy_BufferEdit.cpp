#include "pages/dcm/Tsy_BufferEdit.h"

#include "db/Tsy_WizData.h"
#include "hdl/Tsy_HdlNames.h"
#include "pages/dcm/Tsy_BufferRecords.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_DCMwizPage.h"
#include "wizard/Tsy_Vocabulary.h"

namespace Rec = Tsy_BufferRecords;

namespace {

StringBase sigRecord(int n, const char* port)
{
    return StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_SIGNAME, n, port);
}

StringBase pinRecord(int n, const char* port)
{
    return StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_PINNAME, n, port);
}

} // namespace

Tsy_BufferEdit::Tsy_BufferEdit(Tsy_DCMwizPage* page) : page_(page)
{
    Reset();
}

void Tsy_BufferEdit::Reset()
{
    wizType_ = page_ ? page_->GetWizType() : 0;
    instNum_ = 1;
    pmcdMode_ = "NONE";
    pmcdInst_ = 1;
    prefix_ = StringBase();
    outputs_.clear();
    i0_ = i1_ = type_ = origType_ = StringBase();
    bufNum_ = 0;
    for (int s = 0; s < SlotCount; ++s) {
        names_[s] = StringBase();
        given_[s] = false;
    }
    ignore_[0] = ignore_[1] = kIgnoreSignal;
    batch_ = page_ && page_->IsBatch();
    isNew_ = deleted_ = silent_ = false;
}

void Tsy_BufferEdit::Prepare(int wizType, int instNum, const StringBase& pmcdMode, int pmcdInst,
                             const StringBase& prefix, const std::vector<StringBase>& outputs, const StringBase& i0,
                             const StringBase& i1, const StringBase& type, int bufNum, bool isNew)
{
    Reset();
    wizType_ = wizType;
    instNum_ = instNum;
    pmcdMode_ = pmcdMode.IsEmpty() ? StringBase("NONE") : pmcdMode;
    pmcdInst_ = pmcdInst == 2 ? 2 : 1;
    prefix_ = prefix;
    outputs_ = outputs;
    i0_ = i0;
    i1_ = i1;
    type_ = type;
    origType_ = type;
    bufNum_ = bufNum < 0 ? 0 : bufNum;
    isNew_ = isNew;
    if (!isNew_)
        loadRecordedNames();
}

std::vector<Tsy_BufferEdit::PortDef> Tsy_BufferEdit::PortsOf(const StringBase& type)
{
    if (type.EqualsNoCase("BUFG") || type.EqualsNoCase("OBUF"))
        return {{"I", SlotIn}, {"O", SlotO}};
    if (type.EqualsNoCase("BUFGCE"))
        return {{"I", SlotIn}, {"CE", SlotCE}, {"O", SlotO}};
    if (type.EqualsNoCase("BUFGCTRL"))
        return {{"I0", SlotIn},           {"I1", SlotI1},           {"S0", SlotS},
                {"S1", SlotS1},           {"CE0", SlotCE},          {"CE1", SlotCE1},
                {"IGNORE0", SlotIgnore0}, {"IGNORE1", SlotIgnore1}, {"O", SlotO}};
    if (Rec::IsMuxType(type))
        return {{"I0", SlotIn}, {"I1", SlotI1}, {"S", SlotS}, {"O", SlotO}};
    if (type.EqualsNoCase("LOCALROUTING") || type.EqualsNoCase("LOWSKEWLINE"))
        return {{"O", SlotO}};
    return {};
}

bool Tsy_BufferEdit::HasSlot(const StringBase& type, Slot slot)
{
    for (const PortDef& p : PortsOf(type))
        if (p.slot == slot)
            return true;
    return false;
}

bool Tsy_BufferEdit::IsParallelPmcd() const
{
    return pmcdMode_.EqualsNoCase("PARALLEL");
}

bool Tsy_BufferEdit::IsPmcdDesign() const
{
    return !IsPllDesign() && (pmcdMode_.EqualsNoCase("SINGLE") || IsParallelPmcd());
}

bool Tsy_BufferEdit::IsPllDesign() const
{
    return wizType_ == Tsy_DCMwiz::TypePll || wizType_ == Tsy_DCMwiz::TypeDcmToPll;
}

bool Tsy_BufferEdit::isNone(const StringBase& s)
{
    StringBase t = s;
    t.Trim();
    return t.IsEmpty() || t.EqualsNoCase("NONE");
}

StringBase Tsy_BufferEdit::PinNameOf(const StringBase& shown, int fallbackInst, int* inst)
{
    StringBase s = shown;
    s.Trim();
    int which = fallbackInst;
    if (s.StartsWith("U1 ", Port::CompareNoCase) || s.StartsWith("U2 ", Port::CompareNoCase)) {
        which = s[1] == '2' ? 2 : 1;
        s = s.Mid(3);
        s.Trim();
    }
    if (inst)
        *inst = which;
    return s;
}

StringBase Tsy_BufferEdit::i0Pin() const
{
    return PinNameOf(i0_, pmcdInst_);
}

StringBase Tsy_BufferEdit::i1Pin() const
{
    return isNone(i1_) ? StringBase() : PinNameOf(i1_, pmcdInst_);
}

Tsy_Block* Tsy_BufferEdit::DcmBlock() const
{
    if (!page_ || IsPllDesign())
        return nullptr;
    return page_->GetActiveDCMBlk(instNum_, false);
}

Tsy_Block* Tsy_BufferEdit::SourceBlock() const
{
    if (!page_)
        return nullptr;
    if (IsPllDesign())
        return page_->GetActivePLLBlk(false);
    if (pmcdMode_.EqualsNoCase("SINGLE"))
        return page_->GetActivePMCDBlk(0);
    if (IsParallelPmcd()) {
        int inst = pmcdInst_;
        PinNameOf(i0_, pmcdInst_, &inst);
        return page_->GetActivePMCDBlk(inst);
    }
    return DcmBlock();
}

Tsy_Pin* Tsy_BufferEdit::I0Pin() const
{
    if (isNone(i0_))
        return nullptr;
    Tsy_Block* block = SourceBlock();
    return block ? block->GetNamedPin(i0Pin()) : nullptr;
}

// In PMCD designs the name the PMCD page gave the output stands for prefix
// and output together.
StringBase Tsy_BufferEdit::base() const
{
    if (IsPmcdDesign())
        if (const Tsy_Pin* pin = I0Pin()) {
            StringBase given = pin->GetAttributeValue(Tsy_Attr::TSY_PMCD_SIGNAME);
            if (!given.IsEmpty() && Tsy_IsLegalHdlName(given.str()))
                return given;
        }
    return prefix_ + i0Pin();
}

StringBase Tsy_BufferEdit::GetDefaultName(Slot slot) const
{
    const char* p = prefix_.c_str();
    StringBase s = i0Pin();
    if (s.IsEmpty())
        return StringBase();
    const bool ctrl = type_.EqualsNoCase("BUFGCTRL");
    StringBase i1 = i1Pin();
    switch (slot) {
    case SlotIn:
        if (s.EqualsNoCase("CLKIN") && !IsPmcdDesign() && !IsPllDesign()) {
            Tsy_Block* dcm = DcmBlock();
            bool differential =
                dcm && dcm->GetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL).EqualsNoCase("DIFFERENTIAL");
            return differential ? StringBase::Printf("%s%s_IBUFGDS", p, s.c_str())
                                : StringBase::Printf("%s%s_IBUFG", p, s.c_str());
        }
        if (IsPmcdDesign())
            return StringBase::Printf("%s_BUF", base().c_str());
        return StringBase::Printf("%s%s_BUF", p, s.c_str());
    case SlotI1:
        return i1.IsEmpty() ? StringBase() : StringBase::Printf("%s%s_BUF", p, i1.c_str());
    case SlotS:
        return ctrl ? StringBase::Printf("%s%s_S0_IN", p, s.c_str())
                    : StringBase::Printf("%s%s_SELECT_IN", p, s.c_str());
    case SlotS1:
        return StringBase::Printf("%s%s_S1_IN", p, s.c_str());
    case SlotCE:
        return ctrl ? StringBase::Printf("%s%s_CE0_IN", p, s.c_str())
                    : StringBase::Printf("%s%s_ENABLE_IN", p, s.c_str());
    case SlotCE1:
        return StringBase::Printf("%s%s_CE1_IN", p, s.c_str());
    case SlotIgnore0:
        return StringBase::Printf("%s%s_IGNORE0_IN", p, s.c_str());
    case SlotIgnore1:
        return StringBase::Printf("%s%s_IGNORE1_IN", p, s.c_str());
    case SlotO:
        if (IsPmcdDesign()) {
            StringBase b = base();
            return Rec::IsMuxType(type_) && !i1.IsEmpty() ? StringBase::Printf("%s_%s_OUT", b.c_str(), i1.c_str())
                                                          : StringBase::Printf("%s_OUT", b.c_str());
        }
        return Rec::IsMuxType(type_) && !i1.IsEmpty() ? StringBase::Printf("%s%s_%s_OUT", p, s.c_str(), i1.c_str())
                                                      : StringBase::Printf("%s%s_OUT", p, s.c_str());
    default:
        return StringBase();
    }
}

StringBase Tsy_BufferEdit::GetSignalName(Slot slot) const
{
    if (slot < 0 || slot >= SlotCount)
        return StringBase();
    return given_[slot] ? names_[slot] : GetDefaultName(slot);
}

void Tsy_BufferEdit::SetSignalName(Slot slot, const StringBase& name)
{
    if (slot < 0 || slot >= SlotCount)
        return;
    StringBase s = name;
    s.Trim();
    // A name equal to the default stays a default: it follows I0 and I1.
    given_[slot] = !s.IsEmpty() && s != GetDefaultName(slot);
    names_[slot] = given_[slot] ? s : StringBase();
}

// Names recorded earlier count as chosen unless they are what the defaults
// would give anyway; those keep following I0, I1 and the type.
void Tsy_BufferEdit::loadRecordedNames()
{
    const Tsy_Pin* pin = I0Pin();
    if (!pin)
        return;
    int n = bufNum_ < 1 ? 1 : bufNum_;
    for (const PortDef& port : PortsOf(type_))
        SetSignalName(port.slot, pin->GetAttributeValue(sigRecord(n, port.name)));
    if (type_.EqualsNoCase("BUFGCTRL"))
        for (int k = 0; k < 2; ++k) {
            StringBase choice = pin->GetAttributeValue(pinRecord(n, k ? "IGNORE1" : "IGNORE0"));
            if (choice.EqualsNoCase("GND") || choice.EqualsNoCase("VCC"))
                ignore_[k] = choice.Upper();
        }
}

StringBase Tsy_BufferEdit::GroupTitle() const
{
    StringBase what;
    StringBase pin = i0Pin();
    if (IsPllDesign())
        what.Format("PLL pin %s", pin.c_str());
    else if (IsParallelPmcd())
        what.Format(pmcdInst_ == 2 ? "PMCD pin U2 %s" : "PMCD pin U1 %s", pin.c_str());
    else if (IsPmcdDesign())
        what.Format("PMCD pin %s", pin.c_str());
    else
        what.Format("DCM pin %s", pin.c_str());
    return StringBase("Select buffer for ") + what;
}

bool Tsy_BufferEdit::CanDelete() const
{
    if (i0Pin().EqualsNoCase("CLKIN"))
        return true;
    // A buffer not yet written holds no number of its own.
    return Rec::HasOtherBuffer(I0Pin(), isNew_ ? 0 : (bufNum_ < 1 ? 1 : bufNum_));
}

bool Tsy_BufferEdit::Delete()
{
    // A buffer being added was never written: Delete just drops it.
    if (isNew_) {
        type_ = StringBase();
        deleted_ = true;
        return true;
    }
    if (CanDelete()) {
        type_ = StringBase();
        deleted_ = true;
        if (Ok())
            return true;
        deleted_ = false;
        type_ = origType_;
        return false;
    }
    if (!batch_ && page_) {
        StringBase pin;
        const char* dialog = "General Setup";
        if (IsParallelPmcd()) {
            int inst = pmcdInst_;
            StringBase name = PinNameOf(i0_, pmcdInst_, &inst);
            pin.Format("%s %s", inst == 2 ? "U2" : "U1", name.c_str());
            dialog = "PMCD";
        } else if (IsPmcdDesign()) {
            pin = i0Pin();
            dialog = "PMCD";
        } else {
            pin = i0Pin();
        }
        StringBase text;
        text.Format("To remove all buffers from pin %s, please return to the %s dialog and deselect this pin.",
                    pin.c_str(), dialog);
        page_->IssueMessage(text, false, false, false);
    }
    type_ = origType_;
    return false;
}

bool Tsy_BufferEdit::checkGivenNames()
{
    for (const PortDef& port : PortsOf(type_)) {
        if (!given_[port.slot])
            continue;
        if ((port.slot == SlotIgnore0 && !ignore_[0].EqualsNoCase(kIgnoreSignal)) ||
            (port.slot == SlotIgnore1 && !ignore_[1].EqualsNoCase(kIgnoreSignal)))
            continue;
        std::string problem = Tsy_HdlNameProblem(names_[port.slot].str());
        if (problem.empty())
            continue;
        if (page_) {
            StringBase text;
            text.Format("The signal name '%s' of pin %s cannot be used: it %s.  Please enter a name that is legal in "
                        "both Verilog and VHDL.",
                        names_[port.slot].c_str(), port.name, problem.c_str());
            page_->IssueMessage(text, true, false, false);
        }
        return false;
    }
    return true;
}

bool Tsy_BufferEdit::Ok()
{
    if (deleted_) {
        if (StoreToPin())
            return true;
        deleted_ = false;
        type_ = origType_;
    }
    if (isNew_ && isNone(i0_)) {
        if (!batch_ && page_)
            page_->IssueMessage("Please make a selection for the I0 pin.", false, false, false);
        return false;
    }
    if (Rec::IsMuxType(type_)) {
        if (isNone(i1_)) {
            if (!batch_ && page_)
                page_->IssueMessage("Please make a selection for the I1 pin.", false, false, false);
            return false;
        }
    } else {
        i1_ = StringBase();
    }
    if (!checkGivenNames())
        return false;
    return StoreToPin();
}

bool Tsy_BufferEdit::StoreToPin()
{
    Tsy_Pin* pin = I0Pin();
    if (!pin)
        return false;
    if (isNew_) {
        // A buffer added to an output goes after the buffers it already
        // carries; stale records under that number (a list cut short by
        // hand) do not belong to it.
        if (bufNum_ < 1 || !Rec::TypeOf(pin, bufNum_).IsEmpty())
            bufNum_ = Rec::NextFreeBuffer(pin);
        if (!deleted_)
            Rec::ClearBuffer(pin, bufNum_);
    }
    if (bufNum_ < 1)
        bufNum_ = 1;
    const int n = bufNum_;
    if (deleted_) {
        // A new buffer was never written; an existing one goes, and the
        // buffers after it move down so that the list keeps no gap.
        if (!isNew_)
            Rec::RemoveBuffer(pin, n);
        return true;
    }
    // A silent store (a row never opened) cannot have changed its type.
    if (!silent_ && !type_.EqualsNoCase(origType_))
        for (const PortDef& port : PortsOf(origType_)) {
            pin->RemoveAttribute(sigRecord(n, port.name));
            pin->RemoveAttribute(pinRecord(n, port.name));
        }
    pin->AddAttribute(StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n), type_);
    pin->AddAttribute(StringBase::Printf("TSY_CLKBUF%d_BLKNAME", n),
                      StringBase::Printf("%s%s_%s_INST", prefix_.c_str(), i0Pin().c_str(), type_.c_str()));
    for (const PortDef& port : PortsOf(type_)) {
        const int k = port.slot == SlotIgnore1 ? 1 : 0;
        const bool ignorePort = port.slot == SlotIgnore0 || port.slot == SlotIgnore1;
        if (ignorePort) {
            pin->AddAttribute(pinRecord(n, port.name), ignore_[k]);
            if (!ignore_[k].EqualsNoCase(kIgnoreSignal)) {
                pin->RemoveAttribute(sigRecord(n, port.name));
                continue;
            }
        }
        // The input's net is named after its source, never typed.
        if (port.slot == SlotIn) {
            StringBase computed = GetDefaultName(SlotIn);
            const char* record = Rec::IsMuxType(type_) ? "TSY_CLKBUF%d_I0_SIGNAME" : "TSY_CLKBUF%d_I_SIGNAME";
            pin->AddAttribute(StringBase::Printf(record, n), computed);
            continue;
        }
        StringBase name = GetSignalName(port.slot);
        if (name.IsEmpty())
            pin->RemoveAttribute(sigRecord(n, port.name));
        else
            pin->AddAttribute(sigRecord(n, port.name), name);
        // The I1 source keeps its earlier record when none is chosen now.
        if (port.slot == SlotI1 && !isNone(i1_))
            pin->AddAttribute(pinRecord(n, port.name), i1_);
    }
    return true;
}
