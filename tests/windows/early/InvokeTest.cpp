#include "tests/windows/Printing.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

// The ids of a member and of its parameters.
std::vector<DISPID> IdsOf(IDispatch* object, std::vector<const wchar_t*> names, HRESULT expected = S_OK)
{
    std::vector<LPOLESTR> mutableNames;
    for (const wchar_t* name : names)
        mutableNames.push_back(const_cast<LPOLESTR>(name));
    std::vector<DISPID> ids(names.size(), 12345);
    CHECK(object->GetIDsOfNames(IID_NULL, mutableNames.data(), static_cast<UINT>(names.size()), 0, ids.data())
          == expected);
    return ids;
}

// Invoke as it is, with arguments in the order that automation has them: the last one first, named ones before others.
HRESULT RawInvoke(IDispatch* object, DISPID id, int flags, std::vector<Value>& arguments,
                  std::vector<DISPID> named = {}, VARIANT* result = nullptr)
{
    DISPPARAMS parameters{arguments.data(), named.data(), static_cast<UINT>(arguments.size()),
                          static_cast<UINT>(named.size())};
    EXCEPINFO exception{};
    UINT argument = 0;
    const HRESULT status =
        object->Invoke(id, IID_NULL, 0, static_cast<WORD>(flags), &parameters, result, &exception, &argument);
    SysFreeString(exception.bstrSource);
    SysFreeString(exception.bstrDescription);
    return status;
}

} // namespace

TEST_CASE("Names are found in any letter case, those of parameters too")
{
    const Apartment apartment;
    const auto list = NewList();
    CHECK(IdsOf(list.get(), {L"parsefiles", L"SFOLDERPATH", L"errorno", L"ErrorMessage"})
          == std::vector<DISPID>{1, 0, 1, 2});
    CHECK(IdsOf(list.get(), {L"COUNT"}) == std::vector<DISPID>{5});
}

TEST_CASE("A name that does not exist is DISPID_UNKNOWN, among others that do")
{
    const Apartment apartment;
    const auto list = NewList();
    CHECK(IdsOf(list.get(), {L"NoSuch"}, DISP_E_UNKNOWNNAME) == std::vector<DISPID>{DISPID_UNKNOWN});
    CHECK(IdsOf(list.get(), {L"Count "}, DISP_E_UNKNOWNNAME) == std::vector<DISPID>{DISPID_UNKNOWN});
    CHECK(IdsOf(list.get(), {L""}, DISP_E_UNKNOWNNAME) == std::vector<DISPID>{DISPID_UNKNOWN});
    CHECK(IdsOf(list.get(), {L"ParseFiles", L"NoSuch", L"ErrorNo"}, DISP_E_UNKNOWNNAME)
          == std::vector<DISPID>{1, DISPID_UNKNOWN, 1});
}

TEST_CASE("Names want a reserved identifier that is null")
{
    const Apartment apartment;
    const auto list = NewList();
    std::wstring name = L"Count";
    LPOLESTR names = name.data();
    DISPID id = 0;
    CHECK(list->GetIDsOfNames(IID_IUnknown, &names, 1, 0, &id) == DISP_E_UNKNOWNINTERFACE);
    std::vector<Value> none;
    DISPPARAMS parameters{};
    CHECK(list->Invoke(5, IID_IUnknown, 0, DISPATCH_PROPERTYGET, &parameters, nullptr, nullptr, nullptr)
          == DISP_E_UNKNOWNINTERFACE);
}

TEST_CASE("Arguments are taken by their names, in any order")
{
    const Apartment apartment;
    const auto list = NewList();
    Value number;
    Value words;
    Value result;
    std::vector<Value> arguments{Value::Reference(words), Value(L"Q:\\none"), Value::Reference(number)};
    CHECK(RawInvoke(list.get(), 1, DISPATCH_METHOD, arguments, {2, 0, 1}, &result) == S_OK);
    CHECK(result.vt == VT_BOOL);
    CHECK(result.boolVal == VARIANT_FALSE);
    CHECK(number.vt == VT_I4);
    CHECK(number.lVal == 30030);
    CHECK(words.Text() == L"Folder 'Q:\\none' does not exist.");
}

TEST_CASE("Named arguments follow those by position, and may leave optional ones between them out")
{
    const Apartment apartment;
    const auto list = NewList();
    Value words;
    std::vector<Value> arguments{Value::Reference(words), Value(L"Q:\\none")};
    CHECK(RawInvoke(list.get(), 1, DISPATCH_METHOD, arguments, {2}) == S_OK);
    CHECK(words.Text() == L"Folder 'Q:\\none' does not exist.");
}

