// The host's GUI layer, driven the way a user drives it: buttons clicked,
// keys pressed, dialogs answered, under Qt's offscreen platform.

#include "gui/Gq_Dialog.h"
#include "gui/Gq_HelpViewer.h"
#include "gui/Gq_ImageManager.h"
#include "gui/Gq_StartDialog.h"
#include "gui/Gq_SummaryPage.h"
#include "gui/Gq_Wizard.h"
#include "gui/Gq_WizardPage.h"
#include "gui/Tsy_DialogStream.h"
#include "gui/Tsy_Wait2Dlg.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "run/Tsy_WizardCatalog.h"
#include "wiz/Tsy_WizMain.h"

#include <QApplication>
#include <QBuffer>
#include <QComboBox>
#include <QFile>
#include <QFileDialog>
#include <QLabel>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QRegularExpression>
#include <QSettings>
#include <QStackedWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTextBrowser>
#include <QTimer>

#include <gtest/gtest.h>

#include <functional>
#include <iostream>
#include <memory>
#include <sstream>
#include <vector>

namespace {

// ---------------------------------------------------------------------------
// A page that records what the window asked of it and answers as told.

class ProbePage : public Gq_WizardPage {
public:
    explicit ProbePage(const QString& name)
    {
        setPageName(name);
        auto* label = new QLabel("Form of " + name);
        label->setObjectName("Form " + name);
        setPageWidget(label);
    }

    void onActive() override
    {
        ++active;
        if (onEntry)
            onEntry(this);
    }
    bool onNext() override
    {
        ++next;
        return allowNext;
    }
    bool onBack() override
    {
        ++back;
        return allowBack;
    }
    bool onFinish() override
    {
        ++finish;
        return allowFinish;
    }
    void onCancel() override { ++cancel; }
    void onAdvanced() override { ++advanced; }
    void onMoreInfo() override { ++moreInfo; }

    bool allowNext = true;
    bool allowBack = true;
    bool allowFinish = true;
    int active = 0, next = 0, back = 0, finish = 0, cancel = 0, advanced = 0, moreInfo = 0;
    std::function<void(ProbePage*)> onEntry;
};

// A window of probe pages named as given; the pages outlive the window, as
// the wizard's own page controllers do.
struct WizardRig {
    explicit WizardRig(const QStringList& names)
    {
        for (const QString& n : names)
            pages.push_back(std::make_unique<ProbePage>(n));
        for (auto& p : pages)
            window->addPage(p.get());
    }
    ProbePage& at(int i) { return *pages[static_cast<size_t>(i)]; }
    QPushButton* button(Gq_Wizard::Button b) const { return window->button(b); }
    QString title() const { return window->findChild<QLabel*>("WizardPageTitle")->text(); }
    QWidget* shownForm() const { return window->findChild<QStackedWidget*>("WizardPageStack")->currentWidget(); }
    void click(Gq_Wizard::Button b) const { QTest::mouseClick(button(b), Qt::LeftButton); }

    std::vector<std::unique_ptr<ProbePage>> pages;
    std::unique_ptr<Gq_Wizard> window = std::make_unique<Gq_Wizard>();
};

// Runs 'answer' on the first modal window to appear while 'open' runs (which
// blocks in that window's event loop), and gives back what 'open' returned.
template <typename Result>
Result whileModal(const std::function<Result()>& open, const std::function<void(QWidget*)>& answer)
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
    Result r = open();
    delete poll;
    EXPECT_TRUE(answered) << "no modal window appeared";
    return r;
}

bool showAndActivate(QWidget* w)
{
    w->show();
    QApplication::setActiveWindow(w);
    w->activateWindow();
    return QTest::qWaitForWindowActive(w);
}

// ---------------------------------------------------------------------------
// Wizard window: moving between pages.

TEST(Wizard, StartShowsTheFirstPageWithItsNameAndForm)
{
    WizardRig rig({"General Setup", "Clock Buffers", "Summary"});
    rig.window->start();
    EXPECT_EQ(rig.window->currentIndex(), 0);
    EXPECT_EQ(rig.title(), "General Setup");
    EXPECT_EQ(rig.shownForm(), rig.at(0).pageWidget());
    EXPECT_EQ(rig.at(0).active, 1);
    EXPECT_EQ(rig.at(1).active, 0);
    EXPECT_FALSE(rig.button(Gq_Wizard::Back)->isEnabled());
    EXPECT_TRUE(rig.button(Gq_Wizard::Next)->isEnabled());
    EXPECT_FALSE(rig.button(Gq_Wizard::Finish)->isEnabled());
    // The page widget now belongs to the window.
    EXPECT_TRUE(rig.window->isAncestorOf(rig.at(0).pageWidget()));
    EXPECT_EQ(rig.at(0).wizard(), rig.window.get());
}

TEST(Wizard, NextAndBackMoveOnlyWhenThePageAgrees)
{
    struct Case {
        const char* what;
        int startAt;
        Gq_Wizard::Button press;
        bool pageAgrees;
        int expectIndex;
    };
    const Case cases[] = {
        {"next agreed", 0, Gq_Wizard::Next, true, 1},
        {"next refused", 0, Gq_Wizard::Next, false, 0},
        {"back agreed", 2, Gq_Wizard::Back, true, 1},
        {"back refused", 2, Gq_Wizard::Back, false, 2},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        WizardRig rig({"A", "B", "C"});
        rig.window->start();
        while (rig.window->currentIndex() < c.startAt)
            ASSERT_TRUE(rig.window->goNext());
        ProbePage& here = rig.at(c.startAt);
        here.allowNext = here.allowBack = c.pageAgrees;
        int activeBefore = rig.at(c.expectIndex).active;

        rig.click(c.press);

        EXPECT_EQ(rig.window->currentIndex(), c.expectIndex);
        EXPECT_EQ(rig.title(), rig.at(c.expectIndex).pageName());
        EXPECT_EQ(rig.shownForm(), rig.at(c.expectIndex).pageWidget());
        EXPECT_EQ(c.press == Gq_Wizard::Next ? here.next : here.back, 1);
        // Only a page actually entered is told so.
        EXPECT_EQ(rig.at(c.expectIndex).active, activeBefore + (c.pageAgrees ? 1 : 0));
    }
}

