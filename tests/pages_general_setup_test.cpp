// General Setup on a real design database: what the page loads from the DCM
// block, the validation chain with its messages and questions for every
// family class, the frequency modes at the bounds of the speed data, the
// phase-shift arithmetic, and what the store leaves on the block. Then the
// same page through whole batch runs of pendra.

#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_SpeedData.h"
#include "wizard/Tsy_Vocabulary.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <functional>
#include <sys/stat.h>

namespace {

using Page = Tsy_DCMgenSetup;

// The page of one DCM instance in a wizard on a catalogue part.
class SetupPage {
public:
    SetupPage(const char* keyword, const char* part, int inst = 1, bool batch = true, bool loaded = true)
        : d(keyword, part, batch)
    {
        if (loaded)
            d.MarkLoaded();
        d.Instantiate();
        for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
            if (auto* p = dynamic_cast<Page*>(d.Wizard().GetPage(i)); p && p->GetInstNum() == inst)
                page = p;
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
    }

    void Set(const char* name, const StringBase& value) { dcm->SetAttributeValue(name, value); }
    void Pin(const char* name, bool on) { dcm->GetNamedPin(name)->SetIsActive(on); }
    bool PinOn(const char* name) const { return dcm->GetNamedPin(name) && dcm->GetNamedPin(name)->IsActive(); }
    std::string Attr(const char* name) const { return dcm->GetAttributeValue(name).str(); }
    std::string PinAttr(const char* pin, const char* name) const
    {
        return dcm->GetNamedPin(pin)->GetAttributeValue(name).str();
    }
    // Shows the page and leaves it forward, as Next does.
    bool Next()
    {
        d.Stream().Clear();
        return page->LoadFromBlock() && page->StoreToBlock(true);
    }
    float Speed(const std::string& key) { return d.Wizard().GetSpdDataPtr()->GetSpeedValue(key); }
    std::vector<std::string> Errors() { return texts(d.Stream().Errors()); }
    std::vector<std::string> Notes() { return texts(d.Stream().Notes()); }
    std::vector<std::string> Questions() { return texts(d.Stream().Questions()); }

    TestDesign d;
    Page* page = nullptr;
    Tsy_Block* dcm = nullptr;

private:
    static std::vector<std::string> texts(const std::vector<StringBase>& in)
    {
        std::vector<std::string> out;
        for (const auto& t : in)
            out.push_back(t.str());
        return out;
    }
};

std::string fmt(double v)
{
    return StringBase::Printf("%.9g", v).str();
}

bool contains(const std::vector<std::string>& texts, const std::string& text)
{
    for (const auto& t : texts)
        if (t == text)
            return true;
    return false;
}

// One line of a range report as the user reads it.
std::string rangeLine(const char* what, float min, float max, bool ns)
{
    if (!ns)
        return StringBase::Printf("%s: %3.3f - %3.3f MHz\n", what, double(min), double(max)).str();
    auto period = [](float f) { return f == 0.0f ? 0.0 : 1000.0 / double(f); };
    return StringBase::Printf("%s: %3.3f - %3.3f ns\n", what, period(max), period(min)).str();
}

const char* const kOneFamilyEach[] = {"t2a40-4",  "qt2a250-4", "qrt2a1000-4", "t2p7-5",   "qt2p20-5",
                                      "m3s50-4",  "am3s200-4", "m3e100-4",    "m3a50-4",  "m3an50-4",
                                      "am3e100-4", "t4a15-10", "qt4a25-10",   "qrt4a60-10", "t5da1-1"};

} // namespace

// ------------------------------------------------------------------ loading

TEST(GeneralSetupLoad, RefusedTwoXFeedbackComesBackAsOneX)
{
    const char* text = "The Feedback Value was set to 2X, which is not allowed.  It will be changed to 1X by the wizard.";
    struct Case {
        const char* part;
        bool refused;
    } cases[] = {{"t5da1-1", true}, {"t4a25-10", true}, {"t2p7-5", true}, {"qt2p20-5", true},
                 {"t2a250-4", false}, {"m3s200-4", false}};
    for (const auto& c : cases) {
        SetupPage p("dcm", c.part);
        p.Set("CLK_FEEDBACK", "2X");
        EXPECT_TRUE(p.Next()) << c.part;
        EXPECT_EQ(contains(p.Notes(), text), c.refused) << c.part;
        EXPECT_EQ(p.Attr("CLK_FEEDBACK"), c.refused ? "1X" : "2X") << c.part;
        EXPECT_EQ(p.PinAttr(c.refused ? "CLK0" : "CLK2X", "TSY_CLKBUFTYPE1_NOEDIT"), "FEEDBACK_BUF") << c.part;
    }
}

TEST(GeneralSetupLoad, AnEntryKnownOnlyByItsPeriodIsRebuilt)
{
    struct Case {
        const char* units;
        const char* divide;
        const char* shown;
    } cases[] = {{"MHZ", "FALSE", "200.000"}, {"MHZ", "TRUE", "400.000"}, {"NS", "FALSE", "5.000"},
                 {"NS", "TRUE", "2.500"}};
    for (const auto& c : cases) {
        SetupPage p("dcm", "t2a250-4");
        p.Set("TESY_ONLY_CLKIN_VALUE", "");
        p.Set("CLKIN_PERIOD", "5.000");
        p.Set("FIN_UNITS", c.units);
        p.Set("CLKIN_DIVIDE_BY_2", c.divide);
        ASSERT_TRUE(p.page->LoadFromBlock());
        EXPECT_EQ(p.page->GetSettings().clkinText.str(), c.shown) << c.units << " " << c.divide;
        EXPECT_FLOAT_EQ(p.page->GetInputFrequency(), 200.0f) << c.units << " " << c.divide;
    }
}

