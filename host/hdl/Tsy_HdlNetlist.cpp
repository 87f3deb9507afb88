#include "hdl/Tsy_HdlNetlist.h"

#include "db/Tsy_WizData.h"
#include "hdl/Tsy_HdlNames.h"
#include "hdl/Tsy_HdlText.h"
#include "hdl/Tsy_HdlValues.h"
#include "lib/Tsy_PrimitiveLibrary.h"

#include <algorithm>
#include <cctype>
#include <map>

namespace {

const char* const kAssocWith = "ASSOC_WITH";

// Names the VHDL text itself relies on: a design name equal to one of them
// would hide the library, the package or a type the ports are declared with.
const char* const kVhdlReserved[] = {"ieee",          "std",     "work",      "std_logic", "std_logic_vector",
                                     "std_logic_1164", "bit_vector", "structure"};

std::string pinRef(const std::string& instance, const std::string& pin)
{
    return "pin " + pin + " of " + instance;
}

struct NetInfo {
    const Tsy_Signal* signal = nullptr;
    Tsy_HdlSignal::Kind kind = Tsy_HdlSignal::Wire;
    std::vector<std::string> drivers;
    std::vector<std::string> readers;
    std::vector<std::pair<std::string, int>> widths; // who, width
    std::vector<std::pair<size_t, size_t>> drivingPins; // instance, pin index
    int width = 1;
};

const char* kindWord(Tsy_HdlSignal::Kind kind)
{
    switch (kind) {
    case Tsy_HdlSignal::Input: return "input port";
    case Tsy_HdlSignal::Output: return "output port";
    default: return "net";
    }
}

std::string joinList(const std::vector<std::string>& items)
{
    std::string out;
    for (size_t i = 0; i < items.size(); ++i) {
        if (i > 0)
            out += i + 1 == items.size() ? " and " : ", ";
        out += items[i];
    }
    return out;
}

class Builder {
public:
    Builder(const Tsy_WizData& data, const std::string& module, Tsy_HdlNetlist& out, std::string& error)
        : data_(data), module_(module), out_(out), error_(error)
    {
    }

    bool Run()
    {
        out_ = Tsy_HdlNetlist();
        out_.module = module_;
        return checkModule() && readSignals() && readInstances() && readAssociations() && checkDrivers() &&
               resolveWidths() && collect() && checkClashes();
    }

private:
    bool fail(const std::string& why)
    {
        error_ = why;
        return false;
    }

    bool legal(const std::string& what, const std::string& name)
    {
        std::string problem = Tsy_HdlNameProblem(name);
        if (problem.empty())
            return true;
        return fail("The " + what + " \"" + name + "\" is not a legal Verilog and VHDL name: it " + problem + ".");
    }

    bool checkModule()
    {
        if (!legal("module name", module_))
            return false;
        if (const Tsy_PrimitiveDef* clash = data_.Library().FindNoCase(module_))
            return fail("The module name \"" + module_ + "\" is the name of the primitive " + clash->type +
                        "; the two would clash in any design that uses both.");
        return true;
    }

    bool readSignals()
    {
        for (const auto& s : data_.Signals()) {
            if (!s->IsActive())
                continue;
            NetInfo info;
            info.signal = s.get();
            if (!s->IsExternal()) {
                info.kind = Tsy_HdlSignal::Wire;
            } else if (s->GetDirection() == "I") {
                info.kind = Tsy_HdlSignal::Input;
            } else if (s->GetDirection() == "O") {
                info.kind = Tsy_HdlSignal::Output;
            } else {
                if (!legal("port name", s->GetName().str()))
                    return false;
                return fail("The port \"" + s->GetName().str() + "\" has no direction: a port is an input or an output.");
            }
            if (!legal(info.kind == Tsy_HdlSignal::Wire ? "net name" : "port name", s->GetName().str()))
                return false;
            if (info.kind == Tsy_HdlSignal::Input)
                info.drivers.push_back("the input port itself");
            if (s->IsBus())
                info.widths.emplace_back("its declared width", s->GetWidth());
            nets_[s->GetName().str()] = info;
        }
        return true;
    }

    NetInfo* netNamed(const std::string& name)
    {
        auto it = nets_.find(name);
        return it == nets_.end() ? nullptr : &it->second;
    }

    bool readParameters(const Tsy_Block& b, Tsy_HdlInstance& inst)
    {
        for (const Tsy_AttrDef* def : Tsy_HdlParameterDefs(*inst.def)) {
            const Tsy_AttrDef& ad = *def;
            const Tsy_Attribute* a = b.GetNamedAttribute(ad.name);
            if (!a || !a->IsActive())
                continue;
            Tsy_HdlParameter p;
            p.name = ad.name;
            p.type = ad.hdlType;
            std::string expected;
            if (!Tsy_HdlCanonicalValue(ad.hdlType, a->GetValue().str(), p.value, expected))
                return fail("The attribute " + ad.name + " of " + inst.name + " is \"" + a->GetValue().str() +
                            "\", which is not " + expected + ".");
            inst.parameters.push_back(p);
        }
        return true;
    }

