#include "run/Tsy_WizardCatalog.h"

#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "lib/Tsy_JsonReader.h"
#include "port/StringBase.h"

std::unique_ptr<Tsy_WizardCatalog> Tsy_WizardCatalog::LoadFile(const std::string& path)
{
    auto cat = std::make_unique<Tsy_WizardCatalog>();
    auto doc = Tsy_ReadJsonFile(path);
    Tsy_JsonReader root(doc, path);
    cat->plugin_ = root.RequiredString("plugin");
    root.ForEach("wizards", [&](const Tsy_JsonReader& r) {
        Tsy_WizardInfo w;
        w.key = r.RequiredString("key");
        w.description = r.OptionalString("description", "");
        w.requires_ = r.OptionalStringList("requires");
        if (cat->Find(w.key))
            r.Fail("wizard '" + w.key + "' is listed twice");
        cat->wizards_.push_back(w);
    });
    return cat;
}

const Tsy_WizardInfo* Tsy_WizardCatalog::Find(const std::string& key) const
{
    for (const auto& w : wizards_)
        if (StringBase(w.key).EqualsNoCase(key))
            return &w;
    return nullptr;
}

std::string Tsy_WizardCatalog::MissingCapability(const Tsy_WizardInfo& wizard, const Tsy_FamilyInfo& family)
{
    for (const auto& need : wizard.requires_)
        if (!family.Has(need))
            return need;
    return std::string();
}
