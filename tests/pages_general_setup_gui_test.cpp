// General Setup as the user works it under the offscreen platform: the form
// filled from the block and kept by its rules, the keyboard, the Advanced
// dialog, and the page inside the real wizard window.

#include "Tsy_AdvancedDlgUI.h"
#include "Tsy_DCMgenSetupUI_Imp.h"
#include "gui/Gq_HelpViewer.h"
#include "gui/Gq_Wizard.h"
#include "pages/dcm/Tsy_AdvancedDlgGui.h"
#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "pages/dcm/Tsy_DCMgenSetupGui.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_SpeedData.h"

#include <QApplication>
#include <QDir>
#include <QPushButton>
#include <QTest>
#include <QTextBrowser>
#include <QTimer>

#include <gtest/gtest.h>

#include <functional>
#include <memory>

namespace {

using Page = Tsy_DCMgenSetup;

Page* generalSetup(Tsy_DCMwiz& wizard, int inst)
{
    for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
        if (auto* p = dynamic_cast<Page*>(wizard.GetPage(i)); p && p->GetInstNum() == inst)
            return p;
    return nullptr;
}

QStringList items(const QComboBox* combo)
{
    QStringList out;
    for (int i = 0; i < combo->count(); ++i)
        out << combo->itemText(i);
    return out;
}

QStringList strings(const Tsy_StrArray& list)
{
    QStringList out;
    for (const auto& s : list.Items())
        out << QString::fromStdString(s.str());
    return out;
}

// Runs open() while the first modal window that appears is handed to answer.
int whileModal(const std::function<int()>& open, const std::function<void(QWidget*)>& answer)
{
    auto* poll = new QTimer;
    bool answered = false;
    QObject::connect(poll, &QTimer::timeout, poll, [&] {
        QWidget* modal = QApplication::activeModalWidget();
        if (!modal || answered)
            return;
        answered = true;
        poll->stop();
        answer(modal);
    });
    poll->start(10);
    int r = open();
    delete poll;
    EXPECT_TRUE(answered) << "no modal window appeared";
    return r;
}

void retype(QLineEdit* edit, const QString& text)
{
    edit->selectAll();
    QTest::keyClick(edit, Qt::Key_Backspace);
    QTest::keyClicks(edit, text);
}

// The page of one instance with its controller and form, shown once.
class FormTest : public ::testing::Test {
protected:
    void Open(const char* keyword, const char* part, int inst = 1,
              const std::function<void(TestDesign&, Tsy_Block*)>& before = {})
    {
        design_ = std::make_unique<TestDesign>(keyword, part, false);
        design_->MarkLoaded();
        design_->Instantiate();
        page_ = generalSetup(design_->Wizard(), inst);
        ASSERT_NE(page_, nullptr);
        block_ = design_->Wizard().GetActiveDCMBlk(inst, false);
        if (before)
            before(*design_, block_);
        ASSERT_TRUE(page_->CreateGui(nullptr));
        gui_ = static_cast<Tsy_DCMgenSetupGui*>(page_->GetGui());
        form_ = gui_->form();
        gui_->onActive();
        design_->Stream().Clear();
    }
    std::vector<StringBase> Notes() { return design_->Stream().Notes(); }

    std::unique_ptr<TestDesign> design_;
    Page* page_ = nullptr;
    Tsy_Block* block_ = nullptr;
    Tsy_DCMgenSetupGui* gui_ = nullptr;
    Tsy_DCMgenSetupUI_Imp* form_ = nullptr;
};

} // namespace

