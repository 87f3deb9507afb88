// General Setup as the user works it under the offscreen platform: the form
// filled from the block and kept by its rules, the keyboard, the Advanced
// dialog, and the page inside the real wizard window.

#include "Tsy_AdvancedDlgUI.h"
#include "Tsy_DCMgenSetupUI_Imp.h"
#include "gui/Gq_HelpViewer.h"
#include "pages/dcm/Tsy_AdvancedDlgGui.h"
#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "pages/dcm/Tsy_DCMgenSetupGui.h"
#include "support/GuiTest.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_SpeedData.h"

#include <QApplication>
#include <QPushButton>
#include <QTest>
#include <QTextBrowser>

#include <gtest/gtest.h>

#include <memory>

namespace {

using Page = Tsy_DCMgenSetup;

QStringList strings(const Tsy_StrArray& list)
{
    QStringList out;
    for (const auto& s : list.Items())
        out << QString::fromStdString(s.str());
    return out;
}

// The page of one instance with its controller and form, shown once.
class FormTest : public ::testing::Test {
protected:
    void Open(const char* keyword, const char* part, int inst = 1,
              const std::function<void(Tsy_Block*)>& before = {})
    {
        design_ = std::make_unique<TestDesign>(keyword, part, false);
        design_->MarkLoaded();
        design_->Instantiate();
        page_ = FindPage<Page>(design_->Wizard(), inst);
        ASSERT_NE(page_, nullptr);
        block_ = design_->Wizard().GetActiveDCMBlk(inst, false);
        if (before)
            before(block_);
        ASSERT_TRUE(page_->CreateGui(nullptr));
        gui_ = static_cast<Tsy_DCMgenSetupGui*>(page_->GetGui());
        form_ = gui_->form();
        gui_->onActive();
        design_->Stream().Clear();
    }
    std::vector<std::string> Notes() { return Texts(design_->Stream().Notes()); }
    std::string Attr(const char* name) { return block_->GetAttributeValue(name).str(); }
    // Runs the Advanced dialog, handing its form to the steps.
    void Advanced(const std::function<void(Tsy_AdvancedDlgUI*)>& steps)
    {
        WhileModal([&] { return gui_->onAdvanced(), 0; },
                   [&](QWidget* modal) {
                       auto* dialog = qobject_cast<Tsy_AdvancedDlgGui*>(modal);
                       ASSERT_NE(dialog, nullptr) << "the Advanced dialog is the modal window";
                       steps(dialog->form());
                   });
    }
    void PickPsType(const char* type)
    {
        form_->ComboBoxPsType->setCurrentText(type);
        emit form_->ComboBoxPsType->activated(form_->ComboBoxPsType->currentIndex());
    }

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
        const char *part, *primitive, *statusBox;
        bool twoXOffered;
    } cases[] = {{"t5da1-1", "DCM_ADV", "DO", false},
                 {"m3e100-4", "DCM_SP", "STATUS", true},
                 {"t2a250-4", "DCM", "STATUS", true},
                 {"t2p7-5", "DCM", "STATUS", false}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.part);
        Open("dcm", c.part, 1, [](Tsy_Block* b) {
            b->SetAttributeValue("TESY_ONLY_CLKIN_VALUE", "125.5");
            b->SetAttributeValue("CLKDV_DIVIDE", "4.0");
            b->GetNamedPin("CLK90")->SetIsActive(true);
        });
        EXPECT_EQ(form_->LineEditFin->text(), "125.5");
        EXPECT_TRUE(form_->CheckBoxCLK90->isChecked());
        EXPECT_TRUE(form_->CheckBoxCLK0->isChecked()) << "the internal loop's output";
        EXPECT_FALSE(form_->CheckBoxCLK0->isEnabled()) << "cannot be deselected";
        EXPECT_EQ(form_->ComboBoxDivideByValue->currentText(), "4.0");
        EXPECT_EQ(Items(form_->ComboBoxPsType), strings(page_->GetDcmValueList(Page::ListPhaseShift)));
        EXPECT_EQ(Items(form_->ComboBoxDivideByValue), strings(page_->GetDcmValueList(Page::ListClkdvDivide)));
        EXPECT_EQ(form_->CheckBoxDO->text(), c.statusBox);
        EXPECT_EQ(form_->RadioFb2x->isEnabled(), c.twoXOffered);
        EXPECT_TRUE(form_->CheckBoxPmcd->isHidden());
        EXPECT_EQ(form_->symbol().primitive, c.primitive);
        EXPECT_EQ(form_->symbol().outputs, (QStringList{"CLK0", "CLK90", "LOCKED"}));
        EXPECT_EQ(form_->symbol().inputs, (QStringList{"CLKIN", "CLKFB", "RST"}));
    }
    EXPECT_EQ(form_->windowTitle(), "Corvane Pendra - General Setup");
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
    PickPsType("FIXED");
    EXPECT_TRUE(form_->SpinBoxPsValue->isEnabled());
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-255 to 255");
    EXPECT_FALSE(form_->symbol().inputs.contains("PSEN")) << "a fixed shift needs no shift pins";
    Retype(form_->LineEditFin, "30");
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-76 to 76");
    EXPECT_EQ(form_->SpinBoxPsValue->maximum(), 76);
    form_->SpinBoxPsValue->setValue(100);
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 76);
    EXPECT_EQ(form_->TextLabelPsValueNs->text(), "9.896 ns");
    EXPECT_EQ(form_->TextLabelPsValueDegrees->text(), "106.875 Degrees");
    PickPsType("VARIABLE");
    EXPECT_EQ(form_->TextLabelPsRange->text(), "-38 to 38");
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 38);
    EXPECT_EQ(form_->TextLabelPsValueDegrees->text(), "53.438 Degrees");
    EXPECT_EQ(form_->symbol().inputs, (QStringList{"CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK"}));
    EXPECT_TRUE(form_->symbol().outputs.contains("PSDONE"));

    // Typing a frequency anew neither loses the phase shift while the field
    // is empty nor while the limits narrow on the way.
    Retype(form_->LineEditFin, "");
    EXPECT_FALSE(form_->GroupBoxPs->isEnabled());
    QTest::keyClick(form_->LineEditFin, Qt::Key_3);
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 3);
    QTest::keyClick(form_->LineEditFin, Qt::Key_0);
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(form_->ComboBoxPsType->currentText(), "VARIABLE");
    EXPECT_EQ(form_->SpinBoxPsValue->value(), 38);

    design_->Stream().Clear();
    form_->CheckBoxRST->click();
    EXPECT_EQ(Notes(), std::vector<std::string>{"RST has been deselected.  With RST deselected, the DCM can only be "
                                                "reset upon configuration."});
    EXPECT_FALSE(form_->symbol().inputs.contains("RST"));

    ASSERT_TRUE(gui_->onNext());
    EXPECT_EQ(Attr("CLKOUT_PHASE_SHIFT"), "VARIABLE");
    EXPECT_EQ(Attr("PHASE_SHIFT"), "38");
    EXPECT_EQ(Attr("CLKIN_PERIOD"), "33.333");
    EXPECT_FALSE(block_->GetNamedPin("RST")->IsActive());
    EXPECT_TRUE(block_->GetNamedPin("PSEN")->IsActive());
}

