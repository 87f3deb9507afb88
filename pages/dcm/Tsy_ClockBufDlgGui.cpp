#include "pages/dcm/Tsy_ClockBufDlgGui.h"

#include "Tsy_ClockBufDlgUI.h"
#include "db/Tsy_WizData.h"
#include "gui/Gq_Wizard.h"
#include "pages/dcm/Tsy_BufferRecords.h"
#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_EditBufDlgGui.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QLabel>
#include <QPushButton>
#include <QRadioButton>

#include <cstdlib>
#include <iomanip>
#include <iostream>
#include <ostream>

namespace Rec = Tsy_BufferRecords;

namespace {

const char* const kDcmOutputs[] = {"CLK0",  "CLK90",    "CLK180", "CLK270",  "CLKDV",
                                   "CLK2X", "CLK2X180", "CLKFX",  "CLKFX180"};
const char* const kPmcdOutputs[] = {"CLKA1", "CLKA1D2", "CLKA1D4", "CLKA1D8", "CLKB1", "CLKC1", "CLKD1"};
// Parallel PMCDs: the rows name the instance with the output.
const char* const kParallelShown[2][7] = {
    {"U1 CLKA1", "U1 CLKA1D2", "U1 CLKA1D4", "U1 CLKA1D8", "U1 CLKB1", "U1 CLKC1", "U1 CLKD1"},
    {"U2 CLKA1", "U2 CLKA1D2", "U2 CLKA1D4", "U2 CLKA1D8", "U2 CLKB1", "U2 CLKC1", "U2 CLKD1"},
};

QString q(const StringBase& s)
{
    return QString::fromStdString(s.str());
}

StringBase typeRecord(int n)
{
    return StringBase::Printf(Tsy_Attr::TSY_CLKBUFTYPE_N, n);
}

bool isClkin(const StringBase& pin)
{
    return pin.EqualsNoCase("CLKIN");
}

bool isBufferBlockType(const StringBase& type)
{
    return Rec::IsGlobalType(type);
}

// The row of a clock multiplexer names the output on its I1.
StringBase muxSecondInput(const Tsy_Pin* pin, int n, const StringBase& type)
{
    if (!Rec::IsMuxType(type))
        return StringBase();
    StringBase i1 = pin->GetAttributeValue(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_I1_PINNAME, n));
    if (i1.IsEmpty())
        i1 = pin->GetAttributeValue(Tsy_Attr::TSY_CLKMUX_I1);
    return i1;
}

} // namespace

Tsy_ClockBufDlgGui::Tsy_ClockBufDlgGui(Tsy_ClockBufDlg* page, QWidget* parent, int instNum)
    : Gq_WizardPage(nullptr), parent_(parent), page_(page), data_(page ? page->GetWizData() : nullptr),
      wiz_(page ? page->GetDCMWiz() : nullptr), wizType_(wiz_ ? wiz_->GetWizTypeInt() : 0),
      instNum_(instNum == 2 ? 2 : 1), batch_(page && page->IsBatch()), editor_(page)
{
    if (!batch_ && page_) {
        form_ = new Tsy_ClockBufDlgUI(parent);
        setPageWidget(form_);
        editDlg_ = new Tsy_EditBufDlgGui(editor_, this, form_);
    }
    readPmcdMode();
    // A PLL whose DCM-side outputs are in use only offers customized rows.
    if (wizType_ != Tsy_DCMwiz::TypePllToDcm) {
        Tsy_Block* pll = isPllDesign() ? pllBlock() : (data_ ? data_->GetActiveBlock("PLL_ADV") : nullptr);
        if (pll && pll->GetAttributeValue(Tsy_Attr::TESY_ONLY_ENABLE_CLKOUTDCM).EqualsNoCase("TRUE")) {
            clkoutDcm_ = true;
            mode_ = ModeCustomize;
        }
    }
    setPageName(isSingleBlockType() ? "Clock Buffers"
                : instNum_ == 2     ? "Clock Buffers for INST2"
                                    : "Clock Buffers for INST1");
}

Tsy_ClockBufDlgGui::~Tsy_ClockBufDlgGui()
{
    delete editDlg_.data();
}

Tsy_EditBufDlgGui* Tsy_ClockBufDlgGui::EditDialog() const
{
    return editDlg_.data();
}

const Tsy_ClockBufDlgGui::Row& Tsy_ClockBufDlgGui::GetRow(int r) const
{
    return rows_[r >= 1 && r <= kRows ? r : 0];
}

void Tsy_ClockBufDlgGui::SetUp()
{
    SetNamePrefix();
    if (form_ && !batch_) {
        syncRadios();
        connectForm();
    }
}

void Tsy_ClockBufDlgGui::SetNamePrefix()
{
    switch (wizType_) {
    case Tsy_DCMwiz::TypeBoardDeskew:
    case Tsy_DCMwiz::TypeClockSwitching:
    case Tsy_DCMwiz::TypeCascading:
        prefix_ = instNum_ == 2 ? "U2_" : "U1_";
        break;
    default:
        prefix_ = StringBase();
        break;
    }
}

// ---------------------------------------------------------------- blocks

