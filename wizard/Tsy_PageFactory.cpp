// Builds the page objects. Each page kind takes its place here as its page
// class is written; until then the kind yields no page and the wizard runs
// without it.

#include "wizard/Tsy_PageSets.h"

#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "pages/dcm/Tsy_JitterDlg.h"
#include "wizard/Tsy_DCMwiz.h"

Tsy_DCMwizPage* Tsy_CreatePage(Tsy_PageKind kind, Tsy_DCMwiz* wizard, int instance)
{
    switch (kind) {
    case Tsy_PageKind::GeneralSetup:
        return new Tsy_DCMgenSetup(wizard, wizard ? wizard->GetWizTypeInt() : 0, instance);
    case Tsy_PageKind::ClockBuffers:
        return new Tsy_ClockBufDlg(wizard, instance);
    case Tsy_PageKind::ClockFrequencySynthesizer:
        return new Tsy_JitterDlg(wizard, instance);
    default:
        return nullptr;
    }
}