TEST(GeneralSetupLoad, SecondDcmTakesItsInputFromTheFirst)
{
    struct Case {
        const char* keyword;
        const char* units;
        const char* value;
        const char* cascadeClk;
        const char* divide;
        const char* firstDividesBy2;
        const char* ownUnits;
        const char* ownValue;
        const char* shown;
    } cases[] = {
        {"dcm_cascading", "MHZ", "100", "CLKDV", "4.0", "FALSE", "MHZ", "", "25.000"},
        {"dcm_cascading", "NS", "10", "CLKDV", "4.0", "FALSE", "MHZ", "", "40.000"},
        {"dcm_cascading", "MHZ", "100", "CLK2X", "2.0", "FALSE", "MHZ", "", "200.000"},
        {"dcm_cascading", "NS", "10", "CLK2X180", "2.0", "FALSE", "MHZ", "", "5.000"},
        {"dcm_cascading", "MHZ", "100", "CLK90", "2.0", "TRUE", "MHZ", "", "50.000"},
        {"dcm_bddeskew", "MHZ", "125.5", "CLK0", "2.0", "TRUE", "NS", "", "125.5"},
        {"dcm_clkswitch", "NS", "10", "CLK0", "2.0", "FALSE", "MHZ", "50", "20.000"},
    };
    for (const auto& c : cases) {
        SetupPage p(c.keyword, "t2a250-4", 2);
        ASSERT_NE(p.page, nullptr) << c.keyword;
        Tsy_Block* first = p.d.Wizard().GetActiveDCMBlk(1, false);
        ASSERT_NE(first, nullptr);
        first->SetAttributeValue("FIN_UNITS", c.units);
        first->SetAttributeValue("TESY_ONLY_CLKIN_VALUE", c.value);
        first->SetAttributeValue("CLKIN_PERIOD", "8.000");
        first->SetAttributeValue("TESY_ONLY_CASCADING_CLK", c.cascadeClk);
        first->SetAttributeValue("CLKDV_DIVIDE", c.divide);
        first->SetAttributeValue("CLKIN_DIVIDE_BY_2", c.firstDividesBy2);
        p.Set("FIN_UNITS", c.ownUnits);
        p.Set("TESY_ONLY_CLKIN_VALUE", c.ownValue);
        ASSERT_TRUE(p.page->LoadFromBlock());
        std::string what = std::string(c.keyword) + " " + c.units + " " + c.cascadeClk;
        EXPECT_EQ(p.Attr("FIN_UNITS"), c.units) << what;
        EXPECT_EQ(p.page->GetSettings().clkinText.str(), c.shown) << what;
        if (std::string(c.keyword) == "dcm_bddeskew") {
            EXPECT_EQ(p.Attr("CLKIN_PERIOD"), "8.000");
        }
    }
}

TEST(GeneralSetupLoad, TidiesTheBlock)
{
    SetupPage p("dcm", "t5da1-1");
    p.dcm->AddPin("DRST", "IN");
    p.dcm->GetNamedPin("DADDR")->SetWidth(3);
    p.dcm->AddAttribute("CLK_OUTPUT_TYPE", "DLL");
    p.dcm->GetNamedPin("CLK90")->SetAttributeValue("TSY_CLKBUFTYPE1_NOEDIT", "TRUE");
    p.dcm->GetNamedPin("CLK90")->SetAttributeValue("TSY_CLKBUFTYPE2_NOEDIT", "DISABLED_BUF");
    ASSERT_TRUE(p.page->LoadFromBlock());
    EXPECT_EQ(p.dcm->GetNamedPin("DRST"), nullptr);
    EXPECT_EQ(p.dcm->GetNamedPin("DADDR")->GetWidth(), 7);
    EXPECT_EQ(p.dcm->GetNamedAttribute("CLK_OUTPUT_TYPE"), nullptr);
    EXPECT_EQ(p.PinAttr("CLK90", "TSY_CLKBUFTYPE1_NOEDIT"), "");
    EXPECT_EQ(p.PinAttr("CLK90", "TSY_CLKBUFTYPE2_NOEDIT"), "DISABLED_BUF");
}

// ------------------------------------------------------- frequency modes

TEST(GeneralSetupFrequency, RangesHoldTheirBoundsOnEveryFamilyClass)
{
    struct Case {
        const char* part;
        const char* perf; // DCM_PERFORMANCE_MODE, or empty without performance modes
    } cases[] = {{"t5da1-1", "MAX_SPEED"}, {"t5da1-1", "MAX_RANGE"}, {"t4a25-10", "MAX_SPEED"},
                 {"t4a25-10", "MAX_RANGE"}, {"m3e100-4", ""},        {"m3a200-4", ""},
                 {"m3s200-4", ""},          {"t2p7-5", ""},          {"t2a250-4", ""}};
    for (const auto& c : cases) {
        SetupPage p("dcm", c.part);
        const bool gen45 = *c.perf != '\0';
        const std::string infix = !gen45 ? "" : std::string(c.perf) == "MAX_RANGE" ? "MR_" : "MS_";
        if (gen45)
            p.Set("DCM_PERFORMANCE_MODE", c.perf);
        struct Range {
            bool dll;
            int bit;
            std::string min, max;
        } ranges[] = {
            {true, 1, "CLKIN_FREQ_DLL_LF_" + infix + "Min", "CLKIN_FREQ_DLL_LF_" + infix + "Max"},
            {true, 2, "CLKIN_FREQ_DLL_HF_" + infix + "Min", "CLKIN_FREQ_DLL_HF_" + infix + "Max"},
            {false, 1, "CLKIN_FREQ_FX_LF_" + infix + "Min", "CLKIN_FREQ_FX_LF_" + infix + "Max"},
            {false, 2, std::string(gen45 ? "CLKIN_FREQ_FX_HF_" : "CLKIN_FRQ_FX_HF_") + infix + "Min",
             std::string(gen45 ? "CLKIN_FREQ_FX_HF_" : "CLKIN_FRQ_FX_HF_") + infix + "Max"},
        };
        for (const auto& r : ranges) {
            float min = p.Speed(r.min), max = p.Speed(r.max);
            if (max <= 0.0f)
                continue; // a mode the family does not have
            struct Probe {
                double f;
                bool inside;
            } probes[] = {{min, true}, {max, true}, {min * (1 - 1e-4), false}, {max * (1 + 1e-4), false}};
            for (const auto& probe : probes) {
                p.Set("TESY_ONLY_CLKIN_VALUE", fmt(probe.f));
                ASSERT_TRUE(p.page->LoadFromBlock());
                int mode = r.dll ? p.page->GetDllMode() : p.page->GetDfsMode();
                EXPECT_EQ((mode & r.bit) != 0, probe.inside)
                    << c.part << " " << c.perf << " " << r.min << " f=" << fmt(probe.f) << " mode " << mode;
            }
        }
        EXPECT_TRUE(p.d.Stream().Errors().empty()) << c.part << ": a key the page asks for is missing";
    }
}

TEST(GeneralSetupFrequency, ADoubledCascadeOutputHalvesTheLowMaxima)
{
    SetupPage p("dcm_cascading", "t2a250-4", 1);
    float dllLowMax = p.Speed("CLKIN_FREQ_DLL_LF_Max");
    p.Pin("CLK2X", true);
    p.Set("TESY_ONLY_CLKIN_VALUE", fmt(dllLowMax / 2));
    ASSERT_TRUE(p.page->LoadFromBlock());
    EXPECT_EQ(p.page->GetRanges().dllLowMax, dllLowMax / 2);
    EXPECT_EQ(p.page->GetDllMode() & 1, 1);
    p.Set("TESY_ONLY_CLKIN_VALUE", fmt(dllLowMax * 0.75));
    EXPECT_FALSE(p.Next());
    ASSERT_EQ(p.Errors().size(), 1u);
    EXPECT_EQ(p.Errors()[0], "Only Low Frequency mode is valid for Cascading In Series.\n"
                             "Please enter an Input Clock Frequency value within the valid Low Frequency range.\n\n" +
                                 rangeLine("DLL Low Frequency Mode", p.Speed("CLKIN_FREQ_DLL_LF_Min"), dllLowMax / 2,
                                           false));
}

