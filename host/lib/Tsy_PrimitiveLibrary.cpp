#include "lib/Tsy_PrimitiveLibrary.h"

#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_JsonReader.h"
#include "port/Exception.h"

bool Tsy_IsWizardAttributeName(const std::string& name)
{
    return name.rfind("TESY_ONLY_", 0) == 0 || name.rfind("TSY_", 0) == 0;
}

bool Tsy_AttrDef::IsHdlProperty() const
{
    return hdl && !Tsy_IsWizardAttributeName(name);
}

const Tsy_AttrDef* Tsy_PrimitiveDef::FindAttr(const std::string& name) const
{
    for (const auto& a : attributes)
        if (a.name == name)
            return &a;
    return nullptr;
}

const Tsy_PinDef* Tsy_PrimitiveDef::FindPin(const std::string& name) const
{
    for (const auto& p : pins)
        if (p.name == name)
            return &p;
    return nullptr;
}

namespace {

const char* const kHdlTypes[] = {"string", "integer", "real", "hex", "bit"};

Tsy_PinDef readPin(const Tsy_JsonReader& r)
{
    Tsy_PinDef pin;
    pin.name = r.RequiredString("name");
    pin.direction = r.RequiredString("direction");
    if (pin.direction != "IN" && pin.direction != "OUT")
        r.Fail("'direction' must be \"IN\" or \"OUT\"");
    pin.width = r.OptionalInt("width", 1);
    if (pin.width < 1 || pin.width > 64)
        r.Fail("'width' must be between 1 and 64");
    pin.startsActive = r.OptionalBool("active", false);
    return pin;
}

Tsy_AttrDef readAttr(const Tsy_JsonReader& r)
{
    Tsy_AttrDef attr;
    attr.name = r.RequiredString("name");
    attr.hdlType = r.OptionalString("type", "string");
    bool known = false;
    for (const char* t : kHdlTypes)
        known = known || attr.hdlType == t;
    if (!known)
        r.Fail("'type' must be string, integer, real, hex or bit");
    attr.defaultValue = r.OptionalString("default", "");
    attr.values = r.OptionalStringList("values");
    if (r.Has("range")) {
        std::vector<int> range = r.IntList("range");
        if (range.size() != 2 || range[0] > range[1])
            r.Fail("'range' must be [min, max] with min <= max");
        attr.values.push_back(std::to_string(range[0]) + ":" + std::to_string(range[1]));
    }
    attr.startsActive = r.OptionalBool("active", true);
    attr.onTemplate = r.OptionalBool("template", true);
    attr.hdl = r.OptionalBool("hdl", true);
    return attr;
}

Tsy_PrimitiveDef readPrimitive(const Tsy_JsonReader& r)
{
    Tsy_PrimitiveDef def;
    def.type = r.RequiredString("type");
    def.description = r.OptionalString("description", "");
    r.ForEach("pins", [&](const Tsy_JsonReader& p) {
        Tsy_PinDef pin = readPin(p);
        if (def.FindPin(pin.name))
            p.Fail("pin '" + pin.name + "' is defined twice");
        def.pins.push_back(pin);
    });
    r.ForEach("attributes", [&](const Tsy_JsonReader& a) {
        Tsy_AttrDef attr = readAttr(a);
        if (def.FindAttr(attr.name))
            a.Fail("attribute '" + attr.name + "' is defined twice");
        def.attributes.push_back(attr);
    });
    return def;
}

} // namespace

std::unique_ptr<Tsy_PrimitiveLibrary> Tsy_PrimitiveLibrary::LoadFile(const std::string& path)
{
    auto lib = std::make_unique<Tsy_PrimitiveLibrary>();
    nlohmann::ordered_json doc = Tsy_ReadJsonFile(path);
    Tsy_JsonReader root(doc, path);
    root.ForEach("primitives", [&](const Tsy_JsonReader& p) {
        Tsy_PrimitiveDef def = readPrimitive(p);
        if (lib->defs_.count(def.type))
            p.Fail("primitive '" + def.type + "' is defined twice");
        lib->defs_[def.type] = std::move(def);
    });
    return lib;
}

const Tsy_PrimitiveLibrary& Tsy_PrimitiveLibrary::Instance()
{
    static std::unique_ptr<Tsy_PrimitiveLibrary> lib = LoadFile(Tsy_DataFile("primitives.json"));
    return *lib;
}

const Tsy_PrimitiveDef* Tsy_PrimitiveLibrary::Find(const std::string& type) const
{
    auto it = defs_.find(type);
    return it == defs_.end() ? nullptr : &it->second;
}

const Tsy_PrimitiveDef* Tsy_PrimitiveLibrary::FindNoCase(const std::string& name) const
{
    for (const auto& kv : defs_)
        if (StringBase(kv.first).EqualsNoCase(name))
            return &kv.second;
    return nullptr;
}

std::vector<std::string> Tsy_PrimitiveLibrary::Types() const
{
    std::vector<std::string> out;
    for (const auto& kv : defs_)
        out.push_back(kv.first);
    return out;
}
