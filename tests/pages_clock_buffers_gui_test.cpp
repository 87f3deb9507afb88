// The Clock Buffers page and the View/Edit Buffer dialog in a wizard window
// under Qt's offscreen platform: radio buttons, combo boxes and buttons
// clicked as a user does, and what the rows, the dialog and the pins then
// show. With PENDRA_SCREENSHOT_DIR set, the window and the dialog are also
// saved as pictures for a person to look at.

#include "gui/Gq_Wizard.h"
#include "gui/Gq_WizardPage.h"
#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "pages/dcm/Tsy_EditBufDlgGui.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_Vocabulary.h"

#include <QApplication>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>
#include <QTimer>
#include <QWindow>

#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <memory>

namespace {

const char* const kDcmOutputs[] = {"CLK0",  "CLK90",    "CLK180", "CLK270",  "CLKDV",
                                   "CLK2X", "CLK2X180", "CLKFX",  "CLKFX180"};

class NextProbe : public Gq_WizardPage {
public:
    NextProbe()
    {
        setPageName("Summary");
        setPageWidget(new QLabel("next"));
    }
};

// The View/Edit Buffer dialog's controls, found by name.
struct Dlg {
    Tsy_EditBufDlgGui& dlg;
    template <typename T>
    T* Find(const char* name)
    {
        T* w = dlg.findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    QRadioButton* Radio(const char* name) { return Find<QRadioButton>(name); }
    QComboBox* Combo(const char* name) { return Find<QComboBox>(name); }
    QLineEdit* Line(const char* name) { return Find<QLineEdit>(name); }
    QPushButton* Button(const char* name) { return Find<QPushButton>(name); }
    QLabel* Label(const char* name) { return Find<QLabel>(name); }
    QGroupBox* Group(const char* name) { return Find<QGroupBox>(name); }
};

// A wizard window holding the Clock Buffers page of a design, followed by
// one more page so that Next has somewhere to go.
class Rig {
public:
    Rig(const char* part, std::initializer_list<const char*> outputs, const char* feedback, const char* useBufg,
        const std::function<void(Tsy_Block&)>& setup = {}, const char* keyword = "dcm", int inst = 1)
        : d(keyword, part, false)
    {
        d.MarkLoaded();
        d.Configure([](Tsy_WizContext& c) { c.designVersion = "1.0.0"; });
        d.Instantiate();
        for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
            if (auto* p = dynamic_cast<Tsy_ClockBufDlg*>(d.Wizard().GetPage(i)); p && p->GetInstNum() == inst)
                page = p;
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        if (!page || !dcm)
            return;
        for (const char* o : kDcmOutputs)
            dcm->GetNamedPin(o)->SetIsActive(false);
        for (const char* o : outputs)
            dcm->GetNamedPin(o)->SetIsActive(true);
        dcm->SetAttributeValue(Tsy_Attr::FB_SOURCE, feedback);
        dcm->SetAttributeValue(Tsy_Attr::CLK_FEEDBACK, "1X");
        dcm->SetAttributeValue(Tsy_Attr::USE_BUFG, useBufg);
        if (setup)
            setup(*dcm);
        window = std::make_unique<Gq_Wizard>();
        page->CreateGui(window.get());
        gui = dynamic_cast<Tsy_ClockBufDlgGui*>(page->GetGui());
        if (!gui)
            return;
        form = gui->pageWidget();
        window->addPage(gui);
        window->addPage(&after);
        window->show();
        window->activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(window.get()));
        window->start();
    }
    ~Rig() { window.reset(); }

