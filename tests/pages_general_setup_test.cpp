// General Setup on a real design database: what the page loads from the DCM
// block, the validation chain with its messages and questions for every
// family class, the frequency modes at the bounds of the speed data, the
// phase-shift arithmetic, and what the store leaves on the block. Then the
// same page through whole batch runs of pendra.

#include "pages/dcm/Tsy_DCMgenSetup.h"
#include "support/BatchRun.h"
#include "wizard/Tsy_SpeedData.h"

#include <gtest/gtest.h>

#include <functional>
#include <sstream>

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
        page = FindPage<Page>(d.Wizard(), inst);
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        EXPECT_TRUE(page && dcm);
    }

    void Set(const char* name, const StringBase& value) { dcm->SetAttributeValue(name, value); }
    void Pin(const char* name, bool on) { dcm->GetNamedPin(name)->SetIsActive(on); }
    // Settings as the user leaves them: "ATTR=VALUE", "PIN.ATTR=VALUE",
    // "+PIN", "-PIN", "name:INSTANCE", "module:NAME".
    void Apply(const std::string& settings, Tsy_Block* block = nullptr)
    {
        Tsy_Block* b = block ? block : dcm;
        std::istringstream in(settings);
        for (std::string s; in >> s;) {
            const size_t eq = s.find('=');
            if (s[0] == '+' || s[0] == '-')
                b->GetNamedPin(s.substr(1))->SetIsActive(s[0] == '+');
            else if (s.rfind("name:", 0) == 0)
                b->SetName(s.substr(5));
            else if (s.rfind("module:", 0) == 0)
                d.Configure([&](Tsy_WizContext& c) { c.moduleName = s.substr(7); });
            else if (s.find('.') < eq)
                b->GetNamedPin(s.substr(0, s.find('.')))->SetAttributeValue(s.substr(s.find('.') + 1, eq - s.find('.') - 1),
                                                                           s.substr(eq + 1));
            else
                b->SetAttributeValue(s.substr(0, eq), s.substr(eq + 1));
        }
    }
    // Every "ATTR=VALUE" and "PIN.ATTR=VALUE" given is what the block holds.
    void ExpectStored(const std::string& settings)
    {
        std::istringstream in(settings);
        for (std::string s; in >> s;) {
            const size_t eq = s.find('='), dot = s.find('.');
            const std::string held = dot < eq ? PinAttr(s.substr(0, dot).c_str(), s.substr(dot + 1, eq - dot - 1).c_str())
                                               : Attr(s.substr(0, eq).c_str());
            EXPECT_EQ(held, s.substr(eq + 1)) << s;
        }
    }
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
    std::vector<std::string> Errors() { return Texts(d.Stream().Errors()); }
    std::string FirstError() { return Errors().empty() ? "" : Errors()[0]; }
    std::vector<std::string> Notes() { return Texts(d.Stream().Notes()); }
    std::vector<std::string> Questions() { return Texts(d.Stream().Questions()); }

    TestDesign d;
    Page* page = nullptr;
    Tsy_Block* dcm = nullptr;
};

std::string fmt(double v)
{
    return StringBase::Printf("%.9g", v).str();
}

// One line of a range report as the user reads it.
std::string rangeLine(const char* what, float min, float max, bool ns)
{
    if (!ns)
        return StringBase::Printf("%s: %3.3f - %3.3f MHz\n", what, double(min), double(max)).str();
    auto period = [](float f) { return f == 0.0f ? 0.0 : 1000.0 / double(f); };
    return StringBase::Printf("%s: %3.3f - %3.3f ns\n", what, period(max), period(min)).str();
}

// The infix of the speed-data keys of a performance mode.
std::string infixOf(const char* perf)
{
    return !*perf ? "" : std::string(perf) == "MAX_RANGE" ? "MR_" : "MS_";
}

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
        SCOPED_TRACE(c.part);
        SetupPage p("dcm", c.part);
        p.Set("CLK_FEEDBACK", "2X");
        EXPECT_TRUE(p.Next());
        EXPECT_EQ(Contains(p.Notes(), text), c.refused);
        EXPECT_EQ(p.Attr("CLK_FEEDBACK"), c.refused ? "1X" : "2X");
        EXPECT_EQ(p.PinAttr(c.refused ? "CLK0" : "CLK2X", "TSY_CLKBUFTYPE1_NOEDIT"), "FEEDBACK_BUF");
    }
}

