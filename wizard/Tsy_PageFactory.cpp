// Builds the page objects. Each page kind takes its place here as its page
// class is written; until then the kind yields no page and the wizard runs
// without it.

#include "wizard/Tsy_PageSets.h"

Tsy_DCMwizPage* Tsy_CreatePage(Tsy_PageKind kind, Tsy_DCMwiz* wizard, int instance)
{
    (void)wizard;
    (void)instance;
    switch (kind) {
    default:
        return nullptr;
    }
}
