// The Clock Buffers page and its buffer editor on a real design database,
// without widgets: the rows derived from the outputs' buffer records in both
// modes, the default records written, the repairs of older records, the two
// checks of Next with their messages, the conversion of designs written by
// older versions, and what storing, adding and deleting a buffer leaves on
// the pins. Then whole batch runs of pendra.

#include "db/Tsy_WizData.h"
#include "design/Tsy_DesignFile.h"
#include "pages/dcm/Tsy_BufferEdit.h"
#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "support/TestDesign.h"
#include "wizard/Tsy_Vocabulary.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <fstream>
#include <functional>
#include <map>
#include <sstream>
#include <string>
#include <vector>

namespace {

const char* const kDcmOutputs[] = {"CLK0",  "CLK90",    "CLK180", "CLK270",  "CLKDV",
                                   "CLK2X", "CLK2X180", "CLKFX",  "CLKFX180"};

using Records = std::map<std::string, std::string>;

// The Clock Buffers page of one DCM of a wizard, with the DCM's outputs and
// feedback set directly as General Setup would leave them.
class BufPage {
public:
    BufPage(const char* keyword = "dcm", const char* part = "t5da1-1", int inst = 1, bool batch = true,
            const std::function<void(Tsy_WizContext&)>& context = {})
        : d(keyword, part, batch)
    {
        d.MarkLoaded();
        d.Configure([](Tsy_WizContext& c) { c.designVersion = "1.0.0"; });
        if (context)
            d.Configure(context);
        d.Instantiate();
        for (int i = 0; i < Tsy_WizMain::kPageSlots; ++i)
            if (auto* p = dynamic_cast<Tsy_ClockBufDlg*>(d.Wizard().GetPage(i)); p && p->GetInstNum() == inst)
                page = p;
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
    }

    // Exactly these outputs selected.
    BufPage& Outputs(std::initializer_list<const char*> on)
    {
        for (const char* o : kDcmOutputs)
            if (Tsy_Pin* p = dcm->GetNamedPin(o))
                p->SetIsActive(false);
        for (const char* o : on)
            dcm->GetNamedPin(o)->SetIsActive(true);
        return *this;
    }
    BufPage& Feedback(const char* source, const char* multiple = "1X")
    {
        dcm->SetAttributeValue(Tsy_Attr::FB_SOURCE, source);
        dcm->SetAttributeValue(Tsy_Attr::CLK_FEEDBACK, multiple);
        return *this;
    }
    BufPage& Mode(const char* useBufg)
    {
        dcm->SetAttributeValue(Tsy_Attr::USE_BUFG, useBufg);
        return *this;
    }
    BufPage& Record(const char* pin, const char* attr, const char* value)
    {
        dcm->GetNamedPin(pin)->SetAttributeValue(attr, value);
        return *this;
    }
    Tsy_Pin* Pin(const char* name) { return dcm->GetNamedPin(name); }

    // Page entry as the batch run does it.
    Tsy_ClockBufDlgGui* Load()
    {
        gui = page->Controller();
        gui->SetNamePrefix();
        gui->LoadFromBlock();
        gui->RefreshRows(true);
        return gui;
    }

    // "I0|I1|type|n|state" for each row that shows something.
    std::vector<std::string> Rows() const
    {
        std::vector<std::string> out;
        for (int r = 1; r <= Tsy_ClockBufDlgGui::kRows; ++r) {
            const auto& row = gui->GetRow(r);
            if (row.i0.IsEmpty())
                continue;
            std::ostringstream s;
            s << row.i0 << "|" << row.i1 << "|" << row.type << "|" << row.bufIndex << "|" << row.state;
            out.push_back(s.str());
        }
        return out;
    }
    std::string Dump() const
    {
        std::ostringstream s;
        gui->DumpRows(s);
        return s.str();
    }

    // The wizard's records on a pin ("TSY_CLK..." and "TSY_PMCD..." only).
    Records RecordsOf(const char* pin) const
    {
        Records out;
        for (const auto& a : dcm->GetNamedPin(pin)->Attributes())
            if (a->GetName().StartsWith("TSY_"))
                out[a->GetName().str()] = a->GetValue().str();
        return out;
    }
    std::vector<StringBase> Notes() { return d.Stream().Notes(); }
    std::vector<StringBase> Errors() { return d.Stream().Errors(); }

    TestDesign d;
    Tsy_ClockBufDlg* page = nullptr;
    Tsy_ClockBufDlgGui* gui = nullptr;
    Tsy_Block* dcm = nullptr;
};

std::string internalMessage(const char* out)
{
    return StringBase::Printf("The 'Feedback Source' is Internal %s, which requires that %s be connected to a BUFG.  "
                              "Please use BUFG for %s.",
                              out, out, out)
        .str();
}

const char* const kTooManyNote =
    "More than four DCM outputs are driving global buffers.  Only a maximum of four DCM outputs can use dedicated "
    "routing to global buffers on the same half of the FPGA.  The remaining outputs will use local routing to the "
    "global buffer.";

std::vector<std::string> strings(const std::vector<StringBase>& v)
{
    std::vector<std::string> out;
    for (const auto& s : v)
        out.push_back(s.str());
    return out;
}

} // namespace

// ---------------------------------------------------------------- rows