TEST(GeneralSetupFrequency, RangeReportsForEveryCaseInBothUnits)
{
    const std::string needValue = "A valid Input Clock Frequency value is required to continue.\n"
                                  "Please enter a value within the valid ranges.\n";
    const std::string note = "Note: High Frequency mode is set only after Low Frequency\nmaximum has been exceeded.\n";
    const std::string cascade = "Only Low Frequency mode is valid for Cascading In Series.\n";
    struct Case {
        const char* keyword;
        int inst;
        const char* part;
        const char* perf;
        const char* outputs; // "DLL", "DFS" or "BOTH"
        int reportCase;
        std::string head;
        const char* lines; // D = DLL low, d = DLL high, F = DFS low, f = DFS high, | = blank line
    } cases[] = {
        {"dcm_cascading", 1, "t2a250-4", "", "BOTH", 0,
         cascade + "Please enter an Input Clock Frequency value within the valid Low Frequency range.\n\n", "D|F"},
        {"dcm_cascading", 2, "t2a250-4", "", "DFS", 1,
         cascade + "The Input Clock Frequency for this DCM is set\nusing the first DCM's Input Clock Frequency.\n"
                   "Please adjust that value so this DCM's input frequency\nfalls within the valid Low Frequency "
                   "range.\n\n",
         "F"},
        {"dcm_cascading", 2, "t2a250-4", "", "DLL", 2,
         cascade + "The Input Clock Frequency for this DCM is set\nusing the first DCM's Input Clock Frequency and "
                   "the CLKDV's Divide-By-Value.\nPlease adjust those values so this DCM's input frequency falls\n"
                   "within the valid Low Frequency range.\n\n",
         "D"},
        {"dcm", 1, "t2a250-4", "", "DLL", 3, needValue + note + "\n", "Dd"},
        {"dcm", 1, "m3e100-4", "", "DFS", 4, needValue + note + "\n", "Ff"},
        {"dcm", 1, "t2p7-5", "", "BOTH", 5, needValue + note + "\n", "Dd|Ff"},
        {"dcm", 1, "t5da1-1", "MAX_SPEED", "BOTH", 5,
         needValue + note + "\nPerformance Mode is set to Maximum Speed.\n\n", "Dd|Ff"},
        {"dcm", 1, "t5da1-1", "MAX_RANGE", "BOTH", 5,
         needValue + "\nPerformance Mode is set to Maximum Range.\n\n", "D|F"},
        {"dcm", 1, "t4a25-10", "MAX_RANGE", "DLL", 6,
         "Only Low Frequency mode is valid when the Performance Mode is set to Max Range.\nPlease adjust the "
         "Performance Mode setting (in the Advanced Dialog)\nor change the input frequency to be within the valid "
         "Low Frequency range.\n\n",
         "D|F"},
    };
    for (const auto& c : cases) {
        for (bool ns : {false, true}) {
            SetupPage p(c.keyword, c.part, c.inst);
            ASSERT_NE(p.page, nullptr);
            const std::string infix = *c.perf == '\0' ? "" : std::string(c.perf) == "MAX_RANGE" ? "MR_" : "MS_";
            if (*c.perf)
                p.Set("DCM_PERFORMANCE_MODE", c.perf);
            p.Set("FIN_UNITS", ns ? "NS" : "MHZ");
            if (c.inst == 2)
                p.d.Wizard().GetActiveDCMBlk(1, false)->SetAttributeValue("FIN_UNITS", ns ? "NS" : "MHZ");
            p.Pin("CLK0", std::string(c.outputs) != "DFS");
            p.Pin("CLKFX", std::string(c.outputs) != "DLL");
            ASSERT_TRUE(p.page->LoadFromBlock());
            p.d.Stream().Clear();
            p.page->ReportFrequencyRanges(c.reportCase);
            const std::string fxHigh = *c.perf ? "CLKIN_FREQ_FX_HF_" : "CLKIN_FRQ_FX_HF_";
            std::string expected = c.head;
            for (const char* l = c.lines; *l; ++l) {
                switch (*l) {
                case 'D':
                    expected += rangeLine("DLL Low Frequency Mode", p.Speed("CLKIN_FREQ_DLL_LF_" + infix + "Min"),
                                          p.Speed("CLKIN_FREQ_DLL_LF_" + infix + "Max"), ns);
                    break;
                case 'd':
                    expected += rangeLine("DLL High Frequency Mode", p.Speed("CLKIN_FREQ_DLL_HF_" + infix + "Min"),
                                          p.Speed("CLKIN_FREQ_DLL_HF_" + infix + "Max"), ns);
                    break;
                case 'F':
                    expected += rangeLine("DFS Low Frequency Mode", p.Speed("CLKIN_FREQ_FX_LF_" + infix + "Min"),
                                          p.Speed("CLKIN_FREQ_FX_LF_" + infix + "Max"), ns);
                    break;
                case 'f':
                    expected += rangeLine("DFS High Frequency Mode", p.Speed(fxHigh + infix + "Min"),
                                          p.Speed(fxHigh + infix + "Max"), ns);
                    break;
                default: expected += "\n";
                }
            }
            ASSERT_EQ(p.d.Stream().Entries().size(), 1u);
            const auto& entry = p.d.Stream().Entries()[0];
            EXPECT_EQ(entry.text.str(), expected) << "case " << c.reportCase << (ns ? " ns" : " MHz");
            EXPECT_TRUE(entry.isError);
        }
    }
}

// ---------------------------------------------------------- the chain

namespace {

struct ChainCase {
    const char* what;
    const char* keyword;
    const char* part;
    int inst;
    std::function<void(SetupPage&)> setup;
    bool passes;
    std::string error;              // the one error, exact; empty when none
    std::vector<std::string> notes; // notes that must be among those given
    std::function<std::string(SetupPage&)> errorOf = {}; // an error that quotes the speed data
};

} // namespace