TEST(GeneralSetupLoad, AnEntryKnownOnlyByItsPeriodIsRebuilt)
{
    struct Case {
        const char *units, *divide, *shown;
    } cases[] = {{"MHZ", "FALSE", "200.000"}, {"MHZ", "TRUE", "400.000"}, {"NS", "FALSE", "5.000"},
                 {"NS", "TRUE", "2.500"}};
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.units) + " " + c.divide);
        SetupPage p("dcm", "t2a250-4");
        p.Apply(std::string("TESY_ONLY_CLKIN_VALUE= CLKIN_PERIOD=5.000 FIN_UNITS=") + c.units +
                " CLKIN_DIVIDE_BY_2=" + c.divide);
        ASSERT_TRUE(p.page->LoadFromBlock());
        EXPECT_EQ(p.page->GetSettings().clkinText.str(), c.shown);
        EXPECT_FLOAT_EQ(p.page->GetInputFrequency(), 200.0f);
    }
}

TEST(GeneralSetupLoad, SecondDcmTakesItsInputFromTheFirst)
{
    struct Case {
        const char* keyword;
        const char* first; // the first DCM's settings
        const char* own;
        const char* shown;
    } cases[] = {
        {"dcm_cascading", "FIN_UNITS=MHZ TESY_ONLY_CLKIN_VALUE=100 TESY_ONLY_CASCADING_CLK=CLKDV CLKDV_DIVIDE=4.0",
         "FIN_UNITS=MHZ", "25.000"},
        {"dcm_cascading", "FIN_UNITS=NS TESY_ONLY_CLKIN_VALUE=10 TESY_ONLY_CASCADING_CLK=CLKDV CLKDV_DIVIDE=4.0",
         "FIN_UNITS=MHZ", "40.000"},
        {"dcm_cascading", "FIN_UNITS=MHZ TESY_ONLY_CLKIN_VALUE=100 TESY_ONLY_CASCADING_CLK=CLK2X", "FIN_UNITS=MHZ",
         "200.000"},
        {"dcm_cascading", "FIN_UNITS=NS TESY_ONLY_CLKIN_VALUE=10 TESY_ONLY_CASCADING_CLK=CLK2X180", "FIN_UNITS=MHZ",
         "5.000"},
        {"dcm_cascading",
         "FIN_UNITS=MHZ TESY_ONLY_CLKIN_VALUE=100 TESY_ONLY_CASCADING_CLK=CLK90 CLKIN_DIVIDE_BY_2=TRUE",
         "FIN_UNITS=MHZ", "50.000"},
        {"dcm_bddeskew", "FIN_UNITS=MHZ TESY_ONLY_CLKIN_VALUE=125.5 CLKIN_DIVIDE_BY_2=TRUE", "FIN_UNITS=NS",
         "125.5"},
        {"dcm_clkswitch", "FIN_UNITS=NS TESY_ONLY_CLKIN_VALUE=10", "FIN_UNITS=MHZ TESY_ONLY_CLKIN_VALUE=50",
         "20.000"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.keyword) + " " + c.first);
        SetupPage p(c.keyword, "t2a250-4", 2);
        Tsy_Block* first = p.d.Wizard().GetActiveDCMBlk(1, false);
        ASSERT_NE(first, nullptr);
        p.Apply(std::string("CLKIN_PERIOD=8.000 ") + c.first, first);
        p.Apply(std::string("TESY_ONLY_CLKIN_VALUE= ") + c.own);
        ASSERT_TRUE(p.page->LoadFromBlock());
        EXPECT_EQ(p.Attr("FIN_UNITS"), first->GetAttributeValue("FIN_UNITS").str());
        EXPECT_EQ(p.page->GetSettings().clkinText.str(), c.shown);
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
    p.Apply("CLK90.TSY_CLKBUFTYPE1_NOEDIT=TRUE CLK90.TSY_CLKBUFTYPE2_NOEDIT=DISABLED_BUF");
    ASSERT_TRUE(p.page->LoadFromBlock());
    EXPECT_EQ(p.dcm->GetNamedPin("DRST"), nullptr);
    EXPECT_EQ(p.dcm->GetNamedPin("DADDR")->GetWidth(), 7);
    EXPECT_EQ(p.dcm->GetNamedAttribute("CLK_OUTPUT_TYPE"), nullptr);
    p.ExpectStored("CLK90.TSY_CLKBUFTYPE1_NOEDIT= CLK90.TSY_CLKBUFTYPE2_NOEDIT=DISABLED_BUF");
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
        SCOPED_TRACE(std::string(c.part) + " " + c.perf);
        SetupPage p("dcm", c.part);
        const std::string infix = infixOf(c.perf);
        if (*c.perf)
            p.Set("DCM_PERFORMANCE_MODE", c.perf);
        const std::string fxHigh = *c.perf ? "CLKIN_FREQ_FX_HF_" : "CLKIN_FRQ_FX_HF_";
        struct Range {
            bool dll;
            int bit;
            std::string key;
        } ranges[] = {{true, 1, "CLKIN_FREQ_DLL_LF_" + infix},
                      {true, 2, "CLKIN_FREQ_DLL_HF_" + infix},
                      {false, 1, "CLKIN_FREQ_FX_LF_" + infix},
                      {false, 2, fxHigh + infix}};
        for (const auto& r : ranges) {
            float min = p.Speed(r.key + "Min"), max = p.Speed(r.key + "Max");
            if (max <= 0.0f)
                continue; // a mode the family does not have
            for (auto [f, inside] : {std::pair{double(min), true}, std::pair{double(max), true},
                                     std::pair{min * (1 - 1e-4), false}, std::pair{max * (1 + 1e-4), false}}) {
                p.Set("TESY_ONLY_CLKIN_VALUE", fmt(f));
                ASSERT_TRUE(p.page->LoadFromBlock());
                int mode = r.dll ? p.page->GetDllMode() : p.page->GetDfsMode();
                EXPECT_EQ((mode & r.bit) != 0, inside) << r.key << " f=" << fmt(f) << " mode " << mode;
            }
        }
        EXPECT_TRUE(p.d.Stream().Errors().empty()) << "a key the page asks for is missing";
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
    EXPECT_EQ(p.Errors(), std::vector<std::string>{"Only Low Frequency mode is valid for Cascading In Series.\n"
                                                   "Please enter an Input Clock Frequency value within the valid Low "
                                                   "Frequency range.\n\n" +
                                                   rangeLine("DLL Low Frequency Mode",
                                                             p.Speed("CLKIN_FREQ_DLL_LF_Min"), dllLowMax / 2, false)});
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
        const char *part, *perf;
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
        {"dcm", 1, "t5da1-1", "MAX_RANGE", "BOTH", 5, needValue + "\nPerformance Mode is set to Maximum Range.\n\n",
         "D|F"},
        {"dcm", 1, "t4a25-10", "MAX_RANGE", "DLL", 6,
         "Only Low Frequency mode is valid when the Performance Mode is set to Max Range.\nPlease adjust the "
         "Performance Mode setting (in the Advanced Dialog)\nor change the input frequency to be within the valid "
         "Low Frequency range.\n\n",
         "D|F"},
    };
    for (const auto& c : cases) {
        for (bool ns : {false, true}) {
            SCOPED_TRACE(::testing::Message() << "case " << c.reportCase << " " << c.part << (ns ? " ns" : " MHz"));
            SetupPage p(c.keyword, c.part, c.inst);
            const std::string infix = infixOf(c.perf);
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
                auto line = [&](const char* what, const std::string& key) {
                    expected += rangeLine(what, p.Speed(key + infix + "Min"), p.Speed(key + infix + "Max"), ns);
                };
                switch (*l) {
                case 'D': line("DLL Low Frequency Mode", "CLKIN_FREQ_DLL_LF_"); break;
                case 'd': line("DLL High Frequency Mode", "CLKIN_FREQ_DLL_HF_"); break;
                case 'F': line("DFS Low Frequency Mode", "CLKIN_FREQ_FX_LF_"); break;
                case 'f': line("DFS High Frequency Mode", fxHigh); break;
                default: expected += "\n";
                }
            }
            ASSERT_EQ(p.d.Stream().Entries().size(), 1u);
            EXPECT_EQ(p.d.Stream().Entries()[0].text.str(), expected);
            EXPECT_TRUE(p.d.Stream().Entries()[0].isError);
        }
    }
}

