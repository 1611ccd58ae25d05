// A host with free threads: every call goes through a proxy that the system makes from the type library.
//
// A program of its own, because Wine never releases the class objects that it gives to such a host: the DLL stays
// loaded.
#include "tests/windows/Printing.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

TEST_CASE("A host with free threads gets proxies, made by the type library, that bring everything across")
{
    const Apartment apartment(COINIT_MULTITHREADED);
    const auto details = NewDetails();
    REQUIRE(details);
    CHECK(details->Add(Bstr(L"Phone"), Bstr(L"1 \u00e9\u65e5")) == S_OK);
    Bstr text;
    CHECK(details->get_Values(Value(L"Phone"), text.Out()) == S_OK);
    CHECK(text.Text() == L"1 \u00e9\u65e5");
    short count = 0;
    CHECK(details->get_Count(&count) == S_OK);
    CHECK(count == 1);
    DATE date = 0;
    const auto source = NewSource();
    CHECK(source->put_TimeStamp(38061.5) == S_OK);
    CHECK(source->get_TimeStamp(&date) == S_OK);
    CHECK(date == 38061.5);
    const auto message = NewMessage();
    XaloMessageTypeEnum type{};
    CHECK(message->put_MessageTypeID(Xalo_TaxInvoice) == S_OK);
    CHECK(message->get_MessageTypeID(&type) == S_OK);
    CHECK(type == Xalo_TaxInvoice);
    VARIANT_BOOL flag = VARIANT_FALSE;
    CHECK(message->put_ParseError(VARIANT_TRUE) == S_OK);
    CHECK(message->get_ParseError(&flag) == S_OK);
    CHECK(flag == VARIANT_TRUE);
}

TEST_CASE("Through a proxy: variables by reference come back, errors keep number, source and words")
{
    const Apartment apartment(COINIT_MULTITHREADED);
    const auto list = NewList();
    long number = 7;
    Bstr words(L"before");
    VARIANT_BOOL result = VARIANT_TRUE;
    CHECK(list->ParseFiles(Bstr(L"Q:\\none"), &number, words.InOut(), &result) == S_OK);
    CHECK(result == VARIANT_FALSE);
    CHECK(number == 30030);
    CHECK(words.Text() == L"Folder 'Q:\\none' does not exist.");
    const auto details = NewDetails();
    details->Add(Bstr(L"Phone"), Bstr(L"1"));
    CHECK(details->Add(Bstr(L"Phone"), Bstr(L"2")) == Raised(457));
    const Outcome outcome = Call(details.get(), L"Add", {Value(L"Phone"), Value(L"2")});
    CHECK(outcome.error == Raised(457));
    CHECK(outcome.source == L"InsurerDetailDef.Add");
    CHECK(outcome.description == L"the key 'Phone' is already in the list");
}

TEST_CASE("Through a proxy: objects come out and go in again")
{
    const Apartment apartment(COINIT_MULTITHREADED);
    const auto customer = NewCustomer();
    Ptr<_PersonalNameDef> name;
    CHECK(customer->get_PersonalName(name.Out()) == S_OK);
    REQUIRE(name);
    CHECK(name->put_Surname(Bstr(L"Hopper")) == S_OK);
    const auto other = NewCustomer();
    CHECK(other->putref_PersonalName(name.get()) == S_OK);
    Ptr<_PersonalNameDef> shared;
    CHECK(other->get_PersonalName(shared.Out()) == S_OK);
    CHECK(TextOf(shared, &_PersonalNameDef::get_Surname) == L"Hopper");
}
