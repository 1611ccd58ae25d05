#include "PugixmlQuote.h"

#include <pugixml.hpp>

#include <cstdio>

#include "varnex3/xml/Unicode.h"

namespace varnex3::benchmarks {
namespace {

void Assign(std::string& to, const char* text) { to = text; }

void Assign(std::u16string& to, const char* text) { to = xml::ToUtf16(text); }

class Reader
{
public:
    explicit Reader(pugi::xml_node root) : node(root) {}

    template <class String>
    void Text(const char* name, String& value)
    {
        Assign(value, node.child_value(name));
    }
    void Amount(const char* name, double& value) { value = node.child(name).text().as_double(); }
    void AmountIfPositive(const char* name, double& value) { Amount(name, value); }
    void Whole(const char* name, int& value) { value = node.child(name).text().as_int(); }
    void Flag(const char* name, bool& value) { value = static_cast<bool>(node.child(name)); }
    template <class String>
    void FlagWith(const char* name, const char* attribute, bool& value, String& about)
    {
        Flag(name, value);
        if (value)
            Assign(about, node.child(name).attribute(attribute).value());
    }
    template <class String>
    bool Wants(const String&)
    {
        return true;
    }

    template <class Inside>
    void Group(const char* name, Inside inside)
    {
        const pugi::xml_node outer = std::exchange(node, node.child(name));
        inside();
        node = outer;
    }
    template <class Inside>
    void Case(const char* name, int& kind, int number, Inside inside)
    {
        if (!node.child(name))
            return;
        kind = number;
        Group(name, inside);
    }
    template <class List, class Inside>
    void Each(const char* name, List& list, Inside inside)
    {
        const pugi::xml_node outer = node;
        for (const pugi::xml_node each : outer.children(name)) {
            node = each;
            inside(list.emplace_back());
        }
        node = outer;
    }
    template <class List>
    void Fields(const char* name, const char* attribute, List& list)
    {
        Each(name, list, [&](auto& field) {
            Assign(field.first, node.attribute(attribute).value());
            Assign(field.second, node.child_value());
        });
    }

private:
    pugi::xml_node node;
};

class Writer
{
public:
    explicit Writer(pugi::xml_node root) : node(root) {}

    void Text(const char* name, const std::string& value)
    {
        if (!value.empty())
            node.append_child(name).text().set(value.c_str());
    }
    void Amount(const char* name, double value)
    {
        char digits[64];
        std::snprintf(digits, sizeof(digits), "%.2f", value);
        node.append_child(name).text().set(digits);
    }
    void AmountIfPositive(const char* name, double value)
    {
        if (value > 0)
            Amount(name, value);
    }
    void Whole(const char* name, int value) { node.append_child(name).text().set(value); }
    void Flag(const char* name, bool value)
    {
        if (value)
            node.append_child(name);
    }
    void FlagWith(const char* name, const char* attribute, bool value, const std::string& about)
    {
        if (value)
            node.append_child(name).append_attribute(attribute).set_value(about.c_str());
    }
    static bool Wants(const std::string& value) { return !value.empty(); }

    template <class Inside>
    void Group(const char* name, Inside inside)
    {
        const pugi::xml_node outer = std::exchange(node, node.append_child(name));
        inside();
        node = outer;
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
            pugi::xml_node element = node.append_child(name);
            element.append_attribute(attribute).set_value(field.first.c_str());
            element.text().set(field.second.c_str());
        }
    }

private:
    pugi::xml_node node;
};

struct StringWriter final : pugi::xml_writer
{
    void write(const void* data, std::size_t size) override { text.append(static_cast<const char*>(data), size); }
    std::string text;
};

template <class String>
QuoteModel<String> Mapped(const pugi::xml_document& document)
{
    QuoteModel<String> quote;
    Reader reader(document.child("Xalo_Quote"));
    DescribeQuote(reader, quote);
    return quote;
}

} // namespace

QuoteModel<std::string> ReadWithPugixml(std::string_view text)
{
    pugi::xml_document document;
    document.load_buffer(text.data(), text.size());
    return Mapped<std::string>(document);
}

QuoteModel<std::u16string> ReadWithPugixml(std::u16string_view text)
{
    pugi::xml_document document;
    document.load_buffer(text.data(), text.size() * sizeof(char16_t), pugi::parse_default, pugi::encoding_utf16_le);
    return Mapped<std::u16string>(document);
}

std::string WriteWithPugixml(QuoteModel<std::string>& quote)
{
    pugi::xml_document document;
    pugi::xml_node root = document.append_child("Xalo_Quote");
    root.append_attribute("xmlns:xsi").set_value("http://www.w3.org/2001/XMLSchema-instance");
    root.append_attribute("xsi:noNamespaceSchemaLocation").set_value("Xalo_Quote.xsd");
    Writer writer(root);
    DescribeQuote(writer, quote);
    StringWriter result;
    document.save(result);
    return std::move(result.text);
}

} // namespace varnex3::benchmarks