TEST(Wizard, HiddenPagesArePassedOverBothWays)
{
    WizardRig rig({"A", "B", "C", "D"});
    rig.at(1).hidePage(true);
    rig.at(2).hidePage(true);
    rig.window->start();

    EXPECT_TRUE(rig.window->goNext());
    EXPECT_EQ(rig.window->currentIndex(), 3);
    EXPECT_TRUE(rig.window->goBack());
    EXPECT_EQ(rig.window->currentIndex(), 0);
    EXPECT_EQ(rig.at(1).active + rig.at(2).active, 0);
    EXPECT_EQ(rig.at(1).next + rig.at(2).next, 0);

    // A first page that is hidden is not where the wizard starts.
    WizardRig late({"A", "B"});
    late.at(0).hidePage(true);
    late.window->start();
    EXPECT_EQ(late.window->currentIndex(), 1);
    EXPECT_FALSE(late.button(Gq_Wizard::Back)->isEnabled());
}

TEST(Wizard, APageThatHidesItselfOnEntryIsPassedThrough)
{
    WizardRig rig({"General Setup", "Phase-Matched Clock Divider", "Clock Buffers"});
    rig.at(1).onEntry = [](ProbePage* p) { p->hidePage(true); };
    rig.window->start();

    rig.click(Gq_Wizard::Next);
    EXPECT_EQ(rig.window->currentIndex(), 2);
    EXPECT_EQ(rig.title(), "Clock Buffers");
    EXPECT_EQ(rig.at(1).active, 1);

    rig.click(Gq_Wizard::Back);
    EXPECT_EQ(rig.window->currentIndex(), 0);
    EXPECT_EQ(rig.at(1).active, 1);
}

TEST(Wizard, WhenEveryPageAheadHidesItselfTheUserStaysPut)
{
    WizardRig rig({"A", "B"});
    rig.at(1).onEntry = [](ProbePage* p) { p->hidePage(true); };
    rig.window->start();
    EXPECT_FALSE(rig.window->goNext());
    EXPECT_EQ(rig.window->currentIndex(), 0);
    EXPECT_EQ(rig.title(), "A");
    EXPECT_EQ(rig.shownForm(), rig.at(0).pageWidget());
}

