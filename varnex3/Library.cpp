#include "varnex3/Library.h"

#include <algorithm>

#include "varnex3/varnex3.h"

namespace varnex3 {

namespace {

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
    static const ClassInfo* const classes[] = {
        &modGeneral::Info(),
        &modFunctions::Info(),
        // envelope
        &VersionDef::Info(),
        &SourceDef::Info(),
        &DestinationDef::Info(),
        &XaloBase::Info(),
        // parties
        &InsurerDetailDef::Info(),
        &RepairerDef::Info(),
        &RepairerOptDef::Info(),
        &InsurerDef::Info(),
        &InsurerOptDef::Info(),
        // claim, vehicle and customer
        &ClaimHeaderDef::Info(),
        &VehicleDef::Info(),
        &CustomerDef::Info(),
        &PersonalNameDef::Info(),
        // inbox
        &MessageDef::Info(),
        &Xalo_Messages::Info(),
    };
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
