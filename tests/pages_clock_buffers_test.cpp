// The Clock Buffers page and its buffer editor on a real design database,
// without widgets: the rows derived from the outputs' buffer records in both
// modes, the default records written, the repairs of older records, the two
// checks of Next with their messages, the conversion of designs written by
// older versions, and what storing, adding and deleting a buffer leaves on
// the pins. Then whole batch runs of pendra.

#include "design/Tsy_DesignFile.h"
#include "pages/dcm/Tsy_BufferEdit.h"
#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "support/BatchRun.h"
#include "wizard/Tsy_Vocabulary.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

namespace {

const char* const kDcmOutputs[] = {"CLK0",  "CLK90",    "CLK180", "CLK270",  "CLKDV",
                                   "CLK2X", "CLK2X180", "CLKFX",  "CLKFX180"};

// Records are written "TYPE1=BUFG 1_O_SIGNAME=SYS_CLK": the wizard's names
// without their TSY_CLKBUF; a name that begins TSY_ stands as it is.
std::string recordName(const std::string& key)
{
    return key.rfind("TSY_", 0) == 0 ? key : "TSY_CLKBUF" + key;
}

Records R(const std::string& records)
{
    Records out;
    std::istringstream in(records);
    for (std::string item; in >> item;)
        out[recordName(item.substr(0, item.find('=')))] = item.substr(item.find('=') + 1);
    return out;
}

using Rows = std::vector<std::string>;

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
        page = FindPage<Tsy_ClockBufDlg>(d.Wizard(), inst);
        dcm = d.Wizard().GetActiveDCMBlk(inst, false);
        EXPECT_TRUE(page && dcm);
    }

    // Exactly these outputs selected.
    BufPage& Outputs(const std::vector<const char*>& on)
    {
        for (const char* o : kDcmOutputs)
            Pin(o)->SetIsActive(false);
        for (const char* o : on)
            Pin(o)->SetIsActive(true);
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
    // Records as other pages leave them: "CLK0:TYPE1=BUFGCE CLK90:TYPE2=BUFG".
    BufPage& Records(const std::string& records)
    {
        std::istringstream in(records);
        for (std::string item; in >> item;) {
            size_t colon = item.find(':'), eq = item.find('=');
            Pin(item.substr(0, colon).c_str())
                ->SetAttributeValue(recordName(item.substr(colon + 1, eq - colon - 1)), item.substr(eq + 1));
        }
        return *this;
    }
    Tsy_Pin* Pin(const char* name) { return dcm->GetNamedPin(name); }
    std::string Record(const char* pin, const char* key) { return Pin(pin)->GetAttributeValue(recordName(key)).str(); }

    // Page entry as the batch run does it.
    Tsy_ClockBufDlgGui* Load()
    {
        gui = page->Controller();
        gui->SetNamePrefix();
        gui->LoadFromBlock();
        gui->RefreshRows(true);
        return gui;
    }
    // What the user does in the dialog, run by the page instead of showing it.
    void OnEdit(const std::function<bool(Tsy_BufferEdit&)>& action)
    {
        gui->SetEditRunner([action](Tsy_BufferEdit& e) { return action(e) ? 1 : 0; });
    }

    // "I0|I1|type|n|state" for each row that shows something.
    Rows RowList() const
    {
        Rows out;
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
    // The wizard's records on a pin ("TSY_CLK..." and "TSY_PMCD..." only).
    ::Records RecordsOf(const char* pin)
    {
        ::Records out;
        for (const auto& a : Pin(pin)->Attributes())
            if (a->GetName().StartsWith("TSY_"))
                out[a->GetName().str()] = a->GetValue().str();
        return out;
    }
    std::vector<std::string> Notes() { return Texts(d.Stream().Notes()); }
    std::vector<std::string> Errors() { return Texts(d.Stream().Errors()); }
    bool Silent() { return d.Stream().Entries().empty(); }

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

std::string externalMessage(const char* out, const char* type)
{
    return StringBase::Printf("The 'Feedback Source' is External %s.  %s is connected to a %s, which is not allowed.  "
                              "Please change the selection for %s to use something other than Clock Mux or Enabled "
                              "Buffer.",
                              out, out, type, out)
        .str();
}

const char* const kTooManyNote =
    "More than four DCM outputs are driving global buffers.  Only a maximum of four DCM outputs can use dedicated "
    "routing to global buffers on the same half of the FPGA.  The remaining outputs will use local routing to the "
    "global buffer.";

std::string fullNote(const char* out)
{
    return std::string("The maximum of 16 supported buffers has been reached.  ") + out + " will not be processed.";
}

} // namespace

// ---------------------------------------------------------------- rows

TEST(ClockBuffersRows, GlobalModeGivesEveryOutputAGlobalBuffer)
{
    struct Case {
        const char* name;
        std::vector<const char*> outputs;
        const char *feedback, *multiple, *clkinSource;
        std::vector<std::string> recorded; // outputs that get a BUFG record
    } cases[] = {
        {"CLK0 alone, internal 1X feedback: the feedback buffer is not recorded here", {"CLK0"}, "INTERNAL", "1X",
         "EXTERNAL", {}},
        {"three outputs; CLKIN is listed but takes no row", {"CLK0", "CLK90", "CLKFX"}, "INTERNAL", "1X", "EXTERNAL",
         {"CLK90", "CLKFX"}},
        {"2X feedback closes through CLK2X", {"CLK0", "CLK2X"}, "INTERNAL", "2X", "INTERNAL", {"CLK0"}},
        {"external feedback: every output is recorded", {"CLK0", "CLKDV"}, "EXTERNAL", "1X", "EXTERNAL",
         {"CLK0", "CLKDV"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p;
        p.Outputs(c.outputs).Feedback(c.feedback, c.multiple).Mode("USE_BUFGS");
        p.dcm->SetAttributeValue(Tsy_Attr::CLKIN_SRC_TYPE, c.clkinSource);
        p.Load();
        EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeGlobal);
        Rows rows;
        for (const char* o : c.outputs)
            rows.push_back(std::string(o) + "||BUFG|1|1");
        EXPECT_EQ(p.RowList(), rows);
        EXPECT_EQ(p.gui->GetLastUsedRow(), static_cast<int>(rows.size()));
        for (const char* o : kDcmOutputs)
            EXPECT_EQ(p.Record(o, "TYPE1") == "BUFG", Contains(c.recorded, o)) << o;
        EXPECT_TRUE(p.RecordsOf("CLKIN").empty()) << "CLKIN gets no default record";
        EXPECT_TRUE(p.gui->StoreToBlock(true));
        EXPECT_EQ(p.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_BUFGS");
        EXPECT_TRUE(p.Silent());
    }
}

TEST(ClockBuffersRows, CustomizeModeReadsTheRecordsOfEachOutput)
{
    struct Case {
        const char* name;
        std::vector<const char*> outputs;
        const char* feedback;
        const char* mode; // null: no USE_BUFG attribute
        const char* records;
        Rows rows;
    } cases[] = {
        {"the feedback output gets a greyed row and no record", {"CLK0", "CLK90"}, "INTERNAL", "USE_GRID", "",
         {"CLK0||BUFG|1|2", "CLK90||BUFG|1|1"}},
        {"two buffers on CLK0, the mux naming its I1 itself", {"CLK0", "CLK90"}, "EXTERNAL", "USE_GRID",
         "CLK0:TYPE1=BUFGCE CLK0:TYPE2=BUFGMUX CLK0:2_I1_PINNAME=CLK90",
         {"CLK0||BUFGCE|1|1", "CLK0|CLK90|BUFGMUX|2|1", "CLK90||BUFG|1|1"}},
        {"a mux without its own I1 takes the output's TSY_CLKMUX_I1", {"CLK0", "CLK90"}, "NONE", "USE_GRID",
         "CLK0:TYPE1=BUFGCTRL CLK0:TSY_CLKMUX_I1=CLK90", {"CLK0|CLK90|BUFGCTRL|1|1", "CLK90||BUFG|1|1"}},
        {"states other pages preset are honoured", {"CLK0", "CLK90"}, "NONE", "USE_GRID",
         "CLK0:TYPE1=BUFG CLK0:TYPE1_NOEDIT=DISABLED_BUF CLK0:TYPE2=OBUF CLK0:TYPE2_NOEDIT=TRUE CLK90:TYPE1=BUFG "
         "CLK90:TYPE1_NOEDIT=DEFAULT_BUF",
         {"CLK0||BUFG|1|0", "CLK0||OBUF|2|0", "CLK90||BUFG|1|3"}},
        {"a buffer on CLKIN takes a row after the outputs", {"CLK0"}, "NONE", "USE_GRID", "CLKIN:TYPE1=BUFGCE",
         {"CLK0||BUFG|1|1", "CLKIN||BUFGCE|1|1"}},
        {"no mode attribute means customize", {"CLK0"}, "NONE", nullptr, "", {"CLK0||BUFG|1|1"}},
        {"so does a mode it does not know", {"CLK0"}, "NONE", "something else", "", {"CLK0||BUFG|1|1"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p;
        p.Outputs(c.outputs).Feedback(c.feedback).Records(c.records);
        if (c.mode)
            p.Mode(c.mode);
        else
            p.dcm->RemoveAttribute(Tsy_Attr::USE_BUFG);
        p.Load();
        EXPECT_EQ(p.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
        EXPECT_EQ(p.RowList(), c.rows);
        EXPECT_TRUE(p.Silent());
    }
}

TEST(ClockBuffersRows, CustomizeModeRecordsTheDefaultBufferOfEveryOtherOutput)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("INTERNAL").Mode("USE_GRID").Load();
    EXPECT_EQ(p.RecordsOf("CLK0"), Records{}) << "the feedback path builds its own buffer";
    EXPECT_EQ(p.RecordsOf("CLK90"), R("TYPE1=BUFG TYPE1_NOEDIT=ENABLED_BUF"));
    EXPECT_EQ(p.RecordsOf("CLKIN"), Records{});
    int opened = 0;
    p.gui->SetEditRunner([&](Tsy_BufferEdit&) { return ++opened; });
    p.gui->EditRow(1);
    EXPECT_EQ(opened, 0) << "the feedback row cannot be opened";
    p.gui->EditRow(2);
    EXPECT_EQ(opened, 1);
}

TEST(ClockBuffersRows, OutputsBeyondSixteenRowsAreReportedOnceEach)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180", "CLK270", "CLKDV", "CLK2X", "CLK2X180", "CLKFX", "CLKFX180"})
        .Feedback("NONE")
        .Mode("USE_GRID");
    // Two buffers on each of the first eight outputs fill the sixteen rows.
    for (int i = 0; i < 8; ++i)
        p.Records(std::string(kDcmOutputs[i]) + ":TYPE1=BUFG " + kDcmOutputs[i] + ":TYPE2=LOCALROUTING");
    p.Records("CLKIN:TYPE1=BUFGCE").Load();
    EXPECT_EQ(p.RowList().size(), 16u);
    EXPECT_EQ(p.gui->GetLastUsedRow(), 16);
    EXPECT_EQ(p.Notes(), (std::vector<std::string>{fullNote("CLKFX180"), fullNote("CLKIN")}));
    EXPECT_EQ(p.RecordsOf("CLKFX180"), Records{}) << "an output left over gets no default record";

    // Seventeen buffers: the eighth output's second buffer is the one left over.
    p.d.Stream().Clear();
    p.Records("CLK0:TYPE3=BUFGCE");
    p.gui->AssignDefaultBuffers();
    EXPECT_EQ(p.Notes(), (std::vector<std::string>{fullNote("CLKFX"), fullNote("CLKFX180"), fullNote("CLKIN")}));
    p.gui->AddBuffer();
    EXPECT_EQ(p.Notes().back(), "Maximum number of rows reached for this dialog. No additional rows can be displayed.");
}

TEST(ClockBuffersRows, OlderRecordsAreRepaired)
{
    struct Case {
        const char *part, *stored, *becomes;
        bool note;
    } cases[] = {
        {"t5da1-1", "LOWSKEWLINE", "LOCALROUTING", true},      {"t2a250-4", "LOWSKEWLINE", "LOCALROUTING", true},
        {"t5da1-1", "BUFGMUX_TALDOR4", "BUFGMUX_CTRL", false}, {"t4a25-10", "BUFGMUX_TALDOR4", "BUFGMUX_TALDOR4", false},
        {"t5da1-1", "SOMETHING_NEW", "SOMETHING_NEW", false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.part) + " " + c.stored);
        BufPage p("dcm", c.part);
        p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID").Records(std::string("CLK90:TYPE1=") + c.stored);
        p.Load();
        EXPECT_EQ(p.Record("CLK90", "TYPE1"), c.becomes);
        EXPECT_EQ(p.gui->GetRow(2).type, c.becomes);
        std::vector<std::string> expected;
        if (c.note)
            expected.push_back("The output 'CLK90' was previously configured to use Lowskewlines, but this option is "
                               "no longer allowed.  The Lowskewlines selection has been changed to Local Routing.");
        EXPECT_EQ(p.Notes(), expected);
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
    second.Outputs({"CLK0", "CLKDV"}).Feedback("INTERNAL").Mode("USE_BUFGS").Load();
    EXPECT_EQ(second.gui->GetNamePrefix(), "U2_");
    EXPECT_EQ(second.gui->pageName().toStdString(), "Clock Buffers for INST2");
    EXPECT_EQ(second.RowList(), (Rows{"CLK0||BUFG|1|1", "CLKDV||BUFG|1|1"}));
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
    switching.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_BUFGS").Load();
    EXPECT_EQ(switching.gui->GetMode(), Tsy_ClockBufDlgGui::ModeCustomize);
}

TEST(ClockBuffersRows, SwitchingModesResetsTheEditableBuffers)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Records("CLK90:TYPE1=BUFGCE CLK180:TYPE1=BUFGMUX CLK180:TYPE1_NOEDIT=DISABLED_BUF CLK180:1_I1_PINNAME=CLK90");
    p.Load();
    // Global buffers for all: the editable CLK90 becomes a BUFG; the buffer
    // another page fixed keeps its type.
    p.gui->OnRadioUseBufgs();
    EXPECT_EQ(p.Record("CLK90", "TYPE1"), "BUFG");
    EXPECT_EQ(p.Record("CLK180", "TYPE1"), "BUFGMUX");
    EXPECT_EQ(p.RowList(), (Rows{"CLK0||BUFG|1|1", "CLK90||BUFG|1|1", "CLK180||BUFG|1|0"}));
    // And back: the editable rows start over from a default Global Buffer.
    p.gui->OnRadioUseGrid();
    EXPECT_EQ(p.RecordsOf("CLK90"), R("TYPE1=BUFG TYPE1_NOEDIT=ENABLED_BUF"));
    EXPECT_EQ(p.RowList(), (Rows{"CLK0||BUFG|1|2", "CLK90||BUFG|1|1", "CLK180|CLK90|BUFGMUX|1|0"}));
    // A second click on the customize button changes nothing.
    p.Records("CLK90:TYPE1=BUFGCE");
    p.gui->AssignDefaultBuffers();
    p.gui->OnRadioUseGrid();
    EXPECT_EQ(p.Record("CLK90", "TYPE1"), "BUFGCE");
}

TEST(ClockBuffersRows, GlobalModeStoresOneBufferPerOutput)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("INTERNAL").Mode("USE_GRID");
    p.Records("CLK0:TYPE1=BUFG CLK0:TYPE1_NOEDIT=FEEDBACK_BUF CLK90:TYPE1=BUFG CLK90:TYPE2=BUFGCE "
              "CLK90:2_CE_SIGNAME=EN CLK90:TYPE3=LOCALROUTING CLK90:TYPE3_NOEDIT=DISABLED_BUF");
    p.Load();
    ASSERT_EQ(p.RowList().size(), 4u);
    p.gui->OnRadioUseBufgs();
    EXPECT_EQ(p.RowList().size(), 2u);
    // Still there while the page is open: customizing again brings them back.
    EXPECT_EQ(p.Record("CLK90", "TYPE2"), "BUFGCE");
    ASSERT_TRUE(p.gui->StoreToBlock(true));
    EXPECT_EQ(p.RecordsOf("CLK90"), R("TYPE1=BUFG TYPE2=LOCALROUTING TYPE2_NOEDIT=DISABLED_BUF"));
    EXPECT_EQ(p.RecordsOf("CLK0"), R("TYPE1=BUFG TYPE1_NOEDIT=FEEDBACK_BUF"));
    EXPECT_EQ(p.Notes(), std::vector<std::string>{"Every output uses one Global Buffer (USE_BUFG is USE_BUFGS), so "
                                                  "buffer 2 (BUFGCE) of CLK90 was removed."});
}

// ---------------------------------------------------------------- checks on Next

TEST(ClockBuffersChecks, FeedbackBuffer)
{
    struct Case {
        const char* name;
        const char *feedback, *multiple, *records;
        std::string error; // empty: passes
    } cases[] = {
        {"internal feedback with a BUFG row passes", "INTERNAL", "1X", "", ""},
        {"internal feedback on an Enabled Buffer fails naming CLK0 three times", "INTERNAL", "1X", "CLK0:TYPE1=BUFGCE",
         internalMessage("CLK0")},
        {"a second buffer of the feedback output may be the BUFG", "INTERNAL", "1X",
         "CLK0:TYPE1=BUFGCE CLK0:TYPE2=BUFG CLK0:TYPE2_NOEDIT=FEEDBACK_BUF", ""},
        {"2X feedback looks at CLK2X", "INTERNAL", "2X", "CLK0:TYPE1=BUFGCE CLK2X:TYPE1=LOCALROUTING",
         internalMessage("CLK2X")},
        {"external feedback on a BUFGCTRL names the stored type", "EXTERNAL", "1X", "CLK0:TYPE1=BUFGCTRL",
         externalMessage("CLK0", "BUFGCTRL")},
        {"external feedback on an Enabled Buffer", "EXTERNAL", "2X", "CLK2X:TYPE1=BUFGCE",
         externalMessage("CLK2X", "BUFGCE")},
        {"external feedback through local routing passes", "EXTERNAL", "1X", "CLK0:TYPE1=LOCALROUTING", ""},
        {"no feedback at all leaves CLK0 free", "NONE", "1X", "CLK0:TYPE1=BUFGMUX", ""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        BufPage p;
        p.Outputs({"CLK0", "CLK2X"}).Feedback(c.feedback, c.multiple).Mode("USE_GRID").Records(c.records).Load();
        EXPECT_EQ(p.gui->StoreToBlock(true), c.error.empty());
        EXPECT_EQ(p.Errors(), c.error.empty() ? std::vector<std::string>{} : std::vector<std::string>{c.error});
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
            p.Records(std::string(outs[i]) + ":TYPE1=" + c.types[i]);
        }
        p.Load();
        EXPECT_TRUE(p.gui->StoreToBlock(true)) << "batch runs go on";
        EXPECT_TRUE(p.d.Stream().Questions().empty());
        EXPECT_EQ(p.Notes(), c.note ? std::vector<std::string>{kTooManyNote} : std::vector<std::string>{});
    }
}

TEST(ClockBuffersChecks, LeavingThroughBackNeverComplains)
{
    BufPage p;
    p.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID").Records("CLK0:TYPE1=BUFGCE").Load();
    EXPECT_TRUE(p.gui->onBack());
    EXPECT_TRUE(p.Silent());
    EXPECT_TRUE(p.gui->IsLeftByBack());
    EXPECT_EQ(p.dcm->GetAttributeValue(Tsy_Attr::USE_BUFG), "USE_GRID");
    EXPECT_FALSE(p.gui->StoreToBlock(true)) << "the check still fails, silently";
    EXPECT_TRUE(p.Silent());

    // Without a page there is nothing to store.
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

// CLK90 on a net an older version marked for local routing or low-skew lines.
void markedNet(BufPage& p, const char* mark)
{
    p.Pin("CLK90")->SetSigName("CLK90_NET");
    p.d.Data().AddSignal("CLK90_NET", false, "")->AddAttribute(mark, "TRUE");
}

} // namespace

TEST(ClockBuffersLegacy, BufferBlocksAndNetMarksBecomeRecords)
{
    BufPage p("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.2.03"; });
    Tsy_DesignFile::LoadText(kOlderDesign, "older.tsw", p.d.Data());
    p.Load();
    EXPECT_EQ(p.RecordsOf("CLK0"), R("TYPE1=BUFG 1_O_SIGNAME=SYS_CLK"));
    EXPECT_EQ(p.RecordsOf("CLK90"), R("TYPE1=BUFGMUX 1_I1_PINNAME=CLKFX 1_S_SIGNAME=SEL 1_O_SIGNAME=MUX_CLK"));
    EXPECT_EQ(p.RecordsOf("CLK180"), R("TYPE1=LOCALROUTING 1_O_SIGNAME=CLK180_OUT"));
    EXPECT_EQ(p.RecordsOf("CLK270"), R("TYPE1=BUFG")) << "no net: a Global Buffer";
    // CLKFX feeds the mux's I1 only: that mux is CLK90's; CLKFX gets the default.
    EXPECT_EQ(p.RecordsOf("CLKFX"), R("TYPE1=BUFG TYPE1_NOEDIT=ENABLED_BUF"));
    EXPECT_EQ(p.RowList(), (Rows{"CLK0||BUFG|1|1", "CLK90|CLKFX|BUFGMUX|1|1", "CLK180||LOCALROUTING|1|1",
                                 "CLK270||BUFG|1|1", "CLKFX||BUFG|1|1"}));
    // Finish builds the buffers anew from the records.
    EXPECT_FALSE(p.d.Data().GetNamedBlock("CLK0_BUFG_INST")->active);
    EXPECT_FALSE(p.d.Data().GetNamedBlock("CLK90_BUFGMUX_INST")->active);
}

TEST(ClockBuffersLegacy, OnlyOlderVersionsOnEntryAreConverted)
{
    struct Case {
        const char *keyword, *version;
        bool loaded;
        const char* useBufg;
        bool converted;
    } cases[] = {
        {"dcm", "6.2.03", true, "USE_GRID", true},         {"dcm", "6.1", true, "USE_GRID", true},
        {"dcm", "", true, "USE_GRID", true},               {"dcm", "6.3", true, "USE_GRID", false},
        {"dcm", "1.0.0", true, "USE_GRID", false},         {"dcm", "6.2", false, "USE_GRID", false}, // a new design
        {"dcm", "6.2", true, "USE_BUFGS", false},          // global-buffer mode
        {"dcm_bddeskew", "6.3.1", true, "USE_GRID", true}, {"dcm_clkswitch", "6.1", true, "USE_GRID", false},
        {"dcm_clkswitch", "6.2", true, "USE_GRID", true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.keyword) + " version '" + c.version + "' " + c.useBufg);
        BufPage p(c.keyword, "t5da1-1", 1, true, [&](Tsy_WizContext& ctx) {
            ctx.designVersion = c.version;
            ctx.loadedDesign = c.loaded;
        });
        p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode(c.useBufg);
        markedNet(p, Tsy_Attr::USELOCALROUTING);
        p.Load();
        EXPECT_EQ(p.Record("CLK90", "TYPE1"), c.converted ? "LOCALROUTING" : "BUFG");
    }
}