TEST(ClockBuffersRows, GlobalModeGivesEveryOutputAGlobalBuffer)
{
    struct Case {
        const char* name;
        std::vector<const char*> outputs;
        const char* feedback;
        const char* multiple;
        const char* clkinSource;
        std::vector<std::string> rows;
        std::vector<std::string> recorded; // outputs that get "TSY_CLKBUFTYPE1" = "BUFG"
    } cases[] = {
        {"CLK0 alone, internal 1X feedback: the feedback buffer is not recorded here",
         {"CLK0"},
         "INTERNAL",
         "1X",
         "EXTERNAL",
         {"CLK0||BUFG|1|1"},
         {}},
        {"three outputs; CLKIN is listed but takes no row",
         {"CLK0", "CLK90", "CLKFX"},
         "INTERNAL",
         "1X",
         "EXTERNAL",
         {"CLK0||BUFG|1|1", "CLK90||BUFG|1|1", "CLKFX||BUFG|1|1"},
         {"CLK90", "CLKFX"}},
        {"2X feedback closes through CLK2X",
         {"CLK0", "CLK2X"},
         "INTERNAL",
         "2X",
         "INTERNAL",
         {"CLK0||BUFG|1|1", "CLK2X||BUFG|1|1"},
         {"CLK0"}},
        {"external feedback: every output is recorded",
         {"CLK0", "CLKDV"},
         "EXTERNAL",
         "1X",
         "EXTERNAL",
         {"CLK0||BUFG|1|1", "CLKDV||BUFG|1|1"},
         {"CLK0", "CLKDV"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p;
        ASSERT_NE(p.page, nullptr);
        p.Outputs({}).Feedback(c.feedback, c.multiple).Mode("USE_BUFGS");
        for (const char* o : c.outputs)
            p.Pin(o)->SetIsActive(true);
        p.dcm->SetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE, c.clkinSource);
        p.Load();
        EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeGlobal);
        EXPECT_EQ(p.Rows(), c.rows) << p.Dump();
        EXPECT_EQ(p.gui->GetLastUsedRow(), static_cast<int>(c.rows.size()));
        for (const char* o : kDcmOutputs) {
            bool expected = std::find(c.recorded.begin(), c.recorded.end(), std::string(o)) != c.recorded.end();
            EXPECT_EQ(p.Pin(o)->GetAttributeValue("TSY_CLKBUFTYPE1") == "BUFG", expected) << o;
        }
        EXPECT_TRUE(p.RecordsOf("CLKIN").empty()) << "CLKIN gets no default record";
        EXPECT_TRUE(p.gui->StoreToBlock(true));
        EXPECT_EQ(p.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_BUFGS");
        EXPECT_TRUE(p.d.Stream().Entries().empty());
    }
}

TEST(ClockBuffersRows, CustomizeModeReadsTheRecordsOfEachOutput)
{
    struct Case {
        const char* name;
        std::vector<const char*> outputs;
        const char* feedback;
        Records clk0;
        Records clk90;
        Records clkin;
        std::vector<std::string> rows;
    } cases[] = {
        {"the feedback output gets a greyed row and no record",
         {"CLK0", "CLK90"},
         "INTERNAL",
         {},
         {},
         {},
         {"CLK0||BUFG|1|2", "CLK90||BUFG|1|1"}},
        {"two buffers on CLK0, the mux naming its I1 itself",
         {"CLK0", "CLK90"},
         "EXTERNAL",
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}, {"TSY_CLKBUFTYPE2", "BUFGMUX"}, {"TSY_CLKBUF2_I1_PINNAME", "CLK90"}},
         {},
         {},
         {"CLK0||BUFGCE|1|1", "CLK0|CLK90|BUFGMUX|2|1", "CLK90||BUFG|1|1"}},
        {"a mux without its own I1 takes the output's TSY_CLKMUX_I1",
         {"CLK0", "CLK90"},
         "NONE",
         {{"TSY_CLKBUFTYPE1", "BUFGCTRL"}, {"TSY_CLKMUX_I1", "CLK90"}},
         {},
         {},
         {"CLK0|CLK90|BUFGCTRL|1|1", "CLK90||BUFG|1|1"}},
        {"states other pages preset are honoured",
         {"CLK0", "CLK90"},
         "NONE",
         {{"TSY_CLKBUFTYPE1", "BUFG"},
          {"TSY_CLKBUFTYPE1_NOEDIT", "DISABLED_BUF"},
          {"TSY_CLKBUFTYPE2", "OBUF"},
          {"TSY_CLKBUFTYPE2_NOEDIT", "TRUE"}},
         {{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "DEFAULT_BUF"}},
         {},
         {"CLK0||BUFG|1|0", "CLK0||OBUF|2|0", "CLK90||BUFG|1|3"}},
        {"a buffer on CLKIN takes a row after the outputs",
         {"CLK0"},
         "NONE",
         {},
         {},
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}},
         {"CLK0||BUFG|1|1", "CLKIN||BUFGCE|1|1"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p;
        p.Outputs({}).Feedback(c.feedback).Mode("USE_GRID");
        for (const char* o : c.outputs)
            p.Pin(o)->SetIsActive(true);
        for (const auto& r : c.clk0)
            p.Record("CLK0", r.first.c_str(), r.second.c_str());
        for (const auto& r : c.clk90)
            p.Record("CLK90", r.first.c_str(), r.second.c_str());
        for (const auto& r : c.clkin)
            p.Record("CLKIN", r.first.c_str(), r.second.c_str());
        p.Load();
        EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
        EXPECT_EQ(p.Rows(), c.rows) << p.Dump();
        EXPECT_TRUE(p.d.Stream().Entries().empty());
    }
}

TEST(ClockBuffersRows, CustomizeModeRecordsTheDefaultBufferOfEveryOtherOutput)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Load();
    EXPECT_EQ(p.RecordsOf("CLK0"), Records{}) << "the feedback path builds its own buffer";
    EXPECT_EQ(p.RecordsOf("CLK90"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "ENABLED_BUF"}}));
    EXPECT_EQ(p.RecordsOf("CLKIN"), Records{});
    int opened = 0;
    p.gui->SetEditRunner([&](Tsy_BufferEdit&) { return ++opened; });
    p.gui->EditRow(1);
    EXPECT_EQ(opened, 0) << "the feedback row cannot be opened";
    p.gui->EditRow(2);
    EXPECT_EQ(opened, 1);
}

TEST(ClockBuffersRows, AbsentModeAttributeMeansCustomize)
{
    BufPage p;
    p.Outputs({"CLK0"}).Feedback("NONE");
    p.dcm->RemoveAttribute(Tsy_Attr::USE_BUFG);
    p.Load();
    EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
    p.Mode("something else");
    p.Load();
    EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
}

TEST(ClockBuffersRows, OutputsBeyondSixteenRowsAreReportedOnceEach)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"})
        .Feedback("NONE")
        .Mode("USE_GRID");
    // Two buffers on each of the first eight outputs fill the sixteen rows.
    for (int i = 0; i < 8; ++i) {
        p.Record(kDcmOutputs[i], "TSY_CLKBUFTYPE1", "BUFG");
        p.Record(kDcmOutputs[i], "TSY_CLKBUFTYPE2", "LOCALROUTING");
    }
    p.Record("CLKIN", "TSY_CLKBUFTYPE1", "BUFGCE");
    p.Load();
    EXPECT_EQ(p.Rows().size(), 16u) << p.Dump();
    EXPECT_EQ(p.gui->GetLastUsedRow(), 16);
    EXPECT_EQ(strings(p.Notes()),
              (std::vector<std::string>{
                  "The maximum of 16 supported buffers has been reached.  CLKFX180 will not be processed.",
                  "The maximum of 16 supported buffers has been reached.  CLKIN will not be processed."}));
    EXPECT_EQ(p.RecordsOf("CLKFX180"), Records{}) << "an output left over gets no default record";

    // Seventeen buffers: the eighth output's second buffer is the one left over.
    p.d.Stream().Clear();
    p.Record("CLK0", "TSY_CLKBUFTYPE3", "BUFGCE");
    p.gui->AssignDefaultBuffers();
    EXPECT_EQ(strings(p.Notes()),
              (std::vector<std::string>{
                  "The maximum of 16 supported buffers has been reached.  CLKFX will not be processed.",
                  "The maximum of 16 supported buffers has been reached.  CLKFX180 will not be processed.",
                  "The maximum of 16 supported buffers has been reached.  CLKIN will not be processed."}));
    p.gui->AddBuffer();
    EXPECT_EQ(strings(p.Notes()).back(),
              "Maximum number of rows reached for this dialog. No additional rows can be displayed.");
}

TEST(ClockBuffersRows, OlderRecordsAreRepaired)
{
    struct Case {
        const char* part;
        const char* stored;
        const char* becomes;
        bool note;
    } cases[] = {
        {"t5da1-1", "LOWSKEWLINE", "LOCALROUTING", true},
        {"t2a250-4", "LOWSKEWLINE", "LOCALROUTING", true},
        {"t5da1-1", "BUFGMUX_TALDOR4", "BUFGMUX_CTRL", false},
        {"t4a25-10", "BUFGMUX_TALDOR4", "BUFGMUX_TALDOR4", false},
        {"t5da1-1", "SOMETHING_NEW", "SOMETHING_NEW", false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.part) + " " + c.stored);
        BufPage p("dcm", c.part);
        p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
        p.Record("CLK90", "TSY_CLKBUFTYPE1", c.stored);
        p.Load();
        EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), c.becomes);
        EXPECT_EQ(p.gui->GetRow(2).type, c.becomes);
        std::vector<std::string> expected;
        if (c.note)
            expected.push_back("The output 'CLK90' was previously configured to use Lowskewlines, but this option is "
                               "no longer allowed.  The Lowskewlines selection has been changed to Local Routing.");
        EXPECT_EQ(strings(p.Notes()), expected);
        // Repaired once: the next pass has nothing to say.
        p.d.Stream().Clear();
        p.gui->RefreshRows(false);
        EXPECT_TRUE(p.Notes().empty());
    }
}

