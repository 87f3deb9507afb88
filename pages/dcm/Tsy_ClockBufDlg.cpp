#include "pages/dcm/Tsy_ClockBufDlg.h"

#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "wizard/Tsy_DCMwiz.h"

#include <QApplication>

#include <exception>

Tsy_ClockBufDlg::Tsy_ClockBufDlg(Tsy_DCMwiz* wizard, int instNum) : Tsy_DCMwizPage(wizard, instNum) {}

Tsy_ClockBufDlg::~Tsy_ClockBufDlg()
{
    delete gui_;
}

Tsy_ClockBufDlgGui* Tsy_ClockBufDlg::Controller()
{
    if (!gui_) {
        gui_ = new Tsy_ClockBufDlgGui(this, nullptr, GetInstNum());
        gui_->SetUp();
    }
    return gui_;
}

bool Tsy_ClockBufDlg::ApplySilently()
{
    if (GetDCMWiz())
        GetDCMWiz()->SetBatch(true);
    Tsy_ClockBufDlgGui* gui = Controller();
    gui->SetBatch(true);
    gui->SetNamePrefix();
    gui->LoadFromBlock();
    gui->RefreshRows(true);
    // A batch run goes on to Finish: it must meet the same checks as Next.
    return gui->StoreToBlock(true);
}

bool Tsy_ClockBufDlg::CreateGui(QWidget* parent)
{
    if (gui_)
        return true;
    // Widgets need a running QApplication; without one there is no page to show.
    bool made = false;
    if (qobject_cast<QApplication*>(QCoreApplication::instance())) {
        try {
            gui_ = new Tsy_ClockBufDlgGui(this, parent, GetInstNum());
            gui_->SetUp();
            made = true;
        } catch (const std::exception&) {
            delete gui_;
            gui_ = nullptr;
        }
    }
    if (!made) {
        IssueMessage("Internal error: unable to create GUI object", true, false, false);
        return false;
    }
    return true;
}

Gq_WizardPage* Tsy_ClockBufDlg::GetGui()
{
    return gui_;
}
