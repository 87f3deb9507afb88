// The Clock Buffers page and the View/Edit Buffer dialog in a wizard window
// under Qt's offscreen platform: radio buttons, combo boxes and buttons
// clicked as a user does, and what the rows, the dialog and the pins then
// show. With PENDRA_SCREENSHOT_DIR set, the window and the dialog are also
// saved as pictures for a person to look at.

#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "pages/dcm/Tsy_EditBufDlgGui.h"
#include "support/GuiTest.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QApplication>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QTest>
#include <QTimer>
#include <QWindow>

#include <gtest/gtest.h>

#include <memory>

namespace {

// A wizard window holding the Clock Buffers page of a design whose DCM has
// exactly these outputs, as General Setup leaves them.
class Rig {
public:
    Rig(const char* part, std::initializer_list<const char*> outputs, const char* useBufg,
        const std::function<void(Tsy_Block&)>& setup = {}, const char* keyword = "dcm", int inst = 1)
        : d(keyword, part, false)
    {
        d.MarkLoaded();
        d.Configure([](Tsy_WizContext& c) { c.designVersion = "1.0.0"; });
        d.Instantiate();
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        for (const char* o : {"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"})
            dcm->GetNamedPin(o)->SetIsActive(false);
        for (const char* o : outputs)
            dcm->GetNamedPin(o)->SetIsActive(true);
        dcm->SetAttributeValue(Tsy_Attr::FB_SOURCE, "INTERNAL");
        dcm->SetAttributeValue(Tsy_Attr::CLK_FEEDBACK, "1X");
        dcm->SetAttributeValue(Tsy_Attr::USE_BUFG, useBufg);
        if (setup)
            setup(*dcm);
        auto* page = FindPage<Tsy_ClockBufDlg>(d.Wizard(), inst);
        w = std::make_unique<PageWindow>(page);
        gui = dynamic_cast<Tsy_ClockBufDlgGui*>(w->gui);
        EXPECT_TRUE(gui && w->active);
    }

    template <typename T>
    T* Find(const QString& name)
    {
        return Named<T>(gui->pageWidget(), name);
    }
    QLabel* I0(int r) { return Find<QLabel>(QString("TextLabelPinI0Row%1").arg(r)); }
    QPushButton* Edit(int r) { return Find<QPushButton>(QString("PushButtonEditRow%1").arg(r)); }
    QPushButton* AddBuf() { return Find<QPushButton>("PushButtonAddBuf"); }
    void Click(QAbstractButton* b)
    {
        // Radio buttons are clicked on their indicator, buttons in the middle.
        QPoint at = qobject_cast<QRadioButton*>(b) ? QPoint(8, b->height() / 2) : b->rect().center();
        QTest::mouseClick(b, Qt::LeftButton, Qt::KeyboardModifiers(), at);
    }
    void Next() { Click(w->window.button(Gq_Wizard::Next)); }
    std::string Record(const char* pin, const char* attr) { return dcm->GetNamedPin(pin)->GetAttributeValue(attr).str(); }
    std::vector<std::string> Errors() { return Texts(d.Stream().Errors()); }
    std::vector<std::string> Notes() { return Texts(d.Stream().Notes()); }

    // Does what the steps do in the dialog the next click opens; whatever
    // the steps leave, the dialog is closed afterwards so the test goes on.
    void InDialog(const std::function<void(Tsy_EditBufDlgGui&)>& steps)
    {
        QTimer::singleShot(0, [this, steps] {
            Tsy_EditBufDlgGui* dlg = gui->EditDialog();
            ASSERT_NE(dlg, nullptr);
            ASSERT_TRUE(dlg->isVisible());
            steps(*dlg);
            if (dlg->isVisible())
                dlg->reject();
        });
    }