TEST(ClockBuffersLegacy, NotAfterLeavingThroughBackNorOnAModeSwitch)
{
    BufPage p("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.2"; });
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
    markedNet(p, Tsy_Attr::USELOWSKEWLINES);
    p.Load();
    p.gui->onBack();
    p.Pin("CLK90")->RemoveAllPropsWBase("TSY_CLKBUF");
    p.gui->LoadFromBlock();
    p.gui->RefreshRows(true);
    EXPECT_EQ(p.Record("CLK90", "TYPE1"), "BUFG");

    BufPage q("dcm", "t5da1-1", 1, true, [](Tsy_WizContext& c) { c.designVersion = "6.1"; });
    q.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_BUFGS");
    markedNet(q, Tsy_Attr::USELOCALROUTING);
    q.Load();
    q.Pin("CLK90")->RemoveAllPropsWBase("TSY_CLKBUF");
    q.gui->OnRadioUseGrid();
    EXPECT_EQ(q.Record("CLK90", "TYPE1"), "BUFG") << "a mode switch is no reload";
}

// ---------------------------------------------------------------- the buffer editor

namespace {

// The editor of a page in a GUI-mode wizard (so that its refusals speak),
// prepared with one row of the DCM's outputs.
class Editor {
public:
    explicit Editor(const char* keyword = "dcm") : p(keyword, "t5da1-1", 1, false), edit(p.page)
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
        const char *type, *i0, *i1, *prefix, *clkinKind, *records;
    } cases[] = {
        {"BUFG", "CLK0", "", "", "SINGLE",
         "TYPE1=BUFG 1_BLKNAME=CLK0_BUFG_INST 1_I_SIGNAME=CLK0_BUF 1_O_SIGNAME=CLK0_OUT"},
        {"BUFGCE", "CLK0", "", "", "SINGLE",
         "TYPE1=BUFGCE 1_BLKNAME=CLK0_BUFGCE_INST 1_I_SIGNAME=CLK0_BUF 1_CE_SIGNAME=CLK0_ENABLE_IN "
         "1_O_SIGNAME=CLK0_OUT"},
        {"BUFGMUX", "CLK0", "CLK90", "", "SINGLE",
         "TYPE1=BUFGMUX 1_BLKNAME=CLK0_BUFGMUX_INST 1_I0_SIGNAME=CLK0_BUF 1_I1_SIGNAME=CLK90_BUF 1_I1_PINNAME=CLK90 "
         "1_S_SIGNAME=CLK0_SELECT_IN 1_O_SIGNAME=CLK0_CLK90_OUT"},
        {"BUFGCTRL", "CLK0", "CLK180", "U1_", "SINGLE",
         "TYPE1=BUFGCTRL 1_BLKNAME=U1_CLK0_BUFGCTRL_INST 1_I0_SIGNAME=U1_CLK0_BUF 1_I1_SIGNAME=U1_CLK180_BUF "
         "1_I1_PINNAME=CLK180 1_S0_SIGNAME=U1_CLK0_S0_IN 1_S1_SIGNAME=U1_CLK0_S1_IN 1_CE0_SIGNAME=U1_CLK0_CE0_IN "
         "1_CE1_SIGNAME=U1_CLK0_CE1_IN 1_IGNORE0_SIGNAME=U1_CLK0_IGNORE0_IN 1_IGNORE1_SIGNAME=U1_CLK0_IGNORE1_IN "
         "1_IGNORE0_PINNAME=signal 1_IGNORE1_PINNAME=signal 1_O_SIGNAME=U1_CLK0_CLK180_OUT"},
        {"LOCALROUTING", "CLK90", "", "", "SINGLE",
         "TYPE1=LOCALROUTING 1_BLKNAME=CLK90_LOCALROUTING_INST 1_O_SIGNAME=CLK90_OUT"},
        {"BUFG", "CLKIN", "", "", "SINGLE",
         "TYPE1=BUFG 1_BLKNAME=CLKIN_BUFG_INST 1_I_SIGNAME=CLKIN_IBUFG 1_O_SIGNAME=CLKIN_OUT"},
        {"BUFG", "CLKIN", "", "", "DIFFERENTIAL",
         "TYPE1=BUFG 1_BLKNAME=CLKIN_BUFG_INST 1_I_SIGNAME=CLKIN_IBUFGDS 1_O_SIGNAME=CLKIN_OUT"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.type) + " on " + c.i0 + " " + c.clkinKind);
        Editor e;
        e.p.dcm->SetAttributeValue(Tsy_Attr::TESY_ONLY_CLKIN_EXTERNAL, c.clkinKind);
        e.Open(c.i0, c.i1, c.type, 0, false, c.prefix);
        ASSERT_TRUE(e.edit.Ok());
        EXPECT_EQ(e.p.RecordsOf(c.i0), R(c.records));
        EXPECT_TRUE(e.p.Silent());
    }
}

