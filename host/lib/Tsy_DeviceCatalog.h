#pragma once
// The device catalogue: families, devices and their speed grades, read once
// from data/devices.json. A part is a device name with an optional speed
// grade after it ("t5da1-2"); a bare device name has no speed grade.

#include <memory>
#include <string>
#include <vector>

struct Tsy_FamilyInfo {
    std::string key;          // the family key, lower case ("taldor5")
    std::string name;         // shown name
    std::string prefix;       // the prefix of its device names
    std::string dcmPrimitive; // the family's DCM primitive type
    std::vector<std::string> templates;    // primitives a new design holds a template block of
    std::vector<std::string> primitives;   // primitives the family has
    std::vector<std::string> capabilities; // opaque capability keys
    std::string speedFile;                 // relative to the data directory
    std::vector<std::string> speedGrades;  // slowest first

    bool Has(const std::string& capability) const;
    bool HasPrimitive(const std::string& type) const;
};

struct Tsy_DeviceInfo {
    std::string name;
    std::string family;
    std::vector<std::string> speedGrades; // empty means the family's
    std::vector<std::string> traits;      // opaque device traits
};

struct Tsy_PartInfo {
    std::string part;
    std::string device;
    std::string speedGrade; // may be empty
    const Tsy_FamilyInfo* family = nullptr;
    const Tsy_DeviceInfo* deviceInfo = nullptr;
};

class Tsy_DeviceCatalog {
public:
    static const Tsy_DeviceCatalog& Instance();
    static std::unique_ptr<Tsy_DeviceCatalog> LoadFile(const std::string& path);

    const Tsy_FamilyInfo* FindFamily(const std::string& key) const;
    const Tsy_DeviceInfo* FindDevice(const std::string& name) const;
    // The part of that name (case ignored), or false.
    bool FindPart(const std::string& part, Tsy_PartInfo& out) const;
    // Every device with each of its speed grades, in catalogue order.
    std::vector<Tsy_PartInfo> Parts() const;
    const std::vector<Tsy_FamilyInfo>& Families() const { return families_; }
    const std::vector<std::string>& SpeedGradesOf(const Tsy_DeviceInfo& device) const;

private:
    std::vector<Tsy_FamilyInfo> families_;
    std::vector<Tsy_DeviceInfo> devices_;
};