// ---------------------------------------------------------- the chain

namespace {

// How a case sets the page up: settings (see SetupPage::Apply), or code when
// a value comes from the speed data.
struct Given {
    Given(const char* settings) : settings(settings) {}
    Given(std::function<void(SetupPage&)> code) : code(std::move(code)) {}
    void operator()(SetupPage& p) const { code ? code(p) : p.Apply(settings); }
    const char* settings = "";
    std::function<void(SetupPage&)> code;
};

struct ChainCase {
    const char* what;
    const char* keyword;
    const char* part;
    int inst;
    Given setup;
    bool passes;
    std::string error;              // the one error, exact; empty when none
    std::vector<std::string> notes; // notes that must be among those given
    const char* stored = "";        // "ATTR=VALUE" the block holds afterwards
    std::function<std::string(SetupPage&)> errorOf = {}; // an error that quotes the speed data
};

} // namespace

TEST(GeneralSetupValidation, EveryCheckSaysWhatIsWrong)
{
    const std::string clkdvTail = ", but with the current Divide setting, CLKDV is out of the valid range.  Please "
                                  "adjust your 'Input Clock Frequency' and the setting for 'Divide By Value' to fix "
                                  "this.";
    const char* dfsOnly = "-CLK0 +CLKFX FB_SOURCE=NONE";
    const std::vector<ChainCase> cases = {
        {"no output", "dcm", "t5da1-1", 1, "-CLK0", false, "Please select at least one clock output to continue.", {}},
        {"named like the primitive", "dcm", "t5da1-1", 1, "name:DCM", true, "",
         {"The specified DCM Instance Name is the same as the primitive name'DCM_ADV'.  Since this is not allowed, "
          "the instance name will be changed to 'DCM_ADV_INST'."}},
        {"named DCM_ADV elsewhere", "dcm", "t2a250-4", 1, "name:DCM_ADV", true, "",
         {"The specified DCM Instance Name is the same as the primitive name'DCM'.  Since this is not allowed, the "
          "instance name will be changed to 'DCM_INST'."}},
        {"blanks around the name", "dcm", "t2a250-4", 1, Given([](SetupPage& p) { p.dcm->SetName("  clk_dcm\t"); }),
         true, "", {}},
        {"leading digit", "dcm", "t2a250-4", 1, "name:9dcm", false,
         "The DCM Instance Name cannot begin with a number.  Please specify a valid instance name before continuing.",
         {}},
        {"hyphen", "dcm", "t2a250-4", 1, "name:dcm-1", false,
         "Invalid DCM Instance Name specified.  Please check this before continuing.", {}},
        {"HDL keyword", "dcm", "t2a250-4", 1, "name:signal", false,
         "The DCM Instance Name 'signal' is a VHDL keyword.  Please specify a valid instance name before continuing.",
         {}},
        {"module named like the primitive", "dcm", "t5da1-1", 1, "module:DCM_ADV", true, "",
         {"The module name 'DCM_ADV' is the same as a library primitive name of an instance in this module.  This "
          "may cause errors during synthesis."}},
        {"DLL outputs without feedback", "dcm", "t2a250-4", 1, "FB_SOURCE=NONE", false,
         "When any DLL outputs (CLK0, CLK90, CLK180, CLK270, CLKDV, CLK2X, CLK2X180) are used, the feedback source "
         "cannot be None.  Please adjust your selected output clocks or your Feedback Source setting to correct this.",
         {}},
        {"DFS outputs with feedback, switching", "dcm_clkswitch", "t2a250-4", 1,
         "-CLK0 +CLKFX TESY_ONLY_DCM_SWITCHING_CLK=CLKFX", false,
         "When only DFS outputs (CLKFX, CLKFX180) are used, the feedback source must be set to None.  Please adjust "
         "your selected output clocks to correct this.",
         {}},
        {"external feedback without reset", "dcm", "t2a250-4", 1, "FB_SOURCE=EXTERNAL", true, "",
         {"Resetting after configuration is strongly recommended for a DCM that is configured with external "
          "feedback.  Refer to Corvane Answer Record 14425 for an example of reset logic."}},
        {"2X feedback in high frequency mode", "dcm", "t2a250-4", 1, Given([](SetupPage& p) {
             p.Set("CLK_FEEDBACK", "2X");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_HF_Max")));
         }),
         false,
         "CLK2X is not valid in High Frequency Mode.  Please select feedback value 1X or change the Input Clock "
         "Frequency to be within Low Frequency Mode.",
         {}},
        {"CLKDV above its range", "dcm", "t5da1-1", 1, Given([](SetupPage& p) {
             p.Apply("DCM_PERFORMANCE_MODE=MAX_RANGE CLKDV_DIVIDE=1.5 +CLKDV");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_LF_MR_Max")));
         }),
         false, "", {}, "",
         [clkdvTail](SetupPage& p) {
             return StringBase::Printf("The specified Input Clock Frequency has been determined to fall within the Low "
                                       "Frequency mode.  The valid range for CLKDV is %3.3f - %3.3f MHz",
                                       double(p.Speed("CLKOUT_FREQ_DV_LF_MR_Min")),
                                       double(p.Speed("CLKOUT_FREQ_DV_LF_MR_Max")))
                        .str() +
                    clkdvTail;
         }},
        {"CLKDV at the top of its range", "dcm", "t5da1-1", 1, Given([](SetupPage& p) {
             p.Apply("DCM_PERFORMANCE_MODE=MAX_RANGE CLKDV_DIVIDE=1.5 +CLKDV");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKOUT_FREQ_DV_LF_MR_Max") * 1.5));
         }),
         true, "", {}},
        {"CLK2X in high frequency mode, ns", "dcm", "t5da1-1", 1, Given([](SetupPage& p) {
             p.Apply("+CLK2X FIN_UNITS=NS");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(1000.0 / (p.Speed("CLKIN_FREQ_DLL_LF_MS_Max") * 1.5)));
         }),
         false,
         "The specified Input Clock Frequency has been determined to fall within the High Frequency mode.  The valid "
         "range for CLK2X and CLK2X180 is 0.000 - 0.000 ns.  Please change your 'Input Clock Frequency' so that when "
         "doubled, it will be within this range.",
         {}},
        {"a full turn of fixed shift", "dcm", "t2a250-4", 1, "CLKOUT_PHASE_SHIFT=FIXED PHASE_SHIFT=256", false,
         "Amount of phase shift should not exceed CLKIN period. Please enter a valid phase shift value.", {}},
        {"a negative turn is held to the limits instead", "dcm", "t5da1-1", 1,
         "CLKOUT_PHASE_SHIFT=FIXED PHASE_SHIFT=-256", false,
         "The phase shift value '-256' is outside the valid range of -179 to 179.  Please enter a valid phase shift "
         "value.",
         {}},
        {"DIRECT with a value", "dcm", "t5da1-1", 1, "CLKOUT_PHASE_SHIFT=DIRECT PHASE_SHIFT=40", true, "",
         {"When the DIRECT phase shift type is used, the starting phase shift value is always 0, regardless of the "
          "number specified in the Phase Shift 'Value' field.  The non-zero value for DIRECT mode can only be loaded "
          "to the DCM when a specific 'load phase shift value' command is given by Dynamic Reconfiguration.  Refer to "
          "the 'Dynamic Reconfiguration' section of the HW user guide fore more information."}},
        {"a phase shift type the primitive lacks", "dcm", "t5da1-1", 1, "CLKOUT_PHASE_SHIFT=VARIABLE", false,
         "'VARIABLE' is not a valid value of CLKOUT_PHASE_SHIFT for the DCM_ADV primitive.  Please choose one of the "
         "listed values.",
         {}},
        {"high frequency mode turns the phase shift off on Membra-3", "dcm", "m3s200-4", 1, Given([](SetupPage& p) {
             p.Apply("CLKOUT_PHASE_SHIFT=FIXED PHASE_SHIFT=10");
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_HF_Max")));
         }),
         true, "",
         {"Fixed or Variable phase shifting is not supported when the DFS/DLL frequency mode is set to high.  The "
          "phase shift will automatically be set to 'None'."},
         "CLKOUT_PHASE_SHIFT=NONE PHASE_SHIFT=0 DLL_FREQUENCY_MODE=HIGH"},
        {"second DCM without LOCKED or startup wait", "dcm_clkswitch", "t2a250-4", 2, "-LOCKED", true, "",
         {"LOCKED is not selected. It is essential to monitor LOCKED signal at all times to ensure that system "
          "flip-flops not be enabled until after the DCM that drives their clock input has locked.  To ensure that "
          "DCM is properly locked at startup, either the LOCKED signal must be monitored or the STARTUP_WAIT option "
          "must be used (setting available in Advanced dialog)."}},
        {"stepping 0 of a narrow device", "dcm", "m3e100-4", 1, "-CLK0 +CLKFX FB_SOURCE=NONE TESY_ONLY_CLKIN_VALUE=90.5",
         true, "",
         {"The Input Clock Frequency correctly falls within the Membra3E Stepping 1 valid range.  However, the Input "
          "Clock Frequency does not fall within the valid Membra3E Stepping 0 range of 5 - 90.  Please check the "
          "Datasheet.\n"}},
        {"DFS alone below the DLL range on Taldor-4", "dcm", "t4a25-10", 1, Given([dfsOnly](SetupPage& p) {
             p.Apply(dfsOnly);
             p.Set("TESY_ONLY_CLKIN_VALUE", fmt(p.Speed("CLKIN_FREQ_DLL_LF_MS_Min") / 2));
         }),
         true, "",
         {"Because only DFS clocks are used, but the input clock frequency is outside the DLL frequency range, a "
          "special macro should be used in order for the DCM_ADV to lock properly.  Please refer to Answer Record "
          "23624 for details."}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.what);
        SetupPage p(c.keyword, c.part, c.inst);
        c.setup(p);
        EXPECT_EQ(p.Next(), c.passes);
        const std::string error = c.errorOf ? c.errorOf(p) : c.error;
        EXPECT_EQ(p.Errors(), error.empty() ? std::vector<std::string>{} : std::vector<std::string>{error});
        for (const auto& n : c.notes)
            EXPECT_TRUE(Contains(p.Notes(), n)) << "missing note " << n;
        p.ExpectStored(c.stored);
    }
}