    // The form's controls, found by name as a test tool finds them.
    template <typename T>
    T* Find(const QString& name)
    {
        T* w = form ? form->findChild<T*>(name) : nullptr;
        EXPECT_NE(w, nullptr) << name.toStdString();
        return w;
    }
    QLabel* I0(int r) { return Find<QLabel>(QString("TextLabelPinI0Row%1").arg(r)); }
    QLabel* I1(int r) { return Find<QLabel>(QString("TextLabelPinI1Row%1").arg(r)); }
    QPushButton* Edit(int r) { return Find<QPushButton>(QString("PushButtonEditRow%1").arg(r)); }
    QRadioButton* UseBufgs() { return Find<QRadioButton>("RadioUseBufgs"); }
    QRadioButton* UseGrid() { return Find<QRadioButton>("RadioUseGrid"); }
    QPushButton* AddBuf() { return Find<QPushButton>("PushButtonAddBuf"); }
    std::string Text(QLabel* l) { return l->text().toStdString(); }
    std::string Text(QAbstractButton* b) { return b->text().toStdString(); }
    void Click(QAbstractButton* b)
    {
        // Radio buttons are clicked on their indicator, buttons in the middle.
        QPoint at = qobject_cast<QRadioButton*>(b) ? QPoint(8, b->height() / 2) : b->rect().center();
        QTest::mouseClick(b, Qt::LeftButton, Qt::KeyboardModifiers(), at);
    }
    std::string Record(const char* pin, const char* attr)
    {
        return dcm->GetNamedPin(pin)->GetAttributeValue(attr).str();
    }
    std::vector<StringBase> Errors() { return d.Stream().Errors(); }
    std::vector<StringBase> Notes() { return d.Stream().Notes(); }

    // Does what the steps do in the dialog the next click opens; whatever
    // the steps leave, the dialog is closed afterwards so the test goes on.
    void InDialog(const std::function<void(Tsy_EditBufDlgGui&, Dlg&)>& steps)
    {
        QTimer::singleShot(0, [this, steps] {
            Tsy_EditBufDlgGui* dlg = gui->EditDialog();
            ASSERT_NE(dlg, nullptr);
            ASSERT_TRUE(dlg->isVisible());
            Dlg f{*dlg};
            steps(*dlg, f);
            if (dlg->isVisible())
                dlg->reject();
        });
    }

    void Snap(QWidget* w, const char* name)
    {
        const char* dir = std::getenv("PENDRA_SCREENSHOT_DIR");
        if (!dir || !*dir)
            return;
        QApplication::processEvents(); // pending layouts first
        w->grab().save(QString("%1/%2.png").arg(dir, name));
    }

    TestDesign d;
    Tsy_ClockBufDlg* page = nullptr;
    Tsy_ClockBufDlgGui* gui = nullptr;
    QWidget* form = nullptr;
    Tsy_Block* dcm = nullptr;
    NextProbe after;
    std::unique_ptr<Gq_Wizard> window;
};

bool eventually(const std::function<bool()>& condition)
{
    for (int i = 0; i < 250 && !condition(); ++i)
        QTest::qWait(20);
    return condition();
}

// Clicks a radio button on its indicator, where a click always lands.
void pick(QRadioButton* radio)
{
    QTest::mouseClick(radio, Qt::LeftButton, Qt::KeyboardModifiers(), QPoint(8, radio->height() / 2));
}

// Chooses an entry of a combo box with the arrow keys, as a user does.
bool choose(QComboBox* combo, const char* text)
{
    combo->setFocus();
    QTest::keyClick(combo, Qt::Key_Home);
    for (int i = 0; i <= combo->count() && combo->currentText() != text; ++i)
        QTest::keyClick(combo, Qt::Key_Down);
    return combo->currentText() == text;
}

std::string texts(QComboBox* combo)
{
    std::string out;
    for (int i = 0; i < combo->count(); ++i)
        out += (i ? "," : "") + combo->itemText(i).toStdString();
    return out;
}

} // namespace

