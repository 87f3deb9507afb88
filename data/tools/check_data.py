#!/usr/bin/env python3
"""Checks the data files of Pendra against each other and against the rules
the wizard relies on.

    python3 data/tools/check_data.py [DATA_DIR]

Reads primitives.json, devices.json, wizards.json and every speed file the
device catalogue names, and reports every problem found (exit status 1), or
prints a short summary (exit status 0). It also asks gen_data.py whether the
generated files are up to date.
"""

import json
import math
import os
import re
import struct
import subprocess
import sys

TOOLS_DIR = os.path.dirname(os.path.abspath(__file__))

problems = []


def fail(msg):
    problems.append(msg)


def load_json(data_dir, rel):
    path = os.path.join(data_dir, rel)
    try:
        with open(path) as f:
            return json.load(f)
    except OSError as e:
        fail("%s: cannot be read (%s)" % (rel, e.strerror))
    except ValueError as e:
        fail("%s: not valid JSON: %s" % (rel, e))
    return None


def is_str_list(v):
    return isinstance(v, list) and all(isinstance(e, str) for e in v)


def is_int(v):
    return isinstance(v, int) and not isinstance(v, bool)


def is_number(v):
    return isinstance(v, (int, float)) and not isinstance(v, bool) and math.isfinite(v)


# --------------------------------------------------------------------------
# What the wizard relies on
# --------------------------------------------------------------------------

FAMILY_KEYS = ["taldor4", "qtaldor4", "qrtaldor4", "taldor5", "membra3e", "membra3a", "membra3an", "amembra3e",
               "membra3", "amembra3", "taldor2p", "qtaldor2p", "taldor2", "qtaldor2", "qrtaldor2"]
GEN45 = {"taldor4", "qtaldor4", "qrtaldor4", "taldor5"}
MEMBRA3E_CLASS = {"membra3e", "membra3a", "membra3an", "amembra3e"}
CAPABILITIES = {"dcm", "pll", "pmcd", "bufgctrl", "bufgmux_ctrl", "oddr", "performance_modes"}
WIZARD_KEYS = ["dcm", "dcm_bddeskew", "dcm_clkfwd", "dcm_clkswitch", "dcm_cascading", "dcm_pll", "dcm_dcm2pll",
               "dcm_pll2dcm"]
TALDOR5_LISTED = ["da1", "da1e", "da2", "da2e", "da3", "da3e", "da4", "da4e", "db1e", "db2e"]
DCM_CLOCKS = ["CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"]

# Pins every placement relies on: name -> (direction, width).
def pins(ins, outs, widths=None):
    widths = widths or {}
    d = {n: ("IN", widths.get(n, 1)) for n in ins}
    d.update({n: ("OUT", widths.get(n, 1)) for n in outs})
    return d


DCM_OUT = ["CLK0", "CLK90", "CLK180", "CLK270", "CLK2X", "CLK2X180", "CLKDV", "CLKFX", "CLKFX180", "LOCKED"]
REQUIRED_PINS = {
    "DCM": pins(["CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK", "DSSEN"], DCM_OUT + ["PSDONE", "STATUS"],
                {"STATUS": 8}),
    "DCM_SP": pins(["CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK", "DSSEN"], DCM_OUT + ["PSDONE", "STATUS"],
                   {"STATUS": 8}),
    "DCM_ADV": pins(["CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK", "DADDR", "DI", "DWE", "DEN", "DCLK"],
                    DCM_OUT + ["PSDONE", "DO", "DRDY"], {"DADDR": 7, "DI": 16, "DO": 16}),
    "DCM_BASE": pins(["CLKIN", "CLKFB", "RST"], DCM_OUT),
    "DCM_PS": pins(["CLKIN", "CLKFB", "RST", "PSEN", "PSINCDEC", "PSCLK"], DCM_OUT + ["PSDONE"]),
    "PLL_ADV": pins(["CLKIN1", "CLKIN2", "CLKINSEL", "CLKFBIN", "RST", "REL", "DADDR", "DI", "DWE", "DEN", "DCLK"],
                    ["CLKOUT%d" % n for n in range(6)] + ["CLKOUTDCM%d" % n for n in range(6)]
                    + ["CLKFBOUT", "CLKFBDCM", "LOCKED", "DO", "DRDY"], {"DADDR": 5, "DI": 16, "DO": 16}),
    "PLL_BASE": pins(["CLKIN1", "CLKFBIN", "RST"], ["CLKOUT%d" % n for n in range(6)] + ["CLKFBOUT", "LOCKED"]),
    "PMCD": pins(["CLKA", "CLKB", "CLKC", "CLKD", "RST", "REL"],
                 ["CLKA1", "CLKA1D2", "CLKA1D4", "CLKA1D8", "CLKB1", "CLKC1", "CLKD1"]),
    "BUFG": pins(["I"], ["O"]),
    "BUFGCE": pins(["I", "CE"], ["O"]),
    "BUFGMUX": pins(["I0", "I1", "S"], ["O"]),
    "BUFGMUX_CTRL": pins(["I0", "I1", "S"], ["O"]),
    "BUFGMUX_TALDOR4": pins(["I0", "I1", "S"], ["O"]),
    "BUFGCTRL": pins(["I0", "I1", "S0", "S1", "CE0", "CE1", "IGNORE0", "IGNORE1"], ["O"]),
    "IBUFG": pins(["I"], ["O"]),
    "IBUFGDS": pins(["I", "IB"], ["O"]),
    "OBUF": pins(["I"], ["O"]),
    "INV": pins(["I"], ["O"]),
    "OR2": pins(["I0", "I1"], ["O"]),
    "OR3": pins(["I0", "I1", "I2"], ["O"]),
    "FD": pins(["C", "D"], ["Q"]),
    "FDS": pins(["C", "D", "S"], ["Q"]),
    "SRL16": pins(["A0", "A1", "A2", "A3", "CLK", "D"], ["Q"]),
    "ODDR": pins(["C", "CE", "D1", "D2", "R", "S"], ["Q"]),
    "OFDDRCPE": pins(["C0", "C1", "CE", "CLR", "D0", "D1", "PRE"], ["Q"]),
    "OFDDRRSE": pins(["C0", "C1", "CE", "D0", "D1", "R", "S"], ["Q"]),
    "OFDDRTCPE": pins(["C0", "C1", "CE", "CLR", "D0", "D1", "PRE", "T"], ["O"]),
    "OFDDRTRSE": pins(["C0", "C1", "CE", "D0", "D1", "R", "S", "T"], ["O"]),
}
# Pins in use on a new template block.
TEMPLATE_ACTIVE_PINS = {
    "DCM": {"CLKIN", "CLKFB", "RST", "CLK0", "LOCKED"},
    "DCM_SP": {"CLKIN", "CLKFB", "RST", "CLK0", "LOCKED"},
    "DCM_ADV": {"CLKIN", "CLKFB", "RST", "CLK0", "LOCKED"},
    # CLKINSEL is tied or driven in every PLL design.
    "PLL_ADV": {"CLKIN1", "CLKINSEL", "CLKFBIN", "RST", "CLKOUT0", "LOCKED", "CLKFBOUT"},
}