TEST(Wizard, BackAndNextCarryTheNeighbouringPagesNames)
{
    struct Case {
        const char* what;
        QString backName, nextName;
        bool hideMiddle;
        QString backText, nextText;
    };
    const Case cases[] = {
        {"names given", "General Setup", "Clock Buffers", false, "< General Setup", "Clock Buffers >"},
        {"no names given: the neighbours' own", "", "", false, "< Left", "Right >"},
        {"an ampersand shows as itself", "R&D Setup", "Q&A", false, "< R&&D Setup", "Q&&A >"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        WizardRig rig({"Left", "Middle", "Right"});
        rig.at(1).setPageBackName(c.backName);
        rig.at(1).setPageNextName(c.nextName);
        rig.window->start();
        rig.window->goNext();
        ASSERT_EQ(rig.window->currentIndex(), 1);
        QPushButton* back = rig.button(Gq_Wizard::Back);
        QPushButton* next = rig.button(Gq_Wizard::Next);
        EXPECT_EQ(back->text(), c.backText);
        EXPECT_EQ(next->text(), c.nextText);
        // The accelerators hold whatever the names are.
        EXPECT_EQ(back->shortcut(), QKeySequence(Qt::ALT | Qt::Key_Left));
        EXPECT_EQ(next->shortcut(), QKeySequence(Qt::ALT | Qt::Key_Right));
        QString shownBack = QString(c.backText).remove(0, 2).replace("&&", "&");
        EXPECT_TRUE(back->toolTip().contains(shownBack)) << back->toolTip().toStdString();
    }
}

TEST(Wizard, AButtonSkippingAHiddenPageNamesThePageItLeadsTo)
{
    WizardRig rig({"General Setup", "Phase-Matched Clock Divider", "Clock Buffers"});
    rig.at(0).setPageNextName("Phase-Matched Clock Divider");
    rig.at(2).setPageBackName("Phase-Matched Clock Divider");
    rig.at(1).hidePage(true);
    rig.window->start();
    EXPECT_EQ(rig.button(Gq_Wizard::Next)->text(), "Clock Buffers >");
    rig.window->goNext();
    EXPECT_EQ(rig.button(Gq_Wizard::Back)->text(), "< General Setup");
}

TEST(Wizard, FinishIsOfferedOnlyOnTheLastPage)
{
    WizardRig rig({"A", "B", "C"});
    rig.window->start();
    const struct {
        bool back, next, finish;
    } expect[] = {{false, true, false}, {true, true, false}, {true, false, true}};
    for (int i = 0; i < 3; ++i) {
        SCOPED_TRACE(i);
        ASSERT_EQ(rig.window->currentIndex(), i);
        EXPECT_EQ(rig.button(Gq_Wizard::Back)->isEnabled(), expect[i].back);
        EXPECT_EQ(rig.button(Gq_Wizard::Next)->isEnabled(), expect[i].next);
        EXPECT_EQ(rig.button(Gq_Wizard::Finish)->isEnabled(), expect[i].finish);
        // Enter presses Next, and Finish once there is nothing after.
        EXPECT_EQ(rig.button(Gq_Wizard::Next)->isDefault(), expect[i].next);
        EXPECT_EQ(rig.button(Gq_Wizard::Finish)->isDefault(), expect[i].finish);
        if (i < 2)
            rig.click(Gq_Wizard::Next);
    }
    // Nothing comes after the last page, and its onNext is not even asked.
    EXPECT_FALSE(rig.window->goNext());
    EXPECT_EQ(rig.at(2).next, 0);
    // Finish is refused anywhere but at the end.
    rig.window->goBack();
    EXPECT_FALSE(rig.window->finish());
    EXPECT_EQ(rig.at(1).finish, 0);
}

TEST(Wizard, FinishClosesOnlyWhenPageAndHandlerAgree)
{
    struct Case {
        bool pageAgrees;
        bool handlerAgrees;
        bool handlerAsked;
        bool closes;
    };
    const Case cases[] = {
        {true, true, true, true},
        {true, false, true, false},
        {false, true, false, false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << "page " << c.pageAgrees << " handler " << c.handlerAgrees);
        WizardRig rig({"A", "Summary"});
        int asked = 0;
        rig.window->setFinishHandler([&] {
            ++asked;
            return c.handlerAgrees;
        });
        rig.window->start();
        rig.window->show();
        rig.window->goNext();
        rig.at(1).allowFinish = c.pageAgrees;
        rig.click(Gq_Wizard::Finish);
        EXPECT_EQ(rig.at(1).finish, 1);
        EXPECT_EQ(asked > 0, c.handlerAsked);
        EXPECT_EQ(rig.window->isVisible(), !c.closes);
        if (c.closes) {
            EXPECT_EQ(rig.window->result(), QDialog::Accepted);
        }
    }
}

TEST(Wizard, CancelEscapeAndClosingAllTellThePageAndReject)
{
    const std::vector<std::pair<const char*, std::function<void(WizardRig&)>>> ways = {
        {"Cancel button", [](WizardRig& r) { r.click(Gq_Wizard::Cancel); }},
        {"Escape key", [](WizardRig& r) { QTest::keyClick(r.window.get(), Qt::Key_Escape); }},
        {"window closed", [](WizardRig& r) { r.window->close(); }},
    };
    for (const auto& [what, act] : ways) {
        SCOPED_TRACE(what);
        WizardRig rig({"A", "B"});
        int finished = 0;
        rig.window->setFinishHandler([&] {
            ++finished;
            return true;
        });
        rig.window->start();
        ASSERT_TRUE(showAndActivate(rig.window.get()));
        rig.window->goNext();
        act(rig);
        EXPECT_FALSE(rig.window->isVisible());
        EXPECT_EQ(rig.window->result(), QDialog::Rejected);
        EXPECT_EQ(rig.at(1).cancel, 1);
        EXPECT_EQ(rig.at(0).cancel, 0);
        EXPECT_EQ(finished, 0);
        EXPECT_EQ(rig.at(1).finish, 0);
    }
}

TEST(Wizard, MoreInfoAndAdvancedReachTheCurrentPage)
{
    WizardRig rig({"A", "B"});
    rig.at(0).onEntry = [](ProbePage* p) {
        p->wizard()->showMoreInfo(true);
        p->wizard()->enableMoreInfo(true);
        p->wizard()->showAdvanced(false);
        p->wizard()->enableAdvanced(false);
    };
    rig.at(1).onEntry = [](ProbePage* p) {
        p->wizard()->showMoreInfo(true);
        p->wizard()->enableMoreInfo(false);
        p->wizard()->showAdvanced(true);
        p->wizard()->enableAdvanced(true);
    };
    Gq_Wizard* w = rig.window.get();
    QPushButton* info = rig.button(Gq_Wizard::MoreInfo);
    QPushButton* adv = rig.button(Gq_Wizard::Advanced);
    rig.window->start();

    EXPECT_TRUE(info->isVisibleTo(w));
    EXPECT_TRUE(info->isEnabled());
    EXPECT_FALSE(adv->isVisibleTo(w));
    rig.click(Gq_Wizard::MoreInfo);
    EXPECT_EQ(rig.at(0).moreInfo, 1);

    rig.window->goNext();
    EXPECT_TRUE(adv->isVisibleTo(w));
    EXPECT_TRUE(adv->isEnabled());
    EXPECT_FALSE(info->isEnabled());
    rig.click(Gq_Wizard::Advanced);
    rig.click(Gq_Wizard::MoreInfo); // disabled: nothing happens
    EXPECT_EQ(rig.at(1).advanced, 1);
    EXPECT_EQ(rig.at(1).moreInfo, 0);
    EXPECT_EQ(rig.at(0).advanced, 0);
    EXPECT_EQ(rig.at(0).moreInfo, 1);
}

TEST(Wizard, KeyboardDrivesEveryButton)
{
    WizardRig rig({"A", "B", "C"});
    for (int i = 0; i < 3; ++i)
        rig.at(i).onEntry = [](ProbePage* p) {
            p->wizard()->showMoreInfo(true);
            p->wizard()->showAdvanced(true);
        };
    rig.window->setFinishHandler([] { return true; });
    rig.window->setCaption("Corvane Pendra");
    rig.window->start();
    Gq_Wizard* w = rig.window.get();
    ASSERT_TRUE(showAndActivate(w));
    EXPECT_EQ(w->windowTitle(), "Corvane Pendra");

    // A button's accelerator clicks it a moment later, as a click the user
    // can see; wait for the effect rather than a fixed time.
    // The shared buttons keep off the Alt-letters the page forms use.
    auto press = [w](Qt::Key key, Qt::KeyboardModifiers mods, const std::function<bool()>& done) {
        QTest::keyClick(w, key, mods);
        return QTest::qWaitFor(done, 2000);
    };
    EXPECT_TRUE(press(Qt::Key_Right, Qt::AltModifier, [&] { return w->currentIndex() == 1; }));
    EXPECT_TRUE(press(Qt::Key_Left, Qt::AltModifier, [&] { return w->currentIndex() == 0; }));
    QTest::keyClick(w, Qt::Key_Return);
    EXPECT_EQ(w->currentIndex(), 1);
    EXPECT_TRUE(press(Qt::Key_F1, Qt::NoModifier, [&] { return rig.at(1).moreInfo == 1; }));
    EXPECT_TRUE(press(Qt::Key_A, Qt::AltModifier, [&] { return rig.at(1).advanced == 1; }));
    EXPECT_TRUE(press(Qt::Key_Right, Qt::AltModifier, [&] { return w->currentIndex() == 2; }));
    // On the last page Enter finishes.
    QTest::keyClick(w, Qt::Key_Return);
    EXPECT_EQ(rig.at(2).finish, 1);
    EXPECT_FALSE(w->isVisible());
    EXPECT_EQ(w->result(), QDialog::Accepted);

    // Every button takes the focus from Tab.
    for (int b = Gq_Wizard::MoreInfo; b <= Gq_Wizard::Cancel; ++b)
        EXPECT_TRUE(rig.button(static_cast<Gq_Wizard::Button>(b))->focusPolicy() & Qt::TabFocus) << b;
}

TEST(Wizard, ControllersAndWindowMayGoInEitherOrder)
{
    auto window = std::make_unique<Gq_Wizard>();
    auto kept = std::make_unique<ProbePage>("Kept");
    auto* dropped = new ProbePage("Dropped");
    QPointer<QWidget> droppedForm = dropped->pageWidget();
    QPointer<QWidget> keptForm = kept->pageWidget();
    window->addPage(dropped);
    window->addPage(kept.get());
    window->start();
    ASSERT_EQ(window->currentPage(), dropped);

    delete dropped;
    EXPECT_TRUE(droppedForm.isNull());
    EXPECT_EQ(window->pageCount(), 1);
    EXPECT_EQ(window->currentPage(), nullptr);
    window->start();
    EXPECT_EQ(window->currentPage(), kept.get());

    // The window takes its widgets with it; the controller forgets it.
    window.reset();
    EXPECT_TRUE(keptForm.isNull());
    EXPECT_EQ(kept->pageWidget(), nullptr);
    EXPECT_EQ(kept->wizard(), nullptr);
}

TEST(Wizard, APageWithoutAWidgetOwnsNothing)
{
    // Batch mode: controllers exist, widgets never do.
    Gq_WizardPage page;
    EXPECT_EQ(page.pageWidget(), nullptr);
    auto* first = new QLabel("first");
    QPointer<QLabel> watch = first;
    page.setPageWidget(first);
    page.setPageWidget(new QLabel("second"));
    EXPECT_TRUE(watch.isNull()) << "a replaced widget is deleted";
}

// ---------------------------------------------------------------------------
// Summary page.

TEST(SummaryPage, IsWrittenAnewOnEveryEntry)
{
    int visits = 0;
    WizardRig rig({"A"});
    auto summary = std::make_unique<Gq_SummaryPage>([&] { return QString("<h2>Visit %1</h2>").arg(++visits); });
    summary->setPageName("Summary");
    rig.window->addPage(summary.get());
    rig.at(0).onEntry = [](ProbePage* p) {
        p->wizard()->showMoreInfo(true);
        p->wizard()->showAdvanced(true);
    };
    rig.window->start();
    auto* view = qobject_cast<QTextBrowser*>(summary->pageWidget());
    ASSERT_NE(view, nullptr);

    rig.window->goNext();
    EXPECT_EQ(view->toPlainText().trimmed(), "Visit 1");
    EXPECT_EQ(summary->html(), "<h2>Visit 1</h2>");
    // The summary offers no help or advanced settings of its own.
    EXPECT_FALSE(rig.button(Gq_Wizard::MoreInfo)->isVisibleTo(rig.window.get()));
    EXPECT_FALSE(rig.button(Gq_Wizard::Advanced)->isVisibleTo(rig.window.get()));

    rig.window->goBack();
    rig.window->goNext();
    EXPECT_EQ(view->toPlainText().trimmed(), "Visit 2");
    EXPECT_EQ(visits, 2);
    rig.window.reset();
}

TEST(SummaryPage, AHostWizardWithoutPagesEndsOnItsSummary)
{
    Tsy_WizMain wiz("dcm", false);
    Tsy_WizContext ctx;
    ctx.partName = "t5da1-2";
    ctx.moduleName = "clkgen";
    wiz.SetContext(ctx);
    int written = 0;
    wiz.SetOutputHooks(
        [&](StringBase&) {
            ++written;
            return true;
        },
        [] { return std::vector<StringBase>{"clkgen.v", "clkgen.tsw"}; });
    Gq_Wizard window;
    ASSERT_TRUE(wiz.PrepareGui(&window));
    window.start();
    ASSERT_EQ(window.pageCount(), 1);
    auto* view = qobject_cast<QTextBrowser*>(window.currentPage()->pageWidget());
    ASSERT_NE(view, nullptr);
    QString text = view->toPlainText();
    EXPECT_TRUE(text.contains("clkgen")) << text.toStdString();
    EXPECT_TRUE(text.contains("clkgen.tsw")) << text.toStdString();
    EXPECT_TRUE(window.button(Gq_Wizard::Finish)->isEnabled());
    EXPECT_TRUE(window.finish());
    EXPECT_EQ(written, 1);
}

// ---------------------------------------------------------------------------
// Dialogs that remember where they were.

class PlacedDialog : public Gq_Dialog {
public:
    explicit PlacedDialog(const QString& name = QString())
    {
        if (!name.isEmpty())
            setObjectName(name);
    }
};

class PlacementTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir_.path());
        QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir_.path());
    }
    QTemporaryDir dir_;
};

