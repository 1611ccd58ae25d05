#include "varnex3/Library.h"

#include <algorithm>
#include <array>

#include "varnex3/PublicClasses.h"

namespace varnex3 {

namespace {

template <class... Class>
std::array<const ClassInfo*, sizeof...(Class)> InfosOf(ClassList<Class...>)
{
    return {&Class::Info()...};
}

std::vector<const EnumInfo*> CollectEnumerations()
{
    std::vector<const EnumInfo*> found;
    const auto take = [&](const Type& type) {
        if (type.enumeration && std::ranges::find(found, type.enumeration) == found.end())
            found.push_back(type.enumeration);
    };
    for (const ClassInfo* const info : Classes())
        for (const Member& member : info->members) {
            take(member.type);
            for (const Parameter& parameter : member.Parameters())
                take(parameter.type);
        }
    return found;
}

} // namespace

std::span<const ClassInfo* const> Classes()
{
    static const auto classes = InfosOf(PublicClasses());
    return classes;
}

const ClassInfo* FindClass(Name name)
{
    const auto classes = Classes();
    const auto found = std::ranges::find(classes, name, &ClassInfo::name);
    return found == classes.end() ? nullptr : *found;
}

const std::vector<const EnumInfo*>& Enumerations()
{
    static const std::vector<const EnumInfo*> enumerations = CollectEnumerations();
    return enumerations;
}

} // namespace varnex3
