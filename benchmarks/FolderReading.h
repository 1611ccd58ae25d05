// The least that reading a folder of files can cost: what the time of an inbox is measured against.
#pragma once

#include <cstddef>
#include <string>

namespace varnex3::benchmarks {

// Lists the folder, opens, reads and closes each regular file in it, and keeps nothing. Returns the number of bytes
// read. Throws std::system_error.
std::size_t ReadEveryFile(const std::string& folder);

} // namespace varnex3::benchmarks
