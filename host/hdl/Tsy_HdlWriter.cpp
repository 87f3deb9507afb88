#include "hdl/Tsy_HdlWriter.h"

#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlText.h"
#include "hdl/Tsy_HdlValues.h"
#include "lib/Tsy_PrimitiveLibrary.h"

#include <algorithm>

bool Tsy_WriteHdl(const Tsy_WizData& data, const std::string& module, const std::vector<std::string>& banner,
                  Tsy_HdlFiles& out, std::string& error)
{
    Tsy_HdlNetlist netlist;
    if (!Tsy_BuildHdlNetlist(data, module, netlist, error))
        return false;
    // Each writer names its own helper signals; neither sees the other's.
    Tsy_HdlNetlist forVerilog = netlist;
    Tsy_HdlNetlist forVhdl = netlist;
    out.verilog = Tsy_WriteVerilog(forVerilog, banner);
    out.vhdl = Tsy_WriteVhdl(forVhdl, banner);
    out.verilogTemplate = Tsy_WriteVerilogTemplate(netlist, banner);
    out.vhdlTemplate = Tsy_WriteVhdlTemplate(netlist, banner);
    return true;
}

namespace {

std::string verilogParameter(const Tsy_AttrDef& ad)
{
    std::string value = Tsy_HdlDefaultValue(ad);
    std::string kind;
    if (ad.hdlType == "integer")
        kind = "integer ";
    else if (ad.hdlType == "real")
        kind = "real ";
    else if (ad.hdlType == "hex")
        kind = "[" + std::to_string(Tsy_HdlHexWidth(value) - 1) + ":0] ";
    else if (ad.hdlType == "bit")
        kind = "[0:0] ";
    return "parameter " + kind + ad.name + " = " + Tsy_VerilogValue(ad.hdlType, value);
}

const char* const kLintRules[] = {"DECLFILENAME", "UNUSEDSIGNAL", "UNUSEDPARAM", "UNDRIVEN"};

} // namespace

std::string Tsy_VerilogPrimitiveModels(const Tsy_PrimitiveLibrary& library)
{
    std::string out =
        "// Port-level models of the Pendra primitive library, written from the\n"
        "// library itself. They hold the pins and parameters of every primitive and\n"
        "// no behaviour: enough for HDL tools to check a generated netlist against\n"
        "// the primitives, nothing to simulate with.\n\n";
    // Models without behaviour leave inputs unread and outputs undriven, and
    // several modules share the file.
    for (const char* rule : kLintRules)
        out += std::string("/* verilator lint_off ") + rule + " */\n";
    out += "`default_nettype none\n";
    for (const auto& type : library.Types()) {
        const Tsy_PrimitiveDef& def = *library.Find(type);
        out += "\n(* blackbox *)\nmodule " + def.type;
        std::vector<const Tsy_AttrDef*> params = Tsy_HdlParameterDefs(def);
        if (!params.empty()) {
            out += " #(\n";
            for (size_t i = 0; i < params.size(); ++i)
                out += "    " + verilogParameter(*params[i]) + (i + 1 < params.size() ? ",\n" : "\n");
            out += ")";
        }
        if (def.pins.empty()) {
            out += ";\nendmodule\n";
            continue;
        }
        out += " (\n";
        for (size_t i = 0; i < def.pins.size(); ++i) {
            const Tsy_PinDef& pd = def.pins[i];
            out += std::string("    ") + (pd.direction == "IN" ? "input  wire " : "output wire ");
            if (pd.width > 1)
                out += "[" + std::to_string(pd.width - 1) + ":0] ";
            out += pd.name + (i + 1 < def.pins.size() ? ",\n" : "\n");
        }
        out += ");\nendmodule\n";
    }
    out += "\n`default_nettype wire\n";
    for (const char* rule : kLintRules)
        out += std::string("/* verilator lint_on ") + rule + " */\n";
    return out;
}

std::string Tsy_VhdlPrimitiveModels(const Tsy_PrimitiveLibrary& library)
{
    const std::string libraries = "library ieee;\nuse ieee.std_logic_1164.all;\n";
    std::string out = "-- Port-level models of the Pendra primitive library, written from the\n"
                      "-- library itself: a package of component declarations and an empty\n"
                      "-- entity for every primitive, so that a generated netlist can be\n"
                      "-- analysed and elaborated against the primitives' pins and generics.\n\n";
    out += libraries + "\npackage " + std::string(kTsy_VhdlModelPackage) + " is\n";
    for (const auto& type : library.Types())
        out += "\n" + Tsy_VhdlComponent(*library.Find(type), "    ");
    out += "\nend package " + std::string(kTsy_VhdlModelPackage) + ";\n";
    for (const auto& type : library.Types()) {
        // The entity has the component's interface: cut "component X" /
        // "end component;" from the declaration and wrap it as an entity.
        std::string body = Tsy_VhdlComponent(*library.Find(type), "");
        size_t first = body.find('\n') + 1;
        size_t last = body.rfind("end component;");
        out += "\n" + libraries + "\nentity " + type + " is\n" + body.substr(first, last - first) + "end entity " +
               type + ";\n\narchitecture model of " + type + " is\nbegin\nend architecture model;\n";
    }
    return out;
}
