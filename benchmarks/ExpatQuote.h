// A quote read with expat and a mapping by hand: events alone, no tree in between.
#pragma once

#include <string_view>

#include "QuoteModel.h"

namespace varnex3::benchmarks {

// A quote without items when the document is refused.
QuoteModel<std::string> ReadWithExpat(std::string_view text);

} // namespace varnex3::benchmarks
