// The host's HDL writers on netlists built by hand: parameters typed by the
// primitive library, buses and ties, associated nets, outputs read inside,
// deterministic text, and every netlist they must refuse rather than write.

#include "db/Tsy_WizData.h"
#include "hdl/Tsy_HdlWriter.h"
#include "lib/Tsy_PrimitiveLibrary.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <memory>
#include <sstream>

namespace {

// A netlist built the way generation builds one.
struct Net {
    Tsy_WizData data{Tsy_PrimitiveLibrary::Instance()};

    Tsy_Block* Block(const std::string& name, const std::string& type) { return data.AddBlock(name, type); }
    Tsy_Pin* Pin(Tsy_Block* b, const std::string& pin, const std::string& net)
    {
        const Tsy_PinDef* pd = b->GetDef() ? b->GetDef()->FindPin(pin) : nullptr;
        Tsy_Pin* p = b->AddPin(pin, pd ? pd->direction : "IN");
        p->SetIsActive(true);
        p->SetSigName(net);
        return p;
    }
    Tsy_Signal* In(const std::string& name, int width = 1) { return signal(name, true, "I", width); }
    Tsy_Signal* Out(const std::string& name, int width = 1) { return signal(name, true, "O", width); }
    Tsy_Signal* Wire(const std::string& name, int width = 1) { return signal(name, false, "", width); }

    bool Write(Tsy_HdlFiles& files, std::string& error, const std::string& module = "top") const
    {
        return Tsy_WriteHdl(data, module, {"a test netlist"}, files, error);
    }
    Tsy_HdlFiles Written(const std::string& module = "top") const
    {
        Tsy_HdlFiles files;
        std::string error;
        EXPECT_TRUE(Write(files, error, module)) << error;
        return files;
    }

private:
    Tsy_Signal* signal(const std::string& name, bool external, const char* dir, int width)
    {
        Tsy_Signal* s = data.AddSignal(name, external, dir);
        if (width > 1)
            s->SetIsBus(true, width);
        return s;
    }
};

// A buffered clock: clk_in -> BUFG -> clk_out.
void bufferedClock(Net& n)
{
    n.In("clk_in");
    n.Out("clk_out");
    Tsy_Block* b = n.Block("clk_bufg", "BUFG");
    n.Pin(b, "I", "clk_in");
    n.Pin(b, "O", "clk_out");
}

// The line holding the text, its runs of blanks folded into one, trimmed.
std::string lineWith(const std::string& text, const std::string& key)
{
    std::istringstream in(text);
    std::string line;
    while (std::getline(in, line)) {
        std::string folded;
        for (char c : line)
            if (c != ' ' || (!folded.empty() && folded.back() != ' '))
                folded += c;
        while (!folded.empty() && folded.back() == ' ')
            folded.pop_back();
        if (folded.find(key) != std::string::npos)
            return folded;
    }
    return "(no line with " + key + ")";
}

// The first such line that begins with the text.
std::string lineStarting(const std::string& text, const std::string& start)
{
    std::istringstream in(text);
    std::string line;
    while (std::getline(in, line)) {
        std::string folded = lineWith(line, "");
        if (folded.rfind(start, 0) == 0)
            return folded;
    }
    return "(no line beginning " + start + ")";
}

bool has(const std::string& text, const std::string& piece)
{
    return text.find(piece) != std::string::npos;
}

} // namespace