TEST(ClockBuffersRows, TwoDcmWizardsPrefixTheirNamesAndReadTheirOwnInstance)
{
    BufPage first("dcm_bddeskew", "t5da1-1", 1);
    BufPage second("dcm_bddeskew", "t5da1-1", 2);
    ASSERT_NE(first.page, nullptr);
    ASSERT_NE(second.page, nullptr);
    second.Outputs({"CLK0", "CLKDV"}).Feedback("INTERNAL").Mode("USE_BUFGS");
    second.Load();
    EXPECT_EQ(second.gui->GetNamePrefix(), "U2_");
    EXPECT_EQ(second.gui->pageName().toStdString(), "Clock Buffers for INST2");
    EXPECT_EQ(second.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|1", "CLKDV||BUFG|1|1"}));
    first.Load();
    EXPECT_EQ(first.gui->GetNamePrefix(), "U1_");
    EXPECT_EQ(first.gui->pageName().toStdString(), "Clock Buffers for INST1");

    // Board deskew with external feedback and no DDR flip-flop: rows only.
    BufPage deskew("dcm_bddeskew", "t5da1-1", 1);
    deskew.Outputs({"CLK0"}).Feedback("EXTERNAL").Mode("USE_BUFGS");
    deskew.dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_DDR_FLIPFLOP, "None");
    deskew.Load();
    EXPECT_EQ(deskew.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
    EXPECT_EQ(deskew.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID");

    // Clock switching always customizes.
    BufPage switching("dcm_clkswitch", "t5da1-1", 2);
    switching.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_BUFGS");
    switching.Load();
    EXPECT_EQ(switching.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
}

TEST(ClockBuffersRows, SwitchingModesResetsTheEditableBuffers)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Record("CLK90", "TSY_CLKBUFTYPE1", "BUFGCE");
    p.Record("CLK180", "TSY_CLKBUFTYPE1", "BUFGMUX");
    p.Record("CLK180", "TSY_CLKBUFTYPE1_NOEDIT", "DISABLED_BUF");
    p.Record("CLK180", "TSY_CLKBUF1_I1_PINNAME", "CLK90");
    p.Load();
    // Global buffers for all: the editable CLK90 becomes a BUFG; the buffer
    // another page fixed keeps its type.
    p.gui->OnRadioUseBufgs();
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(p.Pin("CLK180")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|1", "CLK90||BUFG|1|1", "CLK180||BUFG|1|0"}));
    // And back: the editable rows start over from a default Global Buffer.
    p.gui->OnRadioUseGrid();
    EXPECT_EQ(p.RecordsOf("CLK90"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "ENABLED_BUF"}}));
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|2", "CLK90||BUFG|1|1", "CLK180|CLK90|BUFGMUX|1|0"}));
    // A second click on the customize button changes nothing.
    p.Record("CLK90", "TSY_CLKBUFTYPE1", "BUFGCE");
    p.gui->AssignDefaultBuffers();
    p.gui->OnRadioUseGrid();
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFGCE");
}

TEST(ClockBuffersRows, GlobalModeStoresOneBufferPerOutput)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Record("CLK0", "TSY_CLKBUFTYPE1", "BUFG");
    p.Record("CLK0", "TSY_CLKBUFTYPE1_NOEDIT", "FEEDBACK_BUF");
    p.Record("CLK90", "TSY_CLKBUFTYPE1", "BUFG");
    p.Record("CLK90", "TSY_CLKBUFTYPE2", "BUFGCE");
    p.Record("CLK90", "TSY_CLKBUF2_CE_SIGNAME", "EN");
    p.Record("CLK90", "TSY_CLKBUFTYPE3", "LOCALROUTING");
    p.Record("CLK90", "TSY_CLKBUFTYPE3_NOEDIT", "DISABLED_BUF");
    p.Load();
    ASSERT_EQ(p.Rows().size(), 4u) << p.Dump();
    p.gui->OnRadioUseBufgs();
    EXPECT_EQ(p.Rows().size(), 2u);
    // Still there while the page is open: customizing again brings them back.
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE2"), "BUFGCE");
    ASSERT_TRUE(p.gui->StoreToBlock(true));
    EXPECT_EQ(p.RecordsOf("CLK90"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"},
                                             {"TSY_CLKBUFTYPE2", "LOCALROUTING"},
                                             {"TSY_CLKBUFTYPE2_NOEDIT", "DISABLED_BUF"}}));
    EXPECT_EQ(p.RecordsOf("CLK0"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "FEEDBACK_BUF"}}));
    EXPECT_EQ(strings(p.Notes()),
              (std::vector<std::string>{"Every output uses one Global Buffer (USE_BUFG is USE_BUFGS), so buffer 2 "
                                        "(BUFGCE) of CLK90 was removed."}));
}

// ---------------------------------------------------------------- checks on Next

TEST(ClockBuffersChecks, FeedbackBuffer)
{
    struct Case {
        const char* name;
        const char* feedback;
        const char* multiple;
        Records clk0;
        Records clk2x;
        std::string error; // empty: passes
    } cases[] = {
        {"internal feedback with a BUFG row passes", "INTERNAL", "1X", {}, {}, ""},
        {"internal feedback on an Enabled Buffer fails naming CLK0 three times",
         "INTERNAL",
         "1X",
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}},
         {},
         internalMessage("CLK0")},
        {"a second buffer of the feedback output may be the BUFG",
         "INTERNAL",
         "1X",
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}, {"TSY_CLKBUFTYPE2", "BUFG"}, {"TSY_CLKBUFTYPE2_NOEDIT", "FEEDBACK_BUF"}},
         {},
         ""},
        {"2X feedback looks at CLK2X",
         "INTERNAL",
         "2X",
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}},
         {{"TSY_CLKBUFTYPE1", "LOCALROUTING"}},
         internalMessage("CLK2X")},
        {"external feedback on a BUFGCTRL names the stored type",
         "EXTERNAL",
         "1X",
         {{"TSY_CLKBUFTYPE1", "BUFGCTRL"}},
         {},
         "The 'Feedback Source' is External CLK0.  CLK0 is connected to a BUFGCTRL, which is not allowed.  Please "
         "change the selection for CLK0 to use something other than Clock Mux or Enabled Buffer."},
        {"external feedback on an Enabled Buffer",
         "EXTERNAL",
         "2X",
         {},
         {{"TSY_CLKBUFTYPE1", "BUFGCE"}},
         "The 'Feedback Source' is External CLK2X.  CLK2X is connected to a BUFGCE, which is not allowed.  Please "
         "change the selection for CLK2X to use something other than Clock Mux or Enabled Buffer."},
        {"external feedback through local routing passes",
         "EXTERNAL",
         "1X",
         {{"TSY_CLKBUFTYPE1", "LOCALROUTING"}},
         {},
         ""},
        {"no feedback at all leaves CLK0 free", "NONE", "1X", {{"TSY_CLKBUFTYPE1", "BUFGMUX"}}, {}, ""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p("dcm", "t5da1-1");
        p.Outputs({"CLK0", "CLK2X"}).Feedback(c.feedback, c.multiple).Mode("USE_GRID");
        for (const auto& r : c.clk0)
            p.Record("CLK0", r.first.c_str(), r.second.c_str());
        for (const auto& r : c.clk2x)
            p.Record("CLK2X", r.first.c_str(), r.second.c_str());
        p.Load();
        EXPECT_EQ(p.gui->StoreToBlock(true), c.error.empty()) << p.Dump();
        EXPECT_EQ(strings(p.Errors()),
                  c.error.empty() ? std::vector<std::string>{} : std::vector<std::string>{c.error});
        EXPECT_EQ(p.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID") << "stored before the checks";
    }
}

