// The wizard object: wizard types, page sets, the active-block lookups, name
// prefixes, the shared page helpers and the routing of Finish.

#include "support/TestDesign.h"
#include "wizard/Tsy_DCMwizPage.h"
#include "wizard/Tsy_PageSets.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

TEST(WizardTypes, KeywordsCompareWithoutCase)
{
    struct Case {
        const char* keyword;
        int type;
    } cases[] = {
        {"dcm", 1},         {"dcm_bddeskew", 2}, {"dcm_clkfwd", 3}, {"dcm_clkswitch", 4}, {"dcm_cascading", 5},
        {"dcm_pll", 6},     {"DCM_PLL", 6},      {"dcm_dcm2pll", 7}, {"Dcm_Pll2Dcm", 8},  {"pll", 0},
        {"", 0},            {"dcm ", 0},
    };
    for (const auto& c : cases)
        EXPECT_EQ(Tsy_DCMwiz::ConvertWizTypeStr(c.keyword), c.type) << "'" << c.keyword << "'";
}

TEST(WizardTypes, PageSetsNameEveryPageInOrder)
{
    struct Case {
        int type;
        std::vector<std::string> names;
    } cases[] = {
        {1, {"General Setup", "Phase-Matched Clock Divider", "Clock Buffers", "Clock Frequency Synthesizer"}},
        {2,
         {"Board Deskew With An Internal Deskew", "General Setup for INST1", "Clock Buffers for INST1",
          "Clock Frequency Synthesizer for INST1", "General Setup for INST2", "Clock Buffers for INST2",
          "Clock Frequency Synthesizer for INST2"}},
        {3, {"Clock Forwarding / Board Deskew", "General Setup", "Clock Buffers", "Clock Frequency Synthesizer"}},
        {4,
         {"Clock Switching With Two DCMs", "General Setup for INST1", "Clock Buffers for INST1",
          "Clock Frequency Synthesizer for INST1", "General Setup for INST2", "Clock Buffers for INST2",
          "Clock Frequency Synthesizer for INST2"}},
        {5,
         {"Cascading", "General Setup for INST1", "Clock Buffers for INST1", "Clock Frequency Synthesizer for INST1",
          "General Setup for INST2", "Clock Buffers for INST2", "Clock Frequency Synthesizer for INST2"}},
        {6, {"PLL General Setup", "PLL Output Clock Settings", "Clock Buffers"}},
        {7,
         {"Filter DCM Output Clock", "General Setup", "Clock Frequency Synthesizer", "PLL General Setup",
          "PLL Output Clock Settings", "Clock Buffers"}},
        {8,
         {"Filter DCM Input Clock", "PLL General Setup", "PLL Output Clock Settings", "General Setup",
          "Clock Buffers", "Clock Frequency Synthesizer"}},
        {0, {}},
    };
    for (const auto& c : cases) {
        int count = -1;
        const Tsy_PageSlot* slots = Tsy_PageSetOf(c.type, count);
        ASSERT_EQ(count, static_cast<int>(c.names.size())) << "type " << c.type;
        for (int i = 0; i < count; ++i)
            EXPECT_EQ(slots[i].name, c.names[static_cast<size_t>(i)]) << "type " << c.type << " page " << i;
    }
    int count = 0;
    const Tsy_PageSlot* deskew = Tsy_PageSetOf(2, count);
    EXPECT_EQ(deskew[0].instance, 0);
    EXPECT_EQ(deskew[4].kind, Tsy_PageKind::GeneralSetup);
    EXPECT_EQ(deskew[4].instance, 2);
}

TEST(WizardTypes, UnknownKeywordHasNoPagesButStillFinishes)
{
    TestDesign d("nonsense", "t5da1-1");
    d.Instantiate();
    EXPECT_EQ(d.Wizard().GetWizTypeInt(), 0);
    EXPECT_EQ(d.Wizard().GetPage(0), nullptr);
    EXPECT_EQ(d.Wizard().GetPageName(0), "");
    EXPECT_EQ(d.Wizard().Finish(), 0) << "type 0 runs the DCM design";
}

TEST(WizardTypes, FinishFailsWithoutADesignToBuild)
{
    Tsy_DCMwiz wiz("dcm", true);
    wiz.InstantiatePages();
    EXPECT_EQ(wiz.Finish(), -1);
}

