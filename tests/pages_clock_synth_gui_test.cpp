// The Clock Frequency Synthesizer page in a wizard window under Qt's
// offscreen platform: entries typed and buttons clicked as a user does, and
// what the form then shows. With PENDRA_SCREENSHOT_DIR set, the window is
// also saved as pictures for a person to look at.

#include "gui/Gq_Wizard.h"
#include "gui/Gq_WizardPage.h"
#include "pages/dcm/Tsy_JitterDlg.h"
#include "pages/dcm/Tsy_JitterDlgGui.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QApplication>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>

#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <memory>

namespace {

// The page the synthesizer page leads to.
class NextProbe : public Gq_WizardPage {
public:
    NextProbe()
    {
        setPageName("Summary");
        setPageWidget(new QLabel("next"));
    }
};

// A wizard window holding the synthesizer page of a design, followed by one
// more page so that Next has somewhere to go.
class Rig {
public:
    Rig(const char* part, const std::function<void(Tsy_Block&)>& setup, const char* keyword = "dcm", int inst = 1)
        : d(keyword, part, false)
    {
        d.MarkLoaded();
        d.Instantiate();
        for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
            if (auto* p = dynamic_cast<Tsy_JitterDlg*>(d.Wizard().GetPage(i)); p && p->GetInstNum() == inst)
                page = p;
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        if (!page || !dcm)
            return;
        dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, "100");
        dcm->SetAttributeValue(Tsy_Attr::TSY_CLK_OUTPUT_TYPE, "DLL_AND_FX");
        dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_VALID_DFS_MODE, "BOTH");
        if (setup)
            setup(*dcm);
        window = std::make_unique<Gq_Wizard>();
        page->CreateGui(window.get());
        gui = dynamic_cast<Tsy_JitterDlgGui*>(page->GetGui());
        if (!gui)
            return;
        window->addPage(gui);
        window->addPage(&after);
        window->show();
        window->activateWindow();
        // Accelerators reach only the active window.
        active = QTest::qWaitForWindowActive(window.get());
        window->start();
    }

    // The form's controls, found by name as a test tool finds them.
    template <typename T>
    T* Find(const char* name)
    {
        T* w = gui->pageWidget() ? gui->pageWidget()->findChild<T*>(name) : nullptr;
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    QLineEdit* Edit(const char* name) { return Find<QLineEdit>(name); }
    QAbstractButton* Button(const char* name) { return Find<QAbstractButton>(name); }
    std::string Label(const char* name)
    {
        QLabel* l = Find<QLabel>(name);
        return l ? l->text().toStdString() : "(missing)";
    }
    std::string EditText(const char* name)
    {
        QLineEdit* e = Edit(name);
        return e ? e->text().toStdString() : "(missing)";
    }
    void Click(QAbstractButton* b) { QTest::mouseClick(b, Qt::LeftButton); }
    void Type(QLineEdit* edit, const char* text)
    {
        edit->selectAll();
        QTest::keyClick(edit, Qt::Key_Delete);
        QTest::keyClicks(edit, text);
    }
    std::string Title() { return window->findChild<QLabel*>("WizardPageTitle")->text().toStdString(); }
    std::vector<StringBase> Errors() { return d.Stream().Errors(); }

    // For a person checking the layout: the window as it looks now.
    void Snap(const char* name)
    {
        const char* dir = std::getenv("PENDRA_SCREENSHOT_DIR");
        if (!dir || !*dir)
            return;
        // Layouts settle on the next turn of the event loop.
        QApplication::processEvents();
        if (dir && *dir)
            window->grab().save(QString("%1/%2.png").arg(dir, name));
    }

    TestDesign d;
    Tsy_JitterDlg* page = nullptr;
    Tsy_JitterDlgGui* gui = nullptr;
    Tsy_Block* dcm = nullptr;
    bool active = false;
    NextProbe after;
    std::unique_ptr<Gq_Wizard> window;
};

// Runs the event loop until the condition holds (an accelerator clicks its
// button a moment after the key), for at most a few seconds.
bool eventually(const std::function<bool()>& condition)
{
    for (int i = 0; i < 250 && !condition(); ++i)
        QTest::qWait(20);
    return condition();
}

} // namespace

