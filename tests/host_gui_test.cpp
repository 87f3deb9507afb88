// The host's GUI layer, driven the way a user drives it: buttons clicked,
// keys pressed, dialogs answered, under Qt's offscreen platform.

#include "gui/Gq_Dialog.h"
#include "gui/Gq_HelpViewer.h"
#include "gui/Gq_ImageManager.h"
#include "gui/Gq_StartDialog.h"
#include "gui/Gq_SummaryPage.h"
#include "gui/Tsy_DialogStream.h"
#include "gui/Tsy_Wait2Dlg.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "run/Tsy_WizardCatalog.h"
#include "support/GuiTest.h"
#include "wiz/Tsy_WizMain.h"

#include <QApplication>
#include <QBuffer>
#include <QFile>
#include <QFileDialog>
#include <QLabel>
#include <QMessageBox>
#include <QPushButton>
#include <QRegularExpression>
#include <QSettings>
#include <QStackedWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTextBrowser>

#include <iostream>
#include <memory>
#include <sstream>
#include <vector>

namespace {

// A page that records what the window asked of it and answers as told.
class ProbePage : public Gq_WizardPage {
public:
    explicit ProbePage(const QString& name)
    {
        setPageName(name);
        setPageWidget(new QLabel("Form of " + name));
    }
    void onActive() override
    {
        ++active;
        if (onEntry)
            onEntry(this);
    }
    bool onNext() override { return ++next, allowNext; }
    bool onBack() override { return ++back, allowBack; }
    bool onFinish() override { return ++finish, allowFinish; }
    void onCancel() override { ++cancel; }
    void onAdvanced() override { ++advanced; }
    void onMoreInfo() override { ++moreInfo; }

    bool allowNext = true, allowBack = true, allowFinish = true;
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
    // Where the user is: the index, the title and the form shown.
    void expectAt(int i)
    {
        EXPECT_EQ(window->currentIndex(), i);
        EXPECT_EQ(title(), at(i).pageName());
        EXPECT_EQ(shownForm(), at(i).pageWidget());
    }

    std::vector<std::unique_ptr<ProbePage>> pages;
    std::unique_ptr<Gq_Wizard> window = std::make_unique<Gq_Wizard>();
};

} // namespace

// ---------------------------------------------------------------------------
// Wizard window: moving between pages.

TEST(Wizard, StartsOnTheFirstPageAndOffersFinishOnlyOnTheLast)
{
    WizardRig rig({"A", "B", "C"});
    rig.window->start();
    EXPECT_EQ(rig.at(0).active, 1);
    EXPECT_EQ(rig.at(1).active, 0);
    // The page widget now belongs to the window.
    EXPECT_TRUE(rig.window->isAncestorOf(rig.at(0).pageWidget()));
    EXPECT_EQ(rig.at(0).wizard(), rig.window.get());
    const struct {
        bool back, next, finish;
    } expect[] = {{false, true, false}, {true, true, false}, {true, false, true}};
    for (int i = 0; i < 3; ++i) {
        SCOPED_TRACE(i);
        rig.expectAt(i);
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

TEST(Wizard, NextAndBackMoveOnlyWhenThePageAgrees)
{
    struct Case {
        int startAt;
        Gq_Wizard::Button press;
        bool pageAgrees;
        int expectIndex;
    } cases[] = {{0, Gq_Wizard::Next, true, 1}, {0, Gq_Wizard::Next, false, 0},
                 {2, Gq_Wizard::Back, true, 1}, {2, Gq_Wizard::Back, false, 2}};
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.startAt << " " << c.press << " " << c.pageAgrees);
        WizardRig rig({"A", "B", "C"});
        rig.window->start();
        while (rig.window->currentIndex() < c.startAt)
            ASSERT_TRUE(rig.window->goNext());
        ProbePage& here = rig.at(c.startAt);
        here.allowNext = here.allowBack = c.pageAgrees;
        int activeBefore = rig.at(c.expectIndex).active;
        rig.click(c.press);
        rig.expectAt(c.expectIndex);
        EXPECT_EQ(c.press == Gq_Wizard::Next ? here.next : here.back, 1);
        // Only a page actually entered is told so.
        EXPECT_EQ(rig.at(c.expectIndex).active, activeBefore + (c.pageAgrees ? 1 : 0));
    }
}

