#include "LibxmlQuote.h"

#include <libxml/parser.h>
#include <libxml/xmlwriter.h>

#include <cstdio>
#include <cstdlib>
#include <memory>

namespace varnex3::benchmarks {
namespace {

const xmlChar* X(const char* text) { return reinterpret_cast<const xmlChar*>(text); }

const char* C(const xmlChar* text) { return reinterpret_cast<const char*>(text); }

class Reader
{
public:
    explicit Reader(const xmlNode* root) : node(root) {}

    void Text(const char* name, std::string& value) { value = ValueOf(Child(name)); }
    void Amount(const char* name, double& value) { value = std::strtod(ValueOf(Child(name)).c_str(), nullptr); }
    void AmountIfPositive(const char* name, double& value) { Amount(name, value); }
    void Whole(const char* name, int& value) { value = std::atoi(ValueOf(Child(name)).c_str()); }
    void Flag(const char* name, bool& value) { value = Child(name) != nullptr; }
    void FlagWith(const char* name, const char* attribute, bool& value, std::string& about)
    {
        const xmlNode* const child = Child(name);
        value = child != nullptr;
        if (value)
            about = AttributeOf(child, attribute);
    }
    static bool Wants(const std::string&) { return true; }

    template <class Inside>
    void Group(const char* name, Inside inside)
    {
        const xmlNode* const outer = std::exchange(node, Child(name));
        inside();
        node = outer;
    }
    template <class Inside>
    void Case(const char* name, int& kind, int number, Inside inside)
    {
        if (!Child(name))
            return;
        kind = number;
        Group(name, inside);
    }
    template <class List, class Inside>
    void Each(const char* name, List& list, Inside inside)
    {
        const xmlNode* const outer = node;
        for (const xmlNode* each = Child(name); each; each = Find(each->next, name)) {
            node = each;
            inside(list.emplace_back());
        }
        node = outer;
    }
    template <class List>
    void Fields(const char* name, const char* attribute, List& list)
    {
        Each(name, list, [&](auto& field) {
            field.first = AttributeOf(node, attribute);
            field.second = ValueOf(node);
        });
    }

private:
    static const xmlNode* Find(const xmlNode* from, const char* name)
    {
        while (from && (from->type != XML_ELEMENT_NODE || xmlStrcmp(from->name, X(name)) != 0))
            from = from->next;
        return from;
    }
    const xmlNode* Child(const char* name) const { return node ? Find(node->children, name) : nullptr; }

    // The texts here are single nodes, unless they hold references.
    static std::string ValueOf(const xmlNode* element)
    {
        std::string value;
        for (const xmlNode* text = element ? element->children : nullptr; text; text = text->next)
            if (text->content)
                value += C(text->content);
        return value;
    }
    static std::string AttributeOf(const xmlNode* element, const char* name)
    {
        const std::unique_ptr<xmlChar, decltype(xmlFree)> value(xmlGetProp(element, X(name)), xmlFree);
        return value ? C(value.get()) : "";
    }

    const xmlNode* node;
};

class Writer
{
public:
    explicit Writer(xmlTextWriterPtr textWriter) : writer(textWriter) {}

    void Text(const char* name, const std::string& value)
    {
        if (!value.empty())
            xmlTextWriterWriteElement(writer, X(name), X(value.c_str()));
    }
    void Amount(const char* name, double value)
    {
        char digits[64];
        std::snprintf(digits, sizeof(digits), "%.2f", value);
        xmlTextWriterWriteElement(writer, X(name), X(digits));
    }
    void AmountIfPositive(const char* name, double value)
    {
        if (value > 0)
            Amount(name, value);
    }
    void Whole(const char* name, int value)
    {
        xmlTextWriterWriteElement(writer, X(name), X(std::to_string(value).c_str()));
    }
    void Flag(const char* name, bool value)
    {
        if (value)
            xmlTextWriterWriteElement(writer, X(name), nullptr);
    }
    void FlagWith(const char* name, const char* attribute, bool value, const std::string& about)
    {
        if (!value)
            return;
        xmlTextWriterStartElement(writer, X(name));
        xmlTextWriterWriteAttribute(writer, X(attribute), X(about.c_str()));
        xmlTextWriterEndElement(writer);
    }
    static bool Wants(const std::string& value) { return !value.empty(); }

    template <class Inside>
    void Group(const char* name, Inside inside)
    {
        xmlTextWriterStartElement(writer, X(name));
        inside();
        xmlTextWriterEndElement(writer);
    }
    template <class Inside>
    void Case(const char* name, int kind, int number, Inside inside)
    {
        if (kind == number)
            Group(name, inside);
    }
    template <class List, class Inside>
    void Each(const char* name, List& list, Inside inside)
    {
        for (auto& each : list)
            Group(name, [&] { inside(each); });
    }
    template <class List>
    void Fields(const char* name, const char* attribute, const List& list)
    {
        for (const auto& field : list) {
            xmlTextWriterStartElement(writer, X(name));
            xmlTextWriterWriteAttribute(writer, X(attribute), X(field.first.c_str()));
            xmlTextWriterWriteString(writer, X(field.second.c_str()));
            xmlTextWriterEndElement(writer);
        }
    }

private:
    xmlTextWriterPtr writer;
};

} // namespace

QuoteModel<std::string> ReadWithLibxml(std::string_view text)
{
    const std::unique_ptr<xmlDoc, decltype(&xmlFreeDoc)> document(
        xmlReadMemory(text.data(), static_cast<int>(text.size()), nullptr, nullptr,
                      XML_PARSE_NONET | XML_PARSE_NOBLANKS),
        &xmlFreeDoc);
    QuoteModel<std::string> quote;
    Reader reader(document ? xmlDocGetRootElement(document.get()) : nullptr);
    DescribeQuote(reader, quote);
    return quote;
}

std::string WriteWithLibxml(QuoteModel<std::string>& quote)
{
    const std::unique_ptr<xmlBuffer, decltype(&xmlBufferFree)> buffer(xmlBufferCreate(), &xmlBufferFree);
    const std::unique_ptr<xmlTextWriter, decltype(&xmlFreeTextWriter)> text(xmlNewTextWriterMemory(buffer.get(), 0),
                                                                            &xmlFreeTextWriter);
    xmlTextWriterSetIndent(text.get(), 1);
    xmlTextWriterSetIndentString(text.get(), X("\t"));
    xmlTextWriterStartDocument(text.get(), nullptr, "UTF-8", nullptr);
    xmlTextWriterStartElement(text.get(), X("Xalo_Quote"));
    Writer writer(text.get());
    DescribeQuote(writer, quote);
    xmlTextWriterEndDocument(text.get());
    xmlTextWriterFlush(text.get());
    return {C(xmlBufferContent(buffer.get())), static_cast<std::size_t>(xmlBufferLength(buffer.get()))};
}

} // namespace varnex3::benchmarks
