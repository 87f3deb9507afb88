#include "pages/dcm/Tsy_JitterDlgGui.h"

#include "Tsy_JitterDlgUI.h"
#include "gui/Gq_Wizard.h"
#include "pages/dcm/Tsy_JitterDlg.h"

#include <QRegularExpression>
#include <QRegularExpressionValidator>

namespace {

QString q(const StringBase& s)
{
    return QString::fromStdString(s.str());
}

StringBase s(const QString& text)
{
    return StringBase(text.toStdString());
}

} // namespace

Tsy_JitterDlgGui::Tsy_JitterDlgGui(Tsy_JitterDlg* page, QWidget* parent, bool withForm) : page_(page)
{
    setPageName(q(page_->GetPageTitle()));
    if (!withForm)
        return;
    form_ = new Tsy_JitterDlgUI(parent);
    form_->setWindowTitle(q(page_->GetFormCaption()));
    setPageWidget(form_);

    // A frequency or period is a plain decimal; M and D are small whole
    // numbers (the page itself reports those out of range).
    auto* decimal = new QRegularExpressionValidator(QRegularExpression("[0-9]*\\.?[0-9]*"), form_);
    form_->LineEditFout->setValidator(decimal);
    auto* whole = new QRegularExpressionValidator(QRegularExpression("[0-9]{0,3}"), form_);
    form_->LineEditM->setValidator(whole);
    form_->LineEditD->setValidator(whole);

    // M and D keep the range of the synthesizer this page configures; the
    // wider range belongs to synthesizers without a DCM's limits.
    form_->CheckBoxOscMode->setChecked(false);
    form_->CheckBoxOscMode->hide();

    StringBase ui, pk2pk;
    page_->GetJitterCaptions(ui, pk2pk);
    if (!ui.IsEmpty())
        form_->TextLabelPeriodUITitle->setText(q(ui));
    if (!pk2pk.IsEmpty())
        form_->TextLabelPeriodPk2PkTitle->setText(q(pk2pk));

    connect(form_->RadioButtonFout, &QAbstractButton::clicked, this, &Tsy_JitterDlgGui::OnRadioInputType);
    connect(form_->RadioButtonMandD, &QAbstractButton::clicked, this, &Tsy_JitterDlgGui::OnRadioInputType);
    connect(form_->RadioButtonFoutMhz, &QAbstractButton::clicked, this, &Tsy_JitterDlgGui::OnRadioFoutMhzUnits);
    connect(form_->RadioButtonFoutNs, &QAbstractButton::clicked, this, &Tsy_JitterDlgGui::OnRadioFoutNsUnits);
    connect(form_->PushButtonCalculate, &QAbstractButton::clicked, this, &Tsy_JitterDlgGui::OnButtonCalculate);
}

Tsy_JitterDlgGui::~Tsy_JitterDlgGui() = default;

void Tsy_JitterDlgGui::onActive()
{
    if (Gq_Wizard* w = wizard()) {
        w->showMoreInfo(true);
        w->enableMoreInfo(true);
        w->showAdvanced(false);
        w->enableAdvanced(false);
    }
    page_->LoadFromBlock();
    dataToWidgets();
}

void Tsy_JitterDlgGui::readTexts()
{
    if (!form_)
        return;
    page_->SetFoutText(s(form_->LineEditFout->text()));
    page_->SetMText(s(form_->LineEditM->text()));
    page_->SetDText(s(form_->LineEditD->text()));
}

void Tsy_JitterDlgGui::widgetsToData()
{
    if (!form_)
        return;
    readTexts();
    page_->SetInputType(form_->RadioButtonMandD->isChecked() ? Tsy_JitterDlg::InputMAndD
                                                             : Tsy_JitterDlg::InputOutputFrequency);
    page_->SetOutputUnits(form_->RadioButtonFoutNs->isChecked() ? Tsy_JitterDlg::UnitsNs : Tsy_JitterDlg::UnitsMhz);
}