TEST(GeneralSetupValidation, EveryCheckSaysWhatIsWrong)
{
    const std::string clkdvTail = ", but with the current Divide setting, CLKDV is out of the valid range.  Please "
                                  "adjust your 'Input Clock Frequency' and the setting for 'Divide By Value' to fix "
                                  "this.";
    auto on = [](std::initializer_list<const char*> pins) {
        return [pins](SetupPage& p) {
            for (const char* out : {"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX",
                                    "CLKFX180"})
                p.Pin(out, false);
            for (const char* pin : pins)
                p.Pin(pin, true);
        };
    };
    const std::vector<ChainCase> cases = {
        {"no output", "dcm", "t5da1-1", 1, on({}), false, "Please select at least one clock output to continue.", {}},
        {"named like the primitive", "dcm", "t5da1-1", 1, [](SetupPage& p) { p.dcm->SetName("DCM"); }, true, "",
         {"The specified DCM Instance Name is the same as the primitive name'DCM_ADV'.  Since this is not allowed, "
          "the instance name will be changed to 'DCM_ADV_INST'."}},
        {"named DCM_ADV elsewhere", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.dcm->SetName("DCM_ADV"); }, true, "",
         {"The specified DCM Instance Name is the same as the primitive name'DCM'.  Since this is not allowed, the "
          "instance name will be changed to 'DCM_INST'."}},
        {"blanks around the name", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.dcm->SetName("  clk_dcm\t"); }, true,
         "", {}},
        {"leading digit", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.dcm->SetName("9dcm"); }, false,
         "The DCM Instance Name cannot begin with a number.  Please specify a valid instance name before continuing.",
         {}},
        {"hyphen", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.dcm->SetName("dcm-1"); }, false,
         "Invalid DCM Instance Name specified.  Please check this before continuing.", {}},
        {"HDL keyword", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.dcm->SetName("signal"); }, false,
         "The DCM Instance Name 'signal' is a VHDL keyword.  Please specify a valid instance name before continuing.",
         {}},
        {"module named like the primitive", "dcm", "t5da1-1", 1,
         [](SetupPage& p) { p.d.Configure([](Tsy_WizContext& c) { c.moduleName = "DCM_ADV"; }); }, true, "",
         {"The module name 'DCM_ADV' is the same as a library primitive name of an instance in this module.  This "
          "may cause errors during synthesis."}},
        {"DLL outputs without feedback", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.Set("FB_SOURCE", "NONE"); },
         false,
         "When any DLL outputs (CLK0, CLK90, CLK180, CLK270, CLKDV, CLK2X, CLK2X180) are used, the feedback source "
         "cannot be None.  Please adjust your selected output clocks or your Feedback Source setting to correct this.",
         {}},
        {"DFS outputs with feedback, switching", "dcm_clkswitch", "t2a250-4", 1,
         [on](SetupPage& p) {
             on({"CLKFX"})(p);
             p.Set("TESY_ONLY_DCM_SWITCHING_CLK", "CLKFX");
         },
         false,
         "When only DFS outputs (CLKFX, CLKFX180) are used, the feedback source must be set to None.  Please adjust "
         "your selected output clocks to correct this.",
         {}},
        {"external feedback without reset", "dcm", "t2a250-4", 1, [](SetupPage& p) { p.Set("FB_SOURCE", "EXTERNAL"); },
         true, "",
         {"Resetting after configuration is strongly recommended for a DCM that is configured with external "
          "feedback.  Refer to Corvane Answer Record 14425 for an example of reset logic."}},
        {"2X feedback in high frequency mode", "dcm", "t2a250-4", 1,
         [](SetupPage& p) {
             p.Set("CLK_FEEDBACK", "2X");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_HF_Max")));
         },
         false,
         "CLK2X is not valid in High Frequency Mode.  Please select feedback value 1X or change the Input Clock "
         "Frequency to be within Low Frequency Mode.",
         {}},
        {"CLKDV above its range", "dcm", "t5da1-1", 1,
         [](SetupPage& p) {
             p.Set("DCM_PERFORMANCE_MODE", "MAX_RANGE");
             p.Set("CLKDV_DIVIDE", "1.5");
             p.Pin("CLKDV", true);
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_LF_MR_Max")));
         },
         false, "", {},
         [clkdvTail](SetupPage& p) {
             return StringBase::Printf("The specified Input Clock Frequency has been determined to fall within the Low "
                                       "Frequency mode.  The valid range for CLKDV is %3.3f - %3.3f MHz",
                                       double(p.Speed("CLKOUT_FREQ_DV_LF_MR_Min")),
                                       double(p.Speed("CLKOUT_FREQ_DV_LF_MR_Max")))
                        .str() +
                    clkdvTail;
         }},
        {"CLKDV at the top of its range", "dcm", "t5da1-1", 1,
         [](SetupPage& p) {
             p.Set("DCM_PERFORMANCE_MODE", "MAX_RANGE");
             p.Set("CLKDV_DIVIDE", "1.5");
             p.Pin("CLKDV", true);
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKOUT_FREQ_DV_LF_MR_Max") * 1.5));
         },
         true, "", {}},
        {"CLK2X in high frequency mode, ns", "dcm", "t5da1-1", 1,
         [](SetupPage& p) {
             p.Pin("CLK2X", true);
             p.Set("FIN_UNITS", "NS");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(1000.0 / (p.Speed("CLKIN_FREQ_DLL_LF_MS_Max") * 1.5)));
         },
         false,
         "The specified Input Clock Frequency has been determined to fall within the High Frequency mode.  The valid "
         "range for CLK2X and CLK2X180 is 0.000 - 0.000 ns.  Please change your 'Input Clock Frequency' so that when "
         "doubled, it will be within this range.",
         {}},
        {"a full turn of fixed shift", "dcm", "t2a250-4", 1,
         [](SetupPage& p) {
             p.Set("CLKOUT_PHASE_SHIFT", "FIXED");
             p.Set("PHASE_SHIFT", "256");
         },
         false, "Amount of phase shift should not exceed CLKIN period. Please enter a valid phase shift value.", {}},
        {"a negative turn is held to the limits instead", "dcm", "t5da1-1", 1,
         [](SetupPage& p) {
             p.Set("CLKOUT_PHASE_SHIFT", "FIXED");
             p.Set("PHASE_SHIFT", "-256");
         },
         false,
         "The phase shift value '-256' is outside the valid range of -179 to 179.  Please enter a valid phase shift "
         "value.",
         {}},
        {"DIRECT with a value", "dcm", "t5da1-1", 1,
         [](SetupPage& p) {
             p.Set("CLKOUT_PHASE_SHIFT", "DIRECT");
             p.Set("PHASE_SHIFT", "40");
         },
         true, "",
         {"When the DIRECT phase shift type is used, the starting phase shift value is always 0, regardless of the "
          "number specified in the Phase Shift 'Value' field.  The non-zero value for DIRECT mode can only be loaded "
          "to the DCM when a specific 'load phase shift value' command is given by Dynamic Reconfiguration.  Refer to "
          "the 'Dynamic Reconfiguration' section of the HW user guide fore more information."}},
        {"a phase shift type the primitive lacks", "dcm", "t5da1-1", 1,
         [](SetupPage& p) { p.Set("CLKOUT_PHASE_SHIFT", "VARIABLE"); }, false,
         "'VARIABLE' is not a valid value of CLKOUT_PHASE_SHIFT for the DCM_ADV primitive.  Please choose one of the "
         "listed values.",
         {}},
        {"second DCM without LOCKED or startup wait", "dcm_clkswitch", "t2a250-4", 2,
         [](SetupPage& p) { p.Pin("LOCKED", false); }, true, "",
         {"LOCKED is not selected. It is essential to monitor LOCKED signal at all times to ensure that system "
          "flip-flops not be enabled until after the DCM that drives their clock input has locked.  To ensure that "
          "DCM is properly locked at startup, either the LOCKED signal must be monitored or the STARTUP_WAIT option "
          "must be used (setting available in Advanced dialog)."}},
        {"stepping 0 of a narrow device", "dcm", "m3e100-4", 1,
         [](SetupPage& p) {
             p.Pin("CLK0", false);
             p.Pin("CLKFX", true);
             p.Set("FB_SOURCE", "NONE");
             p.Set("TESY_ONLY_CLKIN_VALUE", "90.5");
         },
         true, "",
         {"The Input Clock Frequency correctly falls within the Membra3E Stepping 1 valid range.  However, the Input "
          "Clock Frequency does not fall within the valid Membra3E Stepping 0 range of 5 - 90.  Please check the "
          "Datasheet.\n"}},
        {"DFS alone below the DLL range on Taldor-4", "dcm", "t4a25-10", 1,
         [](SetupPage& p) {
             p.Pin("CLK0", false);
             p.Pin("CLKFX", true);
             p.Set("FB_SOURCE", "NONE");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_LF_MS_Min") / 2));
         },
         true, "",
         {"Because only DFS clocks are used, but the input clock frequency is outside the DLL frequency range, a "
          "special macro should be used in order for the DCM_ADV to lock properly.  Please refer to Answer Record "
          "23624 for details."}},
    };
    for (const auto& c : cases) {
        SetupPage p(c.keyword, c.part, c.inst);
        ASSERT_NE(p.page, nullptr) << c.what;
        c.setup(p);
        EXPECT_EQ(p.Next(), c.passes) << c.what;
        if (c.errorOf) {
            ASSERT_EQ(p.Errors().size(), 1u) << c.what;
            EXPECT_EQ(p.Errors()[0], c.errorOf(p)) << c.what;
        } else if (c.error.empty()) {
            EXPECT_TRUE(p.Errors().empty()) << c.what << ": " << (p.Errors().empty() ? "" : p.Errors()[0]);
        } else {
            ASSERT_EQ(p.Errors().size(), 1u) << c.what;
            EXPECT_EQ(p.Errors()[0], c.error) << c.what;
        }
        for (const auto& n : c.notes)
            EXPECT_TRUE(contains(p.Notes(), n)) << c.what << ": missing note " << n;
    }
}

