#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlText.h"
#include "hdl/Tsy_HdlValues.h"
#include "hdl/Tsy_HdlWriter.h"

#include <algorithm>

namespace {

// Outputs the design leaves unconnected each get a wire of their own,
// named so that lint tools know it is meant to go nowhere.
struct UnusedOutputs {
    std::vector<std::pair<std::string, int>> wires; // name and width, in instance order
    // Per instance and pin: the wire of an unconnected output, else empty.
    std::vector<std::vector<std::string>> names;
};

std::string range(int width)
{
    return width > 1 ? "[" + std::to_string(width - 1) + ":0]" : std::string();
}

std::string constant(int width, bool high)
{
    if (!high)
        return std::to_string(width) + "'b0";
    return width == 1 ? std::string("1'b1") : "{" + std::to_string(width) + "{1'b1}}";
}

std::string comments(const std::vector<std::string>& banner)
{
    return Tsy_HdlCommentBanner(banner, "//");
}

std::string attributes(const Tsy_HdlSignal& s)
{
    std::string out;
    for (const auto& a : s.attributes)
        out += "(* " + a.name + " = " + Tsy_VerilogValue("string", a.value) + " *) ";
    return out;
}

// The range column, or nothing when no declaration has a range.
std::string rangeColumn(int width, size_t columnWidth)
{
    return columnWidth ? Tsy_HdlPadded(range(width), columnWidth) + " " : std::string();
}

std::string moduleHeader(const Tsy_HdlNetlist& n)
{
    if (n.ports.empty())
        return "module " + n.module + ";\n";
    size_t rangeWidth = Tsy_HdlColumnWidth(n.ports, [](const Tsy_HdlSignal& p) { return range(p.width); });
    std::string out = "module " + n.module + " (\n";
    for (size_t i = 0; i < n.ports.size(); ++i) {
        const auto& p = n.ports[i];
        std::string dir = p.kind == Tsy_HdlSignal::Input ? "input  wire " : "output wire ";
        out += "    " + attributes(p) + dir + rangeColumn(p.width, rangeWidth) + p.name;
        out += Tsy_HdlItemEnd(i, n.ports.size(), ",");
    }
    return out + ");\n";
}

UnusedOutputs nameUnusedOutputs(Tsy_HdlNetlist& n)
{
    UnusedOutputs unused;
    unused.names.resize(n.instances.size());
    for (size_t i = 0; i < n.instances.size(); ++i)
        for (const auto& use : n.instances[i].pins) {
            std::string name;
            if (!use.input && use.conn.kind == Tsy_HdlConnection::Open) {
                name = n.FreshName(n.instances[i].name + "_" + use.pin + "_unused");
                unused.wires.emplace_back(name, use.width);
            }
            unused.names[i].push_back(name);
        }
    return unused;
}

std::string wireDeclarations(const Tsy_HdlNetlist& n, const UnusedOutputs& unused)
{
    size_t wireRange = std::max(Tsy_HdlColumnWidth(n.wires, [](const Tsy_HdlSignal& w) { return range(w.width); }),
                                Tsy_HdlColumnWidth(unused.wires, [](const auto& o) { return range(o.second); }));
    auto wireLine = [&](const std::string& attrs, const std::string& name, int width) {
        return "    " + attrs + "wire " + rangeColumn(width, wireRange) + name + ";\n";
    };
    std::string out;
    if (!n.wires.empty()) {
        out += "\n";
        for (const auto& w : n.wires)
            out += wireLine(attributes(w), w.name, w.width);
    }
    if (!unused.wires.empty()) {
        out += "\n    // Outputs left unconnected.\n";
        for (const auto& o : unused.wires)
            out += wireLine("", o.first, o.second);
    }
    return out;
}

std::string continuousAssignments(const Tsy_HdlNetlist& n)
{
    if (n.assigns.empty())
        return std::string();
    std::string out = "\n";
    for (const auto& a : n.assigns)
        out += "    assign " + a.target + " = " + a.source + ";\n";
    return out;
}

std::string parameterOverrides(const Tsy_HdlInstance& inst)
{
    if (inst.parameters.empty())
        return std::string();
    std::string out = " #(\n";
    for (size_t k = 0; k < inst.parameters.size(); ++k) {
        const auto& p = inst.parameters[k];
        out += "        ." + p.name + "(" + Tsy_VerilogValue(p.type, p.value) + ")";
        out += Tsy_HdlItemEnd(k, inst.parameters.size(), ",");
    }
    return out + "    )";
}

std::string actual(const Tsy_HdlPinUse& use, const std::string& unusedWire)
{
    switch (use.conn.kind) {
    case Tsy_HdlConnection::Net: return use.conn.net;
    case Tsy_HdlConnection::Low: return constant(use.width, false);
    case Tsy_HdlConnection::High: return constant(use.width, true);
    case Tsy_HdlConnection::Open: return unusedWire;
    }
    return std::string();
}

// unusedWires: the instance's row of UnusedOutputs::names.
std::string instance(const Tsy_HdlInstance& inst, const std::vector<std::string>& unusedWires)
{
    std::string out = "\n    " + inst.type + parameterOverrides(inst) + " " + inst.name + " (\n";
    size_t pinWidth = Tsy_HdlColumnWidth(inst.pins, [](const Tsy_HdlPinUse& use) { return use.pin; });
    for (size_t k = 0; k < inst.pins.size(); ++k) {
        const auto& use = inst.pins[k];
        out += "        ." + Tsy_HdlPadded(use.pin, pinWidth) + "(" + actual(use, unusedWires[k]) + ")";
        out += Tsy_HdlItemEnd(k, inst.pins.size(), ",");
    }
    return out + "    );\n";
}

} // namespace

std::string Tsy_WriteVerilog(Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    // Every net is declared, so a misspelt name is an error, not a new wire.
    out += "\n`default_nettype none\n\n";
    out += moduleHeader(n);
    const UnusedOutputs unused = nameUnusedOutputs(n);
    out += wireDeclarations(n, unused);
    out += continuousAssignments(n);
    for (size_t i = 0; i < n.instances.size(); ++i)
        out += instance(n.instances[i], unused.names[i]);
    return out + "\nendmodule\n\n`default_nettype wire\n";
}

std::string Tsy_WriteVerilogTemplate(const Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    out += "//\n// Instantiation template: paste the instance below into your own design and\n"
           "// put your signals in place of the names in parentheses.\n\n";
    size_t nameWidth = Tsy_HdlColumnWidth(n.ports, [](const Tsy_HdlSignal& p) { return p.name; });
    out += n.module + " " + n.module + "_inst (";
    if (n.ports.empty())
        return out + ");\n";
    out += "\n";
    for (size_t i = 0; i < n.ports.size(); ++i) {
        const auto& p = n.ports[i];
        std::string line = "    ." + Tsy_HdlPadded(p.name, nameWidth) + "(" + p.name + ")";
        line += i + 1 < n.ports.size() ? "," : " ";
        line = Tsy_HdlPadded(line, nameWidth * 2 + 9);
        line += p.kind == Tsy_HdlSignal::Input ? " // input" : " // output";
        if (p.width > 1)
            line += " " + range(p.width);
        out += line + "\n";
    }
    return out + ");\n";
}
