#include "design/Tsy_DesignFile.h"

#include "db/Tsy_WizData.h"
#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_JsonReader.h"
#include "lib/Tsy_PrimitiveLibrary.h"
#include "port/Exception.h"

#include <set>

using Json = nlohmann::ordered_json;

// ---------------------------------------------------------------- writing

namespace {

Json attributesOf(const Tsy_AttrHolder& holder)
{
    Json out = Json::object();
    for (const auto& a : holder.Attributes()) {
        if (a->IsActive())
            out[a->GetName().str()] = a->GetValue().str();
        else
            out[a->GetName().str()] = Json{{"value", a->GetValue().str()}, {"active", false}};
    }
    return out;
}

const char* tieOf(const Tsy_Pin& pin)
{
    return pin.IsGrounded() ? "GND" : pin.IsVcc() ? "VCC" : "";
}

Json pinToJson(const Tsy_Pin& pin)
{
    return Json{{"name", pin.GetName().str()},           {"direction", pin.GetDirection().str()},
                {"width", pin.GetWidth()},               {"active", pin.IsActive()},
                {"signal", pin.GetSigName().str()},      {"tie", tieOf(pin)},
                {"attributes", attributesOf(pin)}};
}

Json blockToJson(const Tsy_Block& block)
{
    Json pins = Json::array();
    for (const auto& p : block.Pins())
        pins.push_back(pinToJson(*p));
    Json out{{"name", block.GetName().str()}, {"type", block.GetType().str()}, {"active", block.active},
             {"complete", true}};
    if (block.IsTemplate())
        out["template"] = true;
    if (block.IsGenerated())
        out["generated"] = true;
    out["attributes"] = attributesOf(block);
    out["pins"] = pins;
    return out;
}

Json signalToJson(const Tsy_Signal& s)
{
    return Json{{"name", s.GetName().str()},       {"external", s.IsExternal()}, {"direction", s.GetDirection().str()},
                {"width", s.GetWidth()},           {"active", s.IsActive()},     {"attributes", attributesOf(s)}};
}

} // namespace

std::string Tsy_DesignFile::ToText(const Tsy_DesignHeader& header, const Tsy_WizData& data)
{
    Json blocks = Json::array();
    for (const auto& b : data.Blocks())
        blocks.push_back(blockToJson(*b));
    Json signals = Json::array();
    for (const auto& s : data.Signals())
        signals.push_back(signalToJson(*s));
    Json doc{{"format", kFormat},
             {"wizard", header.wizard.str()},
             {"part", header.part.str()},
             {"module", header.module.str()},
             {"version", header.version.str()},
             {"blocks", blocks},
             {"signals", signals}};
    return doc.dump(2) + "\n";
}

// ---------------------------------------------------------------- reading