TEST(ClockBuffersForm, RowsFollowTheModeButtons)
{
    Rig r("t5da1-1", {"CLK0", "CLK90", "CLKFX"}, "INTERNAL", "USE_BUFGS");
    ASSERT_NE(r.gui, nullptr);
    EXPECT_EQ(r.window->windowTitle().toStdString(), "Corvane Pendra - Clock Buffers");
    EXPECT_TRUE(r.window->button(Gq_Wizard::MoreInfo)->isVisible());
    EXPECT_FALSE(r.window->button(Gq_Wizard::Advanced)->isVisible());
    EXPECT_TRUE(r.UseBufgs()->isChecked());
    EXPECT_EQ(r.Text(r.UseBufgs()), "&Use Global Buffers for all selected clock outputs");
    const char* shown[] = {"CLK0", "CLK90", "CLKFX"};
    for (int row = 1; row <= 3; ++row) {
        EXPECT_TRUE(r.I0(row)->isVisible());
        EXPECT_EQ(r.Text(r.I0(row)), shown[row - 1]);
        EXPECT_EQ(r.Text(r.Edit(row)), "Global Buffer");
        EXPECT_FALSE(r.Edit(row)->isEnabled()) << "global-buffer mode edits nothing";
    }
    EXPECT_FALSE(r.I0(4)->isVisible()) << "CLKIN takes no row";
    EXPECT_FALSE(r.AddBuf()->isVisible());
    r.Snap(r.window.get(), "clock_buffers_global");

    r.Click(r.UseGrid());
    EXPECT_TRUE(r.AddBuf()->isVisible());
    EXPECT_FALSE(r.Edit(1)->isEnabled()) << "the feedback buffer";
    EXPECT_TRUE(r.Edit(2)->isEnabled());
    EXPECT_TRUE(r.Edit(3)->isEnabled());
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1_NOEDIT"), "ENABLED_BUF");

    // The accelerators of the two mode buttons.
    QTest::keyClick(r.window.get(), Qt::Key_G, Qt::AltModifier);
    EXPECT_TRUE(eventually([&] { return r.UseBufgs()->isChecked(); }));
    EXPECT_TRUE(eventually([&] { return !r.AddBuf()->isVisible(); }));
    QTest::keyClick(r.window.get(), Qt::Key_U, Qt::AltModifier);
    EXPECT_TRUE(eventually([&] { return r.AddBuf()->isVisible(); }));

    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentPage(), &r.after);
    EXPECT_EQ(r.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID");
    EXPECT_TRUE(r.Errors().empty());
}

TEST(ClockBuffersForm, TheDialogTurnsARowIntoAClockMux)
{
    Rig r("t2a250-4", {"CLK0", "CLK90", "CLKFX"}, "INTERNAL", "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    ASSERT_EQ(r.Text(r.I0(2)), "CLK90");
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        EXPECT_EQ(dlg.windowTitle().toStdString(), "Corvane Pendra - View/Edit Buffer");
        EXPECT_EQ(f.Group("GroupBoxBufferType")->title().toStdString(), "Select buffer for DCM pin CLK90");
        EXPECT_TRUE(f.Radio("RadioButtonBufg")->isChecked());
        EXPECT_EQ(f.dlg.PictureName().toStdString(), "bufg");
        EXPECT_EQ(f.dlg.Picture().size(), QSize(148, 340));
        EXPECT_FALSE(f.Combo("ComboBoxI0")->isEnabled()) << "an existing buffer keeps its source";
        EXPECT_EQ(f.Combo("ComboBoxI0")->currentText().toStdString(), "CLK90");
        EXPECT_FALSE(f.Combo("ComboBoxI1")->isEnabled());
        EXPECT_EQ(f.Line("LineEditO")->text().toStdString(), "CLK90_OUT");
        EXPECT_EQ(f.Line("LineEditI0Sig")->text().toStdString(), "CLK90_BUF");
        EXPECT_FALSE(f.Line("LineEditS0")->isEnabled());
        // Taldor-2 has no BUFGCTRL and no Taldor-4 mux; Lowskewline never.
        EXPECT_FALSE(f.Radio("RadioButtonBufgctrl")->isEnabled());
        EXPECT_FALSE(f.Radio("RadioButtonBufgmuxTal4")->isEnabled());
        EXPECT_FALSE(f.Radio("RadioButtonLowskewline")->isEnabled());
        EXPECT_TRUE(f.Radio("RadioButtonLocalRouting")->isEnabled());

        pick(f.Radio("RadioButtonBufgmux"));
        EXPECT_EQ(f.dlg.PictureName().toStdString(), "bufgmux");
        EXPECT_TRUE(f.Combo("ComboBoxI1")->isEnabled());
        EXPECT_TRUE(f.Line("LineEditS0")->isEnabled());
        EXPECT_EQ(f.Label("TextLabelS0")->text().toStdString(), "S:");
        EXPECT_EQ(f.Line("LineEditS0")->text().toStdString(), "CLK90_SELECT_IN");
        EXPECT_EQ(texts(f.Combo("ComboBoxI1")), "NONE,CLK0,CLK90,CLKFX,CLKIN");
        // OK without an I1 source is refused.
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        EXPECT_TRUE(dlg.isVisible());
        EXPECT_TRUE(choose(f.Combo("ComboBoxI1"), "CLKFX"));
        EXPECT_EQ(f.Line("LineEditO")->text().toStdString(), "CLK90_CLKFX_OUT");
        EXPECT_EQ(f.Line("LineEditI1Sig")->text().toStdString(), "CLKFX_BUF");
        r.Snap(&dlg, "edit_buffer_clock_mux");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        EXPECT_FALSE(dlg.isVisible());
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Notes(), std::vector<StringBase>{"Please make a selection for the I1 pin."});
    EXPECT_EQ(r.Text(r.Edit(2)), "Clock Mux");
    EXPECT_EQ(r.Text(r.I1(2)), "CLKFX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_I1_PINNAME"), "CLKFX");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "CLK90_CLKFX_OUT");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKMUX_I1"), "CLKFX");
    r.Snap(r.window.get(), "clock_buffers_customized");
}