TEST(HdlWriter, ParametersAreWrittenInTheirPrimitiveTypes)
{
    struct Case {
        const char* block;
        const char* attribute;
        const char* value;
        const char* verilog; // the Verilog line, or the refusal when the VHDL is empty
        const char* vhdl;
    };
    const std::vector<Case> cases = {
        {"dcm", "CLKIN_PERIOD", "10", ".CLKIN_PERIOD(10.0),", "CLKIN_PERIOD => 10.0,"},
        {"dcm", "CLKDV_DIVIDE", "1.5", ".CLKDV_DIVIDE(1.5),", "CLKDV_DIVIDE => 1.5,"},
        {"dcm", "CLKIN_PERIOD", "1e-3", ".CLKIN_PERIOD(0.001),", "CLKIN_PERIOD => 0.001,"},
        {"dcm", "CLKFX_MULTIPLY", "2.5e1", "The attribute CLKFX_MULTIPLY of dcm is \"2.5e1\", which is not a whole number.", ""},
        {"dcm", "CLKIN_PERIOD", "inf", "The attribute CLKIN_PERIOD of dcm is \"inf\", which is not a decimal number.", ""},
        {"dcm", "FACTORY_JF", "4'h1F",
         "The attribute FACTORY_JF of dcm is \"4'h1F\", which is not a sized hexadecimal number such as 16'h8080.", ""},
        {"ddr", "INIT", "2", "The attribute INIT of ddr is \"2\", which is not 0 or 1.", ""},
        {"dcm", "PHASE_SHIFT", " -12", ".PHASE_SHIFT(-12),", "PHASE_SHIFT => -12,"},
        {"dcm", "CLK_FEEDBACK", "2X", ".CLK_FEEDBACK(\"2X\"),", "CLK_FEEDBACK => \"2X\","},
        {"dcm", "DESKEW_ADJUST", "say \"7\"", ".DESKEW_ADJUST(\"say \\\"7\\\"\"),", "DESKEW_ADJUST => \"say \"\"7\"\"\","},
        {"dcm", "FACTORY_JF", "16'hf0f0", ".FACTORY_JF(16'hF0F0),", "FACTORY_JF => X\"F0F0\","},
        {"ddr", "INIT", "1", ".INIT(1'b1),", "INIT => '1',"},
        {"ddr", "SRTYPE", "SYNC", ".SRTYPE(\"SYNC\")", "SRTYPE => \"SYNC\""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.attribute) + " = '" + c.value + "'");
        Net n;
        n.In("clk_in");
        Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
        n.Pin(dcm, "CLKIN", "clk_in");
        Tsy_Block* ddr = n.Block("ddr", "ODDR");
        // Parameters after the one looked at, so that it is followed by a
        // separator (SRTYPE is the ODDR's last).
        dcm->SetAttributeValue("STARTUP_WAIT", "FALSE");
        ddr->SetAttributeValue("SRTYPE", "ASYNC");
        Tsy_Block* target = std::string(c.block) == "dcm" ? dcm : ddr;
        target->SetAttributeValue(c.attribute, c.value);
        Tsy_HdlFiles files;
        std::string error;
        bool ok = n.Write(files, error);
        if (!*c.vhdl) {
            EXPECT_FALSE(ok);
            EXPECT_EQ(error, c.verilog);
            continue;
        }
        ASSERT_TRUE(ok) << error;
        EXPECT_EQ(lineWith(files.verilog, std::string(".") + c.attribute + "("), c.verilog);
        EXPECT_EQ(lineWith(files.vhdl, std::string(c.attribute) + " =>"), c.vhdl);
    }
}

TEST(HdlWriter, WizardSettingsAndInactiveAttributesNeverReachTheHdl)
{
    Net n;
    n.In("clk_in");
    Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
    n.Pin(dcm, "CLKIN", "clk_in");
    for (const char* a : {"FIN_UNITS", "CLKIN_SRC_TYPE", "FB_SOURCE", "USE_BUFG", "M_VALUE", "TESY_ONLY_CLKIN_VALUE",
                          "TSY_CLK_OUTPUT_TYPE", "PHASE_SHIFT", "CLKIN_PERIOD"})
        dcm->SetAttributeValue(a, "1");
    dcm->SetAttributeIsActive("PHASE_SHIFT", false);
    dcm->SetAttributeValue("NOT_A_PROPERTY", "1");
    Tsy_HdlFiles files = n.Written();
    for (const char* a : {"FIN_UNITS", "CLKIN_SRC_TYPE", "FB_SOURCE", "USE_BUFG", "M_VALUE", "TESY_ONLY", "TSY_",
                          "NOT_A_PROPERTY"}) {
        EXPECT_FALSE(has(files.verilog, a)) << a;
        EXPECT_FALSE(has(files.vhdl, a)) << a;
    }
    EXPECT_FALSE(has(files.verilog, ".PHASE_SHIFT("));
    EXPECT_FALSE(has(files.vhdl, "PHASE_SHIFT =>"));
    EXPECT_TRUE(has(files.verilog, ".CLKIN_PERIOD(1.0)"));
    // The component still declares the generic with the library's default.
    EXPECT_EQ(lineStarting(files.vhdl, "PHASE_SHIFT :"), "PHASE_SHIFT : integer := 0;");
}

