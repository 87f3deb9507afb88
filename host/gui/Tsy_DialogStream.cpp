#include "gui/Tsy_DialogStream.h"

#include <QApplication>
#include <QMessageBox>

#include <iostream>

namespace {

const char* const kTitle = "Corvane Pendra";

QString toQt(const StringBase& text)
{
    return QString::fromStdString(text.str());
}

bool haveGui()
{
    return qobject_cast<QApplication*>(QCoreApplication::instance()) != nullptr;
}

void writeLine(const StringBase& text, bool isError)
{
    std::string s = text.str();
    while (!s.empty() && (s.back() == '\n' || s.back() == ' '))
        s.pop_back();
    std::cerr << (isError ? "ERROR: " : "INFO: ") << s << std::endl;
}

} // namespace

QWidget* Tsy_DialogStream::owner() const
{
    if (parent_)
        return parent_;
    // Over the dialog the user is answering, not over a help window that
    // merely has the focus.
    if (QWidget* modal = QApplication::activeModalWidget())
        return modal;
    return QApplication::activeWindow();
}

void Tsy_DialogStream::Message(const StringBase& text, bool isError, bool, bool flag3)
{
    CountError(isError);
    // Without a window system there is nobody to show a box to.
    if (!haveGui()) {
        writeLine(text, isError);
        return;
    }
    QMessageBox box(isError ? QMessageBox::Critical : QMessageBox::Information, kTitle, QString(),
                    QMessageBox::Ok, owner());
    box.setObjectName("MessageBox");
    if (flag3) {
        // Range reports line up columns with blanks: keep every line and
        // every blank, in a fixed-pitch face.
        QString lines = toQt(text);
        while (!lines.isEmpty() && lines.back().isSpace())
            lines.chop(1);
        lines = lines.toHtmlEscaped();
        box.setTextFormat(Qt::RichText);
        box.setText("<pre style=\"font-family: monospace;\">" + lines + "</pre>");
    } else {
        // Messages are sentences, never markup.
        box.setTextFormat(Qt::PlainText);
        box.setText(toQt(text).trimmed());
    }
    box.setDefaultButton(QMessageBox::Ok);
    box.exec();
}

void Tsy_DialogStream::Log(const StringBase& text, bool isError)
{
    CountError(isError);
    writeLine(text, isError);
}

int Tsy_DialogStream::Ask(const StringBase& question, const StringBase& second)
{
    if (!haveGui()) {
        // The batch answer: pages ask only to let the user go on anyway.
        writeLine(question, false);
        return 1;
    }
    QMessageBox box(QMessageBox::Question, kTitle, QString(), QMessageBox::Yes | QMessageBox::No, owner());
    box.setObjectName("QuestionBox");
    box.setTextFormat(Qt::PlainText);
    box.setText(toQt(question).trimmed());
    if (!second.IsEmpty())
        box.setInformativeText(toQt(second));
    // Going on despite a warning must be a deliberate choice.
    box.setDefaultButton(QMessageBox::No);
    box.setEscapeButton(QMessageBox::No);
    return box.exec() == QMessageBox::Yes ? 1 : 0;
}
