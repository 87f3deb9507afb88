#pragma once
// The plug-in's manifest (data/wizards.json): its library file, and the
// wizard types it offers with a one-line description and the family
// capabilities each needs.

#include <memory>
#include <string>
#include <vector>

struct Tsy_FamilyInfo;

struct Tsy_WizardInfo {
    std::string key;
    std::string description;
    std::vector<std::string> requires_;
};

class Tsy_WizardCatalog {
public:
    static std::unique_ptr<Tsy_WizardCatalog> LoadFile(const std::string& path);

    const std::string& PluginFile() const { return plugin_; }
    const std::vector<Tsy_WizardInfo>& Wizards() const { return wizards_; }
    // The wizard of that key (case ignored), or null.
    const Tsy_WizardInfo* Find(const std::string& key) const;
    // The first capability the family lacks for the wizard, or empty.
    static std::string MissingCapability(const Tsy_WizardInfo& wizard, const Tsy_FamilyInfo& family);

private:
    std::string plugin_;
    std::vector<Tsy_WizardInfo> wizards_;
};