TEST(ClockSynthForm, ChoosingMAndDAndCalculatingShowsTheGeneratedOutput)
{
    Rig r("t2a250-4", {});
    ASSERT_NE(r.gui, nullptr);
    EXPECT_FALSE(r.Edit("LineEditM")->isEnabled());
    r.Click(r.Button("RadioButtonMandD"));
    EXPECT_TRUE(r.Edit("LineEditM")->isEnabled());
    EXPECT_FALSE(r.Edit("LineEditFout")->isEnabled());
    r.Type(r.Edit("LineEditM"), "1");
    r.Type(r.Edit("LineEditD"), "3");
    r.Click(r.Button("PushButtonCalculate"));
    EXPECT_TRUE(r.Errors().empty());
    // M = 1 is doubled with D, in the entries and in the result.
    EXPECT_EQ(r.EditText("LineEditM"), "2");
    EXPECT_EQ(r.EditText("LineEditD"), "6");
    EXPECT_EQ(r.Label("TextLabelMValue"), "2");
    EXPECT_EQ(r.Label("TextLabelDValue"), "6");
    EXPECT_EQ(r.Label("TextLabelFoutValue"), "33.3333");
    EXPECT_EQ(r.Label("TextLabelFoutTitle"), "<b>Output<br>Freq (MHz)</b>");
    // J = 6*4/32 + (33.333 - 24)*14/216 + 2 = 3.355 % of a 30 ns period.
    EXPECT_EQ(r.Label("TextLabelPeriodUIValue"), "0.03");
    EXPECT_EQ(r.Label("TextLabelPeriodPk2PkValue"), "1.01");
    r.Snap("clock_synth_m_and_d");
}

TEST(ClockSynthForm, TheEntryShowsTheInputClockAndTheValidRanges)
{
    Rig r("t2a250-4", [](Tsy_Block& b) {
        b.SetAttributeValue(Tsy_Attr::CLKIN_DIVIDE_BY_2, "TRUE");
        b.SetAttributeValue(Tsy_Attr::FOUT_VALUE, "150");
    });
    ASSERT_NE(r.gui, nullptr);
    EXPECT_EQ(r.Title(), "Clock Frequency Synthesizer");
    EXPECT_EQ(r.Label("TextLabelInputFrequency"), "Input Clock Frequency:");
    EXPECT_EQ(r.Label("TextLabelFinDivBy2"), "100 MHz => divided by 2 = 50.000 MHz");
    EXPECT_EQ(r.Find<QGroupBox>("GroupBoxRangeTable")->title().toStdString(), "Valid Ranges for Speed Grade -4");
    EXPECT_EQ(r.Label("TextLabelFinRangeTitle"), "<b>Fin (MHz)</b>");
    EXPECT_EQ(r.Label("TextLabelLfFinValue"), "1.000 - 210.000");
    EXPECT_EQ(r.Label("TextLabelHfFinValue"), "50.000 - 420.000");
    EXPECT_EQ(r.Label("TextLabelLfFoutValue"), "24.000 - 210.000");
    EXPECT_EQ(r.Label("TextLabelHfFoutValue"), "210.000 - 420.000");
    // Loading calculated already: 150 / 50 = 3 / 1.
    EXPECT_EQ(r.Label("TextLabelMValue"), "3");
    EXPECT_EQ(r.Label("TextLabelDValue"), "1");
    EXPECT_TRUE(r.window->button(Gq_Wizard::MoreInfo)->isVisible());
    EXPECT_FALSE(r.window->button(Gq_Wizard::Advanced)->isVisible());
    r.Snap("clock_synth_entry");
}

TEST(ClockSynthForm, OutputInNanosecondsTurnsTheEntryAndTheTableIntoPeriods)
{
    Rig r("t2a250-4", [](Tsy_Block& b) { b.SetAttributeValue(Tsy_Attr::FOUT_VALUE, "200"); });
    ASSERT_NE(r.gui, nullptr);
    r.Click(r.Button("RadioButtonFoutNs"));
    EXPECT_EQ(r.EditText("LineEditFout"), "5");
    EXPECT_EQ(r.Label("TextLabelFoutRangeTitle"), "<b>Fout (ns)</b>");
    EXPECT_EQ(r.Label("TextLabelLfFoutValue"), "4.762 - 41.667");
    EXPECT_EQ(r.Label("TextLabelFoutTitle"), "<b>Output<br>Freq (ns)</b>");
    EXPECT_EQ(r.Label("TextLabelFoutValue"), "5");
    r.Click(r.Button("RadioButtonFoutMhz"));
    EXPECT_EQ(r.EditText("LineEditFout"), "200");
    EXPECT_EQ(r.Label("TextLabelFoutValue"), "200");
}