TEST(ClockBuffersChecks, GlobalBufferCountInBatchIsANote)
{
    struct Case {
        const char* part;
        std::vector<const char*> types; // buffer 1 of CLK90, CLK180, ...
        bool note;
    } cases[] = {
        {"t2a250-4", {"BUFG", "BUFGCE", "BUFGMUX", "BUFG"}, true}, // with the CLK0 row: five
        {"t2a250-4", {"BUFG", "BUFGCE", "BUFG"}, false},           // four
        {"t2a250-4", {"BUFGCE", "LOCALROUTING", "BUFGMUX", "BUFG", "BUFGCE"}, true},
        {"t2a250-4", {"BUFG", "LOCALROUTING", "OBUF", "BUFG", "BUFGCE"}, false}, // routing and OBUF do not count
        {"t5da1-1", {"BUFG", "BUFG", "BUFG", "BUFG", "BUFG"}, false},            // BUFGCTRL families: no check
    };
    const char* const outs[] = {"CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X"};
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.part) + " with " + std::to_string(c.types.size()) + " more");
        BufPage p("dcm", c.part);
        p.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID");
        for (size_t i = 0; i < c.types.size(); ++i) {
            p.Pin(outs[i])->SetIsActive(true);
            p.Record(outs[i], "TSY_CLKBUFTYPE1", c.types[i]);
        }
        p.Load();
        EXPECT_TRUE(p.gui->StoreToBlock(true)) << "batch runs go on";
        EXPECT_TRUE(p.d.Stream().Questions().empty());
        EXPECT_EQ(strings(p.Notes()), c.note ? std::vector<std::string>{kTooManyNote} : std::vector<std::string>{});
    }
}

TEST(ClockBuffersChecks, LeavingThroughBackNeverComplains)
{
    BufPage p;
    p.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Record("CLK0", "TSY_CLKBUFTYPE1", "BUFGCE");
    p.Load();
    EXPECT_TRUE(p.gui->onBack());
    EXPECT_TRUE(p.d.Stream().Entries().empty());
    EXPECT_TRUE(p.gui->IsLeftByBack());
    EXPECT_EQ(p.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID");
    EXPECT_FALSE(p.gui->StoreToBlock(true)) << "the check still fails, silently";
    EXPECT_TRUE(p.d.Stream().Entries().empty());
}

TEST(ClockBuffersChecks, WithoutAPageThereIsNothingToStore)
{
    Tsy_ClockBufDlgGui orphan(nullptr, nullptr, 1);
    EXPECT_FALSE(orphan.StoreToBlock(true));
    orphan.RefreshRows(true);
    EXPECT_EQ(orphan.GetLastUsedRow(), 0);
}

// ---------------------------------------------------------------- older designs

namespace {

// A design as an older version wrote it: the buffer choices live in the
// netlist, as buffer blocks on the outputs' nets and as marked nets.
const char* const kOlderDesign = R"({
  "format": 1, "wizard": "dcm", "part": "t5da1-1", "module": "older", "version": "6.2.03",
  "blocks": [
    { "name": "DCM_ADV_INST",
      "attributes": { "USE_BUFG": "USE_GRID", "FB_SOURCE": "EXTERNAL", "CLK_FEEDBACK": "1X" },
      "pins": [ { "name": "CLK0", "active": true, "signal": "CLK0_BUF" },
                { "name": "CLK90", "active": true, "signal": "CLK90_BUF" },
                { "name": "CLK180", "active": true, "signal": "CLK180_OUT" },
                { "name": "CLK270", "active": true },
                { "name": "CLKFX", "active": true, "signal": "CLKFX_BUF" } ] },
    { "name": "CLK0_BUFG_INST", "type": "BUFG", "active": true,
      "pins": [ { "name": "I", "direction": "IN", "signal": "CLK0_BUF" },
                { "name": "O", "direction": "OUT", "signal": "SYS_CLK" } ] },
    { "name": "CLK90_BUFGMUX_INST", "type": "BUFGMUX", "active": true,
      "pins": [ { "name": "I0", "direction": "IN", "signal": "CLK90_BUF" },
                { "name": "I1", "direction": "IN", "signal": "CLKFX_BUF" },
                { "name": "S", "direction": "IN", "signal": "SEL" },
                { "name": "O", "direction": "OUT", "signal": "MUX_CLK" } ] }
  ],
  "signals": [
    { "name": "CLK180_OUT", "external": true, "direction": "O", "attributes": { "USELOCALROUTING": "TRUE" } },
    { "name": "CLK0_BUF", "external": false, "direction": "" },
    { "name": "CLK90_BUF", "external": false, "direction": "" },
    { "name": "CLKFX_BUF", "external": false, "direction": "" },
    { "name": "SYS_CLK", "external": true, "direction": "O" },
    { "name": "MUX_CLK", "external": true, "direction": "O" },
    { "name": "SEL", "external": true, "direction": "I" }
  ]
})";

} // namespace

TEST(ClockBuffersLegacy, BufferBlocksAndNetMarksBecomeRecords)
{
    BufPage p("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.2.03"; });
    Tsy_DesignFile::LoadText(kOlderDesign, "older.tsw", p.d.Data());
    p.Load();
    EXPECT_EQ(p.RecordsOf("CLK0"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUF1_O_SIGNAME", "SYS_CLK"}}));
    EXPECT_EQ(p.RecordsOf("CLK90"), (Records{{"TSY_CLKBUFTYPE1", "BUFGMUX"},
                                             {"TSY_CLKBUF1_I1_PINNAME", "CLKFX"},
                                             {"TSY_CLKBUF1_S_SIGNAME", "SEL"},
                                             {"TSY_CLKBUF1_O_SIGNAME", "MUX_CLK"}}));
    EXPECT_EQ(p.RecordsOf("CLK180"),
              (Records{{"TSY_CLKBUFTYPE1", "LOCALROUTING"}, {"TSY_CLKBUF1_O_SIGNAME", "CLK180_OUT"}}));
    EXPECT_EQ(p.RecordsOf("CLK270"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}})) << "no net: a Global Buffer";
    // CLKFX feeds the mux's I1 only: that mux is CLK90's; CLKFX gets the default.
    EXPECT_EQ(p.RecordsOf("CLKFX"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "ENABLED_BUF"}}));
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|1", "CLK90|CLKFX|BUFGMUX|1|1",
                                                  "CLK180||LOCALROUTING|1|1", "CLK270||BUFG|1|1", "CLKFX||BUFG|1|1"}));
    // Finish builds the buffers anew from the records.
    EXPECT_FALSE(p.d.Data().GetNamedBlock("CLK0_BUFG_INST")->active);
    EXPECT_FALSE(p.d.Data().GetNamedBlock("CLK90_BUFGMUX_INST")->active);
}