TEST(WizardTypes, FactoryBuildsOnlyWhatThisBuildCanFinish)
{
    std::unique_ptr<Tsy_WizMain> dcm(pendra_create_wizard("dcm", true));
    ASSERT_NE(dcm, nullptr);
    EXPECT_NE(dynamic_cast<Tsy_DCMwiz*>(dcm.get()), nullptr);
    EXPECT_EQ(std::unique_ptr<Tsy_WizMain>(pendra_create_wizard("nonsense", true)), nullptr);
    EXPECT_EQ(std::unique_ptr<Tsy_WizMain>(pendra_create_wizard(nullptr, true)), nullptr);
}

TEST(DcmPrefix, SingleDcmTypesKeepNames)
{
    struct Case {
        const char* keyword;
        int which;
        const char* expected;
    } cases[] = {
        {"dcm", 1, "CLKIN_IN"},          {"dcm_clkfwd", 2, "CLKIN_IN"},     {"dcm_bddeskew", 1, "U1_CLKIN_IN"},
        {"dcm_bddeskew", 2, "U2_CLKIN_IN"}, {"dcm_clkswitch", 1, "U1_CLKIN_IN"}, {"dcm_cascading", 2, "U2_CLKIN_IN"},
        {"dcm_pll", 1, "U1_CLKIN_IN"},   {"dcm_dcm2pll", 3, "PLL_CLKIN_IN"}, {"dcm_pll2dcm", 0, "CLKIN_IN"},
        {"dcm_bddeskew", 4, "CLKIN_IN"}, {"nonsense", 1, "U1_CLKIN_IN"},
    };
    for (const auto& c : cases) {
        Tsy_DCMwiz wiz(c.keyword, true);
        EXPECT_EQ(wiz.AddDCMPrefix("CLKIN_IN", c.which), c.expected) << c.keyword << " " << c.which;
    }
}

TEST(ActiveBlocks, SingleDcmWizardEditsTheTemplate)
{
    TestDesign d("dcm", "t5da1-1");
    d.Instantiate();
    Tsy_Block* dcm = d.Wizard().GetActiveDCMBlk(1, true);
    ASSERT_NE(dcm, nullptr);
    EXPECT_EQ(dcm->GetName(), "DCM_ADV_INST");
    EXPECT_TRUE(dcm->IsTemplate());
    dcm->active = true;
    EXPECT_EQ(d.Wizard().GetActiveDCMBlk(2, true), dcm) << "single-DCM types ignore the instance";
}

TEST(ActiveBlocks, TwoDcmWizardCopiesTheTemplatePerInstance)
{
    TestDesign d("dcm_bddeskew", "t5da1-1");
    d.Instantiate();
    Tsy_Block* second = d.Wizard().GetActiveDCMBlk(2, true);
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(second->GetName(), "DCM_ADV_INST2");
    EXPECT_EQ(second->GetAttributeValue("TESY_ONLY_INST_NUM"), "2");
    EXPECT_TRUE(second->active);
    EXPECT_EQ(d.Wizard().GetActiveDCMBlk(2, true), second);
    Tsy_Block* first = d.Wizard().GetActiveDCMBlk(1, true);
    ASSERT_NE(first, nullptr);
    EXPECT_EQ(first->GetName(), "DCM_ADV_INST1");
    EXPECT_NE(first, second);
}

TEST(ActiveBlocks, OlderDcmPrimitivesAreConverted)
{
    // A design made for a DCM family, opened on a DCM_SP family.
    TestDesign d("dcm", "m3e100-4");
    d.Instantiate();
    Tsy_Block* old = d.Data().AddBlock("MY_DCM", "DCM");
    old->FillFromDefinition();
    old->SetAttributeValue("CLKIN_PERIOD", "20.000");
    Tsy_Block* dcm = d.Wizard().GetActiveDCMBlk(1, true);
    ASSERT_EQ(dcm, old);
    EXPECT_EQ(dcm->GetType(), "DCM_SP");
    EXPECT_EQ(dcm->GetAttributeValue("CLKIN_PERIOD"), "20.000");
}

TEST(ActiveBlocks, MissingDcmIsReported)
{
    TestDesign d("dcm", "t5da1-1");
    d.Instantiate();
    d.Configure([](Tsy_WizContext& c) { c.dcmPrimName = "DCM_SP"; });
    EXPECT_EQ(d.Wizard().GetActiveDCMBlk(1, true), nullptr);
    EXPECT_EQ(d.Stream().Errors(), std::vector<StringBase>{"DCM block not found."});
}