    TestDesign d;
    Tsy_Block* dcm = nullptr;
    std::unique_ptr<PageWindow> w;
    Tsy_ClockBufDlgGui* gui = nullptr;
};

QRadioButton* radio(QWidget& dlg, const char* name)
{
    return Named<QRadioButton>(&dlg, name);
}
QComboBox* combo(QWidget& dlg, const char* name)
{
    return Named<QComboBox>(&dlg, name);
}
QString text(QWidget& dlg, const char* name)
{
    auto* w = Named<QWidget>(&dlg, name);
    if (auto* edit = qobject_cast<QLineEdit*>(w))
        return edit->text();
    if (auto* label = qobject_cast<QLabel*>(w))
        return label->text();
    return w ? w->property("title").toString() : QString();
}
void press(QWidget& dlg, const char* button)
{
    QTest::mouseClick(Named<QPushButton>(&dlg, button), Qt::LeftButton);
}

} // namespace

TEST(ClockBuffersForm, RowsFollowTheModeButtons)
{
    Rig r("t5da1-1", {"CLK0", "CLK90", "CLKFX"}, "USE_BUFGS");
    ASSERT_NE(r.gui, nullptr);
    Gq_Wizard& window = r.w->window;
    EXPECT_EQ(window.windowTitle(), "Corvane Pendra - Clock Buffers");
    EXPECT_TRUE(window.button(Gq_Wizard::MoreInfo)->isVisible());
    EXPECT_FALSE(window.button(Gq_Wizard::Advanced)->isVisible());
    auto* useBufgs = r.Find<QRadioButton>("RadioUseBufgs");
    EXPECT_TRUE(useBufgs->isChecked());
    EXPECT_EQ(useBufgs->text(), "&Use Global Buffers for all selected clock outputs");
    const char* shown[] = {"CLK0", "CLK90", "CLKFX"};
    for (int row = 1; row <= 3; ++row) {
        EXPECT_TRUE(r.I0(row)->isVisible());
        EXPECT_EQ(r.I0(row)->text(), shown[row - 1]);
        EXPECT_EQ(r.Edit(row)->text(), "Global Buffer");
        EXPECT_FALSE(r.Edit(row)->isEnabled()) << "global-buffer mode edits nothing";
    }
    EXPECT_FALSE(r.I0(4)->isVisible()) << "CLKIN takes no row";
    EXPECT_FALSE(r.AddBuf()->isVisible());
    Snap(&window, "clock_buffers_global");

    r.Click(r.Find<QRadioButton>("RadioUseGrid"));
    EXPECT_TRUE(r.AddBuf()->isVisible());
    EXPECT_FALSE(r.Edit(1)->isEnabled()) << "the feedback buffer";
    EXPECT_TRUE(r.Edit(2)->isEnabled() && r.Edit(3)->isEnabled());
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1_NOEDIT"), "ENABLED_BUF");

    // The accelerators of the two mode buttons.
    QTest::keyClick(&window, Qt::Key_G, Qt::AltModifier);
    EXPECT_TRUE(Eventually([&] { return useBufgs->isChecked() && !r.AddBuf()->isVisible(); }));
    QTest::keyClick(&window, Qt::Key_U, Qt::AltModifier);
    EXPECT_TRUE(Eventually([&] { return r.AddBuf()->isVisible(); }));

    r.Next();
    EXPECT_EQ(window.currentPage(), &r.w->after);
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID");
    EXPECT_TRUE(r.Errors().empty());
}

