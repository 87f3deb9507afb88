#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlValues.h"
#include "hdl/Tsy_HdlWriter.h"

#include <algorithm>

namespace {

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

std::string padded(const std::string& s, size_t width)
{
    return s + std::string(width > s.size() ? width - s.size() : 0, ' ');
}

std::string comments(const std::vector<std::string>& banner)
{
    std::string out;
    for (const auto& line : banner)
        out += line.empty() ? "//\n" : "// " + line + "\n";
    return out;
}

std::string attributes(const Tsy_HdlSignal& s)
{
    std::string out;
    for (const auto& a : s.attributes)
        out += "(* " + a.name + " = " + Tsy_VerilogValue("string", a.value) + " *) ";
    return out;
}

} // namespace

std::string Tsy_WriteVerilog(Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    // Every net is declared, so a misspelt name is an error, not a new wire.
    out += "\n`default_nettype none\n\n";

    size_t rangeWidth = 0;
    for (const auto& p : n.ports)
        rangeWidth = std::max(rangeWidth, range(p.width).size());
    if (n.ports.empty()) {
        out += "module " + n.module + ";\n";
    } else {
        out += "module " + n.module + " (\n";
        for (size_t i = 0; i < n.ports.size(); ++i) {
            const auto& p = n.ports[i];
            std::string dir = p.kind == Tsy_HdlSignal::Input ? "input  wire " : "output wire ";
            std::string r = range(p.width);
            out += "    " + attributes(p) + dir + (rangeWidth ? padded(r, rangeWidth) + " " : "") + p.name;
            out += i + 1 < n.ports.size() ? ",\n" : "\n";
        }
        out += ");\n";
    }

    // Outputs the design leaves unconnected each get a wire of their own,
    // named so that lint tools know it is meant to go nowhere.
    std::vector<std::pair<std::string, int>> open;
    std::vector<std::vector<std::string>> openNames(n.instances.size());
    for (size_t i = 0; i < n.instances.size(); ++i)
        for (const auto& use : n.instances[i].pins) {
            std::string name;
            if (!use.input && use.conn.kind == Tsy_HdlConnection::Open) {
                name = n.FreshName(n.instances[i].name + "_" + use.pin + "_unused");
                open.emplace_back(name, use.width);
            }
            openNames[i].push_back(name);
        }

    size_t wireRange = 0;
    for (const auto& w : n.wires)
        wireRange = std::max(wireRange, range(w.width).size());
    for (const auto& o : open)
        wireRange = std::max(wireRange, range(o.second).size());
    auto wireLine = [&](const std::string& attrs, const std::string& name, int width) {
        return "    " + attrs + "wire " + (wireRange ? padded(range(width), wireRange) + " " : "") + name + ";\n";
    };
    if (!n.wires.empty()) {
        out += "\n";
        for (const auto& w : n.wires)
            out += wireLine(attributes(w), w.name, w.width);
    }
    if (!open.empty()) {
        out += "\n    // Outputs left unconnected.\n";
        for (const auto& o : open)
            out += wireLine("", o.first, o.second);
    }

    if (!n.assigns.empty()) {
        out += "\n";
        for (const auto& a : n.assigns)
            out += "    assign " + a.target + " = " + a.source + ";\n";
    }

    for (size_t i = 0; i < n.instances.size(); ++i) {
        const auto& inst = n.instances[i];
        out += "\n    " + inst.type;
        if (!inst.parameters.empty()) {
            out += " #(\n";
            for (size_t k = 0; k < inst.parameters.size(); ++k) {
                const auto& p = inst.parameters[k];
                out += "        ." + p.name + "(" + Tsy_VerilogValue(p.type, p.value) + ")";
                out += k + 1 < inst.parameters.size() ? ",\n" : "\n";
            }
            out += "    )";
        }
        out += " " + inst.name + " (\n";
        size_t pinWidth = 0;
        for (const auto& use : inst.pins)
            pinWidth = std::max(pinWidth, use.pin.size());
        for (size_t k = 0; k < inst.pins.size(); ++k) {
            const auto& use = inst.pins[k];
            std::string actual;
            switch (use.conn.kind) {
            case Tsy_HdlConnection::Net: actual = use.conn.net; break;
            case Tsy_HdlConnection::Low: actual = constant(use.width, false); break;
            case Tsy_HdlConnection::High: actual = constant(use.width, true); break;
            case Tsy_HdlConnection::Open: actual = openNames[i][k]; break;
            }
            out += "        ." + padded(use.pin, pinWidth) + "(" + actual + ")";
            out += k + 1 < inst.pins.size() ? ",\n" : "\n";
        }
        out += "    );\n";
    }
    out += "\nendmodule\n\n`default_nettype wire\n";
    return out;
}

std::string Tsy_WriteVerilogTemplate(const Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    out += "//\n// Instantiation template: paste the instance below into your own design and\n"
           "// put your signals in place of the names in parentheses.\n\n";
    size_t nameWidth = 0;
    for (const auto& p : n.ports)
        nameWidth = std::max(nameWidth, p.name.size());
    out += n.module + " " + n.module + "_inst (";
    if (n.ports.empty())
        return out + ");\n";
    out += "\n";
    for (size_t i = 0; i < n.ports.size(); ++i) {
        const auto& p = n.ports[i];
        std::string line = "    ." + padded(p.name, nameWidth) + "(" + p.name + ")";
        line += i + 1 < n.ports.size() ? "," : " ";
        line = padded(line, nameWidth * 2 + 9);
        line += p.kind == Tsy_HdlSignal::Input ? " // input" : " // output";
        if (p.width > 1)
            line += " " + range(p.width);
        out += line + "\n";
    }
    return out + ");\n";
}
