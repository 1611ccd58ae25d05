#include "XsdcxxQuote.h"

#include <sstream>

#include <xercesc/util/PlatformUtils.hpp>

#include "quote.hxx"

namespace varnex3::benchmarks {

struct XsdcxxQuote::Content
{
    std::unique_ptr<generated::Quote> quote;
};

XsdcxxQuote::XsdcxxQuote(std::string_view text) : content(std::make_unique<Content>())
{
    std::istringstream stream{std::string(text)};
    content->quote =
        generated::Xalo_Quote(stream, xml_schema::flags::dont_validate | xml_schema::flags::dont_initialize);
}

XsdcxxQuote::~XsdcxxQuote() = default;

std::size_t XsdcxxQuote::ItemCount() const
{
    const auto& items = content->quote->QuoteItems();
    return items ? items->QuoteItem().size() : 0;
}

std::string XsdcxxQuote::Write() const
{
    xml_schema::namespace_infomap names;
    names[""].schema = "Xalo_Quote.xsd";
    std::ostringstream stream;
    generated::Xalo_Quote(stream, *content->quote, names, "UTF-8", xml_schema::flags::dont_initialize);
    return stream.str();
}

XercesInUse::XercesInUse() { xercesc::XMLPlatformUtils::Initialize(); }
XercesInUse::~XercesInUse() { xercesc::XMLPlatformUtils::Terminate(); }

} // namespace varnex3::benchmarks
