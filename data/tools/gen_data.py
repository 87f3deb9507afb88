#!/usr/bin/env python3
"""Writes the generated data files of Pendra.

    python3 data/tools/gen_data.py            write data/primitives.json and data/speed/*.json
    python3 data/tools/gen_data.py --jitter   also print a table of PLL jitter estimates
    python3 data/tools/gen_data.py --check    write nothing; fail if a file differs from what
                                              this script would write

The primitive library and the speed files are long and repetitive (six PLL
output counters, the same DCM vocabulary on several DCM primitives, eight
jitter constants for each PLL multiplier and bandwidth), so they are written
from the tables below rather than kept by hand. devices.json and wizards.json
are short and kept by hand.
"""

import json
import math
import os
import struct
import sys

DATA_DIR = os.path.normpath(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))

# --------------------------------------------------------------------------
# Primitive library
# --------------------------------------------------------------------------

DCM_CLOCKS = ["CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"]
TRUE_FALSE = ["TRUE", "FALSE"]
FALSE_TRUE = ["FALSE", "TRUE"]


def pin(name, direction, width=1, active=False):
    p = {"name": name, "direction": direction}
    if width != 1:
        p["width"] = width
    p["active"] = active
    return p


def attr(name, type_="string", default="", values=None, range_=None, template=True, active=True):
    a = {"name": name, "type": type_, "default": default}
    if values is not None:
        a["values"] = list(values)
    if range_ is not None:
        a["range"] = list(range_)
    if not active:
        a["active"] = False
    if not template:
        a["template"] = False
    return a


def wizard_only(attrs):
    """Marks attributes as the wizard's own: page settings that are no property
    of the primitive, so the HDL writers leave them out (some, such as
    FIN_UNITS or USE_BUFG, carry no TESY_ONLY_/TSY_ prefix that would say so)."""
    for a in attrs:
        a["hdl"] = False
    return attrs


def simple(type_, description, ins, outs, attributes=()):
    """A primitive all of whose pins are in use whenever it is placed."""
    pins = [pin(n, "IN", active=True) for n in ins] + [pin(n, "OUT", active=True) for n in outs]
    return {"type": type_, "description": description, "pins": pins, "attributes": list(attributes)}


CLKDV_VALUES = ["1.5", "2.0", "2.5", "3.0", "3.5", "4.0", "4.5", "5.0", "5.5", "6.0", "6.5", "7.0", "7.5",
                "8.0", "9.0", "10.0", "11.0", "12.0", "13.0", "14.0", "15.0", "16.0"]
FACTORY_JF_VALUES = ["16'h8080", "16'hF0F0", "16'hC080"]


def deskew_values(last):
    return ["SYSTEM_SYNCHRONOUS", "SOURCE_SYNCHRONOUS"] + [str(i) for i in range(last + 1)]


def dcm_pins(kind):
    """Pins of a DCM primitive. kind: 'dcm' (DCM, DCM_SP), 'adv', 'base', 'ps'."""
    ins = [pin("CLKIN", "IN", active=True), pin("CLKFB", "IN", active=True), pin("RST", "IN", active=True)]
    if kind != "base":
        ins += [pin("PSEN", "IN"), pin("PSINCDEC", "IN"), pin("PSCLK", "IN")]
    if kind == "dcm":
        ins += [pin("DSSEN", "IN")]
    if kind == "adv":
        ins += [pin("DADDR", "IN", 7), pin("DI", "IN", 16), pin("DWE", "IN"), pin("DEN", "IN"), pin("DCLK", "IN")]
    outs = [pin("CLK0", "OUT", active=True), pin("CLK90", "OUT"), pin("CLK180", "OUT"), pin("CLK270", "OUT"),
            pin("CLK2X", "OUT"), pin("CLK2X180", "OUT"), pin("CLKDV", "OUT"), pin("CLKFX", "OUT"),
            pin("CLKFX180", "OUT"), pin("LOCKED", "OUT", active=True)]
    if kind != "base":
        outs += [pin("PSDONE", "OUT")]
    if kind == "dcm":
        outs += [pin("STATUS", "OUT", 8)]
    if kind in ("adv", "ps"):
        outs += [pin("DO", "OUT", 16)]
    if kind == "adv":
        outs += [pin("DRDY", "OUT")]
    return ins + outs


