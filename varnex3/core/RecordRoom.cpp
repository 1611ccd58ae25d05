#include "varnex3/core/RecordRoom.h"

#include <algorithm>
#include <atomic>
#include <limits>
#include <new>
#include <utility>

#ifdef __SANITIZE_ADDRESS__
#include <sanitizer/asan_interface.h>
#endif

namespace varnex3 {

namespace {

constexpr std::size_t kAlignment = RecordRoom::kAlignment;
constexpr std::size_t kLeast = 512;
constexpr std::size_t kMost = std::size_t{16} * 1024; // what a single record that lives on may keep from being freed

// A block that is being filled counts as used by as many records as it could never hold, so that filling it need not
// count; what is too much is taken off when it is full.
constexpr std::int32_t kOpen = std::numeric_limits<std::int32_t>::max();

#ifdef _WIN32
RecordRoom* Innermost() { return nullptr; }
void Enter(RecordRoom*) {}
#else
thread_local constinit RecordRoom* innermost = nullptr;
RecordRoom* Innermost() { return innermost; }
void Enter(RecordRoom* room) { innermost = room; }
#endif

constexpr std::size_t Aligned(std::size_t size) { return (size + kAlignment - 1) / kAlignment * kAlignment; }

} // namespace

// In front of the records of a block.
struct alignas(kAlignment) RecordRoom::Block
{
    std::atomic<std::int32_t> users{kOpen};
};

// In front of each record; without a block it stands by itself.
struct alignas(kAlignment) RecordRoom::Header
{
    Block* block;
};

RecordRoom::RecordRoom(std::size_t expected) : blockSize(std::clamp(expected, kLeast, kMost)), outer(Innermost())
{
    Enter(this);
}

RecordRoom::~RecordRoom()
{
    Close();
    Enter(outer);
}

void* RecordRoom::Allocate(std::size_t size)
{
    RecordRoom* const room = Innermost();
    return room ? room->Take(size) : Place(::operator new(sizeof(Header) + size), nullptr);
}

void RecordRoom::Free(void* memory, [[maybe_unused]] std::size_t size) noexcept
{
#ifdef __SANITIZE_ADDRESS__
    __asan_poison_memory_region(memory, size); // the block may live on: who uses the record is found all the same
#endif
    Header* const header = static_cast<Header*>(memory) - 1;
    header->block ? Drop(header->block, 1) : ::operator delete(header);
}

void* RecordRoom::Take(std::size_t size)
{
    const std::size_t needed = sizeof(Header) + Aligned(size);
    if (needed > left)
        Open(needed);
    void* const memory = std::exchange(next, next + needed);
    left -= needed;
    ++taken;
    return Place(memory, block);
}

void RecordRoom::Open(std::size_t needed)
{
    Close();
    const std::size_t size = std::max(needed, blockSize);
    block = new (::operator new(sizeof(Block) + size)) Block;
    next = reinterpret_cast<std::byte*>(block + 1);
    left = size;
}

void RecordRoom::Close() noexcept
{
    if (block)
        Drop(block, kOpen - taken);
    block = nullptr;
    left = 0;
    taken = 0;
}

void* RecordRoom::Place(void* memory, Block* block) { return new (memory) Header{block} + 1; }

void RecordRoom::Drop(Block* block, std::int32_t users) noexcept
{
    if (block->users.fetch_sub(users, std::memory_order_acq_rel) == users)
        ::operator delete(block);
}

} // namespace varnex3