# Value lists whose order the pages depend on (combo indexes), or that must
# hold at least the named values: primitive -> attribute -> (list, exact order?).
def dcm_lists(phase, deskew_last, ddr):
    lists = {
        "CLKDV_DIVIDE": (["1.5", "2.0", "2.5", "3.0", "3.5", "4.0", "4.5", "5.0", "5.5", "6.0", "6.5", "7.0", "7.5",
                          "8.0", "9.0", "10.0", "11.0", "12.0", "13.0", "14.0", "15.0", "16.0"], True),
        "CLKOUT_PHASE_SHIFT": (phase, True),
        "DESKEW_ADJUST": (["SYSTEM_SYNCHRONOUS", "SOURCE_SYNCHRONOUS"] + [str(i) for i in range(deskew_last + 1)],
                          True),
        "CLK_FEEDBACK": (["1X", "2X", "NONE"], False),
        "DLL_FREQUENCY_MODE": (["LOW", "HIGH"], False),
        "DFS_FREQUENCY_MODE": (["LOW", "HIGH"], False),
        "FACTORY_JF": (["16'h8080", "16'hF0F0", "16'hC080"], False),
        "TESY_ONLY_DDR_FLIPFLOP": (ddr, True),
        "TESY_ONLY_CASCADING_CLK": (["CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180"], True),
        "TESY_ONLY_DCM_SWITCHING_CLK": (DCM_CLOCKS, True),
        "TESY_ONLY_PMCD": (["NONE", "SINGLE", "PARALLEL"], False),
        "USE_BUFG": (["USE_BUFGS", "USE_GRID"], False),
    }
    return lists


REQUIRED_LISTS = {
    "DCM": dcm_lists(["NONE", "FIXED", "VARIABLE"], 15, ["OFDDRCPE", "OFDDRRSE", "OFDDRTCPE", "OFDDRTRSE", "None"]),
    "DCM_SP": dcm_lists(["NONE", "FIXED", "VARIABLE"], 15,
                        ["OFDDRCPE", "OFDDRRSE", "OFDDRTCPE", "OFDDRTRSE", "None"]),
    "DCM_ADV": dict(dcm_lists(["NONE", "FIXED", "VARIABLE_POSITIVE", "VARIABLE_CENTER", "DIRECT"], 31,
                              ["ODDR", "None"]),
                    DCM_PERFORMANCE_MODE=(["MAX_SPEED", "MAX_RANGE"], False),
                    TESY_ONLY_DDR_CLK=(DCM_CLOCKS, True),
                    TSY_DCM2PLL_CLKOUT=(DCM_CLOCKS, True),
                    TSY_PLL2DCM_CLKOUT=(["CLKOUTDCM%d" % n for n in range(6)], True)),
    "PLL_ADV": {
        "TESY_ONLY_PLL_FBSRC_CLKOUT": (["External", "CLKFBOUT with BUFG", "CLKFBOUT without BUFG"], True),
        "TESY_ONLY_PLL_FBSRC_CLKOUTDCM": (["External", "CLKFBDCM with BUFG", "CLKFBDCM without BUFG"], True),
        "TESY_ONLY_CLKSEL": (["1", "0", "signal"], True),
        "BANDWIDTH": (["OPTIMIZED", "HIGH", "LOW"], True),
        "COMPENSATION": (["SYSTEM_SYNCHRONOUS", "SOURCE_SYNCHRONOUS", "INTERNAL", "EXTERNAL", "DCM2PLL", "PLL2DCM"],
                         False),
        "CLKFBOUT_MULT": (["1:64"], True),
        "DIVCLK_DIVIDE": (["1:52"], True),
        "TSY_CLKOUT_DIVIDE_DEFAULT": (["1:128"], True),
    },
    "PMCD": {
        "EN_REL": (["TRUE", "FALSE"], False),
        "TESY_ONLY_PMCD_FB": (["CLKA1", "CLKB1", "CLKC1", "CLKD1"], False),
        "USE_BUFG": (["USE_BUFGS", "USE_GRID"], False),
    },
    "ODDR": {
        "DDR_CLK_EDGE": (["OPPOSITE_EDGE", "SAME_EDGE"], False),
        "SRTYPE": (["SYNC", "ASYNC"], False),
    },
}
for _p in ("DCM", "DCM_SP", "DCM_ADV"):
    REQUIRED_LISTS[_p]["CLKFX_MULTIPLY"] = (["2:32"], True)
    REQUIRED_LISTS[_p]["CLKFX_DIVIDE"] = (["1:32"], True)