TEST(ClockBuffersEditor, ChangingTheTypeDropsTheOldPortsRecords)
{
    Editor e;
    e.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    e.edit.SetIgnoreChoice(1, "GND");
    ASSERT_TRUE(e.edit.Ok());
    ASSERT_EQ(e.p.Record("CLK0", "1_IGNORE1_PINNAME"), "GND");
    EXPECT_EQ(e.p.Record("CLK0", "1_IGNORE1_SIGNAME"), "") << "tied, so no signal";
    e.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    EXPECT_EQ(e.edit.GetIgnoreChoice(1), "GND") << "the tie is read back";
    e.edit.SetType("BUFG");
    ASSERT_TRUE(e.edit.Ok());
    EXPECT_EQ(e.p.RecordsOf("CLK0"), R("TYPE1=BUFG 1_BLKNAME=CLK0_BUFG_INST 1_I_SIGNAME=CLK0_BUF 1_O_SIGNAME=CLK0_OUT"));
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
    EXPECT_EQ(e.p.Record("CLK0", "1_O_SIGNAME"), "CLK0_CLK90_OUT");
    EXPECT_EQ(e.p.Record("CLK0", "1_S_SIGNAME"), "CLOCK_SELECT");
    // An emptied field returns to the default.
    e.Open("CLK0", "CLK90", "BUFGMUX", 1);
    e.edit.SetSignalName(Tsy_BufferEdit::SlotS, "  ");
    EXPECT_EQ(e.edit.GetSignalName(Tsy_BufferEdit::SlotS), "CLK0_SELECT_IN");
}