// One DCM or one PLL: the page's names carry no instance.
bool Tsy_ClockBufDlgGui::isSingleBlockType() const
{
    return wizType_ == Tsy_DCMwiz::TypeDcm || wizType_ == Tsy_DCMwiz::TypeClockForwarding ||
           wizType_ >= Tsy_DCMwiz::TypePll;
}

bool Tsy_ClockBufDlgGui::isPllDesign() const
{
    return wizType_ == Tsy_DCMwiz::TypePll || wizType_ == Tsy_DCMwiz::TypeDcmToPll;
}

bool Tsy_ClockBufDlgGui::isPmcdDesign() const
{
    return !isPllDesign() && (pmcdMode_ == "SINGLE" || pmcdMode_ == "PARALLEL");
}

Tsy_Block* Tsy_ClockBufDlgGui::dcmBlock()
{
    if (!page_ || isPllDesign())
        return nullptr;
    return page_->GetActiveDCMBlk(instNum_, messagesEnabled_);
}

Tsy_Block* Tsy_ClockBufDlgGui::pllBlock()
{
    return page_ ? page_->GetActivePLLBlk(false) : nullptr;
}

Tsy_Block* Tsy_ClockBufDlgGui::blockOf(const Output& output)
{
    if (!page_)
        return nullptr;
    if (isPllDesign())
        return pllBlock();
    if (pmcdMode_ == "SINGLE")
        return page_->GetActivePMCDBlk(0);
    if (pmcdMode_ == "PARALLEL")
        return page_->GetActivePMCDBlk(output.pmcdInst);
    return dcmBlock();
}

Tsy_Pin* Tsy_ClockBufDlgGui::pinOf(const Output& output)
{
    Tsy_Block* block = blockOf(output);
    return block ? block->GetNamedPin(output.pin) : nullptr;
}

void Tsy_ClockBufDlgGui::readPmcdMode()
{
    pmcdMode_ = "NONE";
    if (wizType_ == Tsy_DCMwiz::TypePll || wizType_ == Tsy_DCMwiz::TypeDcmToPll || wizType_ == Tsy_DCMwiz::TypePllToDcm)
        return;
    Tsy_Block* dcm = dcmBlock();
    StringBase v = dcm ? dcm->GetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD) : StringBase();
    if (v.EqualsNoCase("SINGLE"))
        pmcdMode_ = "SINGLE";
    else if (v.EqualsNoCase("PARALLEL"))
        pmcdMode_ = "PARALLEL";
}

void Tsy_ClockBufDlgGui::buildOutputList()
{
    outputs_.clear();
    auto addIfActive = [this](Tsy_Block* block, const char* pin, const char* shown, int inst) {
        const Tsy_Pin* p = block ? block->GetNamedPin(pin) : nullptr;
        if (p && p->IsActive())
            outputs_.push_back({shown, pin, inst});
    };
    if (isPllDesign()) {
        Tsy_Block* pll = pllBlock();
        if (!pll)
            return;
        bool dcmSide = pll->GetAttributeValue(Tsy_Attr::TESY_ONLY_ENABLE_CLKOUTDCM).EqualsNoCase("TRUE");
        if (dcmSide) {
            clkoutDcm_ = true;
            mode_ = ModeCustomize;
        }
        for (int n = 0; n <= 5; ++n) {
            StringBase name = StringBase::Printf(dcmSide ? "CLKOUTDCM%d" : "CLKOUT%d", n);
            addIfActive(pll, name.c_str(), name.c_str(), 1);
        }
        return;
    }
    if (pmcdMode_ == "SINGLE") {
        Tsy_Block* pmcd = page_ ? page_->GetActivePMCDBlk(0) : nullptr;
        for (const char* pin : kPmcdOutputs)
            addIfActive(pmcd, pin, pin, 1);
        return;
    }
    if (pmcdMode_ == "PARALLEL") {
        for (int inst = 1; inst <= 2; ++inst) {
            Tsy_Block* pmcd = page_ ? page_->GetActivePMCDBlk(inst) : nullptr;
            for (int i = 0; i < 7; ++i)
                addIfActive(pmcd, kPmcdOutputs[i], kParallelShown[inst - 1][i], inst);
        }
        return;
    }
    Tsy_Block* dcm = dcmBlock();
    if (!dcm)
        return;
    for (const char* pin : kDcmOutputs)
        addIfActive(dcm, pin, pin, 1);
    if (dcm->GetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE).EqualsNoCase("EXTERNAL"))
        outputs_.push_back({"CLKIN", "CLKIN", 1});
}

// ---------------------------------------------------------------- entry

void Tsy_ClockBufDlgGui::onActive()
{
    if (Gq_Wizard* w = wizard()) {
        w->showMoreInfo(true);
        w->enableMoreInfo(true);
        w->showAdvanced(false);
        w->enableAdvanced(false);
    }
    if (!batch_ && form_) {
        // The caption names the instance wherever the page name does.
        QString caption = isSingleBlockType() ? "Corvane Pendra - Clock Buffers"
                          : instNum_ == 2     ? "Corvane Pendra - Clock Buffers for INST2"
                                              : "Corvane Pendra - Clock Buffers for INST1";
        form_->setWindowTitle(caption);
        if (Gq_Wizard* w = wizard())
            w->setCaption(caption);
    }
    readModeFromRadios();
    messagesEnabled_ = true;
    LoadFromBlock();
    RefreshRows(true);
    updateAddButton();
}

