#include "varnex3/core/Interface.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>

#include "tests/Printing.h"
#include "varnex3/varnex3.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

Variant T(TextView text) { return Text(text); }

// What a host stores in a property of this type to see it again, and what it then sees.
struct Probe
{
    Variant stored;
    Variant seen;
};

Probe ProbeFor(const Type& type)
{
    switch (type.kind) {
    case Kind::Text:
        return {T(u"12"), T(u"12")};
    case Kind::Double:
        return {T(u"1.5"), 1.5};
    case Kind::Date:
        return {T(u"2004-03-15"), Date{38061}};
    case Kind::Int16:
        return {T(u"7"), std::int16_t{7}};
    case Kind::Boolean:
        return {T(u"True"), true};
    case Kind::Object: {
        const Ref<Record> record = FindClass(type.name)->create();
        return {record, record};
    }
    default:
        return {T(u"7"), std::int32_t{7}};
    }
}

// The name behind a macro, when the line begins with it: VARNEX_RECORD(VersionDef, "...") names VersionDef.
std::string NameBehind(std::string_view macro, std::string_view line)
{
    line.remove_prefix(std::min(line.find_first_not_of(' '), line.size()));
    return line.starts_with(macro) ? std::string(line.substr(macro.size(), line.find(',') - macro.size())) : "";
}

// Every class and module that a public header declares.
std::set<std::string> DeclaredClasses()
{
    std::set<std::string> names;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(VARNEX3_SOURCE_DIR "/varnex3")) {
        if (entry.path().extension() != ".h")
            continue;
        std::ifstream file(entry.path());
        for (std::string line; std::getline(file, line);)
            for (const std::string_view macro : {"VARNEX_RECORD(", "VARNEX_MODULE("})
                names.insert(NameBehind(macro, line));
    }
    names.erase("");
    return names;
}

// Whether a property follows from another one, and takes only the values that the other one can say.
bool IsDerived(Name property)
{
    return property == "MessageDescription" || property == "StatusType" || property == "QuoteTypeID";
}

} // namespace

TEST_CASE("Classes: every class and module that a header declares is listed, and once")
{
    const std::set<std::string> declared = DeclaredClasses();
    CHECK(declared.size() >= 17);
    std::set<std::string> listed;
    for (const ClassInfo* const info : Classes())
        CHECK(listed.insert(std::string(info->name)).second);
    CHECK(listed == declared);
}

TEST_CASE("FindClass: letter case counts; an unknown name is no class")
{
    CHECK(FindClass("VehicleDef")->name == "VehicleDef");
    CHECK(FindClass("vehicledef") == nullptr);
    CHECK(FindClass("") == nullptr);
}

TEST_CASE("Every class says what it is, and every member, in a sentence that ends")
{
    for (const ClassInfo* const info : Classes()) {
        CAPTURE(std::string(info->name));
        CHECK(info->doc.ends_with('.'));
        for (const Member& member : info->members) {
            CAPTURE(std::string(member.name));
            CHECK(member.doc.ends_with('.'));
            for (const Parameter& parameter : member.Parameters())
                CHECK_FALSE(parameter.name.empty());
        }
    }
}

TEST_CASE("Every class is made new, by its own name, and separately")
{
    for (const ClassInfo* const info : Classes()) {
        CHECK(info->IsModule() == (info->create == nullptr));
        if (info->IsModule())
            continue;
        const Ref<Record> record = info->create();
        CHECK(record->Class().name == info->name);
        CHECK_FALSE(record == info->create());
    }
}

TEST_CASE("One class is predeclared; modules and the others are not")
{
    for (const ClassInfo* const info : Classes())
        CHECK(info->isPredeclared == (info->name == "VarnexReferenceDataEnum"));
}

TEST_CASE("Every class but the lists and the summary has Serialise and ParseXML first; two have a property before them")
{
    for (const ClassInfo* const info : Classes()) {
        if (!FindMember(*info, "Serialise"))
            continue;
        CAPTURE(std::string(info->name));
        const bool hasPropertyBefore = info->name == "PaymentDetailsDef" || info->name == "ErrorDetailsItem";
        const std::size_t first = hasPropertyBefore ? 1 : 0;
        CHECK(info->members[first].name == "Serialise");
        CHECK((!FindMember(*info, "ParseXML") || info->members[first + 1].name == "ParseXML"));
    }
}

TEST_CASE("Every property that a host can store gives back what was stored, converted to its type")
{
    for (const ClassInfo* const info : Classes())
        for (const Member& member : info->members) {
            if (!member.IsProperty() || member.IsIndexed() || !member.IsWritable() || IsDerived(member.name))
                continue;
            CAPTURE(std::string(info->name) + "." + std::string(member.name));
            const Ref<Record> record = info->create();
            const auto [stored, seen] = ProbeFor(member.type);
            Put(*record, member.name, stored);
            CHECK(Get(*record, member.name) == seen);
        }
}