TEST(GeneralSetupValidation, NotesOnlyWhereTheirFamilyNeedsThem)
{
    struct Case {
        const char* part;
        const char* frequency;
        bool stepping;
        bool macro;
    } cases[] = {{"m3e100-4", "50", false, false}, {"m3e60-4", "100", false, false},
                 {"m3a200-4", "100", false, false}, {"m3e1600-4", "4.5", true, false},
                 {"t5da1-1", "10", false, false},   {"t4a25-10", "50", false, false}};
    for (const auto& c : cases) {
        SetupPage p("dcm", c.part);
        p.Pin("CLK0", false);
        p.Pin("CLKFX", true);
        p.Set("FB_SOURCE", "NONE");
        p.Set("TESY_ONLY_CLKIN_VALUE", c.frequency);
        EXPECT_TRUE(p.Next()) << c.part;
        bool stepping = false, macro = false;
        for (const auto& n : p.Notes()) {
            stepping = stepping || n.find("Stepping 0") != std::string::npos;
            macro = macro || n.find("special macro") != std::string::npos;
        }
        EXPECT_EQ(stepping, c.stepping) << c.part;
        EXPECT_EQ(macro, c.macro) << c.part;
    }
    SetupPage external("dcm", "t5da1-1");
    external.Set("FB_SOURCE", "EXTERNAL");
    EXPECT_TRUE(external.Next());
    EXPECT_TRUE(external.Notes().empty()) << "DCM_ADV needs no reset note";
}

TEST(GeneralSetupValidation, ARenameNeverTakesAnotherBlocksName)
{
    SetupPage p("dcm", "t5da1-1");
    Tsy_Block* renamed = p.d.Data().CopyBlock(p.dcm, "DCM");
    ASSERT_NE(renamed, nullptr);
    renamed->active = true;
    p.dcm->active = false;
    ASSERT_EQ(p.d.Wizard().GetActiveDCMBlk(1, false), renamed);
    EXPECT_TRUE(p.page->LoadFromBlock() && p.page->StoreToBlock(true));
    EXPECT_EQ(renamed->GetName().str(), "DCM_ADV_INST1");
    EXPECT_EQ(p.dcm->GetName().str(), "DCM_ADV_INST");
    EXPECT_TRUE(contains(p.Notes(), "The specified DCM Instance Name is the same as the primitive name'DCM_ADV'.  "
                                    "Since this is not allowed, the instance name will be changed to 'DCM_ADV_INST1'."));
}

TEST(GeneralSetupValidation, QuestionsAnsweredYesAndNo)
{
    const std::string pro =
        "A fixed phase shift with negative phase shift value is specified. Certain Taldor-II Pro devices require a "
        "workaround for this DCM configuration. Please reference Answer Record 13349 for details.  The Pendra cannot "
        "support the work around so the workaround must be added manually. Do you want to continue with the negative "
        "value and make changes manually if required? (If not, please update the phase shift value to a positive "
        "number).";
    const std::string plain =
        "A fixed phase shift with negative phase shift value is specified. A workaround is required for this DCM "
        "configuration. Please reference Answer Record 13349 for details. The Pendra cannot support the work around.  "
        "Do you want to continue with the negative value and make changes yourself as described in the solution "
        "record? (If not, please update the phase shift value to a positive number.)";
    const std::string startup = "STARTUP_WAIT is set to TRUE for DCM INST1 and is set to FALSE for DCM INST2.  Both "
                                "DCMs should have the same STARTUP_WAIT value.  Would you like to go BACK to set both "
                                "DCM instances with the same value?";
    struct Case {
        const char* keyword;
        const char* part;
        int inst;
        std::string question; // empty: nothing is asked
        int answer;
        bool passes;
    } cases[] = {
        {"dcm", "t2p7-5", 1, pro, 1, true},          {"dcm", "qt2p20-5", 1, pro, 0, false},
        {"dcm", "t2a250-4", 1, plain, 1, true},      {"dcm", "qrt2a1000-4", 1, plain, 0, false},
        {"dcm", "t5da1-1", 1, "", 0, true},          {"dcm", "m3s200-4", 1, "", 0, true},
        {"dcm_clkswitch", "t2a250-4", 2, startup, 1, false}, {"dcm_clkswitch", "t2a250-4", 2, startup, 0, true},
    };
    for (const auto& c : cases) {
        for (bool batch : {false, true}) {
            SetupPage p(c.keyword, c.part, c.inst, batch);
            ASSERT_NE(p.page, nullptr);
            if (c.inst == 1) {
                p.Set("CLKOUT_PHASE_SHIFT", "FIXED");
                p.Set("PHASE_SHIFT", "-10");
            } else {
                p.d.Wizard().GetActiveDCMBlk(1, false)->SetAttributeValue("STARTUP_WAIT", "TRUE");
            }
            p.d.Stream().ScriptAnswers({c.answer});
            bool passed = p.Next();
            std::string what = std::string(c.part) + (batch ? " batch" : " window");
            if (batch) {
                // Nobody to ask: the question is a note and the run goes on.
                EXPECT_TRUE(passed) << what;
                EXPECT_TRUE(p.Questions().empty()) << what;
                EXPECT_EQ(contains(p.Notes(), c.question), !c.question.empty()) << what;
            } else {
                EXPECT_EQ(passed, c.passes) << what;
                EXPECT_EQ(p.Questions(), c.question.empty() ? std::vector<std::string>{}
                                                            : std::vector<std::string>{c.question})
                    << what;
            }
        }
    }
}