TEST_F(FormTest, ShowsTheBlockWithTheFamilysChoices)
{
    struct Case {
        const char* part;
        const char* primitive;
        const char* statusBox;
        bool twoXOffered;
    } cases[] = {{"t5da1-1", "DCM_ADV", "DO", false},
                 {"m3e100-4", "DCM_SP", "STATUS", true},
                 {"t2a250-4", "DCM", "STATUS", true},
                 {"t2p7-5", "DCM", "STATUS", false}};
    for (const auto& c : cases) {
        Open("dcm", c.part, 1, [](TestDesign&, Tsy_Block* b) {
            b->SetAttributeValue("TESY_ONLY_CLKIN_VALUE", "125.5");
            b->SetAttributeValue("CLKDV_DIVIDE", "4.0");
            b->GetNamedPin("CLK90")->SetIsActive(true);
        });
        EXPECT_EQ(form_->LineEditFin->text(), "125.5") << c.part;
        EXPECT_TRUE(form_->RadioFinMhz->isChecked());
        EXPECT_TRUE(form_->CheckBoxCLK90->isChecked());
        EXPECT_TRUE(form_->CheckBoxCLK0->isChecked()) << "the internal loop's output";
        EXPECT_FALSE(form_->CheckBoxCLK0->isEnabled()) << "cannot be deselected";
        EXPECT_TRUE(form_->CheckBoxCLK90->isEnabled());
        EXPECT_EQ(form_->ComboBoxDivideByValue->currentText(), "4.0");
        EXPECT_EQ(items(form_->ComboBoxPsType), strings(page_->GetDcmValueList(Page::ListPhaseShift))) << c.part;
        EXPECT_EQ(items(form_->ComboBoxDivideByValue), strings(page_->GetDcmValueList(Page::ListClkdvDivide)));
        EXPECT_FALSE(form_->ComboBoxPsType->isEditable());
        EXPECT_EQ(form_->CheckBoxDO->text(), c.statusBox);
        EXPECT_EQ(form_->RadioFb2x->isEnabled(), c.twoXOffered) << c.part;
        EXPECT_TRUE(form_->TextLabelFinDivided->isHidden());
        EXPECT_TRUE(form_->CheckBoxPmcd->isHidden()) << c.part;
        EXPECT_EQ(form_->symbol().primitive, c.primitive);
        EXPECT_EQ(form_->symbol().instance, "");
        EXPECT_EQ(form_->symbol().outputs, (QStringList{"CLK0", "CLK90", "LOCKED"})) << c.part;
        EXPECT_EQ(form_->symbol().inputs, (QStringList{"CLKIN", "CLKFB", "RST"})) << c.part;
        EXPECT_EQ(form_->windowTitle(), "Corvane Pendra - General Setup");
        EXPECT_EQ(gui_->pageName(), "General Setup");
    }
}

