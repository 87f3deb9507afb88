#pragma once
// The help topics of the wizard's pages and dialogs; the host shows the
// bundled page of each key.

namespace Tsy_HelpTopic {

constexpr const char* GeneralSetup = "tsy_dcmgen";
constexpr const char* Advanced = "tsy_dcmadv";
constexpr const char* ClockBuffers = "tsy_dcmclkbuf";
constexpr const char* PllClockBuffers = "tsy_dcmpllclkbuf";
constexpr const char* ClockFrequencySynthesizer = "tsy_dcmclkfreq";
constexpr const char* EditBuffer = "tsy_dcmeditbuf";
constexpr const char* BoardDeskew = "tsy_dcmbd";
constexpr const char* ClockForwarding = "tsy_dcmcf";
constexpr const char* ClockSwitching = "tsy_dcmcs";
constexpr const char* Cascading = "tsy_dcmca";
constexpr const char* Pmcd = "tsy_dcmpmcd";
constexpr const char* PllGeneralSetup = "tsy_dcmpllgen";
constexpr const char* PllOutputClockSettings = "tsy_dcmpllclkset";
constexpr const char* PllAdvanced = "tsy_plladv";
constexpr const char* PhaseExample = "tsy_dcmpllphaseimage";
constexpr const char* DcmToPll = "tsy_dcm2pll";

constexpr const char* All[] = {GeneralSetup,    Advanced,        ClockBuffers,           PllClockBuffers,
                               ClockFrequencySynthesizer, EditBuffer, BoardDeskew,     ClockForwarding,
                               ClockSwitching,  Cascading,       Pmcd,                   PllGeneralSetup,
                               PllOutputClockSettings, PllAdvanced, PhaseExample,       DcmToPll};

} // namespace Tsy_HelpTopic
