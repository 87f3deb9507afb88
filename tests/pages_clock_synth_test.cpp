// The Clock Frequency Synthesizer page on a real design database: the input
// clock and General Setup's choices read from the DCM block, M and D derived
// from an output frequency or the output from M and D, every refusal with its
// message, the fit against the allowed synthesizer mode, the cascading limit,
// and what Next leaves on the block in both jitter models. Then the same
// through whole batch runs of pendra.

#include "pages/dcm/Tsy_JitterDlg.h"
#include "support/BatchRun.h"
#include "wizard/Tsy_Vocabulary.h"

#include <gtest/gtest.h>

#include <cmath>
#include <functional>

namespace {

// The page of one DCM instance, with the DCM block set up the way General
// Setup leaves it: 100 MHz in, both output groups, either synthesizer mode.
class SynthPage {
public:
    SynthPage(const char* part, bool batch = false, const char* keyword = "dcm", int inst = 1,
              const std::function<void(Tsy_WizContext&)>& context = {})
        : d(keyword, part, batch)
    {
        d.MarkLoaded();
        if (context)
            d.Configure(context);
        d.Instantiate();
        page = FindPage<Tsy_JitterDlg>(d.Wizard(), inst);
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        EXPECT_TRUE(page && dcm);
        Input("100").General("DLL_AND_FX", "BOTH");
    }

    SynthPage& Input(const char* value, const char* units = "MHZ", bool divideBy2 = false)
    {
        Set(Tsy_Attr::FIN_UNITS, units).Set(Tsy_Attr::CLKIN_DIVIDE_BY_2, divideBy2 ? "TRUE" : "FALSE");
        double v = std::atof(value), atDcm = divideBy2 ? 2.0 : 1.0;
        double period = StringBase(units) == "NS" ? v * atDcm : v > 0 ? 1000.0 * atDcm / v : 0.0;
        Set(Tsy_Attr::CLKIN_PERIOD, StringBase::Printf("%3.3f", period).c_str());
        return Set(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, value);
    }
    SynthPage& General(const char* outputs, const char* dfsMode)
    {
        return Set(Tsy_Attr::TSY_CLK_OUTPUT_TYPE, outputs).Set(Tsy_Attr::TESY_ONLY_VALID_DFS_MODE, dfsMode);
    }
    SynthPage& ByOutput(const char* fout, const char* units = "MHZ")
    {
        return Set(Tsy_Attr::JITTER_INPUT_TYPE, "FOUT_STR").Set(Tsy_Attr::FOUT_UNITS, units).Set(Tsy_Attr::FOUT_VALUE, fout);
    }
    SynthPage& ByMAndD(const char* m, const char* dv)
    {
        return Set(Tsy_Attr::JITTER_INPUT_TYPE, "M_AND_D_STR").Set(Tsy_Attr::M_VALUE, m).Set(Tsy_Attr::D_VALUE, dv);
    }
    SynthPage& Set(const char* attr, const char* value)
    {
        dcm->SetAttributeValue(attr, value);
        return *this;
    }
    std::string Get(const char* attr) const { return dcm->GetAttributeValue(attr).str(); }

    // The user enters the page and presses Next.
    bool EnterAndNext()
    {
        page->LoadFromBlock();
        d.Stream().Clear();
        return page->StoreToBlock(true);
    }
    std::vector<StringBase> Errors() { return d.Stream().Errors(); }
    std::string OnlyError()
    {
        auto e = Errors();
        return e.size() == 1 ? e[0].str() : "(" + std::to_string(e.size()) + " errors)";
    }

    TestDesign d;
    Tsy_JitterDlg* page = nullptr;
    Tsy_Block* dcm = nullptr;
};

const std::string kNotInRange =
    "The output frequency is not within the valid range.  Please enter a new value for the output frequency.";

std::string derived(char which, int v)
{
    return StringBase::Printf("The specified output frequency generates the value %c = %d.  This value is not within "
                              "the valid range %s - 32.  Please enter a new output frequency or specify M and D values.",
                              which, v, which == 'M' ? "2" : "1")
        .str();
}

std::string typedRange(char which)
{
    return which == 'M' ? "The Multiply (M) value must be within the range 2 - 32.  Please choose a new value."
                        : "The Divide (D) value must be within the range 1 - 32.  Please choose a new value.";
}

} // namespace

