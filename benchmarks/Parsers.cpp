#include "Parsers.h"

#include <expat.h>
#include <libxml/parser.h>
#include <pugixml.hpp>
#include <rapidxml/rapidxml.hpp>

#include <memory>
#include <string>

#include "varnex3/xml/Document.h"

namespace varnex3::benchmarks {

bool ParseUtf8(std::string_view text)
{
    xml::Document document;
    return document.LoadBytes(text);
}

bool ParseUtf16(std::u16string_view text)
{
    xml::Document document;
    return document.LoadText(text);
}

bool ParseWithPugixml(std::string_view text)
{
    pugi::xml_document document;
    return static_cast<bool>(document.load_buffer(text.data(), text.size()));
}

bool ParseWithRapidxml(std::string_view text)
{
    std::string copy(text); // it parses in place
    rapidxml::xml_document<char> document;
    document.parse<rapidxml::parse_default>(copy.data());
    return document.first_node() != nullptr;
}

bool ParseWithLibxml(std::string_view text)
{
    const std::unique_ptr<xmlDoc, decltype(&xmlFreeDoc)> document(
        xmlReadMemory(text.data(), static_cast<int>(text.size()), nullptr, nullptr, XML_PARSE_NONET), &xmlFreeDoc);
    return document != nullptr;
}

bool ParseWithExpat(std::string_view text)
{
    const std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser(XML_ParserCreate(nullptr),
                                                                              &XML_ParserFree);
    XML_SetElementHandler(
        parser.get(), [](void*, const XML_Char*, const XML_Char**) {}, [](void*, const XML_Char*) {});
    XML_SetCharacterDataHandler(parser.get(), [](void*, const XML_Char*, int) {});
    return XML_Parse(parser.get(), text.data(), static_cast<int>(text.size()), XML_TRUE) == XML_STATUS_OK;
}

} // namespace varnex3::benchmarks
