#include "hdl/Tsy_HdlNetlist.h"
#include "hdl/Tsy_HdlText.h"
#include "hdl/Tsy_HdlValues.h"
#include "hdl/Tsy_HdlWriter.h"
#include "lib/Tsy_PrimitiveLibrary.h"

#include <algorithm>
#include <map>

namespace {

using PortItems = std::vector<std::pair<std::string, std::string>>;
// The output ports the architecture reads, each with the signal that
// stands in for it there.
using InnerSignals = std::map<std::string, std::string>;

std::string type(int width)
{
    return width > 1 ? "std_logic_vector(" + std::to_string(width - 1) + " downto 0)" : std::string("std_logic");
}

std::string constant(int width, bool high)
{
    char bit = high ? '1' : '0';
    return width > 1 ? "\"" + std::string(static_cast<size_t>(width), bit) + "\"" : std::string("'") + bit + "'";
}

std::string comments(const std::vector<std::string>& banner)
{
    return Tsy_HdlCommentBanner(banner, "--");
}

const char* const kLibraries = "library ieee;\nuse ieee.std_logic_1164.all;\n";

std::string mode(bool input)
{
    return input ? "in  " : "out ";
}

// "    NAME : in  std_logic;" lines of a port clause, the last without ';'.
std::string portClause(const PortItems& items, const std::string& indent)
{
    size_t w = Tsy_HdlColumnWidth(items, [](const auto& it) { return it.first; });
    std::string out = indent + "port (\n";
    for (size_t i = 0; i < items.size(); ++i)
        out += indent + "    " + Tsy_HdlPadded(items[i].first, w) + " : " + items[i].second +
               Tsy_HdlItemEnd(i, items.size(), ";");
    return out + indent + ");\n";
}

PortItems portItemsOf(const Tsy_HdlNetlist& n)
{
    PortItems items;
    for (const auto& p : n.ports)
        items.emplace_back(p.name, mode(p.kind == Tsy_HdlSignal::Input) + type(p.width));
    return items;
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

std::string genericClause(const std::vector<const Tsy_AttrDef*>& generics, const std::string& indent)
{
    size_t w = Tsy_HdlColumnWidth(generics, [](const Tsy_AttrDef* ad) { return ad->name; });
    std::string out = indent + "    generic (\n";
    for (size_t i = 0; i < generics.size(); ++i) {
        const Tsy_AttrDef& ad = *generics[i];
        out += indent + "        " + Tsy_HdlPadded(ad.name, w) + " : " + genericType(ad) + " := " +
               Tsy_VhdlValue(ad.hdlType, Tsy_HdlDefaultValue(ad)) + Tsy_HdlItemEnd(i, generics.size(), ";");
    }
    return out + indent + "    );\n";
}

// "    attribute NAME of SIGNAL : signal is VALUE;" for each attribute.
std::string attributeValues(const Tsy_HdlSignal& s)
{
    std::string out;
    for (const auto& a : s.attributes)
        out += "    attribute " + a.name + " of " + s.name + " : signal is " + Tsy_VhdlValue("string", a.value) +
               ";\n";
    return out;
}

// An output port cannot be read inside a VHDL-93 architecture: those the
// design reads get a signal that carries their value and drives them.
InnerSignals innerSignalsOf(Tsy_HdlNetlist& n)
{
    InnerSignals inner;
    for (const auto& p : n.ports)
        if (p.readInside)
            inner[p.name] = n.FreshName(p.name + "_int");
    return inner;
}

// The name the architecture uses for a net.
std::string insideName(const InnerSignals& inner, const std::string& name)
{
    auto it = inner.find(name);
    return it == inner.end() ? name : it->second;
}

std::string entity(const Tsy_HdlNetlist& n)
{
    std::string out = "entity " + n.module + " is\n";
    if (!n.ports.empty())
        out += portClause(portItemsOf(n), "    ");
    // Attributes are declared with the entity, where the ports' own must be
    // specified; the architecture sees the declarations.
    for (const auto& a : n.attributeNames)
        out += "    attribute " + a + " : string;\n";
    for (const auto& p : n.ports)
        out += attributeValues(p);
    return out + "end entity " + n.module + ";\n";
}

std::string signalDeclarations(const Tsy_HdlNetlist& n, const InnerSignals& inner)
{
    std::vector<std::pair<std::string, int>> signals;
    for (const auto& w : n.wires)
        signals.emplace_back(w.name, w.width);
    for (const auto& p : n.ports)
        if (p.readInside)
            signals.emplace_back(inner.at(p.name), p.width);
    std::sort(signals.begin(), signals.end());
    if (signals.empty())
        return std::string();
    size_t w = Tsy_HdlColumnWidth(signals, [](const auto& s) { return s.first; });
    std::string out = "\n";
    for (const auto& s : signals)
        out += "    signal " + Tsy_HdlPadded(s.first, w) + " : " + type(s.second) + ";\n";
    return out;
}

std::string architectureDeclarations(const Tsy_HdlNetlist& n, const InnerSignals& inner)
{
    std::string out;
    for (const auto* def : n.used)
        out += "\n" + Tsy_VhdlComponent(*def, "    ");
    out += signalDeclarations(n, inner);
    for (const auto& wire : n.wires)
        out += attributeValues(wire);
    return out;
}

std::string concurrentAssignments(const Tsy_HdlNetlist& n, const InnerSignals& inner)
{
    if (n.assigns.empty() && inner.empty())
        return std::string();
    std::string out = "\n";
    for (const auto& a : n.assigns)
        out += "    " + insideName(inner, a.target) + " <= " + insideName(inner, a.source) + ";\n";
    for (const auto& [port, signal] : inner)
        out += "    " + port + " <= " + signal + ";\n";
    return out;
}

std::string genericMap(const Tsy_HdlInstance& inst)
{
    if (inst.parameters.empty())
        return std::string();
    size_t w = Tsy_HdlColumnWidth(inst.parameters, [](const Tsy_HdlParameter& p) { return p.name; });
    std::string out = "        generic map (\n";
    for (size_t k = 0; k < inst.parameters.size(); ++k) {
        const auto& p = inst.parameters[k];
        out += "            " + Tsy_HdlPadded(p.name, w) + " => " + Tsy_VhdlValue(p.type, p.value) +
               Tsy_HdlItemEnd(k, inst.parameters.size(), ",");
    }
    return out + "        )\n";
}

std::string actual(const Tsy_HdlPinUse& use, const InnerSignals& inner)
{
    switch (use.conn.kind) {
    case Tsy_HdlConnection::Net: return insideName(inner, use.conn.net);
    case Tsy_HdlConnection::Low: return constant(use.width, false);
    case Tsy_HdlConnection::High: return constant(use.width, true);
    case Tsy_HdlConnection::Open: return "open";
    }
    return std::string();
}

std::string portMap(const Tsy_HdlInstance& inst, const InnerSignals& inner)
{
    size_t w = Tsy_HdlColumnWidth(inst.pins, [](const Tsy_HdlPinUse& use) { return use.pin; });
    std::string out = "        port map (\n";
    for (size_t k = 0; k < inst.pins.size(); ++k) {
        const auto& use = inst.pins[k];
        out += "            " + Tsy_HdlPadded(use.pin, w) + " => " + actual(use, inner) +
               Tsy_HdlItemEnd(k, inst.pins.size(), ",");
    }
    return out + "        );\n";
}

std::string instance(const Tsy_HdlInstance& inst, const InnerSignals& inner)
{
    std::string out = "\n    " + inst.name + " : " + inst.type + "\n" + genericMap(inst);
    if (!inst.pins.empty())
        return out + portMap(inst, inner);
    // Without a port map the statement ends with its last line.
    out.insert(out.size() - 1, ";");
    return out;
}

std::string architecture(const Tsy_HdlNetlist& n, const InnerSignals& inner)
{
    std::string out = "architecture structure of " + n.module + " is\n";
    out += architectureDeclarations(n, inner);
    out += "\nbegin\n";
    out += concurrentAssignments(n, inner);
    for (const auto& inst : n.instances)
        out += instance(inst, inner);
    return out + "\nend architecture structure;\n";
}

} // namespace

std::string Tsy_VhdlComponent(const Tsy_PrimitiveDef& def, const std::string& indent)
{
    std::string out = indent + "component " + def.type + "\n";
    std::vector<const Tsy_AttrDef*> generics = Tsy_HdlParameterDefs(def);
    if (!generics.empty())
        out += genericClause(generics, indent);
    PortItems ports;
    for (const auto& pd : def.pins)
        ports.emplace_back(pd.name, mode(pd.direction == "IN") + type(pd.width));
    if (!ports.empty())
        out += portClause(ports, indent + "    ");
    return out + indent + "end component;\n";
}

std::string Tsy_WriteVhdl(Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    const InnerSignals inner = innerSignalsOf(n);
    return comments(banner) + "\n" + kLibraries + "\n" + entity(n) + "\n" + architecture(n, inner);
}

std::string Tsy_WriteVhdlTemplate(const Tsy_HdlNetlist& n, const std::vector<std::string>& banner)
{
    std::string out = comments(banner);
    out += "--\n-- Instantiation template. Put the component declaration in the declarative\n"
           "-- part of your architecture and the instance in its statement part, with\n"
           "-- your signals in place of the names after the arrows.\n\n";
    out += "component " + n.module + "\n";
    if (!n.ports.empty())
        out += portClause(portItemsOf(n), "    ");
    out += "end component;\n\n";
    out += n.module + "_inst : " + n.module;
    if (n.ports.empty())
        return out + ";\n";
    size_t w = Tsy_HdlColumnWidth(n.ports, [](const Tsy_HdlSignal& p) { return p.name; });
    out += "\n    port map (\n";
    for (size_t i = 0; i < n.ports.size(); ++i)
        out += "        " + Tsy_HdlPadded(n.ports[i].name, w) + " => " + n.ports[i].name +
               Tsy_HdlItemEnd(i, n.ports.size(), ",");
    return out + "    );\n";
}