    bool readPins(const Tsy_Block& b, Tsy_HdlInstance& inst, size_t index)
    {
        for (const auto& pd : inst.def->pins) {
            Tsy_HdlPinUse use;
            use.pin = pd.name;
            use.input = pd.direction == "IN";
            use.width = pd.width;
            const Tsy_Pin* pin = b.GetNamedPin(pd.name);
            if (!pin || !pin->IsActive()) {
                // A pin the design does not use: inputs held low, outputs open.
                use.conn.kind = use.input ? Tsy_HdlConnection::Low : Tsy_HdlConnection::Open;
                inst.pins.push_back(use);
                continue;
            }
            const std::string who = pinRef(inst.name, pd.name);
            if (pin->GetWidth() != pd.width)
                return fail("The " + who + " is " + std::to_string(pin->GetWidth()) + " bits wide, but the " +
                            inst.type + " primitive's pin is " + std::to_string(pd.width) + " bits wide.");
            if (pin->IsGrounded() || pin->IsVcc()) {
                if (!use.input)
                    return fail("The output " + who + " is tied to a constant.");
                use.conn.kind = pin->IsVcc() ? Tsy_HdlConnection::High : Tsy_HdlConnection::Low;
            } else if (!pin->GetSigName().IsEmpty()) {
                const std::string net = pin->GetSigName().str();
                NetInfo* info = netNamed(net);
                if (!info)
                    return fail("The " + who + " is connected to \"" + net + "\", which is not a net of the design.");
                use.conn.kind = Tsy_HdlConnection::Net;
                use.conn.net = net;
                info->widths.emplace_back(who, pd.width);
                if (use.input) {
                    info->readers.push_back(who);
                } else {
                    info->drivers.push_back(who);
                    info->drivingPins.emplace_back(index, inst.pins.size());
                }
            } else if (use.input) {
                return fail("The input " + who + " is connected to nothing.");
            }
            inst.pins.push_back(use);
        }
        for (const auto& pin : b.Pins()) {
            if (inst.def->FindPin(pin->GetName().str()) || !pin->IsActive())
                continue;
            if (!pin->GetSigName().IsEmpty() || pin->IsGrounded() || pin->IsVcc())
                return fail("The instance " + inst.name + " uses a pin " + pin->GetName().str() + " that the " +
                            inst.type + " primitive does not have.");
        }
        return true;
    }

    bool readInstances()
    {
        for (const auto& b : data_.Blocks()) {
            if (!b->active)
                continue;
            Tsy_HdlInstance inst;
            inst.name = b->GetName().str();
            inst.type = b->GetType().str();
            if (!legal("instance name", inst.name))
                return false;
            inst.def = b->GetDef();
            if (!inst.def)
                return fail("The instance " + inst.name + " is of type " + inst.type +
                            ", which the primitive library does not define.");
            if (!readParameters(*b, inst) || !readPins(*b, inst, out_.instances.size()))
                return false;
            out_.instances.push_back(std::move(inst));
        }
        return true;
    }

    bool readAssociations()
    {
        for (auto& [name, info] : nets_) {
            std::string target = info.signal->GetAttributeValue(kAssocWith).str();
            if (target.empty())
                continue;
            NetInfo* port = netNamed(target);
            if (!port || port->kind != Tsy_HdlSignal::Output || target == name)
                return fail("The " + std::string(kindWord(info.kind)) + " " + name + " is associated with \"" +
                            target + "\", which is not an output port of the design.");
            port->drivers.push_back("the " + std::string(kindWord(info.kind)) + " " + name);
            info.readers.push_back("the output port " + target);
            assigns_.push_back({target, name});
        }
        return true;
    }

    bool checkDrivers()
    {
        for (auto& [name, info] : nets_) {
            if (info.drivers.size() > 1) {
                if (info.kind == Tsy_HdlSignal::Input)
                    return fail("The input port " + name + " is also driven by " +
                                joinList({info.drivers.begin() + 1, info.drivers.end()}) + ".");
                return fail("The " + std::string(kindWord(info.kind)) + " " + name + " has more than one driver: " +
                            joinList(info.drivers) + ".");
            }
            if (info.kind == Tsy_HdlSignal::Output && info.drivers.empty())
                return fail("The output port " + name + " is driven by nothing.");
            if (info.kind == Tsy_HdlSignal::Wire && info.drivers.empty() && !info.readers.empty())
                return fail("The net " + name + " is read by " + joinList(info.readers) + ", but nothing drives it.");
        }
        return true;
    }

    bool resolveWidths()
    {
        for (auto& [name, info] : nets_) {
            if (info.widths.empty())
                continue;
            int w = info.widths.front().second;
            for (const auto& [who, width] : info.widths)
                if (width != w)
                    return fail("The " + std::string(kindWord(info.kind)) + " " + name + " is " + std::to_string(w) +
                                " bits wide for " + info.widths.front().first + " but " + std::to_string(width) +
                                " bits for the " + who + ".");
            info.width = w;
        }
        // A port that only an assignment reaches takes the width of its source.
        for (const auto& a : assigns_)
            if (nets_[a.target].widths.empty())
                nets_[a.target].width = nets_[a.source].width;
        for (const auto& a : assigns_) {
            int tw = nets_[a.target].width, sw = nets_[a.source].width;
            if (tw != sw)
                return fail("The net " + a.source + " (" + std::to_string(sw) + " bits) cannot drive the output port " +
                            a.target + " (" + std::to_string(tw) + " bits).");
        }
        return true;
    }