void Tsy_JitterDlgGui::dataToWidgets()
{
    if (!form_)
        return;
    writing_ = true;
    const bool byOutput = page_->GetInputType() == Tsy_JitterDlg::InputOutputFrequency;
    form_->RadioButtonFout->setChecked(byOutput);
    form_->RadioButtonMandD->setChecked(!byOutput);
    form_->RadioButtonFoutMhz->setChecked(page_->GetOutputUnits() == Tsy_JitterDlg::UnitsMhz);
    form_->RadioButtonFoutNs->setChecked(page_->GetOutputUnits() == Tsy_JitterDlg::UnitsNs);
    form_->LineEditFout->setText(q(page_->GetFoutText()));
    form_->LineEditM->setText(q(page_->GetMText()));
    form_->LineEditD->setText(q(page_->GetDText()));
    // Only the chosen way of giving the output can be edited.
    form_->LineEditFout->setEnabled(byOutput);
    form_->RadioButtonFoutMhz->setEnabled(byOutput);
    form_->RadioButtonFoutNs->setEnabled(byOutput);
    form_->TextLabelM->setEnabled(!byOutput);
    form_->LineEditM->setEnabled(!byOutput);
    form_->TextLabelD->setEnabled(!byOutput);
    form_->LineEditD->setEnabled(!byOutput);

    form_->TextLabelInputFrequency->setText("Input Clock Frequency:");
    form_->TextLabelFinDivBy2->setText(q(page_->GetInputClockText()));
    form_->GroupBoxRangeTable->setTitle(q(page_->GetRangeTableTitle()));
    form_->TextLabelFinRangeTitle->setText(q(page_->GetRangeHeader(false)));
    form_->TextLabelFoutRangeTitle->setText(q(page_->GetRangeHeader(true)));
    form_->TextLabelLfFinValue->setText(q(page_->GetRangeText(false, false)));
    form_->TextLabelHfFinValue->setText(q(page_->GetRangeText(true, false)));
    form_->TextLabelLfFoutValue->setText(q(page_->GetRangeText(false, true)));
    form_->TextLabelHfFoutValue->setText(q(page_->GetRangeText(true, true)));
    showResults();
    writing_ = false;
}

void Tsy_JitterDlgGui::showResults()
{
    form_->TextLabelFoutTitle->setText(q(page_->GetOutputHeader()));
    if (!page_->HasResult()) {
        for (QLabel* l : {form_->TextLabelMValue, form_->TextLabelDValue, form_->TextLabelFoutValue,
                          form_->TextLabelPeriodUIValue, form_->TextLabelPeriodPk2PkValue})
            l->setText("-");
        return;
    }
    form_->TextLabelMValue->setText(q(StringBase::Printf("%g", static_cast<double>(page_->GetResultM()))));
    form_->TextLabelDValue->setText(q(StringBase::Printf("%g", static_cast<double>(page_->GetResultD()))));
    form_->TextLabelFoutValue->setText(q(page_->GetOutputText()));
    form_->TextLabelPeriodUIValue->setText(q(page_->GetJitterUiText()));
    form_->TextLabelPeriodPk2PkValue->setText(q(page_->GetJitterPk2PkText()));
}

bool Tsy_JitterDlgGui::onNext()
{
    widgetsToData();
    bool ok = page_->StoreToBlock(true);
    // The store may have rewritten entries (a doubled M); show them.
    dataToWidgets();
    return ok;
}

bool Tsy_JitterDlgGui::onBack()
{
    widgetsToData();
    page_->StoreToBlock(false);
    return true;
}

void Tsy_JitterDlgGui::onMoreInfo()
{
    page_->InvokeMoreInfo("tsy_dcmclkfreq");
}

void Tsy_JitterDlgGui::OnRadioInputType()
{
    if (writing_ || !form_)
        return;
    widgetsToData();
    // The table and the output follow the input just chosen; errors wait
    // for Calculate or Next.
    page_->Calculate(false);
    dataToWidgets();
}

void Tsy_JitterDlgGui::changeUnits(int units)
{
    if (writing_ || !form_)
        return;
    readTexts();
    page_->SetOutputUnits(static_cast<Tsy_JitterDlg::Units>(units));
    page_->Calculate(false);
    dataToWidgets();
}

void Tsy_JitterDlgGui::OnRadioFoutMhzUnits()
{
    changeUnits(Tsy_JitterDlg::UnitsMhz);
}

void Tsy_JitterDlgGui::OnRadioFoutNsUnits()
{
    changeUnits(Tsy_JitterDlg::UnitsNs);
}

void Tsy_JitterDlgGui::OnButtonCalculate()
{
    if (writing_ || !form_)
        return;
    widgetsToData();
    page_->Calculate(true);
    dataToWidgets();
}