void Tsy_ClockBufDlgGui::LoadFromBlock()
{
    if (isPllDesign()) {
        Tsy_Block* pll = pllBlock();
        clkoutDcm_ = pll && pll->GetAttributeValue(Tsy_Attr::TESY_ONLY_ENABLE_CLKOUTDCM).EqualsNoCase("TRUE");
        if (clkoutDcm_) {
            mode_ = ModeCustomize;
            if (form_ && !batch_) {
                form_->RadioUseBufgs->setEnabled(false);
                form_->RadioUseGrid->setEnabled(true);
            }
        }
    }
    Tsy_Block* source = isPllDesign() ? pllBlock() : dcmBlock();
    auto modeOf = [](const Tsy_Block* b) {
        return b && b->GetAttributeValue(Tsy_Attr::USE_BUFG).EqualsNoCase("USE_BUFGS") ? ModeGlobal : ModeCustomize;
    };
    mode_ = modeOf(source);
    updateAddButton();
    if (source) {
        if (!isPllDesign())
            LoadFeedbackSettings(source);
        mode_ = modeOf(source);
        if (clkoutDcm_)
            mode_ = ModeCustomize;
        syncRadios();
    }
}

void Tsy_ClockBufDlgGui::LoadFeedbackSettings(Tsy_Block* block)
{
    if (!block)
        return;
    fbSource_ = block->GetAttributeValue(Tsy_Attr::FB_SOURCE);
    clkFeedback_ = block->GetAttributeValue(Tsy_Attr::CLK_FEEDBACK);
    if (clkFeedback_.EqualsNoCase("1X"))
        fbOutput_ = "CLK0";
    else if (clkFeedback_.EqualsNoCase("2X") || fbSource_.EqualsNoCase("INTERNAL"))
        fbOutput_ = "CLK2X";
    else
        fbOutput_ = StringBase();

    bool bufgsEnabled = true;
    bool gridEnabled = true;
    if (fbSource_.EqualsNoCase("EXTERNAL")) {
        // Board deskew and clock forwarding without a DDR flip-flop send the
        // clock off the chip themselves: their buffers are set row by row.
        if ((wizType_ == Tsy_DCMwiz::TypeBoardDeskew || wizType_ == Tsy_DCMwiz::TypeClockForwarding) &&
            block->GetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_FLIPFLOP).EqualsNoCase("None")) {
            mode_ = ModeCustomize;
            block->SetAttributeValue(Tsy_Attr::USE_BUFG, "USE_GRID");
            bufgsEnabled = false;
        }
    } else if (fbSource_.EqualsNoCase("INTERNAL") || fbSource_.EqualsNoCase("NONE")) {
        if (wizType_ == Tsy_DCMwiz::TypeClockSwitching) {
            mode_ = ModeCustomize;
            bufgsEnabled = gridEnabled = false;
        }
    }
    if (form_ && !batch_ && !clkoutDcm_) {
        form_->RadioUseBufgs->setEnabled(bufgsEnabled);
        form_->RadioUseGrid->setEnabled(gridEnabled);
    }
}

bool Tsy_ClockBufDlgGui::internalFeedback() const
{
    return fbSource_.EqualsNoCase("INTERNAL");
}

void Tsy_ClockBufDlgGui::RefreshRows(bool reload)
{
    readPmcdMode();
    buildOutputList();
    if (!isPllDesign())
        if (Tsy_Block* dcm = dcmBlock())
            LoadFeedbackSettings(dcm);
    syncRadios();
    ConvertLegacyBuffers(reload);
    AssignDefaultBuffers();
}

// ---------------------------------------------------------------- rows

void Tsy_ClockBufDlgGui::SetRow(int r, const StringBase& type, int n, const StringBase& i0, const StringBase& i1,
                                int state)
{
    if (r < 1 || r > kRows)
        return;
    Row& row = rows_[r];
    row.type = type;
    row.bufIndex = n;
    row.i0 = i0;
    row.i1 = i1;
    row.state = state;
    drawRow(r);
}

StringBase Tsy_ClockBufDlgGui::NormalizeBufferType(Tsy_Pin* pin, int n, const StringBase& output, int& state)
{
    StringBase type = Rec::TypeOf(pin, n);
    if (pin && type.EqualsNoCase("BUFGMUX_TALDOR4") && wiz_ && wiz_->IsBufgmuxCtrlFamily()) {
        type = "BUFGMUX_CTRL";
        pin->AddAttribute(typeRecord(n), type);
    } else if (pin && type.EqualsNoCase("LOWSKEWLINE")) {
        type = "LOCALROUTING";
        pin->AddAttribute(typeRecord(n), type);
        if (page_)
            page_->IssueMessage(StringBase::Printf("The output '%s' was previously configured to use Lowskewlines, but "
                                                   "this option is no longer allowed.  The Lowskewlines selection has "
                                                   "been changed to Local Routing.",
                                                   output.c_str()),
                                false, false, false);
    }
    state = Rec::ReadRowState(n, pin);
    return type;
}

