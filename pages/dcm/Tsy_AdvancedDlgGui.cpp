#include "pages/dcm/Tsy_AdvancedDlgGui.h"

#include "Tsy_AdvancedDlgUI.h"
#include "pages/dcm/Tsy_DCMgenSetup.h"

#include <QVBoxLayout>

Tsy_AdvancedDlgGui::Tsy_AdvancedDlgGui(Tsy_DCMgenSetup* page, QWidget* parent)
    : Gq_Dialog(parent), page_(page), form_(new Tsy_AdvancedDlgUI(this))
{
    setObjectName("Tsy_AdvancedDlgGui");
    setWindowTitle("Corvane Pendra - Advanced");
    setMinimumSize(450, 285);
    setModal(true);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(form_);

    connect(form_->PushButtonOk, &QPushButton::clicked, this, &Tsy_AdvancedDlgGui::onOk);
    connect(form_->PushButtonCancel, &QPushButton::clicked, this, &Tsy_AdvancedDlgGui::onCancel);
    connect(form_->PushButtonMoreInfo, &QPushButton::clicked, this, &Tsy_AdvancedDlgGui::onMoreInfo);
    writeWidgets();
}

Tsy_AdvancedDlgGui::~Tsy_AdvancedDlgGui() = default;

void Tsy_AdvancedDlgGui::LoadFromPage()
{
    if (!page_)
        return;
    Tsy_DCMgenSetup::Settings& s = page_->GetSettings();
    deskewAdjust = s.deskewAdjust;
    startupWait = s.startupWait;
    divideBy2 = s.divideBy2;
    reconfigPins = s.reconfigPins;
    maxRange = s.perfMode == Tsy_DCMgenSetup::PerfMaxRange;
    resetLogicAvailable = page_->IsResetLogicAllowed();
    if (!resetLogicAvailable)
        s.resetLogic = false;
    resetLogic = s.resetLogic;

    Tsy_DCMwizPage::FillComboBox(form_->ComboBoxDeskewAdjust, page_->GetDcmValueList(Tsy_DCMwizPage::ListDeskewAdjust));
    // A value the list does not hold shows as no choice and is kept unless
    // the user picks one.
    if (!Tsy_WizPage::SetComboBoxText(form_->ComboBoxDeskewAdjust, deskewAdjust))
        form_->ComboBoxDeskewAdjust->setCurrentIndex(-1);

    // Performance modes and dynamic reconfiguration exist on DCM_ADV only.
    const bool gen45 = page_->IsGeneration45();
    for (QWidget* w : {static_cast<QWidget*>(form_->CheckBoxReconfigPins),
                       static_cast<QWidget*>(form_->TextLabelPerformanceMode),
                       static_cast<QWidget*>(form_->RadioMaxSpeed), static_cast<QWidget*>(form_->RadioMaxRange)}) {
        w->setVisible(gen45);
        w->setEnabled(gen45);
    }
    writeWidgets();
}

void Tsy_AdvancedDlgGui::writeWidgets()
{
    form_->CheckBoxStartupWait->setChecked(startupWait);
    form_->CheckBoxDivideBy2->setChecked(divideBy2);
    form_->CheckBoxResetLogic->setChecked(resetLogic);
    form_->CheckBoxResetLogic->setEnabled(resetLogicAvailable);
    form_->CheckBoxReconfigPins->setChecked(reconfigPins);
    form_->RadioMaxRange->setChecked(maxRange);
    form_->RadioMaxSpeed->setChecked(!maxRange);
}

void Tsy_AdvancedDlgGui::readWidgets()
{
    if (form_->ComboBoxDeskewAdjust->currentIndex() >= 0)
        deskewAdjust = form_->ComboBoxDeskewAdjust->currentText().toStdString();
    startupWait = form_->CheckBoxStartupWait->isChecked();
    divideBy2 = form_->CheckBoxDivideBy2->isChecked();
    resetLogic = resetLogicAvailable && form_->CheckBoxResetLogic->isChecked();
    reconfigPins = form_->CheckBoxReconfigPins->isChecked();
    maxRange = form_->RadioMaxRange->isChecked();
}

bool Tsy_AdvancedDlgGui::StoreToPage() const
{
    if (!page_)
        return false;
    Tsy_DCMgenSetup::Settings& s = page_->GetSettings();
    const bool gen45 = page_->IsGeneration45();
    const Tsy_DCMgenSetup::PerfMode perf =
        gen45 ? (maxRange ? Tsy_DCMgenSetup::PerfMaxRange : Tsy_DCMgenSetup::PerfMaxSpeed) : s.perfMode;
    const bool changed = perf != s.perfMode || divideBy2 != s.divideBy2;
    s.startupWait = startupWait;
    s.divideBy2 = divideBy2;
    s.deskewAdjust = deskewAdjust;
    s.resetLogic = resetLogic;
    if (gen45) {
        s.reconfigPins = reconfigPins;
        s.perfMode = perf;
    }
    return changed;
}

void Tsy_AdvancedDlgGui::onOk()
{
    readWidgets();
    if (page_) {
        if (!deskewAdjust.EqualsNoCase("SOURCE_SYNCHRONOUS") && !deskewAdjust.EqualsNoCase("SYSTEM_SYNCHRONOUS"))
            page_->IssueMessage("Choosing a value other than SOURCE_SYNCHRONOUS or SYSTEM_SYNCHRONOUS may lead to "
                                "unusual timing relationships and should only be attempted after consulting with "
                                "Corvane.",
                                false, false, false);
        if (startupWait)
            page_->IssueMessage("In addition to setting STARTUP_WAIT, the LCK_cycle Forgeon option is required.  The "
                                "configuration startup sequence will wait in the specified LCK_cycle until the DCM "
                                "locks.",
                                false, false, false);
    }
    accept();
}

void Tsy_AdvancedDlgGui::onCancel()
{
    reject();
}

void Tsy_AdvancedDlgGui::onMoreInfo()
{
    if (page_)
        page_->InvokeMoreInfo("tsy_dcmadv");
}