def dcm_hdl_attributes(phase_types, deskew_last, phase_range, factory_jf, generation45):
    """The DCM primitives' own properties, with the defaults of a 100 MHz single-DCM design."""
    attrs = [
        attr("CLKDV_DIVIDE", "real", "2.0", CLKDV_VALUES),
        attr("CLKFX_DIVIDE", "integer", "1", range_=[1, 32]),
        attr("CLKFX_MULTIPLY", "integer", "2", range_=[2, 32]),
        attr("CLKIN_DIVIDE_BY_2", "string", "FALSE", FALSE_TRUE),
        attr("CLKIN_PERIOD", "real", "10.000"),
        attr("CLKOUT_PHASE_SHIFT", "string", "NONE", phase_types),
        attr("CLK_FEEDBACK", "string", "1X", ["1X", "2X", "NONE"]),
    ]
    if generation45:
        attrs += [attr("DCM_AUTOCALIBRATION", "string", "TRUE", TRUE_FALSE),
                  attr("DCM_PERFORMANCE_MODE", "string", "MAX_SPEED", ["MAX_SPEED", "MAX_RANGE"])]
    attrs += [
        attr("DESKEW_ADJUST", "string", "SYSTEM_SYNCHRONOUS", deskew_values(deskew_last)),
        attr("DFS_FREQUENCY_MODE", "string", "LOW", ["LOW", "HIGH"]),
        attr("DLL_FREQUENCY_MODE", "string", "LOW", ["LOW", "HIGH"]),
        attr("DUTY_CYCLE_CORRECTION", "string", "TRUE", TRUE_FALSE),
        attr("FACTORY_JF", "hex", factory_jf, FACTORY_JF_VALUES),
        attr("PHASE_SHIFT", "integer", "0", range_=phase_range),
        attr("STARTUP_WAIT", "string", "FALSE", FALSE_TRUE),
    ]
    if generation45:
        # Added by the General Setup page on Taldor-5 only.
        attrs += [attr("SIM_DEVICE", "string", "TALDOR5", ["TALDOR4", "TALDOR5"], template=False)]
    return attrs


def dcm_wizard_attributes(generation45):
    """The wizard's own attributes of a DCM block: page settings and application choices."""
    attrs = [
        attr("TESY_ONLY_INST_NUM", values=["1", "2"], template=False),
        attr("TESY_ONLY_CLKIN_VALUE", default="100"),
        attr("FIN_UNITS", default="MHZ", values=["MHZ", "NS"]),
        attr("FOUT_UNITS", default="MHZ", values=["MHZ", "NS"]),
        attr("CLKIN_SRC_TYPE", default="EXTERNAL", values=["EXTERNAL", "INTERNAL"]),
        attr("TESY_ONLY_CLKIN_EXTERNAL", default="SINGLE", values=["SINGLE", "DIFFERENTIAL"]),
        attr("FB_SOURCE", default="INTERNAL", values=["INTERNAL", "EXTERNAL", "NONE"]),
        attr("TESY_ONLY_FB_EXTERNAL", default="SINGLE", values=["SINGLE", "DIFFERENTIAL"]),
        attr("TSY_CLK_OUTPUT_TYPE", default="DLL", values=["DLL", "FX", "DLL_AND_FX"]),
        attr("TESY_ONLY_VALID_DFS_MODE", default="LOW", values=["LOW", "HIGH", "BOTH"]),
        attr("TESY_ONLY_RESET_LOGIC", default="FALSE", values=FALSE_TRUE),
    ]
    if generation45:
        attrs += [
            attr("TESY_ONLY_RECONFIG_PINS", default="FALSE", values=FALSE_TRUE),
            # Present only on designs retargeted from generation 4; its presence
            # restricts the PMCD page, so a new block does not carry it.
            attr("TESY_ONLY_RETARGET", values=["T4TOT5"], template=False),
        ]
    attrs += [
        attr("TESY_ONLY_PMCD", default="NONE", values=["NONE", "SINGLE", "PARALLEL"]),
        # Clock Frequency Synthesizer entries: 100 MHz in, 200 MHz out (M = 2, D = 1).
        attr("JITTER_INPUT_TYPE", default="FOUT_STR", values=["FOUT_STR", "M_AND_D_STR"]),
        attr("FOUT_VALUE", default="200"),
        attr("M_VALUE", default="2"),
        attr("D_VALUE", default="1"),
        attr("JITTER_VALUE", template=False),
        attr("JITTER_PK2PK", template=False),
        attr("TESY_ONLY_JITTER_UI_NONOISE", template=False),
        attr("TESY_ONLY_JITTER_PK2PK_NONOISE", template=False),
    ]
    # Clock forwarding. Generation 4/5 forwards one output through an ODDR;
    # the older families drive an OFDDR flip-flop from two clocks C0 and C1.
    if generation45:
        attrs += [
            attr("TESY_ONLY_DDR_FLIPFLOP", default="ODDR", values=["ODDR", "None"]),
            attr("TESY_ONLY_DDR_CLK", default="CLK0", values=DCM_CLOCKS),
            attr("TESY_ONLY_DDR_INIT", default="0", values=["0", "1"]),
            attr("TESY_ONLY_DDR_EDGEMODE", default="OPPOSITE", values=["OPPOSITE", "SAME"]),
            attr("TESY_ONLY_DDR_RESETTYPE", default="ASYNCHRONOUS", values=["ASYNCHRONOUS", "SYNCHRONOUS"]),
        ]
    else:
        attrs += [
            attr("TESY_ONLY_DDR_FLIPFLOP", default="OFDDRCPE",
                 values=["OFDDRCPE", "OFDDRRSE", "OFDDRTCPE", "OFDDRTRSE", "None"]),
            attr("TESY_ONLY_DDR_C0", default="CLK0", values=["CLK0", "CLK2X", "CLKFX"]),
            attr("TESY_ONLY_DDR_C1", default="CLK180", values=["CLK180", "CLK2X180", "CLKFX180", "INVERSION"]),
        ]
    attrs += [
        attr("TESY_ONLY_CASCADING_CLK", default="CLKDV",
             values=["CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180"]),
        attr("TESY_ONLY_DCM_SWITCHING_CLK", default="CLK0", values=DCM_CLOCKS),
    ]
    if generation45:
        attrs += [
            attr("TSY_DCM2PLL_CLKOUT", default="CLK0", values=DCM_CLOCKS),
            attr("TSY_PLL2DCM_CLKOUT", default="CLKOUTDCM0", values=["CLKOUTDCM%d" % n for n in range(6)]),
        ]
    attrs += [attr("USE_BUFG", default="USE_BUFGS", values=["USE_BUFGS", "USE_GRID"])]
    return wizard_only(attrs)