TEST(ClockSynthPage, DerivesMAndDFromTheOutputFrequency)
{
    struct Case {
        const char *fin, *fout, *units; // units of the output
        int m, d;                       // 0: refused with the error
        const char *shown, *kept;       // generated output in the output's units; FOUT_VALUE after Next
        std::string error;
    } cases[] = {
        {"50", "100", "MHZ", 2, 1, "100", "100", ""},
        {"50", "50", "MHZ", 2, 2, "50", "50", ""},       // 1/1 doubles
        {"100", "150", "MHZ", 3, 2, "150", "150", ""},   // reduced
        {"10", "25", "MHZ", 25, 10, "25", "25", ""},     // inside the M and D ranges: as they are
        {"10.5", "25", "MHZ", 25, 10, "26.25", "25", ""}, // whole numbers, and the output they give
        {"400", "25", "MHZ", 2, 32, "25", "25", ""},     // 1/16 doubles to the edge of D
        {"50.7", "50.2", "MHZ", 2, 2, "50.7", "50.7", ""}, // doubled M: the field shows what the DCM makes
        {"50.7", "19.92", "NS", 2, 2, "19.7239", "19.7239", ""},
        {"50", "10", "NS", 2, 1, "10", "10", ""},
        {"100", "33.3", "MHZ", 0, 0, "", "", derived('M', 33)}, // 33/100 has no common divisor
        {"33.33", "200", "MHZ", 0, 0, "", "", derived('M', 200)},
        {"1000", "25", "MHZ", 0, 0, "", "", derived('D', 80)}, // 1/40 doubles past 32
        {"100", "500", "MHZ", 0, 0, "", "", kNotInRange},
        {"100", "23.9", "MHZ", 0, 0, "", "", kNotInRange},
        {"100", "abc", "MHZ", 0, 0, "", "", kNotInRange},
        {"0.5", "30", "MHZ", 0, 0, "", "", kNotInRange}, // no whole-number input to reduce against
        {"", "100", "MHZ", 0, 0, "", "", kNotInRange},
    };
    for (const auto& c : cases) {
        SynthPage p("t2a250-4");
        p.Input(c.fin).ByOutput(c.fout, c.units);
        bool ok = p.EnterAndNext();
        SCOPED_TRACE(std::string("fin ") + c.fin + ", fout " + c.fout + " " + c.units);
        if (c.m == 0) {
            EXPECT_FALSE(ok);
            EXPECT_EQ(p.OnlyError(), c.error);
            EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), "2") << "the template's value stays";
            continue;
        }
        ASSERT_TRUE(ok) << p.OnlyError();
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), std::to_string(c.m));
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_DIVIDE), std::to_string(c.d));
        EXPECT_EQ(p.page->GetOutputText(), c.shown);
        EXPECT_EQ(p.Get(Tsy_Attr::FOUT_VALUE), c.kept);
        EXPECT_EQ(p.Get(Tsy_Attr::FOUT_UNITS), c.units);
    }
}