TEST(ClockBuffersForm, AddingAndDeletingBuffers)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "INTERNAL", "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        EXPECT_TRUE(f.Combo("ComboBoxI0")->isEnabled());
        EXPECT_EQ(texts(f.Combo("ComboBoxI0")), "NONE,CLK0,CLK90,CLKIN");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        EXPECT_TRUE(dlg.isVisible()) << "no I0 chosen";
        EXPECT_TRUE(choose(f.Combo("ComboBoxI0"), "CLK90"));
        EXPECT_EQ(f.Group("GroupBoxBufferType")->title().toStdString(), "Select buffer for DCM pin CLK90");
        pick(f.Radio("RadioButtonBufgce"));
        EXPECT_EQ(f.dlg.PictureName().toStdString(), "bufgce");
        EXPECT_EQ(f.Label("TextLabelCE0")->text().toStdString(), "CE:");
        EXPECT_EQ(f.Line("LineEditCE0")->text().toStdString(), "CLK90_ENABLE_IN");
        r.Snap(&dlg, "edit_buffer_add");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
    });
    r.Click(r.AddBuf());
    EXPECT_EQ(r.Notes(), std::vector<StringBase>{"Please make a selection for the I0 pin."});
    ASSERT_EQ(r.Text(r.I0(3)), "CLK90");
    EXPECT_EQ(r.Text(r.Edit(3)), "Enabled Buffer");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG") << "the first buffer stays";
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE2"), "BUFGCE");

    // The added buffer goes again.
    r.InDialog([&](Tsy_EditBufDlgGui&, Dlg& f) { QTest::mouseClick(f.Button("PushButtonDelete"), Qt::LeftButton); });
    r.Click(r.Edit(3));
    EXPECT_FALSE(r.I0(3)->isVisible());
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE2"), "");

    // The only buffer of an output cannot go.
    r.d.Stream().Clear();
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        pick(f.Radio("RadioButtonLocalRouting"));
        QTest::mouseClick(f.Button("PushButtonDelete"), Qt::LeftButton);
        EXPECT_TRUE(dlg.isVisible());
        EXPECT_TRUE(f.Radio("RadioButtonBufg")->isChecked()) << "the type choice goes back";
        QTest::mouseClick(f.Button("PushButtonCancel"), Qt::LeftButton);
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Notes(), std::vector<StringBase>{"To remove all buffers from pin CLK90, please return to the General "
                                                 "Setup dialog and deselect this pin."});
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG");
}

