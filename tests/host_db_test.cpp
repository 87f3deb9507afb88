// The design database: template blocks, lookups by name, type and instance
// number, conversion and copies, attributes, pins and signals.

#include "db/Tsy_WizData.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "run/Tsy_HostSession.h"

#include <gtest/gtest.h>

namespace {

std::unique_ptr<Tsy_WizData> designFor(const char* part)
{
    Tsy_PartInfo info;
    EXPECT_TRUE(Tsy_DeviceCatalog::Instance().FindPart(part, info)) << part;
    return Tsy_NewDesignFor(info);
}

} // namespace

TEST(WizData, NewDesignHoldsOneInactiveTemplatePerClockPrimitive)
{
    struct Case {
        const char* part;
        std::vector<const char*> templates;
    } cases[] = {
        {"t5da1-1", {"DCM_ADV_INST", "PLL_ADV_INST", "PMCD_INST"}},
    };
    for (const auto& c : cases) {
        auto db = designFor(c.part);
        ASSERT_EQ(db->Blocks().size(), c.templates.size()) << c.part;
        for (const char* name : c.templates) {
            Tsy_Block* b = db->GetNamedBlock(name);
            ASSERT_NE(b, nullptr) << name;
            EXPECT_FALSE(b->active);
            EXPECT_TRUE(b->IsTemplate());
            EXPECT_EQ(db->GetPrimitiveBlock(b->GetType()), b);
        }
    }
}

TEST(WizData, DcmTemplateStartsAsTheDefaultDesign)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* dcm = db->GetPrimitiveBlock("DCM_ADV");
    ASSERT_NE(dcm, nullptr);
    for (const char* pin : {"CLKIN", "CLKFB", "RST", "CLK0", "LOCKED"})
        EXPECT_TRUE(dcm->GetNamedPin(pin) && dcm->GetNamedPin(pin)->IsActive()) << pin;
    for (const char* pin : {"CLK90", "CLKFX", "PSEN"})
        EXPECT_TRUE(dcm->GetNamedPin(pin) && !dcm->GetNamedPin(pin)->IsActive()) << pin;
    EXPECT_EQ(dcm->GetAttributeValue("FB_SOURCE"), "INTERNAL");
    EXPECT_EQ(dcm->GetAttributeValue("CLK_FEEDBACK"), "1X");
    EXPECT_EQ(dcm->GetNamedPin("DADDR")->GetWidth(), 7);
}

TEST(WizData, LookupsFindNothingWithoutACandidate)
{
    auto db = designFor("t5da1-1");
    EXPECT_EQ(db->GetNamedBlock("NOPE"), nullptr);
    EXPECT_EQ(db->GetNamedSignal("NOPE"), nullptr);
    EXPECT_EQ(db->GetActiveBlock("DCM_ADV"), nullptr);
    EXPECT_EQ(db->GetActiveBlockInstNum("DCM_ADV", 1), nullptr);
    EXPECT_EQ(db->GetBlockInstNum("DCM_ADV", 1), nullptr);
    EXPECT_EQ(db->GetPrimitiveBlock("DCM_SP"), nullptr);
    EXPECT_EQ(db->ConvertActiveBlk("DCM_SP", "DCM_ADV", 0), nullptr);
}

TEST(WizData, CopiesAreFoundByInstanceNumber)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* tmpl = db->GetPrimitiveBlock("DCM_ADV");
    Tsy_Block* copy = db->CopyBlock(tmpl, "DCM_ADV_INST2");
    ASSERT_NE(copy, nullptr);
    EXPECT_FALSE(copy->IsTemplate());
    EXPECT_FALSE(copy->active);
    copy->SetAttributeValue("TESY_ONLY_INST_NUM", "2");
    EXPECT_EQ(db->GetBlockInstNum("DCM_ADV", 2), copy);
    EXPECT_EQ(db->GetActiveBlockInstNum("DCM_ADV", 2), nullptr);
    copy->active = true;
    EXPECT_EQ(db->GetActiveBlockInstNum("DCM_ADV", 2), copy);
    EXPECT_EQ(db->GetActiveBlock("DCM_ADV"), copy);
    // The copy's pins belong to the copy.
    EXPECT_EQ(copy->GetNamedPin("CLK0")->GetBlock(), copy);
    copy->GetNamedPin("CLK0")->SetIsActive(false);
    EXPECT_TRUE(tmpl->GetNamedPin("CLK0")->IsActive());
    // A name held by an active block is not free.
    EXPECT_EQ(db->CopyBlock(tmpl, "DCM_ADV_INST2"), nullptr);
}

