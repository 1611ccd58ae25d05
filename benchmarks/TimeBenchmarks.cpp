// Times each job with the engine and with its peers. The names read job/who/size, which benchmarks/run relies on.
//
//     varnex3_bench_time FOLDER [Google Benchmark's options]
//
// FOLDER holds quote-5.xml to quote-10000.xml, named by their number of items, and a folder inbox of messages.
#include <benchmark/benchmark.h>

#include <iostream>
#include <string>

#include <malloc.h>

#include "FolderReading.h"
#include "Parsers.h"
#include "QuoteBenchmarks.h"
#include "varnex3/inbox/Xalo_Messages.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/Unicode.h"

using namespace varnex3::benchmarks;

namespace {

template <typename Text>
void Register(const std::string& name, bool (*parse)(std::basic_string_view<Text>), std::basic_string<Text> text)
{
    benchmark::RegisterBenchmark(name.c_str(), [parse, text = std::move(text)](benchmark::State& state) {
        for (auto _ : state)
            if (!parse(text))
                return state.SkipWithError("the document was refused");
    });
}

void RegisterParsers(const std::string& folder, int items)
{
    const std::string size = std::string("/").append(std::to_string(items));
    const std::string path = folder + "/quote-" + std::to_string(items) + ".xml";
    const std::string text = varnex3::xml::ReadFile(varnex3::xml::ToUtf16(path));
    Register("parse/varnex3-utf8" + size, ParseUtf8, text);
    Register("parse/varnex3-utf16" + size, ParseUtf16, varnex3::xml::ToUtf16(text));
    Register("parse/pugixml" + size, ParseWithPugixml, text);
    Register("parse/rapidxml" + size, ParseWithRapidxml, text);
    Register("parse/libxml2" + size, ParseWithLibxml, text);
    Register("parse/expat" + size, ParseWithExpat, text);
}

bool ParseInbox(const std::u16string& folder)
{
    const auto messages = varnex3::New<varnex3::Xalo_Messages>();
    return messages->ParseFiles(folder) && messages->Count() > 0;
}

void RegisterInbox(const std::string& folder)
{
    benchmark::RegisterBenchmark("inbox/varnex3", [path = varnex3::xml::ToUtf16(folder)](benchmark::State& state) {
        for (auto _ : state)
            if (!ParseInbox(path))
                return state.SkipWithError("the folder was not read");
    });
    benchmark::RegisterBenchmark("inbox/files-only", [folder](benchmark::State& state) {
        for (auto _ : state)
            benchmark::DoNotOptimize(ReadEveryFile(folder));
    });
}

// Keeps freed memory in the process. Otherwise the C library gives it back to the system after some documents and not
// after others, and a parser is timed by which sizes it happens to ask for.
void KeepMemory()
{
    mallopt(M_TRIM_THRESHOLD, 1 << 30);
    mallopt(M_MMAP_THRESHOLD, 1 << 30);
}

} // namespace

int main(int argc, char** argv)
{
    benchmark::Initialize(&argc, argv);
    if (argc != 2) {
        std::cerr << "usage: varnex3_bench_time FOLDER [options]\n";
        return 2;
    }
    KeepMemory();
    const std::string folder = argv[1];
    for (const int items : {5, 50, 500, 5000}) {
        RegisterParsers(folder, items);
        RegisterQuote(folder, items);
    }
    for (const int items : {1000, 10000})
        RegisterGrowth(folder, items);
    RegisterMaking();
    RegisterInbox(folder + "/inbox");
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