TEST(ClockBuffersEditor, NamesThatCannotReachTheHdlAreRefused)
{
    struct Case {
        Tsy_BufferEdit::Slot slot;
        const char *name, *pin, *why; // why empty: accepted
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
        EXPECT_EQ(e.edit.Ok(), *c.why == 0);
        if (*c.why) {
            EXPECT_EQ(e.p.Errors(), std::vector<std::string>{StringBase::Printf(
                                        "The signal name '%s' of pin %s cannot be used: it %s.  Please enter a name "
                                        "that is legal in both Verilog and VHDL.",
                                        c.name, c.pin, c.why)
                                                                 .str()});
            EXPECT_EQ(e.p.Record("CLK0", "TYPE1"), "") << "nothing stored";
        } else {
            EXPECT_EQ(e.p.Record("CLK0", "1_O_SIGNAME"), c.name);
        }
    }
    // A tied IGNORE pin takes no name, so a bad one there does not matter.
    Editor tied;
    tied.Open("CLK0", "CLK90", "BUFGCTRL", 1);
    tied.edit.SetSignalName(Tsy_BufferEdit::SlotIgnore0, "9");
    tied.edit.SetIgnoreChoice(0, "VCC");
    EXPECT_TRUE(tied.edit.Ok());
}

TEST(ClockBuffersEditor, DeleteNeedsAnotherBufferOnThePin)
{
    const std::string refusal = "To remove all buffers from pin %s, please return to the %s dialog and deselect this pin.";
    struct Case {
        const char *pmcd, *i0;
        int pmcdInst;
        bool second; // the pin holds a second buffer
        const char* dialog; // the page the refusal sends the user to; null: deleted
    } cases[] = {
        {"NONE", "CLK0", 1, false, "General Setup"},   {"NONE", "CLK0", 1, true, nullptr},
        {"NONE", "CLKIN", 1, false, nullptr},          {"SINGLE", "CLKB1", 1, false, "PMCD"},
        {"PARALLEL", "U2 CLKA1", 2, false, "PMCD"},    {"PARALLEL", "U2 CLKA1", 2, true, nullptr},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.pmcd) + " " + c.i0 + (c.second ? " with a second buffer" : ""));
        Editor e;
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
        EXPECT_EQ(e.edit.Delete(), c.dialog == nullptr);
        if (c.dialog) {
            EXPECT_EQ(e.p.Notes(), std::vector<std::string>{StringBase::Printf(refusal.c_str(), c.i0, c.dialog).str()});
            EXPECT_EQ(e.edit.GetType(), "BUFG") << "the type choice goes back";
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
        } else {
            EXPECT_TRUE(e.p.Notes().empty());
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE1"), c.second ? "LOCALROUTING" : "");
            EXPECT_EQ(pin->GetAttributeValue("TSY_CLKBUFTYPE2"), "");
        }
    }
}

