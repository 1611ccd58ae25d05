// Ten million property calls and a hundred thousand objects, and what they leave behind: memory and handles before and
// after. Prints the figures.
#include <windows.h>

#include <psapi.h>

#include <cstdio>

#include "tests/windows/Printing.h"
#include "tests/windows/Thread.h"
#include "tests/windows/early/EarlyBound.h"

using namespace varnex3::tests;

namespace {

constexpr int kCalls = 10'000'000;
constexpr int kObjects = 100'000;

struct Use
{
    long kilobytes = 0; // of memory that is this process's alone
    long handles = 0;
};

constexpr Use kMostGrowth{64, 0}; // what an allocator may keep for itself; not one byte an object or a call

// The compiler's runtime opens two handles when it is loaded, for 32-bit Windows, and never closes them.
constexpr long kHandlesOfALoad = 2;

// A new handle gets the lowest number that is free: the numbers below it are in use. (Wine does not count handles.)
long HandlesInUse()
{
    const HANDLE handle = CreateEventW(nullptr, FALSE, FALSE, nullptr);
    CloseHandle(handle);
    return static_cast<long>(reinterpret_cast<ULONG_PTR>(handle) / 4);
}

Use CurrentUse()
{
    PROCESS_MEMORY_COUNTERS memory{};
    memory.cb = sizeof memory;
    GetProcessMemoryInfo(GetCurrentProcess(), &memory, sizeof memory);
    return {static_cast<long>(memory.PagefileUsage / 1024), HandlesInUse()};
}

// Does rounds of work until so much is done, and compares what is in use with what was after the first tenth,
// when every cache is filled.
template <class Round>
void CheckUse(const char* words, int count, int countOfRound, Round round, Use mostGrowth = kMostGrowth)
{
    int done = 0;
    for (; done < count / 10; done += countOfRound)
        round();
    const Use before = CurrentUse();
    const ULONGLONG start = GetTickCount64();
    for (; done < count; done += countOfRound)
        round();
    const double seconds = static_cast<double>(GetTickCount64() - start) / 1000;
    const Use after = CurrentUse();
    std::printf("%s: %d in %.1f s; memory %ld kB, then %ld kB; handles %ld, then %ld\n", words, done, seconds / 9 * 10,
                before.kilobytes, after.kilobytes, before.handles, after.handles);
    CHECK(after.kilobytes - before.kilobytes <= mostGrowth.kilobytes);
    CHECK(after.handles - before.handles <= mostGrowth.handles);
}

} // namespace

TEST_CASE("Ten million property calls leave nothing behind")
{
    const Apartment apartment;
    const auto claim = NewClaim();
    const auto message = NewMessage();
    const Bstr words(L"twenty characters ok");
    const Value text(L"twenty characters ok");
    const DISPID vehicleId = IdOf(claim.get(), L"VehicleID");
    const DISPID number = IdOf(claim.get(), L"ReinstatementNo");
    CheckUse("property calls", kCalls, 10, [&] {
        long value = 0;
        VARIANT_BOOL flag = VARIANT_FALSE;
        Bstr given;
        claim->put_ReinstatementNo(7);
        claim->get_ReinstatementNo(&value);
        claim->put_VehicleID(words);
        claim->get_VehicleID(given.Out());
        message->put_ParseError(VARIANT_TRUE);
        message->get_ParseError(&flag);
        Invoke(claim.get(), vehicleId, DISPATCH_PROPERTYPUT, {text});
        Invoke(claim.get(), vehicleId, DISPATCH_PROPERTYGET);
        Invoke(claim.get(), number, DISPATCH_PROPERTYPUT, {Value(L"12")});
        Invoke(claim.get(), number, DISPATCH_PROPERTYGET);
    });
}

TEST_CASE("A hundred thousand objects leave nothing behind, their children neither")
{
    const Apartment apartment;
    CheckUse("objects made and dropped", kObjects, 4, [] {
        const auto customer = NewCustomer();
        Ptr<_PersonalNameDef> name;
        customer->get_PersonalName(name.Out());
        name->put_Surname(Bstr(L"Hopper"));
        const auto message = NewMessage();
        Bstr path(L"a");
        Bstr result;
        message->ParseXML(Bstr(L"<Xalo_Quote><MessageNo>1</MessageNo></Xalo_Quote>"), Bstr(L"a"), path.InOut(),
                          result.Out());
        const auto list = NewList();
        Ptr<_MessageDef> entry;
        list->Add(Bstr(L"a"), entry.Out());
        const auto info = list.As<IProvideClassInfo>(IID_IProvideClassInfo);
        Ptr<ITypeInfo> type;
        info->GetClassInfo(type.Out());
    });
}

TEST_CASE("A hundred thousand errors leave nothing behind, by both ways and with variables by reference")
{
    const Apartment apartment;
    const auto details = NewDetails();
    const auto customer = NewCustomer();
    const auto version = NewVersion();
    const auto list = NewList();
    CheckUse("errors raised", kObjects, 4, [&] {
        Bstr text;
        details->get_Fields(Value(99), text.Out());
        TakeError();
        customer->putref_PersonalName(reinterpret_cast<_PersonalNameDef*>(version.get()));
        Call(details.get(), L"Fields", {Value(L"Phone")});
        Value number;
        Value words(L"before");
        Call(list.get(), L"ParseFiles", {Value(L"Q:\\none"), Value::Reference(number), Value::Reference(words)});
        Put(customer.get(), L"PersonalName", Value(L"Grace"));
        SetErrorInfo(0, nullptr);
    });
}

TEST_CASE(
    "A thousand threads, each with an apartment of its own, leave nothing behind in a component that stays loaded")
{
    const Apartment apartment;
    const auto held = NewVersion();
    CheckUse("threads", 1000, 1, [] {
        Thread([] {
            const Apartment own;
            const auto customer = NewCustomer();
            TextOf(customer, &_CustomerDef::Serialise);
            Bstr text;
            NewDetails()->get_Fields(Value(99), text.Out());
        }).Join();
    });
}

TEST_CASE("Two hundred times loaded and unloaded, the component leaves no memory behind")
{
    const Apartment apartment;
    CheckUse("loaded and unloaded", 200, 1,
             [] {
                 NewVersion();
                 CoFreeUnusedLibrariesEx(0, 0);
             },
             {kMostGrowth.kilobytes, 200 * kHandlesOfALoad});
}