# Template defaults a run with a few settings relies on.
DCM_DEFAULTS = {
    "FB_SOURCE": "INTERNAL", "CLK_FEEDBACK": "1X", "CLKIN_SRC_TYPE": "EXTERNAL",
    "TESY_ONLY_CLKIN_EXTERNAL": "SINGLE", "TESY_ONLY_FB_EXTERNAL": "SINGLE", "FIN_UNITS": "MHZ",
    "FOUT_UNITS": "MHZ", "CLKIN_DIVIDE_BY_2": "FALSE", "DUTY_CYCLE_CORRECTION": "TRUE",
    "CLKOUT_PHASE_SHIFT": "NONE", "PHASE_SHIFT": "0", "STARTUP_WAIT": "FALSE",
    "DESKEW_ADJUST": "SYSTEM_SYNCHRONOUS", "CLKDV_DIVIDE": "2.0", "TESY_ONLY_RESET_LOGIC": "FALSE",
    "TESY_ONLY_PMCD": "NONE", "TSY_CLK_OUTPUT_TYPE": "DLL", "DLL_FREQUENCY_MODE": "LOW",
    "DFS_FREQUENCY_MODE": "LOW", "JITTER_INPUT_TYPE": "FOUT_STR",
}
PLL_DEFAULTS = {
    "TESY_ONLY_CLKSEL": "1", "TESY_ONLY_FIN1_UNITS": "MHZ", "CLKIN1_PERIOD": "10.000", "DIVCLK_DIVIDE": "1",
    "BANDWIDTH": "OPTIMIZED", "REF_JITTER": "0.100", "TESY_ONLY_PLL_FBSRC_CLKOUT": "CLKFBOUT with BUFG",
    "TESY_ONLY_ENABLE_CLKOUTDCM": "FALSE", "TESY_ONLY_REF_JITTER_UNITS": "UI",
}
# Wizard attributes whose mere presence on a block changes what a page does.
MUST_NOT_BE_ON_TEMPLATE = {"TESY_ONLY_RETARGET", "TESY_ONLY_INST_NUM"}
MUST_BE_ON_TEMPLATE = {
    "DCM": {"TESY_ONLY_DCM_SWITCHING_CLK", "TESY_ONLY_CASCADING_CLK", "TESY_ONLY_DDR_FLIPFLOP", "CLKDV_DIVIDE",
            "CLKOUT_PHASE_SHIFT", "DESKEW_ADJUST"},
    "PLL_ADV": {"TESY_ONLY_CLKSEL", "BANDWIDTH", "COMPENSATION", "TESY_ONLY_PLL_FBSRC_CLKOUT",
                "TESY_ONLY_PLL_FBSRC_CLKOUTDCM", "CLKFBOUT_MULT", "DIVCLK_DIVIDE", "TSY_CLKOUT_DIVIDE_DEFAULT"},
}
MUST_BE_ON_TEMPLATE["DCM_SP"] = MUST_BE_ON_TEMPLATE["DCM"]
MUST_BE_ON_TEMPLATE["DCM_ADV"] = MUST_BE_ON_TEMPLATE["DCM"] | {"TESY_ONLY_DDR_CLK", "TESY_ONLY_DDR_INIT",
                                                              "TESY_ONLY_DDR_EDGEMODE", "TESY_ONLY_DDR_RESETTYPE"}

# --------------------------------------------------------------------------
# Speed keys, as the pages query them
# --------------------------------------------------------------------------

GENERIC = []
for _mode in ("LF", "HF"):
    for _g in ("CLKOUT_FREQ_1X", "CLKOUT_FREQ_2X", "CLKOUT_FREQ_DV", "CLKOUT_FREQ_FX", "CLKIN_FREQ_DLL",
               "CLKIN_FREQ_FX", "PSCLK_FREQ"):
        _stem = "CLKIN_FRQ_FX_HF" if (_g, _mode) == ("CLKIN_FREQ_FX", "HF") else "%s_%s" % (_g, _mode)
        GENERIC += [_stem + "_Min", _stem + "_Max"]


def translate(key, perf_flag, mode):
    """The speed-data layer's key translation."""
    if not perf_flag:
        return key
    for g in GENERIC:
        if g.upper() == key.upper():
            if mode == 1 and g in ("CLKOUT_FREQ_2X_HF_Min", "CLKOUT_FREQ_2X_HF_Max"):
                return key
            stem, end = g[:-3], g[-3:]
            if stem == "CLKIN_FRQ_FX_HF_":
                stem = "CLKIN_FREQ_FX_HF_"
            return stem + ("MS_" if mode == 0 else "MR_") + end
    return key


def queried_keys(family, caps):
    """Every bel key a page of this family can ask the speed file for."""
    perf = "performance_modes" in caps
    modes = (0, 1) if perf else (0,)
    infixes = ("MS_", "MR_") if perf else ("",)
    raw_translated = []
    # General Setup, with the infix filled in.
    untranslated = []
    for ix in infixes:
        for stem in ("CLKIN_FREQ_DLL_LF_", "CLKIN_FREQ_DLL_HF_", "CLKIN_FREQ_FX_LF_", "CLKIN_FREQ_FX_HF_",
                     "CLKIN_FRQ_FX_HF_"):
            untranslated += [stem + ix + "Min", stem + ix + "Max"]
    # General Setup validation: output ranges.
    for g in ("DV", "2X"):
        for m in ("LF", "HF"):
            raw_translated += ["CLKOUT_FREQ_%s_%s_Min" % (g, m), "CLKOUT_FREQ_%s_%s_Max" % (g, m)]
    # Clock Frequency Synthesizer and jitter.
    synth = ["CLKOUT_FREQ_FX_LF_Min", "CLKOUT_FREQ_FX_LF_Max", "CLKOUT_FREQ_FX_HF_Min", "CLKOUT_FREQ_FX_HF_Max",
             "CLKIN_FREQ_DLL_LF_Min", "CLKIN_FREQ_DLL_LF_Max", "CLKIN_FREQ_DLL_HF_Min", "CLKIN_FREQ_DLL_HF_Max",
             "CLKIN_FREQ_FX_LF_Min", "CLKIN_FREQ_FX_LF_Max", "CLKIN_FRQ_FX_HF_Min", "CLKIN_FRQ_FX_HF_Max"]
    raw_translated += synth
    untranslated += ["CLKIN_FREQ_FX_LF_MS_Min", "CLKIN_FREQ_FX_HF_MS_Min", "CLKIN_FREQ_DLL_LF_MS_Min",
                     "CLKIN_FREQ_DLL_HF_MS_Min"]
    # Every generic key, and both spellings of the synthesizer keys.
    raw_translated += GENERIC
    untranslated += synth + GENERIC
    untranslated += ["CLKIN_FREQ_FX_HF_Min", "CLKIN_FREQ_FX_HF_Max", "CLKOUT_FRQ_FX_LF_Min", "CLKOUT_FRQ_FX_LF_Max",
                     "CLKOUT_FRQ_FX_HF_Min", "CLKOUT_FRQ_FX_HF_Max"]
    keys = set(untranslated)
    for k in raw_translated:
        for mode in modes:
            keys.add(translate(k, perf, mode))
    if "pll" in caps:
        keys |= {"CLKIN_FREQ_MIN", "CLKIN_FREQ_MAX", "VCOCLK_FREQ_MIN", "VCOCLK_FREQ_MAX", "O_MAX_HT_LT"}
    return keys


