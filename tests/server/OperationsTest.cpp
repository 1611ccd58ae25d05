#include "varnex3/server/Operations.h"

#include <doctest/doctest.h>

#include "varnex3/varnex3.h"

using namespace varnex3;
using server::Operation;

namespace {

// The slots of a class as "slot dispid access name", one a line.
std::string Slots(const ClassInfo& info)
{
    std::string text;
    for (const Operation& operation : server::OperationsOf(info)) {
        constexpr std::array<std::string_view, 4> words{"call", "get", "put", "set"};
        text += std::to_string(operation.slot) + " " + std::to_string(operation.dispid) + " ";
        text += words[static_cast<std::size_t>(operation.access)];
        text += " " + std::string(operation.member->name) + "\n";
    }
    return text;
}

} // namespace

TEST_CASE("A class's own slots follow the seven of IDispatch; a writable property has two and one dispatch id")
{
    CHECK(Slots(VersionDef::Info())
          == "7 1 call Serialise\n"
             "8 2 call ParseXML\n"
             "9 3 get XaloVersion\n"
             "10 3 put XaloVersion\n"
             "11 4 get DLLVersion\n");
}

TEST_CASE("A record is put by reference")
{
    CHECK(Slots(RepairerOptDef::Info()).ends_with("13 5 get RepairerDetails\n14 5 set RepairerDetails\n"));
}

TEST_CASE("A record that cannot be replaced has a slot for reading alone")
{
    CHECK(Slots(RepairerDef::Info()).ends_with("13 5 get RepairerDetails\n"));
}

TEST_CASE("An indexed property has slots as any other")
{
    CHECK(Slots(InsurerDetailDef::Info())
          == "7 1 call Add\n8 2 get Values\n9 2 put Values\n10 3 get Fields\n11 4 get Count\n");
}

TEST_CASE("A class without members has no slots of its own") { CHECK(server::OperationsOf(XaloBase::Info()).empty()); }
