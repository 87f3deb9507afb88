// The Clock Frequency Synthesizer page in a wizard window under Qt's
// offscreen platform: entries typed and buttons clicked as a user does, and
// what the form then shows. With PENDRA_SCREENSHOT_DIR set, the window is
// also saved as pictures for a person to look at.

#include "pages/dcm/Tsy_JitterDlg.h"
#include "pages/dcm/Tsy_JitterDlgGui.h"
#include "support/GuiTest.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QTest>

#include <gtest/gtest.h>

#include <memory>

namespace {

// A wizard window holding the synthesizer page of a design whose DCM runs at
// 100 MHz with both output groups, as General Setup leaves it.
class Rig {
public:
    Rig(const char* part, const std::function<void(Tsy_Block&)>& setup, const char* keyword = "dcm", int inst = 1)
        : d(keyword, part, false)
    {
        d.MarkLoaded();
        d.Instantiate();
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, "100");
        dcm->SetAttributeValue(Tsy_Attr::TSY_CLK_OUTPUT_TYPE, "DLL_AND_FX");
        dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_VALID_DFS_MODE, "BOTH");
        if (setup)
            setup(*dcm);
        w = std::make_unique<PageWindow>(FindPage<Tsy_JitterDlg>(d.Wizard(), inst));
        gui = w->gui;
    }

    QLineEdit* Edit(const char* name) { return Named<QLineEdit>(gui->pageWidget(), name); }
    QAbstractButton* Button(const char* name) { return Named<QAbstractButton>(gui->pageWidget(), name); }
    std::string Label(const char* name)
    {
        QLabel* l = Named<QLabel>(gui->pageWidget(), name);
        return l ? l->text().toStdString() : "(missing)";
    }
    std::string EditText(const char* name) { return Edit(name)->text().toStdString(); }
    void Click(QAbstractButton* b) { QTest::mouseClick(b, Qt::LeftButton); }
    void Next() { Click(w->window.button(Gq_Wizard::Next)); }
    std::string Title() { return w->window.findChild<QLabel*>("WizardPageTitle")->text().toStdString(); }
    std::vector<std::string> Errors() { return Texts(d.Stream().Errors()); }

    TestDesign d;
    Tsy_Block* dcm = nullptr;
    std::unique_ptr<PageWindow> w;
    Gq_WizardPage* gui = nullptr;
};

} // namespace