QRect placeAndClose(Gq_Dialog& d, const QRect& where, int result)
{
    d.show();
    d.setGeometry(where);
    QRect actual = d.geometry();
    if (result == QDialog::Accepted)
        d.accept();
    else
        d.reject();
    return actual;
}

TEST_F(PlacementTest, ADialogReopensWhereItWasLeft)
{
    struct Case {
        const char* what;
        QString firstName, secondName;
        int closedWith;
        bool remembered;
    };
    const Case cases[] = {
        {"same name, accepted", "Probe1", "Probe1", QDialog::Accepted, true},
        {"same name, cancelled", "Probe2", "Probe2", QDialog::Rejected, true},
        {"another name", "Probe3", "Probe3Other", QDialog::Accepted, false},
        {"unnamed dialogs share their class's place", "", "", QDialog::Accepted, true},
    };
    int shift = 0;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        shift += 20;
        const QRect where(150 + shift, 120 + shift, 430 + shift, 310 + shift);
        QRect placed;
        {
            PlacedDialog first(c.firstName);
            placed = placeAndClose(first, where, c.closedWith);
            ASSERT_EQ(placed.size(), where.size());
        }
        PlacedDialog second(c.secondName);
        second.show();
        EXPECT_EQ(second.geometry() == placed, c.remembered)
            << second.geometry().x() << "," << second.geometry().y() << " " << second.width() << "x"
            << second.height();
        second.reject();
    }
    // It all went to the settings of the product, not anywhere else.
    QSettings settings("Corvane", "Pendra");
    EXPECT_TRUE(settings.fileName().startsWith(dir_.path())) << settings.fileName().toStdString();
    EXPECT_TRUE(settings.contains("Dialogs/Probe1/geometry"));
}

TEST_F(PlacementTest, ShowingAgainInTheSameSessionKeepsTheCurrentPlace)
{
    PlacedDialog d("Again");
    placeAndClose(d, QRect(200, 200, 400, 300), QDialog::Accepted);
    d.show();
    d.setGeometry(QRect(260, 240, 500, 350));
    d.hide();
    d.show();
    EXPECT_EQ(d.geometry(), QRect(260, 240, 500, 350));
    d.accept();
}

// ---------------------------------------------------------------------------
// The image registry.

