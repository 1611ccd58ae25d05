// Not for threads: the programs that link it have one.
#include "CountingHeap.h"

#include <algorithm>
#include <cerrno>
#include <cstdint>

#include <malloc.h>

// The C library's own functions, under the names by which it lets others stand in for them.
extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* block);
}

namespace varnex3::benchmarks {
namespace {

std::size_t allocations = 0;
std::size_t held = 0;
std::size_t heldAtStart = 0;
std::size_t mostHeld = 0;

// What the heap really gave, not what was asked for.
void* Take(void* block)
{
    ++allocations;
    held += malloc_usable_size(block);
    mostHeld = std::max(mostHeld, held);
    return block;
}

void GiveBack(void* block) { held -= malloc_usable_size(block); }

} // namespace

void StartCounting()
{
    allocations = 0;
    mostHeld = heldAtStart = held;
}

HeapUse Counted() { return {allocations, mostHeld - heldAtStart}; }

} // namespace varnex3::benchmarks

using namespace varnex3::benchmarks;

extern "C" {

void* malloc(std::size_t size) { return Take(__libc_malloc(size)); }

void* calloc(std::size_t count, std::size_t size) { return Take(__libc_calloc(count, size)); }

// A block that moves counts twice at its peak: the old one and the new one.
void* realloc(void* block, std::size_t size)
{
    const std::size_t before = malloc_usable_size(block);
    const auto address = reinterpret_cast<std::uintptr_t>(block);
    void* grown = __libc_realloc(block, size);
    if (grown == nullptr)
        return nullptr;
    const bool hasMoved = reinterpret_cast<std::uintptr_t>(grown) != address;
    held -= hasMoved ? 0 : before;
    Take(grown);
    held -= hasMoved ? before : 0;
    return grown;
}

void* memalign(std::size_t alignment, std::size_t size) { return Take(__libc_memalign(alignment, size)); }

void* aligned_alloc(std::size_t alignment, std::size_t size) { return Take(__libc_memalign(alignment, size)); }

int posix_memalign(void** block, std::size_t alignment, std::size_t size)
{
    *block = Take(__libc_memalign(alignment, size));
    return *block == nullptr ? ENOMEM : 0;
}

void free(void* block)
{
    GiveBack(block);
    __libc_free(block);
}
}
