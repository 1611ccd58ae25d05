#include "tests/windows/Printing.h"
#include "tests/windows/Thread.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

// What a call to parse a text gives.
template <class I>
HRESULT Parse(const Ptr<I>& object, const wchar_t* text)
{
    Value result;
    return object->ParseXML(Bstr(text), result.Out());
}

} // namespace

TEST_CASE("An error is its number in the status, and source and words in the thread's error object")
{
    const Apartment apartment;
    const auto details = NewDetails();
    CHECK(details->Add(Bstr(L"caf\u00e9 \u65e5"), Bstr(L"1")) == S_OK);
    CHECK(details->Add(Bstr(L"caf\u00e9 \u65e5"), Bstr(L"2")) == Raised(457));
    CHECK(TakeError() == L"InsurerDetailDef.Add: the key 'caf\u00e9 \u65e5' is already in the list");
}

TEST_CASE("The error object is of the interface that was called")
{
    const Apartment apartment;
    const auto source = NewSource();
    CHECK(Parse(source, L"<Source/>") == Raised(91));
    Ptr<IErrorInfo> info;
    REQUIRE(GetErrorInfo(0, info.Out()) == S_OK);
    GUID id{};
    CHECK(info->GetGUID(&id) == S_OK);
    CHECK(IsEqualGUID(id, IID__SourceDef));
}

TEST_CASE("Every number that the library raises is a status with the facility of controls")
{
    const Apartment apartment;
    const auto details = NewDetails();
    details->Add(Bstr(L"Phone"), Bstr(L"1"));
    Bstr text;
    CHECK(
        Parse(NewSource(), L"<Source><OrgType/><AppVersion/><AppName/><TimeStamp>2004+03-15T1:05</TimeStamp></Source>")
        == Raised(5));
    CHECK(details->get_Values(Value(L"2147483648"), text.Out()) == Raised(6));
    CHECK(details->get_Fields(Value(99), text.Out()) == Raised(9));
    CHECK(details->get_Fields(Value(L"Phone"), text.Out()) == Raised(13));
    const auto message = NewMessage();
    Bstr path;
    message->ParseXML(Bstr(L"<Foo/>"), Bstr(L""), path.InOut(), text.Out());
    CHECK(message->saveToFile(Value(L"Q:\\none\\out.xml"), text.Out()) == Raised(75));
    CHECK(Parse(NewSource(), L"<Source/>") == Raised(91));
    const auto list = NewList();
    Ptr<_MessageDef> entry;
    list->Add(Bstr(L"a"), entry.Out());
    CHECK(list->get_MessageItems(Value(L"b"), entry.Out()) == Raised(424));
    CHECK(details->Add(Bstr(L"Phone"), Bstr(L"2")) == Raised(457));
    Value result;
    CHECK(list->Remove(Value(L"none"), result.Out()) == Raised(32811));
    CHECK(Raised(32811) == static_cast<HRESULT>(0x800A802B));
}

TEST_CASE("What was read before an error stays")
{
    const Apartment apartment;
    const auto source = NewSource();
    CHECK(Parse(source, L"<Source><OrgType>INS</OrgType></Source>") == Raised(91));
    CHECK(TakeError() == L"SourceDef.ParseXML: the element Source/AppVersion is missing");
    CHECK(TextOf(source, &_SourceDef::get_OrgType) == L"INS");
}

TEST_CASE("Errors of two threads are each thread's own")
{
    const Apartment apartment;
    const auto details = NewDetails();
    Bstr text;
    CHECK(details->get_Fields(Value(1), text.Out()) == Raised(9));
    bool hadNone = false;
    Thread([&] {
        const Apartment own;
        hadNone = NewDetails()->Add(nullptr, nullptr) == S_OK && TakeError().empty();
    }).Join();
    CHECK(hadNone);
    CHECK(TakeError() == L"InsurerDetailDef.Fields: Index: '1' is outside the list of 0");
}