// ---------------------------------------------------------------- adding and deleting through the page

TEST(ClockBuffersEditing, AddedBuffersGoAfterTheOutputsOwnBuffers)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID").Load();
    auto add = [&](const char* i0, const char* type, const char* i1) {
        p.OnEdit([=](Tsy_BufferEdit& e) {
            e.SetI0(i0);
            e.SetType(type);
            e.SetI1(i1);
            return e.Ok();
        });
        p.gui->AddBuffer();
    };
    add("CLK0", "BUFGCE", "");
    add("CLK0", "BUFGMUX", "CLK90");
    EXPECT_EQ(p.RowList(), (Rows{"CLK0||BUFG|1|1", "CLK0||BUFGCE|2|1", "CLK0|CLK90|BUFGMUX|3|1", "CLK90||BUFG|1|1"}));
    EXPECT_EQ(p.Record("CLK0", "TYPE1"), "BUFG") << "the first buffer is kept";
    EXPECT_EQ(p.Record("CLK0", "2_CE_SIGNAME"), "CLK0_ENABLE_IN");
    EXPECT_EQ(p.Record("CLK0", "3_O_SIGNAME"), "CLK0_CLK90_OUT");
    EXPECT_EQ(p.Record("CLK0", "TSY_CLKMUX_I1"), "") << "only existing rows write it";
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);

    // Cancelled or left without a type: nothing is added, and the next
    // buffer takes the same row.
    p.OnEdit([](Tsy_BufferEdit&) { return false; });
    p.gui->AddBuffer();
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);
    p.OnEdit([](Tsy_BufferEdit& e) {
        e.SetI0("CLK90");
        return e.Delete();
    });
    p.gui->AddBuffer();
    EXPECT_EQ(p.RowList().size(), 4u);
    EXPECT_EQ(p.Record("CLK90", "TYPE1"), "BUFG");
    EXPECT_EQ(p.Record("CLK90", "TYPE2"), "");
}