TEST_CASE("A named argument that the member does not have, or has got already, is refused")
{
    const Apartment apartment;
    const auto list = NewList();
    std::vector<Value> arguments{Value(1), Value(L"Q:\\none")};
    CHECK(RawInvoke(list.get(), 1, DISPATCH_METHOD, arguments, {7}) == DISP_E_PARAMNOTFOUND);
    CHECK(FAILED(RawInvoke(list.get(), 1, DISPATCH_METHOD, arguments, {0})));
    std::vector<Value> onlyOptional{Value(1)};
    CHECK(RawInvoke(list.get(), 1, DISPATCH_METHOD, onlyOptional, {1}) == DISP_E_PARAMNOTOPTIONAL);
}

TEST_CASE("Variables by reference come back in the type that the host declared")
{
    const Apartment apartment;
    const auto list = NewList();
    short number = 0;
    Value narrow;
    narrow.vt = VT_BYREF | VT_I2;
    narrow.piVal = &number;
    Bstr text(L"before");
    Value words;
    words.vt = VT_BYREF | VT_BSTR;
    words.pbstrVal = text.InOut();
    CHECK(Call(list.get(), L"ParseFiles", {Value(L"Q:\\none"), narrow, words}).status == S_OK);
    CHECK(number == 30030);
    CHECK(text.Text() == L"Folder 'Q:\\none' does not exist.");
}

TEST_CASE("Too many and too few arguments, and a hole that is not optional, are refused by their own statuses")
{
    const Apartment apartment;
    const auto version = NewVersion();
    version->put_XaloVersion(Bstr(L"1.6"));
    CHECK(Call(version.get(), L"ParseXML").status == DISP_E_PARAMNOTOPTIONAL);
    CHECK(Call(version.get(), L"ParseXML", {Value(L"<Version/>"), Value(1)}).status == DISP_E_BADPARAMCOUNT);
    CHECK(Call(version.get(), L"Serialise", {Value(1)}).status == DISP_E_BADPARAMCOUNT);
    CHECK(Get(version.get(), L"XaloVersion", {Value(1)}).status == DISP_E_BADPARAMCOUNT);
    CHECK(Call(version.get(), L"ParseXML", {Value::Missing()}).status == DISP_E_PARAMNOTOPTIONAL);
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion) == L"1.6");
}

TEST_CASE("Optional arguments that are missing are holes")
{
    const Apartment apartment;
    const auto list = NewList();
    const Outcome outcome = Call(list.get(), L"ParseFiles", {Value(L"Q:\\none"), Value::Missing(), Value::Missing()});
    CHECK(outcome.status == S_OK);
    CHECK(outcome.value.boolVal == VARIANT_FALSE);
}

TEST_CASE("An id that no member has is DISP_E_MEMBERNOTFOUND, whatever the flags")
{
    const Apartment apartment;
    const auto version = NewVersion();
    for (const DISPID id : std::vector<DISPID>{DISPID_VALUE, DISPID_NEWENUM, DISPID_UNKNOWN, -12345, 5, 1000000}) {
        CAPTURE(id);
        CHECK(Invoke(version.get(), id, DISPATCH_METHOD).status == DISP_E_MEMBERNOTFOUND);
        CHECK(Invoke(version.get(), id, DISPATCH_PROPERTYGET).status == DISP_E_MEMBERNOTFOUND);
        CHECK(Invoke(version.get(), id, DISPATCH_PROPERTYPUT, {Value(1)}).status == DISP_E_MEMBERNOTFOUND);
    }
}

TEST_CASE("A member is called in its own way: a method is no property, a read-only property is not stored")
{
    const Apartment apartment;
    const auto version = NewVersion();
    CHECK(Invoke(version.get(), 1, DISPATCH_PROPERTYPUT, {Value(1)}).status == DISP_E_MEMBERNOTFOUND);
    CHECK(Invoke(version.get(), 4, DISPATCH_PROPERTYPUT, {Value(1)}).status == DISP_E_MEMBERNOTFOUND);
    CHECK(Invoke(version.get(), 3, 0).status != S_OK);
}

TEST_CASE("Script hosts ask for a property or a method at once, and get the one that is there")
{
    const Apartment apartment;
    const auto version = NewVersion();
    version->put_XaloVersion(Bstr(L"1.6"));
    CHECK(Invoke(version.get(), 3, DISPATCH_METHOD | DISPATCH_PROPERTYGET).value.Text() == L"1.6");
    CHECK(Invoke(version.get(), 1, DISPATCH_METHOD | DISPATCH_PROPERTYGET).value.vt == VT_BSTR);
}

TEST_CASE("A record is put by reference, as VBScript does, and by both flags, as JScript does")
{
    const Apartment apartment;
    const auto customer = NewCustomer();
    const auto name = NewName();
    const auto nameOf = [&] { return Get(customer.get(), L"PersonalName").value; };
    for (const int flags : {DISPATCH_PROPERTYPUTREF, DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF}) {
        CAPTURE(flags);
        CHECK(Invoke(customer.get(), 8, flags, {Value(static_cast<IDispatch*>(name.get()))}).status == S_OK);
        CHECK(nameOf().pdispVal == name.get());
        CHECK(Invoke(customer.get(), 8, flags, {Value(static_cast<IDispatch*>(nullptr))}).status == S_OK);
        CHECK(nameOf().pdispVal != name.get());
    }
}

