#pragma once
// Process-wide registry of shared objects. Each kind of shared object has one
// registry, stored under a type name; a registry maps a key to the object and
// a use count, so that users of the same key share one object.

#include "port/Exception.h"

#include <cstdint>
#include <map>
#include <memory>
#include <string>

namespace Util {
namespace Details {

class SharedRegistryBase {
public:
    virtual ~SharedRegistryBase() = default;
};

class SharedResourceMgr {
public:
    // The registry stored under the type name, or null.
    static SharedRegistryBase* find(const std::string& typeName);
    // Takes ownership; a second insert under the same name is refused.
    static void insert(const std::string& typeName, std::unique_ptr<SharedRegistryBase> registry);
    // Drops every registry; for orderly shutdown and tests.
    static void clear();
};

template <class Key, class Object>
class SharedRegistry : public SharedRegistryBase {
public:
    // The object shared under the key, its use count raised; null when none.
    Object* Get(const Key& key)
    {
        auto it = entries_.find(key);
        if (it == entries_.end())
            return nullptr;
        ++it->second.uses;
        return it->second.object.get();
    }

    Object* Create(const Key& key, std::unique_ptr<Object> object)
    {
        if (entries_.count(key))
            throw IllegalMethodCalledException("Shared Object already exists. Use Get() instead of Create().");
        Object* raw = object.get();
        entries_[key] = Entry{std::move(object), 1};
        return raw;
    }

    // Lowers the use count; the object is destroyed with its last user.
    void Release(const Key& key)
    {
        auto it = entries_.find(key);
        if (it != entries_.end() && --it->second.uses == 0)
            entries_.erase(it);
    }

    uint64_t UseCount(const Key& key) const
    {
        auto it = entries_.find(key);
        return it == entries_.end() ? 0 : it->second.uses;
    }

private:
    struct Entry {
        std::unique_ptr<Object> object;
        uint64_t uses = 0;
    };
    std::map<Key, Entry> entries_;
};

// The registry of a kind, created on first use.
template <class Key, class Object>
SharedRegistry<Key, Object>& SharedRegistryFor(const std::string& typeName)
{
    auto* found = dynamic_cast<SharedRegistry<Key, Object>*>(SharedResourceMgr::find(typeName));
    if (found)
        return *found;
    auto fresh = std::make_unique<SharedRegistry<Key, Object>>();
    auto* raw = fresh.get();
    SharedResourceMgr::insert(typeName, std::move(fresh));
    return *raw;
}

} // namespace Details
} // namespace Util