TEST(ClockBuffersEditing, DeletingABufferMovesTheLaterOnesDown)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90"}).Feedback("NONE").Mode("USE_GRID");
    p.Records("CLK0:TYPE1=BUFG CLK0:TYPE2=BUFGCE CLK0:2_CE_SIGNAME=RUN CLK0:TYPE3=BUFGMUX CLK0:3_I1_PINNAME=CLK90 "
              "CLK0:3_O_SIGNAME=MUXED CLK0:TYPE4=LOCALROUTING CLK0:TYPE4_NOEDIT=DISABLED_BUF");
    p.Load();
    ASSERT_EQ(p.RowList().size(), 5u);
    p.OnEdit([](Tsy_BufferEdit& e) { return e.Delete(); });
    p.gui->EditRow(2); // the BUFGCE
    EXPECT_EQ(p.RecordsOf("CLK0"), R("TYPE1=BUFG TYPE2=BUFGMUX 2_I1_PINNAME=CLK90 2_O_SIGNAME=MUXED "
                                     "TYPE3=LOCALROUTING TYPE3_NOEDIT=DISABLED_BUF"));
    EXPECT_EQ(p.RowList(), (Rows{"CLK0||BUFG|1|1", "CLK0|CLK90|BUFGMUX|2|1", "CLK0||LOCALROUTING|3|0",
                                 "CLK90||BUFG|1|1"}))
        << "no row is left over from before";
    EXPECT_EQ(p.gui->GetLastUsedRow(), 4);
    // The first buffer can go too while others remain.
    p.gui->EditRow(1);
    EXPECT_EQ(p.RecordsOf("CLK0"), R("TYPE1=BUFGMUX 1_I1_PINNAME=CLK90 1_O_SIGNAME=MUXED TYPE2=LOCALROUTING "
                                     "TYPE2_NOEDIT=DISABLED_BUF"));
}