TEST_F(FormTest, HighFrequencyModeTurnsThePhaseShiftOffOnMembra3)
{
    Open("dcm", "m3s200-4", 1, [](Tsy_Block* b) {
        b->SetAttributeValue("CLKOUT_PHASE_SHIFT", "FIXED");
        b->SetAttributeValue("PHASE_SHIFT", "10");
    });
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    float hfMax = design_->Wizard().GetSpdDataPtr()->GetSpeedValue("CLKIN_FREQ_DLL_HF_Max");
    Retype(form_->LineEditFin, QString::number(double(hfMax)));
    EXPECT_EQ(Notes(), std::vector<std::string>{"Fixed or Variable phase shifting is not supported when the DFS/DLL "
                                                "frequency mode is set to high.  The phase shift will automatically be "
                                                "set to 'None'."});
    EXPECT_FALSE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(form_->ComboBoxPsType->currentText(), "NONE");
    Retype(form_->LineEditFin, "100");
    EXPECT_TRUE(form_->GroupBoxPs->isEnabled());
    EXPECT_EQ(Notes().size(), 1u) << "said once";
}

TEST_F(FormTest, ApplicationsFixWhatTheyReserve)
{
    Open("dcm_clkswitch", "t2a250-4", 1,
         [](Tsy_Block* b) { b->SetAttributeValue("TESY_ONLY_DCM_SWITCHING_CLK", "CLK90"); });
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
    EXPECT_EQ(form_->windowTitle(), "Corvane Pendra - General Setup for INST2");

    Open("dcm", "t4a25-10", 1, [](Tsy_Block* b) { b->SetAttributeValue("TESY_ONLY_PMCD", "NONE"); });
    ASSERT_FALSE(form_->CheckBoxPmcd->isHidden());
    EXPECT_TRUE(form_->CheckBoxRST->isEnabled());
    form_->CheckBoxPmcd->click();
    EXPECT_TRUE(form_->CheckBoxRST->isChecked());
    EXPECT_FALSE(form_->CheckBoxRST->isEnabled()) << "the PMCDs are released from the DCM's reset";
}