TEST_F(FormTest, FeedbackPhaseShiftAndResetFollowTheUser)
{
    Open("dcm", "t2a250-4");
    form_->RadioFb2x->click();
    EXPECT_TRUE(form_->CheckBoxCLK2X->isChecked());
    EXPECT_FALSE(form_->CheckBoxCLK2X->isEnabled());
    EXPECT_TRUE(form_->CheckBoxCLK0->isEnabled());

    form_->RadioFbExternal->click();
    EXPECT_TRUE(form_->RadioFbSingle->isEnabled());
    EXPECT_TRUE(form_->CheckBoxCLK2X->isEnabled());
    form_->RadioFbNone->click();
    EXPECT_FALSE(form_->GroupBoxFbValue->isEnabled());
    EXPECT_FALSE(form_->RadioFbSingle->isEnabled());
    EXPECT_FALSE(form_->symbol().inputs.contains("CLKFB"));
    form_->RadioFbInternal->click();
    form_->RadioFb1x->click();

    // Phase shift: the value box takes its limits, the labels the figures.
    EXPECT_FALSE(form_->SpinBoxPsValue->isEnabled()) << "no value without a type";
    form_->ComboBoxPsType->setCurrentText("FIXED");
    emit form_->ComboBoxPsType->activated(form_->ComboBoxPsType->currentIndex());
    EXPECT_TRUE(form_->SpinBoxPsValue->isEnabled());
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-255 to 255");
    EXPECT_FALSE(form_->symbol().inputs.contains("PSEN")) << "a fixed shift needs no shift pins";
    retype(form_->LineEditFin, "30");
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-76 to 76");
    EXPECT_EQ(form_->SpinBoxPsValue->maximum(), 76);
    form_->SpinBoxPsValue->setValue(100);
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 76);
    EXPECT_EQ(form_->TextLabelPsValueNs->text(), "9.896 ns");
    EXPECT_EQ(form_->TextLabelPsValueDegrees->text(), "106.875 Degrees");
    form_->ComboBoxPsType->setCurrentText("VARIABLE");
    emit form_->ComboBoxPsType->activated(form_->ComboBoxPsType->currentIndex());
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-38 to 38");
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 38);
    EXPECT_EQ(form_->TextLabelPsValueDegrees->text(), "53.438 Degrees");
    for (const char* pin : {"PSEN", "PSINCDEC", "PSCLK"})
        EXPECT_TRUE(form_->symbol().inputs.contains(pin)) << pin;
    EXPECT_TRUE(form_->symbol().outputs.contains("PSDONE"));

    // Typing a frequency anew neither loses the phase shift while the field
    // is empty nor while the limits narrow on the way.
    retype(form_->LineEditFin, "");
    EXPECT_FALSE(form_->GroupBoxPs->isEnabled());
    QTest::keyClick(form_->LineEditFin, Qt::Key_3);
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 3);
    QTest::keyClick(form_->LineEditFin, Qt::Key_0);
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(form_->ComboBoxPsType->currentText(), "VARIABLE");
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 38);

    design_->Stream().Clear();
    form_->CheckBoxRST->click();
    EXPECT_EQ(Notes(), std::vector<StringBase>{"RST has been deselected.  With RST deselected, the DCM can only be "
                                               "reset upon configuration."});
    EXPECT_FALSE(form_->symbol().inputs.contains("RST"));

    ASSERT_TRUE(gui_->onNext()) << (design_->Stream().Errors().empty() ? "" : design_->Stream().Errors()[0].str());
    EXPECT_EQ(block_->GetAttributeValue("CLKOUT_PHASE_SHIFT").str(), "VARIABLE");
    EXPECT_EQ(block_->GetAttributeValue("PHASE_SHIFT").str(), "38");
    EXPECT_EQ(block_->GetAttributeValue("CLKIN_PERIOD").str(), "33.333");
    EXPECT_FALSE(block_->GetNamedPin("RST")->IsActive());
    EXPECT_TRUE(block_->GetNamedPin("PSEN")->IsActive());
}

TEST_F(FormTest, HighFrequencyModeTurnsThePhaseShiftOffOnMembra3)
{
    Open("dcm", "m3s200-4", 1, [](TestDesign&, Tsy_Block* b) {
        b->SetAttributeValue("CLKOUT_PHASE_SHIFT", "FIXED");
        b->SetAttributeValue("PHASE_SHIFT", "10");
    });
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    float hfMax = design_->Wizard().GetSpdDataPtr()->GetSpeedValue("CLKIN_FREQ_DLL_HF_Max");
    retype(form_->LineEditFin, QString::number(double(hfMax)));
    EXPECT_EQ(Notes(), std::vector<StringBase>{"Fixed or Variable phase shifting is not supported when the DFS/DLL "
                                               "frequency mode is set to high.  The phase shift will automatically be "
                                               "set to 'None'."});
    EXPECT_FALSE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(form_->ComboBoxPsType->currentText(), "NONE");
    retype(form_->LineEditFin, "100");
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(Notes().size(), 1u) << "said once";
}

