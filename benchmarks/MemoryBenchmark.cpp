// What reading a document, reading a quote into records and writing it cost in memory, a line a job and size: job,
// items, bytes of the UTF-16 text, peak, allocations.
//
//     varnex3_bench_memory FOLDER
//
// FOLDER holds quote-5.xml to quote-5000.xml.
#include <iostream>
#include <string>

#include "CountingHeap.h"
#include "varnex3/quote/Xalo_Quote.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/Unicode.h"

using namespace varnex3;

namespace {

void Print(const char* job, int items, std::size_t textBytes, const benchmarks::HeapUse& use)
{
    std::cout << job << '\t' << items << '\t' << textBytes << '\t' << use.peak << '\t' << use.allocations << '\n';
}

template <typename Load>
bool MeasureLoading(const char* job, int items, std::size_t textBytes, Load load)
{
    benchmarks::StartCounting();
    bool isLoaded = false;
    {
        xml::Document document;
        isLoaded = load(document);
    }
    Print(job, items, textBytes, benchmarks::Counted());
    return isLoaded;
}

// A whole quote read, with all its records and texts, and then written.
void MeasureRecords(int items, const Text& text)
{
    benchmarks::StartCounting();
    const auto quote = New<Xalo_Quote>();
    XmlSection::ReadText(*quote, text);
    Print("read", items, text.size() * sizeof(char16_t), benchmarks::Counted());
    quote->Serialise(); // makes the records that it finds missing
    benchmarks::StartCounting();
    const Text written = quote->Serialise();
    Print("serialise", items, written.size() * sizeof(char16_t), benchmarks::Counted());
}

bool MeasureQuote(const std::string& folder, int items)
{
    const std::string path = folder + "/quote-" + std::to_string(items) + ".xml";
    const std::string bytes = xml::ReadFile(xml::ToUtf16(path));
    const std::u16string text = xml::ToUtf16(bytes);
    const std::size_t textBytes = text.size() * sizeof(char16_t);
    MeasureRecords(items, text);
    return MeasureLoading("utf8", items, textBytes, [&](xml::Document& document) { return document.LoadBytes(bytes); })
           && MeasureLoading("utf16", items, textBytes,
                             [&](xml::Document& document) { return document.LoadText(text); });
}

// A heap that is not counted would show as figures of zero, which look good.
bool IsHeapCounted()
{
    benchmarks::StartCounting();
    const std::string probe(1000, 'x');
    const benchmarks::HeapUse use = benchmarks::Counted();
    return use.allocations == 1 && use.peak >= probe.size();
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2 || !IsHeapCounted()) {
        std::cerr << (argc != 2 ? "usage: varnex3_bench_memory FOLDER\n" : "the heap is not counted\n");
        return 2;
    }
    for (const int items : {5, 50, 500, 5000}) {
        if (!MeasureQuote(argv[1], items)) {
            std::cerr << "quote-" << items << ".xml was refused\n";
            return 2;
        }
    }
    return 0;
}