TEST(Wizard, HiddenPagesArePassedOverAndNamedPast)
{
    WizardRig rig({"General Setup", "Phase-Matched Clock Divider", "Extra", "Clock Buffers"});
    rig.at(0).setPageNextName("Phase-Matched Clock Divider");
    rig.at(3).setPageBackName("Extra");
    rig.at(1).hidePage(true);
    rig.at(2).hidePage(true);
    rig.window->start();
    // A button skipping a hidden page names the page it leads to.
    EXPECT_EQ(rig.button(Gq_Wizard::Next)->text(), "Clock Buffers >");
    EXPECT_TRUE(rig.window->goNext());
    rig.expectAt(3);
    EXPECT_EQ(rig.button(Gq_Wizard::Back)->text(), "< General Setup");
    EXPECT_TRUE(rig.window->goBack());
    rig.expectAt(0);
    EXPECT_EQ(rig.at(1).active + rig.at(2).active + rig.at(1).next + rig.at(2).next, 0);

    // A page that hides itself on entry is passed through, both ways.
    rig.at(2).hidePage(false);
    rig.at(2).onEntry = [](ProbePage* p) { p->hidePage(true); };
    rig.click(Gq_Wizard::Next);
    rig.expectAt(3);
    EXPECT_EQ(rig.at(2).active, 1);
    rig.at(2).hidePage(false);
    rig.click(Gq_Wizard::Back);
    rig.expectAt(0);
    EXPECT_EQ(rig.at(2).active, 2);
    // When every page ahead hides itself the user stays put.
    rig.at(2).hidePage(false);
    rig.at(3).onEntry = [](ProbePage* p) { p->hidePage(true); };
    EXPECT_FALSE(rig.window->goNext());
    rig.expectAt(0);

    // A first page that is hidden is not where the wizard starts.
    WizardRig late({"A", "B"});
    late.at(0).hidePage(true);
    late.window->start();
    EXPECT_EQ(late.window->currentIndex(), 1);
    EXPECT_FALSE(late.button(Gq_Wizard::Back)->isEnabled());
}

TEST(Wizard, BackAndNextCarryTheNeighbouringPagesNames)
{
    struct Case {
        QString backName, nextName;
        QString backText, nextText;
    } cases[] = {
        {"General Setup", "Clock Buffers", "< General Setup", "Clock Buffers >"},
        {"", "", "< Left", "Right >"}, // no names given: the neighbours' own
        {"R&D Setup", "Q&A", "< R&&D Setup", "Q&&A >"}, // an ampersand shows as itself
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.backText.toStdString());
        WizardRig rig({"Left", "Middle", "Right"});
        rig.at(1).setPageBackName(c.backName);
        rig.at(1).setPageNextName(c.nextName);
        rig.window->start();
        rig.window->goNext();
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

TEST(Wizard, FinishClosesOnlyWhenPageAndHandlerAgree)
{
    struct Case {
        bool pageAgrees, handlerAgrees, handlerAsked, closes;
    } cases[] = {{true, true, true, true}, {true, false, true, false}, {false, true, false, false}};
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << "page " << c.pageAgrees << " handler " << c.handlerAgrees);
        WizardRig rig({"A", "Summary"});
        int asked = 0;
        rig.window->setFinishHandler([&] { return ++asked, c.handlerAgrees; });
        rig.window->start();
        rig.window->show();
        rig.window->goNext();
        rig.at(1).allowFinish = c.pageAgrees;
        rig.click(Gq_Wizard::Finish);
        EXPECT_EQ(rig.at(1).finish, 1);
        EXPECT_EQ(asked > 0, c.handlerAsked);
        EXPECT_EQ(rig.window->isVisible(), !c.closes);
        EXPECT_TRUE(!c.closes || rig.window->result() == QDialog::Accepted);
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
        rig.window->setFinishHandler([&] { return ++finished, true; });
        rig.window->start();
        ASSERT_TRUE(ShowAndActivate(rig.window.get()));
        rig.window->goNext();
        act(rig);
        EXPECT_FALSE(rig.window->isVisible());
        EXPECT_EQ(rig.window->result(), QDialog::Rejected);
        EXPECT_EQ(rig.at(1).cancel, 1);
        EXPECT_EQ(rig.at(0).cancel, 0);
        EXPECT_EQ(finished + rig.at(1).finish, 0);
    }
}