def factor_keys():
    keys = set()
    for m in range(1, 65):
        for bw in ("LOW", "HIGH"):
            for k in ("K1", "K2", "K3", "K4", "K5", "K6", "K7", "K12"):
                keys.add("PLL_MULT_%d_BW_%s_%s" % (m, bw, k))
    return keys


def f32(x):
    return struct.unpack("f", struct.pack("f", x))[0]


def pll_jitter(factors, fin, m, d, n, bandwidth, ref_ui):
    """The PLL Output Clock Settings estimate in ns, in single precision."""
    k = {name: f32(factors["PLL_MULT_%d_BW_%s_%s" % (m, bandwidth, name)])
         for name in ("K1", "K2", "K3", "K4", "K5", "K6", "K7", "K12")}
    vco = f32(f32(fin * m) / d)
    a = f32(k["K1"] * f32(vco ** k["K2"]))
    r = f32(f32(ref_ui * 10000) * 0.001)
    b = f32(f32(math.sqrt(d)) * r)
    c = f32(f32(k["K4"] * f32(math.log(vco))) + k["K5"])
    e = f32(f32(400 / vco) ** 0.25)
    f = f32(k["K12"] * e)
    g = f32(c + f32(f32(k["K6"] * e) * f32(math.log(n))))
    h = f32(c * f32(n ** k["K7"]))
    p = f32(b * max(f, min(g, h)))
    q = f32(a * f32(n ** k["K3"]))
    return f32(math.sqrt(f32(f32(p * p) + f32(q * q))))


# --------------------------------------------------------------------------
# Primitive library
# --------------------------------------------------------------------------

HDL_TYPES = {"string", "integer", "real", "hex", "bit"}


def check_value_type(where, type_, value):
    if value == "":
        return
    if type_ == "integer" and not re.fullmatch(r"-?\d+", value):
        fail("%s: '%s' is not an integer" % (where, value))
    if type_ == "real" and not re.fullmatch(r"-?\d+\.\d+", value):
        fail("%s: '%s' is not a decimal number" % (where, value))
    if type_ == "hex" and not re.fullmatch(r"\d+'h[0-9A-F]+", value):
        fail("%s: '%s' is not a sized hex literal" % (where, value))
    if type_ == "bit" and value not in ("0", "1"):
        fail("%s: '%s' is not a bit" % (where, value))


