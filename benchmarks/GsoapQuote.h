// A quote read and written with the classes that gSOAP generates from benchmarks/schema/quote.xsd.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace varnex3::benchmarks {

class GsoapQuote
{
public:
    // Reads a text; one that is refused is a quote without items.
    explicit GsoapQuote(std::string_view text);
    ~GsoapQuote();

    std::size_t ItemCount() const;
    std::string Write() const;

private:
    struct Content;
    std::unique_ptr<Content> content;
};

} // namespace varnex3::benchmarks