TEST(GeneralSetupValidation, NotesOnlyWhereTheirFamilyNeedsThem)
{
    struct Case {
        const char *part, *frequency;
        bool stepping, macro;
    } cases[] = {{"m3e100-4", "50", false, false}, {"m3e60-4", "100", false, false},
                 {"m3a200-4", "100", false, false}, {"m3e1600-4", "4.5", true, false},
                 {"t5da1-1", "10", false, false},   {"t4a25-10", "50", false, false}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.part);
        SetupPage p("dcm", c.part);
        p.Apply(std::string("-CLK0 +CLKFX FB_SOURCE=NONE TESY_ONLY_CLKIN_VALUE=") + c.frequency);
        EXPECT_TRUE(p.Next());
        bool stepping = false, macro = false;
        for (const auto& n : p.Notes()) {
            stepping = stepping || n.find("Stepping 0") != std::string::npos;
            macro = macro || n.find("special macro") != std::string::npos;
        }
        EXPECT_EQ(stepping, c.stepping);
        EXPECT_EQ(macro, c.macro);
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
    EXPECT_TRUE(p.Next());
    EXPECT_EQ(renamed->GetName().str(), "DCM_ADV_INST1");
    EXPECT_EQ(p.dcm->GetName().str(), "DCM_ADV_INST");
    EXPECT_TRUE(Contains(p.Notes(), "The specified DCM Instance Name is the same as the primitive name'DCM_ADV'.  "
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
        const char *keyword, *part;
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
            SCOPED_TRACE(std::string(c.part) + (batch ? " batch" : " window") + " answer " + std::to_string(c.answer));
            SetupPage p(c.keyword, c.part, c.inst, batch);
            if (c.inst == 1)
                p.Apply("CLKOUT_PHASE_SHIFT=FIXED PHASE_SHIFT=-10");
            else
                p.d.Wizard().GetActiveDCMBlk(1, false)->SetAttributeValue("STARTUP_WAIT", "TRUE");
            p.d.Stream().ScriptAnswers({c.answer});
            bool passed = p.Next();
            const std::vector<std::string> asked =
                c.question.empty() ? std::vector<std::string>{} : std::vector<std::string>{c.question};
            // Nobody to ask in a batch run: the question is a note and the run goes on.
            EXPECT_EQ(passed, batch || c.passes);
            EXPECT_EQ(p.Questions(), batch ? std::vector<std::string>{} : asked);
            if (batch) {
                EXPECT_EQ(Contains(p.Notes(), c.question), !c.question.empty());
            }
        }
    }
}