TEST_F(FormTest, FrequencyFieldTakesDecimalsOnly)
{
    Open("dcm", "t5da1-1");
    Retype(form_->LineEditFin, "1a2.5.7e-");
    EXPECT_EQ(form_->LineEditFin->text(), "12.57");
    EXPECT_FLOAT_EQ(page_->GetInputFrequency(), 12.57f);
}

TEST_F(FormTest, KeyboardReachesEveryChoiceInLayoutOrder)
{
    Open("dcm", "t2a250-4");
    ASSERT_TRUE(ShowAndActivate(form_));
    // A button's accelerator presses it the way a click does, a moment later.
    auto press = [this](Qt::Key key, QAbstractButton* button, bool checked) {
        QTest::keyClick(form_, key, Qt::AltModifier);
        EXPECT_TRUE(Eventually([&] { return button->isChecked() == checked; })) << button->objectName().toStdString();
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

    const QStringList expected =
        QString("CheckBoxRST CheckBoxCLK0 CheckBoxCLK90 CheckBoxCLK180 CheckBoxCLK270 CheckBoxCLKDV CheckBoxCLK2X "
                "CheckBoxCLK2X180 CheckBoxCLKFX CheckBoxCLKFX180 CheckBoxDO CheckBoxLOCKED LineEditFin RadioFinMhz "
                "RadioFinNs RadioClkinExternal RadioClkinSingle RadioClkinDifferential RadioClkinInternal "
                "RadioFbExternal RadioFbSingle RadioFbDifferential RadioFbInternal RadioFbNone ComboBoxPsType "
                "SpinBoxPsValue ComboBoxDivideByValue RadioFb1x RadioFb2x CheckBoxDutyCycle CheckBoxPmcd")
            .split(' ');
    QStringList chain;
    QWidget* w = form_->CheckBoxRST;
    do {
        if (expected.contains(w->objectName()) && !chain.contains(w->objectName()))
            chain << w->objectName();
        w = w->nextInFocusChain();
    } while (w != form_->CheckBoxRST && chain.size() < expected.size());
    EXPECT_EQ(chain, expected);
    form_->hide();
}

// ----------------------------------------------------------------- Advanced

TEST_F(FormTest, AdvancedCopiesInTheSettingsByTheFamilysRules)
{
    struct Case {
        const char* part;
        bool rst, gen45;
    } cases[] = {{"t5da1-1", true, true}, {"t5da1-1", false, true}, {"m3e100-4", true, false}};
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.part) + (c.rst ? " with RST" : " without RST"));
        Open("dcm", c.part, 1, [&c](Tsy_Block* b) {
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
        EXPECT_EQ(Items(f->ComboBoxDeskewAdjust), strings(page_->GetDcmValueList(Page::ListDeskewAdjust)));
        EXPECT_EQ(f->ComboBoxDeskewAdjust->currentText(), "SOURCE_SYNCHRONOUS");
        EXPECT_TRUE(f->CheckBoxStartupWait->isChecked());
        EXPECT_EQ(f->CheckBoxResetLogic->isEnabled(), c.rst);
        EXPECT_EQ(f->CheckBoxResetLogic->isChecked(), c.rst);
        EXPECT_EQ(page_->GetSettings().resetLogic, c.rst) << "without RST the page's reset logic is off";
        for (QWidget* w : std::initializer_list<QWidget*>{f->CheckBoxReconfigPins, f->RadioMaxSpeed, f->RadioMaxRange}) {
            EXPECT_EQ(w->isHidden(), !c.gen45) << w->objectName().toStdString();
            EXPECT_EQ(w->isEnabled(), c.gen45) << w->objectName().toStdString();
        }
        EXPECT_TRUE(!c.gen45 || f->RadioMaxSpeed->isChecked());
    }
}

