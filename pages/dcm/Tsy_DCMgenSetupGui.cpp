#include "pages/dcm/Tsy_DCMgenSetupGui.h"

#include "Tsy_DCMgenSetupUI_Imp.h"
#include "db/Tsy_WizData.h"
#include "gui/Gq_Wizard.h"
#include "pages/dcm/Tsy_AdvancedDlgGui.h"
#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "port/UtStr.h"
#include "wizard/Tsy_DCMwiz.h"

#include <QSignalBlocker>

namespace {

using Page = Tsy_DCMgenSetup;

QString qs(const StringBase& s)
{
    return QString::fromStdString(s.str());
}

StringBase sb(const QString& s)
{
    return StringBase(s.toStdString());
}

struct OutputBox {
    int pin;
    QCheckBox* Tsy_DCMgenSetupUI::*box;
};

// The output boxes beside the symbol, in their order on the form.
const OutputBox kOutputs[] = {
    {Page::PinCLK0, &Tsy_DCMgenSetupUI::CheckBoxCLK0},         {Page::PinCLK90, &Tsy_DCMgenSetupUI::CheckBoxCLK90},
    {Page::PinCLK180, &Tsy_DCMgenSetupUI::CheckBoxCLK180},     {Page::PinCLK270, &Tsy_DCMgenSetupUI::CheckBoxCLK270},
    {Page::PinCLKDV, &Tsy_DCMgenSetupUI::CheckBoxCLKDV},       {Page::PinCLK2X, &Tsy_DCMgenSetupUI::CheckBoxCLK2X},
    {Page::PinCLK2X180, &Tsy_DCMgenSetupUI::CheckBoxCLK2X180}, {Page::PinCLKFX, &Tsy_DCMgenSetupUI::CheckBoxCLKFX},
    {Page::PinCLKFX180, &Tsy_DCMgenSetupUI::CheckBoxCLKFX180}, {Page::PinSTATUS, &Tsy_DCMgenSetupUI::CheckBoxDO},
    {Page::PinLOCKED, &Tsy_DCMgenSetupUI::CheckBoxLOCKED},
};

bool userChoosesSources(int wizType)
{
    // The application pages of the other types decide the input and the
    // feedback of their DCMs.
    return wizType == Tsy_DCMwiz::TypeDcm || wizType == Tsy_DCMwiz::TypeClockForwarding;
}

} // namespace

Tsy_DCMgenSetupGui::Tsy_DCMgenSetupGui(Tsy_DCMgenSetup* page, QWidget* /*parent*/) : page_(page)
{
    // The window adopts the form when the page is added to it; until then it
    // belongs to this controller.
    auto* form = new Tsy_DCMgenSetupUI_Imp();
    form_ = form;
    setPageWidget(form);
    setPageName(qs(page_->GetPageTitle()));
    form->setWindowTitle(qs(page_->GetWindowTitle()));
    Tsy_DCMwizPage::FillComboBox(form->ComboBoxPsType, page_->GetDcmValueList(Tsy_DCMwizPage::ListPhaseShift));
    Tsy_DCMwizPage::FillComboBox(form->ComboBoxDivideByValue, page_->GetDcmValueList(Tsy_DCMwizPage::ListClkdvDivide));
    form->CheckBoxDO->setText(page_->IsGeneration45() ? "DO" : "STATUS");
    connectForm();
}

Tsy_DCMgenSetupGui::~Tsy_DCMgenSetupGui() = default;

Tsy_DCMgenSetupUI_Imp* Tsy_DCMgenSetupGui::form() const
{
    return form_;
}