TEST(ClockBuffersLegacy, OnlyOlderVersionsOnEntryAreConverted)
{
    struct Case {
        const char* keyword;
        int inst;
        const char* version;
        bool loaded;
        const char* useBufg;
        bool converted;
    } cases[] = {
        {"dcm", 1, "6.2.03", true, "USE_GRID", true},
        {"dcm", 1, "6.1", true, "USE_GRID", true},
        {"dcm", 1, "", true, "USE_GRID", true},
        {"dcm", 1, "6.3", true, "USE_GRID", false},
        {"dcm", 1, "1.0.0", true, "USE_GRID", false},
        {"dcm", 1, "6.2", false, "USE_GRID", false}, // a new design
        {"dcm", 1, "6.2", true, "USE_BUFGS", false}, // global-buffer mode
        {"dcm_bddeskew", 1, "6.3.1", true, "USE_GRID", true},
        {"dcm_clkswitch", 1, "6.1", true, "USE_GRID", false},
        {"dcm_clkswitch", 1, "6.2", true, "USE_GRID", true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.keyword) + " version '" + c.version + "' " + c.useBufg);
        std::string version = c.version;
        bool loaded = c.loaded;
        BufPage p(c.keyword, "t5da1-1", c.inst, true, [&](Tsy_WizContext& ctx) {
            ctx.designVersion = version;
            ctx.loadedDesign = loaded;
        });
        p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode(c.useBufg);
        p.Pin("CLK90")->SetSigName("CLK90_NET");
        p.d.Data().AddSignal("CLK90_NET", false, "")->AddAttribute(Tsy_Attr::USELOCALROUTING, "TRUE");
        p.Load();
        EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), c.converted ? "LOCALROUTING" : "BUFG");
    }
}

TEST(ClockBuffersLegacy, NotAfterLeavingThroughBackNorOnAModeSwitch)
{
    BufPage p("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.2"; });
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
    p.Pin("CLK90")->SetSigName("CLK90_NET");
    p.d.Data().AddSignal("CLK90_NET", false, "")->AddAttribute(Tsy_Attr::USELOWSKEWLINES, "TRUE");
    p.Load();
    p.gui->onBack();
    p.Pin("CLK90")->RemoveAllPropsWBase("TSY_CLKBUF");
    p.gui->LoadFromBlock();
    p.gui->RefreshRows(true);
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");

    BufPage q("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.1"; });
    q.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_BUFGS");
    q.Pin("CLK90")->SetSigName("CLK90_NET");
    q.d.Data().AddSignal("CLK90_NET", false, "")->AddAttribute(Tsy_Attr::USELOCALROUTING, "TRUE");
    q.Load();
    q.Pin("CLK90")->RemoveAllPropsWBase("TSY_CLKBUF");
    q.gui->OnRadioUseGrid();
    EXPECT_EQ(q.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG") << "a mode switch is no reload";
}

// ---------------------------------------------------------------- the buffer editor

namespace {

// The editor of a page in a GUI-mode wizard (so that its refusals speak),
// prepared with one row of the DCM's outputs.
class Editor {
public:
    explicit Editor(const char* keyword = "dcm", const char* part = "t5da1-1", int inst = 1)
        : p(keyword, part, inst, false), edit(p.page)
    {
        p.Outputs({"CLK0", "CLK90", "CLK180"}).Feedback("NONE").Mode("USE_GRID");
    }
    Editor& Open(const char* i0, const char* i1, const char* type, int n, bool isNew = false, const char* prefix = "")
    {
        edit.Prepare(p.d.Wizard().GetWizTypeInt(), p.page->GetInstNum(), "NONE", 1, prefix,
                     {"CLK0", "CLK90", "CLK180", "CLKIN"}, i0, i1, type, n, isNew);
        return *this;
    }
    BufPage p;
    Tsy_BufferEdit edit;
};

} // namespace