TEST(ClockSynthPage, DerivesTheOutputFromMAndD)
{
    struct Case {
        const char *fin, *finUnits, *m, *d;
        int rm, rd;                        // CLKFX values; 0: refused
        const char *shown, *mText, *dText; // generated output; the entries as the page shows them
        std::string error;
    } cases[] = {
        {"100", "MHZ", "1", "3", 2, 6, "33.3333", "2", "6", ""}, // M = 1 doubles
        {"50", "MHZ", "4", "2", 2, 1, "100", "4", "2", ""},      // reduced for CLKFX, entries kept
        {"50", "MHZ", "3.7", " 1", 3, 1, "150", "3", "1", ""},   // whole numbers, as CLKFX takes them
        {"20", "NS", "3", "1", 3, 1, "6.66667", "3", "1", ""},   // shown in the input's units
        {"100", "MHZ", "33", "1", 0, 0, "", "33", "1", typedRange('M')},
        {"100", "MHZ", "x", "1", 0, 0, "", "0", "1", typedRange('M')},
        {"100", "MHZ", "4", "33", 0, 0, "", "4", "33", typedRange('D')},
        {"100", "MHZ", "1", "17", 0, 0, "", "2", "34", typedRange('D')},
        {"100", "MHZ", "2", "9", 0, 0, "", "2", "9",
         "The specified M and D values generate the output frequency 22.222 MHz which is not within the valid output "
         "frequency range.  Please enter new M and D values or specify a new output frequency."},
        {"10", "NS", "30", "1", 0, 0, "", "30", "1",
         "The specified M and D values generate the output frequency 0.333 ns which is not within the valid output "
         "frequency range.  Please enter new M and D values or specify a new output frequency."},
    };
    for (const auto& c : cases) {
        SynthPage p("t2a250-4");
        p.Input(c.fin, c.finUnits).ByMAndD(c.m, c.d);
        // Entering the page calculates and says what is wrong.
        p.page->LoadFromBlock();
        SCOPED_TRACE(std::string("M ") + c.m + ", D " + c.d);
        EXPECT_EQ(p.page->GetMText(), c.mText);
        EXPECT_EQ(p.page->GetDText(), c.dText);
        if (c.rm == 0) {
            EXPECT_EQ(p.OnlyError(), c.error);
            EXPECT_FALSE(p.page->HasResult());
            EXPECT_FALSE(p.page->StoreToBlock(true));
            continue;
        }
        EXPECT_TRUE(p.Errors().empty()) << p.OnlyError();
        EXPECT_EQ(p.page->GetOutputText(), c.shown);
        ASSERT_TRUE(p.page->StoreToBlock(true)) << p.OnlyError();
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), std::to_string(c.rm));
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_DIVIDE), std::to_string(c.rd));
        EXPECT_EQ(p.Get(Tsy_Attr::M_VALUE), c.mText);
        EXPECT_EQ(p.Get(Tsy_Attr::D_VALUE), c.dText);
        EXPECT_EQ(p.Get(Tsy_Attr::JITTER_INPUT_TYPE), "M_AND_D_STR");
    }
}

TEST(ClockSynthPage, ADcmWithoutSynthesizerOutputsIsNotHeldUpByTheSynthesizer)
{
    // 33.33 MHz in and the untouched 200 MHz out give M = 200: a refusal only
    // where CLKFX or CLKFX180 is in use.
    struct Case {
        const char *outputs, *fin;
        bool passes;
        const char* m; // CLKFX_MULTIPLY after Next
    } cases[] = {{"DLL", "33.33", true, "2"},       {"", "33.33", true, "2"}, {"FX", "33.33", false, "2"},
                 {"DLL_AND_FX", "33.33", false, "2"}, {"DLL", "50", true, "4"}};
    for (const auto& c : cases) {
        SynthPage p("t2a250-4");
        p.Input(c.fin).General(c.outputs, "BOTH").ByOutput("200");
        p.page->LoadFromBlock();
        SCOPED_TRACE(std::string(c.outputs) + " at " + c.fin);
        EXPECT_EQ(p.Errors().size(), c.passes ? 0u : 1u) << "entering the page";
        EXPECT_EQ(p.EnterAndNext(), c.passes);
        EXPECT_EQ(p.Errors().size(), c.passes ? 0u : 1u) << p.OnlyError();
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), c.m);
    }
}

TEST(ClockSynthPage, TheInputClockCountsInItsUnitsAndAfterDividingByTwo)
{
    struct Case {
        const char *value, *units; // value empty: only CLKIN_PERIOD is known
        bool divideBy2;
        const char *m, *d, *line;
    } cases[] = {
        {"100", "MHZ", false, "3", "2", "Input Clock Frequency: 100 MHz"},
        {"100", "MHZ", true, "3", "1", "Input Clock Frequency: 100 MHz => divided by 2 = 50.000 MHz"},
        {"20", "NS", false, "3", "1", "Input Clock Frequency: 20 ns"},
        {"10", "NS", true, "3", "1", "Input Clock Frequency: 10.000 ==> multiplied by 2 = 20.000 ns"},
        {"", "MHZ", false, "3", "1", "Input Clock Frequency: 50.000 MHz"},
    };
    for (const auto& c : cases) {
        SynthPage p("t2a250-4");
        p.Input(*c.value ? c.value : "50", c.units, c.divideBy2).ByOutput("150");
        if (!*c.value)
            p.dcm->RemoveAttribute(Tsy_Attr::TESY_ONLY_CLKIN_VALUE);
        EXPECT_TRUE(p.EnterAndNext()) << c.line << ": " << p.OnlyError();
        EXPECT_EQ(p.page->GetInputClockLine(), c.line);
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), c.m) << c.line;
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_DIVIDE), c.d) << c.line;
    }
}