def check_primitives(doc):
    lib = {}
    if not isinstance(doc, dict) or doc.get("format") != 1 or not isinstance(doc.get("primitives"), list):
        fail("primitives.json: expected {\"format\": 1, \"primitives\": [...]}")
        return lib
    for i, p in enumerate(doc["primitives"]):
        where = "primitives.json: primitives[%d]" % i
        if not isinstance(p, dict) or not isinstance(p.get("type"), str):
            fail(where + ": needs a 'type'")
            continue
        t = p["type"]
        where = "primitives.json: %s" % t
        if t in lib:
            fail(where + ": defined twice")
        if "description" in p and not isinstance(p["description"], str):
            fail(where + ": 'description' must be a string")
        pins_, attrs = {}, {}
        for pd in p.get("pins", []):
            if not isinstance(pd, dict) or not isinstance(pd.get("name"), str):
                fail(where + ": a pin needs a name")
                continue
            if pd["name"] in pins_:
                fail(where + ": pin %s defined twice" % pd["name"])
            if pd.get("direction") not in ("IN", "OUT"):
                fail(where + ": pin %s: direction must be IN or OUT" % pd["name"])
            w = pd.get("width", 1)
            if not is_int(w) or not 1 <= w <= 64:
                fail(where + ": pin %s: bad width" % pd["name"])
            if not isinstance(pd.get("active", False), bool):
                fail(where + ": pin %s: 'active' must be true or false" % pd["name"])
            pins_[pd["name"]] = pd
        for ad in p.get("attributes", []):
            if not isinstance(ad, dict) or not isinstance(ad.get("name"), str):
                fail(where + ": an attribute needs a name")
                continue
            n = ad["name"]
            aw = "%s.%s" % (where, n)
            if n in attrs:
                fail(aw + ": defined twice")
            type_ = ad.get("type", "string")
            if type_ not in HDL_TYPES:
                fail(aw + ": unknown type '%s'" % type_)
            if (n.startswith("TESY_ONLY_") or n.startswith("TSY_")) and type_ != "string":
                fail(aw + ": a wizard attribute is a string")
            if (n.startswith("TESY_ONLY_") or n.startswith("TSY_")) and ad.get("hdl", True) is not False:
                fail(aw + ": a wizard attribute never reaches the HDL (\"hdl\": false)")
            default = ad.get("default", "")
            if not isinstance(default, str):
                fail(aw + ": 'default' must be a string")
                default = ""
            values = ad.get("values", [])
            if not is_str_list(values):
                fail(aw + ": 'values' must be a list of strings")
                values = []
            for key in ("active", "template", "hdl"):
                if not isinstance(ad.get(key, True), bool):
                    fail(aw + ": '%s' must be true or false" % key)
            check_value_type(aw + " default", type_, default)
            for v in values:
                check_value_type(aw + " value", type_, v)
            if len(set(values)) != len(values):
                fail(aw + ": repeated values")
            full = list(values)
            if "range" in ad:
                r = ad["range"]
                if not (isinstance(r, list) and len(r) == 2 and all(is_int(x) for x in r) and r[0] <= r[1]):
                    fail(aw + ": 'range' must be [min, max]")
                else:
                    full.append("%d:%d" % (r[0], r[1]))
                    if default and re.fullmatch(r"-?\d+", default) and not r[0] <= int(default) <= r[1]:
                        fail(aw + ": default %s outside range %s" % (default, r))
            if values and default and default not in values:
                fail(aw + ": default '%s' is not among its values" % default)
            attrs[n] = dict(ad, values=full, type=type_, default=default)
        lib[t] = {"pins": pins_, "attrs": attrs}

    for t, required in REQUIRED_PINS.items():
        if t not in lib:
            fail("primitives.json: %s is missing" % t)
            continue
        for name, (direction, width) in required.items():
            pd = lib[t]["pins"].get(name)
            if pd is None:
                fail("primitives.json: %s has no pin %s" % (t, name))
            elif pd.get("direction") != direction or pd.get("width", 1) != width:
                fail("primitives.json: %s.%s should be %s, width %d" % (t, name, direction, width))
    for t, active in TEMPLATE_ACTIVE_PINS.items():
        if t in lib:
            on = {n for n, pd in lib[t]["pins"].items() if pd.get("active")}
            if on != active:
                fail("primitives.json: %s starts with pins %s in use, expected %s" % (t, sorted(on), sorted(active)))
    for t, lists in REQUIRED_LISTS.items():
        for name, (want, exact) in lists.items():
            ad = lib.get(t, {}).get("attrs", {}).get(name)
            if ad is None:
                fail("primitives.json: %s has no attribute %s" % (t, name))
                continue
            have = ad["values"]
            if exact and have[:len(want)] != want:
                fail("primitives.json: %s.%s values start %s, expected %s" % (t, name, have[:len(want)], want))
            if not exact and not set(want) <= set(have):
                fail("primitives.json: %s.%s lacks %s" % (t, name, sorted(set(want) - set(have))))
    for t, wanted in (("DCM", DCM_DEFAULTS), ("DCM_SP", DCM_DEFAULTS), ("DCM_ADV", DCM_DEFAULTS),
                      ("PLL_ADV", PLL_DEFAULTS)):
        for name, value in wanted.items():
            ad = lib.get(t, {}).get("attrs", {}).get(name)
            if ad is None or ad.get("template") is False or ad["default"] != value:
                fail("primitives.json: a new %s should carry %s = \"%s\"" % (t, name, value))
    if lib.get("DCM_ADV", {}).get("attrs", {}).get("DCM_PERFORMANCE_MODE", {}).get("default") != "MAX_SPEED":
        fail("primitives.json: DCM_ADV should start in MAX_SPEED")
    for t in ("DCM", "DCM_SP", "DCM_ADV", "PLL_ADV", "PMCD"):
        for name in MUST_NOT_BE_ON_TEMPLATE:
            ad = lib.get(t, {}).get("attrs", {}).get(name)
            if ad is not None and ad.get("template", True):
                fail("primitives.json: %s.%s must not be on a new block" % (t, name))
    for t, names in MUST_BE_ON_TEMPLATE.items():
        for name in names:
            ad = lib.get(t, {}).get("attrs", {}).get(name)
            if ad is None or not ad.get("template", True):
                fail("primitives.json: a new %s block must carry %s" % (t, name))
    return lib


# --------------------------------------------------------------------------
# Device catalogue
# --------------------------------------------------------------------------