TEST(ClockBuffersForm, TheDialogTurnsARowIntoAClockMux)
{
    Rig r("t2a250-4", {"CLK0", "CLK90", "CLKFX"}, "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    ASSERT_EQ(r.I0(2)->text(), "CLK90");
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        EXPECT_EQ(dlg.windowTitle(), "Corvane Pendra - View/Edit Buffer");
        EXPECT_EQ(text(dlg, "GroupBoxBufferType"), "Select buffer for DCM pin CLK90");
        EXPECT_TRUE(radio(dlg, "RadioButtonBufg")->isChecked());
        EXPECT_EQ(dlg.PictureName(), "bufg");
        EXPECT_FALSE(combo(dlg, "ComboBoxI0")->isEnabled()) << "an existing buffer keeps its source";
        EXPECT_EQ(combo(dlg, "ComboBoxI0")->currentText(), "CLK90");
        EXPECT_FALSE(combo(dlg, "ComboBoxI1")->isEnabled());
        EXPECT_EQ(text(dlg, "LineEditO"), "CLK90_OUT");
        EXPECT_FALSE(Named<QLineEdit>(&dlg, "LineEditS0")->isEnabled());
        // Taldor-2 has no BUFGCTRL and no Taldor-4 mux; Lowskewline never.
        for (const char* off : {"RadioButtonBufgctrl", "RadioButtonBufgmuxTal4", "RadioButtonLowskewline"})
            EXPECT_FALSE(radio(dlg, off)->isEnabled()) << off;
        EXPECT_TRUE(radio(dlg, "RadioButtonLocalRouting")->isEnabled());

        Pick(radio(dlg, "RadioButtonBufgmux"));
        EXPECT_EQ(dlg.PictureName(), "bufgmux");
        EXPECT_TRUE(combo(dlg, "ComboBoxI1")->isEnabled());
        EXPECT_EQ(text(dlg, "TextLabelS0"), "S:");
        EXPECT_EQ(text(dlg, "LineEditS0"), "CLK90_SELECT_IN");
        EXPECT_EQ(Items(combo(dlg, "ComboBoxI1")), QStringList({"NONE", "CLK0", "CLK90", "CLKFX", "CLKIN"}));
        // OK without an I1 source is refused.
        press(dlg, "PushButtonOk");
        EXPECT_TRUE(dlg.isVisible());
        EXPECT_TRUE(Choose(combo(dlg, "ComboBoxI1"), "CLKFX"));
        EXPECT_EQ(text(dlg, "LineEditO"), "CLK90_CLKFX_OUT");
        EXPECT_EQ(text(dlg, "LineEditI1Sig"), "CLKFX_BUF");
        Snap(&dlg, "edit_buffer_clock_mux");
        press(dlg, "PushButtonOk");
        EXPECT_FALSE(dlg.isVisible());
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Notes(), std::vector<std::string>{"Please make a selection for the I1 pin."});
    EXPECT_EQ(r.Edit(2)->text(), "Clock Mux");
    EXPECT_EQ(r.Find<QLabel>("TextLabelPinI1Row2")->text(), "CLKFX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_I1_PINNAME"), "CLKFX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "CLK90_CLKFX_OUT");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKMUX_I1"), "CLKFX");
    Snap(&r.w->window, "clock_buffers_customized");
}

TEST(ClockBuffersForm, AddingAndDeletingBuffers)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        EXPECT_TRUE(combo(dlg, "ComboBoxI0")->isEnabled());
        EXPECT_EQ(Items(combo(dlg, "ComboBoxI0")), QStringList({"NONE", "CLK0", "CLK90", "CLKIN"}));
        press(dlg, "PushButtonOk");
        EXPECT_TRUE(dlg.isVisible()) << "no I0 chosen";
        EXPECT_TRUE(Choose(combo(dlg, "ComboBoxI0"), "CLK90"));
        EXPECT_EQ(text(dlg, "GroupBoxBufferType"), "Select buffer for DCM pin CLK90");
        Pick(radio(dlg, "RadioButtonBufgce"));
        EXPECT_EQ(dlg.PictureName(), "bufgce");
        EXPECT_EQ(text(dlg, "TextLabelCE0"), "CE:");
        EXPECT_EQ(text(dlg, "LineEditCE0"), "CLK90_ENABLE_IN");
        Snap(&dlg, "edit_buffer_add");
        press(dlg, "PushButtonOk");
    });
    r.Click(r.AddBuf());
    EXPECT_EQ(r.Notes(), std::vector<std::string>{"Please make a selection for the I0 pin."});
    ASSERT_EQ(r.I0(3)->text(), "CLK90");
    EXPECT_EQ(r.Edit(3)->text(), "Enabled Buffer");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG") << "the first buffer stays";
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE2"), "BUFGCE");

    // The added buffer goes again.
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) { press(dlg, "PushButtonDelete"); });
    r.Click(r.Edit(3));
    EXPECT_FALSE(r.I0(3)->isVisible());
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE2"), "");

    // The only buffer of an output cannot go.
    r.d.Stream().Clear();
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        Pick(radio(dlg, "RadioButtonLocalRouting"));
        press(dlg, "PushButtonDelete");
        EXPECT_TRUE(dlg.isVisible());
        EXPECT_TRUE(radio(dlg, "RadioButtonBufg")->isChecked()) << "the type choice goes back";
        press(dlg, "PushButtonCancel");
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Notes(), std::vector<std::string>{"To remove all buffers from pin CLK90, please return to the General "
                                                  "Setup dialog and deselect this pin."});
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG");
}