TEST(Wizard, MoreInfoAdvancedAndTheKeyboardReachTheCurrentPage)
{
    WizardRig rig({"A", "B", "C"});
    // A shows help only; B has both, its help disabled; C has both.
    for (int i = 0; i < 3; ++i)
        rig.at(i).onEntry = [i](ProbePage* p) {
            p->wizard()->showMoreInfo(true);
            p->wizard()->enableMoreInfo(i != 1);
            p->wizard()->showAdvanced(i != 0);
            p->wizard()->enableAdvanced(i != 0);
        };
    rig.window->setFinishHandler([] { return true; });
    rig.window->setCaption("Corvane Pendra");
    rig.window->start();
    Gq_Wizard* w = rig.window.get();
    ASSERT_TRUE(ShowAndActivate(w));
    EXPECT_EQ(w->windowTitle(), "Corvane Pendra");
    QPushButton* info = rig.button(Gq_Wizard::MoreInfo);
    QPushButton* adv = rig.button(Gq_Wizard::Advanced);
    EXPECT_TRUE(info->isVisible() && info->isEnabled());
    EXPECT_FALSE(adv->isVisible());
    rig.click(Gq_Wizard::MoreInfo);

    // A button's accelerator clicks it a moment later, as a click the user
    // can see. The shared buttons keep off the Alt-letters the forms use.
    auto press = [w](Qt::Key key, Qt::KeyboardModifiers mods, const std::function<bool()>& done) {
        QTest::keyClick(w, key, mods);
        return Eventually(done);
    };
    EXPECT_TRUE(press(Qt::Key_Right, Qt::AltModifier, [&] { return w->currentIndex() == 1; }));
    EXPECT_TRUE(adv->isVisible() && adv->isEnabled());
    EXPECT_FALSE(info->isEnabled());
    rig.click(Gq_Wizard::MoreInfo); // disabled: nothing happens
    EXPECT_TRUE(press(Qt::Key_A, Qt::AltModifier, [&] { return rig.at(1).advanced == 1; }));
    EXPECT_TRUE(press(Qt::Key_Left, Qt::AltModifier, [&] { return w->currentIndex() == 0; }));
    QTest::keyClick(w, Qt::Key_Return);
    EXPECT_EQ(w->currentIndex(), 1);
    EXPECT_TRUE(press(Qt::Key_Right, Qt::AltModifier, [&] { return w->currentIndex() == 2; }));
    EXPECT_TRUE(press(Qt::Key_F1, Qt::NoModifier, [&] { return rig.at(2).moreInfo == 1; }));
    const int asked[3][2] = {{1, 0}, {0, 1}, {1, 0}}; // help, advanced
    for (int i = 0; i < 3; ++i)
        EXPECT_EQ(std::make_pair(rig.at(i).moreInfo, rig.at(i).advanced), std::make_pair(asked[i][0], asked[i][1]))
            << i;
    // On the last page Enter finishes.
    QTest::keyClick(w, Qt::Key_Return);
    EXPECT_EQ(rig.at(2).finish, 1);
    EXPECT_FALSE(w->isVisible());
    EXPECT_EQ(w->result(), QDialog::Accepted);
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

    // Batch mode: controllers exist, widgets never do; a replaced widget goes.
    Gq_WizardPage page;
    EXPECT_EQ(page.pageWidget(), nullptr);
    QPointer<QLabel> first = new QLabel("first");
    page.setPageWidget(first);
    page.setPageWidget(new QLabel("second"));
    EXPECT_TRUE(first.isNull());
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
    wiz.SetOutputHooks([&](StringBase&) { return ++written, true; },
                       [] { return std::vector<StringBase>{"clkgen.v", "clkgen.tsw"}; });
    Gq_Wizard window;
    ASSERT_TRUE(wiz.PrepareGui(&window));
    window.start();
    ASSERT_EQ(window.pageCount(), 1);
    auto* view = qobject_cast<QTextBrowser*>(window.currentPage()->pageWidget());
    ASSERT_NE(view, nullptr);
    QString text = view->toPlainText();
    EXPECT_TRUE(text.contains("clkgen") && text.contains("clkgen.tsw")) << text.toStdString();
    EXPECT_TRUE(window.button(Gq_Wizard::Finish)->isEnabled());
    EXPECT_TRUE(window.finish());
    EXPECT_EQ(written, 1);
}