TEST_CASE("Every property that holds a record is never nothing, and takes no record of another class")
{
    int count = 0;
    for (const ClassInfo* const info : Classes())
        for (const Member& member : info->members) {
            if (!member.IsProperty() || member.IsIndexed() || member.type.kind != Kind::Object)
                continue;
            ++count;
            CAPTURE(std::string(info->name) + "." + std::string(member.name));
            const Ref<Record> record = info->create();
            const auto child = std::get<Ref<Record>>(Get(*record, member.name));
            REQUIRE(static_cast<bool>(child));
            CHECK(child->Class().name == member.type.name);
            if (!member.IsWritable())
                continue;
            const std::string source = std::string(info->name) + "." + std::string(member.name);
            CHECK(RaisedBy([&] { Put(*record, member.name, Ref<Record>(New<XaloBase>())); }) == "13 " + source);
            Put(*record, member.name, Ref<Record>());
            const auto again = std::get<Ref<Record>>(Get(*record, member.name));
            CHECK(static_cast<bool>(again));
            CHECK_FALSE(again == child);
        }
    CHECK(count >= 5);
}

TEST_CASE("Every property that a host cannot store says so")
{
    for (const ClassInfo* const info : Classes())
        for (const Member& member : info->members) {
            if (!member.IsProperty() || member.IsIndexed() || member.IsWritable())
                continue;
            const std::string source = std::string(info->name) + "." + std::string(member.name);
            CHECK(RaisedBy([&] { Put(*info->create(), member.name, T(u"1")); }) == "383 " + source);
        }
}

TEST_CASE("An unknown member is 438, and so is a method read as a property or a property called")
{
    const auto version = New<VersionDef>();
    CHECK(RaisedBy([&] { Get(*version, "Version"); }) == "438 VersionDef.Version");
    CHECK(RaisedBy([&] { Get(*version, "xaloversion"); }) == "438 VersionDef.xaloversion");
    CHECK(RaisedBy([&] { Put(*version, "Version", Empty); }) == "438 VersionDef.Version");
    CHECK(RaisedBy([&] { Get(*version, "Serialise"); }) == "438 VersionDef.Serialise");
    CHECK(RaisedBy([&] { Call(*version, "XaloVersion"); }) == "438 VersionDef.XaloVersion");
    CHECK(RaisedBy([&] { Call(modFunctions::Info(), nullptr, "Escape"); }) == "438 modFunctions.Escape");
}

TEST_CASE("A missing argument is 449, one too many 450")
{
    const auto version = New<VersionDef>();
    Variant two[] = {T(u"<"), T(u"<")};
    CHECK(RaisedBy([&] { Call(*version, "ParseXML"); }) == "449 VersionDef.ParseXML");
    CHECK(RaisedBy([&] { Call(*version, "ParseXML", two); }) == "450 VersionDef.ParseXML");
    CHECK(RaisedBy([&] { Get(*version, "XaloVersion", two); }) == "450 VersionDef.XaloVersion");
    CHECK(RaisedBy([&] { Get(*New<InsurerDetailDef>(), "Values"); }) == "449 InsurerDetailDef.Values");
    CHECK(RaisedBy([&] { Call(*New<Xalo_Messages>(), "ParseFiles"); }) == "449 Xalo_Messages.ParseFiles");
}

TEST_CASE("Arguments are converted to the type of their parameter")
{
    Variant arguments[] = {T(u"2004-03-15"), T(u"3")};
    CHECK(std::get<Text>(Call(modFunctions::Info(), nullptr, "FormatDate", arguments)) == u"15/03/2004");
    Variant wrong[] = {T(u"2004-03-15"), T(u"three")};
    CHECK(RaisedBy([&] { Call(modFunctions::Info(), nullptr, "FormatDate", wrong); }) == "13 modFunctions.FormatDate");
    Variant number[] = {1.5};
    CHECK(std::get<Text>(Call(modFunctions::Info(), nullptr, "EscapeXML", number)) == u"1.5");
}

TEST_CASE("Arguments by reference come back, the others stay as they were")
{
    Variant arguments[] = {T(u"2004-03-15T14:05:09+10:00"), Empty, Empty, T(u"before")};
    CHECK(std::get<bool>(Call(modFunctions::Info(), nullptr, "SplitDateTime", arguments)) == false);
    CHECK(std::get<Text>(arguments[0]) == u"2004-03-15T14:05:09+10:00");
    CHECK(std::get<Text>(arguments[1]) == u"2004-03-15");
    CHECK(std::get<Text>(arguments[2]) == u"14:05:09");
    CHECK(std::get<Text>(arguments[3]) == u"10:00");
}

TEST_CASE("After an error every argument is as it was")
{
    Variant arguments[] = {T(u"2004+03-15T14:05:09"), T(u"a"), T(u"b"), T(u"c")};
    CHECK(RaisedBy([&] { Call(modFunctions::Info(), nullptr, "SplitDateTime", arguments); })
          == "5 modFunctions.SplitDateTime");
    CHECK(std::get<Text>(arguments[0]) == u"2004+03-15T14:05:09");
    CHECK(std::get<Text>(arguments[1]) == u"a");
    CHECK(std::get<Text>(arguments[3]) == u"c");
}

