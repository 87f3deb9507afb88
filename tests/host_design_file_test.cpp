// The saved design: exact round trips, hand-written files that give only
// what differs from the templates, malformed files refused with the place and
// the reason, and atomic replacement.

#include "db/Tsy_WizData.h"
#include "design/Tsy_DesignFile.h"
#include "design/Tsy_OutputSet.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "port/Exception.h"
#include "run/Tsy_HostSession.h"
#include "support/TestDesign.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

namespace {

std::unique_ptr<Tsy_WizData> designFor(const char* part)
{
    Tsy_PartInfo info;
    EXPECT_TRUE(Tsy_DeviceCatalog::Instance().FindPart(part, info));
    return Tsy_NewDesignFor(info);
}

Tsy_DesignHeader header()
{
    return Tsy_DesignHeader{"dcm", "t5da1-1", "clkgen", "1.0.0"};
}

// A netlist of the kind Finish leaves: ports, nets, ties, buses, attribute
// activity, pin records.
void buildNetlist(Tsy_WizData& db)
{
    Tsy_Block* dcm = db.GetPrimitiveBlock("DCM_ADV");
    dcm->active = true;
    dcm->RemoveAttribute("DCM_AUTOCALIBRATION");
    dcm->SetAttributeValue("CLKIN_PERIOD", "8.000");
    dcm->SetAttributeIsActive("PHASE_SHIFT", false);
    dcm->GetNamedPin("CLK0")->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFG");
    dcm->GetNamedPin("CLK0")->SetSigName("CLK0_BUF");
    dcm->GetNamedPin("PSEN")->SetIsGrounded(true);
    dcm->GetNamedPin("DADDR")->SetIsVcc(true);
    Tsy_Block* buf = db.AddBlock("CLK0_BUFG_INST", "BUFG");
    buf->AddPin("I", "IN")->SetSigName("CLK0_BUF");
    buf->AddPin("O", "OUT")->SetSigName("CLKFB_IN");
    db.AddSignal("CLK0_BUF", false, "");
    db.AddSignal("CLKFB_IN", false, "")->SetAttributeValue("ASSOC_WITH", "CLK0_OUT");
    db.AddSignal("CLK0_OUT", true, "O");
    db.AddSignal("DO_OUT", true, "O")->SetIsBus(true, 16);
    db.AddSignal("OLD_NET", false, "")->SetIsActive(false);
}

} // namespace

TEST(DesignFile, SaveThenLoadRoundTripsExactly)
{
    auto db = designFor("t5da1-1");
    buildNetlist(*db);
    std::string first = Tsy_DesignFile::ToText(header(), *db);

    auto again = designFor("t5da1-1");
    Tsy_DesignHeader h = Tsy_DesignFile::LoadText(first, "first.tsw", *again);
    EXPECT_EQ(h.wizard, "dcm");
    EXPECT_EQ(h.module, "clkgen");
    EXPECT_EQ(h.version, "1.0.0");
    EXPECT_EQ(Tsy_DesignFile::ToText(header(), *again), first);

    Tsy_Block* dcm = again->GetNamedBlock("DCM_ADV_INST");
    EXPECT_TRUE(dcm->active);
    EXPECT_TRUE(dcm->IsTemplate());
    EXPECT_EQ(dcm->GetNamedAttribute("DCM_AUTOCALIBRATION"), nullptr) << "a removed attribute stays removed";
    EXPECT_FALSE(dcm->GetNamedAttribute("PHASE_SHIFT")->IsActive());
    EXPECT_TRUE(dcm->GetNamedPin("PSEN")->IsGrounded());
    EXPECT_TRUE(again->GetNamedBlock("CLK0_BUFG_INST")->IsGenerated());
    EXPECT_EQ(again->GetNamedSignal("DO_OUT")->GetWidth(), 16);
    EXPECT_FALSE(again->GetNamedSignal("OLD_NET")->IsActive());
}

TEST(DesignFile, HandWrittenFileGivesOnlyTheDifferences)
{
    auto db = designFor("t5da1-1");
    const char* text = R"({
      "format": 1, "wizard": "dcm", "part": "t5da1-1",
      "blocks": [ { "name": "DCM_ADV_INST",
                    "attributes": { "TESY_ONLY_CLKIN_VALUE": "125", "PHASE_SHIFT": {"value": "3", "active": false} },
                    "pins": [ { "name": "CLK90", "active": true } ] },
                  { "name": "EXTRA_BUF", "type": "BUFG" } ]
    })";
    Tsy_DesignHeader h = Tsy_DesignFile::LoadText(text, "hand.tsw", *db);
    EXPECT_EQ(h.module, "");
    EXPECT_EQ(h.version, "");
    Tsy_Block* dcm = db->GetNamedBlock("DCM_ADV_INST");
    EXPECT_EQ(dcm->GetAttributeValue("TESY_ONLY_CLKIN_VALUE"), "125");
    EXPECT_EQ(dcm->GetAttributeValue("FB_SOURCE"), "INTERNAL") << "template defaults stay";
    EXPECT_FALSE(dcm->GetNamedAttribute("PHASE_SHIFT")->IsActive());
    EXPECT_TRUE(dcm->GetNamedPin("CLK90")->IsActive());
    EXPECT_TRUE(dcm->GetNamedPin("CLK0")->IsActive());
    Tsy_Block* extra = db->GetNamedBlock("EXTRA_BUF");
    ASSERT_NE(extra, nullptr);
    EXPECT_NE(extra->GetNamedPin("I"), nullptr) << "a new block takes its primitive's pins";
}

