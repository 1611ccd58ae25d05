// Text to tree with the engine and with each peer: parsed, looked at, destroyed. Each returns whether the document was
// accepted, so that no parser is timed while it fails.
#pragma once

#include <string_view>

namespace varnex3::benchmarks {

bool ParseUtf8(std::string_view text);
bool ParseUtf16(std::u16string_view text);

// The peers keep their defaults: pugixml and RapidXML resolve references and check little, libxml2 checks everything,
// expat checks everything and reports events to empty handlers without building a tree.
bool ParseWithPugixml(std::string_view text);
bool ParseWithRapidxml(std::string_view text);
bool ParseWithLibxml(std::string_view text);
bool ParseWithExpat(std::string_view text);

} // namespace varnex3::benchmarks
