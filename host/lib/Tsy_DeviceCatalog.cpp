#include "lib/Tsy_DeviceCatalog.h"

#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_JsonReader.h"
#include "port/StringBase.h"

#include <algorithm>

bool Tsy_FamilyInfo::Has(const std::string& capability) const
{
    return std::find(capabilities.begin(), capabilities.end(), capability) != capabilities.end();
}

bool Tsy_FamilyInfo::HasPrimitive(const std::string& type) const
{
    return std::find(primitives.begin(), primitives.end(), type) != primitives.end();
}

namespace {

Tsy_FamilyInfo readFamily(const Tsy_JsonReader& r)
{
    Tsy_FamilyInfo f;
    f.key = r.RequiredString("key");
    f.name = r.OptionalString("name", f.key);
    f.prefix = r.RequiredString("prefix");
    f.dcmPrimitive = r.RequiredString("dcm_primitive");
    f.templates = r.OptionalStringList("templates");
    f.primitives = r.OptionalStringList("primitives");
    f.capabilities = r.OptionalStringList("capabilities");
    f.speedFile = r.RequiredString("speed_file");
    f.speedGrades = r.OptionalStringList("speed_grades");
    if (f.speedGrades.empty())
        r.Fail("a family needs at least one speed grade");
    for (const auto& t : f.templates)
        if (!f.HasPrimitive(t))
            r.Fail("template '" + t + "' is not among the family's primitives");
    return f;
}

} // namespace

std::unique_ptr<Tsy_DeviceCatalog> Tsy_DeviceCatalog::LoadFile(const std::string& path)
{
    auto cat = std::make_unique<Tsy_DeviceCatalog>();
    nlohmann::ordered_json doc = Tsy_ReadJsonFile(path);
    Tsy_JsonReader root(doc, path);
    root.ForEach("families", [&](const Tsy_JsonReader& r) {
        Tsy_FamilyInfo f = readFamily(r);
        if (cat->FindFamily(f.key))
            r.Fail("family '" + f.key + "' is defined twice");
        cat->families_.push_back(std::move(f));
    });
    root.ForEach("devices", [&](const Tsy_JsonReader& r) {
        Tsy_DeviceInfo d;
        d.name = r.RequiredString("name");
        d.family = r.RequiredString("family");
        d.speedGrades = r.OptionalStringList("speed_grades");
        d.traits = r.OptionalStringList("traits");
        const Tsy_FamilyInfo* f = cat->FindFamily(d.family);
        if (!f)
            r.Fail("unknown family '" + d.family + "'");
        if (d.name.compare(0, f->prefix.size(), f->prefix) != 0)
            r.Fail("device name must begin with the family prefix '" + f->prefix + "'");
        if (cat->FindDevice(d.name))
            r.Fail("device '" + d.name + "' is defined twice");
        cat->devices_.push_back(std::move(d));
    });
    return cat;
}

const Tsy_DeviceCatalog& Tsy_DeviceCatalog::Instance()
{
    static std::unique_ptr<Tsy_DeviceCatalog> cat = LoadFile(Tsy_DataFile("devices.json"));
    return *cat;
}

const Tsy_FamilyInfo* Tsy_DeviceCatalog::FindFamily(const std::string& key) const
{
    for (const auto& f : families_)
        if (StringBase(f.key).EqualsNoCase(key))
            return &f;
    return nullptr;
}

const Tsy_DeviceInfo* Tsy_DeviceCatalog::FindDevice(const std::string& name) const
{
    for (const auto& d : devices_)
        if (StringBase(d.name).EqualsNoCase(name))
            return &d;
    return nullptr;
}

const std::vector<std::string>& Tsy_DeviceCatalog::SpeedGradesOf(const Tsy_DeviceInfo& device) const
{
    if (!device.speedGrades.empty())
        return device.speedGrades;
    return FindFamily(device.family)->speedGrades;
}

bool Tsy_DeviceCatalog::FindPart(const std::string& part, Tsy_PartInfo& out) const
{
    for (const auto& d : devices_) {
        if (!StringBase(part).StartsWith(d.name, Port::CompareNoCase))
            continue;
        std::string grade = part.substr(d.name.size());
        const auto& grades = SpeedGradesOf(d);
        bool known = grade.empty();
        for (const auto& g : grades)
            known = known || StringBase(g).EqualsNoCase(grade);
        if (!known)
            continue;
        out.part = d.name + grade;
        out.device = d.name;
        out.speedGrade = grade;
        out.family = FindFamily(d.family);
        out.deviceInfo = &d;
        return true;
    }
    return false;
}

std::vector<Tsy_PartInfo> Tsy_DeviceCatalog::Parts() const
{
    std::vector<Tsy_PartInfo> out;
    for (const auto& d : devices_) {
        for (const auto& g : SpeedGradesOf(d)) {
            Tsy_PartInfo p;
            p.part = d.name + g;
            p.device = d.name;
            p.speedGrade = g;
            p.family = FindFamily(d.family);
            p.deviceInfo = &d;
            out.push_back(p);
        }
    }
    return out;
}