TEST(DesignFile, MalformedFilesAreRefusedWithPlaceAndReason)
{
    struct Case {
        const char* text;
        const char* expected; // a part of the message
    } cases[] = {
        {"", "line 1, column 1"},
        {"{\"format\": 1,\n \"wizard\": \"dcm\",\n \"part\": }", "line 3, column"},
        {"[]", "top level: expected an object"},
        {R"({"wizard": "dcm", "part": "p"})", "format: missing"},
        {R"({"format": 7, "wizard": "dcm", "part": "p"})", "unsupported format version 7"},
        {R"({"format": 1, "part": "p"})", "wizard: missing"},
        {R"({"format": 1, "wizard": 3, "part": "p"})", "wizard: expected a string"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": {}})", "blocks: expected a list"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "X", "type": "NOPE"}]})",
         "blocks[0].type: unknown primitive 'NOPE'"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "X"}]})", "blocks[0].type: missing"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "DCM_ADV_INST", "pins": [{"name": "CLK0", "width": 0}]}]})",
         "blocks[0].pins[0].width: must be between 1 and 64"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "DCM_ADV_INST", "pins": [{"name": "CLK0", "tie": "HIGH"}]}]})",
         "blocks[0].pins[0].tie"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "DCM_ADV_INST", "pins": [{"name": "CLK0", "signal": "GHOST"}]}]})",
         "blocks[0].pins[0].signal: no signal named 'GHOST'"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "DCM_ADV_INST", "attributes": {"A": 5}}]})",
         "blocks[0].attributes.A: expected a text value"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "blocks": [{"name": "B", "type": "BUFG"}, {"name": "B", "type": "BUFG"}]})",
         "blocks[1].name: block 'B' is given twice"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "signals": [{"name": "S", "external": true, "direction": "X"}]})",
         "signals[0].direction"},
        {R"({"format": 1, "wizard": "dcm", "part": "p", "signals": [{"name": "S", "width": 99}]})",
         "signals[0].width"},
    };
    for (const auto& c : cases) {
        auto db = designFor("t5da1-1");
        std::string before = Tsy_DesignFile::ToText(header(), *db);
        try {
            Tsy_DesignFile::LoadText(c.text, "bad.tsw", *db);
            ADD_FAILURE() << "accepted: " << c.text;
        } catch (const Port::Exception& e) {
            std::string what = e.what();
            EXPECT_EQ(what.rfind("bad.tsw: ", 0), 0u) << what;
            EXPECT_NE(what.find(c.expected), std::string::npos) << what << "\n  expected: " << c.expected;
            EXPECT_EQ(what.find('\n'), std::string::npos) << "one line: " << what;
        }
        EXPECT_EQ(Tsy_DesignFile::ToText(header(), *db), before) << "a refused file changes nothing";
    }
}

TEST(OutputSet, ReplacesFilesTogetherOrNotAtAll)
{
    TempDir dir;
    std::string error;
    ASSERT_TRUE(Tsy_WriteFileAtomically(dir.File("a.tsw"), "old a", error)) << error;
    ASSERT_TRUE(Tsy_WriteFileAtomically(dir.File("b.v"), "old b", error)) << error;

    Tsy_OutputSet failing;
    failing.Add(dir.File("a.tsw"), "new a");
    failing.Add(dir.File("missing-folder/b.v"), "new b");
    EXPECT_FALSE(failing.Commit(error));
    EXPECT_NE(error.find("missing-folder/b.v"), std::string::npos) << error;
    EXPECT_EQ(ReadTextFile(dir.File("a.tsw")), "old a") << "nothing is replaced when one file fails";
    CommandResult ls = RunCommand("ls -A '" + dir.Path() + "'");
    EXPECT_EQ(ls.out, "a.tsw\nb.v\n") << "no temporaries are left behind";

    Tsy_OutputSet good;
    good.Add(dir.File("a.tsw"), "new a");
    good.Add(dir.File("b.v"), "new b");
    ASSERT_TRUE(good.Commit(error)) << error;
    EXPECT_EQ(ReadTextFile(dir.File("a.tsw")), "new a");
    EXPECT_EQ(ReadTextFile(dir.File("b.v")), "new b");
    struct stat st {};
    ASSERT_EQ(::stat(dir.File("b.v").c_str(), &st), 0);
    EXPECT_EQ(st.st_mode & 0777, 0644u);
}