    bool signalAttributes(const NetInfo& info, Tsy_HdlSignal& s)
    {
        for (const auto& a : info.signal->Attributes()) {
            const std::string& n = a->GetName().str();
            if (!a->IsActive() || n == kAssocWith || Tsy_IsWizardAttributeName(n))
                continue;
            if (!legal("attribute name", n))
                return false;
            std::string value, expected;
            if (!Tsy_HdlCanonicalValue("string", a->GetValue().str(), value, expected))
                return fail("The attribute " + n + " of " + s.name + " is not " + expected + ".");
            s.attributes.push_back({n, value});
            attributeNames_.insert(n);
        }
        return true;
    }

    bool collect()
    {
        std::vector<Tsy_HdlSignal> inputs, outputs;
        for (auto& [name, info] : nets_) {
            Tsy_HdlSignal s;
            s.name = name;
            s.kind = info.kind;
            s.width = info.width;
            if (info.kind == Tsy_HdlSignal::Wire) {
                if (info.readers.empty()) {
                    // Driven but read by nothing: the writers leave the driving
                    // pin open rather than declare a net no tool wants to see.
                    for (const auto& [i, p] : info.drivingPins)
                        out_.instances[i].pins[p].conn = Tsy_HdlConnection();
                    continue;
                }
            } else if (info.kind == Tsy_HdlSignal::Output) {
                s.readInside = !info.readers.empty();
            }
            if (!signalAttributes(info, s))
                return false;
            if (info.kind == Tsy_HdlSignal::Input)
                inputs.push_back(s);
            else if (info.kind == Tsy_HdlSignal::Output)
                outputs.push_back(s);
            else
                out_.wires.push_back(s);
        }
        out_.ports = inputs;
        out_.ports.insert(out_.ports.end(), outputs.begin(), outputs.end());
        std::sort(assigns_.begin(), assigns_.end(),
                  [](const Tsy_HdlAssign& a, const Tsy_HdlAssign& b) { return a.target < b.target; });
        out_.assigns = assigns_;
        std::map<std::string, const Tsy_PrimitiveDef*> used;
        for (const auto& inst : out_.instances)
            used[inst.type] = inst.def;
        for (const auto& [type, def] : used)
            out_.used.push_back(def);
        out_.attributeNames.assign(attributeNames_.begin(), attributeNames_.end());
        return true;
    }

    bool claim(const std::string& name, const std::string& what, std::map<std::string, std::pair<std::string, std::string>>& seen)
    {
        auto [it, fresh] = seen.emplace(Tsy_HdlFoldCase(name), std::make_pair(name, what));
        if (fresh)
            return true;
        const auto& [otherName, otherWhat] = it->second;
        if (otherName == name)
            return fail("The name \"" + name + "\" is given to both " + otherWhat + " and " + what + ".");
        return fail("The names \"" + otherName + "\" (" + otherWhat + ") and \"" + name + "\" (" + what +
                    ") differ only in case, which VHDL does not tell apart.");
    }

    bool checkClashes()
    {
        std::map<std::string, std::pair<std::string, std::string>> seen;
        for (const char* word : kVhdlReserved)
            seen.emplace(word, std::make_pair(std::string(word), "a name the VHDL netlist relies on"));
        bool ok = claim(module_, "the module", seen);
        for (const auto* def : out_.used)
            ok = ok && claim(def->type, "the primitive " + def->type, seen);
        for (const auto& p : out_.ports)
            ok = ok && claim(p.name, std::string("an ") + kindWord(p.kind), seen);
        for (const auto& w : out_.wires)
            ok = ok && claim(w.name, "a net", seen);
        for (const auto& inst : out_.instances)
            ok = ok && claim(inst.name, "an instance", seen);
        for (const auto& a : out_.attributeNames)
            ok = ok && claim(a, "a signal attribute", seen);
        if (!ok)
            return false;
        for (const auto& [low, entry] : seen)
            out_.taken.insert(low);
        return true;
    }

    const Tsy_WizData& data_;
    const std::string& module_;
    Tsy_HdlNetlist& out_;
    std::string& error_;
    std::map<std::string, NetInfo> nets_;
    std::vector<Tsy_HdlAssign> assigns_;
    std::set<std::string> attributeNames_;
};

} // namespace

std::string Tsy_HdlNetlist::FreshName(const std::string& base)
{
    std::string name = base;
    for (int n = 1; taken.count(Tsy_HdlFoldCase(name)); ++n)
        name = base + std::to_string(n);
    taken.insert(Tsy_HdlFoldCase(name));
    return name;
}

bool Tsy_BuildHdlNetlist(const Tsy_WizData& data, const std::string& module, Tsy_HdlNetlist& out, std::string& error)
{
    return Builder(data, module, out, error).Run();
}