def dcm_primitives():
    older_phase = ["NONE", "FIXED", "VARIABLE"]
    membra_phase = ["NONE", "FIXED", "VARIABLE", "VARIABLE_POSITIVE", "VARIABLE_CENTER"]
    adv_phase = ["NONE", "FIXED", "VARIABLE_POSITIVE", "VARIABLE_CENTER", "DIRECT"]
    return [
        {"type": "DCM",
         "description": "Digital clock manager: delay-locked loop, frequency synthesizer and phase shifter",
         "pins": dcm_pins("dcm"),
         "attributes": dcm_hdl_attributes(older_phase, 15, [-255, 255], "16'hC080", False)
         + dcm_wizard_attributes(False)},
        {"type": "DCM_SP",
         "description": "Digital clock manager of the Membra-3E class",
         "pins": dcm_pins("dcm"),
         "attributes": dcm_hdl_attributes(membra_phase, 15, [-255, 255], "16'hC080", False)
         + dcm_wizard_attributes(False)},
        {"type": "DCM_ADV",
         "description": "Digital clock manager with dynamic reconfiguration port and performance modes",
         "pins": dcm_pins("adv"),
         "attributes": dcm_hdl_attributes(adv_phase, 31, [-255, 1023], "16'hF0F0", True)
         + dcm_wizard_attributes(True)},
        {"type": "DCM_BASE",
         "description": "Digital clock manager without phase-shift or reconfiguration ports",
         "pins": dcm_pins("base"),
         "attributes": dcm_hdl_attributes(["NONE", "FIXED"], 31, [-255, 255], "16'hF0F0", True)},
        {"type": "DCM_PS",
         "description": "Digital clock manager with the variable phase-shift port",
         "pins": dcm_pins("ps"),
         "attributes": dcm_hdl_attributes(adv_phase, 31, [-255, 1023], "16'hF0F0", True)},
    ]


def pll_attributes(adv):
    attrs = [
        attr("BANDWIDTH", "string", "OPTIMIZED", ["OPTIMIZED", "HIGH", "LOW"]),
        attr("CLKFBOUT_MULT", "integer", "8", range_=[1, 64]),
        attr("CLKIN1_PERIOD", "real", "10.000"),
    ]
    if adv:
        attrs += [attr("CLKIN2_PERIOD", "real", "10.000")]
    for n in range(6):
        attrs += [attr("CLKOUT%d_DIVIDE" % n, "integer", "8", range_=[1, 128]),
                  attr("CLKOUT%d_DUTY_CYCLE" % n, "real", "0.500"),
                  attr("CLKOUT%d_PHASE" % n, "real", "0.000")]
    if adv:
        # Older designs kept the CLKOUTDCM counters apart; they are read and
        # then removed, never written.
        for n in range(6):
            attrs += [attr("CLKOUTDCM%d_DIVIDE" % n, "integer", "8", range_=[1, 128], template=False),
                      attr("CLKOUTDCM%d_DUTY_CYCLE" % n, "real", "0.500", template=False),
                      attr("CLKOUTDCM%d_PHASE" % n, "real", "0.000", template=False)]
    compensation = ["SYSTEM_SYNCHRONOUS", "SOURCE_SYNCHRONOUS", "INTERNAL", "EXTERNAL"]
    if adv:
        compensation += ["DCM2PLL", "PLL2DCM"]
    attrs += [
        attr("COMPENSATION", "string", "SYSTEM_SYNCHRONOUS", compensation),
        attr("DIVCLK_DIVIDE", "integer", "1", range_=[1, 52]),
        attr("REF_JITTER", "real", "0.100"),
        attr("RESET_ON_LOSS_OF_LOCK", "string", "FALSE", FALSE_TRUE, template=False),
    ]
    if not adv:
        return attrs
    attrs += wizard_only([
        attr("TESY_ONLY_CLKSEL", default="1", values=["1", "0", "signal"]),
        attr("TESY_ONLY_CLKIN1_VALUE", default="100"),
        attr("TESY_ONLY_CLKIN2_VALUE", default="100"),
        attr("TESY_ONLY_FIN1_UNITS", default="MHZ", values=["MHZ", "NS"]),
        attr("TESY_ONLY_FIN2_UNITS", default="MHZ", values=["MHZ", "NS"]),
        attr("TESY_ONLY_REF_JITTER_UNITS", default="UI", values=["UI", "PS"]),
        attr("TESY_ONLY_RECONFIG_PINS", default="FALSE", values=FALSE_TRUE),
        attr("TESY_ONLY_ENABLE_CLKOUTDCM", default="FALSE", values=FALSE_TRUE),
        # The order matters: the feedback list is selected by index
        # (0 external, 1 through a BUFG, 2 straight).
        attr("TESY_ONLY_PLL_FBSRC_CLKOUT", default="CLKFBOUT with BUFG",
             values=["External", "CLKFBOUT with BUFG", "CLKFBOUT without BUFG"]),
        attr("TESY_ONLY_PLL_FBSRC_CLKOUTDCM", default="CLKFBDCM without BUFG",
             values=["External", "CLKFBDCM with BUFG", "CLKFBDCM without BUFG"]),
        attr("TSY_CLKIN1_SRC_IBUFG", default="TRUE", values=TRUE_FALSE),
        attr("TSY_CLKIN2_SRC_IBUFG", default="TRUE", values=TRUE_FALSE),
        attr("TSY_CLKIN1_INPUT_BUFFER", default="SINGLE", values=["SINGLE", "DIFFERENTIAL"]),
        attr("TSY_CLKIN2_INPUT_BUFFER", default="SINGLE", values=["SINGLE", "DIFFERENTIAL"]),
        # Carries the range of the output divider spin boxes.
        attr("TSY_CLKOUT_DIVIDE_DEFAULT", default="8", range_=[1, 128]),
    ])
    for n in range(6):
        attrs += wizard_only([attr("TSY_PLL_EST_JITTER_CLKOUT%d" % n, template=False)])
    for n in range(6):
        attrs += wizard_only([attr("TSY_PLL_EST_JITTER_CLKOUTDCM%d" % n, template=False)])
    attrs += wizard_only([attr("USE_BUFG", default="USE_BUFGS", values=["USE_BUFGS", "USE_GRID"])])
    return attrs