TEST(ClockBuffersEditor, StoreWritesTheRecordsOfTheTypeWithDefaultNames)
{
    struct Case {
        const char* type;
        const char* i0;
        const char* i1;
        const char* prefix;
        const char* clkinKind;
        Records expected;
    } cases[] = {
        {"BUFG",
         "CLK0",
         "",
         "",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "BUFG"},
          {"TSY_CLKBUF1_BLKNAME", "CLK0_BUFG_INST"},
          {"TSY_CLKBUF1_I_SIGNAME", "CLK0_BUF"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLK0_OUT"}}},
        {"BUFGCE",
         "CLK0",
         "",
         "",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "BUFGCE"},
          {"TSY_CLKBUF1_BLKNAME", "CLK0_BUFGCE_INST"},
          {"TSY_CLKBUF1_I_SIGNAME", "CLK0_BUF"},
          {"TSY_CLKBUF1_CE_SIGNAME", "CLK0_ENABLE_IN"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLK0_OUT"}}},
        {"BUFGMUX",
         "CLK0",
         "CLK90",
         "",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "BUFGMUX"},
          {"TSY_CLKBUF1_BLKNAME", "CLK0_BUFGMUX_INST"},
          {"TSY_CLKBUF1_I0_SIGNAME", "CLK0_BUF"},
          {"TSY_CLKBUF1_I1_SIGNAME", "CLK90_BUF"},
          {"TSY_CLKBUF1_I1_PINNAME", "CLK90"},
          {"TSY_CLKBUF1_S_SIGNAME", "CLK0_SELECT_IN"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLK0_CLK90_OUT"}}},
        {"BUFGCTRL",
         "CLK0",
         "CLK180",
         "U1_",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "BUFGCTRL"},
          {"TSY_CLKBUF1_BLKNAME", "U1_CLK0_BUFGCTRL_INST"},
          {"TSY_CLKBUF1_I0_SIGNAME", "U1_CLK0_BUF"},
          {"TSY_CLKBUF1_I1_SIGNAME", "U1_CLK180_BUF"},
          {"TSY_CLKBUF1_I1_PINNAME", "CLK180"},
          {"TSY_CLKBUF1_S0_SIGNAME", "U1_CLK0_S0_IN"},
          {"TSY_CLKBUF1_S1_SIGNAME", "U1_CLK0_S1_IN"},
          {"TSY_CLKBUF1_CE0_SIGNAME", "U1_CLK0_CE0_IN"},
          {"TSY_CLKBUF1_CE1_SIGNAME", "U1_CLK0_CE1_IN"},
          {"TSY_CLKBUF1_IGNORE0_SIGNAME", "U1_CLK0_IGNORE0_IN"},
          {"TSY_CLKBUF1_IGNORE1_SIGNAME", "U1_CLK0_IGNORE1_IN"},
          {"TSY_CLKBUF1_IGNORE0_PINNAME", "signal"},
          {"TSY_CLKBUF1_IGNORE1_PINNAME", "signal"},
          {"TSY_CLKBUF1_O_SIGNAME", "U1_CLK0_CLK180_OUT"}}},
        {"LOCALROUTING",
         "CLK90",
         "",
         "",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "LOCALROUTING"},
          {"TSY_CLKBUF1_BLKNAME", "CLK90_LOCALROUTING_INST"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLK90_OUT"}}},
        {"BUFG",
         "CLKIN",
         "",
         "",
         "SINGLE",
         {{"TSY_CLKBUFTYPE1", "BUFG"},
          {"TSY_CLKBUF1_BLKNAME", "CLKIN_BUFG_INST"},
          {"TSY_CLKBUF1_I_SIGNAME", "CLKIN_IBUFG"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLKIN_OUT"}}},
        {"BUFG",
         "CLKIN",
         "",
         "",
         "DIFFERENTIAL",
         {{"TSY_CLKBUFTYPE1", "BUFG"},
          {"TSY_CLKBUF1_BLKNAME", "CLKIN_BUFG_INST"},
          {"TSY_CLKBUF1_I_SIGNAME", "CLKIN_IBUFGDS"},
          {"TSY_CLKBUF1_O_SIGNAME", "CLKIN_OUT"}}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.type) + " on " + c.i0);
        Editor e;
        e.p.dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL, c.clkinKind);
        e.Open(c.i0, c.i1, c.type, 0, false, c.prefix);
        ASSERT_TRUE(e.edit.Ok());
        EXPECT_EQ(e.p.RecordsOf(c.i0), c.expected);
        EXPECT_TRUE(e.p.d.Stream().Entries().empty());
    }
}

TEST(ClockBuffersEditor, ChangingTheTypeDropsTheOldPortsRecords)
{
    Editor e;
    e.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    e.edit.SetIgnoreChoice(1, "GND");
    ASSERT_TRUE(e.edit.Ok());
    ASSERT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_IGNORE1_PINNAME"), "GND");
    EXPECT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_IGNORE1_SIGNAME"), "") << "tied, so no signal";

    e.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    EXPECT_EQ(e.edit.GetIgnoreChoice(1), "GND") << "the tie is read back";
    e.edit.SetType("BUFG");
    ASSERT_TRUE(e.edit.Ok());
    EXPECT_EQ(e.p.RecordsOf("CLK0"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"},
                                              {"TSY_CLKBUF1_BLKNAME", "CLK0_BUFG_INST"},
                                              {"TSY_CLKBUF1_I_SIGNAME", "CLK0_BUF"},
                                              {"TSY_CLKBUF1_O_SIGNAME", "CLK0_OUT"}}));
}

TEST(ClockBuffersEditor, GivenNamesStayAndDefaultsFollowTheInputs)
{
    Editor e;
    e.Open("CLK0", "CLK90", "BUFGMUX", 1);
    e.edit.SetSignalName(Tsy_BufferEdit::SlotS, "CLOCK_SELECT");
    EXPECT_EQ(e.edit.GetSignalName(Tsy_BufferEdit::SlotO), "CLK0_CLK90_OUT");
    e.edit.SetI1("CLK180");
    EXPECT_EQ(e.edit.GetSignalName(Tsy_BufferEdit::SlotO), "CLK0_CLK180_OUT");
    EXPECT_EQ(e.edit.GetSignalName(Tsy_BufferEdit::SlotS), "CLOCK_SELECT");
    ASSERT_TRUE(e.edit.Ok());
    // Reopened: the given name is kept, the stored default still follows I1.
    e.Open("CLK0", "CLK180", "BUFGMUX", 1);
    EXPECT_TRUE(e.edit.IsNameGiven(Tsy_BufferEdit::SlotS));
    EXPECT_FALSE(e.edit.IsNameGiven(Tsy_BufferEdit::SlotO));
    e.edit.SetI1("CLK90");
    ASSERT_TRUE(e.edit.Ok());
    EXPECT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_O_SIGNAME"), "CLK0_CLK90_OUT");
    EXPECT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_S_SIGNAME"), "CLOCK_SELECT");
    // An emptied field returns to the default.
    e.Open("CLK0", "CLK90", "BUFGMUX", 1);
    e.edit.SetSignalName(Tsy_BufferEdit::SlotS, "  ");
    EXPECT_EQ(e.edit.GetSignalName(Tsy_BufferEdit::SlotS), "CLK0_SELECT_IN");
}

TEST(ClockBuffersEditor, NamesThatCannotReachTheHdlAreRefused)
{
    struct Case {
        Tsy_BufferEdit::Slot slot;
        const char* name;
        const char* pin;
        const char* why; // empty: accepted
    } cases[] = {
        {Tsy_BufferEdit::SlotO, "1ST_CLOCK", "O", "must begin with a letter"},
        {Tsy_BufferEdit::SlotO, "signal", "O", "is a VHDL keyword"},
        {Tsy_BufferEdit::SlotS1, "wire", "S1", "is a Verilog keyword"},
        {Tsy_BufferEdit::SlotCE, "EN ABLE", "CE0", "may hold only letters, digits and '_'"},
        {Tsy_BufferEdit::SlotIgnore0, "IGN__0", "IGNORE0", "must not hold two '_' in a row (VHDL)"},
        {Tsy_BufferEdit::SlotO, "fast_clock", "O", ""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        Editor e;
        e.Open("CLK0", "CLK90", "BUFGCTRL", 1);
        e.edit.SetSignalName(c.slot, c.name);
        bool ok = e.edit.Ok();
        EXPECT_EQ(ok, *c.why == 0);
        if (*c.why) {
            EXPECT_EQ(strings(e.p.Errors()),
                      std::vector<std::string>{
                          StringBase::Printf("The signal name '%s' of pin %s cannot be used: it %s.  Please "
                                             "enter a name that is legal in both Verilog and VHDL.",
                                             c.name, c.pin, c.why)
                              .str()});
            EXPECT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE1"), "") << "nothing stored";
        } else {
            EXPECT_EQ(e.p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_O_SIGNAME"), c.name);
        }
    }
    // A tied IGNORE pin takes no name, so a bad one there does not matter.
    Editor tied;
    tied.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    tied.edit.SetSignalName(Tsy_BufferEdit::SlotIgnore0, "9");
    tied.edit.SetIgnoreChoice(0, "VCC");
    EXPECT_TRUE(tied.edit.Ok());
}

TEST(ClockBuffersEditor, SelectionsAreRequired)
{
    Editor e;
    e.Open("", "", "BUFG", 0, true);
    EXPECT_FALSE(e.edit.Ok());
    e.edit.SetI0("NONE");
    EXPECT_FALSE(e.edit.Ok());
    e.edit.SetI0("CLK90");
    e.edit.SetType("BUFGMUX");
    EXPECT_FALSE(e.edit.Ok());
    e.edit.SetI1("CLK180");
    EXPECT_TRUE(e.edit.Ok());
    EXPECT_EQ(strings(e.p.Notes()), (std::vector<std::string>{"Please make a selection for the I0 pin.",
                                                              "Please make a selection for the I0 pin.",
                                                              "Please make a selection for the I1 pin."}));
}

TEST(ClockBuffersEditor, DeleteNeedsAnotherBufferOnThePin)
{
    struct Case {
        const char* keyword;
        const char* pmcd;
        int pmcdInst;
        const char* i0;
        bool second;         // the pin holds a second buffer
        std::string refusal; // empty: deleted
    } cases[] = {
        {"dcm", "NONE", 1, "CLK0", false,
         "To remove all buffers from pin CLK0, please return to the General Setup dialog and deselect this pin."},
        {"dcm", "NONE", 1, "CLK0", true, ""},
        {"dcm", "NONE", 1, "CLKIN", false, ""},
        {"dcm", "SINGLE", 1, "CLKB1", false,
         "To remove all buffers from pin CLKB1, please return to the PMCD dialog and deselect this pin."},
        {"dcm", "PARALLEL", 2, "U2 CLKA1", false,
         "To remove all buffers from pin U2 CLKA1, please return to the PMCD dialog and deselect this pin."},
        {"dcm", "PARALLEL", 2, "U2 CLKA1", true, ""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.pmcd) + " " + c.i0 + (c.second ? " with a second buffer" : ""));
        Editor e(c.keyword);
        int inst = 1;
        StringBase pinName = Tsy_BufferEdit::PinNameOf(c.i0, 1, &inst);
        Tsy_Block* block = StringBase(c.pmcd) == "NONE"     ? e.p.dcm
                           : StringBase(c.pmcd) == "SINGLE" ? e.p.d.Wizard().GetActivePMCDBlk(0)
                                                            : e.p.d.Wizard().GetActivePMCDBlk(inst);
        ASSERT_NE(block, nullptr);
        Tsy_Pin* pin = block->GetNamedPin(pinName);
        pin->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFG");
        if (c.second)
            pin->SetAttributeValue("TSY_CLKBUFTYPE2", "LOCALROUTING");
        e.edit.Prepare(1, 1, c.pmcd, c.pmcdInst, "", {}, c.i0, "", "BUFG", 1, false);
        EXPECT_EQ(e.edit.Delete(), c.refusal.empty());
        EXPECT_EQ(strings(e.p.Notes()),
                  c.refusal.empty() ? std::vector<std::string>{} : std::vector<std::string>{c.refusal});
        if (c.refusal.empty()) {
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE1"), c.second ? "LOCALROUTING" : "");
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE2"), "");
        } else {
            EXPECT_EQ(e.edit.GetType(), "BUFG") << "the type choice goes back";
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
        }
    }
}

// ---------------------------------------------------------------- adding and deleting through the page

namespace {

// What a user does in the dialog, for the page to run instead of showing it.
using Action = std::function<bool(Tsy_BufferEdit&)>;

Action add(const char* i0, const char* type, const char* i1 = "")
{
    return [=](Tsy_BufferEdit& e) {
        e.SetI0(i0);
        e.SetType(type);
        e.SetI1(i1);
        return e.Ok();
    };
}

Action remove()
{
    return [](Tsy_BufferEdit& e) { return e.Delete(); };
}

} // namespace

TEST(ClockBuffersEditing, AddedBuffersGoAfterTheOutputsOwnBuffers)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
    p.Load();
    Action next;
    p.gui->SetEditRunner([&](Tsy_BufferEdit& e) { return next(e) ? 1 : 0; });
    next = add("CLK0", "BUFGCE");
    p.gui->AddBuffer();
    next = add("CLK0", "BUFGMUX", "CLK90");
    p.gui->AddBuffer();
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|1", "CLK0||BUFGCE|2|1", "CLK0|CLK90|BUFGMUX|3|1",
                                                  "CLK90||BUFG|1|1"}))
        << p.Dump();
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG") << "the first buffer is kept";
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF2_CE_SIGNAME"), "CLK0_ENABLE_IN");
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF3_O_SIGNAME"), "CLK0_CLK90_OUT");
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue(Tsy_Attr::TSY_CLKMUX_I1), "") << "only existing rows write it";
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);

    // Cancelled or left without a type: nothing is added, and the next
    // buffer takes the same row.
    p.gui->SetEditRunner([](Tsy_BufferEdit&) { return 0; });
    p.gui->AddBuffer();
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);
    next = [](Tsy_BufferEdit& e) {
        e.SetI0("CLK90");
        return e.Delete();
    };
    p.gui->SetEditRunner([&](Tsy_BufferEdit& e) { return next(e) ? 1 : 0; });
    p.gui->AddBuffer();
    EXPECT_EQ(p.Rows().size(), 4u) << p.Dump();
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue("TSY_CLKBUFTYPE2"), "");
}

