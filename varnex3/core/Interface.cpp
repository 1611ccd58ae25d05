#include "varnex3/core/Interface.h"

#include <algorithm>
#include <string>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"

namespace varnex3 {

namespace {

std::string FullName(const ClassInfo& info, Name member) { return std::string(info.name) + "." + std::string(member); }

const Member& RequiredMember(const ClassInfo& info, Name name, MemberKind kind)
{
    const Member* const member = FindMember(info, name);
    if (member && member->kind == kind)
        return *member;
    Raise(ErrorNumber::NoSuchMember, FullName(info, name),
          ToText(info.name) + (kind == MemberKind::Property ? u" has no property " : u" has no method ")
              + Quoted(ToText(name)));
}

// All arguments of a call: those given, and for those omitted what their declaration says.
class WholeArguments
{
public:
    WholeArguments(const ClassInfo& info, const Member& member, Arguments given_) : given(given_)
    {
        const auto parameters = member.Parameters();
        if (given.size() > parameters.size())
            Raise(ErrorNumber::WrongArgumentCount, FullName(info, member.name),
                  u"too many arguments: " + ToText(Variant(static_cast<std::int32_t>(given.size()))) + u" given, "
                      + ToText(Variant(static_cast<std::int32_t>(parameters.size()))) + u" wanted");
        for (std::size_t i = given.size(); i < parameters.size(); ++i) {
            if (!parameters[i].isOptional)
                Raise(ErrorNumber::ArgumentMissing, FullName(info, member.name),
                      u"the argument " + ToText(parameters[i].name) + u" is missing");
            if (!parameters[i].initial.empty())
                whole[i] = ToText(parameters[i].initial);
        }
        std::ranges::move(given, whole.begin());
        count = parameters.size();
    }
    ~WholeArguments() { std::ranges::move(std::span(whole).first(given.size()), given.begin()); }
    WholeArguments(const WholeArguments&) = delete;
    WholeArguments& operator=(const WholeArguments&) = delete;

    operator Arguments() { return std::span(whole).first(count); }

private:
    Arguments given;
    std::array<Variant, Member::kMaxParameters> whole;
    std::size_t count = 0;
};

template <class Action>
auto Named(const ClassInfo& info, const Member& member, Action action)
{
    try {
        return action();
    } catch (const Error& error) {
        throw error.About(FullName(info, member.name), {});
    }
}

} // namespace

Name NameOf(Kind kind)
{
    constexpr Name names[] = {"nothing",        "text",    "double",      "date",   "16-bit integer",
                              "32-bit integer", "Boolean", "enumeration", "object", "variant"};
    return names[static_cast<std::size_t>(kind)];
}

const Member* FindMember(const ClassInfo& info, Name name)
{
    const auto member = std::ranges::find(info.members, name, &Member::name);
    return member == info.members.end() ? nullptr : &*member;
}

Variant Get(Record& record, Name property, Arguments arguments)
{
    const ClassInfo& info = record.Class();
    const Member& member = RequiredMember(info, property, MemberKind::Property);
    WholeArguments whole(info, member, arguments);
    return Named(info, member, [&] { return member.get(&record, whole); });
}

void Put(Record& record, Name property, const Variant& value, Arguments arguments)
{
    const ClassInfo& info = record.Class();
    const Member& member = RequiredMember(info, property, MemberKind::Property);
    if (!member.IsWritable())
        Raise(ErrorNumber::ReadOnlyProperty, FullName(info, property), ToText(property) + u" is read-only");
    WholeArguments whole(info, member, arguments);
    Named(info, member, [&] { member.put(&record, whole, value); });
}

Variant Call(const ClassInfo& info, Record* record, Name method, Arguments arguments)
{
    const Member& member = RequiredMember(info, method, MemberKind::Method);
    WholeArguments whole(info, member, arguments);
    return Named(info, member, [&] { return member.get(record, whole); });
}

} // namespace varnex3
