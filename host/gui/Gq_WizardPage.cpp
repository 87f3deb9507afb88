#include "gui/Gq_WizardPage.h"

#include <QWidget>

Gq_WizardPage::Gq_WizardPage(QObject* parent) : QObject(parent) {}

// The widget may already be gone with the window that showed it; the guarded
// pointer then reads null and there is nothing left to delete.
Gq_WizardPage::~Gq_WizardPage()
{
    delete widget_.data();
}

void Gq_WizardPage::setPageWidget(QWidget* widget)
{
    if (widget_ == widget)
        return;
    delete widget_.data();
    widget_ = widget;
}
