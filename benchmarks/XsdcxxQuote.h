// A quote read and written with the classes that CodeSynthesis XSD generates from benchmarks/schema/quote.xsd, with
// Xerces-C below them.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace varnex3::benchmarks {

class XsdcxxQuote
{
public:
    // Reads a text, without validating it. Throws when it is refused.
    explicit XsdcxxQuote(std::string_view text);
    ~XsdcxxQuote();

    std::size_t ItemCount() const;
    std::string Write() const;

private:
    struct Content;
    std::unique_ptr<Content> content;
};

// Initialises Xerces-C, as every program that uses it does once.
class XercesInUse
{
public:
    XercesInUse();
    ~XercesInUse();
    XercesInUse(const XercesInUse&) = delete;
    XercesInUse& operator=(const XercesInUse&) = delete;
};

} // namespace varnex3::benchmarks
