#include <climits>

#include "tests/windows/Printing.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

TEST_CASE("A text goes in and comes out as a text that the host frees")
{
    const Apartment apartment;
    const auto version = NewVersion();
    CHECK(version->put_XaloVersion(Bstr(L"1.6 \u00e9\u65e5")) == S_OK);
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion) == L"1.6 \u00e9\u65e5");
    CHECK(version->put_XaloVersion(Bstr(std::wstring_view(L"a\0b", 3))) == S_OK);
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion) == std::wstring(L"a\0b", 3));
}

TEST_CASE("A null text is the empty text")
{
    const Apartment apartment;
    const auto version = NewVersion();
    version->put_XaloVersion(Bstr(L"1.6"));
    CHECK(version->put_XaloVersion(nullptr) == S_OK);
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion).empty());
    Value result(5);
    CHECK(version->ParseXML(nullptr, result.Out()) == S_OK);
}

TEST_CASE("Each call gives a text of its own")
{
    const Apartment apartment;
    const auto version = NewVersion();
    version->put_XaloVersion(Bstr(L"1.6"));
    Bstr first;
    Bstr second;
    version->get_XaloVersion(first.Out());
    version->get_XaloVersion(second.Out());
    CHECK(static_cast<BSTR>(first) != static_cast<BSTR>(second));
}

TEST_CASE("A date, a 32-bit integer, a Boolean and an enumeration go in and come out")
{
    const Apartment apartment;
    DATE date = 1;
    const auto source = NewSource();
    CHECK(source->get_TimeStamp(&date) == S_OK);
    CHECK(date == 0);
    CHECK(source->put_TimeStamp(38061.5) == S_OK);
    CHECK(source->get_TimeStamp(&date) == S_OK);
    CHECK(date == 38061.5);
    long number = 0;
    const auto claim = NewClaim();
    CHECK(claim->put_ReinstatementNo(LONG_MIN) == S_OK);
    CHECK(claim->get_ReinstatementNo(&number) == S_OK);
    CHECK(number == LONG_MIN);
    VARIANT_BOOL flag = 5;
    const auto message = NewMessage();
    CHECK(message->get_ParseError(&flag) == S_OK);
    CHECK(flag == VARIANT_FALSE);
    CHECK(message->put_ParseError(VARIANT_TRUE) == S_OK);
    CHECK(message->get_ParseError(&flag) == S_OK);
    CHECK(flag == VARIANT_TRUE);
    XaloMessageTypeEnum type{};
    CHECK(message->put_MessageTypeID(Xalo_Quote) == S_OK);
    CHECK(message->get_MessageTypeID(&type) == S_OK);
    CHECK(type == Xalo_Quote);
}

TEST_CASE("A double and a 16-bit integer go in and come out")
{
    const Apartment apartment;
    const auto part = New<_QuoteItemPart>(CLSID_QuoteItemPart);
    double amount = 0;
    CHECK(part->put_PartValue(149.625) == S_OK);
    CHECK(part->get_PartValue(&amount) == S_OK);
    CHECK(amount == 149.625);
    short quantity = 0;
    CHECK(part->put_PartQuantity(SHRT_MIN) == S_OK);
    CHECK(part->get_PartQuantity(&quantity) == S_OK);
    CHECK(quantity == SHRT_MIN);
}

TEST_CASE("A Boolean of a host that is neither 0 nor -1 is True")
{
    const Apartment apartment;
    const auto message = NewMessage();
    CHECK(message->put_ParseError(1) == S_OK);
    VARIANT_BOOL flag = 0;
    message->get_ParseError(&flag);
    CHECK(flag == VARIANT_TRUE);
}

TEST_CASE("A result without a place gives E_POINTER, and the method is not called")
{
    const Apartment apartment;
    const auto version = NewVersion();
    CHECK(version->get_XaloVersion(nullptr) == E_POINTER);
    CHECK(version->Serialise(nullptr) == E_POINTER);
    version->put_XaloVersion(Bstr(L"1.6"));
    CHECK(version->ParseXML(Bstr(L"<Version/>"), nullptr) == E_POINTER);
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion) == L"1.6");
    CHECK(NewSource()->get_TimeStamp(nullptr) == E_POINTER);
    CHECK(NewClaim()->get_ReinstatementNo(nullptr) == E_POINTER);
    CHECK(NewDetails()->get_Count(nullptr) == E_POINTER);
    CHECK(NewMessage()->get_ParseError(nullptr) == E_POINTER);
    CHECK(NewMessage()->get_MessageTypeID(nullptr) == E_POINTER);
    CHECK(NewCustomer()->get_PersonalName(nullptr) == E_POINTER);
    const auto list = NewList();
    CHECK(list->Add(Bstr(L"a"), nullptr) == E_POINTER);
    short count = 5;
    list->get_Count(&count);
    CHECK(count == 0);
}

TEST_CASE("What ParseXML gives is Empty, over whatever was in the result's place")
{
    const Apartment apartment;
    VARIANT result;
    result.vt = VT_BSTR; // a place that was never initialised is written, not freed
    result.llVal = -1;
    CHECK(NewVersion()->ParseXML(Bstr(L"<Version/>"), &result) == S_OK);
    CHECK(result.vt == VT_EMPTY);
}