TEST(HdlWriter, BusesTiesAndPinsTheDesignDoesNotUse)
{
    Net n;
    n.In("clk_in");
    n.In("addr", 7);
    n.Out("status", 16);
    Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
    n.Pin(dcm, "CLKIN", "clk_in");
    n.Pin(dcm, "DADDR", "addr");
    n.Pin(dcm, "DO", "status");
    n.Pin(dcm, "DI", "")->SetIsVcc(true);
    n.Pin(dcm, "DWE", "")->SetIsGrounded(true);
    n.Pin(dcm, "CLK90", ""); // in use but connected to nothing
    Tsy_HdlFiles f = n.Written();

    EXPECT_EQ(lineWith(f.verilog, " addr"), "input wire [6:0] addr,");
    EXPECT_EQ(lineWith(f.verilog, " status"), "output wire [15:0] status");
    EXPECT_EQ(lineWith(f.verilog, ".DADDR"), ".DADDR (addr),");
    EXPECT_EQ(lineWith(f.verilog, ".DI "), ".DI ({16{1'b1}}),");
    EXPECT_EQ(lineWith(f.verilog, ".DWE"), ".DWE (1'b0),");
    EXPECT_EQ(lineWith(f.verilog, ".RST"), ".RST (1'b0),"); // not in use: held low
    EXPECT_EQ(lineWith(f.verilog, ".CLK90 "), ".CLK90 (dcm_CLK90_unused),");
    EXPECT_EQ(lineWith(f.verilog, "dcm_CLK90_unused;"), "wire dcm_CLK90_unused;");
    EXPECT_EQ(lineWith(f.verilog, "dcm_DRDY_unused;"), "wire dcm_DRDY_unused;");

    EXPECT_EQ(lineWith(f.vhdl, "addr :"), "addr : in std_logic_vector(6 downto 0);");
    EXPECT_EQ(lineWith(f.vhdl, "status :"), "status : out std_logic_vector(15 downto 0)");
    EXPECT_EQ(lineWith(f.vhdl, "DI =>"), "DI => \"1111111111111111\",");
    EXPECT_EQ(lineWith(f.vhdl, "DWE =>"), "DWE => '0',");
    EXPECT_EQ(lineWith(f.vhdl, "CLK90 =>"), "CLK90 => open,");
}

TEST(HdlWriter, AssociatedNetsDriveTheirPortsAndOutputsReadInsideGetASignal)
{
    Net n;
    n.In("clk_in");
    n.Out("clk_out");
    n.Out("locked_out");
    n.Out("unlocked");
    n.Wire("clk_buf")->AddAttribute("ASSOC_WITH", "clk_out");
    n.data.GetNamedSignal("clk_out")->AddAttribute("USELOCALROUTING", "TRUE");
    n.Wire("dangling");
    Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
    n.Pin(dcm, "CLKIN", "clk_in");
    n.Pin(dcm, "CLK0", "clk_buf");
    n.Pin(dcm, "CLKFB", "clk_buf");
    n.Pin(dcm, "LOCKED", "locked_out");
    n.Pin(dcm, "CLK90", "dangling"); // driven, read by nothing
    Tsy_Block* inv = n.Block("lock_inv", "INV");
    n.Pin(inv, "I", "locked_out");
    n.Pin(inv, "O", "unlocked");
    Tsy_HdlFiles f = n.Written();

    EXPECT_TRUE(has(f.verilog, "    assign clk_out = clk_buf;\n"));
    EXPECT_EQ(lineWith(f.verilog, "wire clk_out"), "(* USELOCALROUTING = \"TRUE\" *) output wire clk_out,");
    EXPECT_EQ(lineWith(f.verilog, ".I("), ".I(locked_out),");
    EXPECT_FALSE(has(f.verilog, "wire dangling"));
    EXPECT_EQ(lineWith(f.verilog, ".CLK90 "), ".CLK90 (dcm_CLK90_unused),");

    EXPECT_TRUE(has(f.vhdl, "    clk_out <= clk_buf;\n"));
    EXPECT_EQ(lineWith(f.vhdl, "signal locked_out_int"), "signal locked_out_int : std_logic;");
    EXPECT_EQ(lineWith(f.vhdl, "LOCKED =>"), "LOCKED => locked_out_int,");
    EXPECT_EQ(lineStarting(f.vhdl, "I =>"), "I => locked_out_int,");
    EXPECT_TRUE(has(f.vhdl, "    locked_out <= locked_out_int;\n"));
    EXPECT_FALSE(has(f.vhdl, "dangling"));
    EXPECT_EQ(lineWith(f.vhdl, "attribute USELOCALROUTING of"),
              "attribute USELOCALROUTING of clk_out : signal is \"TRUE\";");
}

