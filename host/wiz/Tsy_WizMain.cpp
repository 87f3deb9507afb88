#include "wiz/Tsy_WizMain.h"

#include "db/Tsy_WizData.h"
#include "gui/Gq_HelpViewer.h"
#include "gui/Gq_SummaryPage.h"
#include "gui/Gq_Wizard.h"
#include "wiz/Port_Stream.h"
#include "wiz/Tsy_WizPage.h"

#include <QString>

Tsy_WizMain::Tsy_WizMain(const StringBase& keyword, bool batch) : keyword_(keyword), batch_(batch) {}

Tsy_WizMain::~Tsy_WizMain()
{
    if (ownsPages_)
        DeletePages();
}

// A copy shares the pages with its original and never deletes them.
Tsy_WizMain::Tsy_WizMain(const Tsy_WizMain& other)
{
    *this = other;
}

Tsy_WizMain& Tsy_WizMain::operator=(const Tsy_WizMain& other)
{
    if (this == &other)
        return *this;
    if (ownsPages_)
        DeletePages();
    keyword_ = other.keyword_;
    batch_ = other.batch_;
    ctx_ = other.ctx_;
    for (int i = 0; i < kPageSlots; ++i)
        pages_[i] = other.pages_[i];
    summaryPage_ = other.summaryPage_;
    window_ = other.window_;
    write_ = other.write_;
    plannedFiles_ = other.plannedFiles_;
    beforePages_ = other.beforePages_;
    ownsPages_ = false;
    return *this;
}

void Tsy_WizMain::SetContext(const Tsy_WizContext& context)
{
    ctx_ = context;
}

void Tsy_WizMain::SetOutputHooks(std::function<bool(StringBase&)> write,
                                 std::function<std::vector<StringBase>()> plannedFiles)
{
    write_ = std::move(write);
    plannedFiles_ = std::move(plannedFiles);
}

StringBase Tsy_WizMain::GetDeviceNoPrefix() const
{
    const StringBase& device = ctx_.deviceName;
    if (!ctx_.devicePrefix.IsEmpty() && device.StartsWith(ctx_.devicePrefix, Port::CompareNoCase))
        return device.Mid(ctx_.devicePrefix.GetLength());
    return device;
}

bool Tsy_WizMain::HasDeviceTrait(const StringBase& trait) const
{
    for (const auto& t : ctx_.deviceTraits)
        if (t.EqualsNoCase(trait))
            return true;
    return false;
}

Tsy_WizPage* Tsy_WizMain::GetPage(int slot) const
{
    return slot >= 0 && slot < kPageSlots ? pages_[slot] : nullptr;
}

void Tsy_WizMain::SetPage(int slot, Tsy_WizPage* page)
{
    if (slot < 0 || slot >= kPageSlots) {
        delete page;
        return;
    }
    if (ownsPages_ && pages_[slot] != page)
        delete pages_[slot];
    pages_[slot] = page;
}

void Tsy_WizMain::DeletePages()
{
    for (auto*& p : pages_) {
        delete p;
        p = nullptr;
    }
}

Tsy_Block* Tsy_WizMain::ResolveTarget(const StringBase& target, StringBase& reason)
{
    reason = StringBase::Printf("this wizard has no block named '%s'", target.c_str());
    return nullptr;
}

bool Tsy_WizMain::InstantiatePages()
{
    return true;
}

bool Tsy_WizMain::CustomizeGui(Gq_Wizard*)
{
    return true;
}

int Tsy_WizMain::Finish()
{
    return 0;
}

bool Tsy_WizMain::GoBackFromSummary()
{
    return true;
}

bool Tsy_WizMain::DoFinishAtSummaryStart()
{
    return false;
}

bool Tsy_WizMain::ShowHelp(const StringBase& topicKey)
{
    if (batch_)
        return false;
    return Gq_HelpViewer::showTopic(QString::fromStdString(topicKey.str()), window_);
}

int Tsy_WizMain::Run()
{
    return batch_ ? RunBatchMode() : RunGuiMode();
}

bool Tsy_WizMain::FinishAndWrite()
{
    if (Finish() != 0) {
        Tsy_WizPage::DoMessage("Finish failed: the design could not be generated, so nothing was written.", batch_,
                               ctx_.stream, true, ctx_.messageFlag, false);
        return false;
    }
    StringBase error;
    if (write_ && !write_(error)) {
        Tsy_WizPage::DoMessage(error, batch_, ctx_.stream, true, ctx_.messageFlag, false);
        return false;
    }
    return true;
}

int Tsy_WizMain::RunBatchMode()
{
    auto errors = [this] { return ctx_.stream ? ctx_.stream->ErrorCount() : 0; };
    if (!InstantiatePages() || errors() > 0)
        return 1;
    if (beforePages_ && !beforePages_())
        return 2;
    for (Tsy_WizPage* page : pages_) {
        if (!page)
            break;
        int before = errors();
        page->ApplySilently();
        if (errors() > before)
            return 1;
    }
    return FinishAndWrite() ? 0 : 1;
}

bool Tsy_WizMain::CreateGuiDlgs(Gq_Wizard* wizard)
{
    for (Tsy_WizPage* page : pages_) {
        if (!page)
            break;
        page->CreateGui(wizard);
    }
    return true;
}