void Tsy_ClockBufDlgGui::reportOverflow(const StringBase& output)
{
    if (output.IsEmpty() || !page_)
        return;
    page_->IssueMessage(StringBase::Printf("The maximum of %d supported buffers has been reached.  %s will not be "
                                           "processed.",
                                           kRows, output.c_str()),
                        false, false, false);
}

void Tsy_ClockBufDlgGui::AssignDefaultBuffers()
{
    // Unfilled rows show the state of the output at their position.
    for (int r = 1; r <= kRows; ++r) {
        size_t i = static_cast<size_t>(r - 1);
        const Tsy_Pin* pin = i < outputs_.size() ? pinOf(outputs_[i]) : nullptr;
        rows_[r].state = pin ? Rec::ReadRowState(1, pin) : Rec::StateEnabled;
        // "TSY_CLKBUFTYPE1_NOEDIT" decides; the helper reads exactly that.
    }
    defaultPass(!isPllDesign() && !isPmcdDesign());
    if (std::getenv("PENDRA_DUMP_CLOCK_BUFFERS"))
        DumpRows(std::cerr);
}

void Tsy_ClockBufDlgGui::defaultPass(bool dcmRules)
{
    if (dcmRules)
        if (Tsy_Block* dcm = dcmBlock())
            LoadFeedbackSettings(dcm);
    const bool internal = dcmRules && internalFeedback();
    lastUsedRow_ = 0;
    int r = mode_ == ModeGlobal ? globalBufferRows(internal) : recordedBufferRows(internal);
    // Rows past the last buffer would otherwise keep what they showed
    // before a buffer was deleted, and be counted by the checks on Next.
    for (; r <= kRows; ++r)
        SetRow(r, StringBase(), 0, StringBase(), StringBase(), Rec::StateDefault);
}

// PLL outputs carry no CLKIN entry; DCM and PMCD lists end with it.
bool Tsy_ClockBufDlgGui::takesNoDefaultRow(const Output& o) const
{
    return !isPllDesign() && isClkin(o.pin);
}

bool Tsy_ClockBufDlgGui::closesFeedbackLoop(const Output& o, bool internal) const
{
    return internal && o.pin.EqualsNoCase(fbOutput_);
}

int Tsy_ClockBufDlgGui::takeRow(int r, const StringBase& type, int n, const StringBase& i0, const StringBase& i1,
                                int state, const Output& o)
{
    SetRow(r, type, n, i0, i1, state);
    rows_[r].pmcdInst = o.pmcdInst;
    lastUsedRow_ = r;
    return r + 1;
}

int Tsy_ClockBufDlgGui::globalBufferRows(bool internal)
{
    int r = 1;
    for (const Output& o : outputs_) {
        if (takesNoDefaultRow(o))
            continue;
        if (r > kRows) {
            reportOverflow(o.shown);
            continue;
        }
        Tsy_Pin* pin = pinOf(o);
        int state = Rec::ReadRowState(1, pin);
        r = takeRow(r, "BUFG", 1, o.shown, StringBase(), state, o);
        // The feedback buffer is the feedback path's own; buffers another
        // page fixed keep their type.
        if (pin && !closesFeedbackLoop(o, internal) && (state == Rec::StateEnabled || Rec::TypeOf(pin, 1).IsEmpty()))
            pin->AddAttribute(typeRecord(1), "BUFG");
    }
    return r;
}

int Tsy_ClockBufDlgGui::recordedBufferRows(bool internal)
{
    int r = 1;
    for (const Output& o : outputs_)
        if (Tsy_Pin* pin = pinOf(o))
            r = recordedRowsOf(o, pin, internal, r);
    return r;
}

int Tsy_ClockBufDlgGui::recordedRowsOf(const Output& o, Tsy_Pin* pin, bool internal, int r)
{
    // A pin holds far fewer buffers than this; the bound only guards
    // against a malformed design.
    for (int n = 1; n <= 999; ++n) {
        int state = Rec::StateEnabled;
        StringBase type = NormalizeBufferType(pin, n, o.shown, state);
        if (type.IsEmpty())
            return n == 1 && !takesNoDefaultRow(o) ? defaultRowOf(o, pin, internal, r) : r;
        if (r > kRows) {
            reportOverflow(o.shown);
            return r;
        }
        StringBase i1 = muxSecondInput(pin, n, type);
        StringBase i0 = shownFirstInput(o, pin, type, state);
        r = takeRow(r, type, n, i0, i1, state, o);
    }
    return r;
}

// An output without buffer records gets a Global Buffer, unless it closes
// the feedback loop, whose buffer is the feedback path's own.
int Tsy_ClockBufDlgGui::defaultRowOf(const Output& o, Tsy_Pin* pin, bool internal, int r)
{
    if (r > kRows) {
        reportOverflow(o.shown);
        return r;
    }
    const bool feedback = closesFeedbackLoop(o, internal);
    r = takeRow(r, "BUFG", 1, o.shown, StringBase(), feedback ? Rec::StateFeedback : Rec::StateEnabled, o);
    if (!feedback) {
        pin->AddAttribute(typeRecord(1), "BUFG");
        pin->AddAttribute("TSY_CLKBUFTYPE1_NOEDIT", Tsy_BufState::ENABLED);
    }
    return r;
}

