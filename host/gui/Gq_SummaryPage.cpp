#include "gui/Gq_SummaryPage.h"

#include "gui/Gq_Wizard.h"

#include <QTextBrowser>

Gq_SummaryPage::Gq_SummaryPage(std::function<QString()> describe, QWidget* parentWidget)
    : describe_(std::move(describe))
{
    auto* view = new QTextBrowser(parentWidget);
    view->setObjectName("SummaryView");
    view->setOpenLinks(false);
    view_ = view;
    setPageWidget(view);
}

void Gq_SummaryPage::onActive()
{
    // The summary has no help topic and no advanced settings of its own.
    if (Gq_Wizard* w = wizard()) {
        w->showMoreInfo(false);
        w->showAdvanced(false);
    }
    // Built anew on every entry: the pages before may have changed anything.
    html_ = describe_ ? describe_() : QString();
    if (view_)
        view_->setHtml(html_);
}

QString Gq_SummaryPage::html() const
{
    return html_;
}