def check_devices(doc, lib):
    families, devices = {}, []
    if not isinstance(doc, dict) or doc.get("format") != 1:
        fail("devices.json: expected {\"format\": 1, ...}")
        return families, devices
    for i, f in enumerate(doc.get("families", [])):
        where = "devices.json: families[%d]" % i
        ok = isinstance(f, dict) and all(isinstance(f.get(k), str) and f.get(k)
                                         for k in ("key", "prefix", "dcm_primitive", "speed_file"))
        if not ok:
            fail(where + ": needs key, prefix, dcm_primitive and speed_file")
            continue
        key = f["key"]
        where = "devices.json: family %s" % key
        if key.lower() in families:
            fail(where + ": defined twice")
        for k in ("templates", "primitives", "capabilities", "speed_grades"):
            if not is_str_list(f.get(k, [])):
                fail(where + ": '%s' must be a list of strings" % k)
                f[k] = []
        f.setdefault("templates", [])
        f.setdefault("primitives", [])
        f.setdefault("capabilities", [])
        f.setdefault("speed_grades", [])
        if not f["speed_grades"]:
            fail(where + ": needs speed grades")
        for t in f["templates"]:
            if t not in f["primitives"]:
                fail(where + ": template %s is not among its primitives" % t)
        for t in f["primitives"]:
            if t not in lib:
                fail(where + ": primitive %s is not in primitives.json" % t)
        if f["dcm_primitive"] not in f["templates"]:
            fail(where + ": its DCM primitive is not a template")
        for c in f["capabilities"]:
            if c not in CAPABILITIES:
                fail(where + ": unknown capability '%s'" % c)
        for g in f["speed_grades"]:
            if not re.fullmatch(r"-\d+", g):
                fail(where + ": speed grade '%s' is not of the form -N" % g)
        families[key.lower()] = f
    if sorted(families) != sorted(FAMILY_KEYS):
        fail("devices.json: families %s, expected %s" % (sorted(families), sorted(FAMILY_KEYS)))
    prefixes = [f["prefix"].lower() for f in families.values()]
    if len(set(prefixes)) != len(prefixes):
        fail("devices.json: family prefixes are not distinct")

    # Family rules.
    for key, f in families.items():
        caps = set(f["capabilities"])
        prims = set(f["primitives"])
        gen45 = key in GEN45
        expect_dcm = "DCM_ADV" if gen45 else "DCM_SP" if key in MEMBRA3E_CLASS else "DCM"
        if f["dcm_primitive"] != expect_dcm:
            fail("devices.json: %s: DCM primitive %s, expected %s" % (key, f["dcm_primitive"], expect_dcm))
        expect_caps = {"dcm"}
        if gen45:
            expect_caps |= {"pmcd", "bufgctrl", "oddr", "performance_modes"}
        if key == "taldor5":
            expect_caps |= {"pll", "bufgmux_ctrl"}
        if caps != expect_caps:
            fail("devices.json: %s: capabilities %s, expected %s" % (key, sorted(caps), sorted(expect_caps)))
        expect_templates = [expect_dcm] + (["PLL_ADV"] if "pll" in caps else []) + (["PMCD"] if "pmcd" in caps else [])
        if sorted(f["templates"]) != sorted(expect_templates):
            fail("devices.json: %s: templates %s, expected %s" % (key, f["templates"], expect_templates))
        for cap, prim in (("bufgctrl", "BUFGCTRL"), ("bufgmux_ctrl", "BUFGMUX_CTRL"), ("oddr", "ODDR"),
                          ("pmcd", "PMCD"), ("pll", "PLL_ADV")):
            if (cap in caps) != (prim in prims):
                fail("devices.json: %s: has %s exactly when it has capability %s" % (key, prim, cap))
        # Everything design generation may place.
        needed = {"BUFG", "BUFGCE", "BUFGMUX", "IBUFG", "IBUFGDS", "OBUF", "INV", "OR2", "OR3", "FD", "FDS"}
        needed |= {"ODDR"} if gen45 else {"OFDDRCPE", "OFDDRRSE", "OFDDRTCPE", "OFDDRTRSE"}
        needed |= {"BUFGMUX_TALDOR4"} if gen45 and key != "taldor5" else set()
        needed |= {"SRL16", "PLL_BASE"} if "pll" in caps else set()
        if not needed <= prims:
            fail("devices.json: %s lacks primitives %s" % (key, sorted(needed - prims)))

    by_name = {}
    for i, d in enumerate(doc.get("devices", [])):
        where = "devices.json: devices[%d]" % i
        if not isinstance(d, dict) or not isinstance(d.get("name"), str) or not isinstance(d.get("family"), str):
            fail(where + ": needs a name and a family")
            continue
        name, fam = d["name"], d["family"].lower()
        where = "devices.json: device %s" % name
        if fam not in families:
            fail(where + ": unknown family %s" % fam)
            continue
        f = families[fam]
        if not name.lower().startswith(f["prefix"].lower()):
            fail(where + ": does not begin with the prefix %s" % f["prefix"])
        longest = max((g for g in families.values() if name.lower().startswith(g["prefix"].lower())),
                      key=lambda g: len(g["prefix"]))
        if longest is not f:
            fail(where + ": its name begins with the longer prefix of %s" % longest["key"])
        if name.lower() in by_name:
            fail(where + ": defined twice")
        if "-" in name:
            fail(where + ": a device name holds no '-'")
        for k in ("speed_grades", "traits"):
            if not is_str_list(d.get(k, [])):
                fail(where + ": '%s' must be a list of strings" % k)
        grades = d.get("speed_grades") or f["speed_grades"]
        if not set(grades) <= set(f["speed_grades"]):
            fail(where + ": speed grades %s are not all of its family" % grades)
        d = dict(d, grades=grades, family=fam)
        by_name[name.lower()] = d
        devices.append(d)

    # A device name followed by one of its grades finds that very device.
    for d in devices:
        for g in [""] + d["grades"]:
            part = (d["name"] + g).lower()
            found = None
            for e in devices:
                if part.startswith(e["name"].lower()):
                    rest = part[len(e["name"]):]
                    if rest == "" or rest in [x.lower() for x in e["grades"]]:
                        found = e
                        break
            if found is not d:
                fail("devices.json: part %s resolves to %s" % (part, found and found["name"]))

    per_family = {}
    for d in devices:
        per_family.setdefault(d["family"], []).append(d)
    for key in families:
        if len(per_family.get(key, [])) < 2:
            fail("devices.json: %s needs a few devices" % key)
    t5 = [d["name"][len(families["taldor5"]["prefix"]):].lower() for d in per_family.get("taldor5", [])] \
        if "taldor5" in families else []
    for n in TALDOR5_LISTED:
        if n not in t5:
            fail("devices.json: taldor5 lacks the device size %s" % n)
    if len([n for n in t5 if n not in TALDOR5_LISTED]) < 2:
        fail("devices.json: taldor5 needs two or more devices beyond the listed ten")
    narrow = [d for d in per_family.get("membra3e", []) if "narrow_first_stepping" in d.get("traits", [])]
    if len(narrow) != 5:
        fail("devices.json: membra3e has %d devices with narrow_first_stepping, expected 5" % len(narrow))
    if len(per_family.get("membra3e", [])) - len(narrow) < 1:
        fail("devices.json: membra3e needs devices without narrow_first_stepping")
    for d in devices:
        if d.get("traits") and d["family"] != "membra3e":
            fail("devices.json: device %s: traits are for membra3e devices only" % d["name"])
    return families, devices


# --------------------------------------------------------------------------
# Speed files
# --------------------------------------------------------------------------

def load_speed(data_dir, rel, cache):
    if rel in cache:
        return cache[rel]
    doc = load_json(data_dir, rel)
    result = None
    if doc is not None:
        ok = isinstance(doc, dict) and doc.get("format") == 1
        for sec in ("common", "factors"):
            v = doc.get(sec, {})
            if not isinstance(v, dict) or not all(is_number(x) for x in v.values()):
                ok = False
        grades = doc.get("grades", {})
        if not isinstance(grades, dict) or not all(
                isinstance(g, dict) and all(is_number(x) for x in g.values()) for g in grades.values()):
            ok = False
        if not ok:
            fail("%s: expected format 1 with numeric common, grades and factors" % rel)
        else:
            result = doc
    cache[rel] = result
    return result


def figures(doc, grade):
    out = dict(doc.get("common", {}))
    out.update(doc["grades"].get(grade, {}))
    return out


def ranges_of(figs):
    """(stem, min, max) for every pair of keys that differ only in Min/Max."""
    out = []
    for k, lo in figs.items():
        for a, b in (("_Min", "_Max"), ("_MIN", "_MAX")):
            if k.endswith(a) and k[:-len(a)] + b in figs:
                out.append((k[:-len(a)], lo, figs[k[:-len(a)] + b]))
    return out


