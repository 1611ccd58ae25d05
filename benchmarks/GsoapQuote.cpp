#include "GsoapQuote.h"

#include <sstream>

#include "soapH.h"

// gSOAP looks for this table by its name. The one that it generates is for services; a document without namespaces
// needs an empty one.
Namespace namespaces[] = {{nullptr, nullptr, nullptr, nullptr}};

namespace varnex3::benchmarks {

struct GsoapQuote::Content
{
    std::unique_ptr<soap, decltype(&soap_free)> context{soap_new1(SOAP_XML_TREE | SOAP_C_UTFSTRING), &soap_free};
    Quote* quote = nullptr;

    ~Content()
    {
        soap_destroy(context.get());
        soap_end(context.get());
    }
};

GsoapQuote::GsoapQuote(std::string_view text) : content(std::make_unique<Content>())
{
    soap* const context = content->context.get();
    std::istringstream stream{std::string(text)};
    context->is = &stream;
    Quote* const quote = soap_new_Xalo_USCOREQuote(context);
    if (soap_read_Xalo_USCOREQuote(context, quote) == SOAP_OK)
        content->quote = quote;
    context->is = nullptr;
}

GsoapQuote::~GsoapQuote() = default;

std::size_t GsoapQuote::ItemCount() const
{
    const bool hasItems = content->quote && content->quote->QuoteItems_;
    return hasItems ? content->quote->QuoteItems_->QuoteItem_.size() : 0;
}

std::string GsoapQuote::Write() const
{
    soap* const context = content->context.get();
    std::ostringstream stream;
    context->os = &stream;
    if (content->quote)
        soap_write_Xalo_USCOREQuote(context, content->quote);
    context->os = nullptr;
    return stream.str();
}

} // namespace varnex3::benchmarks