def pll_primitives():
    adv_pins = [pin("CLKIN1", "IN", active=True), pin("CLKIN2", "IN"), pin("CLKINSEL", "IN", active=True),
                pin("CLKFBIN", "IN", active=True), pin("RST", "IN", active=True), pin("REL", "IN"),
                pin("DADDR", "IN", 5), pin("DI", "IN", 16), pin("DWE", "IN"), pin("DEN", "IN"), pin("DCLK", "IN")]
    adv_pins += [pin("CLKOUT%d" % n, "OUT", active=(n == 0)) for n in range(6)]
    adv_pins += [pin("CLKOUTDCM%d" % n, "OUT") for n in range(6)]
    adv_pins += [pin("CLKFBOUT", "OUT", active=True), pin("CLKFBDCM", "OUT"), pin("LOCKED", "OUT", active=True),
                 pin("DO", "OUT", 16), pin("DRDY", "OUT")]
    base_pins = [pin("CLKIN1", "IN", active=True), pin("CLKFBIN", "IN", active=True), pin("RST", "IN", active=True)]
    base_pins += [pin("CLKOUT%d" % n, "OUT", active=(n == 0)) for n in range(6)]
    base_pins += [pin("CLKFBOUT", "OUT", active=True), pin("LOCKED", "OUT", active=True)]
    return [
        {"type": "PLL_ADV",
         "description": "Phase-locked loop with two inputs, DCM-side outputs and dynamic reconfiguration port",
         "pins": adv_pins, "attributes": pll_attributes(True)},
        {"type": "PLL_BASE",
         "description": "Phase-locked loop with one input and six outputs",
         "pins": base_pins, "attributes": pll_attributes(False)},
    ]


def pmcd_primitive():
    ins = [pin("CLKA", "IN", active=True), pin("CLKB", "IN"), pin("CLKC", "IN"), pin("CLKD", "IN"),
           pin("RST", "IN", active=True), pin("REL", "IN", active=True)]
    outs = [pin("CLKA1", "OUT", active=True), pin("CLKA1D2", "OUT"), pin("CLKA1D4", "OUT"), pin("CLKA1D8", "OUT"),
            pin("CLKB1", "OUT"), pin("CLKC1", "OUT"), pin("CLKD1", "OUT")]
    attrs = [
        attr("EN_REL", "string", "FALSE", FALSE_TRUE),
        attr("RST_DEASSERT_CLK", "string", "CLKA", ["CLKA", "CLKB", "CLKC", "CLKD"]),
    ] + wizard_only([
        attr("TESY_ONLY_INST_NUM", values=["1", "2"], template=False),
        attr("TESY_ONLY_PMCD_CONFIG", default="SINGLE", values=["SINGLE", "PARALLEL"]),
        attr("TESY_ONLY_PMCD_CLKA", default="CLK0", values=DCM_CLOCKS),
        attr("TESY_ONLY_PMCD_CLKB", default="", values=DCM_CLOCKS),
        attr("TESY_ONLY_PMCD_CLKC", default="", values=DCM_CLOCKS),
        attr("TESY_ONLY_PMCD_CLKD", default="", values=DCM_CLOCKS),
        attr("TESY_ONLY_PMCD_FB", default="CLKA1", values=["CLKA1", "CLKB1", "CLKC1", "CLKD1"]),
        attr("USE_BUFG", default="USE_BUFGS", values=["USE_BUFGS", "USE_GRID"]),
    ])
    return {"type": "PMCD",
            "description": "Phase-matched clock divider: four phase-aligned inputs, CLKA divided by 1, 2, 4 and 8",
            "pins": ins + outs, "attributes": attrs}