TEST(ClockBuffersEditing, EditingAMuxRowRecordsItsI1OnThePin)
{
    BufPage p;
    p.Outputs({"CLK0", "CLK90", "CLK180"}).Feedback("NONE").Mode("USE_GRID").Load();
    p.OnEdit([](Tsy_BufferEdit& e) {
        e.SetType("BUFGMUX");
        e.SetI1("CLK180");
        return e.Ok();
    });
    p.gui->EditRow(2);
    EXPECT_EQ(p.Record("CLK90", "TSY_CLKMUX_I1"), "CLK180");
    EXPECT_EQ(p.RowList().at(1), "CLK90|CLK180|BUFGMUX|1|1");
    EXPECT_TRUE(p.gui->GetRow(2).edited);
    p.OnEdit([](Tsy_BufferEdit& e) {
        e.SetType("BUFG");
        return e.Ok();
    });
    p.gui->EditRow(2);
    EXPECT_EQ(p.RecordsOf("CLK90"), R("TYPE1=BUFG TYPE1_NOEDIT=ENABLED_BUF 1_BLKNAME=CLK90_BUFG_INST "
                                      "1_I_SIGNAME=CLK90_BUF 1_O_SIGNAME=CLK90_OUT"))
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
    EXPECT_EQ(p.RowList(),
              (Rows{"U1 CLKA1||BUFG|1|1", "U1 CLKD1||BUFG|1|1", "U2 CLKA1||BUFG|1|1", "U2 CLKB1||BUFGCE|1|1"}));
    EXPECT_EQ(p.gui->GetRow(4).pmcdInst, 2);
    EXPECT_EQ(u2->GetNamedPin("CLKA1")->GetAttributeValue("TSY_CLKBUFTYPE1"), "BUFG");
    EXPECT_EQ(p.Record("CLK0", "TYPE1"), "") << "the DCM is not the source";
    // Edited through the page: the records land on the second PMCD.
    p.OnEdit([](Tsy_BufferEdit& e) {
        e.SetSignalName(Tsy_BufferEdit::SlotO, "FAST_CLK");
        return e.Ok();
    });
    p.gui->EditRow(4);
    EXPECT_EQ(u2->GetNamedPin("CLKB1")->GetAttributeValue("TSY_CLKBUF1_O_SIGNAME"), "FAST_CLK");
    EXPECT_EQ(u2->GetNamedPin("CLKB1")->GetAttributeValue("TSY_CLKBUF1_BLKNAME"), "CLKB1_BUFGCE_INST");
    EXPECT_TRUE(p.gui->StoreToBlock(true)) << "PMCD designs skip the DCM checks";
}