TEST(ClockSynthForm, ChoosingMAndDAndCalculatingShowsTheGeneratedOutput)
{
    Rig r("t2a250-4", {});
    ASSERT_NE(r.gui, nullptr);
    EXPECT_FALSE(r.Edit("LineEditM")->isEnabled());
    r.Click(r.Button("RadioButtonMandD"));
    EXPECT_TRUE(r.Edit("LineEditM")->isEnabled());
    EXPECT_FALSE(r.Edit("LineEditFout")->isEnabled());
    Retype(r.Edit("LineEditM"), "1");
    Retype(r.Edit("LineEditD"), "3");
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
    Snap(&r.w->window, "clock_synth_m_and_d");
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
    EXPECT_EQ(Named<QGroupBox>(r.gui->pageWidget(), "GroupBoxRangeTable")->title().toStdString(), "Valid Ranges for Speed Grade -4");
    EXPECT_EQ(r.Label("TextLabelFinRangeTitle"), "<b>Fin (MHz)</b>");
    EXPECT_EQ(r.Label("TextLabelLfFinValue"), "1.000 - 210.000");
    EXPECT_EQ(r.Label("TextLabelHfFinValue"), "50.000 - 420.000");
    EXPECT_EQ(r.Label("TextLabelLfFoutValue"), "24.000 - 210.000");
    EXPECT_EQ(r.Label("TextLabelHfFoutValue"), "210.000 - 420.000");
    // Loading calculated already: 150 / 50 = 3 / 1.
    EXPECT_EQ(r.Label("TextLabelMValue"), "3");
    EXPECT_EQ(r.Label("TextLabelDValue"), "1");
    EXPECT_TRUE(r.w->window.button(Gq_Wizard::MoreInfo)->isVisible());
    EXPECT_FALSE(r.w->window.button(Gq_Wizard::Advanced)->isVisible());
    Snap(&r.w->window, "clock_synth_entry");
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
    Retype(r.Edit("LineEditM"), "40");
    r.Click(r.Button("PushButtonCalculate"));
    EXPECT_EQ(r.Errors(),
              std::vector<std::string>{"The Multiply (M) value must be within the range 2 - 32.  Please choose a new "
                                       "value."});
    EXPECT_EQ(r.Label("TextLabelMValue"), "-");
    EXPECT_EQ(r.Label("TextLabelPeriodUIValue"), "-");

    r.d.Stream().Clear();
    r.Click(r.Button("RadioButtonFout"));
    Retype(r.Edit("LineEditFout"), "33.3");
    r.Next();
    EXPECT_EQ(r.w->window.currentIndex(), 0);
    ASSERT_EQ(r.Errors().size(), 1u);
    EXPECT_NE(r.Errors()[0].find("generates the value M = 33."), std::string::npos);

    Retype(r.Edit("LineEditFout"), "150");
    r.Next();
    EXPECT_EQ(r.w->window.currentIndex(), 1);
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
    ASSERT_TRUE(r.w->active);
    Retype(r.Edit("LineEditFout"), "1a2.5x.3");
    EXPECT_EQ(r.EditText("LineEditFout"), "12.53");
    QTest::keyClick(&r.w->window, Qt::Key_S, Qt::AltModifier);
    EXPECT_TRUE(Eventually([&] { return r.Edit("LineEditM")->isEnabled(); }));
    EXPECT_TRUE(r.Button("RadioButtonMandD")->isChecked());
    Retype(r.Edit("LineEditM"), "12345");
    EXPECT_EQ(r.EditText("LineEditM"), "123");
    QTest::keyClick(&r.w->window, Qt::Key_U, Qt::AltModifier);
    EXPECT_TRUE(Eventually([&] { return r.Edit("LineEditFout")->isEnabled(); }));
    Retype(r.Edit("LineEditFout"), "125");
    QTest::keyClick(&r.w->window, Qt::Key_N, Qt::AltModifier);
    EXPECT_TRUE(Eventually([&] { return r.EditText("LineEditFout") == "8"; }));
    EXPECT_TRUE(r.Button("RadioButtonFoutNs")->isChecked());
    EXPECT_EQ(r.w->window.currentIndex(), 0);
}

TEST(ClockSynthForm, CaptionsFollowTheWizardType)
{
    struct Case {
        const char* keyword;
        int inst;
        const char *title, *jitter; // the jitter captions read "<b>Period Jitter" + jitter + "(unit interval)</b>"
    } cases[] = {
        {"dcm", 1, "Clock Frequency Synthesizer", "<br>"},
        {"dcm_dcm2pll", 1, "Clock Frequency Synthesizer", " Before PLL Filter "},
        {"dcm_pll2dcm", 1, "Clock Frequency Synthesizer", " After PLL Filter "},
        {"dcm_bddeskew", 2, "Clock Frequency Synthesizer for INST2", "<br>"},
        {"dcm_cascading", 1, "Clock Frequency Synthesizer for INST1", "<br>"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.keyword);
        Rig r("t5da1-1", {}, c.keyword, c.inst);
        ASSERT_NE(r.gui, nullptr);
        EXPECT_EQ(r.Title(), c.title);
        EXPECT_EQ(r.gui->pageWidget()->windowTitle().toStdString(), std::string("Corvane Pendra - ") + c.title);
        EXPECT_EQ(r.Label("TextLabelPeriodUITitle"), std::string("<b>Period Jitter") + c.jitter + "(unit interval)</b>");
        EXPECT_EQ(r.Label("TextLabelPeriodPk2PkTitle"), std::string("<b>Period Jitter") + c.jitter + "(pk-to-pk ns)</b>");
        // The newest families show the figures to the nanosecond's thousandth.
        EXPECT_EQ(r.Label("TextLabelPeriodPk2PkValue").size(), 5);
        if (std::string(c.keyword) == "dcm_dcm2pll")
            Snap(&r.w->window, "clock_synth_dcm2pll");
    }
}