namespace {

struct AttrRec {
    std::string name, value;
    bool active = true;
};

struct PinRec {
    std::string name, direction, signal, tie;
    int width = 1;
    bool hasDirection = false, hasWidth = false, hasActive = false, active = false, hasSignal = false, hasTie = false;
    std::vector<AttrRec> attrs;
    std::string path;
};

struct BlockRec {
    std::string name, type;
    bool hasActive = false, active = false, complete = false, isTemplate = false, generated = false;
    std::vector<AttrRec> attrs;
    std::vector<PinRec> pins;
    std::string path;
};

struct SignalRec {
    std::string name, direction;
    bool external = false, active = true;
    int width = 1;
    std::vector<AttrRec> attrs;
};

std::vector<AttrRec> readAttributes(const Tsy_JsonReader& r)
{
    std::vector<AttrRec> out;
    if (!r.Has("attributes"))
        return out;
    const Json& node = r.Node().at("attributes");
    if (!node.is_object())
        r.FailAt("attributes", "expected an object of attribute values");
    for (auto it = node.begin(); it != node.end(); ++it) {
        AttrRec a;
        a.name = it.key();
        if (a.name.empty())
            r.FailAt("attributes", "an attribute has no name");
        if (it.value().is_string()) {
            a.value = it.value().get<std::string>();
        } else if (it.value().is_object()) {
            const Json& v = it.value();
            if (!v.contains("value") || !v.at("value").is_string())
                r.FailAt("attributes." + a.name, "expected a text \"value\"");
            if (v.contains("active") && !v.at("active").is_boolean())
                r.FailAt("attributes." + a.name, "\"active\" must be true or false");
            a.value = v.at("value").get<std::string>();
            a.active = v.value("active", true);
        } else {
            r.FailAt("attributes." + a.name, "expected a text value");
        }
        out.push_back(a);
    }
    return out;
}

PinRec readPin(const Tsy_JsonReader& r)
{
    PinRec p;
    p.path = r.Path();
    p.name = r.RequiredString("name");
    if ((p.hasDirection = r.Has("direction"))) {
        p.direction = r.RequiredString("direction");
        if (p.direction != "IN" && p.direction != "OUT")
            r.FailAt("direction", "must be \"IN\" or \"OUT\"");
    }
    if ((p.hasWidth = r.Has("width"))) {
        p.width = r.OptionalInt("width", 1);
        if (p.width < 1 || p.width > 64)
            r.FailAt("width", "must be between 1 and 64");
    }
    if ((p.hasActive = r.Has("active")))
        p.active = r.OptionalBool("active", false);
    if ((p.hasSignal = r.Has("signal")))
        p.signal = r.RequiredString("signal");
    if ((p.hasTie = r.Has("tie"))) {
        p.tie = r.RequiredString("tie");
        if (p.tie != "" && p.tie != "GND" && p.tie != "VCC")
            r.FailAt("tie", "must be \"\", \"GND\" or \"VCC\"");
        if (!p.tie.empty() && !p.signal.empty())
            r.Fail("a pin cannot be tied and connected to a signal at once");
    }
    p.attrs = readAttributes(r);
    return p;
}

BlockRec readBlock(const Tsy_JsonReader& r, const Tsy_WizData& data)
{
    BlockRec b;
    b.path = r.Path();
    b.name = r.RequiredString("name");
    if (b.name.empty())
        r.FailAt("name", "a block needs a name");
    const Tsy_Block* existing = data.GetNamedBlock(b.name);
    b.type = r.Has("type") ? r.RequiredString("type") : existing ? existing->GetType().str() : std::string();
    if (b.type.empty())
        r.FailAt("type", "missing (the part has no template block of that name)");
    if (!data.Library().Find(b.type))
        r.FailAt("type", "unknown primitive '" + b.type + "'");
    if ((b.hasActive = r.Has("active")))
        b.active = r.OptionalBool("active", false);
    b.complete = r.OptionalBool("complete", false);
    b.isTemplate = r.OptionalBool("template", false);
    b.generated = r.OptionalBool("generated", false);
    b.attrs = readAttributes(r);
    std::set<std::string> seen;
    r.ForEach("pins", [&](const Tsy_JsonReader& pr) {
        PinRec p = readPin(pr);
        if (!seen.insert(p.name).second)
            pr.FailAt("name", "pin '" + p.name + "' is given twice");
        b.pins.push_back(p);
    });
    return b;
}

SignalRec readSignal(const Tsy_JsonReader& r)
{
    SignalRec s;
    s.name = r.RequiredString("name");
    if (s.name.empty())
        r.FailAt("name", "a signal needs a name");
    s.external = r.OptionalBool("external", false);
    s.direction = r.OptionalString("direction", "");
    if (s.external && s.direction != "I" && s.direction != "O")
        r.FailAt("direction", "a port's direction must be \"I\" or \"O\"");
    if (!s.external && !s.direction.empty())
        r.FailAt("direction", "an internal signal has no direction");
    s.width = r.OptionalInt("width", 1);
    if (s.width < 1 || s.width > 64)
        r.FailAt("width", "must be between 1 and 64");
    s.active = r.OptionalBool("active", true);
    s.attrs = readAttributes(r);
    return s;
}

void applyAttributes(Tsy_AttrHolder& holder, const std::vector<AttrRec>& attrs)
{
    for (const auto& a : attrs) {
        holder.SetAttributeValue(a.name, a.value);
        holder.SetAttributeIsActive(a.name, a.active);
    }
}

void clearAttributes(Tsy_AttrHolder& holder)
{
    std::vector<StringBase> names;
    for (const auto& a : holder.Attributes())
        names.push_back(a->GetName());
    for (const auto& n : names)
        holder.RemoveAttribute(n);
}

void applyPin(Tsy_Block& block, const PinRec& p, bool complete)
{
    Tsy_Pin* pin = block.GetNamedPin(p.name);
    if (!pin) {
        const Tsy_PinDef* def = block.GetDef() ? block.GetDef()->FindPin(p.name) : nullptr;
        pin = block.AddPin(p.name, p.hasDirection ? p.direction : def ? def->direction : "IN");
    }
    if (complete)
        clearAttributes(*pin);
    if (p.hasWidth)
        pin->SetWidth(p.width);
    if (p.hasActive)
        pin->SetIsActive(p.active);
    if (p.hasSignal || p.hasTie) {
        pin->ClearAllConnections();
        pin->SetSigName(p.signal);
        pin->SetIsGrounded(p.tie == "GND");
        pin->SetIsVcc(p.tie == "VCC");
    }
    applyAttributes(*pin, p.attrs);
}

void applyBlock(Tsy_WizData& data, const BlockRec& b)
{
    Tsy_Block* block = data.GetNamedBlock(b.name);
    const Tsy_PrimitiveDef* def = data.Library().Find(b.type);
    if (block && block->GetType() != StringBase(b.type))
        block->Retype(b.type, def);
    if (!block) {
        if (b.isTemplate && !data.GetPrimitiveBlock(b.type) && b.name == b.type + "_INST") {
            block = data.AddTemplateBlock(b.type);
        } else {
            block = data.AddBlock(b.name, b.type);
            if (!b.complete)
                block->FillFromDefinition();
        }
        block->active = false;
    }
    block->SetIsGenerated(b.generated);
    if (b.complete) {
        clearAttributes(*block);
        std::vector<Tsy_Pin*> pins;
        for (const auto& p : block->Pins())
            pins.push_back(p.get());
        for (Tsy_Pin* p : pins)
            block->DeletePin(p);
    }
    if (b.hasActive)
        block->active = b.active;
    applyAttributes(*block, b.attrs);
    for (const auto& p : b.pins)
        applyPin(*block, p, b.complete);
}

void applySignal(Tsy_WizData& data, const SignalRec& s)
{
    Tsy_Signal* sig = data.AddSignal(s.name, s.external, s.direction);
    sig->SetExternal(s.external, s.direction);
    sig->SetIsBus(s.width > 1, s.width);
    sig->SetIsActive(s.active);
    clearAttributes(*sig);
    applyAttributes(*sig, s.attrs);
}

StringBase textMember(const Tsy_JsonReader& r, const std::string& key)
{
    return StringBase(r.OptionalString(key, ""));
}

Tsy_DesignHeader readHeader(const Tsy_JsonReader& root)
{
    if (!root.Has("format"))
        root.FailAt("format", "missing (not a design file)");
    int format = root.OptionalInt("format", 0);
    if (format != Tsy_DesignFile::kFormat)
        root.FailAt("format", "unsupported format version " + std::to_string(format));
    Tsy_DesignHeader h;
    h.wizard = StringBase(root.RequiredString("wizard"));
    h.part = StringBase(root.RequiredString("part"));
    h.module = textMember(root, "module");
    h.version = textMember(root, "version");
    return h;
}

} // namespace