TEST_F(FormTest, ApplicationsFixWhatTheyReserve)
{
    Open("dcm_clkswitch", "t2a250-4", 1,
         [](TestDesign&, Tsy_Block* b) { b->SetAttributeValue("TESY_ONLY_DCM_SWITCHING_CLK", "CLK90"); });
    EXPECT_TRUE(form_->CheckBoxCLK90->isChecked());
    EXPECT_FALSE(form_->CheckBoxCLK90->isEnabled());
    EXPECT_FALSE(form_->GroupBoxFbSrc->isEnabled()) << "the switching page chose the feedback";
    EXPECT_EQ(form_->symbol().instance, "INST1");
    EXPECT_EQ(gui_->pageName(), "General Setup for INST1");

    Open("dcm_cascading", "t2a250-4", 2);
    EXPECT_TRUE(form_->CheckBoxRST->isChecked());
    EXPECT_FALSE(form_->CheckBoxRST->isEnabled());
    EXPECT_FALSE(form_->LineEditFin->isEnabled()) << "the first DCM sets this input";
    EXPECT_FALSE(form_->RadioFinNs->isEnabled());
    EXPECT_EQ(form_->symbol().instance, "INST2");
    EXPECT_EQ(form_->windowTitle(), "Corvane Pendra - General Setup for INST2");

    Open("dcm", "t4a25-10", 1, [](TestDesign&, Tsy_Block* b) { b->SetAttributeValue("TESY_ONLY_PMCD", "NONE"); });
    ASSERT_FALSE(form_->CheckBoxPmcd->isHidden());
    EXPECT_TRUE(form_->CheckBoxRST->isEnabled());
    form_->CheckBoxPmcd->click();
    EXPECT_TRUE(form_->CheckBoxRST->isChecked());
    EXPECT_FALSE(form_->CheckBoxRST->isEnabled()) << "the PMCDs are released from the DCM's reset";
}

TEST_F(FormTest, FrequencyFieldTakesDecimalsOnly)
{
    Open("dcm", "t5da1-1");
    retype(form_->LineEditFin, "1a2.5.7e-");
    EXPECT_EQ(form_->LineEditFin->text(), "12.57");
    EXPECT_FLOAT_EQ(page_->GetInputFrequency(), 12.57f);
}

TEST_F(FormTest, KeyboardReachesEveryChoiceInLayoutOrder)
{
    Open("dcm", "t2a250-4");
    form_->show();
    QApplication::setActiveWindow(form_);
    ASSERT_TRUE(QTest::qWaitForWindowActive(form_));

    // A button's accelerator presses it the way a click does, a moment later.
    auto press = [this](Qt::Key key, QAbstractButton* button, bool checked) {
        QTest::keyClick(form_, key, Qt::AltModifier);
        EXPECT_TRUE(QTest::qWaitFor([&] { return button->isChecked() == checked; }))
            << button->objectName().toStdString();
    };
    press(Qt::Key_S, form_->RadioFinNs, true);
    EXPECT_EQ(page_->GetSettings().units, Page::UnitsNs);
    press(Qt::Key_I, form_->RadioClkinInternal, true);
    press(Qt::Key_X, form_->RadioFbExternal, true);
    press(Qt::Key_Y, form_->CheckBoxDutyCycle, false);
    gui_->ReadFromGui();
    EXPECT_FALSE(page_->GetSettings().dutyCycle);
    QTest::keyClick(form_, Qt::Key_P, Qt::AltModifier);
    EXPECT_EQ(QApplication::focusWidget(), form_->ComboBoxPsType);
    QTest::keyClick(form_, Qt::Key_F, Qt::AltModifier);
    EXPECT_EQ(QApplication::focusWidget(), form_->LineEditFin);

    const QList<QWidget*> expected = {
        form_->CheckBoxRST,        form_->CheckBoxCLK0,         form_->CheckBoxCLK90,
        form_->CheckBoxCLK180,     form_->CheckBoxCLK270,       form_->CheckBoxCLKDV,
        form_->CheckBoxCLK2X,      form_->CheckBoxCLK2X180,     form_->CheckBoxCLKFX,
        form_->CheckBoxCLKFX180,   form_->CheckBoxDO,           form_->CheckBoxLOCKED,
        form_->LineEditFin,        form_->RadioFinMhz,          form_->RadioFinNs,
        form_->RadioClkinExternal, form_->RadioClkinSingle,     form_->RadioClkinDifferential,
        form_->RadioClkinInternal, form_->RadioFbExternal,      form_->RadioFbSingle,
        form_->RadioFbDifferential, form_->RadioFbInternal,     form_->RadioFbNone,
        form_->ComboBoxPsType,     form_->SpinBoxPsValue,       form_->ComboBoxDivideByValue,
        form_->RadioFb1x,          form_->RadioFb2x,            form_->CheckBoxDutyCycle,
        form_->CheckBoxPmcd};
    QList<QWidget*> chain;
    QWidget* w = form_->CheckBoxRST;
    do {
        if (expected.contains(w))
            chain << w;
        w = w->nextInFocusChain();
    } while (w != form_->CheckBoxRST && chain.size() < expected.size() + 1);
    EXPECT_EQ(chain, expected);
    form_->hide();
}