// ----------------------------------------------------------- phase shift

TEST(GeneralSetupPhaseShift, LimitsAndDisplayFollowTypeFamilyAndFrequency)
{
    struct Case {
        const char* part;
        const char* perf;
        const char* type;
        const char* input;
        const char* units;
        bool divideBy2;
        const char* value;
        int lowest, highest;
        double ns, degrees;
    } cases[] = {
        {"t2a250-4", "", "FIXED", "100", "MHZ", false, "0", -255, 255, 0, 0},
        {"t2a250-4", "", "FIXED", "400", "MHZ", false, "0", -255, 255, 0, 0},
        {"t2a250-4", "", "FIXED", "5", "MHZ", false, "12", -12, 12, 9.375, 16.875},
        {"t2a250-4", "", "FIXED", "200", "NS", false, "-12", -12, 12, -9.375, -16.875},
        {"t2a250-4", "", "FIXED", "10", "MHZ", true, "0", -12, 12, 0, 0},
        {"t2a250-4", "", "VARIABLE", "100", "MHZ", false, "64", -128, 128, 2.5, 90},
        {"t5da1-1", "MAX_SPEED", "FIXED", "100", "MHZ", false, "0", -179, 179, 0, 0},
        {"t5da1-1", "MAX_RANGE", "FIXED", "100", "MHZ", false, "0", -255, 255, 0, 0},
        {"t5da1-1", "MAX_SPEED", "VARIABLE_CENTER", "100", "MHZ", false, "0", -76, 76, 0, 0},
        {"t5da1-1", "MAX_RANGE", "VARIABLE_CENTER", "100", "MHZ", false, "0", -128, 128, 0, 0},
        {"t5da1-1", "MAX_SPEED", "VARIABLE_POSITIVE", "100", "MHZ", false, "0", 0, 179, 0, 0},
        {"t5da1-1", "MAX_SPEED", "DIRECT", "100", "MHZ", false, "40", 0, 1023, 1.0, 36},
        {"m3e100-4", "", "FIXED", "5", "MHZ", false, "0", -255, 255, 0, 0},
        {"m3e100-4", "", "VARIABLE_CENTER", "5", "MHZ", false, "0", -12, 12, 0, 0},
        {"m3e100-4", "", "VARIABLE_POSITIVE", "5", "MHZ", false, "0", 0, 12, 0, 0},
        {"m3s200-4", "", "VARIABLE", "50", "MHZ", false, "0", -64, 64, 0, 0},
    };
    for (const auto& c : cases) {
        SetupPage p("dcm", c.part);
        if (*c.perf)
            p.Set("DCM_PERFORMANCE_MODE", c.perf);
        p.Set("CLKOUT_PHASE_SHIFT", c.type);
        p.Set("TESY_ONLY_CLKIN_VALUE", c.input);
        p.Set("FIN_UNITS", c.units);
        p.Set("CLKIN_DIVIDE_BY_2", c.divideBy2 ? "TRUE" : "FALSE");
        p.Set("PHASE_SHIFT", c.value);
        ASSERT_TRUE(p.page->LoadFromBlock());
        std::string what = std::string(c.part) + " " + c.perf + " " + c.type + " " + c.input + " " + c.units;
        EXPECT_EQ(p.page->GetPsLowest(), c.lowest) << what;
        EXPECT_EQ(p.page->GetPsHighest(), c.highest) << what;
        EXPECT_NEAR(p.page->GetPsNs(), c.ns, 1e-4) << what;
        EXPECT_NEAR(p.page->GetPsDegrees(), c.degrees, 1e-4) << what;
    }
}

TEST(GeneralSetupPhaseShift, HighFrequencyModeTurnsItOffOnMembra3)
{
    SetupPage p("dcm", "m3s200-4");
    p.Set("CLKOUT_PHASE_SHIFT", "FIXED");
    p.Set("PHASE_SHIFT", "10");
    p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_HF_Max")));
    EXPECT_TRUE(p.Next());
    EXPECT_TRUE(contains(p.Notes(), "Fixed or Variable phase shifting is not supported when the DFS/DLL frequency "
                                    "mode is set to high.  The phase shift will automatically be set to 'None'."));
    EXPECT_EQ(p.Attr("CLKOUT_PHASE_SHIFT"), "NONE");
    EXPECT_EQ(p.Attr("PHASE_SHIFT"), "0");
    EXPECT_EQ(p.Attr("DLL_FREQUENCY_MODE"), "HIGH");
}

// ----------------------------------------------------------------- store

TEST(GeneralSetupStore, DerivedAttributesByFamilyAndMode)
{
    struct Case {
        const char* part;
        const char* input;
        const char* dll, *dfs, *validDfs, *jf, *simDevice;
    } cases[] = {
        {"t2a250-4", "100", "LOW", "LOW", "BOTH", "16'hC080", ""},
        {"t2a250-4", "300", "HIGH", "HIGH", "HIGH", "16'hF0F0", ""},
        {"t2a250-4", "30", "LOW", "LOW", "LOW", "16'hC080", ""},
        {"m3s200-4", "100", "LOW", "LOW", "BOTH", "16'h8080", ""},
        {"am3s200-4", "100", "LOW", "LOW", "BOTH", "16'h8080", ""},
        {"m3e100-4", "100", "LOW", "LOW", "LOW", "16'hC080", ""},
        {"t4a25-10", "100", "LOW", "LOW", "BOTH", "16'hF0F0", ""},
        {"t5da1-1", "100", "LOW", "LOW", "BOTH", "16'hF0F0", "TALDOR5"},
    };
    for (const auto& c : cases) {
        SetupPage p("dcm", c.part);
        p.Set("TESY_ONLY_CLKIN_VALUE", c.input);
        ASSERT_TRUE(p.Next()) << c.part << " " << c.input << ": " << (p.Errors().empty() ? "" : p.Errors()[0]);
        std::string what = std::string(c.part) + " " + c.input;
        EXPECT_EQ(p.Attr("DLL_FREQUENCY_MODE"), c.dll) << what;
        EXPECT_EQ(p.Attr("DFS_FREQUENCY_MODE"), c.dfs) << what;
        EXPECT_EQ(p.Attr("TESY_ONLY_VALID_DFS_MODE"), c.validDfs) << what;
        EXPECT_EQ(p.Attr("FACTORY_JF"), c.jf) << what;
        EXPECT_EQ(p.Attr("SIM_DEVICE"), c.simDevice) << what;
        const bool gen45 = std::string(c.part)[0] == 't' && (c.part[1] == '4' || c.part[1] == '5');
        EXPECT_EQ(p.Attr("DCM_AUTOCALIBRATION"), gen45 ? "TRUE" : "") << what;
        EXPECT_EQ(p.Attr("DCM_PERFORMANCE_MODE"), gen45 ? "MAX_SPEED" : "") << what;
    }
}

