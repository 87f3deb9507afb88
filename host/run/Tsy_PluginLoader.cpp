#include "run/Tsy_PluginLoader.h"

#include "lib/Tsy_DataDir.h"
#include "wiz/Tsy_WizMain.h"

#include <cstdlib>
#include <dlfcn.h>
#include <unistd.h>

namespace {

bool readable(const std::string& path)
{
    return ::access(path.c_str(), R_OK) == 0;
}

} // namespace

std::string Tsy_PluginLoader::Locate(const std::string& fileName)
{
    std::string candidates[4];
    int n = 0;
    if (const char* env = std::getenv("PENDRA_PLUGIN_DIR"); env && *env)
        candidates[n++] = std::string(env) + "/" + fileName;
    std::string exe = Tsy_ExecutableDir();
    if (exe.empty())
        exe = ".";
    candidates[n++] = exe + "/" + fileName;
    candidates[n++] = exe + "/../lib/pendra/" + fileName;
#ifdef PENDRA_PLUGIN_BUILD_DIR
    candidates[n++] = std::string(PENDRA_PLUGIN_BUILD_DIR) + "/" + fileName;
#endif
    for (int i = 0; i < n; ++i)
        if (readable(candidates[i]))
            return candidates[i];
    return std::string();
}

const Tsy_PluginLoader* Tsy_PluginLoader::Shared(const std::string& fileName, std::string& error)
{
    static Tsy_PluginLoader loader;
    if (loader.IsLoaded())
        return &loader;
    std::string path = Locate(fileName);
    if (path.empty()) {
        error = fileName + ": wizard plug-in not found";
        return nullptr;
    }
    return loader.Load(path, error) ? &loader : nullptr;
}

bool Tsy_PluginLoader::Load(const std::string& path, std::string& error)
{
    // The library stays loaded for the life of the process: wizards and the
    // pictures they registered point into it.
    void* handle = ::dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle) {
        const char* why = ::dlerror();
        error = why ? why : (path + ": cannot be loaded");
        return false;
    }
    factory_ = reinterpret_cast<Factory>(::dlsym(handle, kFactorySymbol));
    if (!factory_) {
        error = path + ": not a wizard plug-in (no " + kFactorySymbol + ")";
        return false;
    }
    return true;
}

std::unique_ptr<Tsy_WizMain> Tsy_PluginLoader::Create(const StringBase& keyword, bool batch) const
{
    if (!factory_)
        return nullptr;
    return std::unique_ptr<Tsy_WizMain>(factory_(keyword.c_str(), batch));
}