def inside(f, lo, hi):
    return lo <= f <= hi


def check_speed(data_dir, families, devices, lib):
    cache = {}
    overlap_families = []
    jitter_summary = None
    for key, f in sorted(families.items()):
        doc = load_speed(data_dir, f["speed_file"], cache)
        if doc is None:
            continue
        caps = set(f["capabilities"])
        perf = "performance_modes" in caps
        needed = queried_keys(key, caps)
        grades = set(f["speed_grades"])
        for d in devices:
            if d["family"] == key:
                grades |= set(d["grades"])
        order = [g for g in f["speed_grades"]]
        for g in sorted(grades):
            if g not in doc["grades"]:
                fail("%s: no figures for grade %s of %s" % (f["speed_file"], g, key))
                continue
            figs = figures(doc, g)
            where = "%s grade %s (%s)" % (f["speed_file"], g, key)
            missing = sorted(needed - set(figs))
            if missing:
                fail("%s: missing keys %s" % (where, missing))
                continue
            for stem, lo, hi in ranges_of(figs):
                if lo > hi:
                    fail("%s: %s range %s > %s" % (where, stem, lo, hi))
            sfx = "_MS" if perf else ""
            dll_lf = (figs["CLKIN_FREQ_DLL_LF%s_Min" % sfx], figs["CLKIN_FREQ_DLL_LF%s_Max" % sfx])
            dll_hf = (figs["CLKIN_FREQ_DLL_HF%s_Min" % sfx], figs["CLKIN_FREQ_DLL_HF%s_Max" % sfx])
            if key in MEMBRA3E_CLASS:
                for stem, lo, hi in ranges_of(figs):
                    if "_HF" in stem and (lo, hi) != (0, 0):
                        fail("%s: %s should be 0 - 0 (one frequency mode)" % (where, stem))
            # Low and high ranges of one kind overlap where both exist.
            for stem, lo, hi in ranges_of(figs):
                if "_LF" in stem:
                    other = stem.replace("_LF", "_HF")
                    hlo, hhi = figs.get(other + "_Min"), figs.get(other + "_Max")
                    if hhi and hi and max(lo, hlo) > min(hi, hhi):
                        fail("%s: %s and %s do not overlap" % (where, stem, other))
            if dll_hf[1] and max(dll_lf[0], dll_hf[0]) <= min(dll_lf[1], dll_hf[1]):
                overlap_families.append("%s%s" % (key, g))
            # The design a new block starts with.
            check_default_design(where, key, f, lib, figs, perf, dll_lf, dll_hf)
        # Faster grades never lower a maximum.
        for slow, fast in zip(order, order[1:]):
            if slow in doc["grades"] and fast in doc["grades"]:
                a, b = figures(doc, slow), figures(doc, fast)
                for k in a:
                    if k.upper().endswith("MAX") and b.get(k, a[k]) < a[k]:
                        fail("%s: %s falls from grade %s to %s" % (f["speed_file"], k, slow, fast))
        if "pll" in caps:
            factors = doc.get("factors", {})
            missing = sorted(factor_keys() - set(factors))
            if missing:
                fail("%s: missing factors, e.g. %s" % (f["speed_file"], missing[:4]))
            else:
                jitter_summary = check_jitter(f["speed_file"], factors)
    if not overlap_families:
        fail("speed files: no family has overlapping low and high DLL input ranges")
    return overlap_families, jitter_summary


def attr_default(lib, prim, name):
    ad = lib.get(prim, {}).get("attrs", {}).get(name)
    return ad["default"] if ad else ""


def check_default_design(where, key, family, lib, figs, perf, dll_lf, dll_hf):
    dcm = family["dcm_primitive"]
    try:
        fin = float(attr_default(lib, dcm, "TESY_ONLY_CLKIN_VALUE"))
        period = attr_default(lib, dcm, "CLKIN_PERIOD")
        fout = float(attr_default(lib, dcm, "FOUT_VALUE"))
        m = int(attr_default(lib, dcm, "CLKFX_MULTIPLY"))
        d = int(attr_default(lib, dcm, "CLKFX_DIVIDE"))
        dv = float(attr_default(lib, dcm, "CLKDV_DIVIDE"))
    except ValueError:
        fail("primitives.json: %s lacks numeric defaults for its input, output and synthesizer" % dcm)
        return
    if period != "%3.3f" % (1000 / fin):
        fail("primitives.json: %s: CLKIN_PERIOD %s does not match an input of %g MHz" % (dcm, period, fin))
    if not (inside(fin, *dll_lf) or inside(fin, *dll_hf)):
        fail("%s: the default input of %g MHz lies in no DLL range" % (where, fin))
    if attr_default(lib, dcm, "M_VALUE") != str(m) or attr_default(lib, dcm, "D_VALUE") != str(d) \
            or abs(fin * m / d - fout) > 1e-9:
        fail("primitives.json: %s: M, D and FOUT defaults disagree" % dcm)
    fx_keys = [translate(k, perf, 0) for k in ("CLKOUT_FREQ_FX_LF_Min", "CLKOUT_FREQ_FX_LF_Max",
                                               "CLKOUT_FREQ_FX_HF_Min", "CLKOUT_FREQ_FX_HF_Max")]
    fx = [figs[k] for k in fx_keys]
    if not (inside(fout, fx[0], fx[1]) or inside(fout, fx[2], fx[3])):
        fail("%s: the default synthesizer output of %g MHz lies in no range" % (where, fout))
    if not inside(fout, fx[0], fx[1]) and attr_default(lib, dcm, "TESY_ONLY_VALID_DFS_MODE") == "LOW":
        fail("%s: the default synthesizer output is not in the low range its mode says" % where)
    fxin = [figs[translate(k, perf, 0)] for k in ("CLKIN_FREQ_FX_LF_Min", "CLKIN_FREQ_FX_LF_Max")]
    if not inside(fin, *fxin):
        fail("%s: the default input of %g MHz is outside the low synthesizer input range" % (where, fin))
    # The second DCM of a cascade runs in low-frequency mode from the default cascading clock.
    if attr_default(lib, dcm, "TESY_ONLY_CASCADING_CLK") == "CLKDV" and not inside(fin / dv, *dll_lf):
        fail("%s: a default cascade (%g MHz / %g) leaves the low DLL range" % (where, fin, dv))
    if "pll" in family["capabilities"]:
        try:
            f1 = float(attr_default(lib, "PLL_ADV", "TESY_ONLY_CLKIN1_VALUE"))
            mult = int(attr_default(lib, "PLL_ADV", "CLKFBOUT_MULT"))
            div = int(attr_default(lib, "PLL_ADV", "DIVCLK_DIVIDE"))
            out0 = int(attr_default(lib, "PLL_ADV", "CLKOUT0_DIVIDE"))
        except ValueError:
            fail("primitives.json: PLL_ADV lacks numeric defaults")
            return
        if not inside(f1, figs["CLKIN_FREQ_MIN"], figs["CLKIN_FREQ_MAX"]):
            fail("%s: the default PLL input of %g MHz is out of range" % (where, f1))
        vco = f1 * mult / div
        if not inside(vco, figs["VCOCLK_FREQ_MIN"], figs["VCOCLK_FREQ_MAX"]):
            fail("%s: the default PLL VCO of %g MHz is out of range" % (where, vco))
        # 450 MHz is the lowest output limit the output settings page applies.
        if not inside(vco / out0, 3.125, 450):
            fail("%s: the default CLKOUT0 of %g MHz is out of the output range" % (where, vco / out0))
        if figs["O_MAX_HT_LT"] != 63:
            fail("%s: O_MAX_HT_LT should be 63" % where)


