// A registry in memory that counts its handles and notes what is asked of it.
#pragma once

#include <algorithm>
#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "varnex3/services/Registry.h"

namespace varnex3::tests {

// As keys and values are told apart: without regard to upper and lower case.
inline std::string Folded(std::string name)
{
    for (char& c : name)
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
    return name;
}

class MemoryRegistry final : public Registry
{
public:
    struct Value
    {
        RegistryType type;
        std::string data;
    };
    using Values = std::map<std::string, Value>;

    // As "HKLM\SOFTWARE\a", upper and lower case alike.
    std::map<std::string, Values> keys;

    std::vector<std::string> calls;
    std::set<std::string> readOnly; // keys whose values cannot be set
    bool canCreate = true;
    RegistryStatus queryFault = RegistryStatus::Done; // what each query fails with

    void Put(const std::string& key, const std::string& name, RegistryType type, const std::string& data)
    {
        keys[Folded(key)][Folded(name)] = {type, data};
    }
    void PutText(const std::string& key, const std::string& name, const std::string& text)
    {
        Put(key, name, RegistryType::Text, text + '\0');
    }
    // The value as the data are, or "none".
    std::string At(const std::string& key, const std::string& name) const
    {
        const auto values = keys.find(Folded(key));
        if (values == keys.end() || !values->second.contains(Folded(name)))
            return "none";
        return values->second.at(Folded(name)).data;
    }
    std::size_t OpenHandles() const { return open.size(); }

    RegistryStatus Open(RegistryRoot root, const std::string& path, RegistryKey& key) override
    {
        key = RegistryKey::Invalid;
        calls.push_back("open " + NameOf(root, path));
        if (!keys.contains(Folded(NameOf(root, path))))
            return RegistryStatus::NotFound;
        key = static_cast<RegistryKey>(++last);
        open[key] = Folded(NameOf(root, path));
        return RegistryStatus::Done;
    }

    RegistryStatus Create(RegistryRoot root, const std::string& path, RegistryKey& key) override
    {
        key = RegistryKey::Invalid;
        calls.push_back("create " + NameOf(root, path));
        if (!canCreate)
            return RegistryStatus::AccessDenied;
        keys[Folded(NameOf(root, path))];
        key = static_cast<RegistryKey>(++last);
        open[key] = Folded(NameOf(root, path));
        return RegistryStatus::Done;
    }

    QueriedValue Query(RegistryKey key, const std::string& name, std::span<char> buffer) override
    {
        calls.push_back("query " + name);
        const Values& values = keys.at(open.at(key));
        if (queryFault != RegistryStatus::Done)
            return {queryFault, RegistryType::Text, 0};
        if (!values.contains(Folded(name)))
            return {RegistryStatus::NotFound, RegistryType::Text, 0};
        const Value& value = values.at(Folded(name));
        const bool fits = value.data.size() <= buffer.size();
        if (fits)
            std::ranges::copy(value.data, buffer.begin());
        return {fits ? RegistryStatus::Done : RegistryStatus::MoreData, value.type, value.data.size()};
    }

    RegistryStatus Set(RegistryKey key, const std::string& name, RegistryType type, std::string_view data) override
    {
        calls.push_back("set " + name);
        if (readOnly.contains(open.at(key)))
            return RegistryStatus::AccessDenied;
        keys.at(open.at(key))[Folded(name)] = {type, std::string(data)};
        return RegistryStatus::Done;
    }

    RegistryStatus Delete(RegistryRoot root, const std::string& path) override
    {
        calls.push_back("delete " + NameOf(root, path));
        return keys.erase(Folded(NameOf(root, path))) > 0 ? RegistryStatus::Done : RegistryStatus::NotFound;
    }

    RegistryStatus Close(RegistryKey key) override
    {
        calls.push_back(key == RegistryKey::Invalid ? "close invalid" : "close");
        return open.erase(key) > 0 ? RegistryStatus::Done : RegistryStatus::InvalidHandle;
    }

private:
    static std::string NameOf(RegistryRoot root, const std::string& path)
    {
        return (root == RegistryRoot::LocalMachine ? "HKLM\\" : "HKCU\\") + path;
    }

    std::map<RegistryKey, std::string> open;
    std::uintptr_t last = 0;
};

} // namespace varnex3::tests
