#include "varnex3/core/RecordRoom.h"

#include <array>
#include <atomic>
#include <cstdlib>
#include <vector>

#include "tests/Printing.h"
#include "tests/Threads.h"
#include "varnex3/core/CustomerDef.h"
#include "varnex3/core/VersionDef.h"

#ifdef __SANITIZE_ADDRESS__
#include <sanitizer/asan_interface.h>
#endif

using namespace varnex3;

namespace {

Ref<VersionDef> NewVersion(std::size_t number)
{
    auto version = New<VersionDef>();
    version->XaloVersion(Text(number % 40, u'x'));
    return version;
}

} // namespace

TEST_CASE("RecordRoom: a record outlives its room and the records beside it")
{
    Ref<VersionDef> kept;
    {
        const RecordRoom room(0);
        const auto before = NewVersion(1);
        kept = NewVersion(2);
        const auto behind = NewVersion(3);
    }
    CHECK(kept->XaloVersion() == u"xx");
}

#ifndef _WIN32
TEST_CASE("RecordRoom: its records stand side by side, whatever is made in between")
{
    const RecordRoom room(1000);
    const auto first = NewVersion(1);
    {
        const RecordRoom inner(600);
        NewVersion(2);
    }
    const std::vector<char> between(5000);
    const auto second = NewVersion(3);
    const auto* const begin = reinterpret_cast<const char*>(first.get());
    CHECK(std::abs(reinterpret_cast<const char*>(second.get()) - begin) < 200);
}
#endif

TEST_CASE("RecordRoom: any number of records fits, each keeps its values, and a large one has its place, too")
{
    std::vector<Ref<VersionDef>> versions;
    std::vector<Ref<CustomerDef>> customers;
    for (const std::size_t expected : {0U, 700U, 1000000U}) {
        const RecordRoom room(expected);
        for (std::size_t i = 0; i < 1000; ++i) {
            versions.push_back(NewVersion(i));
            customers.push_back(New<CustomerDef>());
        }
    }
    for (std::size_t i = 0; i < versions.size(); ++i)
        REQUIRE(versions[i]->XaloVersion().size() == i % 1000 % 40);
}

TEST_CASE("RecordRoom: rooms nest, and behind the last one records stand by themselves")
{
    std::vector<Ref<VersionDef>> versions;
    {
        const RecordRoom outer(600);
        versions.push_back(NewVersion(1));
        {
            const RecordRoom inner(600);
            versions.push_back(NewVersion(2));
        }
        versions.push_back(NewVersion(3));
    }
    versions.push_back(NewVersion(4));
    versions.erase(versions.begin());
    CHECK(versions[2]->XaloVersion() == u"xxxx");
}

TEST_CASE("RecordRoom: records of one room may end on several threads, and other threads have no part in it")
{
    constexpr std::size_t kThreads = 4;
    std::array<std::vector<Ref<VersionDef>>, kThreads> parts;
    const RecordRoom room(100000);
    for (std::size_t i = 0; i < 4000; ++i)
        parts.at(i % kThreads).push_back(NewVersion(i));
    std::atomic<std::size_t> next{0};
    std::atomic<std::size_t> wrong{0};
    tests::OnThreads(kThreads, [&] {
        parts.at(next++).clear();
        for (std::size_t i = 0; i < 1000; ++i)
            wrong += NewVersion(i)->XaloVersion().size() != i % 40 ? 1 : 0;
    });
    CHECK(wrong == 0);
}

#ifdef __SANITIZE_ADDRESS__
TEST_CASE("RecordRoom: the address sanitizer sees that a record has ended whose block has not")
{
    const RecordRoom room(1000);
    const auto before = NewVersion(1);
    auto ended = NewVersion(2);
    const Record* const address = ended.get();
    CHECK_FALSE(__asan_address_is_poisoned(address));
    ended = {};
    CHECK(__asan_address_is_poisoned(address));
    CHECK_FALSE(__asan_address_is_poisoned(before.get()));
}
#endif