// ----------------------------------------------------------------- Advanced

namespace {

Tsy_AdvancedDlgUI* advancedForm(QWidget* modal)
{
    auto* dialog = qobject_cast<Tsy_AdvancedDlgGui*>(modal);
    EXPECT_NE(dialog, nullptr) << "the Advanced dialog is the modal window";
    return dialog ? dialog->form() : nullptr;
}

} // namespace

TEST_F(FormTest, AdvancedCopiesInTheSettingsByTheFamilysRules)
{
    struct Case {
        const char* part;
        bool rst;
        bool gen45;
    } cases[] = {{"t5da1-1", true, true}, {"t5da1-1", false, true}, {"m3e100-4", true, false}};
    for (const auto& c : cases) {
        Open("dcm", c.part, 1, [&c](TestDesign&, Tsy_Block* b) {
            b->SetAttributeValue("DESKEW_ADJUST", "SOURCE_SYNCHRONOUS");
            b->SetAttributeValue("STARTUP_WAIT", "TRUE");
            b->SetAttributeValue("TESY_ONLY_RESET_LOGIC", "TRUE");
            b->SetAttributeValue("TESY_ONLY_RECONFIG_PINS", "TRUE");
            b->GetNamedPin("RST")->SetIsActive(c.rst);
        });
        Tsy_AdvancedDlgGui dialog(page_, form_);
        dialog.LoadFromPage();
        Tsy_AdvancedDlgUI* f = dialog.form();
        EXPECT_EQ(dialog.windowTitle(), "Corvane Pendra - Advanced");
        EXPECT_GE(dialog.minimumWidth(), 450);
        EXPECT_GE(dialog.minimumHeight(), 285);
        EXPECT_EQ(items(f->ComboBoxDeskewAdjust), strings(page_->GetDcmValueList(Page::ListDeskewAdjust)));
        EXPECT_EQ(f->ComboBoxDeskewAdjust->currentText(), "SOURCE_SYNCHRONOUS");
        EXPECT_TRUE(f->CheckBoxStartupWait->isChecked());
        EXPECT_EQ(f->CheckBoxResetLogic->isEnabled(), c.rst) << c.part;
        EXPECT_EQ(f->CheckBoxResetLogic->isChecked(), c.rst) << c.part;
        EXPECT_EQ(page_->GetSettings().resetLogic, c.rst) << "without RST the page's reset logic is off";
        for (QWidget* w : {static_cast<QWidget*>(f->CheckBoxReconfigPins), static_cast<QWidget*>(f->RadioMaxSpeed),
                           static_cast<QWidget*>(f->RadioMaxRange)}) {
            EXPECT_EQ(w->isHidden(), !c.gen45) << c.part << " " << w->objectName().toStdString();
            EXPECT_EQ(w->isEnabled(), c.gen45);
        }
        if (c.gen45) {
            EXPECT_TRUE(f->RadioMaxSpeed->isChecked());
        }
    }
}

