// The GUI run of a wizard: the window, its pages and the summary page.

#include "wiz/Tsy_WizMain.h"

#include "db/Tsy_WizData.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "gui/Gq_SummaryPage.h"
#include "gui/Gq_Wizard.h"
#include "wiz/Tsy_WizPage.h"

#include <QString>

namespace {

QString escaped(const StringBase& s)
{
    return QString::fromStdString(s.str()).toHtmlEscaped();
}

// The wizard's own settings kept on a block are no property of the design.
bool isWizardPrivate(const Tsy_Attribute& a)
{
    return Tsy_IsWizardAttributeName(a.GetName().str()) || (a.GetDef() && !a.GetDef()->hdl);
}

// The primitive properties of every active block: what the HDL will carry.
QString describeBlocks(const Tsy_WizData* data)
{
    QString html;
    if (!data)
        return html;
    for (const auto& block : data->Blocks()) {
        if (!block->active)
            continue;
        html += QString("<h3>%1 <small>(%2)</small></h3><table>")
                    .arg(escaped(block->GetName()), escaped(block->GetType()));
        for (const auto& a : block->Attributes())
            if (a->IsActive() && !isWizardPrivate(*a))
                html += QString("<tr><td>%1</td><td>&nbsp;%2</td></tr>").arg(escaped(a->GetName()), escaped(a->GetValue()));
        QStringList pins;
        for (const auto& p : block->Pins())
            if (p->IsActive())
                pins << escaped(p->GetName());
        html += "</table>";
        if (!pins.isEmpty())
            html += "<p>Pins in use: " + pins.join(", ") + "</p>";
    }
    return html;
}

} // namespace

QString Tsy_WizMain_SummaryHtml(const Tsy_WizMain& wiz, const std::vector<StringBase>& files)
{
    QString html = QString("<h2>Module %1</h2><p>Part %2, wizard %3.</p>")
                       .arg(escaped(wiz.GetModuleName()), escaped(wiz.GetPartName()), escaped(wiz.GetKeyword()));
    html += describeBlocks(wiz.GetWizData());
    html += "<h3>Finish will write</h3><ul>";
    for (const auto& f : files)
        html += "<li>" + escaped(f) + "</li>";
    html += "</ul>";
    return html;
}

bool Tsy_WizMain::PrepareGui(Gq_Wizard* window)
{
    window_ = window;
    auto* summary = new Gq_SummaryPage([this] {
        return Tsy_WizMain_SummaryHtml(*this, plannedFiles_ ? plannedFiles_() : std::vector<StringBase>());
    });
    summary->setParent(window);
    summary->setPageName("Summary");
    summaryPage_ = summary;
    CreateGuiDlgs(window);
    CustomizeGui(window);
    // A wizard without pages still ends on its summary.
    if (window->pageCount() == 0)
        window->addPage(summary);
    window->setFinishHandler([this] { return FinishAndWrite(); });
    return true;
}

int Tsy_WizMain::RunGuiMode()
{
    if (!InstantiatePages())
        return 1;
    Gq_Wizard window;
    PrepareGui(&window);
    window.start();
    int rc = window.exec() == QDialog::Accepted ? 0 : 1;
    summaryPage_ = nullptr;
    window_ = nullptr;
    return rc;
}