TEST(ClockBuffersEditing, DeletingABufferMovesTheLaterOnesDown)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
    p.Record("CLK0", "TSY_CLKBUFTYPE1", "BUFG");
    p.Record("CLK0", "TSY_CLKBUFTYPE2", "BUFGCE");
    p.Record("CLK0", "TSY_CLKBUF2_CE_SIGNAME", "RUN");
    p.Record("CLK0", "TSY_CLKBUFTYPE3", "BUFGMUX");
    p.Record("CLK0", "TSY_CLKBUF3_I1_PINNAME", "CLK90");
    p.Record("CLK0", "TSY_CLKBUF3_O_SIGNAME", "MUXED");
    p.Record("CLK0", "TSY_CLKBUFTYPE4", "LOCALROUTING");
    p.Record("CLK0", "TSY_CLKBUFTYPE4_NOEDIT", "DISABLED_BUF");
    p.Load();
    ASSERT_EQ(p.Rows().size(), 5u) << p.Dump();
    Action next = remove();
    p.gui->SetEditRunner([&](Tsy_BufferEdit& e) { return next(e) ? 1 : 0; });
    p.gui->EditRow(2); // the BUFGCE
    EXPECT_EQ(p.RecordsOf("CLK0"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"},
                                            {"TSY_CLKBUFTYPE2", "BUFGMUX"},
                                            {"TSY_CLKBUF2_I1_PINNAME", "CLK90"},
                                            {"TSY_CLKBUF2_O_SIGNAME", "MUXED"},
                                            {"TSY_CLKBUFTYPE3", "LOCALROUTING"},
                                            {"TSY_CLKBUFTYPE3_NOEDIT", "DISABLED_BUF"}}));
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"CLK0||BUFG|1|1", "CLK0|CLK90|BUFGMUX|2|1", "CLK0||LOCALROUTING|3|0",
                                                  "CLK90||BUFG|1|1"}))
        << "no row is left over from before: " << p.Dump();
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);

    // The first buffer can go too while others remain.
    p.gui->EditRow(1);
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUF1_O_SIGNAME"), "MUXED");
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE2"), "LOCALROUTING");
    EXPECT_EQ(p.Pin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE3"), "");
}

TEST(ClockBuffersEditing, EditingAMuxRowRecordsItsI1OnThePin)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180"}).Feedback("NONE").Mode("USE_GRID");
    p.Load();
    Action next = [](Tsy_BufferEdit& e) {
        e.SetType("BUFGMUX");
        e.SetI1("CLK180");
        return e.Ok();
    };
    p.gui->SetEditRunner([&](Tsy_BufferEdit& e) { return next(e) ? 1 : 0; });
    p.gui->EditRow(2);
    EXPECT_EQ(p.Pin("CLK90")->GetAttributeValue(Tsy_Attr::TSY_CLKMUX_I1), "CLK180");
    EXPECT_EQ(p.gui->GetRow(2).type, "BUFGMUX");
    EXPECT_EQ(p.gui->GetRow(2).i1, "CLK180");
    EXPECT_TRUE(p.gui->GetRow(2).edited);
    next = [](Tsy_BufferEdit& e) {
        e.SetType("BUFG");
        return e.Ok();
    };
    p.gui->EditRow(2);
    EXPECT_EQ(p.RecordsOf("CLK90"), (Records{{"TSY_CLKBUFTYPE1", "BUFG"},
                                             {"TSY_CLKBUFTYPE1_NOEDIT", "ENABLED_BUF"},
                                             {"TSY_CLKBUF1_BLKNAME", "CLK90_BUFG_INST"},
                                             {"TSY_CLKBUF1_I_SIGNAME", "CLK90_BUF"},
                                             {"TSY_CLKBUF1_O_SIGNAME", "CLK90_OUT"}}))
        << "no mux left on CLK90, so no I1 record either";
}

TEST(ClockBuffersEditing, ParallelPmcdRowsNameTheirInstance)
{
    BufPage p;
    p.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_PMCD, "PARALLEL");
    Tsy_Block* u1 = p.d.Wizard().GetActivePMCDBlk(1);
    Tsy_Block* u2 = p.d.Wizard().GetActivePMCDBlk(2);
    ASSERT_TRUE(u1 && u2);
    u1->GetNamedPin("CLKD1")->SetIsActive(true);
    u2->GetNamedPin("CLKB1")->SetIsActive(true);
    u2->GetNamedPin("CLKB1")->SetAttributeValue("TSY_CLKBUFTYPE1", "BUFGCE");
    p.Load();
    EXPECT_EQ(p.gui->GetPmcdMode(), "PARALLEL");
    EXPECT_EQ(p.Rows(), (std::vector<std::string>{"U1 CLKA1||BUFG|1|1", "U1 CLKD1||BUFG|1|1", "U2 CLKA1||BUFG|1|1",
                                                  "U2 CLKB1||BUFGCE|1|1"}))
        << p.Dump();
    EXPECT_EQ(p.gui->GetRow(4).pmcdInst, 2);
    EXPECT_EQ(u2->GetNamedPin("CLKA1")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(p.dcm->GetNamedPin("CLK0")->GetAttributeValue("TSY_CLKBUFTYPE1"), "") << "the DCM is not the source";
    // Edited through the page: the records land on the second PMCD.
    Action next = [](Tsy_BufferEdit& e) {
        e.SetSignalName(Tsy_BufferEdit::SlotO, "FAST_CLK");
        return e.Ok();
    };
    p.gui->SetEditRunner([&](Tsy_BufferEdit& e) { return next(e) ? 1 : 0; });
    p.gui->EditRow(4);
    EXPECT_EQ(u2->GetNamedPin("CLKB1")->GetAttributeValue("TSY_CLKBUF1_O_SIGNAME"), "FAST_CLK");
    EXPECT_EQ(u2->GetNamedPin("CLKB1")->GetAttributeValue("TSY_CLKBUF1_BLKNAME"), "CLKB1_BUFGCE_INST");
    EXPECT_TRUE(p.gui->StoreToBlock(true)) << "PMCD designs skip the DCM checks";
}

