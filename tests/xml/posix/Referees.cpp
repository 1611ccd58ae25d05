#include "Referees.h"

#include <algorithm>
#include <array>
#include <memory>

#include <expat.h>
#include <libxml/parser.h>

namespace varnex3::xml::referees {
namespace {

// The bytes of windows-1252 from 0x80 on that are not the code point of the same number, as the web reads them: the
// five that are not assigned are control characters.
constexpr std::array<int, 32> kWindows1252 = {0x20AC, 0x81,   0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                              0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x8D,   0x017D, 0x8F,
                                              0x90,   0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                              0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x9D,   0x017E, 0x0178};

// Teaches expat the one encoding it lacks and the engine has.
int TeachWindows1252(void*, const XML_Char* name, XML_Encoding* encoding)
{
    std::string lower(name);
    std::ranges::transform(lower, lower.begin(), [](char c) { return c >= 'A' && c <= 'Z' ? char(c + 32) : c; });
    if (lower != "windows-1252")
        return XML_STATUS_ERROR;
    for (int i = 0; i < 256; ++i)
        encoding->map[i] = i;
    std::ranges::copy(kWindows1252, encoding->map + 0x80);
    return XML_STATUS_OK;
}

// libxml2 writes some errors to the console otherwise. NOLINTNEXTLINE(cert-dcl50-cpp): its type for the purpose
void Hush(void*, const char*, ...) {}

const char* Utf8(const xmlChar* text) { return text == nullptr ? "" : reinterpret_cast<const char*>(text); }

bool IsWhite(std::string_view text) { return text.find_first_not_of(" \t\r\n") == text.npos; }

std::string QualifiedName(const xmlNs* space, const xmlChar* name)
{
    return space != nullptr && space->prefix != nullptr ? std::string(Utf8(space->prefix)) + ":" + Utf8(name)
                                                        : Utf8(name);
}

std::string TakeText(xmlChar* text)
{
    std::string taken(Utf8(text));
    xmlFree(text);
    return taken;
}

bool IsDropped(const xmlNode* node)
{
    return node->type == XML_TEXT_NODE && IsWhite(Utf8(node->content)) && xmlNodeGetSpacePreserve(node->parent) != 1;
}

std::string TextOf(const xmlNode* node)
{
    if (node->type == XML_TEXT_NODE || node->type == XML_CDATA_SECTION_NODE)
        return IsDropped(node) ? "" : Utf8(node->content);
    std::string text;
    if (node->type == XML_ELEMENT_NODE)
        for (const xmlNode* child = node->children; child != nullptr; child = child->next)
            text += TextOf(child);
    return text;
}

// A line an element, in document order: name, attributes, text.
void List(const xmlNode* node, std::string& to)
{
    for (; node != nullptr; node = node->next) {
        if (node->type != XML_ELEMENT_NODE)
            continue;
        to += QualifiedName(node->ns, node->name);
        for (const xmlAttr* a = node->properties; a != nullptr; a = a->next)
            to += " @" + QualifiedName(a->ns, a->name) + "=" + TakeText(xmlNodeListGetString(a->doc, a->children, 1));
        to += " = " + TextOf(node) + "\n";
        List(node->children, to);
    }
}

} // namespace

Opinion AskExpat(std::string_view bytes)
{
    constexpr char kSeparator = '\1'; // no document holds it, so that expat refuses no namespace's name for it
    const std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser(XML_ParserCreateNS(nullptr, kSeparator),
                                                                              &XML_ParserFree);
    XML_SetUnknownEncodingHandler(parser.get(), TeachWindows1252, nullptr);
    XML_Parse(parser.get(), bytes.data(), static_cast<int>(bytes.size()), XML_TRUE);
    const XML_Error error = XML_GetErrorCode(parser.get());
    return {error == XML_ERROR_NONE, error, ""};
}

Opinion AskLibxml(std::string_view bytes)
{
    constexpr int kOptions = XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING | XML_PARSE_HUGE;
    xmlSetGenericErrorFunc(nullptr, Hush);
    const std::unique_ptr<xmlParserCtxt, decltype(&xmlFreeParserCtxt)> parser(xmlNewParserCtxt(), &xmlFreeParserCtxt);
    const std::unique_ptr<xmlDoc, decltype(&xmlFreeDoc)> document(
        xmlCtxtReadMemory(parser.get(), bytes.data(), static_cast<int>(bytes.size()), nullptr, nullptr, kOptions),
        &xmlFreeDoc);

    Opinion opinion;
    opinion.isAccepted = document && parser->wellFormed && parser->nsWellFormed;
    opinion.error = parser->lastError.code;
    if (opinion.isAccepted)
        List(xmlDocGetRootElement(document.get()), opinion.tree);
    return opinion;
}

} // namespace varnex3::xml::referees