TEST(ActiveBlocks, PllIsTheTemplateMadeActive)
{
    TestDesign d("dcm_pll", "t5da1-1");
    d.Instantiate();
    Tsy_Block* pll = d.Wizard().GetActivePLLBlk(true);
    ASSERT_NE(pll, nullptr);
    EXPECT_EQ(pll->GetName(), "PLL_ADV_INST");
    EXPECT_TRUE(pll->active);

    TestDesign noPll("dcm_pll", "t2p7-5");
    noPll.Instantiate();
    EXPECT_EQ(noPll.Wizard().GetActivePLLBlk(false), nullptr);
    EXPECT_TRUE(noPll.Stream().Entries().empty()) << "no message unless asked for";
    EXPECT_EQ(noPll.Wizard().GetActivePLLBlk(true), nullptr);
    EXPECT_EQ(noPll.Stream().Errors(), std::vector<StringBase>{"PLL block not found."});
}

TEST(ActiveBlocks, PmcdInstances)
{
    TestDesign d("dcm", "t5da1-1");
    d.Instantiate();
    Tsy_Block* single = d.Wizard().GetActivePMCDBlk(0);
    ASSERT_NE(single, nullptr);
    EXPECT_EQ(single->GetName(), "PMCD_INST");
    EXPECT_TRUE(single->active);
    Tsy_Block* second = d.Wizard().GetActivePMCDBlk(2);
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(second->GetName(), "PMCD_INST2");
    EXPECT_EQ(second->GetAttributeValue("TESY_ONLY_INST_NUM"), "2");
    EXPECT_TRUE(second->active);
    EXPECT_FALSE(single->active) << "the primitive steps back for the copies";
    EXPECT_EQ(d.Wizard().GetActivePMCDBlk(2), second);
    EXPECT_EQ(d.Wizard().GetActivePMCDBlk(3), nullptr);
}

TEST(PageHelpers, ApplicationClockOutputs)
{
    TestDesign d("dcm_bddeskew", "t5da1-1");
    d.Instantiate();
    Tsy_Block* b = d.Wizard().GetActiveDCMBlk(1, true);
    struct Case {
        int type;
        const char* inst;
        std::vector<std::pair<const char*, const char*>> attrs;
        bool ddrClockOnly;
        const char* first;
        const char* second;
    } cases[] = {
        {3, "1", {{"TESY_ONLY_DDR_C0", "CLK0"}, {"TESY_ONLY_DDR_C1", "CLK180"}}, false, "CLK0", "CLK180"},
        {3, "1", {{"TESY_ONLY_DDR_C0", "CLKFX"}, {"TESY_ONLY_DDR_C1", "INVERSION"}}, false, "CLKFX", ""},
        {2, "1", {{"TESY_ONLY_DDR_C0", "CLK2X"}, {"TESY_ONLY_DDR_C1", "CLK2X180"}}, false, "CLK2X", "CLK2X180"},
        {2, "2", {{"TESY_ONLY_DDR_C0", "CLK2X"}}, false, "", ""},
        {3, "1", {{"TESY_ONLY_DDR_CLK", "CLK90"}}, true, "CLK90", ""},
        {4, "2", {{"TESY_ONLY_DCM_SWITCHING_CLK", "CLKDV"}}, false, "CLKDV", ""},
        {5, "1", {{"TESY_ONLY_CASCADING_CLK", "CLK2X"}}, false, "CLK2X", ""},
        {5, "2", {{"TESY_ONLY_CASCADING_CLK", "CLK2X"}}, false, "", ""},
        {7, "1", {{"TSY_DCM2PLL_CLKOUT", "CLKFX"}}, false, "CLKFX", ""},
        {1, "1", {{"TESY_ONLY_DDR_C0", "CLK0"}}, false, "", ""},
    };
    for (const auto& c : cases) {
        b->SetAttributeValue("TESY_ONLY_INST_NUM", c.inst);
        b->SetAttributeValue("TESY_ONLY_DDR_C1", "");
        for (const auto& a : c.attrs)
            b->SetAttributeValue(a.first, a.second);
        StringBase first, second;
        Tsy_DCMwizPage::GetApplicationClockOutputs(b, c.type, c.ddrClockOnly, first, second);
        EXPECT_EQ(first, c.first) << "type " << c.type;
        EXPECT_EQ(second, c.second) << "type " << c.type;
    }
}

