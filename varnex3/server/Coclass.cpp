#include "varnex3/server/Coclass.h"

#include <algorithm>
#include <bit>

#include "varnex3/server/Guids.h"

namespace varnex3::server {

namespace {

Coclass CoclassFrom(const ClassVtable& from)
{
    const ClassInfo& info = from.info();
    return {&info, from.vtable, std::bit_cast<GUID>(ClassGuid(info.name)),
            std::bit_cast<GUID>(InterfaceGuid(info.name)), OperationsOf(info)};
}

// In the order of the addresses of the classes' tables, by which records look for them.
template <class... List>
std::vector<Coclass> Collect(Folders<List...>)
{
    std::vector<Coclass> coclasses;
    (std::ranges::transform(VtablesOf(List()), std::back_inserter(coclasses), CoclassFrom), ...);
    std::ranges::sort(coclasses, std::less<>(), &Coclass::info);
    return coclasses;
}

} // namespace

const std::vector<Coclass>& Coclasses()
{
    static const std::vector<Coclass> coclasses = Collect(ClassFolders());
    return coclasses;
}

const Coclass& CoclassOf(const Record& record)
{
    return *std::ranges::lower_bound(Coclasses(), &record.Class(), std::less<>(), &Coclass::info);
}

const Coclass* FindCoclass(REFCLSID classId)
{
    const auto found = std::ranges::find(Coclasses(), classId, &Coclass::classId);
    return found == Coclasses().end() ? nullptr : &*found;
}

} // namespace varnex3::server