TEST(ClockSynthPage, TheOutputMustFitTheModeGeneralSetupAllowed)
{
    const char* mode[] = {"Low", "High"};
    auto byOutput = [&](int high) {
        return StringBase::Printf("The specified input clock frequency is in %s Frequency mode. So your output "
                                  "frequency must also be in the %s Frequency range.  Either change your input or "
                                  "output clock frequency to correct this.",
                                  mode[high], mode[high])
            .str();
    };
    auto byMAndD = [&](int high) {
        return StringBase::Printf("The specified input clock frequency, which is in %s Frequency mode, restricts your "
                                  "output frequency to %s frequency range.  Either change your input clock frequency "
                                  "or your M/D value to correct this.",
                                  mode[high], high ? "HIGH" : "LOW")
            .str();
    };
    struct Case {
        const char *outputs, *allowed;
        bool mAndD;
        const char* value;  // fout, or M with D = 1, at 100 MHz in
        std::string error;  // empty: passes
        const char* stored; // DFS_FREQUENCY_MODE
    } cases[] = {
        {"FX", "LOW", false, "300", byOutput(0), ""},      {"DLL_AND_FX", "LOW", true, "3", byMAndD(0), ""},
        {"FX", "HIGH", false, "100", byOutput(1), ""},     {"DLL_AND_FX", "HIGH", true, "2", byMAndD(1), ""},
        {"FX", "LOW", false, "100", "", "LOW"},            {"FX", "HIGH", false, "300", "", "HIGH"},
        {"FX", "BOTH", false, "100", "", "LOW"},           {"FX", "BOTH", false, "300", "", "HIGH"},
        {"FX", "BOTH", false, "210", "", "LOW"}, // in both ranges: low, as the input runs
        {"FX", "HIGH", false, "210", "", "HIGH"},
        {"DLL", "LOW", false, "300", "", "LOW"}, // no synthesizer output: nothing to fit
    };
    for (const auto& c : cases) {
        SynthPage p("t2a250-4");
        p.General(c.outputs, c.allowed).Set(Tsy_Attr::DFS_FREQUENCY_MODE, "");
        if (c.mAndD)
            p.ByMAndD(c.value, "1");
        else
            p.ByOutput(c.value);
        bool ok = p.EnterAndNext();
        SCOPED_TRACE(std::string(c.outputs) + " " + c.allowed + " " + c.value);
        EXPECT_EQ(ok, c.error.empty());
        EXPECT_EQ(p.OnlyError(), c.error.empty() ? "(0 errors)" : c.error);
        EXPECT_EQ(p.Get(Tsy_Attr::DFS_FREQUENCY_MODE), c.stored);
        EXPECT_TRUE(p.page->HasResult()) << "the derived output is shown either way";
    }
}