// ---------------------------------------------------------------- the logical page

TEST(ClockBuffersPage, WithoutAnApplicationNoFormCanBeMade)
{
    BufPage p("dcm", "t5da1-1", 1, false);
    ASSERT_NE(p.page, nullptr);
    EXPECT_FALSE(p.page->CreateGui(nullptr));
    EXPECT_EQ(p.page->GetGui(), nullptr);
    EXPECT_EQ(strings(p.Errors()), std::vector<std::string>{"Internal error: unable to create GUI object"});
}

TEST(ClockBuffersPage, SilentApplyStoresAndChecks)
{
    BufPage good;
    good.Outputs({"CLK0", "CLK180"}).Feedback("INTERNAL").Mode("USE_GRID");
    EXPECT_TRUE(good.page->ApplySilently());
    EXPECT_EQ(good.RecordsOf("CLK180"),
              (Records{{"TSY_CLKBUFTYPE1", "BUFG"}, {"TSY_CLKBUFTYPE1_NOEDIT", "ENABLED_BUF"}}));
    EXPECT_EQ(good.page->GetGui()->pageWidget(), nullptr) << "no widget in batch mode";

    BufPage bad;
    bad.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID");
    bad.Record("CLK0", "TSY_CLKBUFTYPE1", "LOCALROUTING");
    EXPECT_FALSE(bad.page->ApplySilently());
    EXPECT_EQ(strings(bad.Errors()), std::vector<std::string>{internalMessage("CLK0")});
    EXPECT_TRUE(bad.d.Stream().Entries().front().logged);
}

// ---------------------------------------------------------------- whole batch runs

namespace {

struct BatchRun {
    CommandResult result;
    nlohmann::json design;

    // The wizard's records on a pin of the DCM.
    Records RecordsOf(const std::string& pin) const
    {
        Records out;
        for (const auto& b : design["blocks"])
            if (b["type"] == "DCM_ADV" || b["type"] == "DCM")
                for (const auto& p : b["pins"])
                    if (p["name"] == pin && p.contains("attributes"))
                        for (const auto& [k, v] : p["attributes"].items())
                            if (k.rfind("TSY_CLKBUF", 0) == 0)
                                out[k] = v.is_string() ? v.get<std::string>() : v["value"].get<std::string>();
        return out;
    }
    std::string Dcm(const std::string& attr) const
    {
        for (const auto& b : design["blocks"])
            if ((b["type"] == "DCM_ADV" || b["type"] == "DCM") && b["attributes"].contains(attr)) {
                const auto& v = b["attributes"][attr];
                return v.is_string() ? v.get<std::string>() : v["value"].get<std::string>();
            }
        return "";
    }
};

BatchRun generate(const std::string& args)
{
    TempDir dir;
    BatchRun run;
    run.result =
        RunCommand(std::string(PENDRA_BIN_DIR) + "/pendra generate " + args + " --module clocks -o " + dir.Path());
    std::string text = ReadTextFile(dir.File("clocks.tsw"));
    if (!text.empty())
        run.design = nlohmann::json::parse(text);
    return run;
}

} // namespace

TEST(ClockBuffersBatch, SettingsReachThePinRecords)
{
    BatchRun r =
        generate("--wizard dcm --part t5da1-1 --set dcm.USE_BUFG=USE_GRID --pin dcm.CLK90=on --pin dcm.CLK180=on "
                 "--set dcm.CLK90.TSY_CLKBUFTYPE1=BUFGMUX --set dcm.CLK90.TSY_CLKBUF1_I1_PINNAME=CLK180 "
                 "--set dcm.CLK180.TSY_CLKBUFTYPE1=LOWSKEWLINE");
    ASSERT_EQ(r.result.status, 0) << r.result.err;
    EXPECT_EQ(r.Dcm("USE_BUFG"), "USE_GRID");
    EXPECT_EQ(r.RecordsOf("CLK90").at("TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(r.RecordsOf("CLK90").at("TSY_CLKBUF1_I1_PINNAME"), "CLK180");
    EXPECT_EQ(r.RecordsOf("CLK180").at("TSY_CLKBUFTYPE1"), "LOCALROUTING");
    EXPECT_NE(r.result.err.find("INFO: The output 'CLK180' was previously configured to use Lowskewlines"),
              std::string::npos)
        << r.result.err;
}

TEST(ClockBuffersBatch, GlobalBuffersForAllByDefault)
{
    BatchRun r = generate("--wizard dcm --part t5da1-1 --pin dcm.CLK90=on --pin dcm.CLKDV=on");
    ASSERT_EQ(r.result.status, 0) << r.result.err;
    EXPECT_EQ(r.Dcm("USE_BUFG"), "USE_BUFGS");
    EXPECT_EQ(r.RecordsOf("CLK90").at("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(r.RecordsOf("CLKDV").at("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_TRUE(r.RecordsOf("CLKIN").empty());
}

TEST(ClockBuffersBatch, RefusedConfigurationsWriteNothing)
{
    BatchRun r = generate("--wizard dcm --part t5da1-1 --set dcm.FB_SOURCE=EXTERNAL --set dcm.USE_BUFG=USE_GRID "
                          "--set dcm.CLK0.TSY_CLKBUFTYPE1=BUFGCTRL");
    EXPECT_EQ(r.result.status, 1);
    EXPECT_NE(r.result.err.find("ERROR: The 'Feedback Source' is External CLK0.  CLK0 is connected to a BUFGCTRL, "
                                "which is not allowed."),
              std::string::npos)
        << r.result.err;
    EXPECT_TRUE(r.design.is_null()) << "nothing written";
}

TEST(ClockBuffersBatch, TooManyGlobalBuffersIsANoteWithoutTheQuestion)
{
    BatchRun r = generate("--wizard dcm --part t2a250-4 --pin dcm.CLK90=on --pin dcm.CLK180=on --pin dcm.CLK270=on "
                          "--pin dcm.CLKDV=on");
    ASSERT_EQ(r.result.status, 0) << r.result.err;
    EXPECT_NE(r.result.err.find(std::string("INFO: ") + kTooManyNote), std::string::npos) << r.result.err;
    EXPECT_EQ(r.result.err.find("Do you want to continue?"), std::string::npos);
}

TEST(ClockBuffersBatch, AnOlderDesignFileIsConverted)
{
    TempDir dir;
    std::string path = dir.File("older.tsw");
    {
        std::ofstream out(path);
        out << kOlderDesign;
    }
    BatchRun r = generate(path);
    ASSERT_EQ(r.result.status, 0) << r.result.err;
    EXPECT_EQ(r.RecordsOf("CLK90").at("TSY_CLKBUFTYPE1"), "BUFGMUX");
    EXPECT_EQ(r.RecordsOf("CLK90").at("TSY_CLKBUF1_I1_PINNAME"), "CLKFX");
    EXPECT_EQ(r.RecordsOf("CLK180").at("TSY_CLKBUFTYPE1"), "LOCALROUTING");
}