TEST(WizData, ConversionKeepsWhatBothPrimitivesShare)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* dcm = db->AddBlock("MY_DCM", "DCM");
    dcm->FillFromDefinition();
    dcm->SetAttributeValue("TESY_ONLY_INST_NUM", "1");
    dcm->SetAttributeValue("CLKIN_PERIOD", "5.000");
    dcm->SetAttributeValue("TSY_CLK_OUTPUT_TYPE", "DLL");
    dcm->GetNamedPin("CLK90")->SetIsActive(true);
    Tsy_Block* adv = db->ConvertActiveBlk("DCM", "DCM_ADV", 1);
    ASSERT_EQ(adv, dcm);
    EXPECT_EQ(adv->GetType(), "DCM_ADV");
    EXPECT_EQ(adv->GetAttributeValue("CLKIN_PERIOD"), "5.000");
    EXPECT_EQ(adv->GetAttributeValue("TSY_CLK_OUTPUT_TYPE"), "DLL");
    EXPECT_TRUE(adv->GetNamedPin("CLK90")->IsActive());
    EXPECT_NE(adv->GetNamedPin("DADDR"), nullptr);
    EXPECT_EQ(adv->GetNamedPin("STATUS"), nullptr);
    EXPECT_NE(adv->GetNamedAttribute("DCM_PERFORMANCE_MODE"), nullptr);
}

TEST(WizData, AddBlockReplacesOnlyInactiveBlocks)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* first = db->AddBlock("CLK0_BUFG_INST", "BUFG");
    ASSERT_NE(first, nullptr);
    EXPECT_TRUE(first->active);
    EXPECT_TRUE(first->IsGenerated());
    EXPECT_TRUE(first->Pins().empty());
    EXPECT_EQ(db->AddBlock("CLK0_BUFG_INST", "BUFG"), nullptr);
    EXPECT_EQ(db->AddBlock("DCM_ADV_INST", "BUFG"), nullptr) << "a template is never replaced";
    first->active = false;
    Tsy_Block* second = db->AddBlock("CLK0_BUFG_INST", "BUFG");
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(db->GetNamedBlock("CLK0_BUFG_INST"), second);
    size_t named = 0;
    for (const auto& b : db->Blocks())
        named += b->GetName() == "CLK0_BUFG_INST";
    EXPECT_EQ(named, 1u);
}

TEST(WizData, AttributesKeepOrderValueAndActivity)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* dcm = db->GetPrimitiveBlock("DCM_ADV");
    EXPECT_EQ(dcm->GetAttributeValue("NOT_THERE"), "");
    EXPECT_TRUE(dcm->SetAttributeValue("TSY_NEW", "1"));
    EXPECT_EQ(dcm->GetAttributeValue("TSY_NEW"), "1");
    EXPECT_TRUE(dcm->SetAttributeIsActive("TSY_NEW", false));
    EXPECT_FALSE(dcm->GetNamedAttribute("TSY_NEW")->IsActive());
    dcm->AddAttribute("TSY_NEW", "2");
    EXPECT_TRUE(dcm->GetNamedAttribute("TSY_NEW")->IsActive());
    EXPECT_TRUE(dcm->RemoveAttribute("TSY_NEW"));
    EXPECT_FALSE(dcm->RemoveAttribute("TSY_NEW"));
    EXPECT_FALSE(dcm->SetAttributeIsActive("TSY_NEW", true));

    Tsy_Pin* clk0 = dcm->GetNamedPin("CLK0");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFG");
    clk0->SetAttributeValue("TSY_CLKBUFTYPE1_NOEDIT", "FEEDBACK_BUF");
    clk0->SetAttributeValue("TSY_CLKBUF1_O_SIGNAME", "X");
    clk0->SetAttributeValue("TSY_CLKMUX_I1", "CLK90");
    EXPECT_EQ(clk0->RemoveAllPropsWBase("TSY_CLKBUFTYPE1"), 2);
    ASSERT_EQ(clk0->Attributes().size(), 2u);
    EXPECT_EQ(clk0->Attributes()[0]->GetName(), "TSY_CLKBUF1_O_SIGNAME");
}