def logic_primitives():
    mux = ["I0", "I1", "S"]
    return [
        simple("BUFG", "Global clock buffer", ["I"], ["O"]),
        simple("BUFGCE", "Global clock buffer with clock enable", ["I", "CE"], ["O"]),
        simple("BUFGMUX", "Global clock multiplexer", mux, ["O"]),
        simple("BUFGMUX_CTRL", "Global clock multiplexer with glitch-free switching", mux, ["O"]),
        simple("BUFGMUX_TALDOR4", "Global clock multiplexer of the Taldor-4 clock tree", mux, ["O"]),
        simple("BUFGCTRL", "Global clock multiplexer with separate selects, enables and ignore inputs",
               ["I0", "I1", "S0", "S1", "CE0", "CE1", "IGNORE0", "IGNORE1"], ["O"]),
        simple("IBUFG", "Clock input buffer", ["I"], ["O"]),
        simple("IBUFGDS", "Differential clock input buffer", ["I", "IB"], ["O"]),
        simple("OBUF", "Output buffer", ["I"], ["O"]),
        simple("INV", "Inverter", ["I"], ["O"]),
        simple("OR2", "Two-input OR gate", ["I0", "I1"], ["O"]),
        simple("OR3", "Three-input OR gate", ["I0", "I1", "I2"], ["O"]),
        simple("FD", "D flip-flop", ["C", "D"], ["Q"]),
        simple("FDS", "D flip-flop with synchronous set", ["C", "D", "S"], ["Q"]),
        simple("SRL16", "16-bit shift register look-up table", ["A0", "A1", "A2", "A3", "CLK", "D"], ["Q"]),
        simple("ODDR", "Output double-data-rate register", ["C", "CE", "D1", "D2", "R", "S"], ["Q"], [
            attr("DDR_CLK_EDGE", "string", "OPPOSITE_EDGE", ["OPPOSITE_EDGE", "SAME_EDGE"]),
            attr("INIT", "bit", "0", ["0", "1"]),
            attr("SRTYPE", "string", "SYNC", ["SYNC", "ASYNC"]),
        ]),
        simple("OFDDRCPE", "Output DDR flip-flop with clock enable, asynchronous preset and clear",
               ["C0", "C1", "CE", "CLR", "D0", "D1", "PRE"], ["Q"]),
        simple("OFDDRRSE", "Output DDR flip-flop with clock enable, synchronous set and reset",
               ["C0", "C1", "CE", "D0", "D1", "R", "S"], ["Q"]),
        simple("OFDDRTCPE", "Tri-state output DDR flip-flop with clock enable, asynchronous preset and clear",
               ["C0", "C1", "CE", "CLR", "D0", "D1", "PRE", "T"], ["O"]),
        simple("OFDDRTRSE", "Tri-state output DDR flip-flop with clock enable, synchronous set and reset",
               ["C0", "C1", "CE", "D0", "D1", "R", "S", "T"], ["O"]),
    ]


def primitive_library():
    return {"format": 1,
            "primitives": dcm_primitives() + pll_primitives() + [pmcd_primitive()] + logic_primitives()}


# --------------------------------------------------------------------------
# Speed files
# --------------------------------------------------------------------------

GROUPS = ["CLKOUT_FREQ_1X", "CLKOUT_FREQ_2X", "CLKOUT_FREQ_DV", "CLKOUT_FREQ_FX",
          "CLKIN_FREQ_DLL", "CLKIN_FREQ_FX", "PSCLK_FREQ"]
NONE = (0, 0)  # a range nothing lies in


def scaled(value, factor):
    """A maximum raised for a faster grade, rounded as a data sheet would print it."""
    v = value * factor
    if v >= 100:
        return int(round(v))
    if v >= 10:
        return round(v, 1)
    return round(v, 2)


def number(v):
    return int(v) if float(v).is_integer() else v