void Tsy_DCMgenSetupGui::connectForm()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    for (QRadioButton* r : {f->RadioClkinExternal, f->RadioClkinInternal})
        connect(r, &QRadioButton::clicked, this, &Tsy_DCMgenSetupGui::OnChangeCLKIN);
    for (QRadioButton* r : {f->RadioFbExternal, f->RadioFbSingle, f->RadioFbDifferential, f->RadioFbInternal,
                            f->RadioFbNone, f->RadioFb1x, f->RadioFb2x})
        connect(r, &QRadioButton::clicked, this, &Tsy_DCMgenSetupGui::OnChangeFeedback);
    for (QRadioButton* r : {f->RadioFinMhz, f->RadioFinNs})
        connect(r, &QRadioButton::clicked, this, &Tsy_DCMgenSetupGui::OnChangeFIN);
    connect(f->LineEditFin, &QLineEdit::textChanged, this, &Tsy_DCMgenSetupGui::OnChangeFIN);
    connect(f->ComboBoxPsType, qOverload<int>(&QComboBox::activated), this, &Tsy_DCMgenSetupGui::OnChangePStype);
    connect(f->CheckBoxRST, &QCheckBox::clicked, this, &Tsy_DCMgenSetupGui::OnChangeRST);
    for (const auto& o : kOutputs)
        connect(f->*o.box, &QCheckBox::clicked, this, &Tsy_DCMgenSetupGui::OnChangeClkout);
    connect(f->CheckBoxPmcd, &QCheckBox::clicked, this, &Tsy_DCMgenSetupGui::OnChangePMCD);
    connect(f->SpinBoxPsValue, qOverload<int>(&QSpinBox::valueChanged), this, &Tsy_DCMgenSetupGui::OnChangePSvalue);
}

// ------------------------------------------------------------ page events

void Tsy_DCMgenSetupGui::onActive()
{
    if (Gq_Wizard* w = wizard()) {
        w->showMoreInfo(true);
        w->enableMoreInfo(true);
        w->showAdvanced(true);
        w->enableAdvanced(true);
        w->setCaption(qs(page_->GetWindowTitle()));
    }
    page_->LoadFromBlock();
    recompute(false);
    ApplyToGui();
}

bool Tsy_DCMgenSetupGui::onNext()
{
    ReadFromGui();
    takeShownPsValue();
    return page_->StoreToBlock(true);
}

bool Tsy_DCMgenSetupGui::onBack()
{
    ReadFromGui();
    takeShownPsValue();
    page_->StoreToBlock(false);
    return true;
}

int Tsy_DCMgenSetupGui::shownPsValue() const
{
    int value = 0;
    UT_STR::ParseInt(page_->GetSettings().psValue, value);
    if (page_->GetSettings().psType == Page::PsNone)
        return value;
    return qBound(page_->GetPsLowest(), value, page_->GetPsHighest());
}

void Tsy_DCMgenSetupGui::takeShownPsValue()
{
    // What leaves the page is what the user sees.
    if (form_)
        page_->GetSettings().psValue = StringBase::Printf("%d", form_->SpinBoxPsValue->value());
}

void Tsy_DCMgenSetupGui::onMoreInfo()
{
    page_->InvokeMoreInfo("tsy_dcmgen");
}

void Tsy_DCMgenSetupGui::onAdvanced()
{
    if (!form_)
        return;
    ReadFromGui();
    takeShownPsValue();
    Tsy_AdvancedDlgGui dialog(page_, form_->window());
    dialog.LoadFromPage();
    if (dialog.exec() == QDialog::Accepted && dialog.StoreToPage())
        recompute(true);
    ApplyToGui();
}

// ------------------------------------------------------------ form <-> page

void Tsy_DCMgenSetupGui::ReadFromGui()
{
    if (!form_)
        return;
    Tsy_DCMgenSetupUI_Imp* f = form_;
    Page::Settings& s = page_->GetSettings();
    s.clkinText = sb(f->LineEditFin->text());
    s.units = f->RadioFinNs->isChecked() ? Page::UnitsNs : Page::UnitsMHz;
    s.clkinInternal = f->RadioClkinInternal->isChecked();
    s.clkinDifferential = f->RadioClkinDifferential->isChecked();
    if (f->RadioFbNone->isChecked())
        s.fbSource = Page::FbSourceNone;
    else if (f->RadioFbInternal->isChecked())
        s.fbSource = Page::FbSourceInternal;
    else
        s.fbSource = Page::FbSourceExternal;
    s.fbDifferential = f->RadioFbDifferential->isChecked();
    if (s.fbSource == Page::FbSourceNone)
        s.fbValue = Page::FbValueNone;
    else
        s.fbValue = f->RadioFb2x->isChecked() ? Page::FbValue2X : Page::FbValue1X;

    s.pins[Page::PinRST] = f->CheckBoxRST->isChecked();
    for (const auto& o : kOutputs)
        s.pins[o.pin] = (f->*o.box)->isChecked();

    // A stored value the list does not hold shows as no choice and stays as
    // it was until the user picks one; Next then names it.
    if (f->ComboBoxPsType->currentIndex() >= 0) {
        StringBase text = sb(f->ComboBoxPsType->currentText());
        s.psType = Page::PsTypeFromText(text);
        s.psTypeText = s.psType == Page::PsUnknown ? text : StringBase();
    }
    if (f->SpinBoxPsValue->value() != shownPs_)
        s.psValue = StringBase::Printf("%d", f->SpinBoxPsValue->value());
    if (f->ComboBoxDivideByValue->currentIndex() >= 0)
        s.clkdvDivide = sb(f->ComboBoxDivideByValue->currentText());
    s.dutyCycle = f->CheckBoxDutyCycle->isChecked();
    if (s.pmcdAvailable)
        s.pmcdSelected = f->CheckBoxPmcd->isChecked();
}

