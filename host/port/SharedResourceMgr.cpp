#include "port/SharedResourceMgr.h"

namespace Util {
namespace Details {

namespace {
std::map<std::string, std::unique_ptr<SharedRegistryBase>>& registries()
{
    static std::map<std::string, std::unique_ptr<SharedRegistryBase>> all;
    return all;
}
} // namespace

SharedRegistryBase* SharedResourceMgr::find(const std::string& typeName)
{
    auto it = registries().find(typeName);
    return it == registries().end() ? nullptr : it->second.get();
}

void SharedResourceMgr::insert(const std::string& typeName, std::unique_ptr<SharedRegistryBase> registry)
{
    if (registries().count(typeName))
        throw IllegalMethodCalledException("Shared Object already exists. Use Get() instead of Create().");
    registries()[typeName] = std::move(registry);
}

void SharedResourceMgr::clear()
{
    registries().clear();
}

} // namespace Details
} // namespace Util