QByteArray bmpBytes(int w, int h, QColor colour)
{
    QImage image(w, h, QImage::Format_RGB32);
    image.fill(colour);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    EXPECT_TRUE(image.save(&buffer, "BMP"));
    return bytes;
}

Gq_ImageEntry entry(const QByteArray& bytes, const char* name)
{
    return Gq_ImageEntry{static_cast<unsigned int>(bytes.size()), reinterpret_cast<const unsigned char*>(bytes.constData()),
                         name};
}

TEST(ImageManager, RegistersATableAndDecodesOnDemand)
{
    Gq_ImageManager* images = Gq_ImageManager::getInstance();
    ASSERT_EQ(images, Gq_ImageManager::getInstance());
    const QByteArray red = bmpBytes(4, 3, Qt::red);
    const QByteArray blue = bmpBytes(7, 5, Qt::blue);
    const QByteArray garbage("BM this is no bitmap at all", 27);
    std::vector<Gq_ImageEntry> table = {
        entry(red, "tbl1_red"),
        entry(blue, "tbl1_blue"),
        entry(blue, "tbl1_red"), // again: the first one stays
        entry(garbage, "tbl1_corrupt"),
        entry(red, nullptr),     // nameless: cannot be asked for
        {40, nullptr, "tbl1_nodata"},
        {0, nullptr, nullptr},   // the end of the table
        entry(red, "tbl1_after_end"),
    };
    int before = images->imageCount();
    EXPECT_EQ(images->addImages(table.data(), sizeof(Gq_ImageEntry)), 3);
    EXPECT_EQ(images->imageCount(), before + 3);

    struct Expect {
        const char* name;
        bool known;
        QSize size;
        QColor colour;
    };
    const Expect expect[] = {
        {"tbl1_red", true, QSize(4, 3), Qt::red},
        {"tbl1_blue", true, QSize(7, 5), Qt::blue},
        {"tbl1_corrupt", true, QSize(), QColor()},
        {"tbl1_nodata", false, QSize(), QColor()},
        {"tbl1_after_end", false, QSize(), QColor()},
        {"never_registered", false, QSize(), QColor()},
    };
    for (const Expect& e : expect) {
        SCOPED_TRACE(e.name);
        EXPECT_EQ(images->hasImage(e.name), e.known);
        QImage image = images->getImage(e.name);
        EXPECT_EQ(image.isNull(), !e.size.isValid());
        if (e.size.isValid()) {
            EXPECT_EQ(image.size(), e.size);
            EXPECT_EQ(QColor(image.pixel(1, 1)), e.colour);
            // Decoded once, then handed out from the cache.
            EXPECT_EQ(images->getImage(e.name).cacheKey(), image.cacheKey());
        }
    }
}

TEST(ImageManager, WalksEntriesByTheGivenSize)
{
    // Entries may carry more than the registry needs.
    struct WideEntry {
        Gq_ImageEntry e;
        double extra;
    };
    const QByteArray green = bmpBytes(2, 2, Qt::green);
    std::vector<WideEntry> wide = {{entry(green, "tbl2_green"), 1.5}, {entry(green, "tbl2_green2"), 2.5},
                                   {{0, nullptr, nullptr}, 0}};
    Gq_ImageManager* images = Gq_ImageManager::getInstance();
    EXPECT_EQ(images->addImages(wide.data(), sizeof(WideEntry)), 2);
    EXPECT_EQ(QColor(images->getImage("tbl2_green2").pixel(0, 0)), QColor(Qt::green));

    // Entries smaller than one record cannot be read at all.
    std::vector<Gq_ImageEntry> table = {entry(green, "tbl2_small"), {0, nullptr, nullptr}};
    EXPECT_EQ(images->addImages(table.data(), 12), 0);
    EXPECT_FALSE(images->hasImage("tbl2_small"));
    EXPECT_EQ(images->addImages(nullptr, sizeof(Gq_ImageEntry)), 0);
}

TEST(ImageManager, KeepsItsOwnCopyOfTheBytes)
{
    QByteArray bytes = bmpBytes(3, 3, Qt::yellow);
    std::vector<Gq_ImageEntry> table = {entry(bytes, "tbl3_yellow"), {0, nullptr, nullptr}};
    Gq_ImageManager* images = Gq_ImageManager::getInstance();
    ASSERT_EQ(images->addImages(table.data(), sizeof(Gq_ImageEntry)), 1);
    // The table's owner goes away before the picture is first painted.
    bytes.fill('\0');
    bytes.clear();
    QImage image = images->getImage("tbl3_yellow");
    ASSERT_FALSE(image.isNull());
    EXPECT_EQ(QColor(image.pixel(2, 2)), QColor(Qt::yellow));
}

// ---------------------------------------------------------------------------
// Help pages.

const char* const kHelpKeys[] = {
    "tsy_dcmgen",  "tsy_dcmadv",   "tsy_dcmclkbuf",   "tsy_dcmpllclkbuf", "tsy_dcmclkfreq", "tsy_dcmeditbuf",
    "tsy_dcmbd",   "tsy_dcmcf",    "tsy_dcmcs",       "tsy_dcmca",        "tsy_dcmpmcd",    "tsy_dcmpllgen",
    "tsy_dcmpllclkset", "tsy_plladv", "tsy_dcmpllphaseimage", "tsy_dcm2pll",
};

QTextBrowser* helpBrowser()
{
    QWidget* w = Gq_HelpViewer::currentWindow();
    return w ? w->findChild<QTextBrowser*>() : nullptr;
}

TEST(HelpViewer, EveryTopicOfTheWizardHasAPage)
{
    QWidget* reused = nullptr;
    for (const char* key : kHelpKeys) {
        SCOPED_TRACE(key);
        ASSERT_FALSE(Gq_HelpViewer::topicFile(key).isEmpty());
        ASSERT_TRUE(Gq_HelpViewer::showTopic(key, nullptr));
        QWidget* window = Gq_HelpViewer::currentWindow();
        ASSERT_NE(window, nullptr);
        EXPECT_TRUE(window->isVisible());
        EXPECT_FALSE(window->isModal());
        EXPECT_EQ(window->windowTitle(), "Corvane Pendra - Help");
        if (reused) {
            EXPECT_EQ(window, reused) << "one help window serves every topic";
        }
        reused = window;

        QTextBrowser* browser = helpBrowser();
        ASSERT_NE(browser, nullptr);
        QString title = browser->documentTitle();
        QString body = browser->toPlainText();
        EXPECT_GE(title.size(), 8) << title.toStdString();
        EXPECT_GE(body.size(), 1200) << "a page that explains its settings";
        EXPECT_TRUE(body.contains("Pendra"));
        // Each page opens with its own heading.
        EXPECT_TRUE(body.trimmed().startsWith(title.section(" - ", -1).left(6))) << title.toStdString();
    }
    Gq_HelpViewer::currentWindow()->close();
}