TEST_F(FormTest, AdvancedOkHandsBackWithItsNotesAndTheFiguresFollow)
{
    Open("dcm", "t5da1-1");
    ASSERT_FLOAT_EQ(page_->GetInputFrequency(), 100.0f);
    whileModal([&] { gui_->onAdvanced(); return 0; },
               [&](QWidget* modal) {
                   Tsy_AdvancedDlgUI* f = advancedForm(modal);
                   ASSERT_NE(f, nullptr);
                   f->ComboBoxDeskewAdjust->setCurrentText("5");
                   f->CheckBoxStartupWait->click();
                   f->CheckBoxDivideBy2->click();
                   f->CheckBoxReconfigPins->click();
                   f->RadioMaxRange->click();
                   f->PushButtonOk->click();
               });
    EXPECT_EQ(Notes(), (std::vector<StringBase>{
                           "Choosing a value other than SOURCE_SYNCHRONOUS or SYSTEM_SYNCHRONOUS may lead to unusual "
                           "timing relationships and should only be attempted after consulting with Corvane.",
                           "In addition to setting STARTUP_WAIT, the LCK_cycle Forgeon option is required.  The "
                           "configuration startup sequence will wait in the specified LCK_cycle until the DCM locks."}));
    const Page::Settings& s = page_->GetSettings();
    EXPECT_EQ(s.deskewAdjust.str(), "5");
    EXPECT_TRUE(s.startupWait);
    EXPECT_TRUE(s.divideBy2);
    EXPECT_TRUE(s.reconfigPins);
    EXPECT_EQ(s.perfMode, Page::PerfMaxRange);
    EXPECT_FLOAT_EQ(page_->GetInputFrequency(), 50.0f) << "the divider halves what the page checks";
    EXPECT_FALSE(form_->TextLabelFinDivided->isHidden());
    EXPECT_TRUE(form_->symbol().inputs.contains("DADDR[6:0]"));
    EXPECT_TRUE(form_->symbol().outputs.contains("DRDY"));
    EXPECT_TRUE(form_->CheckBoxDO->isChecked());
    EXPECT_FALSE(form_->CheckBoxDO->isEnabled());

    // 50 MHz is outside the maximum-range figures: Next now says so.
    EXPECT_FALSE(gui_->onNext());
    ASSERT_EQ(design_->Stream().Errors().size(), 1u);
    EXPECT_NE(design_->Stream().Errors()[0].str().find("Performance Mode is set to Maximum Range."), std::string::npos);
}

TEST_F(FormTest, AdvancedCancelLeavesThePageAlone)
{
    Open("dcm", "t2a250-4");
    const Page::Settings before = page_->GetSettings();
    whileModal([&] { gui_->onAdvanced(); return 0; },
               [&](QWidget* modal) {
                   Tsy_AdvancedDlgUI* f = advancedForm(modal);
                   ASSERT_NE(f, nullptr);
                   EXPECT_TRUE(f->CheckBoxReconfigPins->isHidden());
                   f->ComboBoxDeskewAdjust->setCurrentText("3");
                   f->CheckBoxDivideBy2->click();
                   f->CheckBoxResetLogic->click();
                   f->PushButtonCancel->click();
               });
    const Page::Settings& s = page_->GetSettings();
    EXPECT_EQ(s.deskewAdjust, before.deskewAdjust);
    EXPECT_EQ(s.divideBy2, before.divideBy2);
    EXPECT_EQ(s.resetLogic, before.resetLogic);
    EXPECT_TRUE(Notes().empty());
    EXPECT_FLOAT_EQ(page_->GetInputFrequency(), 100.0f);
}

TEST_F(FormTest, MoreInfoOpensThePagesAndTheDialogsTopics)
{
    Open("dcm", "t2a250-4");
    auto shownTopic = [] {
        QWidget* help = Gq_HelpViewer::currentWindow();
        auto* browser = help ? help->findChild<QTextBrowser*>("HelpBrowser") : nullptr;
        return browser ? browser->source().fileName() : QString();
    };
    gui_->onMoreInfo();
    EXPECT_EQ(shownTopic(), "tsy_dcmgen.html");
    QString fromDialog;
    whileModal([&] { gui_->onAdvanced(); return 0; },
               [&](QWidget* modal) {
                   Tsy_AdvancedDlgUI* f = advancedForm(modal);
                   ASSERT_NE(f, nullptr);
                   f->PushButtonMoreInfo->click();
                   fromDialog = shownTopic();
                   f->PushButtonCancel->click();
               });
    EXPECT_EQ(fromDialog, "tsy_dcmadv.html");
}