TEST(ClockSynthPage, StoresTheJitterOfTheModelInForce)
{
    const double a = 232.8 - 0.7 * 30, bn = 25423 * std::pow(30.0, -0.7674);
    const double maxRange = (a + 2 * (bn - a) / 31) * 0.001; // taldor5, fin 30, D = 3
    struct Case {
        const char* part;
        bool noiseFree;
        const char *fin, *fout, *perf;
        double ui, ns; // worked out by hand
    } cases[] = {
        // taldor2, low: J = 6*4/32 + 36*14/216 + 2 = 5.0833 %, T = 16.667 ns.
        {"t2a250-4", false, "10", "60", "", 0.050833, 0.847222},
        // taldor2, high, 3/1: J = 3/8 + 90*7/110 + 0.04*100 + 10 = 20.1023 %.
        {"t2a250-4", false, "100", "300", "", 0.201023, 0.670076},
        // noise-free, D = 1: A = 0.8891 - 0.145 = 0.7441 ns over a 16.667 ns period.
        {"t2a250-4", true, "10", "60", "", 0.044646, 0.7441},
        // taldor5 high, 3/1: (156 - 10) ps over 3.333 ns.
        {"t5da1-1", true, "100", "300", "MAX_SPEED", 0.0438, 0.146},
        // taldor5 low, maximum range: 40/30 = 4/3.
        {"t5da1-1", true, "30", "40", "MAX_RANGE", maxRange / 25.0, maxRange},
        // taldor4: 100/20 = 5/1, A = 0.8891 - 0.29 = 0.5991 ns.
        {"t4a25-10", true, "20", "100", "MAX_SPEED", 0.05991, 0.5991},
    };
    for (const auto& c : cases) {
        SynthPage p(c.part, false, "dcm", 1, [&](Tsy_WizContext& ctx) { ctx.bufgctrlFamily = c.noiseFree; });
        p.Input(c.fin).ByOutput(c.fout).Set(Tsy_Attr::DCM_PERFORMANCE_MODE, c.perf);
        p.Set(Tsy_Attr::TESY_ONLY_JITTER_UI_NONOISE, "stale").Set(Tsy_Attr::JITTER_VALUE, "stale");
        SCOPED_TRACE(std::string(c.part) + " " + c.fin + " -> " + c.fout);
        ASSERT_TRUE(p.EnterAndNext()) << p.OnlyError();
        const char* format = c.noiseFree ? "%3.3f" : "%3.2f";
        std::string ui = StringBase::Printf(format, c.ui).str(), ns = StringBase::Printf(format, c.ns).str();
        EXPECT_EQ(p.page->GetJitterUiText(), ui);
        EXPECT_EQ(p.page->GetJitterPk2PkText(), ns);
        if (c.noiseFree) {
            EXPECT_EQ(p.Get(Tsy_Attr::TESY_ONLY_JITTER_UI_NONOISE), ui);
            EXPECT_EQ(p.Get(Tsy_Attr::TESY_ONLY_JITTER_PK2PK_NONOISE), ns);
        } else {
            EXPECT_EQ(p.Get(Tsy_Attr::JITTER_VALUE), ui);
            EXPECT_EQ(p.Get(Tsy_Attr::JITTER_PK2PK), ns);
        }
        // Figures of the other model do not stay behind.
        const char* other = c.noiseFree ? Tsy_Attr::JITTER_VALUE : Tsy_Attr::TESY_ONLY_JITTER_UI_NONOISE;
        EXPECT_EQ(p.dcm->GetNamedAttribute(other), nullptr);
    }
}

