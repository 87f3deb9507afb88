#pragma once
// The pages of each wizard type, in page order, with the instance number each
// page edits and the page names used for the Back and Next buttons.

class Tsy_DCMwiz;
class Tsy_DCMwizPage;

enum class Tsy_PageKind {
    GeneralSetup,
    Pmcd,
    ClockBuffers,
    ClockFrequencySynthesizer,
    BoardDeskew,
    ClockForwarding,
    ClockSwitching,
    Cascading,
    PllGeneralSetup,
    PllOutputClockSettings,
    DcmToPll,
    PllToDcm
};

struct Tsy_PageSlot {
    Tsy_PageKind kind;
    int instance; // 1 or 2; the two-block application pages take 0
    const char* name;
};

// The page set of a wizard type; count is 0 for type 0.
const Tsy_PageSlot* Tsy_PageSetOf(int wizType, int& count);

// A page of that kind, or null while this build has no such page.
Tsy_DCMwizPage* Tsy_CreatePage(Tsy_PageKind kind, Tsy_DCMwiz* wizard, int instance);
