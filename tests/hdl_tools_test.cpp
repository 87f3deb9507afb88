// Every generated design through the HDL tools a designer's flow would run
// it through: Verilator lint with every warning on, Yosys with its checks
// treated as errors, Icarus Verilog, and GHDL analysis and elaboration. The
// primitives are our own port-level models, written from our primitive
// library; the instantiation templates are compiled inside a design of
// their own, as a designer would paste them.

#include "design/Tsy_DesignFile.h"
#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlWriter.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "run/Tsy_HostSession.h"
#include "support/BatchRun.h"
#include "support/DcmDesigns.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>
#include <sys/stat.h>

namespace {

void write(const std::string& path, const std::string& text)
{
    std::ofstream(path, std::ios::binary) << text;
}

std::string range(int width)
{
    return width > 1 ? "[" + std::to_string(width - 1) + ":0] " : std::string();
}

std::string vhdlType(int width)
{
    return width > 1 ? "std_logic_vector(" + std::to_string(width - 1) + " downto 0)" : std::string("std_logic");
}

// A design of the designer's own with the Verilog template pasted in.
std::string verilogTemplateCheck(const Tsy_HdlNetlist& n, const std::string& templ)
{
    std::string out = "`default_nettype none\nmodule template_check;\n";
    for (const auto& p : n.ports)
        out += "    wire " + range(p.width) + p.name + ";\n";
    return out + templ + "endmodule\n`default_nettype wire\n";
}

std::string vhdlTemplateCheck(const Tsy_HdlNetlist& n, const std::string& templ)
{
    std::string out = "library ieee;\nuse ieee.std_logic_1164.all;\n\nentity template_check is\nend entity "
                      "template_check;\n\narchitecture check of template_check is\n";
    for (const auto& p : n.ports)
        out += "    signal " + p.name + " : " + vhdlType(p.width) + ";\n";
    const std::string cut = "end component;\n";
    size_t split = templ.find(cut);
    if (split == std::string::npos)
        return "-- the template has no component declaration\n";
    split += cut.size();
    return out + templ.substr(0, split) + "begin\n" + templ.substr(split) + "end architecture check;\n";
}

// The lines of a tool's output that are warnings, less the one Yosys prints
// for every real-valued parameter it keeps as a string.
std::string yosysWarnings(const std::string& log)
{
    std::istringstream in(log);
    std::string line, out;
    while (std::getline(in, line))
        if (line.find("Warning") != std::string::npos &&
            line.find("Replacing floating point parameter") == std::string::npos)
            out += line + "\n";
    return out;
}

class ToolRun {
public:
    ToolRun()
    {
        const auto& lib = Tsy_PrimitiveLibrary::Instance();
        write(dir_.File("models.v"), Tsy_VerilogPrimitiveModels(lib));
        write(dir_.File("models.vhd"), Tsy_VhdlPrimitiveModels(lib));
        ::mkdir(dir_.File("work").c_str(), 0755);
    }

    // Runs the four tools on a design's HDL; every complaint is a failure.
    void Check(const Tsy_HdlNetlist& n, const Tsy_HdlFiles& files)
    {
        const std::string m = n.module;
        write(dir_.File(m + ".v"), files.verilog);
        write(dir_.File(m + ".vhd"), files.vhdl);
        write(dir_.File("template_check.v"), verilogTemplateCheck(n, files.verilogTemplate));
        write(dir_.File("template_check.vhd"), vhdlTemplateCheck(n, files.vhdlTemplate));
        const std::string cd = "cd '" + dir_.Path() + "' && ";

        CommandResult lint =
            RunCommand(cd + "verilator --lint-only -Wall --top-module " + m + " models.v " + m + ".v");
        EXPECT_EQ(lint.status, 0) << lint.err << lint.out;
        EXPECT_EQ(lint.err + lint.out, "");

        CommandResult yosys = RunCommand(cd + "yosys -q -p 'read_verilog models.v " + m + ".v; hierarchy -check -top " +
                                         m + "; check -assert'");
        EXPECT_EQ(yosys.status, 0) << yosys.err << yosys.out;
        EXPECT_EQ(yosysWarnings(yosys.err + yosys.out), "");

        CommandResult icarus = RunCommand(cd + "iverilog -g2001 -Wall -o sim -s template_check models.v " + m +
                                          ".v template_check.v");
        EXPECT_EQ(icarus.status, 0) << icarus.err << icarus.out;
        EXPECT_EQ(icarus.err + icarus.out, "");

        // Analysed as VHDL-93. Elaborating binds every component to its
        // entity, which checks each port and generic map against the models;
        // strict VHDL-93 binds only entities made visible by a use clause,
        // so elaboration takes the relaxed rules every simulator applies.
        CommandResult ghdl = RunCommand(cd + "rm -f work/* && ghdl -a --std=93 --workdir=work models.vhd " + m +
                                        ".vhd template_check.vhd && ghdl -e --std=93c --workdir=work template_check");
        EXPECT_EQ(ghdl.status, 0) << ghdl.err << ghdl.out;
        EXPECT_EQ(ghdl.err + ghdl.out, "");
    }

    void Check(const Tsy_WizData& data, const std::string& module)
    {
        Tsy_HdlFiles files;
        std::string error;
        ASSERT_TRUE(Tsy_WriteHdl(data, module, {"checked by the HDL tools"}, files, error)) << error;
        Tsy_HdlNetlist n;
        ASSERT_TRUE(Tsy_BuildHdlNetlist(data, module, n, error)) << error;
        Check(n, files);
    }

private:
    TempDir dir_;
};

} // namespace