TEST(ClockSynthForm, RefusalsSayWhyAndNextStoresOnceTheEntryIsSound)
{
    Rig r("t2a250-4", {});
    ASSERT_NE(r.gui, nullptr);
    r.Click(r.Button("RadioButtonMandD"));
    r.Type(r.Edit("LineEditM"), "40");
    r.Click(r.Button("PushButtonCalculate"));
    ASSERT_EQ(r.Errors().size(), 1u);
    EXPECT_EQ(r.Errors()[0], "The Multiply (M) value must be within the range 2 - 32.  Please choose a new value.");
    EXPECT_EQ(r.Label("TextLabelMValue"), "-");
    EXPECT_EQ(r.Label("TextLabelPeriodUIValue"), "-");

    r.d.Stream().Clear();
    r.Click(r.Button("RadioButtonFout"));
    r.Type(r.Edit("LineEditFout"), "33.3");
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentIndex(), 0);
    ASSERT_EQ(r.Errors().size(), 1u);
    EXPECT_NE(r.Errors()[0].str().find("generates the value M = 33."), std::string::npos);

    r.Type(r.Edit("LineEditFout"), "150");
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentIndex(), 1);
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::CLKFX_MULTIPLY), "3");
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::CLKFX_DIVIDE), "2");
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::FOUT_VALUE), "150");
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::JITTER_INPUT_TYPE), "FOUT_STR");
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::M_VALUE), "40");
}

TEST(ClockSynthForm, EntriesTakeOnlyNumbersAndAcceleratorsChooseTheInput)
{
    Rig r("t2a250-4", {});
    ASSERT_NE(r.gui, nullptr);
    ASSERT_TRUE(r.active);
    r.Type(r.Edit("LineEditFout"), "1a2.5x.3");
    EXPECT_EQ(r.EditText("LineEditFout"), "12.53");
    QTest::keyClick(r.window.get(), Qt::Key_S, Qt::AltModifier);
    EXPECT_TRUE(eventually([&] { return r.Edit("LineEditM")->isEnabled(); }));
    EXPECT_TRUE(r.Button("RadioButtonMandD")->isChecked());
    r.Type(r.Edit("LineEditM"), "12345");
    EXPECT_EQ(r.EditText("LineEditM"), "123");
    QTest::keyClick(r.window.get(), Qt::Key_U, Qt::AltModifier);
    EXPECT_TRUE(eventually([&] { return r.Edit("LineEditFout")->isEnabled(); }));
    r.Type(r.Edit("LineEditFout"), "125");
    QTest::keyClick(r.window.get(), Qt::Key_N, Qt::AltModifier);
    EXPECT_TRUE(eventually([&] { return r.EditText("LineEditFout") == "8"; }));
    EXPECT_TRUE(r.Button("RadioButtonFoutNs")->isChecked());
    EXPECT_EQ(r.window->currentIndex(), 0);
}

TEST(ClockSynthForm, CaptionsFollowTheWizardType)
{
    struct Case {
        const char* keyword;
        int inst;
        const char* title;
        const char* ui;
        const char* pk2pk;
    } cases[] = {
        {"dcm", 1, "Clock Frequency Synthesizer", "<b>Period Jitter<br>(unit interval)</b>",
         "<b>Period Jitter<br>(pk-to-pk ns)</b>"},
        {"dcm_dcm2pll", 1, "Clock Frequency Synthesizer", "<b>Period Jitter Before PLL Filter (unit interval)</b>",
         "<b>Period Jitter Before PLL Filter (pk-to-pk ns)</b>"},
        {"dcm_pll2dcm", 1, "Clock Frequency Synthesizer", "<b>Period Jitter After PLL Filter (unit interval)</b>",
         "<b>Period Jitter After PLL Filter (pk-to-pk ns)</b>"},
        {"dcm_bddeskew", 2, "Clock Frequency Synthesizer for INST2", "<b>Period Jitter<br>(unit interval)</b>",
         "<b>Period Jitter<br>(pk-to-pk ns)</b>"},
        {"dcm_cascading", 1, "Clock Frequency Synthesizer for INST1", "<b>Period Jitter<br>(unit interval)</b>",
         "<b>Period Jitter<br>(pk-to-pk ns)</b>"},
    };
    for (const auto& c : cases) {
        Rig r("t5da1-1", {}, c.keyword, c.inst);
        ASSERT_NE(r.gui, nullptr) << c.keyword;
        EXPECT_EQ(r.Title(), c.title) << c.keyword;
        EXPECT_EQ(r.gui->pageWidget()->windowTitle().toStdString(), std::string("Corvane Pendra - ") + c.title);
        EXPECT_EQ(r.Label("TextLabelPeriodUITitle"), c.ui) << c.keyword;
        EXPECT_EQ(r.Label("TextLabelPeriodPk2PkTitle"), c.pk2pk) << c.keyword;
        // The newest families show the figures to the nanosecond's thousandth.
        EXPECT_EQ(r.Label("TextLabelPeriodPk2PkValue").size(), 5) << c.keyword;
        if (std::string(c.keyword) == "dcm_dcm2pll")
            r.Snap("clock_synth_dcm2pll");
    }
}
