// Memory for the records that one text is read into. They stand side by side in blocks: a message of many small records
// costs few allocations, and its end few deallocations.
#pragma once

#include <cstddef>
#include <cstdint>

namespace varnex3 {

// While a room is there, the records that its thread makes stand in it. They may outlive it, in any order and on any
// thread: a block is freed with the last of its records. Rooms nest; the innermost one counts.
//
// On Windows a room changes nothing, and every record stands by itself: to look up a thread's variable takes as long
// there as memory does, and leaves a handle behind when a library is unloaded.
class RecordRoom
{
public:
    // What a record may ask for: no member of a record needs more.
    static constexpr std::size_t kAlignment = 8;

    // What the records are expected to take together, in bytes: little is not to waste a large block.
    explicit RecordRoom(std::size_t expected);
    ~RecordRoom();
    RecordRoom(const RecordRoom&) = delete;
    RecordRoom& operator=(const RecordRoom&) = delete;

    // Memory for one record: in the thread's room, or by itself where there is none. For Record alone.
    static void* Allocate(std::size_t size);
    static void Free(void* memory, std::size_t size) noexcept;

private:
    struct Block;
    struct Header;

    void* Take(std::size_t size);
    void Open(std::size_t needed);
    void Close() noexcept;
    static void* Place(void* memory, Block* block);
    static void Drop(Block* block, std::int32_t users) noexcept;

    std::size_t blockSize;
    RecordRoom* outer;
    Block* block = nullptr; // the one that is being filled
    std::byte* next = nullptr;
    std::size_t left = 0;
    std::int32_t taken = 0;
};

} // namespace varnex3