TEST_CASE("A parameter that is passed by reference and not changed is no output")
{
    const Member& parse = *FindMember(MessageDef::Info(), "ParseXML");
    CHECK(parse.Parameters()[2].isByReference);
    CHECK_FALSE(parse.Parameters()[2].isOutput);
    CHECK_FALSE(parse.Parameters()[1].isByReference);
}

TEST_CASE("Optional arguments may be left off the end, and come back when given")
{
    const auto messages = New<Xalo_Messages>();
    Variant arguments[] = {T(u"/no such folder"), Empty, Empty};
    CHECK_FALSE(std::get<bool>(Call(*messages, "ParseFiles", {arguments, 1})));
    CHECK(IsEmpty(arguments[1]));
    CHECK_FALSE(std::get<bool>(Call(*messages, "ParseFiles", arguments)));
    CHECK(std::get<std::int32_t>(arguments[1]) == 30030);
    CHECK(std::get<Text>(arguments[2]) == u"Folder '/no such folder' does not exist.");
}

TEST_CASE("The source of an error is the class and operation that raised it, whoever was called")
{
    const auto repairer = New<RepairerDef>();
    repairer->RepairerDetails()->Add(u"a", u"");
    Variant text[] = {T(u"<Repairer><RepairerID/><RepairerName/><RepairerDetails FieldName='a'/></Repairer>")};
    CHECK(RaisedBy([&] { Call(*repairer, "ParseXML", text); }) == "457 InsurerDetailDef.Add");
}

TEST_CASE("Error: what() says it all in one line")
{
    const Error error(ErrorNumber::TypeMismatch, u"SourceDef.ParseXML", u"TimeStamp: 'soon' is not a date");
    CHECK(std::string(error.what()) == "SourceDef.ParseXML: TimeStamp: 'soon' is not a date (13)");
}

TEST_CASE("CurrentError: what is not of the library becomes it")
{
    const auto numberOf = [](const auto& thrown) {
        try {
            throw thrown;
        } catch (...) {
            return CurrentError("A.B").Number();
        }
    };
    CHECK(numberOf(std::bad_alloc()) == 7);
    CHECK(numberOf(std::length_error("x")) == 7);
    CHECK(numberOf(std::runtime_error("x")) == 51);
    CHECK(numberOf(5) == 51);
    CHECK(numberOf(std::system_error(ENOENT, std::generic_category())) == 53);
    CHECK(numberOf(std::system_error(EACCES, std::generic_category())) == 70);
    CHECK(numberOf(Error(ErrorNumber::DuplicateKey, u"C.D", u"x")) == 457);
}

TEST_CASE("Enumerations: each once, with the values that hosts compile in")
{
    std::set<std::string> names;
    for (const EnumInfo* const info : Enumerations())
        CHECK(names.insert(std::string(info->name)).second);
    CHECK(names.contains("CustomerTypeEnum"));
    CHECK(names.contains("XaloMessageTypeEnum"));
    CHECK(static_cast<int>(CustomerTypeEnum::Personal) == 0);
    CHECK(static_cast<int>(CustomerTypeEnum::Company) == 1);
    const EnumInfo& types = EnumerationOf(XaloMessageTypeEnum{});
    CHECK(types.values.size() == 17);
    CHECK(types.values[3].name == "Xalo_DeclinedRepair");
    for (std::int32_t i = 0; i < 17; ++i)
        CHECK(types.values[static_cast<std::size_t>(i)].value == i);
}

TEST_CASE("Declarations: names, defaults and nothing else are taken from a parameter list")
{
    constexpr auto declared = Declarations("(const Text& sList, const Text& sDelimiter = u\",\", Text* Out = nullptr)");
    CHECK(declared[0].name == "sList");
    CHECK_FALSE(declared[0].isOptional);
    CHECK(declared[1].name == "sDelimiter");
    CHECK(declared[1].isOptional);
    CHECK(declared[1].initial == ",");
    CHECK(declared[2].name == "Out");
    CHECK(declared[2].isOptional);
    CHECK(declared[2].initial == "");
    CHECK(Declarations("()")[0].name == "");
}

TEST_CASE("VersionDef: DLLVersion is the library's major and minor number")
{
    std::ifstream file(VARNEX3_SOURCE_DIR "/CMakeLists.txt");
    const std::string text(std::istreambuf_iterator<char>(file), {});
    const std::size_t at = text.find("    VERSION ") + 12;
    const std::string version = text.substr(at, text.find('\n', at) - at); // such as 3.0.0
    CHECK(ToUtf8(New<VersionDef>()->DLLVersion()) == version.substr(0, version.rfind('.')));
}

TEST_CASE("Indent: up to 32767 TABs")
{
    CHECK(Indent(32767) == Text(32767, u'\t'));
    CHECK(RaisedBy([] { Indent(32768); }) == "6 modGeneral.Indent");
}