TEST(HdlWriter, SameDesignGivesTheSameBytes)
{
    // The same netlist, its nets and ports made in another order.
    auto build = [](bool reversed) {
        auto n = std::make_unique<Net>();
        std::vector<std::function<void()>> steps = {
            [&] { n->In("clk_in"); }, [&] { n->Out("clk_out"); }, [&] { n->Wire("clk_buf"); },
            [&] { n->Out("locked"); }, [&] { n->In("rst"); }};
        if (reversed)
            std::reverse(steps.begin(), steps.end());
        for (auto& s : steps)
            s();
        Tsy_Block* dcm = n->Block("dcm", "DCM_ADV");
        n->Pin(dcm, "CLKIN", "clk_in");
        n->Pin(dcm, "RST", "rst");
        n->Pin(dcm, "CLK0", "clk_buf");
        n->Pin(dcm, "LOCKED", "locked");
        Tsy_Block* b = n->Block("clk_bufg", "BUFG");
        n->Pin(b, "I", "clk_buf");
        n->Pin(b, "O", "clk_out");
        n->Pin(dcm, "CLKFB", "clk_out");
        return n;
    };
    auto a = build(false), b = build(true);
    Tsy_HdlFiles fa = a->Written(), fa2 = a->Written(), fb = b->Written();
    for (const auto* f : {&fa2, &fb}) {
        EXPECT_EQ(fa.verilog, f->verilog);
        EXPECT_EQ(fa.vhdl, f->vhdl);
        EXPECT_EQ(fa.verilogTemplate, f->verilogTemplate);
        EXPECT_EQ(fa.vhdlTemplate, f->vhdlTemplate);
    }
    // Inputs first, then outputs, each by name.
    EXPECT_LT(fa.verilog.find("input  wire clk_in"), fa.verilog.find("input  wire rst"));
    EXPECT_LT(fa.verilog.find("input  wire rst"), fa.verilog.find("output wire clk_out"));
    EXPECT_LT(fa.verilog.find("output wire clk_out"), fa.verilog.find("output wire locked"));
}

TEST(HdlWriter, TemplatesListEveryPortOnce)
{
    Net n;
    bufferedClock(n);
    n.In("sel", 3);
    Tsy_HdlFiles f = n.Written("clocks");
    EXPECT_TRUE(has(f.verilogTemplate, "\nclocks clocks_inst (\n"));
    EXPECT_EQ(lineWith(f.verilogTemplate, ".clk_in"), ".clk_in (clk_in), // input");
    EXPECT_EQ(lineWith(f.verilogTemplate, ".sel"), ".sel (sel), // input [2:0]");
    EXPECT_EQ(lineWith(f.verilogTemplate, ".clk_out"), ".clk_out(clk_out) // output");
    EXPECT_TRUE(has(f.vhdlTemplate, "\ncomponent clocks\n"));
    EXPECT_EQ(lineWith(f.vhdlTemplate, "sel :"), "sel : in std_logic_vector(2 downto 0);");
    EXPECT_EQ(lineWith(f.vhdlTemplate, "clk_out :"), "clk_out : out std_logic");
    EXPECT_TRUE(has(f.vhdlTemplate, "\nclocks_inst : clocks\n"));
    EXPECT_EQ(lineWith(f.vhdlTemplate, "clk_out =>"), "clk_out => clk_out");
}