TEST_F(FormTest, AdvancedOkHandsBackWithItsNotesAndTheFiguresFollow)
{
    Open("dcm", "t5da1-1");
    ASSERT_FLOAT_EQ(page_->GetInputFrequency(), 100.0f);
    Advanced([](Tsy_AdvancedDlgUI* f) {
        f->ComboBoxDeskewAdjust->setCurrentText("5");
        f->CheckBoxStartupWait->click();
        f->CheckBoxDivideBy2->click();
        f->CheckBoxReconfigPins->click();
        f->RadioMaxRange->click();
        f->PushButtonOk->click();
    });
    EXPECT_EQ(Notes(), (std::vector<std::string>{
                           "Choosing a value other than SOURCE_SYNCHRONOUS or SYSTEM_SYNCHRONOUS may lead to unusual "
                           "timing relationships and should only be attempted after consulting with Corvane.",
                           "In addition to setting STARTUP_WAIT, the LCK_cycle Forgeon option is required.  The "
                           "configuration startup sequence will wait in the specified LCK_cycle until the DCM locks."}));
    const Page::Settings& s = page_->GetSettings();
    EXPECT_EQ(s.deskewAdjust.str(), "5");
    EXPECT_TRUE(s.startupWait && s.divideBy2 && s.reconfigPins);
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
    Advanced([](Tsy_AdvancedDlgUI* f) {
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
    Advanced([&](Tsy_AdvancedDlgUI* f) {
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
    auto* gui = qobject_cast<Tsy_DCMgenSetupGui*>(window.currentPage());
    ASSERT_NE(gui, nullptr);
    EXPECT_EQ(window.windowTitle(), "Corvane Pendra - General Setup");
    EXPECT_TRUE(window.button(Gq_Wizard::Advanced)->isVisibleTo(&window));
    EXPECT_TRUE(window.button(Gq_Wizard::MoreInfo)->isEnabled());
    Tsy_DCMgenSetupUI_Imp* form = gui->form();
    EXPECT_EQ(form->LineEditFin->text(), "100") << "the default setup";
    Tsy_Block* dcm = d.Wizard().GetActiveDCMBlk(1, false);

    float top = d.Wizard().GetSpdDataPtr()->GetSpeedValue("CLKIN_FREQ_DLL_HF_MS_Max");
    Retype(form->LineEditFin, QString::number(double(top) + 100));
    d.Stream().Clear();
    window.button(Gq_Wizard::Next)->click();
    EXPECT_EQ(window.currentIndex(), 0) << "the page stays";
    ASSERT_EQ(d.Stream().Errors().size(), 1u);
    EXPECT_EQ(d.Stream().Errors()[0].str().rfind("A valid Input Clock Frequency value is required to continue.", 0),
              0u);
    EXPECT_TRUE(d.Stream().Entries()[0].flag3) << "shown as a range report";
    EXPECT_EQ(dcm->GetAttributeValue("TESY_ONLY_CLKIN_VALUE").str(), "100") << "nothing stored on a refusal";

    Retype(form->LineEditFin, "125");
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
        SCOPED_TRACE(keyword);
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
            EXPECT_EQ(gui->pageBackName().toStdString(), i > 0 ? d.Wizard().GetPageName(i - 1).str() : "") << i;
            EXPECT_EQ(gui->pageNextName().toStdString(), last ? "Summary" : d.Wizard().GetPageName(i + 1).str()) << i;
            if (qobject_cast<Tsy_DCMgenSetupGui*>(gui)) {
                ++general;
                EXPECT_EQ(gui->pageName().toStdString(), d.Wizard().GetPageName(i).str());
            }
        }
        EXPECT_EQ(general, std::string(keyword) == "dcm" ? 1 : 2);
        ASSERT_GT(window.pageCount(), 0);
        EXPECT_EQ(window.page(window.pageCount() - 1), d.Wizard().GetSummaryPage());
    }
}

TEST(GeneralSetupWindow, NothingIsClippedAndThePicturesAreKept)
{
    // PENDRA_SCREENSHOT_DIR keeps pictures of the page and the dialog.
    auto checkFits = [](QWidget* root) {
        for (QWidget* w : root->findChildren<QWidget*>()) {
            if (!w->isVisibleTo(root) || !(qobject_cast<QLabel*>(w) || qobject_cast<QAbstractButton*>(w)))
                continue;
            SCOPED_TRACE(w->objectName().toStdString());
            EXPECT_GE(w->width(), w->minimumSizeHint().width());
            EXPECT_GE(w->height(), w->minimumSizeHint().height());
            EXPECT_TRUE(w->parentWidget()->rect().contains(w->geometry()));
        }
    };
    struct Case {
        const char* part;
        bool busy; // every pin the symbol can show
    } cases[] = {{"t5da1-1", false}, {"m3e100-4", false}, {"t5da1-1", true}};
    for (const auto& c : cases) {
        const QString name = QString(c.part) + (c.busy ? "-busy" : "");
        SCOPED_TRACE(name.toStdString());
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
        checkFits(gui->form());
        if (c.busy) {
            EXPECT_EQ(gui->form()->symbol().inputs, (QStringList{"CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK",
                                                                 "DADDR[6:0]", "DI[15:0]", "DWE", "DEN", "DCLK"}));
            EXPECT_EQ(gui->form()->symbol().outputs.size(), 13);
        }
        Snap(&window, "general_setup_" + name);
        WhileModal([&] { return gui->onAdvanced(), 0; },
                   [&](QWidget* modal) {
                       QApplication::processEvents();
                       checkFits(modal);
                       Snap(modal, "general_setup_advanced_" + name);
                       modal->close();
                   });
        window.hide();
    }
}