TEST(GeneralSetupStore, InputPeriodUnitsAndTheDivider)
{
    SetupPage p("dcm", "t2a250-4");
    p.Set("TESY_ONLY_CLKIN_VALUE", "200");
    p.Set("FIN_UNITS", "NS");
    p.Set("FOUT_UNITS", "MHZ");
    p.Set("CLKIN_DIVIDE_BY_2", "TRUE");
    ASSERT_TRUE(p.page->LoadFromBlock());
    EXPECT_FLOAT_EQ(p.page->GetInputFrequency(), 2.5f);
    ASSERT_TRUE(p.page->StoreToBlock(false)) << "Back stores whatever the content";
    EXPECT_EQ(p.Attr("CLKIN_PERIOD"), "400.000");
    EXPECT_EQ(p.Attr("TESY_ONLY_CLKIN_VALUE"), "200");
    EXPECT_EQ(p.Attr("FIN_UNITS"), "NS");
    EXPECT_EQ(p.Attr("FOUT_UNITS"), "MHZ") << "a loaded design keeps its output units";

    SetupPage fresh("dcm", "t2a250-4", 1, true, false);
    fresh.Set("FOUT_UNITS", "NS");
    fresh.Set("TESY_ONLY_CLKIN_VALUE", "8");
    ASSERT_TRUE(fresh.Next());
    EXPECT_EQ(fresh.Attr("FOUT_UNITS"), "MHZ") << "a new design's output units follow the input's";
    EXPECT_EQ(fresh.Attr("TESY_ONLY_CLKIN_VALUE"), "100") << "the default setup starts at 100";

    for (const char* empty : {"0", ".", "abc"}) {
        SetupPage z("dcm", "t2a250-4");
        z.Set("TESY_ONLY_CLKIN_VALUE", empty);
        ASSERT_TRUE(z.page->LoadFromBlock());
        EXPECT_EQ(z.page->GetInputFrequency(), 0.0f);
        EXPECT_TRUE(z.page->StoreToBlock(false));
        EXPECT_EQ(z.Attr("CLKIN_PERIOD"), "0.000") << "'" << empty << "'";
    }
}

TEST(GeneralSetupStore, PinsFollowTheSettings)
{
    SetupPage p("dcm", "t5da1-1");
    p.Set("CLKOUT_PHASE_SHIFT", "VARIABLE_POSITIVE");
    p.Set("TESY_ONLY_RECONFIG_PINS", "TRUE");
    p.Pin("CLKFX", true);
    ASSERT_TRUE(p.Next()) << (p.Errors().empty() ? "" : p.Errors()[0]);
    for (const char* pin : {"PSEN", "PSINCDEC", "PSCLK", "PSDONE", "DADDR", "DI", "DWE", "DEN", "DCLK", "DRDY", "DO",
                            "CLKFX", "CLKFB"})
        EXPECT_TRUE(p.PinOn(pin)) << pin;
    EXPECT_EQ(p.Attr("TSY_CLK_OUTPUT_TYPE"), "DLL_AND_FX");

    p.Set("CLKOUT_PHASE_SHIFT", "FIXED");
    p.Set("TESY_ONLY_RECONFIG_PINS", "FALSE");
    p.Set("FB_SOURCE", "NONE");
    p.Pin("CLK0", false);
    p.Pin("DO", false); // the status box, unticked
    ASSERT_TRUE(p.Next()) << (p.Errors().empty() ? "" : p.Errors()[0]);
    for (const char* pin : {"PSEN", "PSINCDEC", "PSCLK", "PSDONE", "DADDR", "DI", "DWE", "DEN", "DCLK", "DRDY", "DO",
                            "CLKFB", "CLK0"})
        EXPECT_FALSE(p.PinOn(pin)) << pin;
    EXPECT_EQ(p.Attr("TSY_CLK_OUTPUT_TYPE"), "FX");
    EXPECT_EQ(p.Attr("CLK_FEEDBACK"), "NONE");
}