// Every netlist a tool would refuse, or that would hold an illegal name, is
// refused with a sentence naming the fault.
TEST(HdlWriter, RefusesWhatNoToolWouldAccept)
{
    struct Case {
        const char* what;
        std::function<void(Net&)> spoil;
        std::string module;
        std::string error;
    };
    const std::vector<Case> cases = {
        {"net name with a dollar", [](Net& n) { n.Wire("clk$1"); }, "top",
         "The net name \"clk$1\" is not a legal Verilog and VHDL name: it may hold only letters, digits and '_'."},
        {"port named with a VHDL keyword", [](Net& n) { n.Out("entity"); }, "top",
         "The port name \"entity\" is not a legal Verilog and VHDL name: it is a VHDL keyword."},
        {"instance name beginning with a digit", [](Net& n) { n.Block("1buf", "BUFG"); }, "top",
         "The instance name \"1buf\" is not a legal Verilog and VHDL name: it must begin with a letter."},
        {"module named like a Verilog keyword", [](Net&) {}, "wire",
         "The module name \"wire\" is not a legal Verilog and VHDL name: it is a Verilog keyword."},
        {"module named like a primitive", [](Net&) {}, "bufg",
         "The module name \"bufg\" is the name of the primitive BUFG; the two would clash in any design that uses "
         "both."},
        {"names differing only in case",
         [](Net& n) { n.In("CLK_IN"); }, "top",
         "The names \"CLK_IN\" (an input port) and \"clk_in\" (an input port) differ only in case, which VHDL does not "
         "tell apart."},
        {"net named like an instance",
         [](Net& n) {
             Tsy_Block* a = n.Block("inv_a", "INV");
             n.Pin(a, "I", "clk_in");
             n.Wire("clk_bufg");
             n.Pin(a, "O", "clk_bufg");
             Tsy_Block* b = n.Block("inv_b", "INV");
             n.Pin(b, "I", "clk_bufg");
             n.Out("back");
             n.Pin(b, "O", "back");
         },
         "top", "The name \"clk_bufg\" is given to both a net and an instance."},
        {"port named like a VHDL type", [](Net& n) { n.In("STD_LOGIC"); }, "top",
         "The names \"std_logic\" (a name the VHDL netlist relies on) and \"STD_LOGIC\" (an input port) differ only "
         "in case, which VHDL does not tell apart."},
        {"two drivers",
         [](Net& n) {
             Tsy_Block* b = n.Block("second", "BUFG");
             n.Pin(b, "I", "clk_in");
             n.Pin(b, "O", "clk_out");
         },
         "top", "The output port clk_out has more than one driver: pin O of clk_bufg and pin O of second."},
        {"input port driven inside",
         [](Net& n) {
             Tsy_Block* b = n.Block("back", "BUFG");
             n.Pin(b, "I", "clk_out");
             n.Pin(b, "O", "clk_in");
         },
         "top", "The input port clk_in is also driven by pin O of back."},
        {"net read but driven by nothing",
         [](Net& n) {
             n.Wire("floating");
             Tsy_Block* b = n.Block("reader", "INV");
             n.Pin(b, "I", "floating");
             n.Out("inv_out");
             n.Pin(b, "O", "inv_out");
         },
         "top", "The net floating is read by pin I of reader, but nothing drives it."},
        {"output port driven by nothing", [](Net& n) { n.Out("nothing"); }, "top",
         "The output port nothing is driven by nothing."},
        {"pin on a net the design does not have",
         [](Net& n) { n.Pin(n.data.GetNamedBlock("clk_bufg"), "I", "ghost"); }, "top",
         "The pin I of clk_bufg is connected to \"ghost\", which is not a net of the design."},
        {"input pin connected to nothing", [](Net& n) { n.Pin(n.data.GetNamedBlock("clk_bufg"), "I", ""); }, "top",
         "The input pin I of clk_bufg is connected to nothing."},
        {"output pin tied to a constant",
         [](Net& n) {
             n.data.GetNamedSignal("clk_out")->SetIsActive(false);
             n.Pin(n.data.GetNamedBlock("clk_bufg"), "O", "")->SetIsVcc(true);
         },
         "top", "The output pin O of clk_bufg is tied to a constant."},
        {"association with a net that is no output port",
         [](Net& n) { n.data.GetNamedSignal("clk_in")->AddAttribute("ASSOC_WITH", "clk_in2"); }, "top",
         "The input port clk_in is associated with \"clk_in2\", which is not an output port of the design."},
        {"bus on a pin of another width",
         [](Net& n) {
             n.Out("st", 8);
             Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
             n.Pin(dcm, "CLKIN", "clk_in");
             n.Pin(dcm, "DO", "st");
         },
         "top", "The output port st is 8 bits wide for its declared width but 16 bits for the pin DO of dcm."},
        {"port without a direction", [](Net& n) { n.data.AddSignal("odd", true, "X"); }, "top",
         "The port \"odd\" has no direction: a port is an input or an output."},
        {"text parameter with a line break",
         [](Net& n) {
             Tsy_Block* dcm = n.Block("dcm", "DCM_ADV");
             n.Pin(dcm, "CLKIN", "clk_in");
             dcm->SetAttributeValue("CLK_FEEDBACK", "1X\nNONE");
         },
         "top", "The attribute CLK_FEEDBACK of dcm is \"1X\nNONE\", which is not text of printable characters."},
        {"instance of a primitive the library lacks", [](Net& n) { n.Block("mystery", "BUFGX"); }, "top",
         "The instance mystery is of type BUFGX, which the primitive library does not define."},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.what);
        Net n;
        bufferedClock(n);
        c.spoil(n);
        Tsy_HdlFiles files;
        std::string error;
        EXPECT_FALSE(n.Write(files, error, c.module));
        EXPECT_EQ(error, c.error);
        EXPECT_TRUE(files.verilog.empty() && files.vhdl.empty());
    }
}