bool Tsy_DCMgenSetupGui::isRstForced() const
{
    const Page::Settings& s = page_->GetSettings();
    const int type = page_->GetWizTypeOfPage();
    return type == Tsy_DCMwiz::TypeCascading ||
           (type == Tsy_DCMwiz::TypeDcm && s.pmcdAvailable && s.pmcdSelected);
}

bool Tsy_DCMgenSetupGui::isRstBlocked() const
{
    if (page_->GetWizTypeOfPage() != Tsy_DCMwiz::TypePllToDcm)
        return false;
    // Looked up without creating anything: the PLL pages own that block.
    const Tsy_WizData* data = page_->GetWizData();
    const Tsy_Block* pll = data ? data->GetActiveBlock("PLL_ADV") : nullptr;
    const Tsy_Pin* rst = pll ? pll->GetNamedPin("RST") : nullptr;
    return !(rst && rst->IsActive());
}

void Tsy_DCMgenSetupGui::recompute(bool warn)
{
    Page::Settings& s = page_->GetSettings();
    page_->ComputeFrequencyModes(s.clkinText, s.pins[Page::PinCLK2X], s.units);
    phaseShiftHeld_ = page_->RestrictPhaseShift(warn);
    page_->ComputePhaseShiftLimits();
    page_->ComputePhaseShiftDisplay(shownPsValue());
}

void Tsy_DCMgenSetupGui::ApplyToGui()
{
    if (!form_)
        return;
    updating_ = true;
    const StringBase feedback = page_->FeedbackOutput();
    forceRequiredPins(feedback);
    // Held until the whole form shows the settings.
    const QSignalBlocker blockEdit(form_->LineEditFin);
    applyInputFrequency();
    applyInputSource();
    applyFeedback();
    applyPinBoxes(feedback);
    applyOutputOptions();
    applyPhaseShift();
    applySymbol();
    updating_ = false;
}

// An output the page's rules reserve, or the one that closes the feedback
// loop, runs whatever the user chose.
bool Tsy_DCMgenSetupGui::isOutputForced(int pin, const StringBase& feedback) const
{
    return page_->IsReservedOutput(pin) || (!feedback.IsEmpty() && feedback == Page::PinName(pin));
}

// What the page's rules force is selected in the settings as well.
void Tsy_DCMgenSetupGui::forceRequiredPins(const StringBase& feedback)
{
    Page::Settings& s = page_->GetSettings();
    for (const auto& o : kOutputs)
        if (isOutputForced(o.pin, feedback))
            s.pins[o.pin] = true;
    if (isRstForced())
        s.pins[Page::PinRST] = true;
}

void Tsy_DCMgenSetupGui::applyInputFrequency()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    if (f->LineEditFin->text() != qs(s.clkinText))
        f->LineEditFin->setText(qs(s.clkinText));
    f->LineEditFin->setEnabled(!page_->IsInputDerived());
    f->RadioFinMhz->setChecked(s.units == Page::UnitsMHz);
    f->RadioFinNs->setChecked(s.units == Page::UnitsNs);
    f->RadioFinMhz->setEnabled(!page_->AreUnitsDerived());
    f->RadioFinNs->setEnabled(!page_->AreUnitsDerived());
    f->TextLabelFinDivided->setVisible(s.divideBy2);
}

void Tsy_DCMgenSetupGui::applyInputSource()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    f->GroupBoxClkinSrc->setEnabled(userChoosesSources(page_->GetWizTypeOfPage()));
    f->RadioClkinExternal->setChecked(!s.clkinInternal);
    f->RadioClkinInternal->setChecked(s.clkinInternal);
    f->RadioClkinSingle->setChecked(!s.clkinDifferential);
    f->RadioClkinDifferential->setChecked(s.clkinDifferential);
    f->RadioClkinSingle->setEnabled(!s.clkinInternal);
    f->RadioClkinDifferential->setEnabled(!s.clkinInternal);
}

