#pragma once
// The names of the attributes that pages and generation share through the
// design database, and the values they hold. Attributes beginning
// "TESY_ONLY_" or "TSY_" are the wizard's own and never reach the netlist.

namespace Tsy_Attr {

// Primitive attributes of the DCM block.
constexpr const char* CLKIN_PERIOD = "CLKIN_PERIOD";
constexpr const char* CLKIN_DIVIDE_BY_2 = "CLKIN_DIVIDE_BY_2";
constexpr const char* CLKDV_DIVIDE = "CLKDV_DIVIDE";
constexpr const char* CLKFX_MULTIPLY = "CLKFX_MULTIPLY";
constexpr const char* CLKFX_DIVIDE = "CLKFX_DIVIDE";
constexpr const char* CLK_FEEDBACK = "CLK_FEEDBACK";
constexpr const char* CLKOUT_PHASE_SHIFT = "CLKOUT_PHASE_SHIFT";
constexpr const char* PHASE_SHIFT = "PHASE_SHIFT";
constexpr const char* DESKEW_ADJUST = "DESKEW_ADJUST";
constexpr const char* DUTY_CYCLE_CORRECTION = "DUTY_CYCLE_CORRECTION";
constexpr const char* STARTUP_WAIT = "STARTUP_WAIT";
constexpr const char* DCM_AUTOCALIBRATION = "DCM_AUTOCALIBRATION";
constexpr const char* DLL_FREQUENCY_MODE = "DLL_FREQUENCY_MODE";
constexpr const char* DFS_FREQUENCY_MODE = "DFS_FREQUENCY_MODE";
constexpr const char* DCM_PERFORMANCE_MODE = "DCM_PERFORMANCE_MODE";
constexpr const char* FACTORY_JF = "FACTORY_JF";
constexpr const char* SIM_DEVICE = "SIM_DEVICE";

// Primitive attributes of the PLL block.
constexpr const char* CLKIN1_PERIOD = "CLKIN1_PERIOD";
constexpr const char* CLKIN2_PERIOD = "CLKIN2_PERIOD";
constexpr const char* CLKFBOUT_MULT = "CLKFBOUT_MULT";
constexpr const char* DIVCLK_DIVIDE = "DIVCLK_DIVIDE";
constexpr const char* BANDWIDTH = "BANDWIDTH";
constexpr const char* COMPENSATION = "COMPENSATION";
constexpr const char* REF_JITTER = "REF_JITTER";
constexpr const char* RESET_ON_LOSS_OF_LOCK = "RESET_ON_LOSS_OF_LOCK";

// Primitive attributes of the PMCD and of the forwarding flip-flops.
constexpr const char* EN_REL = "EN_REL";
constexpr const char* RST_DEASSERT_CLK = "RST_DEASSERT_CLK";
constexpr const char* DDR_CLK_EDGE = "DDR_CLK_EDGE";
constexpr const char* INIT = "INIT";
constexpr const char* SRTYPE = "SRTYPE";

// Wizard attributes of the DCM and PLL blocks.
constexpr const char* TESY_ONLY_INST_NUM = "TESY_ONLY_INST_NUM";
constexpr const char* TESY_ONLY_CLKIN_VALUE = "TESY_ONLY_CLKIN_VALUE";
constexpr const char* FIN_UNITS = "FIN_UNITS";
constexpr const char* FOUT_UNITS = "FOUT_UNITS";
constexpr const char* TESY_ONLY_CLKIN1_VALUE = "TESY_ONLY_CLKIN1_VALUE";
constexpr const char* TESY_ONLY_CLKIN2_VALUE = "TESY_ONLY_CLKIN2_VALUE";
constexpr const char* TESY_ONLY_FIN1_UNITS = "TESY_ONLY_FIN1_UNITS";
constexpr const char* TESY_ONLY_FIN2_UNITS = "TESY_ONLY_FIN2_UNITS";
constexpr const char* CLKIN_SRC_TYPE = "CLKIN_SRC_TYPE";
constexpr const char* TESY_ONLY_CLKIN_EXTERNAL = "TESY_ONLY_CLKIN_EXTERNAL";
constexpr const char* FB_SOURCE = "FB_SOURCE";
constexpr const char* TESY_ONLY_FB_EXTERNAL = "TESY_ONLY_FB_EXTERNAL";
constexpr const char* TSY_CLK_OUTPUT_TYPE = "TSY_CLK_OUTPUT_TYPE";
constexpr const char* TESY_ONLY_VALID_DFS_MODE = "TESY_ONLY_VALID_DFS_MODE";
constexpr const char* TESY_ONLY_RESET_LOGIC = "TESY_ONLY_RESET_LOGIC";
constexpr const char* TESY_ONLY_RECONFIG_PINS = "TESY_ONLY_RECONFIG_PINS";
constexpr const char* TESY_ONLY_RETARGET = "TESY_ONLY_RETARGET";
constexpr const char* TESY_ONLY_PMCD = "TESY_ONLY_PMCD";
constexpr const char* TESY_ONLY_PMCD_CLKA = "TESY_ONLY_PMCD_CLKA";
constexpr const char* TESY_ONLY_PMCD_CLKB = "TESY_ONLY_PMCD_CLKB";
constexpr const char* TESY_ONLY_PMCD_CLKC = "TESY_ONLY_PMCD_CLKC";
constexpr const char* TESY_ONLY_PMCD_CLKD = "TESY_ONLY_PMCD_CLKD";
constexpr const char* TESY_ONLY_PMCD_FB = "TESY_ONLY_PMCD_FB";
constexpr const char* M_VALUE = "M_VALUE";
constexpr const char* D_VALUE = "D_VALUE";
constexpr const char* FOUT_VALUE = "FOUT_VALUE";
constexpr const char* JITTER_INPUT_TYPE = "JITTER_INPUT_TYPE";
constexpr const char* JITTER_VALUE = "JITTER_VALUE";
constexpr const char* JITTER_PK2PK = "JITTER_PK2PK";
constexpr const char* TESY_ONLY_JITTER_UI_NONOISE = "TESY_ONLY_JITTER_UI_NONOISE";
constexpr const char* TESY_ONLY_JITTER_PK2PK_NONOISE = "TESY_ONLY_JITTER_PK2PK_NONOISE";
constexpr const char* TESY_ONLY_DDR_FLIPFLOP = "TESY_ONLY_DDR_FLIPFLOP";
constexpr const char* TESY_ONLY_DDR_C0 = "TESY_ONLY_DDR_C0";
constexpr const char* TESY_ONLY_DDR_C1 = "TESY_ONLY_DDR_C1";
constexpr const char* TESY_ONLY_DDR_CLK = "TESY_ONLY_DDR_CLK";
constexpr const char* TESY_ONLY_DDR_EDGEMODE = "TESY_ONLY_DDR_EDGEMODE";
constexpr const char* TESY_ONLY_DDR_INIT = "TESY_ONLY_DDR_INIT";
constexpr const char* TESY_ONLY_DDR_RESETTYPE = "TESY_ONLY_DDR_RESETTYPE";
constexpr const char* TESY_ONLY_CASCADING_CLK = "TESY_ONLY_CASCADING_CLK";
constexpr const char* TESY_ONLY_DCM_SWITCHING_CLK = "TESY_ONLY_DCM_SWITCHING_CLK";
constexpr const char* TSY_DCM2PLL_CLKOUT = "TSY_DCM2PLL_CLKOUT";
constexpr const char* TSY_PLL2DCM_CLKOUT = "TSY_PLL2DCM_CLKOUT";
constexpr const char* TESY_ONLY_CLKSEL = "TESY_ONLY_CLKSEL";
constexpr const char* TESY_ONLY_ENABLE_CLKOUTDCM = "TESY_ONLY_ENABLE_CLKOUTDCM";
constexpr const char* TESY_ONLY_PLL_FBSRC_CLKOUT = "TESY_ONLY_PLL_FBSRC_CLKOUT";
constexpr const char* TESY_ONLY_PLL_FBSRC_CLKOUTDCM = "TESY_ONLY_PLL_FBSRC_CLKOUTDCM";
constexpr const char* USE_BUFG = "USE_BUFG";

// Wizard attributes of output pins; the numbered ones are formatted with the
// buffer number n, counted from 1.
constexpr const char* TSY_CLKBUFTYPE = "TSY_CLKBUFTYPE";
constexpr const char* TSY_CLKBUFTYPE_N = "TSY_CLKBUFTYPE%d";
constexpr const char* TSY_CLKBUFTYPE_N_NOEDIT = "TSY_CLKBUFTYPE%d_NOEDIT";
constexpr const char* TSY_CLKBUF_N_BLKNAME = "TSY_CLKBUF%d_BLKNAME";
constexpr const char* TSY_CLKBUF_N_PORT_SIGNAME = "TSY_CLKBUF%d_%s_SIGNAME";
constexpr const char* TSY_CLKBUF_N_PORT_PINNAME = "TSY_CLKBUF%d_%s_PINNAME";
constexpr const char* TSY_CLKBUF_N_O_SIGNAME = "TSY_CLKBUF%d_O_SIGNAME";
constexpr const char* TSY_CLKBUF_N_I1_PINNAME = "TSY_CLKBUF%d_I1_PINNAME";
constexpr const char* TSY_CLKMUX_I0 = "TSY_CLKMUX_I0";
constexpr const char* TSY_CLKMUX_I1 = "TSY_CLKMUX_I1";
constexpr const char* TSY_PMCD_SIGNAME = "TSY_PMCD_SIGNAME";

// Wizard attributes of signals.
constexpr const char* ASSOC_WITH = "ASSOC_WITH";
constexpr const char* USELOWSKEWLINES = "USELOWSKEWLINES";
constexpr const char* USELOCALROUTING = "USELOCALROUTING";

} // namespace Tsy_Attr

// Row states of a buffer record ("TSY_CLKBUFTYPE%d_NOEDIT").
namespace Tsy_BufState {
constexpr const char* FIXED = "TRUE";
constexpr const char* ENABLED = "ENABLED_BUF";
constexpr const char* DISABLED = "DISABLED_BUF";
constexpr const char* FEEDBACK = "FEEDBACK_BUF";
constexpr const char* DEFAULT = "DEFAULT_BUF";
} // namespace Tsy_BufState