TEST(PageHelpers, FeedbackSharedWithApplicationClock)
{
    TestDesign d("dcm_bddeskew", "t5da1-1");
    d.Instantiate();
    Tsy_Block* b = d.Wizard().GetActiveDCMBlk(1, true);
    struct Case {
        int type;
        const char* source;
        const char* feedback;
        const char* attr;
        const char* value;
        bool shared;
    } cases[] = {
        {4, "INTERNAL", "1X", "TESY_ONLY_DCM_SWITCHING_CLK", "CLK0", true},
        {4, "EXTERNAL", "1X", "TESY_ONLY_DCM_SWITCHING_CLK", "CLK0", false},
        {4, "INTERNAL", "2X", "TESY_ONLY_DCM_SWITCHING_CLK", "CLK0", false},
        {3, "INTERNAL", "2X", "TESY_ONLY_DDR_C0", "CLK2X", true},
        {3, "INTERNAL", "1X", "TESY_ONLY_DDR_CLK", "CLK0", true},
        {5, "INTERNAL", "1X", "TESY_ONLY_CASCADING_CLK", "CLK0", true},
        {1, "INTERNAL", "1X", "TESY_ONLY_CASCADING_CLK", "CLK0", false},
    };
    for (const auto& c : cases) {
        for (const char* a : {"TESY_ONLY_DCM_SWITCHING_CLK", "TESY_ONLY_DDR_C0", "TESY_ONLY_DDR_CLK",
                              "TESY_ONLY_CASCADING_CLK"})
            b->SetAttributeValue(a, "");
        b->SetAttributeValue("FB_SOURCE", c.source);
        b->SetAttributeValue("CLK_FEEDBACK", c.feedback);
        b->SetAttributeValue(c.attr, c.value);
        EXPECT_EQ(Tsy_DCMwizPage::IsFeedbackSharedWithAppClock(b, c.type), c.shared)
            << "type " << c.type << " " << c.source << " " << c.feedback << " " << c.attr;
    }
    b->SetAttributeValue("TESY_ONLY_INST_NUM", "2");
    b->SetAttributeValue("FB_SOURCE", "INTERNAL");
    b->SetAttributeValue("CLK_FEEDBACK", "1X");
    b->SetAttributeValue("TESY_ONLY_CASCADING_CLK", "CLK0");
    EXPECT_FALSE(Tsy_DCMwizPage::IsFeedbackSharedWithAppClock(b, 5)) << "only the first DCM of a cascade";
}

TEST(PageHelpers, HighestBufferIndexReadsTheWholeNumber)
{
    TestDesign d("dcm", "t5da1-1");
    d.Instantiate();
    Tsy_Pin* pin = d.Wizard().GetActiveDCMBlk(1, true)->GetNamedPin("CLK0");
    EXPECT_EQ(Tsy_DCMwizPage::GetHighestBufferIndex(pin), 0);
    pin->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFG");
    pin->SetAttributeValue("TSY_CLKBUFTYPE3", "BUFG");
    pin->SetAttributeValue("TSY_CLKBUFTYPE3_NOEDIT", "ENABLED_BUF");
    EXPECT_EQ(Tsy_DCMwizPage::GetHighestBufferIndex(pin), 3);
    pin->SetAttributeValue("TSY_CLKBUFTYPE12", "BUFGCE");
    EXPECT_EQ(Tsy_DCMwizPage::GetHighestBufferIndex(pin), 12);
    pin->SetAttributeValue("TSY_CLKBUFTYPE99_NOEDIT", "ENABLED_BUF");
    EXPECT_EQ(Tsy_DCMwizPage::GetHighestBufferIndex(pin), 12) << "markers alone are not buffers";
    EXPECT_EQ(Tsy_DCMwizPage::GetHighestBufferIndex(nullptr), 0);
}

TEST(Targets, BatchSettingsNameBlocksThroughTheWizard)
{
    struct Case {
        const char* keyword;
        const char* target;
        const char* block; // empty: refused
    } cases[] = {
        {"dcm", "dcm", "DCM_ADV_INST"},        {"dcm", "DCM1", "DCM_ADV_INST"},
        {"dcm", "dcm2", ""},                   {"dcm", "pll", ""},
        {"dcm", "pmcd", "PMCD_INST"},          {"dcm", "pmcd2", "PMCD_INST2"},
        {"dcm", "frobnicator", ""},            {"dcm_cascading", "dcm2", "DCM_ADV_INST2"},
        {"dcm_cascading", "pmcd", ""},         {"dcm_pll", "pll", "PLL_ADV_INST"},
        {"dcm_pll", "dcm", ""},
    };
    for (const auto& c : cases) {
        TestDesign d(c.keyword, "t5da1-1");
        d.Instantiate();
        StringBase reason;
        Tsy_Block* b = d.Wizard().ResolveTarget(c.target, reason);
        if (*c.block) {
            ASSERT_NE(b, nullptr) << c.keyword << " " << c.target << ": " << reason;
            EXPECT_EQ(b->GetName(), c.block);
        } else {
            EXPECT_EQ(b, nullptr) << c.keyword << " " << c.target;
            EXPECT_FALSE(reason.IsEmpty());
        }
    }
}