TEST(HelpViewer, LinksBetweenPagesLeadToPagesThatExist)
{
    QRegularExpression href("href=\"([^\"#]+)");
    for (const char* key : kHelpKeys) {
        SCOPED_TRACE(key);
        QFile file(Gq_HelpViewer::topicFile(key));
        ASSERT_TRUE(file.open(QIODevice::ReadOnly));
        QString html = QString::fromUtf8(file.readAll());
        EXPECT_TRUE(html.contains("<title>"));
        auto links = href.globalMatch(html);
        while (links.hasNext()) {
            QString target = links.next().captured(1);
            if (target.startsWith("http"))
                continue;
            EXPECT_TRUE(QFile::exists(QFileInfo(file).dir().filePath(target))) << target.toStdString();
        }
    }
}

TEST(HelpViewer, RefusesKeysWithoutAPage)
{
    const char* bad[] = {"tsy_nosuchtopic", "", "../help/tsy_dcmgen", "TSY DCMGEN", "tsy_dcmgen.html"};
    for (const char* key : bad) {
        SCOPED_TRACE(key);
        EXPECT_TRUE(Gq_HelpViewer::topicFile(key).isEmpty());
        EXPECT_FALSE(Gq_HelpViewer::showTopic(key, nullptr));
    }
}

TEST(HelpViewer, HelpAskedFromAModalDialogCanBeUsed)
{
    QDialog owner;
    owner.setObjectName("WizardStandIn");
    bool shown = false;
    QWidget* helpParent = nullptr;
    bool blocked = true;
    whileModal<int>([&] { return owner.exec(); },
                    [&](QWidget* modal) {
                        // A modal dialog of its own, opened over the owner.
                        QDialog advanced(modal);
                        whileModal<int>([&] { return advanced.exec(); },
                                        [&](QWidget* top) {
                                            shown = Gq_HelpViewer::showTopic("tsy_dcmadv", &owner);
                                            QWidget* help = Gq_HelpViewer::currentWindow();
                                            helpParent = help ? help->parentWidget() : nullptr;
                                            blocked = help && QApplication::activeModalWidget() == top &&
                                                      help->parentWidget() != top;
                                            top->close();
                                        });
                        modal->close();
                    });
    EXPECT_TRUE(shown);
    EXPECT_FALSE(blocked) << "the help window must belong to the dialog that asked";
    EXPECT_NE(helpParent, &owner);
}

// ---------------------------------------------------------------------------
// The start dialog.

class StartDialogTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        write("wizards.json", R"({"plugin": "libnone.so", "wizards": [
            {"key": "dcm_pll", "description": "Single PLL", "requires": ["pll"]},
            {"key": "dcm", "description": "Single DCM"}]})");
        write("devices.json", R"({
            "families": [
              {"key": "taldor5", "name": "Taldor5", "prefix": "t5", "dcm_primitive": "DCM_ADV",
               "capabilities": ["pll"], "speed_file": "speed/t5.json", "speed_grades": ["-1", "-2"]},
              {"key": "membra3e", "name": "Membra-3E", "prefix": "m3e", "dcm_primitive": "DCM_SP",
               "speed_file": "speed/m3e.json", "speed_grades": ["-4"]}],
            "devices": [
              {"name": "t5da1", "family": "taldor5"},
              {"name": "m3e100", "family": "membra3e"}]})");
        wizards_ = Tsy_WizardCatalog::LoadFile(path("wizards.json"));
        devices_ = Tsy_DeviceCatalog::LoadFile(path("devices.json"));
        dialog_ = std::make_unique<Gq_StartDialog>(*wizards_, *devices_);
        dialog_->setObjectName("StartDialogUnderTest");
    }
    std::string path(const char* name) const { return dir_.filePath(name).toStdString(); }
    void write(const char* name, const char* text) const
    {
        QFile f(dir_.filePath(name));
        ASSERT_TRUE(f.open(QIODevice::WriteOnly));
        f.write(text);
    }
    template <typename T>
    T* child(const char* name) const
    {
        T* w = dialog_->findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    void type(QWidget* field, const QString& text) const
    {
        if (auto* edit = qobject_cast<QLineEdit*>(field))
            edit->clear();
        if (auto* combo = qobject_cast<QComboBox*>(field))
            combo->clearEditText();
        QTest::keyClicks(field, text);
    }

    QTemporaryDir dir_;
    std::unique_ptr<Tsy_WizardCatalog> wizards_;
    std::unique_ptr<Tsy_DeviceCatalog> devices_;
    std::unique_ptr<Gq_StartDialog> dialog_;
};

TEST_F(StartDialogTest, OffersTheCataloguesWithSensibleDefaults)
{
    EXPECT_EQ(dialog_->windowTitle(), "Corvane Pendra - New Design");
    auto* wizards = child<QComboBox>("ComboWizard");
    ASSERT_EQ(wizards->count(), 2);
    EXPECT_EQ(wizards->itemText(1), "dcm - Single DCM");
    auto* parts = child<QComboBox>("ComboPart");
    QStringList listed;
    for (int i = 0; i < parts->count(); ++i)
        listed << parts->itemText(i);
    EXPECT_EQ(listed, QStringList({"t5da1-1", "t5da1-2", "m3e100-4"}));

    EXPECT_EQ(dialog_->wizardKey(), "dcm");
    EXPECT_EQ(dialog_->part(), "t5da1-1");
    EXPECT_EQ(dialog_->moduleName(), "clkgen");
    EXPECT_EQ(dialog_->outputFolder(), ".");
    EXPECT_TRUE(dialog_->okButton()->isEnabled());
    EXPECT_TRUE(dialog_->problem().isEmpty());
}