// ---------------------------------------------------------------- the logical page

TEST(ClockBuffersPage, WithoutAnApplicationNoFormCanBeMade)
{
    BufPage p("dcm", "t5da1-1", 1, false);
    EXPECT_FALSE(p.page->CreateGui(nullptr));
    EXPECT_EQ(p.page->GetGui(), nullptr);
    EXPECT_EQ(p.Errors(), std::vector<std::string>{"Internal error: unable to create GUI object"});
}

TEST(ClockBuffersPage, SilentApplyStoresAndChecks)
{
    BufPage good;
    good.Outputs({"CLK0", "CLK180"}).Feedback("INTERNAL").Mode("USE_GRID");
    EXPECT_TRUE(good.page->ApplySilently());
    EXPECT_EQ(good.RecordsOf("CLK180"), R("TYPE1=BUFG TYPE1_NOEDIT=ENABLED_BUF"));
    EXPECT_EQ(good.page->GetGui()->pageWidget(), nullptr) << "no widget in batch mode";

    BufPage bad;
    bad.Outputs({"CLK0"}).Feedback("INTERNAL").Mode("USE_GRID").Records("CLK0:TYPE1=LOCALROUTING");
    EXPECT_FALSE(bad.page->ApplySilently());
    EXPECT_EQ(bad.Errors(), std::vector<std::string>{internalMessage("CLK0")});
    EXPECT_TRUE(bad.d.Stream().Entries().front().logged);
}

// ---------------------------------------------------------------- whole batch runs

TEST(ClockBuffersBatch, SettingsAndOlderDesignsReachThePinRecords)
{
    TempDir dir;
    std::ofstream(dir.File("older.tsw")) << kOlderDesign;
    struct Case {
        std::string args;
        const char *useBufg, *records, *note;
    } cases[] = {
        {"--wizard dcm --part t5da1-1 --set dcm.USE_BUFG=USE_GRID --pin dcm.CLK90=on --pin dcm.CLK180=on "
         "--set dcm.CLK90.TSY_CLKBUFTYPE1=BUFGMUX --set dcm.CLK90.TSY_CLKBUF1_I1_PINNAME=CLK180 "
         "--set dcm.CLK180.TSY_CLKBUFTYPE1=LOWSKEWLINE",
         "USE_GRID", "CLK90:TYPE1=BUFGMUX CLK90:1_I1_PINNAME=CLK180 CLK180:TYPE1=LOCALROUTING",
         "INFO: The output 'CLK180' was previously configured to use Lowskewlines"},
        // Global buffers for all by default; CLKIN gets no record.
        {"--wizard dcm --part t5da1-1 --pin dcm.CLK90=on --pin dcm.CLKDV=on", "USE_BUFGS",
         "CLK90:TYPE1=BUFG CLKDV:TYPE1=BUFG CLKIN:TYPE1=", ""},
        {dir.File("older.tsw"), "USE_GRID", "CLK90:TYPE1=BUFGMUX CLK90:1_I1_PINNAME=CLKFX CLK180:TYPE1=LOCALROUTING", ""},
        // Too many global buffers is a note, and nobody is asked.
        {"--wizard dcm --part t2a250-4 --pin dcm.CLK90=on --pin dcm.CLK180=on --pin dcm.CLK270=on --pin dcm.CLKDV=on",
         "USE_BUFGS", "", kTooManyNote},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.args);
        GenerateRun r = Generate(c.args, "clocks");
        ASSERT_EQ(r.result.status, 0) << r.result.err;
        EXPECT_EQ(r.DcmAttr("USE_BUFG"), c.useBufg);
        std::istringstream records(c.records);
        for (std::string item; records >> item;) {
            size_t colon = item.find(':'), eq = item.find('=');
            EXPECT_EQ(r.DcmPinRecords(item.substr(0, colon))[recordName(item.substr(colon + 1, eq - colon - 1))],
                      item.substr(eq + 1))
                << item;
        }
        EXPECT_TRUE(!*c.note || r.result.err.find(c.note) != std::string::npos) << r.result.err;
        EXPECT_EQ(r.result.err.find("Do you want to continue?"), std::string::npos);
    }
}

TEST(ClockBuffersBatch, RefusedConfigurationsWriteNothing)
{
    GenerateRun r = Generate("--wizard dcm --part t5da1-1 --set dcm.FB_SOURCE=EXTERNAL --set dcm.USE_BUFG=USE_GRID "
                             "--set dcm.CLK0.TSY_CLKBUFTYPE1=BUFGCTRL",
                             "clocks");
    EXPECT_EQ(r.result.status, 1);
    EXPECT_NE(r.result.err.find("ERROR: " + externalMessage("CLK0", "BUFGCTRL")), std::string::npos) << r.result.err;
    EXPECT_FALSE(r.Written());
}