TEST_CASE("A value is not put by reference alone: Set wants an object")
{
    const Apartment apartment;
    const auto version = NewVersion();
    const auto other = NewVersion();
    CHECK(FAILED(PutReference(version.get(), L"XaloVersion", other.get()).status));
}

TEST_CASE("A record of another class, a foreign object and a value are each refused by error 13")
{
    const Apartment apartment;
    const auto customer = NewCustomer();
    const Value before = Get(customer.get(), L"PersonalName").value;
    CHECK(PutReference(customer.get(), L"PersonalName", NewVersion().get()).error == Raised(13));
    CHECK(PutReference(customer.get(), L"PersonalName", Create(L"Scripting.Dictionary").get()).status != S_OK);
    CHECK(Put(customer.get(), L"PersonalName", Value(L"Grace")).status != S_OK);
    CHECK(Get(customer.get(), L"PersonalName").value.pdispVal == before.pdispVal);
}

TEST_CASE("An object held as IUnknown is taken where its class fits")
{
    const Apartment apartment;
    const auto customer = NewCustomer();
    const auto name = NewName();
    Value unknown;
    unknown.vt = VT_UNKNOWN;
    unknown.punkVal = name.As<IUnknown>(IID_IUnknown).get();
    unknown.punkVal->AddRef();
    CHECK(Invoke(customer.get(), 8, DISPATCH_PROPERTYPUTREF, {unknown}).status == S_OK);
    CHECK(Get(customer.get(), L"PersonalName").value.pdispVal == name.get());
}

TEST_CASE("An exception has number, source and words, and no error object is left behind")
{
    const Apartment apartment;
    const auto details = NewDetails();
    details->Add(Bstr(L"caf\u00e9"), Bstr(L"1"));
    const Outcome outcome = Call(details.get(), L"Add", {Value(L"caf\u00e9"), Value(L"2")});
    CHECK(outcome.status == DISP_E_EXCEPTION);
    CHECK(outcome.error == Raised(457));
    CHECK(outcome.source == L"InsurerDetailDef.Add");
    CHECK(outcome.description == L"the key 'caf\u00e9' is already in the list");
    CHECK(TakeError().empty());
}

TEST_CASE("A value that does not convert raises the member's error, with the name of the parameter")
{
    const Apartment apartment;
    const Outcome outcome = Put(NewClaim().get(), L"ReinstatementNo", Value(L"12x"));
    CHECK(outcome.error == Raised(13));
    CHECK(outcome.source == L"ClaimHeaderDef.ReinstatementNo");
    CHECK(outcome.description == L"'12x' is not a number");
}

TEST_CASE("Places for result, exception and argument may be null")
{
    const Apartment apartment;
    const auto version = NewVersion();
    DISPPARAMS none{};
    CHECK(version->Invoke(1, IID_NULL, 0, DISPATCH_METHOD, &none, nullptr, nullptr, nullptr) == S_OK);
    CHECK(version->Invoke(2, IID_NULL, 0, DISPATCH_METHOD, &none, nullptr, nullptr, nullptr)
          == DISP_E_PARAMNOTOPTIONAL);
    Value index(99);
    DISPPARAMS one{&index, nullptr, 1, 0};
    CHECK(NewDetails()->Invoke(3, IID_NULL, 0, DISPATCH_PROPERTYGET, &one, nullptr, nullptr, nullptr)
          == DISP_E_EXCEPTION);
}

TEST_CASE("Without parameters there is nothing to call with: an invalid argument")
{
    const Apartment apartment;
    CHECK(FAILED(NewVersion()->Invoke(1, IID_NULL, 0, DISPATCH_METHOD, nullptr, nullptr, nullptr, nullptr)));
}

TEST_CASE("An object has one type information, which names its interface")
{
    const Apartment apartment;
    const auto version = NewVersion();
    UINT count = 0;
    CHECK(version->GetTypeInfoCount(&count) == S_OK);
    CHECK(count == 1);
    Ptr<ITypeInfo> type;
    REQUIRE(version->GetTypeInfo(0, 0, type.Out()) == S_OK);
    Bstr name;
    type->GetDocumentation(MEMBERID_NIL, name.Out(), nullptr, nullptr, nullptr);
    CHECK(name.Text() == L"_VersionDef");
    CHECK(version->GetTypeInfo(1, 0, type.Out()) == DISP_E_BADINDEX);
    CHECK(version->GetTypeInfo(0, 0, nullptr) == E_POINTER);
    CHECK(version->GetTypeInfoCount(nullptr) == E_POINTER);
}