TEST_F(StartDialogTest, ModuleNameIsCheckedAsTyped)
{
    struct Case {
        const char* typed;
        bool accepted;
        const char* because;
    };
    const Case cases[] = {
        {"clkgen", true, ""},
        {"clk_gen2", true, ""},
        {"9clocks", false, "begin with a letter"},
        {"", false, "empty"},
        {"entity", false, "VHDL keyword"},
        {"clk__a", false, "two '_'"},
        {"clk-a", false, "letters, digits"},
        {"top_", false, "end with"},
    };
    auto* module = child<QLineEdit>("LineEditModule");
    auto* note = child<QLabel>("TextLabelModuleProblem");
    dialog_->show();
    for (const Case& c : cases) {
        SCOPED_TRACE(c.typed);
        type(module, c.typed);
        EXPECT_EQ(dialog_->moduleName(), c.typed);
        EXPECT_EQ(dialog_->okButton()->isEnabled(), c.accepted);
        EXPECT_EQ(note->isVisible(), !c.accepted);
        if (!c.accepted) {
            EXPECT_TRUE(note->text().contains(c.because)) << note->text().toStdString();
        }
    }
    dialog_->reject();
}

TEST_F(StartDialogTest, PartMustBeKnownAndAbleToBuildTheWizard)
{
    struct Case {
        const char* wizard;
        const char* typed;
        bool accepted;
        const char* part;
        const char* because;
    };
    const Case cases[] = {
        {"dcm", "t5da1-2", true, "t5da1-2", ""},
        {"dcm", "T5DA1-2", true, "t5da1-2", ""},
        {"dcm", "m3e100-4", true, "m3e100-4", ""},
        {"dcm", "t5da1-9", false, "t5da1-9", "no part named"},
        {"dcm", "", false, "", "Choose a part"},
        {"dcm_pll", "t5da1-1", true, "t5da1-1", ""},
        {"dcm_pll", "m3e100-4", false, "m3e100-4", "Membra-3E family"},
    };
    auto* part = child<QComboBox>("ComboPart");
    auto* note = child<QLabel>("TextLabelPartProblem");
    dialog_->show();
    for (const Case& c : cases) {
        SCOPED_TRACE(std::string(c.wizard) + " " + c.typed);
        dialog_->setWizardKey(c.wizard);
        ASSERT_EQ(dialog_->wizardKey(), c.wizard);
        type(part, c.typed);
        EXPECT_EQ(dialog_->part(), c.part);
        EXPECT_EQ(dialog_->okButton()->isEnabled(), c.accepted);
        EXPECT_EQ(note->isVisible(), !c.accepted);
        if (!c.accepted) {
            EXPECT_TRUE(note->text().contains(c.because)) << note->text().toStdString();
        }
    }
    // Choosing a wizard the part can build clears the complaint.
    dialog_->setWizardKey("dcm");
    EXPECT_TRUE(dialog_->okButton()->isEnabled());
    dialog_->reject();
}

TEST_F(StartDialogTest, OkIsRefusedWhileSomethingIsWrong)
{
    type(child<QLineEdit>("LineEditModule"), "1bad");
    QTest::mouseClick(dialog_->okButton(), Qt::LeftButton);
    EXPECT_FALSE(dialog_->okButton()->isEnabled());
    // Enter does not slip past the check either.
    int rc = whileModal<int>([&] { return dialog_->exec(); },
                             [&](QWidget* modal) {
                                 QTest::keyClick(modal, Qt::Key_Return);
                                 EXPECT_TRUE(modal->isVisible());
                                 modal->close();
                             });
    EXPECT_EQ(rc, QDialog::Rejected);

    type(child<QLineEdit>("LineEditModule"), "good_name");
    rc = whileModal<int>([&] { return dialog_->exec(); },
                         [&](QWidget* modal) { QTest::keyClick(modal, Qt::Key_Return); });
    EXPECT_EQ(rc, QDialog::Accepted);
    EXPECT_EQ(dialog_->moduleName(), "good_name");
}

TEST_F(StartDialogTest, LabelsLeadTheKeyboardToTheirFields)
{
    ASSERT_TRUE(showAndActivate(dialog_.get()));
    const std::pair<Qt::Key, const char*> keys[] = {
        {Qt::Key_M, "LineEditModule"},
        {Qt::Key_P, "ComboPart"},
        {Qt::Key_F, "LineEditFolder"},
        {Qt::Key_W, "ComboWizard"},
    };
    for (const auto& [key, field] : keys) {
        SCOPED_TRACE(field);
        QTest::keyClick(dialog_.get(), key, Qt::AltModifier);
        QWidget* focus = QApplication::focusWidget();
        ASSERT_NE(focus, nullptr);
        QWidget* expected = dialog_->findChild<QWidget*>(field);
        EXPECT_TRUE(focus == expected || expected->isAncestorOf(focus)) << focus->objectName().toStdString();
    }
    dialog_->reject();
}

TEST_F(StartDialogTest, BrowseFillsInTheChosenFolder)
{
    QTemporaryDir chosen;
    ASSERT_TRUE(chosen.isValid());
    dialog_->show();
    whileModal<int>(
        [&] {
            QTest::mouseClick(child<QPushButton>("PushButtonBrowse"), Qt::LeftButton);
            return 0;
        },
        [&](QWidget* modal) {
            auto* files = qobject_cast<QFileDialog*>(modal);
            ASSERT_NE(files, nullptr);
            // Entering the folder and accepting chooses it; selecting its
            // name in the parent would race the dialog's file listing.
            files->setDirectory(chosen.path());
            QMetaObject::invokeMethod(files, "accept");
        });
    EXPECT_EQ(QFileInfo(dialog_->outputFolder()).canonicalFilePath(), QFileInfo(chosen.path()).canonicalFilePath());

    // Cancelling the folder dialog leaves the folder alone.
    QString before = dialog_->outputFolder();
    whileModal<int>(
        [&] {
            QTest::mouseClick(child<QPushButton>("PushButtonBrowse"), Qt::LeftButton);
            return 0;
        },
        [&](QWidget* modal) { qobject_cast<QDialog*>(modal)->reject(); });
    EXPECT_EQ(dialog_->outputFolder(), before);

    type(child<QLineEdit>("LineEditFolder"), "");
    EXPECT_FALSE(dialog_->okButton()->isEnabled());
    dialog_->reject();
}

TEST(StartDialog, ReportsCataloguesItCannotRead)
{
    QTemporaryDir empty;
    QByteArray saved = qgetenv("PENDRA_DATA_DIR");
    qputenv("PENDRA_DATA_DIR", empty.path().toUtf8());
    QString error;
    auto dialog = Gq_StartDialog::fromDataDir(error);
    if (saved.isNull())
        qunsetenv("PENDRA_DATA_DIR");
    else
        qputenv("PENDRA_DATA_DIR", saved);
    EXPECT_EQ(dialog, nullptr);
    EXPECT_TRUE(error.contains("wizards.json")) << error.toStdString();
}

