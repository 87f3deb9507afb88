#pragma once
// The Clock Buffers page: which global clock buffer (or other clock routing)
// each selected output of the DCM, PLL or PMCD drives. The logical page only
// creates its controller and forwards to it; the rules live there.

#include "wizard/Tsy_DCMwizPage.h"

class QWidget;
class Tsy_ClockBufDlgGui;

class Tsy_ClockBufDlg : public Tsy_DCMwizPage {
public:
    Tsy_ClockBufDlg(Tsy_DCMwiz* wizard, int instNum);
    ~Tsy_ClockBufDlg() override;

    // Batch: loads the buffer rows from the block, fills in the default
    // buffers and stores with the checks of Next.
    bool ApplySilently() override;
    bool CreateGui(QWidget* parent) override;
    Gq_WizardPage* GetGui() override;
    // The same operation under its second name.
    virtual Gq_WizardPage* GetGuiPage() { return GetGui(); }

    // The controller, made without a form when there is none yet (batch).
    Tsy_ClockBufDlgGui* Controller();

private:
    Tsy_ClockBufDlgGui* gui_ = nullptr;
};
