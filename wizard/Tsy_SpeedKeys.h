#pragma once
// The speed-file keys the pages query, as patterns. The DCM input ranges
// take "MS_" or "MR_" on families with performance modes and nothing
// elsewhere; the output ranges take "LF" or "HF"; the PLL jitter constants
// take the multiplier and "LOW" or "HIGH".

namespace Tsy_SpeedKey {

// DCM input ranges (General Setup); %s is the performance-mode infix.
constexpr const char* CLKIN_DLL_LF_MIN = "CLKIN_FREQ_DLL_LF_%sMin";
constexpr const char* CLKIN_DLL_LF_MAX = "CLKIN_FREQ_DLL_LF_%sMax";
constexpr const char* CLKIN_DLL_HF_MIN = "CLKIN_FREQ_DLL_HF_%sMin";
constexpr const char* CLKIN_DLL_HF_MAX = "CLKIN_FREQ_DLL_HF_%sMax";
constexpr const char* CLKIN_FX_LF_MIN = "CLKIN_FREQ_FX_LF_%sMin";
constexpr const char* CLKIN_FX_LF_MAX = "CLKIN_FREQ_FX_LF_%sMax";
// The synthesizer's high input range is spelled FREQ on the families with
// performance modes and FRQ on all others.
constexpr const char* CLKIN_FX_HF_MIN_MODES = "CLKIN_FREQ_FX_HF_%sMin";
constexpr const char* CLKIN_FX_HF_MAX_MODES = "CLKIN_FREQ_FX_HF_%sMax";
constexpr const char* CLKIN_FX_HF_MIN = "CLKIN_FRQ_FX_HF_%sMin";
constexpr const char* CLKIN_FX_HF_MAX = "CLKIN_FRQ_FX_HF_%sMax";

// DCM output ranges (General Setup); %s is "LF" or "HF".
constexpr const char* CLKOUT_DV_MIN = "CLKOUT_FREQ_DV_%s_Min";
constexpr const char* CLKOUT_DV_MAX = "CLKOUT_FREQ_DV_%s_Max";
constexpr const char* CLKOUT_2X_MIN = "CLKOUT_FREQ_2X_%s_Min";
constexpr const char* CLKOUT_2X_MAX = "CLKOUT_FREQ_2X_%s_Max";

// Synthesizer output ranges (Clock Frequency Synthesizer).
constexpr const char* CLKOUT_FX_LF_MIN = "CLKOUT_FREQ_FX_LF_Min";
constexpr const char* CLKOUT_FX_LF_MAX = "CLKOUT_FREQ_FX_LF_Max";
constexpr const char* CLKOUT_FX_HF_MIN = "CLKOUT_FREQ_FX_HF_Min";
constexpr const char* CLKOUT_FX_HF_MAX = "CLKOUT_FREQ_FX_HF_Max";

// PLL limits (PLL pages).
constexpr const char* PLL_CLKIN_MIN = "CLKIN_FREQ_MIN";
constexpr const char* PLL_CLKIN_MAX = "CLKIN_FREQ_MAX";
constexpr const char* PLL_VCO_MIN = "VCOCLK_FREQ_MIN";
constexpr const char* PLL_VCO_MAX = "VCOCLK_FREQ_MAX";
constexpr const char* PLL_O_MAX_HT_LT = "O_MAX_HT_LT";
// PLL jitter constants: "PLL_MULT_%d_BW_%s_K1" to "_K7" and "_K12".
constexpr const char* PLL_JITTER_K1 = "PLL_MULT_%d_BW_%s_K1";
constexpr const char* PLL_JITTER_K12 = "PLL_MULT_%d_BW_%s_K12";
constexpr const char* PLL_JITTER_KN = "PLL_MULT_%d_BW_%s_K%d";
constexpr int kPllJitterConstants[] = {1, 2, 3, 4, 5, 6, 7, 12};

} // namespace Tsy_SpeedKey