TEST(ClockSynthPage, EntriesEmptyOutputsAndBack)
{
    // Entries out of range stop Next where they are the input; M and D typed
    // for the other input are kept as they are.
    const char* stored = "%c value must be within the allowable range %d - 32.  Please set this value accordingly "
                         "before continuing.";
    for (auto [mAndD, m, d, error] : {std::tuple{true, "40", "1", StringBase::Printf(stored, 'M', 2)},
                                      std::tuple{true, "", "1", StringBase::Printf(stored, 'M', 2)},
                                      std::tuple{true, "2", "0", StringBase::Printf(stored, 'D', 1)},
                                      std::tuple{false, "40", "0", StringBase()}}) {
        SynthPage p("t2a250-4");
        p.ByOutput("150").Set(Tsy_Attr::M_VALUE, m).Set(Tsy_Attr::D_VALUE, d);
        if (mAndD)
            p.Set(Tsy_Attr::JITTER_INPUT_TYPE, "M_AND_D_STR");
        EXPECT_EQ(p.EnterAndNext(), error.IsEmpty()) << m << "/" << d;
        EXPECT_EQ(p.OnlyError(), error.IsEmpty() ? "(0 errors)" : error.str());
        EXPECT_EQ(p.Get(Tsy_Attr::CLKFX_MULTIPLY), mAndD ? "2" : "3") << m << "/" << d;
    }

    SynthPage shown("t2a250-4");
    shown.ByOutput("");
    EXPECT_FALSE(shown.EnterAndNext());
    EXPECT_EQ(shown.OnlyError(), "Please enter an output frequency to continue.");
    // Without the form an empty output is taken as 200 MHz.
    SynthPage silent("t2a250-4", true);
    silent.ByOutput("");
    EXPECT_TRUE(silent.page->ApplySilently()) << silent.OnlyError();
    EXPECT_EQ(silent.Get(Tsy_Attr::FOUT_VALUE), "200");
    EXPECT_EQ(silent.Get(Tsy_Attr::CLKFX_MULTIPLY), "2");
    EXPECT_EQ(silent.Get(Tsy_Attr::CLKFX_DIVIDE), "1");

    // Back keeps what was typed, checked or not, and derives nothing.
    SynthPage back("t2a250-4");
    back.ByOutput("150").page->LoadFromBlock();
    back.page->SetInputType(Tsy_JitterDlg::InputMAndD);
    back.page->SetMText("40");
    EXPECT_TRUE(back.page->StoreToBlock(false));
    EXPECT_EQ(back.Get(Tsy_Attr::JITTER_INPUT_TYPE), "M_AND_D_STR");
    EXPECT_EQ(back.Get(Tsy_Attr::M_VALUE), "40");
    EXPECT_EQ(back.Get(Tsy_Attr::CLKFX_MULTIPLY), "2");
}

TEST(ClockSynthPage, ValidRangesInTheUnitsOfTheSelectedInput)
{
    struct Case {
        const char* part;
        bool mAndD;
        const char *foutUnits, *finUnits, *header, *lowIn, *highOut;
    } cases[] = {
        {"t2a250-4", false, "MHZ", "NS", "<b>Fin (MHz)</b>", "1.000 - 210.000", "210.000 - 420.000"},
        {"t2a250-4", false, "NS", "MHZ", "<b>Fin (ns)</b>", "4.762 - 1000.000", "2.381 - 4.762"},
        {"t2a250-4", true, "MHZ", "NS", "<b>Fin (ns)</b>", "4.762 - 1000.000", "2.381 - 4.762"},
        // One mode only: the high row holds nothing, and no period divides by zero.
        {"m3e100-4", false, "NS", "MHZ", "<b>Fin (ns)</b>", "3.215 - 5000.000", "0.000 - 0.000"},
    };
    for (const auto& c : cases) {
        SynthPage p(c.part);
        p.Input(StringBase(c.finUnits) == "NS" ? "10" : "100", c.finUnits);
        if (c.mAndD)
            p.ByMAndD("2", "1");
        else
            p.ByOutput("100", c.foutUnits);
        p.page->LoadFromBlock();
        SCOPED_TRACE(std::string(c.part) + (c.mAndD ? " M and D" : " output ") + c.foutUnits);
        EXPECT_EQ(p.page->GetRangeTableTitle(), "Valid Ranges for Speed Grade -4");
        EXPECT_EQ(p.page->GetRangeHeader(false), c.header);
        EXPECT_EQ(p.page->GetRangeText(false, false), c.lowIn);
        EXPECT_EQ(p.page->GetRangeText(true, true), c.highOut);
    }
}

