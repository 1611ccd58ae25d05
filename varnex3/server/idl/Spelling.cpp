#include "varnex3/server/idl/Spelling.h"

#include <algorithm>

namespace varnex3::server::idl {

namespace {

std::string InLowerCase(std::string name)
{
    std::ranges::transform(name, name.begin(),
                           [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; });
    return name;
}

} // namespace

void Spelling::Claim(const std::string& name, const std::string& place)
{
    const auto [entry, isNew] = claimed.try_emplace(InLowerCase(name), Claimed{name, place});
    const Claimed& first = entry->second;
    if (!isNew && first.name != name)
        clashes.push_back(first.name + " (" + first.place + ") and " + name + " (" + place + ")");
}

std::string Spelling::OfParameter(const std::string& name)
{
    return claimed.try_emplace(InLowerCase(name), Claimed{name, "a parameter"}).first->second.name;
}

void Spelling::Check() const
{
    if (clashes.empty())
        return;
    std::string message = "a type library cannot hold names that differ in the case of letters alone:";
    for (const std::string& clash : clashes)
        message += "\n    " + clash;
    throw ClashingNames(message);
}

} // namespace varnex3::server::idl
