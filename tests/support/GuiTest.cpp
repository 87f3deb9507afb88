#include "support/GuiTest.h"

#include "wiz/Tsy_WizPage.h"

#include <QApplication>
#include <QLabel>
#include <QTest>
#include <QTimer>

bool ShowAndActivate(QWidget* window)
{
    window->show();
    QApplication::setActiveWindow(window);
    window->activateWindow();
    return QTest::qWaitForWindowActive(window);
}

bool Eventually(const std::function<bool()>& condition)
{
    return QTest::qWaitFor(condition, 5000);
}

int WhileModal(const std::function<int()>& open, const std::function<void(QWidget*)>& answer)
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

void Retype(QWidget* field, const QString& text)
{
    if (auto* edit = qobject_cast<QLineEdit*>(field)) {
        edit->selectAll();
        QTest::keyClick(edit, Qt::Key_Backspace);
    } else if (auto* combo = qobject_cast<QComboBox*>(field)) {
        combo->clearEditText();
    }
    QTest::keyClicks(field, text);
}

void Pick(QRadioButton* radio)
{
    QTest::mouseClick(radio, Qt::LeftButton, Qt::KeyboardModifiers(), QPoint(8, radio->height() / 2));
}

bool Choose(QComboBox* combo, const QString& text)
{
    combo->setFocus();
    QTest::keyClick(combo, Qt::Key_Home);
    for (int i = 0; i <= combo->count() && combo->currentText() != text; ++i)
        QTest::keyClick(combo, Qt::Key_Down);
    return combo->currentText() == text;
}

QStringList Items(const QComboBox* combo)
{
    QStringList out;
    for (int i = 0; i < combo->count(); ++i)
        out << combo->itemText(i);
    return out;
}

void Snap(QWidget* widget, const QString& name)
{
    const QString dir = qEnvironmentVariable("PENDRA_SCREENSHOT_DIR");
    if (dir.isEmpty())
        return;
    QApplication::processEvents(); // layouts settle on the next turn of the loop
    widget->grab().save(QString("%1/%2.png").arg(dir, name));
}

PageWindow::PageWindow(Tsy_WizPage* page)
{
    after.setPageName("Summary");
    after.setPageWidget(new QLabel("next"));
    if (!page || !page->CreateGui(&window) || !(gui = page->GetGui()))
        return;
    window.addPage(gui);
    window.addPage(&after);
    active = ShowAndActivate(&window);
    window.start();
}

PageWindow::~PageWindow()
{
    window.hide();
}
