// Resolving references and line ends.
#include "varnex3/xml/References.h"

#include "varnex3/xml/Characters.h"

namespace varnex3::xml {
namespace {

struct Entity
{
    std::string_view name;
    char32_t character;
};

constexpr Entity predefinedEntities[] = {{"lt", '<'}, {"gt", '>'}, {"amp", '&'}, {"quot", '"'}, {"apos", '\''}};

template <class Char>
char32_t EntityNamed(std::basic_string_view<Char> name)
{
    for (const Entity& entity : predefinedEntities)
        if (EqualsAscii(name, entity.name))
            return entity.character;
    return 0;
}

template <class Char>
char32_t DigitValue(Char c)
{
    return IsDigit(c) ? Unit(c) - '0' : (Unit(c) | 0x20) - 'a' + 10;
}

// A number beyond Unicode stays beyond it, however many digits it has.
template <class Char>
char32_t NumberIn(std::basic_string_view<Char> digits, char32_t base)
{
    char32_t number = 0;
    for (const Char c : digits)
        number = number > 0x10FFFF ? number : number * base + DigitValue(c);
    return number;
}

// The place of the first character that is not itself.
template <class Char>
std::size_t FindSpecial(std::basic_string_view<Char> raw, bool areReferencesMeant, bool isAttribute)
{
    std::size_t at = 0;
    for (; at < raw.size(); ++at) {
        const Char c = raw[at];
        if (c == '\r' || (c == '&' && areReferencesMeant) || (isAttribute && (c == '\n' || c == '\t')))
            break;
    }
    return at;
}

template <class Char>
void AppendResolved(std::u16string& to, std::basic_string_view<Char> raw, bool areReferencesMeant, bool isAttribute)
{
    while (!raw.empty()) {
        const std::size_t plain = FindSpecial(raw, areReferencesMeant, isAttribute);
        AppendPlain(to, raw.substr(0, plain));
        raw.remove_prefix(plain);
        if (raw.empty())
            return;

        std::size_t length = 1;
        if (raw[0] == '&') {
            const Reference reference = ReadReference(raw);
            AppendPoint(to, reference.character);
            length = reference.length;
        } else {
            to += isAttribute ? u' ' : u'\n';
            length = raw[0] == '\r' && raw.size() > 1 && raw[1] == '\n' ? 2 : 1;
        }
        raw.remove_prefix(length);
    }
}

} // namespace

template <class Char>
Reference ReadReference(std::basic_string_view<Char> from)
{
    const std::size_t length = from.find(Char{';'}) + 1;
    const std::basic_string_view<Char> body = from.substr(1, length - 2);
    if (body[0] != '#')
        return {EntityNamed(body), length};
    if (body[1] == 'x')
        return {NumberIn(body.substr(2), 16), length};
    return {NumberIn(body.substr(1), 10), length};
}

template <class Char>
void AppendContent(std::u16string& to, std::basic_string_view<Char> raw, NodeType type)
{
    const bool areReferencesMeant = type == NodeType::Element || type == NodeType::Text;
    AppendResolved(to, raw, areReferencesMeant, false);
}

template <class Char>
void AppendAttributeValue(std::u16string& to, std::basic_string_view<Char> raw)
{
    AppendResolved(to, raw, true, true);
}

template Reference ReadReference(std::string_view);
template Reference ReadReference(std::u16string_view);
template void AppendContent(std::u16string&, std::string_view, NodeType);
template void AppendContent(std::u16string&, std::u16string_view, NodeType);
template void AppendAttributeValue(std::u16string&, std::string_view);
template void AppendAttributeValue(std::u16string&, std::u16string_view);

} // namespace varnex3::xml
