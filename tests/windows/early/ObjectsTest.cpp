#include "tests/windows/Printing.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

Ptr<_PersonalNameDef> NameOf(const Ptr<_CustomerDef>& customer)
{
    Ptr<_PersonalNameDef> name;
    customer->get_PersonalName(name.Out());
    return name;
}

ULONG CountOf(IUnknown* object)
{
    object->AddRef();
    return object->Release();
}

using CanUnloadNow = HRESULT(STDAPICALLTYPE*)();

HRESULT CanUnload()
{
    const HMODULE component = GetModuleHandleW(L"Varnex3.dll");
    const FARPROC function = GetProcAddress(component, "DllCanUnloadNow");
    return reinterpret_cast<CanUnloadNow>(reinterpret_cast<void*>(function))();
}

} // namespace

TEST_CASE("All interfaces of an object lead to one identity, and back")
{
    const Apartment apartment;
    const auto version = NewVersion();
    const auto dispatch = version.As<IDispatch>(IID_IDispatch);
    const auto errors = version.As<ISupportErrorInfo>(IID_ISupportErrorInfo);
    const auto info = version.As<IProvideClassInfo>(IID_IProvideClassInfo);
    REQUIRE(dispatch);
    REQUIRE(errors);
    REQUIRE(info);
    const auto identity = version.As<IUnknown>(IID_IUnknown);
    CHECK(dispatch.As<IUnknown>(IID_IUnknown).get() == identity.get());
    CHECK(errors.As<IUnknown>(IID_IUnknown).get() == identity.get());
    CHECK(info.As<IUnknown>(IID_IUnknown).get() == identity.get());
    CHECK(errors.As<_VersionDef>(IID__VersionDef).get() == version.get());
    CHECK(info.As<IDispatch>(IID_IDispatch).get() == dispatch.get());
}

TEST_CASE("An interface that an object does not have gives E_NOINTERFACE and null")
{
    const Apartment apartment;
    const auto version = NewVersion();
    auto* other = reinterpret_cast<void*>(1);
    CHECK(version->QueryInterface(IID__SourceDef, &other) == E_NOINTERFACE);
    CHECK(other == nullptr);
    CHECK(version->QueryInterface(IID_IUnknown, nullptr) == E_POINTER);
}

TEST_CASE("The errors of its own interface are an object's, those of another one are not")
{
    const Apartment apartment;
    const auto errors = NewVersion().As<ISupportErrorInfo>(IID_ISupportErrorInfo);
    CHECK(errors->InterfaceSupportsErrorInfo(IID__VersionDef) == S_OK);
    CHECK(errors->InterfaceSupportsErrorInfo(IID__SourceDef) == S_FALSE);
}

TEST_CASE("References are counted, and the last one ends the object")
{
    const Apartment apartment;
    auto version = NewVersion();
    CHECK(CountOf(version.get()) == 1);
    const auto again = version;
    CHECK(CountOf(version.get()) == 2);
    CHECK(CanUnload() == S_FALSE);
}

TEST_CASE("A child is one object as long as anybody holds it, whoever its owners are")
{
    const Apartment apartment;
    auto customer = NewCustomer();
    const auto name = NameOf(customer);
    CHECK(NameOf(customer).get() == name.get());
    const auto other = NewCustomer();
    CHECK(other->putref_PersonalName(name.get()) == S_OK);
    customer.Drop();
    CHECK(NameOf(other).get() == name.get());
    name->put_Surname(Bstr(L"Hopper"));
    CHECK(TextOf(NameOf(other), &_PersonalNameDef::get_Surname) == L"Hopper");
}

TEST_CASE("A child set to Nothing is made again")
{
    const Apartment apartment;
    const auto customer = NewCustomer();
    NameOf(customer)->put_Surname(Bstr(L"Hopper"));
    CHECK(customer->putref_PersonalName(nullptr) == S_OK);
    CHECK(TextOf(NameOf(customer), &_PersonalNameDef::get_Surname).empty());
}