TEST(ClockBuffersForm, ANameThatCannotReachTheHdlKeepsTheDialogOpen)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "INTERNAL", "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        f.Line("LineEditO")->selectAll();
        QTest::keyClicks(f.Line("LineEditO"), "out");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        EXPECT_TRUE(dlg.isVisible());
        f.Line("LineEditO")->selectAll();
        QTest::keyClicks(f.Line("LineEditO"), "PIXEL_CLK");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        EXPECT_FALSE(dlg.isVisible());
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Errors(),
              std::vector<StringBase>{"The signal name 'out' of pin O cannot be used: it is a VHDL keyword.  "
                                      "Please enter a name that is legal in both Verilog and VHDL."});
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "PIXEL_CLK");
}

TEST(ClockBuffersForm, TheMuxChoicesFollowTheFamily)
{
    struct Case {
        const char* part;
        const char* label;
        const char* stored;
        const char* picture;
        bool localRouting;
    } cases[] = {
        {"t5da1-1", "Global Clock Mux", "BUFGMUX_CTRL", "bufgmux_ctrl", false},
        {"t4a25-10", "Clock Mux for &Taldor4", "BUFGMUX_TALDOR4", "bufgmuxtal4", true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.part);
        Rig r(c.part, {"CLK0", "CLK90", "CLK180"}, "INTERNAL", "USE_GRID");
        ASSERT_NE(r.gui, nullptr);
        r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
            EXPECT_EQ(f.Radio("RadioButtonBufgmuxTal4")->text().toStdString(), c.label);
            EXPECT_EQ(f.Radio("RadioButtonLocalRouting")->isEnabled(), c.localRouting);
            EXPECT_TRUE(f.Radio("RadioButtonBufgctrl")->isEnabled());
            pick(f.Radio("RadioButtonBufgctrl"));
            EXPECT_EQ(f.dlg.PictureName().toStdString(), "bufgctrl");
            EXPECT_EQ(f.Label("TextLabelS0")->text().toStdString(), "S0:");
            EXPECT_TRUE(f.Line("LineEditIgnore1")->isEnabled());
            EXPECT_TRUE(choose(f.Combo("ComboBoxIgnore1"), "GND"));
            EXPECT_FALSE(f.Line("LineEditIgnore1")->isEnabled());
            r.Snap(&dlg, (std::string("edit_buffer_bufgctrl_") + c.part).c_str());
            pick(f.Radio("RadioButtonBufgmuxTal4"));
            EXPECT_EQ(f.dlg.PictureName().toStdString(), c.picture);
            EXPECT_TRUE(choose(f.Combo("ComboBoxI1"), "CLK180"));
            QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
        });
        r.Click(r.Edit(2));
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), c.stored);
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_BLKNAME"), std::string("CLK90_") + c.stored + "_INST");
        EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_IGNORE1_PINNAME"), "") << "the BUFGCTRL was never stored";
    }
}

TEST(ClockBuffersForm, NextAsksBeforeUsingMoreThanFourGlobalBuffers)
{
    Rig r("t2a250-4", {"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV"}, "INTERNAL", "USE_BUFGS");
    ASSERT_NE(r.gui, nullptr);
    r.d.Stream().ScriptAnswers({0, 1});
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentPage(), r.gui) << "No keeps the page";
    ASSERT_EQ(r.d.Stream().Questions().size(), 1u);
    EXPECT_EQ(r.d.Stream().Questions()[0],
              "More than four DCM outputs are driving global buffers.  Only a maximum of four DCM outputs can use "
              "dedicated routing to global buffers on the same half of the FPGA.  The remaining outputs will use "
              "local routing to the global buffer.  Do you want to continue?");
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentPage(), &r.after) << "Yes goes on";
    EXPECT_EQ(r.d.Stream().Questions().size(), 2u);
}