TEST(ClockBuffersForm, ANameThatCannotReachTheHdlKeepsTheDialogOpen)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        Retype(Named<QLineEdit>(&dlg, "LineEditO"), "out");
        press(dlg, "PushButtonOk");
        EXPECT_TRUE(dlg.isVisible());
        Retype(Named<QLineEdit>(&dlg, "LineEditO"), "PIXEL_CLK");
        press(dlg, "PushButtonOk");
        EXPECT_FALSE(dlg.isVisible());
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Errors(), std::vector<std::string>{"The signal name 'out' of pin O cannot be used: it is a VHDL "
                                                   "keyword.  Please enter a name that is legal in both Verilog and "
                                                   "VHDL."});
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "PIXEL_CLK");
}

TEST(ClockBuffersForm, TheMuxChoicesFollowTheFamily)
{
    struct Case {
        const char *part, *label, *stored, *picture;
        bool localRouting;
    } cases[] = {
        {"t5da1-1", "Global Clock Mux", "BUFGMUX_CTRL", "bufgmux_ctrl", false},
        {"t4a25-10", "Clock Mux for &Taldor4", "BUFGMUX_TALDOR4", "bufgmuxtal4", true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.part);
        Rig r(c.part, {"CLK0", "CLK90", "CLK180"}, "USE_GRID");
        ASSERT_NE(r.gui, nullptr);
        r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
            EXPECT_EQ(radio(dlg, "RadioButtonBufgmuxTal4")->text(), c.label);
            EXPECT_EQ(radio(dlg, "RadioButtonLocalRouting")->isEnabled(), c.localRouting);
            EXPECT_TRUE(radio(dlg, "RadioButtonBufgctrl")->isEnabled());
            Pick(radio(dlg, "RadioButtonBufgctrl"));
            EXPECT_EQ(dlg.PictureName(), "bufgctrl");
            EXPECT_EQ(text(dlg, "TextLabelS0"), "S0:");
            EXPECT_TRUE(Named<QLineEdit>(&dlg, "LineEditIgnore1")->isEnabled());
            EXPECT_TRUE(Choose(combo(dlg, "ComboBoxIgnore1"), "GND"));
            EXPECT_FALSE(Named<QLineEdit>(&dlg, "LineEditIgnore1")->isEnabled());
            Snap(&dlg, QString("edit_buffer_bufgctrl_") + c.part);
            Pick(radio(dlg, "RadioButtonBufgmuxTal4"));
            EXPECT_EQ(dlg.PictureName(), c.picture);
            EXPECT_TRUE(Choose(combo(dlg, "ComboBoxI1"), "CLK180"));
            press(dlg, "PushButtonOk");
        });
        r.Click(r.Edit(2));
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), c.stored);
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_BLKNAME"), std::string("CLK90_") + c.stored + "_INST");
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_IGNORE1_PINNAME"), "") << "the BUFGCTRL was never stored";
    }
}

TEST(ClockBuffersForm, NextAsksBeforeUsingMoreThanFourGlobalBuffers)
{
    Rig r("t2a250-4", {"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV"}, "USE_BUFGS");
    ASSERT_NE(r.gui, nullptr);
    r.d.Stream().ScriptAnswers({0, 1});
    r.Next();
    EXPECT_EQ(r.w->window.currentPage(), r.gui) << "No keeps the page";
    EXPECT_EQ(Texts(r.d.Stream().Questions()),
              std::vector<std::string>{"More than four DCM outputs are driving global buffers.  Only a maximum of "
                                       "four DCM outputs can use dedicated routing to global buffers on the same half "
                                       "of the FPGA.  The remaining outputs will use local routing to the global "
                                       "buffer.  Do you want to continue?"});
    r.Next();
    EXPECT_EQ(r.w->window.currentPage(), &r.w->after) << "Yes goes on";
    EXPECT_EQ(r.d.Stream().Questions().size(), 2u);
}