// ---------------------------------------------------------------------------
// Dialogs that remember where they were.

class PlacedDialog : public Gq_Dialog {
public:
    explicit PlacedDialog(const QString& name)
    {
        if (!name.isEmpty())
            setObjectName(name);
    }
};

TEST(Placement, ADialogReopensWhereItWasLeft)
{
    QTemporaryDir dir;
    ASSERT_TRUE(dir.isValid());
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.path());
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.path());
    struct Case {
        QString firstName, secondName;
        int closedWith;
        bool remembered;
    } cases[] = {
        {"Probe1", "Probe1", QDialog::Accepted, true},
        {"Probe2", "Probe2", QDialog::Rejected, true},
        {"Probe3", "Probe3Other", QDialog::Accepted, false},
        {"", "", QDialog::Accepted, true}, // unnamed dialogs share their class's place
    };
    int shift = 0;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.secondName.toStdString());
        shift += 20;
        const QRect where(150 + shift, 120 + shift, 430 + shift, 310 + shift);
        QRect placed;
        {
            PlacedDialog first(c.firstName);
            first.show();
            first.setGeometry(where);
            placed = first.geometry();
            ASSERT_EQ(placed.size(), where.size());
            c.closedWith == QDialog::Accepted ? first.accept() : first.reject();
        }
        PlacedDialog second(c.secondName);
        second.show();
        EXPECT_EQ(second.geometry() == placed, c.remembered) << second.x() << "," << second.y();
        // Shown again in the same session, it stays where it is now.
        second.setGeometry(QRect(260, 240, 500, 350));
        second.hide();
        second.show();
        EXPECT_EQ(second.geometry(), QRect(260, 240, 500, 350));
        second.reject();
    }
    // It all went to the settings of the product, not anywhere else.
    QSettings settings("Corvane", "Pendra");
    EXPECT_TRUE(settings.fileName().startsWith(dir.path())) << settings.fileName().toStdString();
    EXPECT_TRUE(settings.contains("Dialogs/Probe1/geometry"));
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