// ----------------------------------------------------------- phase shift

TEST(GeneralSetupPhaseShift, LimitsAndDisplayFollowTypeFamilyAndFrequency)
{
    struct Case {
        const char* part;
        const char* settings;
        int lowest, highest;
        double ns, degrees;
    } cases[] = {
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=100", -255, 255, 0, 0},
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=400", -255, 255, 0, 0},
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=5 PHASE_SHIFT=12", -12, 12, 9.375, 16.875},
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=200 FIN_UNITS=NS PHASE_SHIFT=-12", -12, 12, -9.375,
         -16.875},
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=10 CLKIN_DIVIDE_BY_2=TRUE", -12, 12, 0, 0},
        {"t2a250-4", "CLKOUT_PHASE_SHIFT=VARIABLE TESY_ONLY_CLKIN_VALUE=100 PHASE_SHIFT=64", -128, 128, 2.5, 90},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_SPEED CLKOUT_PHASE_SHIFT=FIXED", -179, 179, 0, 0},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_RANGE CLKOUT_PHASE_SHIFT=FIXED", -255, 255, 0, 0},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_SPEED CLKOUT_PHASE_SHIFT=VARIABLE_CENTER", -76, 76, 0, 0},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_RANGE CLKOUT_PHASE_SHIFT=VARIABLE_CENTER", -128, 128, 0, 0},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_SPEED CLKOUT_PHASE_SHIFT=VARIABLE_POSITIVE", 0, 179, 0, 0},
        {"t5da1-1", "DCM_PERFORMANCE_MODE=MAX_SPEED CLKOUT_PHASE_SHIFT=DIRECT PHASE_SHIFT=40", 0, 1023, 1.0, 36},
        {"m3e100-4", "CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_CLKIN_VALUE=5", -255, 255, 0, 0},
        {"m3e100-4", "CLKOUT_PHASE_SHIFT=VARIABLE_CENTER TESY_ONLY_CLKIN_VALUE=5", -12, 12, 0, 0},
        {"m3e100-4", "CLKOUT_PHASE_SHIFT=VARIABLE_POSITIVE TESY_ONLY_CLKIN_VALUE=5", 0, 12, 0, 0},
        {"m3s200-4", "CLKOUT_PHASE_SHIFT=VARIABLE TESY_ONLY_CLKIN_VALUE=50", -64, 64, 0, 0},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.part) + " " + c.settings);
        SetupPage p("dcm", c.part);
        p.Apply(std::string("TESY_ONLY_CLKIN_VALUE=100 FIN_UNITS=MHZ CLKIN_DIVIDE_BY_2=FALSE PHASE_SHIFT=0 ") +
                c.settings);
        ASSERT_TRUE(p.page->LoadFromBlock());
        EXPECT_EQ(p.page->GetPsLowest(), c.lowest);
        EXPECT_EQ(p.page->GetPsHighest(), c.highest);
        EXPECT_NEAR(p.page->GetPsNs(), c.ns, 1e-4);
        EXPECT_NEAR(p.page->GetPsDegrees(), c.degrees, 1e-4);
    }
}

