// A registry that is looked at and not changed: whoever reads settings through it may migrate nothing.
#pragma once

#include "varnex3/services/Registry.h"

namespace varnex3::tool {

class ReadOnlyRegistry final : public Registry
{
public:
    explicit ReadOnlyRegistry(Registry& registry_) : registry(registry_) {}

    RegistryStatus Open(RegistryRoot root, const std::string& path, RegistryKey& key) override
    {
        return registry.Open(root, path, key);
    }

    QueriedValue Query(RegistryKey key, const std::string& name, std::span<char> buffer) override
    {
        return registry.Query(key, name, buffer);
    }

    RegistryStatus Close(RegistryKey key) override { return registry.Close(key); }

    RegistryStatus Create(RegistryRoot, const std::string&, RegistryKey& key) override
    {
        key = RegistryKey::Invalid;
        return RegistryStatus::AccessDenied;
    }

    RegistryStatus Set(RegistryKey, const std::string&, RegistryType, std::string_view) override
    {
        return RegistryStatus::AccessDenied;
    }

    RegistryStatus Delete(RegistryRoot, const std::string&) override { return RegistryStatus::AccessDenied; }

private:
    Registry& registry;
};

} // namespace varnex3::tool