TEST_CASE("A call that fails leaves null in a result that would have to be freed")
{
    const Apartment apartment;
    const auto details = NewDetails();
    auto* text = reinterpret_cast<BSTR>(1);
    CHECK(details->get_Fields(Value(0), &text) == Raised(9));
    CHECK(text == nullptr);
    const auto list = NewList();
    Ptr<_MessageDef> entry;
    list->Add(Bstr(L"a"), entry.Out());
    auto* object = reinterpret_cast<_MessageDef*>(1);
    CHECK(list->get_MessageItems(Value(L"b"), &object) == Raised(424));
    CHECK(object == nullptr);
}

TEST_CASE("An index is a variant of any type, by value or by reference")
{
    const Apartment apartment;
    const auto details = NewDetails();
    details->Add(Bstr(L"Phone"), Bstr(L"1"));
    details->Add(Bstr(L"Fax"), Bstr(L"2"));
    const auto valueAt = [&](const Value& index) {
        Bstr text;
        const HRESULT status = details->get_Values(index, text.Out());
        return SUCCEEDED(status) ? text.Text() : std::to_wstring(status);
    };
    CHECK(valueAt(L"Fax") == L"2");
    CHECK(valueAt(1) == L"2");
    CHECK(valueAt(static_cast<short>(1)) == L"2");
    CHECK(valueAt(1.0) == L"2");
    CHECK(valueAt(false) == L"1");
    CHECK(valueAt(Value()) == L"1");
    Value byte;
    byte.vt = VT_UI1;
    byte.bVal = 1;
    CHECK(valueAt(byte) == L"2");
    Value wide;
    wide.vt = VT_I8;
    wide.llVal = 1;
    CHECK(valueAt(wide) == L"2");
    Value amount;
    amount.vt = VT_CY;
    amount.cyVal.int64 = 10000;
    CHECK(valueAt(amount) == L"2");
    Value key(L"Fax");
    CHECK(valueAt(Value::Reference(key)) == L"2");
    long position = 1;
    Value reference;
    reference.vt = VT_BYREF | VT_I4;
    reference.plVal = &position;
    CHECK(valueAt(reference) == L"2");
}

TEST_CASE("An index that is no value is a type mismatch")
{
    const Apartment apartment;
    const auto details = NewDetails();
    Bstr text;
    Value null;
    null.vt = VT_NULL;
    CHECK(details->get_Values(null, text.Out()) == Raised(13));
    CHECK(details->get_Values(Value(static_cast<IDispatch*>(details.get())), text.Out()) == Raised(13));
    CHECK(details->get_Values(Value::Missing(), text.Out()) == Raised(13));
    Value array;
    array.parray = SafeArrayCreateVector(VT_I4, 0, 3);
    array.vt = VT_ARRAY | VT_I4;
    CHECK(details->get_Values(array, text.Out()) == Raised(13));
    short count = 5;
    details->get_Count(&count);
    CHECK(count == 0);
}

TEST_CASE("Results by reference are written to the host's variables, and the old text is freed")
{
    const Apartment apartment;
    const auto list = NewList();
    long number = 7;
    Bstr words(L"before");
    VARIANT_BOOL result = VARIANT_TRUE;
    CHECK(list->ParseFiles(Bstr(L"Q:\\none"), &number, words.InOut(), &result) == S_OK);
    CHECK(result == VARIANT_FALSE);
    CHECK(number == 30030);
    CHECK(words.Text() == L"Folder 'Q:\\none' does not exist.");
}

TEST_CASE("Optional results by reference may be null, and a null text may be in their place")
{
    const Apartment apartment;
    const auto list = NewList();
    VARIANT_BOOL result = VARIANT_TRUE;
    CHECK(list->ParseFiles(Bstr(L"Q:\\none"), nullptr, nullptr, &result) == S_OK);
    CHECK(result == VARIANT_FALSE);
    long number = 0;
    CHECK(list->ParseFiles(Bstr(L"Q:\\none"), &number, nullptr, &result) == S_OK);
    CHECK(number == 30030);
    Bstr words;
    CHECK(list->ParseFiles(Bstr(L"Q:\\none"), nullptr, words.InOut(), &result) == S_OK);
    CHECK(words.Text() == L"Folder 'Q:\\none' does not exist.");
}

TEST_CASE("A variable by reference that nothing comes back in keeps its very text")
{
    const Apartment apartment;
    const auto message = NewMessage();
    Bstr path(L"C:\\inbox\\q.xml");
    const BSTR before = path;
    Bstr result;
    CHECK(message->ParseXML(Bstr(L"<Xalo_Quote/>"), Bstr(L"q.xml"), path.InOut(), result.Out()) == S_OK);
    CHECK(static_cast<BSTR>(path) == before);
    CHECK(TextOf(message, &_MessageDef::get_FilePath) == L"C:\\inbox\\q.xml");
    BSTR none = nullptr;
    CHECK(message->ParseXML(Bstr(L"<Xalo_Quote/>"), Bstr(L"q.xml"), &none, result.Out()) == S_OK);
    CHECK(none == nullptr);
    CHECK(TextOf(message, &_MessageDef::get_FilePath).empty());
}