// ----------------------------------------------------------------- store

TEST(GeneralSetupStore, DerivedAttributesByFamilyAndMode)
{
    struct Case {
        const char *part, *input, *dll, *dfs, *validDfs, *jf, *simDevice;
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
        SCOPED_TRACE(std::string(c.part) + " " + c.input);
        SetupPage p("dcm", c.part);
        p.Set("TESY_ONLY_CLKIN_VALUE", c.input);
        ASSERT_TRUE(p.Next()) << p.FirstError();
        EXPECT_EQ(p.Attr("DLL_FREQUENCY_MODE"), c.dll);
        EXPECT_EQ(p.Attr("DFS_FREQUENCY_MODE"), c.dfs);
        EXPECT_EQ(p.Attr("TESY_ONLY_VALID_DFS_MODE"), c.validDfs);
        EXPECT_EQ(p.Attr("FACTORY_JF"), c.jf);
        EXPECT_EQ(p.Attr("SIM_DEVICE"), c.simDevice);
        const bool gen45 = c.part[0] == 't' && (c.part[1] == '4' || c.part[1] == '5');
        EXPECT_EQ(p.Attr("DCM_AUTOCALIBRATION"), gen45 ? "TRUE" : "");
        EXPECT_EQ(p.Attr("DCM_PERFORMANCE_MODE"), gen45 ? "MAX_SPEED" : "");
    }
}

