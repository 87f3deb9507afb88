#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlValues.h"
#include "hdl/Tsy_HdlWriter.h"
#include "lib/Tsy_PrimitiveLibrary.h"

#include <algorithm>
#include <map>

namespace {

std::string type(int width)
{
    return width > 1 ? "std_logic_vector(" + std::to_string(width - 1) + " downto 0)" : std::string("std_logic");
}

std::string constant(int width, bool high)
{
    char bit = high ? '1' : '0';
    return width > 1 ? "\"" + std::string(static_cast<size_t>(width), bit) + "\"" : std::string("'") + bit + "'";
}

std::string padded(const std::string& s, size_t width)
{
    return s + std::string(width > s.size() ? width - s.size() : 0, ' ');
}

std::string comments(const std::vector<std::string>& banner)
{
    std::string out;
    for (const auto& line : banner)
        out += line.empty() ? "--\n" : "-- " + line + "\n";
    return out;
}

const char* const kLibraries = "library ieee;\nuse ieee.std_logic_1164.all;\n";

// "    NAME : in  std_logic;" lines of a port clause, the last without ';'.
std::string portClause(const std::vector<std::pair<std::string, std::string>>& items, const std::string& indent)
{
    size_t w = 0;
    for (const auto& it : items)
        w = std::max(w, it.first.size());
    std::string out = indent + "port (\n";
    for (size_t i = 0; i < items.size(); ++i)
        out += indent + "    " + padded(items[i].first, w) + " : " + items[i].second +
               (i + 1 < items.size() ? ";\n" : "\n");
    return out + indent + ");\n";
}

std::string genericType(const Tsy_AttrDef& ad)
{
    if (ad.hdlType == "integer")
        return "integer";
    if (ad.hdlType == "real")
        return "real";
    if (ad.hdlType == "hex")
        return "bit_vector";
    if (ad.hdlType == "bit")
        return "bit";
    return "string";
}

bool isWizardAttribute(const std::string& name)
{
    return name.rfind("TESY_ONLY_", 0) == 0 || name.rfind("TSY_", 0) == 0;
}

} // namespace

std::string Tsy_VhdlComponent(const Tsy_PrimitiveDef& def, const std::string& indent)
{
    std::string out = indent + "component " + def.type + "\n";
    std::vector<const Tsy_AttrDef*> generics;
    for (const auto& ad : def.attributes)
        if (ad.hdl && !isWizardAttribute(ad.name))
            generics.push_back(&ad);
    if (!generics.empty()) {
        size_t w = 0;
        for (const auto* ad : generics)
            w = std::max(w, ad->name.size());
        out += indent + "    generic (\n";
        for (size_t i = 0; i < generics.size(); ++i) {
            const Tsy_AttrDef& ad = *generics[i];
            std::string value, expected;
            if (!Tsy_HdlCanonicalValue(ad.hdlType, ad.defaultValue, value, expected))
                value = Tsy_HdlNeutralValue(ad.hdlType);
            out += indent + "        " + padded(ad.name, w) + " : " + genericType(ad) + " := " +
                   Tsy_VhdlValue(ad.hdlType, value) + (i + 1 < generics.size() ? ";\n" : "\n");
        }
        out += indent + "    );\n";
    }
    std::vector<std::pair<std::string, std::string>> ports;
    for (const auto& pd : def.pins)
        ports.emplace_back(pd.name, (pd.direction == "IN" ? "in  " : "out ") + type(pd.width));
    if (!ports.empty())
        out += portClause(ports, indent + "    ");
    return out + indent + "end component;\n";
}