# Ranges of the slowest grade: group -> (low-frequency range, high-frequency range).
OLDER_DCM = {
    "CLKOUT_FREQ_1X": ((24, 210), (48, 420)),
    "CLKOUT_FREQ_2X": ((48, 420), NONE),
    "CLKOUT_FREQ_DV": ((1.5, 140), (3, 280)),
    "CLKOUT_FREQ_FX": ((24, 210), (210, 420)),
    "CLKIN_FREQ_DLL": ((24, 210), (48, 420)),
    "CLKIN_FREQ_FX": ((1, 210), (50, 420)),
    "PSCLK_FREQ": ((1, 420), (1, 420)),
}
MEMBRA3_DCM = {
    "CLKOUT_FREQ_1X": ((18, 167), (48, 280)),
    "CLKOUT_FREQ_2X": ((36, 334), NONE),
    "CLKOUT_FREQ_DV": ((1.125, 111), (3, 186)),
    "CLKOUT_FREQ_FX": ((18, 210), (210, 307)),
    "CLKIN_FREQ_DLL": ((18, 167), (48, 280)),
    "CLKIN_FREQ_FX": ((1, 210), (48, 280)),
    "PSCLK_FREQ": ((1, 167), (1, 280)),
}
# One mode only: the high-frequency ranges are empty.
MEMBRA3E_DCM_SLOW = {
    "CLKOUT_FREQ_1X": ((5, 240), NONE),
    "CLKOUT_FREQ_2X": ((10, 311), NONE),
    "CLKOUT_FREQ_DV": ((0.3125, 160), NONE),
    "CLKOUT_FREQ_FX": ((5, 333), NONE),
    "CLKIN_FREQ_DLL": ((5, 240), NONE),
    "CLKIN_FREQ_FX": ((0.2, 311), NONE),
    "PSCLK_FREQ": ((1, 167), NONE),
}
MEMBRA3E_DCM_FAST = {
    "CLKOUT_FREQ_1X": ((5, 275), NONE),
    "CLKOUT_FREQ_2X": ((10, 333), NONE),
    "CLKOUT_FREQ_DV": ((0.3125, 183), NONE),
    "CLKOUT_FREQ_FX": ((5, 350), NONE),
    "CLKIN_FREQ_DLL": ((5, 275), NONE),
    "CLKIN_FREQ_FX": ((0.2, 333), NONE),
    "PSCLK_FREQ": ((1, 183), NONE),
}
# Generation 4/5: group -> {"MS": (LF, HF), "MR": (LF, HF)}.
def generation45_dcm(dll_lf, dll_hf):
    return {
        "CLKOUT_FREQ_1X": {"MS": (dll_lf, dll_hf), "MR": ((19, 32), NONE)},
        "CLKOUT_FREQ_2X": {"MS": ((64, 300), NONE), "MR": ((38, 64), NONE)},
        "CLKOUT_FREQ_DV": {"MS": ((2, 100), (9.4, 333)), "MR": ((1.2, 21), NONE)},
        "CLKOUT_FREQ_FX": {"MS": ((32, 210), (210, 350)), "MR": ((19, 40), NONE)},
        "CLKIN_FREQ_DLL": {"MS": (dll_lf, dll_hf), "MR": ((19, 32), NONE)},
        "CLKIN_FREQ_FX": {"MS": ((1, 210), (50, 500)), "MR": ((1, 40), NONE)},
        "PSCLK_FREQ": {"MS": ((1, 500), (1, 500)), "MR": ((1, 500), NONE)},
    }


TALDOR4_DCM = generation45_dcm((32, 150), (150, 500))
TALDOR5_DCM = generation45_dcm((32, 120), (120, 550))


def raise_maxima(table, factor):
    """The same ranges with every non-empty maximum raised by the factor."""
    out = {}
    for group, ranges in table.items():
        out[group] = tuple((lo, scaled(hi, factor) if hi else hi) for lo, hi in ranges)
    return out


def plain_keys(table):
    """Keys of a family without performance modes, as its pages query them."""
    keys = {}
    for group in GROUPS:
        for mode, (lo, hi) in zip(("LF", "HF"), table[group]):
            base = "%s_%s" % (group, mode)
            keys[base + "_Min"] = lo
            keys[base + "_Max"] = hi
            if base == "CLKIN_FREQ_FX_HF":
                # The generic spelling of this key drops the E of FREQ.
                keys["CLKIN_FRQ_FX_HF_Min"] = lo
                keys["CLKIN_FRQ_FX_HF_Max"] = hi
            if group == "CLKOUT_FREQ_FX":
                keys["CLKOUT_FRQ_FX_%s_Min" % mode] = lo
                keys["CLKOUT_FRQ_FX_%s_Max" % mode] = hi
            if group in ("CLKIN_FREQ_DLL", "CLKIN_FREQ_FX"):
                # The synthesizer page reads the input ranges under their
                # maximum-speed names on every family.
                keys[base + "_MS_Min"] = lo
                keys[base + "_MS_Max"] = hi
    return keys


def modal_keys(table):
    """Keys of a family with performance modes: every range under its MS_ and
    MR_ names, and the plain names with the maximum-speed figures for the
    keys that are queried untranslated."""
    keys = {}
    for group in GROUPS:
        for perf in ("MS", "MR"):
            for mode, (lo, hi) in zip(("LF", "HF"), table[group][perf]):
                keys["%s_%s_%s_Min" % (group, mode, perf)] = lo
                keys["%s_%s_%s_Max" % (group, mode, perf)] = hi
                if group == "CLKIN_FREQ_FX" and mode == "HF":
                    keys["CLKIN_FRQ_FX_HF_%s_Min" % perf] = lo
                    keys["CLKIN_FRQ_FX_HF_%s_Max" % perf] = hi
    plain_table = {g: table[g]["MS"] for g in GROUPS}
    # In maximum-range mode the doubled-output high range is queried under its
    # plain name: it takes the maximum-range figures (that mode has no high range).
    plain_table["CLKOUT_FREQ_2X"] = (table["CLKOUT_FREQ_2X"]["MS"][0], table["CLKOUT_FREQ_2X"]["MR"][1])
    for k, v in plain_keys(plain_table).items():
        keys.setdefault(k, v)
    return keys