TEST(ClockSynthPage, TheSecondCascadedDcmIsLimitedBehindADoubledFastInput)
{
    const std::string limit =
        "For cascading in series, only low frequency mode is allowed.  Additionally, when DCM_INST1 input clock "
        "frequency is greater than 50 MHz, and both DCM are used to multiply the frequency (CLK2X or CLKFX), the "
        "DCM_INST2 output frequency is limited to 1/2 of the maximum frequency range.\n\n.  The valid CLKIN frequency "
        "for DCM_INST2 in this configuration is 24.000 - 105.000 MHz.";
    struct Case {
        const char *cascadingClk, *firstInput, *fout;
        bool passes;
    } cases[] = {{"CLK2X", "60", "150", false}, {"CLK2X180", "60", "150", false}, {"CLK2X", "60", "105", true},
                 {"CLK2X", "50", "150", true},  {"CLK0", "60", "150", true}};
    for (const auto& c : cases) {
        SynthPage p("t2a250-4", false, "dcm_cascading", 2);
        Tsy_Block* first = p.d.Wizard().GetActiveDCMBlk(1, false);
        first->SetAttributeValue(Tsy_Attr::TESY_ONLY_CASCADING_CLK, c.cascadingClk);
        first->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, c.firstInput);
        first->SetAttributeValue(Tsy_Attr::FIN_UNITS, "MHZ");
        p.Input("120").ByOutput(c.fout);
        SCOPED_TRACE(std::string(c.cascadingClk) + " at " + c.firstInput + " -> " + c.fout);
        EXPECT_EQ(p.EnterAndNext(), c.passes);
        EXPECT_EQ(p.OnlyError(), c.passes ? "(0 errors)" : limit);
    }
}

TEST(ClockSynthPage, NothingIsCalculatedWithoutSpeedData)
{
    TestDesign d("dcm", "t2a250-4", false);
    Tsy_JitterDlg page(&d.Wizard(), 1); // a wizard whose speed data never loaded
    EXPECT_FALSE(page.Calculate(true));
    EXPECT_EQ(Texts(d.Stream().Errors()),
              std::vector<std::string>{"Unable to access speedsfile. (Bad speedsfile pointer)"});
}

TEST(ClockSynthPage, MalformedEntriesAreRefusedWithAMessage)
{
    // Whatever a hand-written design holds, the silent run either stores a
    // sound configuration or says why not.
    for (const char* in : {"abc", "-5", "0", "1e308", "0.0001"})
        for (const char* out : {"", "nan", "-1", "1e309", "0.5", "99999999999"})
            for (const char* m : {"1", "-2147483648", "99999999999", "32"})
                for (const char* type : {"FOUT_STR", "M_AND_D_STR"}) {
                    SynthPage p("t2a250-4", true);
                    p.ByOutput(out).Set(Tsy_Attr::TESY_ONLY_CLKIN_VALUE, in);
                    p.Set(Tsy_Attr::M_VALUE, m).Set(Tsy_Attr::D_VALUE, m).Set(Tsy_Attr::JITTER_INPUT_TYPE, type);
                    SCOPED_TRACE(std::string(in) + " / " + out + " / " + m + " " + type);
                    if (p.page->ApplySilently()) {
                        int cm = std::atoi(p.Get(Tsy_Attr::CLKFX_MULTIPLY).c_str());
                        int cd = std::atoi(p.Get(Tsy_Attr::CLKFX_DIVIDE).c_str());
                        EXPECT_TRUE(cm >= 2 && cm <= 32 && cd >= 1 && cd <= 32);
                    } else {
                        EXPECT_FALSE(p.Errors().empty());
                    }
                }
}

// ---------------------------------------------------------------------------
// Whole batch runs. General Setup's choices are set the way it makes them, so
// the runs hold with or without that page ahead of this one.

namespace {

GenerateRun generate(const std::string& args)
{
    return Generate("--wizard dcm " + args, "synth");
}

const std::string kWithClkfx = " --pin dcm.CLKFX=on --set dcm.TSY_CLK_OUTPUT_TYPE=DLL_AND_FX";
const std::string kClkfxOnly = " --pin dcm.CLK0=off --pin dcm.CLKFX=on --set dcm.FB_SOURCE=NONE"
                               " --set dcm.CLK_FEEDBACK=NONE --set dcm.TSY_CLK_OUTPUT_TYPE=FX";

} // namespace

