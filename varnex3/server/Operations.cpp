#include "varnex3/server/Operations.h"

namespace varnex3::server {

namespace {

Access PutOf(const Member& property) { return property.type.kind == Kind::Object ? Access::PutReference : Access::Put; }

} // namespace

std::vector<Operation> OperationsOf(const ClassInfo& info)
{
    std::vector<Operation> operations;
    int dispid = 0;
    const auto add = [&](const Member& member, Access access) {
        operations.push_back({&member, access, dispid, kFirstSlot + static_cast<int>(operations.size())});
    };
    for (const Member& member : info.members) {
        ++dispid;
        add(member, member.IsProperty() ? Access::Get : Access::Call);
        if (member.IsWritable())
            add(member, PutOf(member));
    }
    return operations;
}

} // namespace varnex3::server