TEST_CASE("A pointer to an object of another class is refused, the library's or not")
{
    const Apartment apartment;
    const auto customer = NewCustomer();
    const auto version = NewVersion();
    CHECK(customer->putref_PersonalName(reinterpret_cast<_PersonalNameDef*>(version.get())) == Raised(13));
    CHECK(TakeError() == L"CustomerDef.PersonalName: an object of class VersionDef is not a PersonalNameDef");
    const auto dictionary = Create(L"Scripting.Dictionary");
    REQUIRE(dictionary);
    CHECK(customer->putref_PersonalName(reinterpret_cast<_PersonalNameDef*>(dictionary.get())) == Raised(13));
    CHECK(NameOf(customer));
}

TEST_CASE("A list gives nothing as null and S_OK")
{
    const Apartment apartment;
    auto* entry = reinterpret_cast<_MessageDef*>(1);
    CHECK(NewList()->get_MessageItems(Value(0), &entry) == S_OK);
    CHECK(entry == nullptr);
}

TEST_CASE("No class can be part of another object")
{
    const Apartment apartment;
    const auto outer = Create(L"Scripting.Dictionary");
    auto* inner = reinterpret_cast<void*>(1);
    CHECK(CoCreateInstance(CLSID_VersionDef, outer.get(), CLSCTX_INPROC_SERVER, IID_IUnknown, &inner)
          == CLASS_E_NOAGGREGATION);
    CHECK(inner == nullptr);
}

TEST_CASE("A class object makes objects, is one for all, and can be locked in memory")
{
    const Apartment apartment;
    Ptr<IClassFactory> factory;
    REQUIRE(CoGetClassObject(CLSID_VersionDef, CLSCTX_INPROC_SERVER, nullptr, IID_IClassFactory, factory.OutVoid())
            == S_OK);
    Ptr<_VersionDef> version;
    CHECK(factory->CreateInstance(nullptr, IID__VersionDef, version.OutVoid()) == S_OK);
    void* other = nullptr;
    CHECK(factory->CreateInstance(nullptr, IID__SourceDef, &other) == E_NOINTERFACE);
    CHECK(factory->CreateInstance(nullptr, IID__VersionDef, nullptr) == E_POINTER);
    version.Drop();
    CHECK(factory->LockServer(TRUE) == S_OK);
    factory.Drop();
    CHECK(CanUnload() == S_FALSE);
    REQUIRE(CoGetClassObject(CLSID_VersionDef, CLSCTX_INPROC_SERVER, nullptr, IID_IClassFactory, factory.OutVoid())
            == S_OK);
    CHECK(factory->LockServer(FALSE) == S_OK);
    factory.Drop();
    CHECK(CanUnload() == S_OK);
}

TEST_CASE("The DLL is needed while an object, or only a child of one, is held")
{
    const Apartment apartment;
    auto customer = NewCustomer();
    CHECK(CanUnload() == S_FALSE);
    auto name = NameOf(customer);
    customer.Drop();
    CHECK(CanUnload() == S_FALSE);
    auto errors = name.As<ISupportErrorInfo>(IID_ISupportErrorInfo);
    name.Drop();
    CHECK(CanUnload() == S_FALSE);
    errors.Drop();
    CHECK(CanUnload() == S_OK);
}

TEST_CASE("A class that the component does not have gives CLASS_E_CLASSNOTAVAILABLE")
{
    const Apartment apartment;
    const auto version = NewVersion();
    using GetClassObject = HRESULT(STDAPICALLTYPE*)(REFCLSID, REFIID, void**);
    const FARPROC function = GetProcAddress(GetModuleHandleW(L"Varnex3.dll"), "DllGetClassObject");
    const auto get = reinterpret_cast<GetClassObject>(reinterpret_cast<void*>(function));
    auto* object = reinterpret_cast<void*>(1);
    CHECK(get(IID_IUnknown, IID_IClassFactory, &object) == CLASS_E_CLASSNOTAVAILABLE);
    CHECK(object == nullptr);
    CHECK(get(CLSID_VersionDef, IID_IDispatch, &object) == E_NOINTERFACE);
}