void Tsy_DCMgenSetupGui::applyFeedback()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    const bool sources = userChoosesSources(page_->GetWizTypeOfPage());
    const bool external = s.fbSource == Page::FbSourceExternal;
    f->GroupBoxFbSrc->setEnabled(sources);
    f->RadioFbExternal->setChecked(external);
    f->RadioFbInternal->setChecked(s.fbSource == Page::FbSourceInternal);
    f->RadioFbNone->setChecked(s.fbSource == Page::FbSourceNone);
    f->RadioFbSingle->setChecked(!s.fbDifferential);
    f->RadioFbDifferential->setChecked(s.fbDifferential);
    f->RadioFbSingle->setEnabled(external);
    f->RadioFbDifferential->setEnabled(external);
    f->GroupBoxFbValue->setEnabled(sources && s.fbSource != Page::FbSourceNone);
    f->RadioFb1x->setChecked(s.fbValue != Page::FbValue2X);
    f->RadioFb2x->setChecked(s.fbValue == Page::FbValue2X);
    f->RadioFb2x->setEnabled(!page_->Is2XFeedbackRefused());
}

// RST and the output boxes beside the symbol; a forced one cannot be cleared.
void Tsy_DCMgenSetupGui::applyPinBoxes(const StringBase& feedback)
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    f->CheckBoxRST->setChecked(s.pins[Page::PinRST]);
    f->CheckBoxRST->setEnabled(!isRstForced() && !isRstBlocked());
    for (const auto& o : kOutputs) {
        QCheckBox* box = f->*o.box;
        box->setChecked(s.pins[o.pin]);
        bool fixed = isOutputForced(o.pin, feedback);
        // DO also carries the read-back data of dynamic reconfiguration.
        if (o.pin == Page::PinSTATUS && page_->IsGeneration45() && s.reconfigPins) {
            box->setChecked(true);
            fixed = true;
        }
        box->setEnabled(!fixed);
    }
}

// The CLKDV divider, the duty-cycle correction and the PMCD choice.
void Tsy_DCMgenSetupGui::applyOutputOptions()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    if (f->ComboBoxDivideByValue->count() == 0)
        Tsy_DCMwizPage::FillComboBox(f->ComboBoxDivideByValue,
                                     page_->GetDcmValueList(Tsy_DCMwizPage::ListClkdvDivide));
    if (!Tsy_WizPage::SetComboBoxText(f->ComboBoxDivideByValue, s.clkdvDivide))
        f->ComboBoxDivideByValue->setCurrentIndex(-1);
    f->CheckBoxDutyCycle->setChecked(s.dutyCycle);
    f->CheckBoxPmcd->setVisible(page_->IsGeneration45() && s.pmcdAvailable);
    f->CheckBoxPmcd->setChecked(s.pmcdSelected);
}

void Tsy_DCMgenSetupGui::applyPhaseShift()
{
    Tsy_DCMgenSetupUI_Imp* f = form_;
    const Page::Settings& s = page_->GetSettings();
    if (f->ComboBoxPsType->count() == 0)
        Tsy_DCMwizPage::FillComboBox(f->ComboBoxPsType, page_->GetDcmValueList(Tsy_DCMwizPage::ListPhaseShift));
    const QSignalBlocker blockType(f->ComboBoxPsType);
    StringBase typeText = s.psType == Page::PsUnknown ? s.psTypeText : StringBase(Page::PsTypeName(s.psType));
    if (!Tsy_WizPage::SetComboBoxText(f->ComboBoxPsType, typeText))
        f->ComboBoxPsType->setCurrentIndex(-1);

    const QSignalBlocker blockValue(f->SpinBoxPsValue);
    f->SpinBoxPsValue->setRange(page_->GetPsLowest(), page_->GetPsHighest());
    shownPs_ = shownPsValue();
    f->SpinBoxPsValue->setValue(shownPs_);
    page_->ComputePhaseShiftDisplay(f->SpinBoxPsValue->value());
    const bool shifting = s.psType != Page::PsNone;
    for (QWidget* w : {static_cast<QWidget*>(f->SpinBoxPsValue), static_cast<QWidget*>(f->TextLabelPsValue),
                       static_cast<QWidget*>(f->TextLabelPsRange), static_cast<QWidget*>(f->TextLabelPsValueNs),
                       static_cast<QWidget*>(f->TextLabelPsValueDegrees)})
        w->setEnabled(shifting);
    f->TextLabelPsRange->setText(QString::asprintf("%d to %d", page_->GetPsLowest(), page_->GetPsHighest()));
    f->TextLabelPsValueNs->setText(QString::asprintf("%3.3f ns", page_->GetPsNs()));
    f->TextLabelPsValueDegrees->setText(QString::asprintf("%3.3f Degrees", page_->GetPsDegrees()));
    f->GroupBoxPs->setEnabled(!phaseShiftHeld_);
}