// ------------------------------------------------------- the real window

TEST(GeneralSetupWindow, AnOutOfRangeFrequencyKeepsThePageUntilFixed)
{
    TestDesign d("dcm", "t5da1-1", false);
    d.Instantiate();
    Gq_Wizard window;
    d.Wizard().PrepareGui(&window);
    window.start();
    ASSERT_EQ(window.currentIndex(), 0);
    auto* gui = qobject_cast<Tsy_DCMgenSetupGui*>(window.currentPage());
    ASSERT_NE(gui, nullptr);
    EXPECT_EQ(window.windowTitle(), "Corvane Pendra - General Setup");
    EXPECT_TRUE(window.button(Gq_Wizard::Advanced)->isVisibleTo(&window));
    EXPECT_TRUE(window.button(Gq_Wizard::MoreInfo)->isEnabled());
    Tsy_DCMgenSetupUI_Imp* form = gui->form();
    EXPECT_EQ(form->LineEditFin->text(), "100") << "the default setup";

    float top = d.Wizard().GetSpdDataPtr()->GetSpeedValue("CLKIN_FREQ_DLL_HF_MS_Max");
    retype(form->LineEditFin, QString::number(double(top) + 100));
    d.Stream().Clear();
    window.button(Gq_Wizard::Next)->click();
    EXPECT_EQ(window.currentIndex(), 0) << "the page stays";
    ASSERT_EQ(d.Stream().Errors().size(), 1u);
    EXPECT_EQ(d.Stream().Errors()[0].str().rfind("A valid Input Clock Frequency value is required to continue.", 0),
              0u);
    EXPECT_TRUE(d.Stream().Entries()[0].flag3) << "shown as a range report";
    Tsy_Block* dcm = d.Wizard().GetActiveDCMBlk(1, false);
    EXPECT_EQ(dcm->GetAttributeValue("TESY_ONLY_CLKIN_VALUE").str(), "100") << "nothing stored on a refusal";

    retype(form->LineEditFin, "125");
    d.Stream().Clear();
    window.button(Gq_Wizard::Next)->click();
    EXPECT_EQ(window.currentIndex(), 1) << "the page lets the user on";
    EXPECT_TRUE(d.Stream().Errors().empty());
    EXPECT_EQ(dcm->GetAttributeValue("CLKIN_PERIOD").str(), "8.000");
    EXPECT_EQ(dcm->GetAttributeValue("DLL_FREQUENCY_MODE").str(), "HIGH");

    window.goBack();
    EXPECT_EQ(window.currentIndex(), 0);
    EXPECT_EQ(form->LineEditFin->text(), "125") << "shown again from the block";
}

TEST(GeneralSetupWindow, PagesCarryTheirNeighboursNames)
{
    for (const char* keyword : {"dcm", "dcm_clkswitch", "dcm_cascading"}) {
        TestDesign d(keyword, "t2a250-4", false);
        d.Instantiate();
        Gq_Wizard window;
        d.Wizard().PrepareGui(&window);
        EXPECT_EQ(window.windowTitle(), "Corvane Pendra");
        int general = 0;
        for (int i = 0; i < Tsy_WizMain::kPageSlots && d.Wizard().GetPage(i); ++i) {
            Gq_WizardPage* gui = d.Wizard().GetPage(i)->GetGui();
            if (!gui)
                continue;
            const bool last = !d.Wizard().GetPage(i + 1);
            if (i > 0) {
                EXPECT_EQ(gui->pageBackName().toStdString(), d.Wizard().GetPageName(i - 1).str())
                    << keyword << " " << i;
            }
            EXPECT_EQ(gui->pageNextName().toStdString(), last ? "Summary" : d.Wizard().GetPageName(i + 1).str())
                << keyword << " " << i;
            if (qobject_cast<Tsy_DCMgenSetupGui*>(gui)) {
                ++general;
                EXPECT_EQ(gui->pageName().toStdString(), d.Wizard().GetPageName(i).str());
            }
        }
        EXPECT_EQ(general, std::string(keyword) == "dcm" ? 1 : 2) << keyword;
        ASSERT_GT(window.pageCount(), 0);
        EXPECT_EQ(window.page(window.pageCount() - 1), d.Wizard().GetSummaryPage());
    }
}