// The output a row shows on I0: its own, except on a multiplexer of the
// second DCM of clock switching that another page set, which shows the I0
// recorded on the pin.
StringBase Tsy_ClockBufDlgGui::shownFirstInput(const Output& o, const Tsy_Pin* pin, const StringBase& type,
                                               int state) const
{
    const bool sharedMux = wizType_ == Tsy_DCMwiz::TypeClockSwitching && instNum_ == 2 &&
                           (type.EqualsNoCase("BUFGMUX") || type.EqualsNoCase("BUFGCTRL")) &&
                           (state == Rec::StateDisabled || state == Rec::StateDefault);
    if (!sharedMux)
        return o.shown;
    StringBase other = pin->GetAttributeValue(Tsy_Attr::TSY_CLKMUX_I0);
    return other.IsEmpty() ? o.shown : other;
}

// ---------------------------------------------------------------- legacy designs

void Tsy_ClockBufDlgGui::ConvertLegacyBuffers(bool reload)
{
    if (!isLegacyConversionDue(reload))
        return;
    for (const Output& o : outputs_)
        convertLegacyOutput(o);
    if (pmcdMode_ == "PARALLEL")
        for (const Output& o : outputs_)
            if (const Tsy_Pin* pin = pinOf(o); pin && !pin->GetSigName().IsEmpty())
                if (Tsy_Signal* sig = data_->GetNamedSignal(pin->GetSigName()))
                    sig->RemoveAttribute(Tsy_Attr::ASSOC_WITH);
}

// Older versions kept the buffers in the netlist itself, not as records on
// the output pins.
bool Tsy_ClockBufDlgGui::isLegacyConversionDue(bool reload) const
{
    if (leftByBack_ || mode_ != ModeCustomize || !wiz_ || !wiz_->IsLoadedDesign() || !data_)
        return false;
    if (wizType_ == Tsy_DCMwiz::TypePll || wizType_ == Tsy_DCMwiz::TypeDcmToPll || wizType_ == Tsy_DCMwiz::TypePllToDcm)
        return false;
    const StringBase& version = wiz_->GetDesignVersion();
    StringBase v = version.Left(3);
    if (v == "6.3" && wizType_ == Tsy_DCMwiz::TypeBoardDeskew)
        return true;
    if (version.IsEmpty() || v == "6.1" || v == "6.2")
        return wizType_ == Tsy_DCMwiz::TypeClockSwitching ? v == "6.2" : reload;
    return false;
}

void Tsy_ClockBufDlgGui::convertLegacyOutput(const Output& o)
{
    Tsy_Pin* pin = pinOf(o);
    if (!pin || Rec::HasAnyBufferRecord(pin))
        return;
    const StringBase net = pin->GetSigName();
    if (net.IsEmpty()) {
        if (!isClkin(o.pin))
            pin->AddAttribute(typeRecord(Rec::NextFreeBuffer(pin)), "BUFG");
        return;
    }
    Tsy_Signal* sig = data_->GetNamedSignal(net);
    if (sig && sig->GetNamedAttribute(Tsy_Attr::USELOWSKEWLINES))
        recordRouting(pin, sig, net, "LOWSKEWLINE");
    if (sig && sig->GetNamedAttribute(Tsy_Attr::USELOCALROUTING))
        recordRouting(pin, sig, net, "LOCALROUTING");
    Tsy_Block* source = blockOf(o);
    // General Setup may already have stepped every block back; the older
    // netlist is read whether its blocks are active or not.
    for (const auto& b : data_->Blocks())
        if (b.get() != source && isLegacyBufferOn(*b, net))
            recordLegacyBuffer(o, pin, *b);
}

void Tsy_ClockBufDlgGui::recordRouting(Tsy_Pin* pin, const Tsy_Signal* sig, const StringBase& net, const char* type)
{
    int n = Rec::NextFreeBuffer(pin);
    pin->AddAttribute(typeRecord(n), type);
    // A routed output that was a port keeps its port name.
    if (sig->IsExternal())
        pin->AddAttribute(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_O_SIGNAME, n), net);
}

// A buffer block of the older netlist that the net feeds. A mux belongs to
// the output on its I0; the one on I1 is named there.
bool Tsy_ClockBufDlgGui::isLegacyBufferOn(const Tsy_Block& b, const StringBase& net) const
{
    if (b.IsTemplate() || b.IsGenerated() || !isBufferBlockType(b.GetType()))
        return false;
    const Tsy_Pin* in = b.GetNamedPin(Rec::IsMuxType(b.GetType()) ? "I0" : "I");
    return in && in->GetSigName() == net;
}