TEST(WizData, DefinitionsGiveValueListsAndRanges)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* dcm = db->GetPrimitiveBlock("DCM_ADV");
    Tsy_StrArray dv = dcm->GetNamedAttribute("CLKDV_DIVIDE")->GetValueList();
    EXPECT_TRUE(dv.Contains("2.0"));
    EXPECT_EQ(dcm->GetNamedAttribute("CLKDV_DIVIDE")->GetHdlType(), "real");
    Tsy_Block* pll = db->GetPrimitiveBlock("PLL_ADV");
    Tsy_Attribute* mult = pll->GetNamedAttribute("CLKFBOUT_MULT");
    ASSERT_NE(mult, nullptr);
    Tsy_StrArray ranges = mult->GetValueList();
    ASSERT_FALSE(ranges.IsEmpty());
    int lo = 0, hi = 0;
    EXPECT_TRUE(mult->GetRangeValues(ranges.GetAt(ranges.GetSize() - 1), lo, hi));
    EXPECT_EQ(lo, 1);
    EXPECT_EQ(hi, 64);
    EXPECT_FALSE(mult->GetRangeValues("7", lo, hi));
    EXPECT_FALSE(mult->GetRangeValues("9:2", lo, hi));
    EXPECT_FALSE(mult->GetRangeValues("a:b", lo, hi));
    Tsy_StrArray fb = pll->GetNamedAttribute("TESY_ONLY_PLL_FBSRC_CLKOUT")
                          ? pll->GetNamedAttribute("TESY_ONLY_PLL_FBSRC_CLKOUT")->GetValueList()
                          : Tsy_StrArray();
    ASSERT_GE(fb.GetSize(), 3);
    EXPECT_EQ(fb.GetAt(0), "External");
    EXPECT_EQ(fb.GetAt(1), "CLKFBOUT with BUFG");
    EXPECT_EQ(fb.GetAt(2), "CLKFBOUT without BUFG");
}

TEST(WizData, PinsAreTiedOrConnectedNeverBoth)
{
    auto db = designFor("t5da1-1");
    Tsy_Block* b = db->AddBlock("FD1_INST", "FD");
    Tsy_Pin* d = b->AddPin("D", "IN");
    EXPECT_EQ(b->AddPin("D", "IN"), d);
    d->SetSigName("X");
    d->SetIsGrounded(true);
    EXPECT_TRUE(d->IsGrounded());
    EXPECT_EQ(d->GetSigName(), "");
    d->SetIsVcc(true);
    EXPECT_FALSE(d->IsGrounded());
    d->SetSigName("Y");
    EXPECT_FALSE(d->IsVcc());
    b->ClearAllPinSignals();
    EXPECT_EQ(d->GetSigName(), "");
    b->SetAllPinsIsActive(true);
    EXPECT_TRUE(d->IsActive());
    EXPECT_TRUE(b->DeletePin(d));
    EXPECT_EQ(b->GetNamedPin("D"), nullptr);
}

TEST(WizData, SignalsAreReusedAndCanBecomePorts)
{
    auto db = designFor("t5da1-1");
    Tsy_Signal* net = db->AddSignal("CLK0_BUF", false, "");
    EXPECT_FALSE(net->IsExternal());
    EXPECT_EQ(db->AddSignal("CLK0_BUF", false, ""), net);
    db->SetAllSigsIsActive(false);
    EXPECT_FALSE(net->IsActive());
    Tsy_Signal* port = db->AddSignal("CLK0_BUF", true, "O");
    EXPECT_EQ(port, net);
    EXPECT_TRUE(port->IsActive());
    EXPECT_TRUE(port->IsExternal());
    EXPECT_EQ(port->GetDirection(), "O");
    port->SetIsBus(true, 16);
    EXPECT_EQ(port->GetWidth(), 16);
    port->SetIsBus(true, 1);
    EXPECT_FALSE(port->IsBus());
}