TEST(ClockBuffersForm, NextRefusesAFeedbackOutputWithoutItsBufg)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "INTERNAL", "USE_GRID",
          [](Tsy_Block& b) { b.GetNamedPin("CLK0")->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFGCE"); });
    ASSERT_NE(r.gui, nullptr);
    EXPECT_TRUE(r.Edit(1)->isEnabled());
    EXPECT_EQ(r.Text(r.Edit(1)), "Enabled Buffer");
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentPage(), r.gui);
    EXPECT_EQ(r.Errors(), std::vector<StringBase>{"The 'Feedback Source' is Internal CLK0, which requires that CLK0 be "
                                                  "connected to a BUFG.  Please use BUFG for CLK0."});
    // Changed to a Global Buffer in the dialog, Next goes on.
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        // The offscreen platform does not hand the focus to a dialog by itself.
        dlg.windowHandle()->requestActivate();
        EXPECT_TRUE(eventually([] {
            return QApplication::activeWindow() && QApplication::activeWindow()->inherits("Tsy_EditBufDlgGui");
        }));
        QTest::keyClick(&dlg, Qt::Key_G, Qt::AltModifier);
        EXPECT_TRUE(eventually([&] { return f.Radio("RadioButtonBufg")->isChecked(); }));
        QTest::keyClick(&dlg, Qt::Key_O, Qt::AltModifier);
        eventually([&] { return !f.dlg.isVisible(); });
    });
    r.Click(r.Edit(1));
    EXPECT_EQ(r.Record("CLK0", "TSY_CLKBUFTYPE1"), "BUFG");
    r.Click(r.window->button(Gq_Wizard::Next));
    EXPECT_EQ(r.window->currentPage(), &r.after);
}

TEST(ClockBuffersForm, EveryPictureIsDrawnAtItsSize)
{
    Rig r("t4a25-10", {"CLK0", "CLK90", "CLK180"}, "INTERNAL", "USE_GRID");
    ASSERT_NE(r.gui, nullptr);
    r.InDialog([&](Tsy_EditBufDlgGui& dlg, Dlg& f) {
        struct Step {
            QRadioButton* radio;
            const char* picture;
        } steps[] = {
            {f.Radio("RadioButtonBufgce"), "bufgce"},          {f.Radio("RadioButtonBufgmux"), "bufgmux"},
            {f.Radio("RadioButtonBufgctrl"), "bufgctrl"},      {f.Radio("RadioButtonBufgmuxTal4"), "bufgmuxtal4"},
            {f.Radio("RadioButtonLocalRouting"), "localrout"}, {f.Radio("RadioButtonBufg"), "bufg"}};
        for (const auto& s : steps) {
            pick(s.radio);
            EXPECT_EQ(f.dlg.PictureName().toStdString(), s.picture);
            EXPECT_EQ(f.dlg.Picture().size(), QSize(148, 340)) << s.picture;
            r.Snap(&dlg, (std::string("edit_buffer_") + s.picture).c_str());
        }
        dlg.reject();
    });
    r.Click(r.Edit(2));
    EXPECT_TRUE(r.Notes().empty()) << "every picture was found";
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUFTYPE1"), "BUFG") << "Cancel changes nothing";
}

TEST(ClockBuffersForm, TheSecondDcmOfATwoDcmWizardNamesItsInstance)
{
    Rig r("t5da1-1", {"CLK0", "CLK90"}, "INTERNAL", "USE_GRID", {}, "dcm_cascading", 2);
    ASSERT_NE(r.gui, nullptr);
    EXPECT_EQ(r.window->windowTitle().toStdString(), "Corvane Pendra - Clock Buffers for INST2");
    EXPECT_EQ(r.window->findChild<QLabel*>("WizardPageTitle")->text().toStdString(), "Clock Buffers for INST2");
    r.InDialog([&](Tsy_EditBufDlgGui&, Dlg& f) {
        EXPECT_EQ(f.Line("LineEditO")->text().toStdString(), "U2_CLK90_OUT");
        EXPECT_EQ(f.Line("LineEditI0Sig")->text().toStdString(), "U2_CLK90_BUF");
        QTest::mouseClick(f.Button("PushButtonOk"), Qt::LeftButton);
    });
    r.Click(r.Edit(2));
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_BLKNAME"), "U2_CLK90_BUFG_INST");
    EXPECT_EQ(r.Record("CLK90", "TSY_CLKBUF1_O_SIGNAME"), "U2_CLK90_OUT");
}
