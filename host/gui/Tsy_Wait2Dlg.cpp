#include "gui/Tsy_Wait2Dlg.h"

#include <QApplication>
#include <QFrame>
#include <QGuiApplication>
#include <QLabel>
#include <QScreen>
#include <QVBoxLayout>
#include <QWidget>

namespace {

QString toQt(const StringBase& text)
{
    return QString::fromStdString(text.str());
}

} // namespace

Tsy_Wait2Dlg::Tsy_Wait2Dlg() = default;

Tsy_Wait2Dlg::~Tsy_Wait2Dlg() = default;

void Tsy_Wait2Dlg::SetText(const StringBase& text)
{
    text_ = text;
    if (!window_)
        return;
    if (auto* label = window_->findChild<QLabel*>("WaitText"))
        label->setText(toQt(text_));
    window_->adjustSize();
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
}

void Tsy_Wait2Dlg::Run()
{
    // Batch runs and tests without a window system have nothing to paint on.
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        return;
    if (!window_) {
        auto* frame = new QFrame(nullptr, Qt::Tool | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint);
        frame->setObjectName("WaitNote");
        frame->setFrameShape(QFrame::Box);
        frame->setLineWidth(1);
        frame->setAttribute(Qt::WA_ShowWithoutActivating);
        auto* label = new QLabel(toQt(text_), frame);
        label->setObjectName("WaitText");
        label->setTextFormat(Qt::PlainText);
        label->setAlignment(Qt::AlignCenter);
        auto* layout = new QVBoxLayout(frame);
        layout->setContentsMargins(24, 16, 24, 16);
        layout->addWidget(label);
        window_.reset(frame);
    }
    window_->adjustSize();
    QWidget* over = QApplication::activeWindow();
    QRect area = over ? over->frameGeometry()
                      : (QGuiApplication::primaryScreen() ? QGuiApplication::primaryScreen()->availableGeometry()
                                                          : QRect());
    if (area.isValid()) {
        QRect r = window_->frameGeometry();
        r.moveCenter(area.center());
        window_->move(r.topLeft());
    }
    window_->show();
    window_->raise();
    // The slow work that follows keeps the event loop from running: paint now.
    window_->repaint();
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
}

void Tsy_Wait2Dlg::Quit()
{
    if (!window_)
        return;
    window_->hide();
    window_.reset();
}

bool Tsy_Wait2Dlg::IsShown() const
{
    return window_ && window_->isVisible();
}