// ---------------------------------------------------------------------------
// Messages and questions in GUI mode.

struct SeenBox {
    QString title, text;
    QMessageBox::Icon icon = QMessageBox::NoIcon;
    Qt::TextFormat format = Qt::AutoText;
    QString defaultButton;
};

SeenBox look(QWidget* modal)
{
    SeenBox seen;
    auto* box = qobject_cast<QMessageBox*>(modal);
    EXPECT_NE(box, nullptr);
    if (!box)
        return seen;
    seen.title = box->windowTitle();
    seen.text = box->text();
    seen.icon = box->icon();
    seen.format = box->textFormat();
    if (box->defaultButton())
        seen.defaultButton = box->defaultButton()->text().remove('&');
    return seen;
}

TEST(DialogStream, ErrorsAndNotesShowInMessageBoxes)
{
    struct Case {
        const char* text;
        bool isError;
        bool flag3;
        QMessageBox::Icon icon;
        int errorsAfter;
    };
    const Case cases[] = {
        {"The input clock frequency is out of range.", true, false, QMessageBox::Critical, 1},
        {"The DIRECT phase shift starts at 0.", false, false, QMessageBox::Information, 1},
        {"Ranges:\n  Low   32.000 - 210.000\n  High 210.000 - 450.000\n", true, true, QMessageBox::Critical, 2},
    };
    Tsy_DialogStream stream;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        SeenBox seen;
        whileModal<int>(
            [&] {
                stream.Message(c.text, c.isError, false, c.flag3);
                return 0;
            },
            [&](QWidget* modal) {
                seen = look(modal);
                modal->close();
            });
        EXPECT_EQ(seen.title, "Corvane Pendra");
        EXPECT_EQ(seen.icon, c.icon);
        EXPECT_EQ(stream.ErrorCount(), c.errorsAfter);
        if (c.flag3) {
            // Columns stay lined up: each line kept, blanks kept, fixed pitch.
            EXPECT_EQ(seen.format, Qt::RichText);
            EXPECT_TRUE(seen.text.contains("<pre"));
            EXPECT_TRUE(seen.text.contains("  Low   32.000 - 210.000\n  High 210.000 - 450.000"));
        } else {
            EXPECT_EQ(seen.format, Qt::PlainText);
            EXPECT_EQ(seen.text, c.text);
        }
    }
}

TEST(DialogStream, MarkupInAMessageIsShownAsTyped)
{
    Tsy_DialogStream stream;
    SeenBox seen;
    whileModal<int>(
        [&] {
            stream.Message("Signal <CLK0> & friends", false, false, false);
            return 0;
        },
        [&](QWidget* modal) {
            seen = look(modal);
            modal->close();
        });
    EXPECT_EQ(seen.text, "Signal <CLK0> & friends");
    EXPECT_EQ(seen.format, Qt::PlainText);
}

TEST(DialogStream, QuestionsDefaultToNo)
{
    struct Case {
        const char* what;
        std::function<void(QMessageBox*)> answer;
        int expect;
    };
    const Case cases[] = {
        {"Yes clicked", [](QMessageBox* b) { QTest::mouseClick(b->button(QMessageBox::Yes), Qt::LeftButton); }, 1},
        {"No clicked", [](QMessageBox* b) { QTest::mouseClick(b->button(QMessageBox::No), Qt::LeftButton); }, 0},
        {"Enter pressed", [](QMessageBox* b) { QTest::keyClick(b, Qt::Key_Return); }, 0},
        {"Escape pressed", [](QMessageBox* b) { QTest::keyClick(b, Qt::Key_Escape); }, 0},
    };
    Tsy_DialogStream stream;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        SeenBox seen;
        int answer = whileModal<int>([&] { return stream.Ask("Do you want to continue anyway?", ""); },
                                     [&](QWidget* modal) {
                                         seen = look(modal);
                                         c.answer(qobject_cast<QMessageBox*>(modal));
                                     });
        EXPECT_EQ(answer != 0, c.expect != 0);
        EXPECT_EQ(seen.text, "Do you want to continue anyway?");
        EXPECT_EQ(seen.icon, QMessageBox::Question);
        EXPECT_EQ(seen.defaultButton, "No");
    }
    EXPECT_EQ(stream.ErrorCount(), 0);
}

TEST(DialogStream, LoggedMessagesGoToStandardError)
{
    Tsy_DialogStream stream;
    std::ostringstream captured;
    std::streambuf* old = std::cerr.rdbuf(captured.rdbuf());
    stream.Log("DCM block not found.", true);
    stream.Log("Loading default.\n", false);
    std::cerr.rdbuf(old);
    EXPECT_EQ(captured.str(), "ERROR: DCM block not found.\nINFO: Loading default.\n");
    EXPECT_EQ(stream.ErrorCount(), 1);
    EXPECT_EQ(QApplication::activeModalWidget(), nullptr);
}

// ---------------------------------------------------------------------------
// The busy note.

QWidget* waitNote()
{
    for (QWidget* w : QApplication::topLevelWidgets())
        if (w->objectName() == "WaitNote")
            return w;
    return nullptr;
}

TEST(WaitNote, ShowsItsTextUntilQuit)
{
    {
        Tsy_Wait2Dlg wait;
        wait.SetText("Loading speed data...");
        EXPECT_FALSE(wait.IsShown());
        wait.Run();
        EXPECT_TRUE(wait.IsShown());
        QWidget* note = waitNote();
        ASSERT_NE(note, nullptr);
        EXPECT_TRUE(note->isVisible());
        auto* label = note->findChild<QLabel*>();
        ASSERT_NE(label, nullptr);
        EXPECT_EQ(label->text(), "Loading speed data...");
        wait.SetText("Reading the design...");
        EXPECT_EQ(label->text(), "Reading the design...");
        wait.Quit();
        EXPECT_FALSE(wait.IsShown());
        EXPECT_EQ(waitNote(), nullptr);
        // Shown again after a Quit.
        wait.Run();
        EXPECT_TRUE(wait.IsShown());
    }
    // Gone with its owner even when nobody called Quit.
    EXPECT_EQ(waitNote(), nullptr);
}

} // namespace
