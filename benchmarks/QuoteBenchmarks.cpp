#include "QuoteBenchmarks.h"

#include <benchmark/benchmark.h>

#include <stdexcept>

#include "ExpatQuote.h"
#include "GsoapQuote.h"
#include "LibxmlQuote.h"
#include "PugixmlQuote.h"
#include "XsdcxxQuote.h"
#include "varnex3/quote/Xalo_Quote.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/Unicode.h"

namespace varnex3::benchmarks {
namespace {

// A document, its number of items, and the names' ending.
struct Sample
{
    std::string utf8;
    std::u16string utf16;
    std::size_t items;
    std::string size;
};

Sample Load(const std::string& folder, int items)
{
    const std::string number = std::to_string(items);
    const std::string utf8 = xml::ReadFile(xml::ToUtf16(folder + "/quote-" + number + ".xml"));
    return {utf8, xml::ToUtf16(utf8), static_cast<std::size_t>(items), "/" + number};
}

// Registers a job; it returns whether it did what it should, so that nobody is timed while failing.
template <class Job>
void Register(const std::string& name, Job job)
{
    benchmark::RegisterBenchmark(name.c_str(), [job](benchmark::State& state) mutable {
        for (auto _ : state)
            if (!job())
                return state.SkipWithError("it did not do its work");
    });
}

// What ParseXML does, less the text it returns.
Ref<Xalo_Quote> Read(const Text& text)
{
    const auto quote = New<Xalo_Quote>();
    XmlSection::ReadText(*quote, text);
    return quote;
}

std::size_t CountOf(const Ref<Xalo_Quote>& quote)
{
    return static_cast<std::size_t>(quote->QuoteItemsField()->Count());
}

// A peer that reads less than the others would be measured as quick.
void RequireSameReading(const Sample& sample)
{
    auto expected = ReadWithPugixml(sample.utf8);
    auto byLibxml = ReadWithLibxml(sample.utf8);
    auto byExpat = ReadWithExpat(sample.utf8);
    const std::string text = WriteWithPugixml(expected);
    if (WriteWithPugixml(byLibxml) != text || WriteWithPugixml(byExpat) != text)
        throw std::runtime_error("the peers do not read the same");
}

void RegisterReading(const Sample& sample)
{
    RequireSameReading(sample);
    Register("read/varnex3" + sample.size, [sample] { return CountOf(Read(sample.utf16)) == sample.items; });
    Register("read/pugixml-8" + sample.size,
             [sample] { return ReadWithPugixml(sample.utf8).items.size() == sample.items; });
    Register("read/pugixml-16" + sample.size,
             [sample] { return ReadWithPugixml(sample.utf16).items.size() == sample.items; });
    Register("read/libxml2" + sample.size,
             [sample] { return ReadWithLibxml(sample.utf8).items.size() == sample.items; });
    Register("read/gsoap" + sample.size, [sample] { return GsoapQuote(sample.utf8).ItemCount() == sample.items; });
    Register("read/xsdcxx" + sample.size, [sample] { return XsdcxxQuote(sample.utf8).ItemCount() == sample.items; });
    Register("read/expat" + sample.size, [sample] { return ReadWithExpat(sample.utf8).items.size() == sample.items; });
}

void RegisterWriting(const Sample& sample)
{
    const std::size_t least = sample.items * 100; // characters
    Register("write/varnex3" + sample.size,
             [quote = Read(sample.utf16), least] { return quote->Serialise().size() > least; });
    auto model = ReadWithPugixml(sample.utf8);
    Register("write/pugixml" + sample.size,
             [model, least]() mutable { return WriteWithPugixml(model).size() > least; });
    Register("write/libxml2" + sample.size, [model, least]() mutable { return WriteWithLibxml(model).size() > least; });
}

void RegisterBoth(const Sample& sample)
{
    const std::size_t least = sample.items * 100;
    Register("both/varnex3" + sample.size, [sample, least] { return Read(sample.utf16)->Serialise().size() > least; });
    Register("both/pugixml" + sample.size, [sample, least] {
        auto model = ReadWithPugixml(sample.utf8);
        return WriteWithPugixml(model).size() > least;
    });
    Register("both/libxml2" + sample.size, [sample, least] {
        auto model = ReadWithLibxml(sample.utf8);
        return WriteWithLibxml(model).size() > least;
    });
    Register("both/gsoap" + sample.size, [sample, least] { return GsoapQuote(sample.utf8).Write().size() > least; });
    Register("both/xsdcxx" + sample.size, [sample, least] { return XsdcxxQuote(sample.utf8).Write().size() > least; });
}

} // namespace

void RegisterQuote(const std::string& folder, int items)
{
    static const XercesInUse xerces;
    const Sample sample = Load(folder, items);
    RegisterReading(sample);
    RegisterWriting(sample);
    RegisterBoth(sample);
}

void RegisterGrowth(const std::string& folder, int items)
{
    const Sample sample = Load(folder, items);
    Register("growth/both" + sample.size,
             [sample] { return Read(sample.utf16)->Serialise().size() > sample.items * 100; });
    Register("growth/pugixml" + sample.size, [sample] {
        auto model = ReadWithPugixml(sample.utf8);
        return WriteWithPugixml(model).size() > sample.items * 100;
    });
}

void RegisterMaking()
{
    Register("make/QuoteDetailsDef", [] { return static_cast<bool>(New<QuoteDetailsDef>()); });
}

} // namespace varnex3::benchmarks