def raise_modal_maxima(table, factor):
    """Faster grades raise the maximum-speed maxima; the maximum-range ranges
    end where maximum speed takes over and stay as they are."""
    out = {}
    for group, perfs in table.items():
        out[group] = {"MS": tuple((lo, scaled(hi, factor) if hi else hi) for lo, hi in perfs["MS"]),
                      "MR": perfs["MR"]}
    return out


def split_common(per_grade):
    """Keys equal in every grade go to 'common', the rest stay per grade."""
    grades = list(per_grade)
    first = per_grade[grades[0]]
    common = {k: v for k, v in first.items() if all(per_grade[g].get(k) == v for g in grades)}
    by_grade = {g: {k: v for k, v in per_grade[g].items() if k not in common} for g in grades}
    return common, by_grade


def key_order(key):
    """Sorts a range's minimum before its maximum."""
    for end, rank in (("_Min", 0), ("_MIN", 0), ("_Max", 1), ("_MAX", 1)):
        if key.endswith(end):
            return (key[:-len(end)], rank)
    return (key, 0)


def speed_document(description, per_grade, factors=None):
    common, by_grade = split_common(per_grade)
    doc = {"format": 1, "description": description, "units": "MHz",
           "common": {k: number(common[k]) for k in sorted(common, key=key_order)},
           "grades": {g: {k: number(v[k]) for k in sorted(v, key=key_order)} for g, v in by_grade.items()}}
    if factors:
        doc["factors"] = factors
    return doc


def older_speed(grades, factors):
    return {g: plain_keys(raise_maxima(OLDER_DCM, f)) for g, f in zip(grades, factors)}


# ---- PLL jitter constants --------------------------------------------------
#
# The output jitter estimate of the PLL Output Clock Settings page is
#   VCO = fin * M / D
#   A = K1 * VCO^K2                        intrinsic jitter of the loop
#   B = sqrt(D) * R                        reference jitter (R in ns; 1 UI = 10000 ps)
#   C = K4 * ln(VCO) + K5                  share of the reference jitter passed on
#   E = (400 / VCO)^0.25, F = K12 * E      least share passed on
#   G = C + K6 * E * ln(N), H = C * N^K7   growth of the share with the divider N
#   P = B * max(F, min(G, H)), Q = A * N^K3
#   jitter = sqrt(P^2 + Q^2)  (ns)
# The constants below give 0.1 to 0.4 ns for a reference jitter of 0.1 UI over
# the usual VCO range (600 - 900 MHz) and dividers (2 - 32). A low loop
# bandwidth filters more of the reference jitter (smaller C, F, G, H) and lets
# slightly more of the VCO's own jitter through (larger A). The constants
# change linearly with M, so the estimate moves smoothly from one multiplier
# to the next.

VCO_REF = 750.0  # MHz, where the shares below are taken
BANDWIDTHS = {
    #        share C  growth K6  K7    floor K12  intrinsic A  K3    VCO slope K4
    "HIGH": (0.135, 0.040, 0.18, 0.090, 0.055, 0.12, -0.015),
    "LOW": (0.085, 0.025, 0.15, 0.060, 0.062, 0.12, -0.010),
}


def pll_constants(m, bandwidth):
    share, k6, k7, floor, intrinsic, k3, k4 = BANDWIDTHS[bandwidth]
    # More multiplication passes on more of the reference jitter and adds a
    # little divider noise: both rise evenly with M, by well under one percent
    # from one multiplier to the next.
    grow = 1.0 + 0.2 * (m - 8) / 63.0
    c = share * grow
    return {
        "K1": intrinsic * (1.0 + 0.1 * (m - 8) / 63.0) * math.sqrt(VCO_REF),
        "K2": -0.5,
        "K3": k3,
        "K4": k4 * grow,
        "K5": c - k4 * grow * math.log(VCO_REF),
        "K6": k6 * grow,
        "K7": k7,
        "K12": floor * grow,
    }


def pll_factors():
    factors = {}
    for m in range(1, 65):
        for bw in ("LOW", "HIGH"):
            for name, value in pll_constants(m, bw).items():
                factors["PLL_MULT_%d_BW_%s_%s" % (m, bw, name)] = float("%.6g" % value)
    return factors


def f32(x):
    return struct.unpack("f", struct.pack("f", x))[0]


def pll_jitter(factors, fin, m, d, n, bandwidth, ref_jitter_ui=0.1):
    """The page's estimate, in ns, evaluated in single precision."""
    k = {name: f32(factors["PLL_MULT_%d_BW_%s_%s" % (m, bandwidth, name)])
         for name in ("K1", "K2", "K3", "K4", "K5", "K6", "K7", "K12")}
    vco = f32(f32(fin * m) / d)
    a = f32(k["K1"] * f32(vco ** k["K2"]))
    r = f32(f32(ref_jitter_ui * 10000) * 0.001)
    b = f32(f32(math.sqrt(d)) * r)
    c = f32(f32(k["K4"] * f32(math.log(vco))) + k["K5"])
    e = f32(f32(400 / vco) ** 0.25)
    f = f32(k["K12"] * e)
    g = f32(c + f32(f32(k["K6"] * e) * f32(math.log(n))))
    h = f32(c * f32(n ** k["K7"]))
    p = f32(b * max(f, min(g, h)))
    q = f32(a * f32(n ** k["K3"]))
    return f32(math.sqrt(f32(f32(p * p) + f32(q * q))))


