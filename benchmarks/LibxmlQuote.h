// A quote read and written with libxml2: its tree with a mapping by hand, and its text writer.
#pragma once

#include <string_view>

#include "QuoteModel.h"

namespace varnex3::benchmarks {

// A quote without items when the document is refused.
QuoteModel<std::string> ReadWithLibxml(std::string_view text);

std::string WriteWithLibxml(QuoteModel<std::string>& quote);

} // namespace varnex3::benchmarks
