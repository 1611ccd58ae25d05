// Counts what a piece of code asks of the heap: linked into a program, it stands in for malloc and its kin, which
// operator new and realloc come down to.
#pragma once

#include <cstddef>

namespace varnex3::benchmarks {

struct HeapUse
{
    std::size_t allocations = 0; // calls that ask for memory, each growth of a block included
    std::size_t peak = 0;        // the most bytes held at once, over those held at the start
};

// From here on until the next call.
void StartCounting();
HeapUse Counted();

} // namespace varnex3::benchmarks