TEST(GeneralSetupStore, InputPeriodUnitsAndTheDivider)
{
    SetupPage p("dcm", "t2a250-4");
    p.Apply("TESY_ONLY_CLKIN_VALUE=200 FIN_UNITS=NS FOUT_UNITS=MHZ CLKIN_DIVIDE_BY_2=TRUE");
    ASSERT_TRUE(p.page->LoadFromBlock());
    EXPECT_FLOAT_EQ(p.page->GetInputFrequency(), 2.5f);
    ASSERT_TRUE(p.page->StoreToBlock(false)) << "Back stores whatever the content";
    p.ExpectStored("CLKIN_PERIOD=400.000 TESY_ONLY_CLKIN_VALUE=200 FIN_UNITS=NS");
    EXPECT_EQ(p.Attr("FOUT_UNITS"), "MHZ") << "a loaded design keeps its output units";

    SetupPage fresh("dcm", "t2a250-4", 1, true, false);
    fresh.Apply("FOUT_UNITS=NS TESY_ONLY_CLKIN_VALUE=8");
    ASSERT_TRUE(fresh.Next());
    EXPECT_EQ(fresh.Attr("FOUT_UNITS"), "MHZ") << "a new design's output units follow the input's";
    EXPECT_EQ(fresh.Attr("TESY_ONLY_CLKIN_VALUE"), "100") << "the default setup starts at 100";

    for (const char* empty : {"0", ".", "abc"}) {
        SCOPED_TRACE(empty);
        SetupPage z("dcm", "t2a250-4");
        z.Set("TESY_ONLY_CLKIN_VALUE", empty);
        ASSERT_TRUE(z.page->LoadFromBlock());
        EXPECT_EQ(z.page->GetInputFrequency(), 0.0f);
        EXPECT_TRUE(z.page->StoreToBlock(false));
        EXPECT_EQ(z.Attr("CLKIN_PERIOD"), "0.000");
    }
}

TEST(GeneralSetupStore, PinsFollowTheSettings)
{
    const char* const dependent[] = {"PSEN", "PSINCDEC", "PSCLK", "PSDONE", "DADDR", "DI",
                                     "DWE",  "DEN",      "DCLK",  "DRDY",   "DO",    "CLKFB"};
    SetupPage p("dcm", "t5da1-1");
    p.Apply("CLKOUT_PHASE_SHIFT=VARIABLE_POSITIVE TESY_ONLY_RECONFIG_PINS=TRUE +CLKFX");
    ASSERT_TRUE(p.Next()) << p.FirstError();
    for (const char* pin : dependent)
        EXPECT_TRUE(p.PinOn(pin)) << pin;
    EXPECT_TRUE(p.PinOn("CLKFX"));
    EXPECT_EQ(p.Attr("TSY_CLK_OUTPUT_TYPE"), "DLL_AND_FX");

    // The status box unticked, no shift, no loop.
    p.Apply("CLKOUT_PHASE_SHIFT=FIXED TESY_ONLY_RECONFIG_PINS=FALSE FB_SOURCE=NONE -CLK0 -DO");
    ASSERT_TRUE(p.Next()) << p.FirstError();
    for (const char* pin : dependent)
        EXPECT_FALSE(p.PinOn(pin)) << pin;
    EXPECT_FALSE(p.PinOn("CLK0"));
    p.ExpectStored("TSY_CLK_OUTPUT_TYPE=FX CLK_FEEDBACK=NONE");
}

