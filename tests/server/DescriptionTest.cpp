// What is told of the component: by the rows, as IDL, as a listing and as a manifest.
#include <algorithm>

#include <doctest/doctest.h>

#include "varnex3/server/idl/Describe.h"
#include "varnex3/server/idl/Idl.h"
#include "varnex3/server/idl/Listing.h"
#include "varnex3/server/idl/Manifest.h"
#include "varnex3/server/idl/Spelling.h"
#include "varnex3/varnex3.h"

using namespace varnex3;
using namespace varnex3::server::idl;

namespace {

// A class of one method.
struct Toy
{
    Member member;
    ClassInfo info;

    Toy(Name className, Name method, const Parameter& parameter = {})
    {
        member.name = method;
        member.parameterSlots[0] = parameter;
        member.parameterCount = parameter.name.empty() ? 0 : 1;
        info = {className, "A toy.", {&member, 1}, &rows::Create<XaloBase>};
    }
};

Library Described(std::vector<const ClassInfo*> classes, std::vector<const EnumInfo*> enumerations = {})
{
    return Describe(classes, enumerations);
}

std::string Clash(std::vector<const ClassInfo*> classes, std::vector<const EnumInfo*> enumerations = {})
{
    try {
        Described(std::move(classes), std::move(enumerations));
        return "none";
    } catch (const ClashingNames& clash) {
        const std::string_view words = clash.what();
        return std::string(words.substr(words.find('\n') + 5));
    }
}

bool Has(const std::string& text, std::string_view part) { return text.find(part) != std::string::npos; }

// The line of a text that has a word in it, and what follows it, without the blanks in front.
std::string LineWith(const std::string& text, std::string_view word)
{
    const std::size_t at = text.find(word);
    const std::size_t start = text.rfind('\n', at) + 1;
    return text.substr(text.find_first_not_of(' ', start), text.find('\n', at) - text.find_first_not_of(' ', start));
}

} // namespace

TEST_CASE("Names of members that differ in the case of letters alone are refused, and told")
{
    const Toy a("ADef", "Count");
    const Toy b("BDef", "COUNT");
    CHECK(Clash({&a.info, &b.info}) == "Count (ADef.Count) and COUNT (BDef.COUNT)");
    CHECK(Clash({&a.info, &a.info}) == "none");
}

TEST_CASE("Names of classes, enumerations and constants are compared with all the others")
{
    const Enumerator constants[] = {{"badef", 0, "A constant."}};
    const EnumInfo enumeration{"KindEnum", "A kind.", constants};
    const Toy a("BaDef", "Count");
    const Toy b("BaDef", "kindenum");
    CHECK(Clash({&a.info}, {&enumeration}) == "badef (a constant of KindEnum) and BaDef (a class)");
    CHECK(Has(Clash({&b.info}, {&enumeration}), "KindEnum (an enumeration) and kindenum (BaDef.kindenum)"));
}

TEST_CASE("Every clash is told, not the first alone")
{
    const Toy a("ADef", "Count");
    const Toy b("aDEF", "COUNT");
    CHECK(Clash({&a.info, &b.info})
          == "ADef (a class) and aDEF (a class)\n    _ADef (an interface) and _aDEF (an interface)\n"
             "    Count (ADef.Count) and COUNT (aDEF.COUNT)");
}

TEST_CASE("A parameter takes the spelling of the public name that it differs from in the case of letters alone")
{
    const Toy a("ADef", "Find", {"count", TypeOf<Text>::type, false, false, false, {}});
    const Toy b("BDef", "Count");
    CHECK(Described({&a.info, &b.info}).classes[0].slots[0].arguments[0].name == "Count");
    CHECK(Described({&a.info}).classes[0].slots[0].arguments[0].name == "count");
}

TEST_CASE("The names that IDL adds clash with none of the library's")
{
    const std::string idl = ToIdl(Describe());
    Spelling spelling;
    spelling.Claim("newValue", "IDL");
    spelling.Claim("pResult", "IDL");
    for (const Class& described : Describe().classes)
        for (const Slot& slot : described.slots)
            spelling.Claim(slot.name, described.name);
    CHECK_NOTHROW(spelling.Check());
    CHECK(Has(idl, "* pResult)"));
    CHECK(Has(idl, " newValue)"));
}

TEST_CASE("Every class is described, and every enumeration; a module is not")
{
    const Library library = Describe();
    const auto isModule = [](const ClassInfo* info) { return info->IsModule(); };
    const auto modules = std::ranges::count_if(Classes(), isModule);
    CHECK(modules > 0);
    CHECK(library.classes.size() + static_cast<std::size_t>(modules) == Classes().size());
    CHECK(library.enumerations.size() == Enumerations().size());
}

TEST_CASE("IDL: a property is read by propget and stored by propput, a record by propputref")
{
    const std::string idl = ToIdl(Describe());
    CHECK(Has(idl, "[id(3), propget, helpstring(\"Version of the message language, such as 1.6.\")]\n"
                   "        HRESULT XaloVersion([out, retval] BSTR* pResult);\n"
                   "        [id(3), propput, helpstring(\"Version of the message language, such as 1.6.\")]\n"
                   "        HRESULT XaloVersion([in] BSTR newValue);\n"));
    CHECK(Has(idl, "HRESULT RepairerDetails([in] _InsurerDetailDef* newValue);\n"));
    CHECK(Has(idl, "[id(5), propputref, helpstring("));
}