def check_jitter(rel, factors):
    """Reference jitter 0.1 UI, D = 1, VCO 600 - 900 MHz, dividers 2 - 32."""
    lo, hi = float("inf"), 0.0
    for vco in (600, 700, 800, 900):
        for n in range(2, 33):
            for bw in ("LOW", "HIGH"):
                prev = None
                for m in range(1, 65):
                    j = pll_jitter(factors, vco / m, m, 1, n, bw, 0.1)
                    lo, hi = min(lo, j), max(hi, j)
                    if not 0.09 <= j <= 0.40:
                        fail("%s: jitter %.3f ns at VCO %d, M %d, N %d, %s" % (rel, j, vco, m, n, bw))
                    if prev is not None and abs(j - prev) > 0.05 * prev:
                        fail("%s: jitter jumps from %.3f to %.3f ns between M %d and %d" % (rel, prev, j, m - 1, m))
                    prev = j
            for m in range(1, 65):
                low = pll_jitter(factors, vco / m, m, 1, n, "LOW", 0.1)
                high = pll_jitter(factors, vco / m, m, 1, n, "HIGH", 0.1)
                if not low < high:
                    fail("%s: LOW bandwidth is not below HIGH at VCO %d, M %d, N %d" % (rel, vco, m, n))
    # More reference jitter never gives less output jitter.
    if not pll_jitter(factors, 100, 8, 1, 8, "HIGH", 0.2) > pll_jitter(factors, 100, 8, 1, 8, "HIGH", 0.1):
        fail("%s: the estimate does not grow with the reference jitter" % rel)
    return lo, hi


# --------------------------------------------------------------------------
# Wizard manifest
# --------------------------------------------------------------------------

def check_wizards(doc, families):
    if not isinstance(doc, dict) or doc.get("format") != 1 or not isinstance(doc.get("plugin"), str):
        fail("wizards.json: expected {\"format\": 1, \"plugin\": ..., \"wizards\": [...]}")
        return
    wz = doc.get("wizards", [])
    keys = [w.get("key") for w in wz if isinstance(w, dict)]
    if keys != WIZARD_KEYS:
        fail("wizards.json: keys %s, expected %s" % (keys, WIZARD_KEYS))
    for w in wz:
        if not isinstance(w, dict):
            continue
        k = w.get("key")
        req = w.get("requires", [])
        if not isinstance(w.get("description", ""), str) or not w.get("description"):
            fail("wizards.json: %s needs a one-line description" % k)
        if not is_str_list(req) or not set(req) <= CAPABILITIES:
            fail("wizards.json: %s: unknown requirements %s" % (k, req))
            continue
        uses_pll = k in ("dcm_pll", "dcm_dcm2pll", "dcm_pll2dcm")
        uses_dcm = k != "dcm_pll"
        if ("pll" in req) != uses_pll or ("dcm" in req) != uses_dcm or "pmcd" in req:
            fail("wizards.json: %s requires %s" % (k, req))
        if not any(set(req) <= set(f["capabilities"]) for f in families.values()):
            fail("wizards.json: no family can run %s" % k)


def main(argv):
    data_dir = os.path.abspath(argv[0]) if argv else os.path.dirname(TOOLS_DIR)
    prim_doc = load_json(data_dir, "primitives.json")
    dev_doc = load_json(data_dir, "devices.json")
    wiz_doc = load_json(data_dir, "wizards.json")
    lib = check_primitives(prim_doc) if prim_doc is not None else {}
    families, devices = check_devices(dev_doc, lib) if dev_doc is not None else ({}, [])
    overlap, jitter = check_speed(data_dir, families, devices, lib)
    if wiz_doc is not None:
        check_wizards(wiz_doc, families)
    if not argv:
        gen = subprocess.run([sys.executable, os.path.join(TOOLS_DIR, "gen_data.py"), "--check"],
                             capture_output=True, text=True)
        if gen.returncode != 0:
            fail("generated files are out of date; run data/tools/gen_data.py:\n" + gen.stdout.strip())
    if problems:
        for p in problems:
            print(p)
        print("%d problem(s)" % len(problems))
        return 1
    print("data is consistent: %d primitives, %d families, %d devices" % (len(lib), len(families), len(devices)))
    print("families with overlapping DLL ranges: %s" % ", ".join(overlap))
    if jitter:
        print("PLL jitter over VCO 600-900 MHz, M 1-64, N 2-32: %.3f - %.3f ns" % jitter)
    return 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