TEST(GeneralSetupStore, TheFeedbackBufferFollowsTheLoop)
{
    SetupPage p("dcm", "t2a250-4");
    p.Apply("CLK0.TSY_CLKBUFTYPE1=BUFGCE CLK0.TSY_CLKBUF1_O_SIGNAME=fast_clk");
    ASSERT_TRUE(p.Next());
    p.ExpectStored("CLK0.TSY_CLKBUFTYPE2=BUFG CLK0.TSY_CLKBUFTYPE2_NOEDIT=FEEDBACK_BUF");
    ASSERT_TRUE(p.Next()) << "a second Next adds no second feedback buffer";
    p.ExpectStored("CLK0.TSY_CLKBUFTYPE3=");

    // A 2X loop: the feedback buffer moves; the user's own buffer stays.
    p.Set("CLK_FEEDBACK", "2X");
    ASSERT_TRUE(p.Next());
    p.ExpectStored("CLK2X.TSY_CLKBUFTYPE1=BUFG CLK2X.TSY_CLKBUFTYPE1_NOEDIT=FEEDBACK_BUF CLK0.TSY_CLKBUFTYPE1=BUFGCE "
                   "CLK0.TSY_CLKBUFTYPE2=");
    EXPECT_TRUE(p.PinOn("CLK2X"));

    // A feedback buffer ahead of the user's: the list closes up behind it.
    p.dcm->GetNamedPin("CLK0")->RemoveAllPropsWBase("TSY_CLKBUF");
    p.Apply("CLK0.TSY_CLKBUFTYPE1=BUFG CLK0.TSY_CLKBUFTYPE1_NOEDIT=FEEDBACK_BUF CLK0.TSY_CLKBUFTYPE2=BUFGMUX "
            "CLK0.TSY_CLKBUF2_O_SIGNAME=muxed CLK0.TSY_CLKBUFTYPE12=BUFG FB_SOURCE=EXTERNAL");
    ASSERT_TRUE(p.Next());
    p.ExpectStored("CLK0.TSY_CLKBUFTYPE1=BUFGMUX CLK0.TSY_CLKBUF1_O_SIGNAME=muxed CLK0.TSY_CLKBUFTYPE1_NOEDIT= "
                   "CLK0.TSY_CLKBUFTYPE11=BUFG CLK0.TSY_CLKBUFTYPE12=");
    p.ExpectStored("CLK2X.TSY_CLKBUFTYPE1="); // no loop, no feedback buffer
}

TEST(GeneralSetupStore, ResetLogicNeedsRstAndPmcdFollowsAvailability)
{
    SetupPage noRst("dcm", "t2a250-4");
    noRst.Apply("TESY_ONLY_RESET_LOGIC=TRUE -RST");
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

TEST(GeneralSetupBatch, EveryFamilyStoresTheDefaultSetup)
{
    for (const char* part : {"t2a40-4", "qt2a250-4", "qrt2a1000-4", "t2p7-5", "qt2p20-5", "m3s50-4", "am3s200-4",
                             "m3e100-4", "m3a50-4", "m3an50-4", "am3e100-4", "t4a15-10", "qt4a25-10", "qrt4a60-10",
                             "t5da1-1"}) {
        SCOPED_TRACE(part);
        GenerateRun r = Generate(std::string("--wizard dcm --part ") + part);
        ASSERT_EQ(r.result.status, 0) << r.result.err;
        EXPECT_EQ(r.DcmAttr("CLKIN_PERIOD"), "10.000");
        EXPECT_EQ(r.DcmAttr("TESY_ONLY_CLKIN_VALUE"), "100");
        EXPECT_EQ(r.DcmAttr("CLK_FEEDBACK"), "1X");
        EXPECT_TRUE(r.DcmPinOn("CLK0"));
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
        SCOPED_TRACE(std::string(c.part) + " " + c.args);
        SetupPage figures("dcm", c.part);
        std::string expected = c.message(figures);
        while (!expected.empty() && expected.back() == '\n')
            expected.pop_back();
        GenerateRun r = Generate(std::string("--wizard dcm --part ") + c.part + " " + c.args);
        EXPECT_EQ(r.result.status, 1) << r.result.err;
        EXPECT_NE(r.result.err.find("ERROR: " + expected + "\n"), std::string::npos) << r.result.err;
        size_t errors = 0;
        for (size_t at = r.result.err.find("ERROR: "); at != std::string::npos; at = r.result.err.find("ERROR: ", at + 1))
            ++errors;
        EXPECT_EQ(errors, 1u) << r.result.err;
        EXPECT_FALSE(r.Written());
    }
}
