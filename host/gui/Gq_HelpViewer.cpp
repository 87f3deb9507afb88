#include "gui/Gq_HelpViewer.h"

#include "lib/Tsy_DataDir.h"

#include <QApplication>
#include <QDialog>
#include <QDialogButtonBox>
#include <QFileInfo>
#include <QPointer>
#include <QPushButton>
#include <QRegularExpression>
#include <QTextBrowser>
#include <QUrl>
#include <QVBoxLayout>

namespace {

// One help window for the whole session, reused by every topic.
QPointer<QDialog>& helpWindow()
{
    static QPointer<QDialog> window;
    return window;
}

QDialog* makeWindow(QWidget* parent)
{
    auto* dialog = new QDialog(parent, Qt::Window);
    dialog->setObjectName("HelpViewer");
    dialog->setWindowTitle("Corvane Pendra - Help");
    dialog->setModal(false);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->resize(640, 560);

    auto* browser = new QTextBrowser(dialog);
    browser->setObjectName("HelpBrowser");
    browser->setOpenExternalLinks(true);

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Close, dialog);
    QObject::connect(buttons, &QDialogButtonBox::rejected, dialog, &QDialog::close);

    auto* layout = new QVBoxLayout(dialog);
    layout->addWidget(browser, 1);
    layout->addWidget(buttons);
    return dialog;
}

// Whether the widget is the window or lies anywhere below it, across
// window boundaries.
bool isWithin(const QWidget* widget, const QWidget* window)
{
    for (const QWidget* w = widget; w; w = w->parentWidget())
        if (w == window)
            return true;
    return false;
}

} // namespace

QString Gq_HelpViewer::topicFile(const QString& topicKey)
{
    // Keys are lower-case words; anything else could reach outside the
    // help folder.
    static const QRegularExpression keyShape("^[a-z0-9_]+$");
    if (!keyShape.match(topicKey).hasMatch())
        return QString();
    QString path = QString::fromStdString(Tsy_DataFile("help/" + topicKey.toStdString() + ".html"));
    QFileInfo info(path);
    if (!info.isFile() || !info.isReadable())
        return QString();
    return info.absoluteFilePath();
}

bool Gq_HelpViewer::showTopic(const QString& topicKey, QWidget* parent)
{
    QString file = topicFile(topicKey);
    if (file.isEmpty() || !qobject_cast<QApplication*>(QCoreApplication::instance()))
        return false;

    // Help asked from a modal dialog must sit above it, or the dialog would
    // block the help window it opened.
    QWidget* owner = parent;
    if (QWidget* modal = QApplication::activeModalWidget())
        if (!isWithin(parent, modal))
            owner = modal;

    QPointer<QDialog>& window = helpWindow();
    if (window && window->parentWidget() != owner)
        delete window.data();
    if (!window)
        window = makeWindow(owner);

    auto* browser = window->findChild<QTextBrowser*>("HelpBrowser");
    browser->setSource(QUrl::fromLocalFile(file));
    if (browser->document()->isEmpty())
        return false;
    window->show();
    window->raise();
    window->activateWindow();
    return true;
}

QWidget* Gq_HelpViewer::currentWindow()
{
    return helpWindow().data();
}