void Tsy_DCMgenSetupGui::applySymbol()
{
    const Page::Settings& s = page_->GetSettings();
    const bool gen45 = page_->IsGeneration45();
    const bool dynamicPs = s.psType != Page::PsNone && s.psType != Page::PsFixed;
    const bool reconfig = gen45 && s.reconfigPins;

    Tsy_DCMgenSetupUI_Imp::Symbol symbol;
    symbol.primitive = qs(page_->GetSymbolPrimitive());
    if (!Tsy_DCMwiz::IsSingleDcmType(page_->GetWizTypeOfPage()))
        symbol.instance = page_->GetInstNum() == 2 ? "INST2" : "INST1";
    symbol.inputs << "CLKIN";
    if (s.fbSource != Page::FbSourceNone)
        symbol.inputs << "CLKFB";
    if (s.pins[Page::PinRST])
        symbol.inputs << "RST";
    if (dynamicPs)
        symbol.inputs << "PSEN" << "PSINCDEC" << "PSCLK";
    if (reconfig)
        symbol.inputs << "DADDR[6:0]" << "DI[15:0]" << "DWE" << "DEN" << "DCLK";
    for (int p : {Page::PinCLK0, Page::PinCLK90, Page::PinCLK180, Page::PinCLK270, Page::PinCLKDV, Page::PinCLK2X,
                  Page::PinCLK2X180, Page::PinCLKFX, Page::PinCLKFX180})
        if (s.pins[p])
            symbol.outputs << Page::PinName(p);
    if (gen45 ? (s.pins[Page::PinSTATUS] || reconfig) : s.pins[Page::PinSTATUS])
        symbol.outputs << (gen45 ? "DO[15:0]" : "STATUS[7:0]");
    if (s.pins[Page::PinLOCKED])
        symbol.outputs << "LOCKED";
    if (dynamicPs)
        symbol.outputs << "PSDONE";
    if (reconfig)
        symbol.outputs << "DRDY";
    form_->setSymbol(symbol);
}

// ------------------------------------------------------------------ slots

void Tsy_DCMgenSetupGui::OnChangeCLKIN()
{
    if (updating_)
        return;
    ReadFromGui();
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangeFeedback()
{
    if (updating_)
        return;
    ReadFromGui();
    // The output that closes the loop runs in the frequency modes too.
    recompute(true);
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangeFIN()
{
    if (updating_)
        return;
    ReadFromGui();
    recompute(true);
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangePStype()
{
    if (updating_)
        return;
    ReadFromGui();
    recompute(false);
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangeRST()
{
    if (updating_)
        return;
    ReadFromGui();
    if (!page_->GetSettings().pins[Page::PinRST])
        page_->IssueMessage("RST has been deselected.  With RST deselected, the DCM can only be reset upon "
                            "configuration.",
                            false, false, false);
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangeClkout()
{
    if (updating_)
        return;
    ReadFromGui();
    recompute(true);
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangePMCD()
{
    if (updating_)
        return;
    ReadFromGui();
    ApplyToGui();
}

void Tsy_DCMgenSetupGui::OnChangePSvalue()
{
    if (updating_ || !form_)
        return;
    ReadFromGui();
    shownPs_ = form_->SpinBoxPsValue->value();
    page_->ComputePhaseShiftDisplay(shownPs_);
    form_->TextLabelPsValueNs->setText(QString::asprintf("%3.3f ns", page_->GetPsNs()));
    form_->TextLabelPsValueDegrees->setText(QString::asprintf("%3.3f Degrees", page_->GetPsDegrees()));
}