std::string Tsy_WriteVhdl(Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    // An output port cannot be read inside a VHDL-93 architecture: those the
    // design reads get a signal that carries their value and drives them.
    std::map<std::string, std::string> inner;
    for (const auto& p : n.ports)
        if (p.readInside)
            inner[p.name] = n.FreshName(p.name + "_int");
    auto ref = [&](const std::string& name) {
        auto it = inner.find(name);
        return it == inner.end() ? name : it->second;
    };

    std::string out = comments(banner) + "\n" + kLibraries + "\n";
    out += "entity " + n.module + " is\n";
    if (!n.ports.empty()) {
        std::vector<std::pair<std::string, std::string>> items;
        for (const auto& p : n.ports)
            items.emplace_back(p.name, (p.kind == Tsy_HdlSignal::Input ? "in  " : "out ") + type(p.width));
        out += portClause(items, "    ");
    }
    // Attributes are declared with the entity, where the ports' own must be
    // specified; the architecture sees the declarations.
    for (const auto& a : n.attributeNames)
        out += "    attribute " + a + " : string;\n";
    for (const auto& p : n.ports)
        for (const auto& a : p.attributes)
            out += "    attribute " + a.name + " of " + p.name + " : signal is " + Tsy_VhdlValue("string", a.value) +
                   ";\n";
    out += "end entity " + n.module + ";\n\n";

    out += "architecture structure of " + n.module + " is\n";
    for (const auto* def : n.used)
        out += "\n" + Tsy_VhdlComponent(*def, "    ");
    std::vector<std::pair<std::string, int>> signals;
    for (const auto& w : n.wires)
        signals.emplace_back(w.name, w.width);
    for (const auto& p : n.ports)
        if (p.readInside)
            signals.emplace_back(inner[p.name], p.width);
    std::sort(signals.begin(), signals.end());
    if (!signals.empty()) {
        size_t w = 0;
        for (const auto& s : signals)
            w = std::max(w, s.first.size());
        out += "\n";
        for (const auto& s : signals)
            out += "    signal " + padded(s.first, w) + " : " + type(s.second) + ";\n";
    }
    for (const auto& wire : n.wires)
        for (const auto& a : wire.attributes)
            out += "    attribute " + a.name + " of " + wire.name + " : signal is " +
                   Tsy_VhdlValue("string", a.value) + ";\n";
    out += "\nbegin\n";

    if (!n.assigns.empty() || !inner.empty()) {
        out += "\n";
        for (const auto& a : n.assigns)
            out += "    " + ref(a.target) + " <= " + ref(a.source) + ";\n";
        for (const auto& [port, signal] : inner)
            out += "    " + port + " <= " + signal + ";\n";
    }

    for (const auto& inst : n.instances) {
        out += "\n    " + inst.name + " : " + inst.type + "\n";
        if (!inst.parameters.empty()) {
            size_t w = 0;
            for (const auto& p : inst.parameters)
                w = std::max(w, p.name.size());
            out += "        generic map (\n";
            for (size_t k = 0; k < inst.parameters.size(); ++k) {
                const auto& p = inst.parameters[k];
                out += "            " + padded(p.name, w) + " => " + Tsy_VhdlValue(p.type, p.value) +
                       (k + 1 < inst.parameters.size() ? ",\n" : "\n");
            }
            out += "        )\n";
        }
        size_t w = 0;
        for (const auto& use : inst.pins)
            w = std::max(w, use.pin.size());
        if (inst.pins.empty()) {
            out.insert(out.size() - 1, ";");
            continue;
        }
        out += "        port map (\n";
        for (size_t k = 0; k < inst.pins.size(); ++k) {
            const auto& use = inst.pins[k];
            std::string actual;
            switch (use.conn.kind) {
            case Tsy_HdlConnection::Net: actual = ref(use.conn.net); break;
            case Tsy_HdlConnection::Low: actual = constant(use.width, false); break;
            case Tsy_HdlConnection::High: actual = constant(use.width, true); break;
            case Tsy_HdlConnection::Open: actual = "open"; break;
            }
            out += "            " + padded(use.pin, w) + " => " + actual + (k + 1 < inst.pins.size() ? ",\n" : "\n");
        }
        out += "        );\n";
    }
    out += "\nend architecture structure;\n";
    return out;
}

std::string Tsy_WriteVhdlTemplate(const Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    out += "--\n-- Instantiation template. Put the component declaration in the declarative\n"
           "-- part of your architecture and the instance in its statement part, with\n"
           "-- your signals in place of the names after the arrows.\n\n";
    out += "component " + n.module + "\n";
    std::vector<std::pair<std::string, std::string>> items;
    for (const auto& p : n.ports)
        items.emplace_back(p.name, (p.kind == Tsy_HdlSignal::Input ? "in  " : "out ") + type(p.width));
    if (!items.empty())
        out += portClause(items, "    ");
    out += "end component;\n\n";
    out += n.module + "_inst : " + n.module;
    if (n.ports.empty())
        return out + ";\n";
    size_t w = 0;
    for (const auto& p : n.ports)
        w = std::max(w, p.name.size());
    out += "\n    port map (\n";
    for (size_t i = 0; i < n.ports.size(); ++i)
        out += "        " + padded(n.ports[i].name, w) + " => " + n.ports[i].name +
               (i + 1 < n.ports.size() ? ",\n" : "\n");
    return out + "    );\n";
}