TEST_CASE("IDL: an index comes before what is stored and what is given")
{
    const std::string idl = ToIdl(Describe());
    CHECK(Has(idl, "HRESULT Values([in] VARIANT Index, [out, retval] BSTR* pResult);\n"));
    CHECK(Has(idl, "HRESULT Values([in] VARIANT Index, [in] BSTR newValue);\n"));
}

TEST_CASE("IDL: an omitted variable of a number is 0, one of a text has no default")
{
    CHECK(LineWith(ToIdl(Describe()), "HRESULT ParseFiles")
          == "HRESULT ParseFiles([in] BSTR sFolderPath, [in, out, optional, defaultvalue(0)] long* ErrorNo, "
             "[in, out, optional] BSTR* ErrorMessage, [out, retval] VARIANT_BOOL* pResult);");
}

TEST_CASE("IDL: the default of a text, and what help says, are quoted")
{
    Toy toy("ADef", "CSV", {"sDelimiter", TypeOf<Text>::type, false, false, true, ","});
    toy.member.doc = "Says \"no\\yes\".";
    const std::string idl = ToIdl(Described({&toy.info}));
    CHECK(Has(idl, "HRESULT CSV([in, optional, defaultvalue(\",\")] BSTR sDelimiter);\n"));
    CHECK(Has(idl, "helpstring(\"Says \\\"no\\\\yes\\\".\")"));
}

TEST_CASE("IDL: what is passed by reference is a pointer, changed or not")
{
    Toy toy("ADef", "Find", {"sKey", TypeOf<Text>::type, true, false, false, {}});
    CHECK(Has(ToIdl(Described({&toy.info})), "HRESULT Find([in, out] BSTR* sKey);\n"));
}

TEST_CASE("IDL for the header: a class is its identifier; one that is called as a constant is still told from it")
{
    const std::string idl = ToHeaderIdl(Describe());
    CHECK_FALSE(Has(idl, "coclass"));
    CHECK(Has(idl,
              "cpp_quote(\"DEFINE_GUID(CLSID_VersionDef, 0x6CD4640B, 0xE818, 0x5F00, 0xAA, 0xFD, 0x60, 0xAF, 0xBD, "
              "0xC6, 0xEB, 0xB8);\")"));
    CHECK(Has(idl, "cpp_quote(\"__CRT_UUID_DECL(class VersionDef, 0x6CD4640B, "));
    CHECK(Has(idl, "cpp_quote(\"class DECLSPEC_UUID(\\\"6CD4640B-E818-5F00-AAFD-60AFBDC6EBB8\\\") VersionDef;\")"));
}

TEST_CASE("IDL: the predeclared class is the application object, and no other")
{
    const std::string idl = ToIdl(Describe());
    const std::size_t at = idl.find(", appobject, helpstring(");
    REQUIRE(at != std::string::npos);
    CHECK(idl.find("appobject", at + 12) == std::string::npos);
    CHECK(LineWith(idl.substr(at), "coclass") == "coclass VarnexReferenceDataEnum");
}

TEST_CASE("Listing: a line has slot, dispatch id, access and signature")
{
    const std::string listing = ToListing(Describe());
    CHECK(LineWith(listing, "get    DLLVersion") == "11    4  get    DLLVersion: text");
    CHECK(LineWith(listing, "ParseFiles")
          == "7    1  method ParseFiles(sFolderPath: text, [inout ErrorNo: int32 = 0], [inout ErrorMessage: text]): "
             "Boolean");
    CHECK(LineWith(listing, "putref RepairerDetails") == "14    5  putref RepairerDetails: InsurerDetailDef");
    CHECK(LineWith(listing, "Company") == "1  Company");
}

TEST_CASE("Help strings: every class, member and enumeration has one")
{
    const std::string words = ToHelpStrings(Describe());
    CHECK(LineWith(words, "VersionDef.XaloVersion")
          == "VersionDef.XaloVersion: Version of the message language, such as 1.6.");
    CHECK_FALSE(Has(words, ": \n"));
}

TEST_CASE("Manifest: a class under both its names, an interface, the type library, the architecture")
{
    const std::string manifest = ToManifest(Describe(), "amd64", "3.0.0.0");
    CHECK(Has(manifest, " processorArchitecture=\"amd64\"/>"));
    CHECK(Has(manifest, " progid=\"Varnex3.VersionDef\" threadingModel=\"Apartment\""));
    CHECK(Has(manifest, "<progid>Varnex3.VersionDef.3</progid>"));
    CHECK(Has(manifest, "<comInterfaceExternalProxyStub name=\"_VersionDef\""));
    CHECK(Has(manifest, "<typelib tlbid=\"{" + Describe().guid + "}\" version=\"3.0\""));
}