def speed_files():
    files = {}
    files["speed/taldor2.json"] = speed_document(
        "DCM figures of Taldor-II, QTaldor-II and QRTaldor-II",
        older_speed(["-4", "-5", "-6"], [1.0, 1.1, 1.2]))
    files["speed/taldor2p.json"] = speed_document(
        "DCM figures of Taldor-II Pro and QTaldor-II Pro",
        older_speed(["-5", "-6", "-7"], [1.0, 1.1, 1.2]))
    files["speed/membra3.json"] = speed_document(
        "DCM figures of Membra-3 and AMembra-3",
        {g: plain_keys(raise_maxima(MEMBRA3_DCM, f)) for g, f in (("-4", 1.0), ("-5", 1.1))})
    files["speed/membra3e.json"] = speed_document(
        "DCM_SP figures of the Membra-3E class (one frequency mode: the high ranges are empty)",
        {"-4": plain_keys(MEMBRA3E_DCM_SLOW), "-5": plain_keys(MEMBRA3E_DCM_FAST)})
    files["speed/taldor4.json"] = speed_document(
        "DCM_ADV figures of Taldor-4, QTaldor-4 and QRTaldor-4 (MS_ maximum speed, MR_ maximum range)",
        {g: modal_keys(raise_modal_maxima(TALDOR4_DCM, f))
         for g, f in (("-10", 1.0), ("-11", 1.08), ("-12", 1.16))})
    t5 = {}
    pll = {"-1": (450, 1000), "-2": (500, 1100), "-3": (710, 1200)}
    for g, f in (("-1", 1.0), ("-2", 1.08), ("-3", 1.16)):
        keys = modal_keys(raise_modal_maxima(TALDOR5_DCM, f))
        keys.update({"CLKIN_FREQ_MIN": 19, "CLKIN_FREQ_MAX": pll[g][0],
                     "VCOCLK_FREQ_MIN": 400, "VCOCLK_FREQ_MAX": pll[g][1], "O_MAX_HT_LT": 63})
        t5[g] = keys
    files["speed/taldor5.json"] = speed_document(
        "DCM_ADV and PLL_ADV figures of Taldor-5 (MS_ maximum speed, MR_ maximum range)",
        t5, pll_factors())
    return files


# --------------------------------------------------------------------------
# Writing
# --------------------------------------------------------------------------

def dump(value, indent=0, inline_depth=None):
    """JSON with two-space indentation; objects inside lists of pins and
    attributes stay on one line each so the files read as tables."""
    pad = "  " * indent
    if isinstance(value, dict):
        if not value:
            return "{}"
        if inline_depth is not None and indent >= inline_depth:
            return "{" + ", ".join("%s: %s" % (json.dumps(k), json.dumps(v)) for k, v in value.items()) + "}"
        items = ["%s  %s: %s" % (pad, json.dumps(k), dump(v, indent + 1, inline_depth)) for k, v in value.items()]
        return "{\n" + ",\n".join(items) + "\n" + pad + "}"
    if isinstance(value, list):
        if not value:
            return "[]"
        if all(not isinstance(v, (dict, list)) for v in value):
            return json.dumps(value)
        items = ["%s  %s" % (pad, dump(v, indent + 1, inline_depth)) for v in value]
        return "[\n" + ",\n".join(items) + "\n" + pad + "]"
    return json.dumps(value)


def outputs():
    out = {"primitives.json": dump(primitive_library(), inline_depth=4) + "\n"}
    for path, doc in speed_files().items():
        out[path] = dump(doc) + "\n"
    return out


def jitter_report(factors):
    lines = ["PLL jitter estimate (ns), REF_JITTER 0.1 UI, D = 1",
             "  %-28s %8s %8s %8s %8s" % ("configuration", "N=2", "N=8", "N=16", "N=32")]
    for vco, m in ((600, 6), (800, 8), (900, 9), (600, 24), (800, 32), (900, 45), (750, 3), (640, 64)):
        fin = vco / m
        for bw in ("HIGH", "LOW"):
            row = [pll_jitter(factors, fin, m, 1, n, bw) for n in (2, 8, 16, 32)]
            lines.append("  %-28s %8.3f %8.3f %8.3f %8.3f" % (
                "VCO %d (fin %.1f, M %d) %s" % (vco, fin, m, bw), *row))
    return "\n".join(lines)


def main(argv):
    files = outputs()
    if "--check" in argv:
        stale = []
        for path, text in files.items():
            full = os.path.join(DATA_DIR, path)
            try:
                with open(full) as f:
                    if f.read() != text:
                        stale.append(path)
            except OSError:
                stale.append(path)
        for path in stale:
            print("out of date: data/%s" % path)
        return 1 if stale else 0
    for path, text in files.items():
        full = os.path.join(DATA_DIR, path)
        os.makedirs(os.path.dirname(full), exist_ok=True)
        with open(full, "w") as f:
            f.write(text)
        print("wrote data/%s" % path)
    if "--jitter" in argv:
        print(jitter_report(pll_factors()))
    return 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