TEST(GeneralSetupWindow, NothingIsClippedAndThePicturesAreKept)
{
    // PENDRA_SCREENSHOT_DIR keeps pictures of the page and the dialog.
    const QString shots = qEnvironmentVariable("PENDRA_SCREENSHOT_DIR");
    auto checkFits = [](QWidget* root, const std::string& what) {
        for (QWidget* w : root->findChildren<QWidget*>()) {
            if (!w->isVisibleTo(root) || !(qobject_cast<QLabel*>(w) || qobject_cast<QAbstractButton*>(w)))
                continue;
            EXPECT_GE(w->width(), w->minimumSizeHint().width()) << what << " " << w->objectName().toStdString();
            EXPECT_GE(w->height(), w->minimumSizeHint().height()) << what << " " << w->objectName().toStdString();
            QRect inParent = w->geometry();
            EXPECT_TRUE(w->parentWidget()->rect().contains(inParent)) << what << " " << w->objectName().toStdString();
        }
    };
    struct Case {
        const char* part;
        bool busy; // every pin the symbol can show
    } cases[] = {{"t5da1-1", false}, {"m3e100-4", false}, {"t5da1-1", true}};
    for (const auto& c : cases) {
        const std::string part = std::string(c.part) + (c.busy ? "-busy" : "");
        TestDesign d("dcm", c.part, false);
        d.Instantiate();
        if (c.busy) {
            d.MarkLoaded();
            Tsy_Block* dcm = d.Wizard().GetActiveDCMBlk(1, false);
            dcm->SetAttributeValue("TESY_ONLY_RECONFIG_PINS", "TRUE");
            dcm->SetAttributeValue("CLKOUT_PHASE_SHIFT", "VARIABLE_POSITIVE");
            dcm->SetAttributeValue("CLKIN_DIVIDE_BY_2", "TRUE");
            for (const auto& pin : dcm->Pins())
                if (pin->GetDirection() == "OUT")
                    pin->SetIsActive(true);
        }
        Gq_Wizard window;
        d.Wizard().PrepareGui(&window);
        window.resize(window.minimumSize());
        window.show();
        window.start();
        auto* gui = qobject_cast<Tsy_DCMgenSetupGui*>(window.currentPage());
        ASSERT_NE(gui, nullptr);
        QApplication::processEvents();
        checkFits(gui->form(), part);
        if (c.busy) {
            EXPECT_EQ(gui->form()->symbol().inputs,
                      (QStringList{"CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK", "DADDR[6:0]", "DI[15:0]", "DWE",
                                   "DEN", "DCLK"}));
            EXPECT_EQ(gui->form()->symbol().outputs.size(), 13);
        }
        if (!shots.isEmpty())
            window.grab().save(QDir(shots).filePath(QString("general_setup_%1.png").arg(part.c_str())));
        whileModal([&] { gui->onAdvanced(); return 0; },
                   [&](QWidget* modal) {
                       QApplication::processEvents();
                       checkFits(modal, std::string(part) + " Advanced");
                       if (!shots.isEmpty())
                           modal->grab().save(
                               QDir(shots).filePath(QString("general_setup_advanced_%1.png").arg(part.c_str())));
                       modal->close();
                   });
        window.hide();
    }
}
