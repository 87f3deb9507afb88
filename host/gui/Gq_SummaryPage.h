#pragma once
// The last page of every wizard: the configuration as it stands and the files
// that Finish will write.

#include "gui/Gq_WizardPage.h"

#include <QPointer>

#include <functional>

class QTextBrowser;

class Gq_SummaryPage : public Gq_WizardPage {
    Q_OBJECT
public:
    // describe returns the page's HTML; it is called on every entry.
    explicit Gq_SummaryPage(std::function<QString()> describe, QWidget* parentWidget = nullptr);

    void onActive() override;
    // The HTML of the last entry, as describe gave it.
    QString html() const;

private:
    std::function<QString()> describe_;
    // Guarded: the window deletes the view with itself.
    QPointer<QTextBrowser> view_;
    QString html_;
};
