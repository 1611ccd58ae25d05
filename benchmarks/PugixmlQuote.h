// A quote read and written with pugixml and a mapping by hand.
#pragma once

#include <string_view>

#include "QuoteModel.h"

namespace varnex3::benchmarks {

// Each gives a quote without items when the document is refused. Of the second the text and the values are UTF-16,
// which pugixml converts on its way in and the mapping on its way out.
QuoteModel<std::string> ReadWithPugixml(std::string_view text);
QuoteModel<std::u16string> ReadWithPugixml(std::u16string_view text);

std::string WriteWithPugixml(QuoteModel<std::string>& quote);

} // namespace varnex3::benchmarks