void Tsy_ClockBufDlgGui::recordLegacyBuffer(const Output& o, Tsy_Pin* pin, Tsy_Block& b)
{
    int n = Rec::NextFreeBuffer(pin);
    pin->AddAttribute(typeRecord(n), b.GetType());
    // The nets the user named on the buffer's output, select and enable
    // pins stay those names.
    for (const auto& bp : b.Pins()) {
        const StringBase& name = bp->GetName();
        if (bp->GetSigName().IsEmpty() || name == "I" || name == "I0" || name == "I1")
            continue;
        pin->AddAttribute(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_PORT_SIGNAME, n, name.c_str()), bp->GetSigName());
    }
    const bool recordI1 = !(wizType_ == Tsy_DCMwiz::TypeClockSwitching && instNum_ == 2);
    if (Rec::IsMuxType(b.GetType()) && recordI1)
        recordLegacyMuxI1(o, pin, n, b);
    // Its place in the netlist is now recorded on the pin; Finish
    // builds it anew from there.
    b.active = false;
}

void Tsy_ClockBufDlgGui::recordLegacyMuxI1(const Output& o, Tsy_Pin* pin, int n, const Tsy_Block& mux)
{
    const Tsy_Pin* i1 = mux.GetNamedPin("I1");
    if (!i1 || i1->GetSigName().IsEmpty())
        return;
    for (const Output& other : outputs_) {
        const Tsy_Pin* op = pinOf(other);
        if (op && &other != &o && op->GetSigName() == i1->GetSigName()) {
            pin->AddAttribute(StringBase::Printf(Tsy_Attr::TSY_CLKBUF_N_I1_PINNAME, n), other.shown);
            return;
        }
    }
}

// ---------------------------------------------------------------- store and checks

void Tsy_ClockBufDlgGui::dropExtraBuffers(Tsy_Pin* pin)
{
    if (!pin)
        return;
    // From the top down, so that the numbers still to visit do not move.
    for (int n = Rec::NextFreeBuffer(pin) - 1; n >= 2; --n) {
        if (Rec::ReadRowState(n, pin) != Rec::StateEnabled)
            continue;
        if (batch_ && page_)
            page_->IssueMessage(StringBase::Printf("Every output uses one Global Buffer (USE_BUFG is USE_BUFGS), so "
                                                   "buffer %d (%s) of %s was removed.",
                                                   n, Rec::TypeOf(pin, n).c_str(), pin->GetName().c_str()),
                                false, false, false);
        Rec::RemoveBuffer(pin, n);
    }
}

bool Tsy_ClockBufDlgGui::StoreToBlock(bool validate)
{
    Tsy_Block* block = isPllDesign() ? (page_ ? pllBlock() : nullptr) : dcmBlock();
    if (!block)
        return false;
    block->SetAttributeValue(Tsy_Attr::USE_BUFG, mode_ == ModeGlobal ? "USE_BUFGS" : "USE_GRID");
    // One Global Buffer per output is what the page shows in this mode, so
    // the buffers added in customize mode do not reach the netlist.
    if (mode_ == ModeGlobal)
        for (const Output& o : outputs_)
            if (!isClkin(o.pin) || isPllDesign())
                dropExtraBuffers(pinOf(o));
    if (validate && !isPmcdDesign())
        return CheckFeedbackBuffer() && CheckGlobalBufferCount();
    return true;
}

bool Tsy_ClockBufDlgGui::CheckFeedbackBuffer()
{
    if (fbOutput_.IsEmpty())
        return true;
    const char* fb = fbOutput_.c_str();
    if (internalFeedback()) {
        for (int r = 1; r <= kRows; ++r)
            if (rows_[r].i0.EqualsNoCase(fbOutput_) && rows_[r].type.EqualsNoCase("BUFG"))
                return true;
        if (messagesEnabled_ && page_)
            page_->IssueMessage(StringBase::Printf("The 'Feedback Source' is Internal %s, which requires that %s be "
                                                   "connected to a BUFG.  Please use BUFG for %s.",
                                                   fb, fb, fb),
                                true, false, false);
        return false;
    }
    // Only an external feedback path leaves the chip through this output.
    if (!fbSource_.EqualsNoCase("EXTERNAL"))
        return true;
    for (int r = 1; r <= kRows; ++r) {
        const StringBase& t = rows_[r].type;
        if (!rows_[r].i0.EqualsNoCase(fbOutput_))
            continue;
        if (t.EqualsNoCase("BUFGMUX") || t.EqualsNoCase("BUFGCE") || t.EqualsNoCase("BUFGMUX_TALDOR4") ||
            t.EqualsNoCase("BUFGMUX_CTRL") || t.EqualsNoCase("BUFGCTRL")) {
            if (messagesEnabled_ && page_)
                page_->IssueMessage(StringBase::Printf("The 'Feedback Source' is External %s.  %s is connected to a "
                                                       "%s, which is not allowed.  Please change the selection for %s "
                                                       "to use something other than Clock Mux or Enabled Buffer.",
                                                       fb, fb, t.c_str(), fb),
                                    true, false, false);
            return false;
        }
    }
    return true;
}

bool Tsy_ClockBufDlgGui::CheckGlobalBufferCount()
{
    if (wiz_ && wiz_->IsBufgctrlFamily())
        return true;
    int count = 0;
    for (int r = 1; r <= kRows; ++r)
        if (Rec::IsGlobalType(rows_[r].type))
            ++count;
    if (count <= 4 || !page_)
        return true;
    if (batch_) {
        page_->IssueMessage(
            "More than four DCM outputs are driving global buffers.  Only a maximum of four DCM outputs "
            "can use dedicated routing to global buffers on the same half of the FPGA.  The remaining "
            "outputs will use local routing to the global buffer.",
            false, false, false);
        return true;
    }
    return page_->IssueYesNoQuestion("More than four DCM outputs are driving global buffers.  Only a maximum of four "
                                     "DCM outputs can use dedicated routing to global buffers on the same half of the "
                                     "FPGA.  The remaining outputs will use local routing to the global buffer.  Do "
                                     "you want to continue?",
                                     "") != 0;
}

