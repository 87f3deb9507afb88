#include "Tsy_DCMgenSetupUI.h"

#include <QEvent>
#include <QRegularExpression>
#include <QRegularExpressionValidator>

Tsy_DCMgenSetupUI::Tsy_DCMgenSetupUI(QWidget* parent) : QWidget(parent)
{
    setupUi(this);
    // A frequency or a period: digits with at most one decimal point; no
    // sign, no exponent.
    LineEditFin->setValidator(
        new QRegularExpressionValidator(QRegularExpression(QStringLiteral("[0-9]{0,9}(\\.[0-9]{0,6})?")), LineEditFin));
    // The group's accelerator leads to the frequency itself, not to the
    // checked unit button a group box would pick.
    GroupBoxFin->installEventFilter(this);
}

bool Tsy_DCMgenSetupUI::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == GroupBoxFin && event->type() == QEvent::Shortcut && LineEditFin->isEnabled()) {
        LineEditFin->setFocus(Qt::ShortcutFocusReason);
        LineEditFin->selectAll();
        return true;
    }
    return QWidget::eventFilter(watched, event);
}

Tsy_DCMgenSetupUI::~Tsy_DCMgenSetupUI() = default;