TEST(ClockSynthBatch, DerivesAndStoresMAndDAndTheJitter)
{
    struct Case {
        std::string settings;
        const char* m;
        const char* d;
        const char* mValue;    // M_VALUE as stored
        const char* uiAttr;    // the unit-interval figure of the family's model
        const char* ui;
    } cases[] = {
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=50 --set dcm.FOUT_VALUE=150" + kWithClkfx, "3", "1", "2",
         "JITTER_VALUE", "(none)"},
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=50 --set dcm.FOUT_VALUE=50" + kWithClkfx, "2", "2", "2",
         "JITTER_VALUE", "(none)"},
        // (156 - 0.1*100) ps at D = 1 over a 3.333 ns period.
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=100 --set dcm.FOUT_VALUE=300 "
         "--set dcm.TESY_ONLY_VALID_DFS_MODE=BOTH" + kWithClkfx, "3", "1", "2", "TESY_ONLY_JITTER_UI_NONOISE", "0.044"},
        // J = 2*4/32 + 76*14/216 + 2 = 7.18 % on the older families.
        {"--part t2a250-4 --set dcm.TESY_ONLY_CLKIN_VALUE=50 --set dcm.FOUT_VALUE=100 "
         "--set dcm.TESY_ONLY_VALID_DFS_MODE=BOTH" + kWithClkfx, "2", "1", "2", "JITTER_VALUE", "0.07"},
        {"--part t2a250-4 --set dcm.TESY_ONLY_CLKIN_VALUE=10 --set dcm.FOUT_VALUE=25" + kClkfxOnly, "25", "10", "2",
         "JITTER_PK2PK", "2.08"}, // J = 25*4/32 + 14/216 + 2 = 5.19 % of 40 ns
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=100 --set dcm.JITTER_INPUT_TYPE=M_AND_D_STR "
         "--set dcm.M_VALUE=1 --set dcm.D_VALUE=3 --set dcm.TESY_ONLY_VALID_DFS_MODE=BOTH" + kWithClkfx, "2", "6", "2",
         "TESY_ONLY_JITTER_PK2PK_NONOISE", "0.190"}, // A + 5 (Bn - A) / 31 ps at 100 MHz in
        // A DCM without synthesizer outputs is not held up by the entries.
        {"--part t2a250-4 --set dcm.TESY_ONLY_CLKIN_VALUE=33.33", "2", "1", "2", "JITTER_VALUE", "(none)"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.settings);
        GenerateRun r = generate(c.settings);
        ASSERT_EQ(r.result.status, 0) << r.result.err;
        EXPECT_EQ(r.DcmAttr("CLKFX_MULTIPLY"), c.m);
        EXPECT_EQ(r.DcmAttr("CLKFX_DIVIDE"), c.d);
        EXPECT_EQ(r.DcmAttr("M_VALUE"), c.mValue);
        EXPECT_EQ(r.DcmAttr(c.uiAttr), c.ui);
    }
}

TEST(ClockSynthBatch, RefusalsPrintTheMessageExitOneAndWriteNothing)
{
    struct Case {
        std::string settings;
        std::string error;
    } cases[] = {
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=100 --set dcm.FOUT_VALUE=33.3" + kWithClkfx,
         derived('M', 33)},
        {"--part t2a250-4 --set dcm.TESY_ONLY_CLKIN_VALUE=33.33" + kWithClkfx, derived('M', 200)},
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=40 --set dcm.FOUT_VALUE=300 "
         "--set dcm.TESY_ONLY_VALID_DFS_MODE=LOW" + kWithClkfx,
         "The specified input clock frequency is in Low Frequency mode. So your output frequency must also be in the "
         "Low Frequency range.  Either change your input or output clock frequency to correct this."},
        {"--part t5da1-1 --set dcm.TESY_ONLY_CLKIN_VALUE=100 --set dcm.JITTER_INPUT_TYPE=M_AND_D_STR "
         "--set dcm.M_VALUE=1 --set dcm.D_VALUE=17" + kWithClkfx,
         "D value must be within the allowable range 1 - 32.  Please set this value accordingly before continuing."},
        // A synthesizer input below 1 MHz, possible on this family, has no
        // whole-number ratio to the output.
        {"--part m3e100-4 --set dcm.TESY_ONLY_CLKIN_VALUE=0.5 --set dcm.FOUT_VALUE=30" + kClkfxOnly, kNotInRange},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.settings);
        GenerateRun r = generate(c.settings);
        EXPECT_EQ(r.result.status, 1) << r.result.err;
        EXPECT_NE(r.result.err.find("ERROR: " + c.error + "\n"), std::string::npos) << r.result.err;
        EXPECT_FALSE(r.Written());
    }
}
