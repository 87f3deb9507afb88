#pragma once
// Loads the wizard plug-in at run time. The plug-in exports one factory,
// "pendra_create_wizard", which builds its wizard for a keyword, or returns
// null for a keyword it cannot build.

#include "port/StringBase.h"

#include <memory>
#include <string>

class Tsy_WizMain;

class Tsy_PluginLoader {
public:
    using Factory = Tsy_WizMain* (*)(const char* keyword, bool batch);
    static constexpr const char* kFactorySymbol = "pendra_create_wizard";

    // Finds the plug-in file by name: $PENDRA_PLUGIN_DIR, then beside the
    // program, then lib/pendra beside it, then the build tree.
    static std::string Locate(const std::string& fileName);

    // The process's one loader of the plug-in of that file name, loaded on
    // first use; null with the reason when it cannot be found or loaded.
    static const Tsy_PluginLoader* Shared(const std::string& fileName, std::string& error);

    // False with the reason when the library or its factory cannot be loaded.
    bool Load(const std::string& path, std::string& error);
    std::unique_ptr<Tsy_WizMain> Create(const StringBase& keyword, bool batch) const;
    bool IsLoaded() const { return factory_ != nullptr; }

private:
    Factory factory_ = nullptr;
};