bool Tsy_ClockBufDlgGui::onNext()
{
    readModeFromRadios();
    return StoreToBlock(true);
}

bool Tsy_ClockBufDlgGui::onBack()
{
    messagesEnabled_ = false;
    readModeFromRadios();
    StoreToBlock(false);
    leftByBack_ = true;
    return true;
}

void Tsy_ClockBufDlgGui::onMoreInfo()
{
    if (page_)
        page_->InvokeMoreInfo(isPllDesign() ? "tsy_dcmpllclkbuf" : "tsy_dcmclkbuf");
}

// ---------------------------------------------------------------- editing

void Tsy_ClockBufDlgGui::OnRadioUseBufgs()
{
    if (guard_)
        return;
    mode_ = ModeGlobal;
    RefreshRows(false);
    updateAddButton();
    syncRadios();
}

void Tsy_ClockBufDlgGui::OnRadioUseGrid()
{
    if (guard_)
        return;
    // Coming from global-buffer mode the editable rows start over from a
    // default Global Buffer; the rows other pages fixed keep their records.
    if (mode_ != ModeCustomize)
        for (int r = 1; r <= kRows; ++r) {
            const Row& row = rows_[r];
            if (row.state != Rec::StateEnabled || row.i0.IsEmpty())
                continue;
            for (const Output& o : outputs_)
                if (o.shown == row.i0) {
                    if (Tsy_Pin* pin = pinOf(o))
                        pin->RemoveAttribute(typeRecord(row.bufIndex < 1 ? 1 : row.bufIndex));
                    break;
                }
        }
    mode_ = ModeCustomize;
    RefreshRows(false);
    updateAddButton();
    syncRadios();
}

void Tsy_ClockBufDlgGui::OnButtonAddBuf()
{
    AddBuffer();
}

void Tsy_ClockBufDlgGui::AddBuffer()
{
    readModeFromRadios();
    // One Global Buffer per output leaves nothing to add.
    if (mode_ != ModeCustomize)
        return;
    if (lastUsedRow_ >= kRows) {
        if (page_)
            page_->IssueMessage("Maximum number of rows reached for this dialog. No additional rows can be displayed.",
                                false, false, false);
        return;
    }
    const int r = ++lastUsedRow_;
    std::vector<StringBase> shown;
    for (const Output& o : outputs_)
        shown.push_back(o.shown);
    editor_.Prepare(wizType_, instNum_, pmcdMode_, 1, prefix_, shown, StringBase(), StringBase(), "BUFG", 0, true);
    if (runEditor() != 1) {
        // Nothing was added: the next buffer takes this row again.
        --lastUsedRow_;
        return;
    }
    applyEdit(r, true);
}

void Tsy_ClockBufDlgGui::EditRow(int r)
{
    if (r < 1 || r > kRows)
        return;
    readModeFromRadios();
    const Row row = rows_[r];
    // Rows other pages fixed, and every row in global-buffer mode, are shown
    // but not edited.
    if (row.i0.IsEmpty() || row.state != Rec::StateEnabled || mode_ != ModeCustomize)
        return;
    std::vector<StringBase> shown;
    for (const Output& o : outputs_)
        shown.push_back(o.shown);
    editor_.Prepare(wizType_, instNum_, pmcdMode_, row.pmcdInst, prefix_, shown, row.i0, row.i1, row.type, row.bufIndex,
                    false);
    if (runEditor() != 1)
        return;
    applyEdit(r, false);
}

int Tsy_ClockBufDlgGui::runEditor()
{
    if (editRunner_)
        return editRunner_(editor_);
    if (editDlg_)
        return editDlg_->exec();
    return 0;
}

void Tsy_ClockBufDlgGui::applyEdit(int r, bool isNew)
{
    rows_[r].edited = true;
    const StringBase type = editor_.GetType();
    if (Tsy_Pin* pin = editor_.I0Pin()) {
        if (!isNew && !editor_.IsDeleted() && Rec::IsMuxType(type) && !editor_.GetI1().IsEmpty())
            pin->AddAttribute(Tsy_Attr::TSY_CLKMUX_I1, editor_.GetI1());
        // The output-wide I1 record only ever served a mux of this output.
        bool anyMux = false;
        for (int n = 1; n < Rec::NextFreeBuffer(pin); ++n)
            anyMux = anyMux || Rec::IsMuxType(Rec::TypeOf(pin, n));
        if (!anyMux)
            pin->RemoveAttribute(Tsy_Attr::TSY_CLKMUX_I1);
    }
    if (!isNew || !type.IsEmpty())
        SetRow(r, type, editor_.GetBufferNumber(), editor_.GetI0(), editor_.GetI1(), Rec::StateEnabled);
    else
        SetRow(r, StringBase(), 0, StringBase(), StringBase(), Rec::StateDefault);
    AssignDefaultBuffers();
    syncRadios();
    updateAddButton();
}

