// A quote read into objects, written, and both, with the library and with its peers.
#pragma once

#include <string>

namespace varnex3::benchmarks {

// FOLDER holds quote-N.xml.
void RegisterQuote(const std::string& folder, int items);

// The same with the library alone, to see how time grows.
void RegisterGrowth(const std::string& folder, int items);

// Making what holds a reference set, in a program without a database.
void RegisterMaking();

} // namespace varnex3::benchmarks