TEST(ImageManager, RegistersTablesAndDecodesOnDemandFromItsOwnCopy)
{
    Gq_ImageManager* images = Gq_ImageManager::getInstance();
    ASSERT_EQ(images, Gq_ImageManager::getInstance());
    QByteArray red = bmpBytes(4, 3, Qt::red);
    QByteArray blue = bmpBytes(7, 5, Qt::blue);
    const QByteArray garbage("BM this is no bitmap at all", 27);
    std::vector<Gq_ImageEntry> table = {
        entry(red, "tbl1_red"),
        entry(blue, "tbl1_blue"),
        entry(blue, "tbl1_red"), // again: the first one stays
        entry(garbage, "tbl1_corrupt"),
        entry(red, nullptr), // nameless: cannot be asked for
        {40, nullptr, "tbl1_nodata"},
        {0, nullptr, nullptr}, // the end of the table
        entry(red, "tbl1_after_end"),
    };
    int before = images->imageCount();
    EXPECT_EQ(images->addImages(table.data(), sizeof(Gq_ImageEntry)), 3);
    EXPECT_EQ(images->imageCount(), before + 3);
    // The table's owner goes away before a picture is first painted.
    for (QByteArray* bytes : {&red, &blue}) {
        bytes->fill('\0');
        bytes->clear();
    }
    struct Expect {
        const char* name;
        bool known;
        QSize size;
        QColor colour;
    } expect[] = {
        {"tbl1_red", true, QSize(4, 3), Qt::red},         {"tbl1_blue", true, QSize(7, 5), Qt::blue},
        {"tbl1_corrupt", true, QSize(), QColor()},        {"tbl1_nodata", false, QSize(), QColor()},
        {"tbl1_after_end", false, QSize(), QColor()},     {"never_registered", false, QSize(), QColor()},
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

    // Entries may carry more than the registry needs.
    struct WideEntry {
        Gq_ImageEntry e;
        double extra;
    };
    const QByteArray green = bmpBytes(2, 2, Qt::green);
    std::vector<WideEntry> wide = {{entry(green, "tbl2_green"), 1.5}, {entry(green, "tbl2_green2"), 2.5},
                                   {{0, nullptr, nullptr}, 0}};
    EXPECT_EQ(images->addImages(wide.data(), sizeof(WideEntry)), 2);
    EXPECT_EQ(QColor(images->getImage("tbl2_green2").pixel(0, 0)), QColor(Qt::green));
    // Entries smaller than one record cannot be read at all.
    std::vector<Gq_ImageEntry> small = {entry(green, "tbl2_small"), {0, nullptr, nullptr}};
    EXPECT_EQ(images->addImages(small.data(), 12), 0);
    EXPECT_FALSE(images->hasImage("tbl2_small"));
    EXPECT_EQ(images->addImages(nullptr, sizeof(Gq_ImageEntry)), 0);
}

// ---------------------------------------------------------------------------
// Help pages.

TEST(HelpViewer, EveryTopicOfTheWizardHasAPageWhoseLinksLeadSomewhere)
{
    const char* const keys[] = {
        "tsy_dcmgen", "tsy_dcmadv", "tsy_dcmclkbuf", "tsy_dcmpllclkbuf", "tsy_dcmclkfreq", "tsy_dcmeditbuf",
        "tsy_dcmbd", "tsy_dcmcf", "tsy_dcmcs", "tsy_dcmca", "tsy_dcmpmcd", "tsy_dcmpllgen", "tsy_dcmpllclkset",
        "tsy_plladv", "tsy_dcmpllphaseimage", "tsy_dcm2pll"};
    const QRegularExpression href("href=\"([^\"#]+)");
    QWidget* reused = nullptr;
    for (const char* key : keys) {
        SCOPED_TRACE(key);
        ASSERT_TRUE(Gq_HelpViewer::showTopic(key, nullptr));
        QWidget* window = Gq_HelpViewer::currentWindow();
        ASSERT_NE(window, nullptr);
        EXPECT_TRUE(window->isVisible());
        EXPECT_FALSE(window->isModal());
        EXPECT_EQ(window->windowTitle(), "Corvane Pendra - Help");
        EXPECT_TRUE(!reused || window == reused) << "one help window serves every topic";
        reused = window;
        auto* browser = window->findChild<QTextBrowser*>();
        ASSERT_NE(browser, nullptr);
        QString title = browser->documentTitle(), body = browser->toPlainText();
        EXPECT_GE(title.size(), 8) << title.toStdString();
        EXPECT_GE(body.size(), 1200) << "a page that explains its settings";
        EXPECT_TRUE(body.contains("Pendra"));
        // Each page opens with its own heading.
        EXPECT_TRUE(body.trimmed().startsWith(title.section(" - ", -1).left(6))) << title.toStdString();

        QFile file(Gq_HelpViewer::topicFile(key));
        ASSERT_TRUE(file.open(QIODevice::ReadOnly));
        for (auto links = href.globalMatch(QString::fromUtf8(file.readAll())); links.hasNext();) {
            QString target = links.next().captured(1);
            EXPECT_TRUE(target.startsWith("http") || QFile::exists(QFileInfo(file).dir().filePath(target)))
                << target.toStdString();
        }
    }
    Gq_HelpViewer::currentWindow()->close();
    for (const char* bad : {"tsy_nosuchtopic", "", "../help/tsy_dcmgen", "TSY DCMGEN", "tsy_dcmgen.html"}) {
        EXPECT_TRUE(Gq_HelpViewer::topicFile(bad).isEmpty()) << bad;
        EXPECT_FALSE(Gq_HelpViewer::showTopic(bad, nullptr)) << bad;
    }
}

TEST(HelpViewer, HelpAskedFromAModalDialogCanBeUsed)
{
    QDialog owner;
    bool shown = false;
    QWidget* helpParent = nullptr;
    bool blocked = true;
    WhileModal([&] { return owner.exec(); },
               [&](QWidget* modal) {
                   // A modal dialog of its own, opened over the owner.
                   QDialog advanced(modal);
                   WhileModal([&] { return advanced.exec(); },
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
        wizards_ = Tsy_WizardCatalog::LoadFile(dir_.filePath("wizards.json").toStdString());
        devices_ = Tsy_DeviceCatalog::LoadFile(dir_.filePath("devices.json").toStdString());
        dialog_ = std::make_unique<Gq_StartDialog>(*wizards_, *devices_);
        dialog_->setObjectName("StartDialogUnderTest");
    }
    void write(const char* name, const char* text) const
    {
        QFile f(dir_.filePath(name));
        ASSERT_TRUE(f.open(QIODevice::WriteOnly));
        f.write(text);
    }
    template <typename T>
    T* child(const char* name) const
    {
        return Named<T>(dialog_.get(), name);
    }
    int execAnswering(const std::function<void(QWidget*)>& answer)
    {
        return WhileModal([&] { return dialog_->exec(); }, answer);
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
    EXPECT_EQ(Items(child<QComboBox>("ComboPart")), QStringList({"t5da1-1", "t5da1-2", "m3e100-4"}));
    EXPECT_EQ(dialog_->wizardKey(), "dcm");
    EXPECT_EQ(dialog_->part(), "t5da1-1");
    EXPECT_EQ(dialog_->moduleName(), "clkgen");
    EXPECT_EQ(dialog_->outputFolder(), ".");
    EXPECT_TRUE(dialog_->okButton()->isEnabled());
    EXPECT_TRUE(dialog_->problem().isEmpty());
}

TEST_F(StartDialogTest, ModuleAndPartAreCheckedAsTyped)
{
    struct Case {
        const char* wizard;
        bool part; // typed into the part box, else the module name
        const char* typed;
        const char* kept; // what the dialog then holds
        const char* because; // empty: accepted
    } cases[] = {
        {"dcm", false, "9clocks", "9clocks", "begin with a letter"},
        {"dcm", false, "", "", "empty"},
        {"dcm", false, "entity", "entity", "VHDL keyword"},
        {"dcm", false, "clk__a", "clk__a", "two '_'"},
        {"dcm", false, "clk-a", "clk-a", "letters, digits"},
        {"dcm", false, "top_", "top_", "end with"},
        {"dcm", false, "clk_gen2", "clk_gen2", ""},
        {"dcm", true, "t5da1-2", "t5da1-2", ""},
        {"dcm", true, "T5DA1-2", "t5da1-2", ""},
        {"dcm", true, "m3e100-4", "m3e100-4", ""},
        {"dcm", true, "t5da1-9", "t5da1-9", "no part named"},
        {"dcm", true, "", "", "Choose a part"},
        {"dcm_pll", true, "t5da1-1", "t5da1-1", ""},
        {"dcm_pll", true, "m3e100-4", "m3e100-4", "Membra-3E family"},
    };
    dialog_->show();
    for (const Case& c : cases) {
        SCOPED_TRACE(std::string(c.wizard) + " '" + c.typed + "'");
        dialog_->setWizardKey(c.wizard);
        ASSERT_EQ(dialog_->wizardKey(), c.wizard);
        Retype(c.part ? static_cast<QWidget*>(child<QComboBox>("ComboPart")) : child<QLineEdit>("LineEditModule"),
               c.typed);
        EXPECT_EQ(c.part ? dialog_->part() : dialog_->moduleName(), c.kept);
        const bool accepted = !*c.because;
        EXPECT_EQ(dialog_->okButton()->isEnabled(), accepted);
        auto* note = child<QLabel>(c.part ? "TextLabelPartProblem" : "TextLabelModuleProblem");
        EXPECT_EQ(note->isVisible(), !accepted);
        EXPECT_TRUE(accepted || note->text().contains(c.because)) << note->text().toStdString();
    }
    // Choosing a wizard the part can build clears the complaint.
    dialog_->setWizardKey("dcm");
    EXPECT_TRUE(dialog_->okButton()->isEnabled());
    dialog_->reject();
}

TEST_F(StartDialogTest, OkIsRefusedWhileSomethingIsWrong)
{
    Retype(child<QLineEdit>("LineEditModule"), "1bad");
    QTest::mouseClick(dialog_->okButton(), Qt::LeftButton);
    EXPECT_FALSE(dialog_->okButton()->isEnabled());
    // Enter does not slip past the check either.
    EXPECT_EQ(execAnswering([](QWidget* modal) {
                  QTest::keyClick(modal, Qt::Key_Return);
                  EXPECT_TRUE(modal->isVisible());
                  modal->close();
              }),
              QDialog::Rejected);
    Retype(child<QLineEdit>("LineEditModule"), "good_name");
    EXPECT_EQ(execAnswering([](QWidget* modal) { QTest::keyClick(modal, Qt::Key_Return); }), QDialog::Accepted);
    EXPECT_EQ(dialog_->moduleName(), "good_name");
}

TEST_F(StartDialogTest, LabelsLeadTheKeyboardToTheirFields)
{
    ASSERT_TRUE(ShowAndActivate(dialog_.get()));
    const std::pair<Qt::Key, const char*> keys[] = {
        {Qt::Key_M, "LineEditModule"}, {Qt::Key_P, "ComboPart"}, {Qt::Key_F, "LineEditFolder"}, {Qt::Key_W, "ComboWizard"}};
    for (const auto& [key, field] : keys) {
        SCOPED_TRACE(field);
        QTest::keyClick(dialog_.get(), key, Qt::AltModifier);
        QWidget* focus = QApplication::focusWidget();
        ASSERT_NE(focus, nullptr);
        QWidget* expected = child<QWidget>(field);
        EXPECT_TRUE(focus == expected || expected->isAncestorOf(focus)) << focus->objectName().toStdString();
    }
    dialog_->reject();
}

TEST_F(StartDialogTest, BrowseFillsInTheChosenFolder)
{
    QTemporaryDir chosen;
    ASSERT_TRUE(chosen.isValid());
    dialog_->show();
    auto browse = [&](const std::function<void(QFileDialog*)>& answer) {
        WhileModal([&] { return QTest::mouseClick(child<QPushButton>("PushButtonBrowse"), Qt::LeftButton), 0; },
                   [&](QWidget* modal) {
                       auto* files = qobject_cast<QFileDialog*>(modal);
                       ASSERT_NE(files, nullptr);
                       answer(files);
                   });
    };
    // Entering the folder and accepting chooses it; selecting its name in
    // the parent would race the dialog's file listing.
    browse([&](QFileDialog* files) {
        files->setDirectory(chosen.path());
        QMetaObject::invokeMethod(files, "accept");
    });
    EXPECT_EQ(QFileInfo(dialog_->outputFolder()).canonicalFilePath(), QFileInfo(chosen.path()).canonicalFilePath());
    // Cancelling the folder dialog leaves the folder alone.
    QString before = dialog_->outputFolder();
    browse([](QFileDialog* files) { files->reject(); });
    EXPECT_EQ(dialog_->outputFolder(), before);
    Retype(child<QLineEdit>("LineEditFolder"), "");
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
    saved.isNull() ? qunsetenv("PENDRA_DATA_DIR") : qputenv("PENDRA_DATA_DIR", saved);
    EXPECT_EQ(dialog, nullptr);
    EXPECT_TRUE(error.contains("wizards.json")) << error.toStdString();
}

// ---------------------------------------------------------------------------
// Messages and questions in GUI mode.

namespace {

// The message box a stream call opens, as the user sees it, then closed.
struct SeenBox {
    QString title, text, defaultButton;
    QMessageBox::Icon icon = QMessageBox::NoIcon;
    Qt::TextFormat format = Qt::AutoText;
};

SeenBox look(QWidget* modal)
{
    SeenBox seen;
    auto* box = qobject_cast<QMessageBox*>(modal);
    EXPECT_NE(box, nullptr);
    if (!box)
        return seen;
    seen = {box->windowTitle(), box->text(), box->defaultButton() ? box->defaultButton()->text().remove('&') : "",
            box->icon(), box->textFormat()};
    return seen;
}

} // namespace

TEST(DialogStream, ErrorsAndNotesShowInMessageBoxesAsTyped)
{
    struct Case {
        const char* text;
        bool isError, flag3;
        QMessageBox::Icon icon;
        int errorsAfter;
    } cases[] = {
        {"The input clock frequency is out of range.", true, false, QMessageBox::Critical, 1},
        {"The DIRECT phase shift starts at 0.", false, false, QMessageBox::Information, 1},
        {"Signal <CLK0> & friends", false, false, QMessageBox::Information, 1}, // markup shown as typed
        {"Ranges:\n  Low   32.000 - 210.000\n  High 210.000 - 450.000\n", true, true, QMessageBox::Critical, 2},
    };
    Tsy_DialogStream stream;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        SeenBox seen;
        WhileModal([&] { return stream.Message(c.text, c.isError, false, c.flag3), 0; },
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

TEST(DialogStream, QuestionsDefaultToNo)
{
    struct Case {
        const char* what;
        std::function<void(QMessageBox*)> answer;
        bool yes;
    } cases[] = {
        {"Yes clicked", [](QMessageBox* b) { QTest::mouseClick(b->button(QMessageBox::Yes), Qt::LeftButton); }, true},
        {"No clicked", [](QMessageBox* b) { QTest::mouseClick(b->button(QMessageBox::No), Qt::LeftButton); }, false},
        {"Enter pressed", [](QMessageBox* b) { QTest::keyClick(b, Qt::Key_Return); }, false},
        {"Escape pressed", [](QMessageBox* b) { QTest::keyClick(b, Qt::Key_Escape); }, false},
    };
    Tsy_DialogStream stream;
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        SeenBox seen;
        int answer = WhileModal([&] { return stream.Ask("Do you want to continue anyway?", ""); },
                                [&](QWidget* modal) {
                                    seen = look(modal);
                                    c.answer(qobject_cast<QMessageBox*>(modal));
                                });
        EXPECT_EQ(answer != 0, c.yes);
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

TEST(WaitNote, ShowsItsTextUntilQuit)
{
    auto waitNote = []() -> QWidget* {
        for (QWidget* w : QApplication::topLevelWidgets())
            if (w->objectName() == "WaitNote")
                return w;
        return nullptr;
    };
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