// ---------------------------------------------------------------- the form

void Tsy_ClockBufDlgGui::readModeFromRadios()
{
    if (form_ && !batch_)
        mode_ = form_->RadioUseGrid->isChecked() ? ModeCustomize : ModeGlobal;
}

void Tsy_ClockBufDlgGui::syncRadios()
{
    if (!form_ || batch_)
        return;
    guard_ = true;
    form_->RadioUseBufgs->setChecked(mode_ == ModeGlobal);
    form_->RadioUseGrid->setChecked(mode_ == ModeCustomize);
    guard_ = false;
    for (int r = 1; r <= kRows; ++r)
        drawRow(r);
}

void Tsy_ClockBufDlgGui::updateAddButton()
{
    if (!form_ || batch_)
        return;
    bool show =
        mode_ == ModeCustomize && rows_[kRows].i0.IsEmpty() && (!clkoutDcm_ || wizType_ == Tsy_DCMwiz::TypeDcmToPll);
    form_->PushButtonAddBuf->setVisible(show);
}

void Tsy_ClockBufDlgGui::drawRow(int r)
{
    if (!form_ || batch_ || r < 1 || r > kRows)
        return;
    const Row& row = rows_[r];
    QLabel* i0 = form_->RowI0(r);
    QLabel* i1 = form_->RowI1(r);
    QPushButton* button = form_->RowButton(r);
    const bool shown = !row.i0.IsEmpty();
    i0->setVisible(shown);
    i1->setVisible(shown);
    button->setVisible(shown);
    if (!shown)
        return;
    i0->setText(q(row.i0));
    i1->setText(q(row.i1));
    button->setText(q(Rec::ShownName(row.type)));
    if (row.state == Rec::StateEnabled) {
        bool enabled = mode_ == ModeCustomize;
        i0->setEnabled(enabled);
        i1->setEnabled(enabled);
        button->setEnabled(enabled);
        button->setToolTip(enabled ? QString("View or edit the buffer of %1").arg(q(row.i0))
                                   : QString("Choose \"Customize buffers\" to change this buffer"));
    } else {
        i0->setEnabled(false);
        i1->setEnabled(false);
        button->setEnabled(false);
        button->setVisible(!row.type.IsEmpty());
        button->setToolTip(row.state == Rec::StateFeedback ? QString("The feedback buffer of the DCM")
                                                           : QString("Set by another page of the wizard"));
    }
}

void Tsy_ClockBufDlgGui::connectForm()
{
    connect(form_->RadioUseBufgs, &QRadioButton::clicked, this, &Tsy_ClockBufDlgGui::OnRadioUseBufgs);
    connect(form_->RadioUseGrid, &QRadioButton::clicked, this, &Tsy_ClockBufDlgGui::OnRadioUseGrid);
    connect(form_->PushButtonAddBuf, &QPushButton::clicked, this, &Tsy_ClockBufDlgGui::OnButtonAddBuf);
    using Slot = void (Tsy_ClockBufDlgGui::*)();
    static const Slot editSlots[kRows] = {
        &Tsy_ClockBufDlgGui::OnButtonEdit1,  &Tsy_ClockBufDlgGui::OnButtonEdit2,  &Tsy_ClockBufDlgGui::OnButtonEdit3,
        &Tsy_ClockBufDlgGui::OnButtonEdit4,  &Tsy_ClockBufDlgGui::OnButtonEdit5,  &Tsy_ClockBufDlgGui::OnButtonEdit6,
        &Tsy_ClockBufDlgGui::OnButtonEdit7,  &Tsy_ClockBufDlgGui::OnButtonEdit8,  &Tsy_ClockBufDlgGui::OnButtonEdit9,
        &Tsy_ClockBufDlgGui::OnButtonEdit10, &Tsy_ClockBufDlgGui::OnButtonEdit11, &Tsy_ClockBufDlgGui::OnButtonEdit12,
        &Tsy_ClockBufDlgGui::OnButtonEdit13, &Tsy_ClockBufDlgGui::OnButtonEdit14, &Tsy_ClockBufDlgGui::OnButtonEdit15,
        &Tsy_ClockBufDlgGui::OnButtonEdit16};
    for (int r = 1; r <= kRows; ++r)
        connect(form_->RowButton(r), &QPushButton::clicked, this, editSlots[r - 1]);
}

void Tsy_ClockBufDlgGui::DumpRows(std::ostream& out) const
{
    out << "Clock Buffers rows (" << (mode_ == ModeGlobal ? "global buffers" : "customized") << ", last used row "
        << lastUsedRow_ << ")\n";
    for (int r = 1; r <= kRows; ++r) {
        const Row& row = rows_[r];
        if (row.i0.IsEmpty() && row.type.IsEmpty())
            continue;
        out << std::setw(3) << r << "  " << std::left << std::setw(12) << row.i0 << std::setw(12) << row.i1
            << std::setw(16) << row.type << std::right << " n=" << row.bufIndex << " state=" << row.state
            << (row.edited ? " edited" : "") << "\n";
    }
}
