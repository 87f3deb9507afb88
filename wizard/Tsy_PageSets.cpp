#include "wizard/Tsy_PageSets.h"

namespace {

using K = Tsy_PageKind;

const Tsy_PageSlot kDcm[] = {
    {K::GeneralSetup, 1, "General Setup"},
    {K::Pmcd, 1, "Phase-Matched Clock Divider"},
    {K::ClockBuffers, 1, "Clock Buffers"},
    {K::ClockFrequencySynthesizer, 1, "Clock Frequency Synthesizer"},
};

#define TWO_DCM_PAGES                                                                                                  \
    {K::GeneralSetup, 1, "General Setup for INST1"}, {K::ClockBuffers, 1, "Clock Buffers for INST1"},                  \
        {K::ClockFrequencySynthesizer, 1, "Clock Frequency Synthesizer for INST1"},                                  \
        {K::GeneralSetup, 2, "General Setup for INST2"}, {K::ClockBuffers, 2, "Clock Buffers for INST2"},              \
        {K::ClockFrequencySynthesizer, 2, "Clock Frequency Synthesizer for INST2"}

const Tsy_PageSlot kBoardDeskew[] = {{K::BoardDeskew, 0, "Board Deskew With An Internal Deskew"}, TWO_DCM_PAGES};
const Tsy_PageSlot kClockSwitching[] = {{K::ClockSwitching, 0, "Clock Switching With Two DCMs"}, TWO_DCM_PAGES};
const Tsy_PageSlot kCascading[] = {{K::Cascading, 0, "Cascading"}, TWO_DCM_PAGES};

#undef TWO_DCM_PAGES

const Tsy_PageSlot kClockForwarding[] = {
    {K::ClockForwarding, 0, "Clock Forwarding / Board Deskew"},
    {K::GeneralSetup, 1, "General Setup"},
    {K::ClockBuffers, 1, "Clock Buffers"},
    {K::ClockFrequencySynthesizer, 1, "Clock Frequency Synthesizer"},
};

const Tsy_PageSlot kPll[] = {
    {K::PllGeneralSetup, 1, "PLL General Setup"},
    {K::PllOutputClockSettings, 1, "PLL Output Clock Settings"},
    {K::ClockBuffers, 1, "Clock Buffers"},
};

const Tsy_PageSlot kDcmToPll[] = {
    {K::DcmToPll, 0, "Filter DCM Output Clock"},
    {K::GeneralSetup, 1, "General Setup"},
    {K::ClockFrequencySynthesizer, 1, "Clock Frequency Synthesizer"},
    {K::PllGeneralSetup, 1, "PLL General Setup"},
    {K::PllOutputClockSettings, 1, "PLL Output Clock Settings"},
    {K::ClockBuffers, 1, "Clock Buffers"},
};

const Tsy_PageSlot kPllToDcm[] = {
    {K::PllToDcm, 0, "Filter DCM Input Clock"},
    {K::PllGeneralSetup, 1, "PLL General Setup"},
    {K::PllOutputClockSettings, 1, "PLL Output Clock Settings"},
    {K::GeneralSetup, 1, "General Setup"},
    {K::ClockBuffers, 1, "Clock Buffers"},
    {K::ClockFrequencySynthesizer, 1, "Clock Frequency Synthesizer"},
};

template <int N>
const Tsy_PageSlot* set(const Tsy_PageSlot (&table)[N], int& count)
{
    count = N;
    return table;
}

} // namespace

const Tsy_PageSlot* Tsy_PageSetOf(int wizType, int& count)
{
    switch (wizType) {
    case 1: return set(kDcm, count);
    case 2: return set(kBoardDeskew, count);
    case 3: return set(kClockForwarding, count);
    case 4: return set(kClockSwitching, count);
    case 5: return set(kCascading, count);
    case 6: return set(kPll, count);
    case 7: return set(kDcmToPll, count);
    case 8: return set(kPllToDcm, count);
    default: count = 0; return nullptr;
    }
}
