#include "tests/windows/Printing.h"
#include "tests/windows/Thread.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

bool IsLoaded() { return GetModuleHandleW(L"Varnex3.dll") != nullptr; }

// Some use of every kind: texts, children, a parse, an error.
void Use()
{
    const auto customer = NewCustomer();
    Ptr<_PersonalNameDef> name;
    customer->get_PersonalName(name.Out());
    name->put_Surname(Bstr(L"Hopper"));
    TextOf(customer, &_CustomerDef::Serialise);
    Bstr text;
    CHECK(NewDetails()->get_Fields(Value(5), text.Out()) == Raised(9));
    TakeError();
    Put(customer.get(), L"Fax", Value(1.5));
}

} // namespace

TEST_CASE("A DLL that nobody needs is unloaded when the host asks for it, and not before")
{
    const Apartment apartment;
    auto version = NewVersion();
    CoFreeUnusedLibrariesEx(0, 0);
    CHECK(IsLoaded());
    CHECK(version->put_XaloVersion(Bstr(L"1.6")) == S_OK);
    version.Drop();
    CoFreeUnusedLibrariesEx(0, 0);
    CHECK(!IsLoaded());
}

TEST_CASE("It is loaded and unloaded two hundred times, used in between")
{
    for (int i = 0; i < 200; ++i) {
        const Apartment apartment;
        Use();
        REQUIRE(IsLoaded());
        CoFreeUnusedLibrariesEx(0, 0);
        REQUIRE(!IsLoaded());
    }
}

TEST_CASE("A thread that ends gives back what it used: the DLL can be unloaded afterwards")
{
    const Apartment apartment;
    for (int i = 0; i < 20; ++i)
        Thread([] {
            const Apartment own;
            Use();
        }).Join();
    Use();
    CoFreeUnusedLibrariesEx(0, 0);
    CHECK(!IsLoaded());
}