TEST(ClockBuffersForm, NextRefusesAFeedbackOutputWithoutItsBufg)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "USE_GRID",
          [](Tsy_Block& b) { b.GetNamedPin("CLK0")->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFGCE"); });
    ASSERT_NE(r.gui, nullptr);
    EXPECT_TRUE(r.Edit(1)->isEnabled());
    EXPECT_EQ(r.Edit(1)->text(), "Enabled Buffer");
    r.Next();
    EXPECT_EQ(r.w->window.currentPage(), r.gui);
    EXPECT_EQ(r.Errors(), std::vector<std::string>{"The 'Feedback Source' is Internal CLK0, which requires that CLK0 "
                                                   "be connected to a BUFG.  Please use BUFG for CLK0."});
    // Changed to a Global Buffer in the dialog, Next goes on.
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        // The offscreen platform does not hand the focus to a dialog by itself.
        dlg.windowHandle()->requestActivate();
        EXPECT_TRUE(Eventually([] {
            return QApplication::activeWindow() && QApplication::activeWindow()->inherits("Tsy_EditBufDlgGui");
        }));
        QTest::keyClick(&dlg, Qt::Key_G, Qt::AltModifier);
        EXPECT_TRUE(Eventually([&] { return radio(dlg, "RadioButtonBufg")->isChecked(); }));
        QTest::keyClick(&dlg, Qt::Key_O, Qt::AltModifier);
        Eventually([&] { return !dlg.isVisible(); });
    });
    r.Click(r.Edit(1));
    EXPECT_EQ(r.Record("CLK0", "TSY_CLKBUFTYPE1"), "BUFG");
    r.Next();
    EXPECT_EQ(r.w->window.currentPage(), &r.w->after);
}

TEST(ClockBuffersForm, EveryPictureIsDrawnAtItsSize)
{
    Rig r("t4a25-10", {"CLK0", "CLK90", "CLK180"}, "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        const std::pair<const char*, const char*> steps[] = {
            {"RadioButtonBufgce", "bufgce"},          {"RadioButtonBufgmux", "bufgmux"},
            {"RadioButtonBufgctrl", "bufgctrl"},      {"RadioButtonBufgmuxTal4", "bufgmuxtal4"},
            {"RadioButtonLocalRouting", "localrout"}, {"RadioButtonBufg", "bufg"}};
        for (const auto& [button, picture] : steps) {
            Pick(radio(dlg, button));
            EXPECT_EQ(dlg.PictureName(), picture);
            EXPECT_EQ(dlg.Picture().size(), QSize(148, 340)) << picture;
            Snap(&dlg, QString("edit_buffer_") + picture);
        }
        dlg.reject();
    });
    r.Click(r.Edit(2));
    EXPECT_TRUE(r.Notes().empty()) << "every picture was found";
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG") << "Cancel changes nothing";
}

TEST(ClockBuffersForm, TheSecondDcmOfATwoDcmWizardNamesItsInstance)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "USE_GRID", {}, "dcm_cascading", 2);
    ASSERT_NE(r.gui, nullptr);
    EXPECT_EQ(r.w->window.windowTitle(), "Corvane Pendra - Clock Buffers for INST2");
    EXPECT_EQ(r.w->window.findChild<QLabel*>("WizardPageTitle")->text(), "Clock Buffers for INST2");
    r.InDialog([&](Tsy_EditBufDlgGui& dlg) {
        EXPECT_EQ(text(dlg, "LineEditO"), "U2_CLK90_OUT");
        EXPECT_EQ(text(dlg, "LineEditI0Sig"), "U2_CLK90_BUF");
        press(dlg, "PushButtonOk");
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_BLKNAME"), "U2_CLK90_BUFG_INST");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "U2_CLK90_OUT");
}
