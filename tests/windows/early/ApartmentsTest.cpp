#include <atomic>

#include "tests/windows/Printing.h"
#include "tests/windows/Thread.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

// What two threads do at once, each with objects of its own. Gives how often a value was not what it should be.
int Work(const std::wstring& mine)
{
    const Apartment apartment;
    int wrong = 0;
    const auto customer = NewCustomer();
    for (int i = 0; i < 2000; ++i) {
        const std::wstring text = mine + std::to_wstring(i);
        Ptr<_PersonalNameDef> name;
        customer->get_PersonalName(name.Out());
        name->put_Surname(Bstr(text));
        wrong += TextOf(name, &_PersonalNameDef::get_Surname) != text;
        wrong += TextOf(customer, &_CustomerDef::Serialise).find(text) == std::wstring::npos;
        Bstr none;
        wrong += NewDetails()->get_Fields(Value(text.c_str()), none.Out()) != Raised(13);
        wrong += TakeError() != L"InsurerDetailDef.Fields: Index: '" + text + L"' is not a number";
        wrong += Put(customer.get(), L"Fax", Value(text.c_str())).status != S_OK;
        wrong += Get(customer.get(), L"fax").value.Text() != text;
    }
    return wrong;
}

} // namespace

TEST_CASE("Two apartments at once: each works with objects of its own and meets its own errors")
{
    std::atomic<int> wrong = 0;
    {
        Thread first([&] { wrong += Work(L"first "); });
        Thread second([&] { wrong += Work(L"second "); });
    }
    CHECK(wrong == 0);
}

TEST_CASE("An object of one apartment is used from another one, and calls are served where it lives")
{
    const Apartment apartment;
    const auto version = NewVersion();
    version->put_XaloVersion(Bstr(L"here"));
    IStream* stream = nullptr;
    REQUIRE(CoMarshalInterThreadInterfaceInStream(IID__VersionDef, version.get(), &stream) == S_OK);
    std::wstring seen;
    bool isProxy = false;
    Thread([&] {
        const Apartment own;
        Ptr<_VersionDef> proxy;
        if (FAILED(CoGetInterfaceAndReleaseStream(stream, IID__VersionDef, proxy.OutVoid())))
            return;
        isProxy = proxy.get() != version.get();
        seen = TextOf(proxy, &_VersionDef::get_XaloVersion);
        proxy->put_XaloVersion(Bstr(L"from there"));
    }).Join();
    CHECK(isProxy);
    CHECK(seen == L"here");
    CHECK(TextOf(version, &_VersionDef::get_XaloVersion) == L"from there");
}