TEST(GeneralSetupStore, TheFeedbackBufferFollowsTheLoop)
{
    SetupPage p("dcm", "t2a250-4");
    Tsy_Pin* clk0 = p.dcm->GetNamedPin("CLK0");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFGCE");
    clk0->SetAttributeValue("TSY_CLKBUF1_O_SIGNAME", "fast_clk");
    ASSERT_TRUE(p.Next());
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE2"), "BUFG");
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE2_NOEDIT"), "FEEDBACK_BUF");
    ASSERT_TRUE(p.Next()) << "a second Next adds no second feedback buffer";
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE3"), "");

    p.Set("CLK_FEEDBACK", "2X");
    ASSERT_TRUE(p.Next());
    EXPECT_EQ(p.PinAttr("CLK2X", "TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(p.PinAttr("CLK2X", "TSY_CLKBUFTYPE1_NOEDIT"), "FEEDBACK_BUF");
    EXPECT_TRUE(p.PinOn("CLK2X"));
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE1"), "BUFGCE") << "the user's own buffer stays";
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE2"), "");

    // A feedback buffer ahead of the user's: the list closes up behind it.
    clk0->RemoveAllPropsWBase("TSY_CLKBUF");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFG");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE1_NOEDIT", "FEEDBACK_BUF");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE2", "BUFGMUX");
    clk0->SetAttributeValue("TSY_CLKBUF2_O_SIGNAME", "muxed");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE12", "BUFG");
    p.Set("FB_SOURCE", "EXTERNAL");
    ASSERT_TRUE(p.Next());
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUF1_O_SIGNAME"), "muxed");
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE1_NOEDIT"), "");
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE11"), "BUFG");
    EXPECT_EQ(p.PinAttr("CLK0", "TSY_CLKBUFTYPE12"), "");
    EXPECT_EQ(p.PinAttr("CLK2X", "TSY_CLKBUFTYPE1"), "") << "no loop, no feedback buffer";
}

TEST(GeneralSetupStore, ResetLogicNeedsRstAndPmcdFollowsAvailability)
{
    SetupPage noRst("dcm", "t2a250-4");
    noRst.Set("TESY_ONLY_RESET_LOGIC", "TRUE");
    noRst.Pin("RST", false);
    ASSERT_TRUE(noRst.Next());
    EXPECT_EQ(noRst.Attr("TESY_ONLY_RESET_LOGIC"), "FALSE");

    SetupPage cascade("dcm_cascading", "t2a250-4", 2);
    cascade.Set("TESY_ONLY_RESET_LOGIC", "TRUE");
    ASSERT_TRUE(cascade.page->LoadFromBlock());
    EXPECT_FALSE(cascade.page->GetSettings().resetLogic);

    SetupPage t4("dcm", "t4a25-10");
    t4.Set("TESY_ONLY_PMCD", "");
    ASSERT_TRUE(t4.Next());
    EXPECT_TRUE(t4.page->GetSettings().pmcdAvailable);
    EXPECT_EQ(t4.Attr("TESY_ONLY_PMCD"), "NONE");

    SetupPage t5("dcm", "t5da1-1");
    t5.d.Configure([](Tsy_WizContext& c) { c.retarget = true; });
    ASSERT_TRUE(t5.page->LoadFromBlock());
    EXPECT_TRUE(t5.page->GetSettings().pmcdAvailable);
    EXPECT_EQ(t5.Attr("TESY_ONLY_RETARGET"), "T4TOT5");
}

TEST(GeneralSetupStore, ASingleDcmDesignStartsFromItsDcmAlone)
{
    SetupPage p("dcm", "t5da1-1");
    Tsy_Signal* stale = p.d.Data().AddSignal("OLD_NET", false, "");
    Tsy_Block* pmcd = p.d.Data().GetPrimitiveBlock("PMCD");
    ASSERT_NE(pmcd, nullptr);
    pmcd->active = true;
    ASSERT_TRUE(p.Next());
    EXPECT_FALSE(stale->IsActive());
    EXPECT_FALSE(pmcd->active);
    EXPECT_TRUE(p.dcm->active);
}

// ----------------------------------------------------------- batch runs

namespace {

std::string pendra()
{
    return std::string(PENDRA_BIN_DIR) + "/pendra";
}

bool exists(const std::string& path)
{
    struct stat st;
    return ::stat(path.c_str(), &st) == 0;
}

const nlohmann::json* dcmBlock(const nlohmann::json& design)
{
    for (const auto& b : design["blocks"])
        if (b["type"].get<std::string>().rfind("DCM", 0) == 0 && b.value("active", false))
            return &b;
    return nullptr;
}

} // namespace

TEST(GeneralSetupBatch, EveryFamilyStoresTheDefaultSetup)
{
    for (const char* part : kOneFamilyEach) {
        TempDir dir;
        CommandResult r = RunCommand(pendra() + " generate --wizard dcm --part " + part + " -o " + dir.Path());
        ASSERT_EQ(r.status, 0) << part << ": " << r.err;
        auto design = nlohmann::json::parse(ReadTextFile(dir.File("clkgen.tsw")));
        const nlohmann::json* dcm = dcmBlock(design);
        ASSERT_NE(dcm, nullptr) << part;
        EXPECT_EQ((*dcm)["attributes"]["CLKIN_PERIOD"], "10.000") << part;
        EXPECT_EQ((*dcm)["attributes"]["TESY_ONLY_CLKIN_VALUE"], "100") << part;
        EXPECT_EQ((*dcm)["attributes"]["CLK_FEEDBACK"], "1X") << part;
        bool clk0 = false;
        for (const auto& pin : (*dcm)["pins"])
            if (pin["name"] == "CLK0")
                clk0 = pin["active"].get<bool>();
        EXPECT_TRUE(clk0) << part;
    }
}

TEST(GeneralSetupBatch, WrongInputsStopWithThePagesMessageAndWriteNothing)
{
    struct Case {
        const char* part;
        std::string args;
        std::function<std::string(SetupPage&)> message;
    } cases[] = {
        {"t5da1-1", "--set dcm.TESY_ONLY_CLKIN_VALUE=700",
         [](SetupPage& p) {
             return "A valid Input Clock Frequency value is required to continue.\nPlease enter a value within the "
                    "valid ranges.\nNote: High Frequency mode is set only after Low Frequency\nmaximum has been "
                    "exceeded.\n\nPerformance Mode is set to Maximum Speed.\n\n" +
                    rangeLine("DLL Low Frequency Mode", p.Speed("CLKIN_FREQ_DLL_LF_MS_Min"),
                              p.Speed("CLKIN_FREQ_DLL_LF_MS_Max"), false) +
                    rangeLine("DLL High Frequency Mode", p.Speed("CLKIN_FREQ_DLL_HF_MS_Min"),
                              p.Speed("CLKIN_FREQ_DLL_HF_MS_Max"), false);
         }},
        {"t2a250-4", "--set dcm.FB_SOURCE=NONE",
         [](SetupPage&) {
             return std::string("When any DLL outputs (CLK0, CLK90, CLK180, CLK270, CLKDV, CLK2X, CLK2X180) are used, "
                                "the feedback source cannot be None.  Please adjust your selected output clocks or "
                                "your Feedback Source setting to correct this.");
         }},
        {"m3e100-4", "--pin dcm.CLK0=off --pin dcm.CLKFX=on",
         [](SetupPage&) {
             return std::string("When only DFS outputs (CLKFX, CLKFX180) are used, the feedback source must be set to "
                                "None.  Please adjust your selected output clocks or your Feedback Source setting to "
                                "correct this.");
         }},
        {"t2p7-5", "--set dcm.CLKOUT_PHASE_SHIFT=FIXED --set dcm.PHASE_SHIFT=300",
         [](SetupPage&) {
             return std::string(
                 "Amount of phase shift should not exceed CLKIN period. Please enter a valid phase shift value.");
         }},
        {"m3a200-4", "--set dcm.TESY_ONLY_CLKIN_VALUE=5 --set dcm.FIN_UNITS=NS --pin dcm.CLK2X=on",
         [](SetupPage& p) {
             return StringBase::Printf("The specified Input Clock Frequency has been determined to fall within the "
                                       "Low Frequency mode.  The valid range for CLK2X and CLK2X180 is %3.3f - %3.3f "
                                       "ns.  Please change your 'Input Clock Frequency' so that when doubled, it "
                                       "will be within this range.",
                                       1000.0 / p.Speed("CLKOUT_FREQ_2X_LF_Min"),
                                       1000.0 / p.Speed("CLKOUT_FREQ_2X_LF_Max"))
                 .str();
         }},
    };
    for (const auto& c : cases) {
        SetupPage figures("dcm", c.part);
        std::string expected = c.message(figures);
        while (!expected.empty() && expected.back() == '\n')
            expected.pop_back();
        TempDir dir;
        CommandResult r = RunCommand(pendra() + " generate --wizard dcm --part " + c.part + " " + c.args + " -o " +
                                     dir.Path() + "/out");
        EXPECT_EQ(r.status, 1) << c.part << " " << c.args << ": " << r.err;
        EXPECT_NE(r.err.find("ERROR: " + expected + "\n"), std::string::npos) << c.part << " " << c.args << ":\n"
                                                                            << r.err;
        size_t errors = 0;
        for (size_t at = r.err.find("ERROR: "); at != std::string::npos; at = r.err.find("ERROR: ", at + 1))
            ++errors;
        EXPECT_EQ(errors, 1u) << r.err;
        EXPECT_FALSE(exists(dir.Path() + "/out/clkgen.tsw")) << c.part;
    }
}