Tsy_DesignHeader Tsy_DesignFile::ReadHeader(const std::string& path)
{
    Json doc = Tsy_ReadJsonFile(path);
    return readHeader(Tsy_JsonReader(doc, path));
}

namespace {

Tsy_DesignHeader loadDocument(const Json& doc, const std::string& origin, Tsy_WizData& data)
{
    Tsy_JsonReader root(doc, origin);
    Tsy_DesignHeader header = readHeader(root);

    // Everything is read and checked before the database changes.
    std::vector<BlockRec> blocks;
    std::set<std::string> blockNames;
    root.ForEach("blocks", [&](const Tsy_JsonReader& r) {
        BlockRec b = readBlock(r, data);
        if (!blockNames.insert(b.name).second)
            r.FailAt("name", "block '" + b.name + "' is given twice");
        blocks.push_back(b);
    });
    std::vector<SignalRec> signals;
    std::set<std::string> signalNames;
    root.ForEach("signals", [&](const Tsy_JsonReader& r) {
        SignalRec s = readSignal(r);
        if (!signalNames.insert(s.name).second)
            r.FailAt("name", "signal '" + s.name + "' is given twice");
        signals.push_back(s);
    });
    for (const auto& b : blocks)
        for (const auto& p : b.pins)
            if (!p.signal.empty() && !signalNames.count(p.signal) && !data.GetNamedSignal(p.signal))
                throw Port::Exception(origin + ": " + p.path + ".signal: no signal named '" + p.signal + "'");

    for (const auto& b : blocks)
        applyBlock(data, b);
    for (const auto& s : signals)
        applySignal(data, s);
    return header;
}

} // namespace

Tsy_DesignHeader Tsy_DesignFile::Load(const std::string& path, Tsy_WizData& data)
{
    return loadDocument(Tsy_ReadJsonFile(path), path, data);
}

Tsy_DesignHeader Tsy_DesignFile::LoadText(const std::string& text, const std::string& origin, Tsy_WizData& data)
{
    return loadDocument(Tsy_ParseJson(text, origin), origin, data);
}
