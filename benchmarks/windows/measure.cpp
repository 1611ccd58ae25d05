// What the component costs a host: property gets, objects and a scan, against a plain call of the library's own C++ and
// against Scripting.Dictionary, in one run.
//
//     measure.exe INBOX
//
// Prints a line for each figure: what is done, by whom, the median of its nanoseconds over rounds that are interleaved
// at random.
#include <algorithm>
#include <cstdio>
#include <functional>
#include <random>

#include "tests/windows/early/EarlyBound.h"
#include "varnex3/varnex3.h"

using namespace varnex3::tests;

// Scripting.Dictionary's own interface, as far as it is called here. Interfaces have no destructors.
// Not local to this file: the compiler would know that nothing here implements it, and call nothing.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor"
struct Dictionary : IDispatch
{
    virtual HRESULT STDMETHODCALLTYPE putref_Item(VARIANT* key, VARIANT* item) = 0;
    virtual HRESULT STDMETHODCALLTYPE put_Item(VARIANT* key, VARIANT* item) = 0;
    virtual HRESULT STDMETHODCALLTYPE get_Item(VARIANT* key, VARIANT* item) = 0;
    virtual HRESULT STDMETHODCALLTYPE Add(VARIANT* key, VARIANT* item) = 0;
    virtual HRESULT STDMETHODCALLTYPE get_Count(long* count) = 0;
};
#pragma GCC diagnostic pop

namespace {

constexpr int kRounds = 15;

constexpr IID kDictionary{0x42C642C1, 0x97E1, 0x11CF, {0x97, 0x8F, 0x00, 0xA0, 0x24, 0x63, 0xE0, 0x6F}};

struct Job
{
    const char* what;
    const char* whom;
    int count;
    std::function<void()> action;
    std::vector<double> times{};
};

double Now()
{
    LARGE_INTEGER count;
    LARGE_INTEGER frequency;
    QueryPerformanceCounter(&count);
    QueryPerformanceFrequency(&frequency);
    return static_cast<double>(count.QuadPart) / static_cast<double>(frequency.QuadPart) * 1e9;
}

void Run(Job& job)
{
    const double start = Now();
    for (int i = 0; i < job.count; ++i)
        job.action();
    job.times.push_back((Now() - start) / job.count);
}

double Median(std::vector<double> times)
{
    std::ranges::sort(times);
    return times[times.size() / 2];
}

// Called through these, so that the compiler cannot look into them.
std::int32_t (varnex3::ClaimHeaderDef::*volatile numberOf)() const = &varnex3::ClaimHeaderDef::ReinstatementNo;
const varnex3::Text& (varnex3::ClaimHeaderDef::*volatile textOf)() const = &varnex3::ClaimHeaderDef::VehicleID;
volatile std::size_t sink = 0;

CLSID ClassOf(const wchar_t* programId)
{
    CLSID id{};
    CLSIDFromProgID(programId, &id);
    return id;
}

std::vector<Job> Jobs(const std::wstring& inbox)
{
    const Bstr words(L"twenty characters ok");
    const auto plain = varnex3::New<varnex3::ClaimHeaderDef>();
    plain->ReinstatementNo(7);
    plain->VehicleID(u"twenty characters ok");
    const auto claim = NewClaim();
    claim->put_ReinstatementNo(7);
    claim->put_VehicleID(words);
    const DISPID number = IdOf(claim.get(), L"ReinstatementNo");
    const DISPID text = IdOf(claim.get(), L"VehicleID");
    Ptr<Dictionary> dictionary;
    const CLSID dictionaryClass = ClassOf(L"Scripting.Dictionary");
    CoCreateInstance(dictionaryClass, nullptr, CLSCTX_INPROC_SERVER, kDictionary, dictionary.OutVoid());
    Value key(L"VehicleID");
    Value item(L"twenty characters ok");
    dictionary->Add(&key, &item);
    const DISPID count = IdOf(dictionary.get(), L"Count");
    const DISPID itemId = IdOf(dictionary.get(), L"Item");
    Ptr<IClassFactory> factory;
    CoGetClassObject(CLSID_ClaimHeaderDef, CLSCTX_INPROC_SERVER, nullptr, IID_IClassFactory, factory.OutVoid());
    const varnex3::Text folder(inbox.begin(), inbox.end());

    return {
        {"get a number", "C++", 1000000, [=] { sink = sink + static_cast<std::size_t>((plain.get()->*numberOf)()); }},
        {"get a number", "vtable", 1000000,
         [=] {
             long value = 0;
             claim->get_ReinstatementNo(&value);
             sink = sink + static_cast<std::size_t>(value);
         }},
        {"get a number", "IDispatch", 100000, [=] { Invoke(claim.get(), number, DISPATCH_PROPERTYGET); }},
        {"get a number", "Dictionary, vtable", 1000000,
         [=] {
             long value = 0;
             dictionary->get_Count(&value);
             sink = sink + static_cast<std::size_t>(value);
         }},
        {"get a number", "Dictionary, IDispatch", 100000,
         [=] { Invoke(dictionary.get(), count, DISPATCH_PROPERTYGET); }},
        {"get a text", "C++", 1000000,
         [=] {
             const varnex3::Text copy = (plain.get()->*textOf)();
             sink = sink + copy.size();
         }},
        {"get a text", "vtable", 100000,
         [=] {
             Bstr given;
             claim->get_VehicleID(given.Out());
         }},
        {"get a text", "IDispatch", 100000, [=] { Invoke(claim.get(), text, DISPATCH_PROPERTYGET); }},
        {"get a text", "Dictionary, vtable", 100000,
         [=]() mutable {
             Value given;
             dictionary->get_Item(&key, &given);
         }},
        {"get a text", "Dictionary, IDispatch", 100000,
         [=] { Invoke(dictionary.get(), itemId, DISPATCH_PROPERTYGET, {key}); }},
        {"make an object", "C++", 100000, [] { varnex3::New<varnex3::ClaimHeaderDef>(); }},
        {"make an object", "class object", 20000,
         [=] {
             Ptr<_ClaimHeaderDef> made;
             factory->CreateInstance(nullptr, IID__ClaimHeaderDef, made.OutVoid());
         }},
        {"make an object", "CoCreateInstance", 2000, [] { NewClaim(); }},
        {"make an object", "Dictionary, CoCreateInstance", 2000,
         [=] {
             Ptr<IDispatch> made;
             CoCreateInstance(dictionaryClass, nullptr, CLSCTX_INPROC_SERVER, IID_IDispatch, made.OutVoid());
         }},
        {"scan the sample inbox", "C++", 3, [=] { varnex3::New<varnex3::Xalo_Messages>()->ParseFiles(folder); }},
        {"scan the sample inbox", "vtable", 3,
         [=] {
             VARIANT_BOOL result = VARIANT_FALSE;
             NewList()->ParseFiles(Bstr(inbox), nullptr, nullptr, &result);
         }},
    };
}

} // namespace

int wmain(int count, wchar_t** arguments)
{
    const Apartment apartment;
    std::vector<Job> jobs = Jobs(count > 1 ? arguments[1] : L"samples\\inbox");
    std::vector<Job*> order;
    for (Job& job : jobs)
        order.push_back(&job);
    std::mt19937 random; // NOLINT: the same order every time will do
    for (int round = 0; round < kRounds; ++round) {
        std::ranges::shuffle(order, random);
        for (Job* job : order)
            Run(*job);
    }
    for (const Job& job : jobs)
        std::printf("%s\t%s\t%.1f\n", job.what, job.whom, Median(job.times));
    return 0;
}