TEST(HdlTools, AreInstalled)
{
    for (const char* tool : {"verilator", "yosys", "iverilog", "ghdl"})
        EXPECT_EQ(RunCommand(std::string("command -v ") + tool).status, 0) << tool << " is needed by these tests";
}

class GeneratedDesign : public ::testing::TestWithParam<DcmDesign> {};

TEST_P(GeneratedDesign, PassesEveryHdlTool)
{
    const DcmDesign& design = GetParam();
    TestDesign d(design.keyword, design.part);
    d.MarkLoaded();
    d.Instantiate();
    design.setup(d.Wizard());
    ASSERT_EQ(d.Wizard().Finish(), 0);
    ToolRun tools;
    tools.Check(d.Data(), "clkgen");
}

INSTANTIATE_TEST_SUITE_P(DcmDesigns, GeneratedDesign, ::testing::ValuesIn(DcmDesigns()),
                         [](const ::testing::TestParamInfo<DcmDesign>& info) { return info.param.name; });

// What the generator does not make today but a design file can hold: an
// output port read inside, routing marks on a port and on a net, buses tied
// high and low, an unused net, the parameter kinds of every HDL type.
TEST(HdlTools, HandWrittenNetlistWithEveryWriterCase)
{
    Tsy_WizData data(Tsy_PrimitiveLibrary::Instance());
    auto pin = [](Tsy_Block* b, const char* name, const char* net) {
        Tsy_Pin* p = b->AddPin(name, b->GetDef()->FindPin(name)->direction);
        p->SetIsActive(true);
        p->SetSigName(net);
        return p;
    };
    data.AddSignal("clk_in", true, "I");
    data.AddSignal("addr", true, "I")->SetIsBus(true, 7);
    data.AddSignal("locked_out", true, "O");
    data.AddSignal("clk_out", true, "O")->AddAttribute("USELOWSKEWLINES", "TRUE");
    data.AddSignal("ddr_out", true, "O");
    data.AddSignal("status", true, "O")->SetIsBus(true, 16);
    data.AddSignal("clk_buf", false, "")->AddAttribute("ASSOC_WITH", "clk_out");
    data.GetNamedSignal("clk_buf")->AddAttribute("USELOCALROUTING", "TRUE");
    data.AddSignal("not_locked", false, "");
    data.AddSignal("spare", false, "");
    Tsy_Block* dcm = data.AddBlock("dcm", "DCM_ADV");
    pin(dcm, "CLKIN", "clk_in");
    pin(dcm, "CLKFB", "clk_buf");
    pin(dcm, "CLK0", "clk_buf");
    pin(dcm, "CLK90", "spare");
    pin(dcm, "LOCKED", "locked_out");
    pin(dcm, "DADDR", "addr");
    pin(dcm, "DI", "")->SetIsVcc(true);
    pin(dcm, "DO", "status");
    dcm->SetAttributeValue("CLKIN_PERIOD", "4");
    dcm->SetAttributeValue("PHASE_SHIFT", "-40");
    dcm->SetAttributeValue("FACTORY_JF", "16'h8080");
    dcm->SetAttributeValue("DESKEW_ADJUST", "SOURCE_SYNCHRONOUS");
    Tsy_Block* inv = data.AddBlock("lock_inv", "INV");
    pin(inv, "I", "locked_out");
    pin(inv, "O", "not_locked");
    Tsy_Block* ddr = data.AddBlock("ddr", "ODDR");
    pin(ddr, "C", "clk_buf");
    pin(ddr, "D1", "")->SetIsVcc(true);
    pin(ddr, "D2", "")->SetIsGrounded(true);
    pin(ddr, "R", "not_locked");
    pin(ddr, "Q", "ddr_out");
    ddr->SetAttributeValue("INIT", "1");
    ToolRun tools;
    tools.Check(data, "hand_netlist");
}

// The acceptance designs as a designer makes them: pendra generate, and the
// files it writes straight into the tools.
TEST(HdlTools, BatchRunOutputPassesEveryTool)
{
    struct Case {
        const char* args;
        const char* module;
    };
    for (const Case& c : {Case{"--wizard dcm --part t5da1-1", "clkgen"},
                          Case{"--wizard dcm_bddeskew --part t5da1-1 --module deskew", "deskew"},
                          Case{"--wizard dcm --part t2a250-4 --module older --pin dcm.CLK90=on "
                               "--set dcm.TESY_ONLY_RESET_LOGIC=TRUE",
                               "older"}}) {
        SCOPED_TRACE(c.args);
        TempDir out;
        CommandResult r = RunCommand(PendraProgram() + " generate " + c.args + " -o " + out.Path());
        ASSERT_EQ(r.status, 0) << r.err;
        const std::string m = c.module;
        Tsy_HdlFiles files{ReadTextFile(out.File(m + ".v")), ReadTextFile(out.File(m + ".vhd")),
                           ReadTextFile(out.File(m + "_inst.vt")), ReadTextFile(out.File(m + "_inst.vht"))};
        // The ports, for the template's surroundings, from the design file.
        Tsy_PartInfo part;
        std::string partName = std::string(c.args).substr(std::string(c.args).find("--part ") + 7);
        partName = partName.substr(0, partName.find(' '));
        ASSERT_TRUE(Tsy_DeviceCatalog::Instance().FindPart(partName, part));
        auto data = Tsy_NewDesignFor(part);
        Tsy_DesignFile::Load(out.File(m + ".tsw"), *data);
        Tsy_HdlNetlist n;
        std::string error;
        ASSERT_TRUE(Tsy_BuildHdlNetlist(*data, m, n, error)) << error;
        ToolRun tools;
        tools.Check(n, files);
    }
}
