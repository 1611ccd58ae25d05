#include "ExpatQuote.h"

#include <expat.h>

#include <cstdlib>
#include <functional>
#include <map>
#include <memory>

namespace varnex3::benchmarks {
namespace {

using Item = ItemModel<std::string>;
using Field = std::pair<std::string, std::string>;

// What an element means: where its values go, counted in bytes from the structure that its group fills, and what may
// stand inside it. One tree of these is made for the whole message, once.
struct Place
{
    enum class Kind
    {
        Group,
        Text,
        Amount,
        Whole,
        Flag,
        FlagWith,
        Item,
        Field,
    };

    Kind kind = Kind::Group;
    std::size_t offset = 0;
    std::size_t attributeOffset = 0;
    int number = -1; // of a kind of work; it goes where the offset says
    std::map<std::string, Place, std::less<>> inside;

    const Place* Find(std::string_view name) const
    {
        const auto found = inside.find(name);
        return found == inside.end() ? nullptr : &found->second;
    }
};

// Is led through an empty message and notes where everything is.
class Surveyor
{
public:
    Surveyor(Place& root, const void* base) : place(&root), start(static_cast<const char*>(base)) {}

    void Text(const char* name, const std::string& value) { Note(name, Place::Kind::Text, &value); }
    void Amount(const char* name, const double& value) { Note(name, Place::Kind::Amount, &value); }
    void AmountIfPositive(const char* name, const double& value) { Amount(name, value); }
    void Whole(const char* name, const int& value) { Note(name, Place::Kind::Whole, &value); }
    void Flag(const char* name, const bool& value) { Note(name, Place::Kind::Flag, &value); }
    void FlagWith(const char* name, const char* /*attribute*/, const bool& value, const std::string& about)
    {
        Note(name, Place::Kind::FlagWith, &value).attributeOffset = OffsetOf(&about);
    }
    static bool Wants(const std::string&) { return true; }

    template <class Inside>
    void Group(const char* name, Inside inside)
    {
        Place* const outer = std::exchange(place, &place->inside[name]);
        inside();
        place = outer;
    }
    template <class Inside>
    void Case(const char* name, const int& kind, int number, Inside inside)
    {
        Note(name, Place::Kind::Group, &kind).number = number;
        Group(name, inside);
    }
    template <class Inside>
    void Each(const char* name, std::vector<Item>& list, Inside inside)
    {
        Item item;
        Note(name, Place::Kind::Item, &list);
        const char* const outer = std::exchange(start, reinterpret_cast<const char*>(&item));
        Group(name, [&] { inside(item); });
        start = outer;
    }
    void Fields(const char* name, const char* /*attribute*/, const std::vector<Field>& list)
    {
        Note(name, Place::Kind::Field, &list);
    }

private:
    std::size_t OffsetOf(const void* value) const
    {
        return static_cast<std::size_t>(static_cast<const char*>(value) - start);
    }
    Place& Note(const char* name, Place::Kind kind, const void* value)
    {
        Place& noted = place->inside[name];
        noted.kind = kind;
        noted.offset = OffsetOf(value);
        return noted;
    }

    Place* place;
    const char* start;
};

const Place& PlacesOfQuote()
{
    static const Place places = [] {
        Place root;
        QuoteModel<std::string> empty;
        Surveyor surveyor(root, &empty);
        surveyor.Group("Xalo_Quote", [&] { DescribeQuote(surveyor, empty); });
        return root;
    }();
    return places;
}

// Follows the events through the places. Inside what has none nothing is looked for.
class Reader
{
public:
    explicit Reader(QuoteModel<std::string>& quote) { open.push_back({&PlacesOfQuote(), &quote}); }

    void Start(const char* name, const char** attributes)
    {
        const Open& outer = open.back();
        const Place* const place = outer.place ? outer.place->Find(name) : nullptr;
        open.push_back({place, place ? Enter(*place, outer.base, attributes) : nullptr});
        text.clear();
    }
    void Take(std::string_view characters) { text += characters; }
    void End()
    {
        const Open ended = open.back();
        open.pop_back();
        if (ended.place)
            Store(*ended.place, ended.base);
        text.clear();
    }

private:
    struct Open
    {
        const Place* place;
        void* base; // the structure that is filled
    };

    template <class T>
    static T& At(void* base, std::size_t offset)
    {
        return *reinterpret_cast<T*>(static_cast<char*>(base) + offset);
    }

    // Gives the structure that what stands inside the element fills.
    static void* Enter(const Place& place, void* base, const char** attributes)
    {
        switch (place.kind) {
        case Place::Kind::Flag:
        case Place::Kind::FlagWith:
            At<bool>(base, place.offset) = true;
            if (place.kind == Place::Kind::FlagWith && attributes[0])
                At<std::string>(base, place.attributeOffset) = attributes[1];
            return base;
        case Place::Kind::Item:
            return &At<std::vector<Item>>(base, place.offset).emplace_back();
        case Place::Kind::Field:
            return &At<std::vector<Field>>(base, place.offset).emplace_back(attributes[0] ? attributes[1] : "", "");
        case Place::Kind::Group:
            if (place.number >= 0)
                At<int>(base, place.offset) = place.number;
            return base;
        default:
            return base;
        }
    }

    void Store(const Place& place, void* base) const
    {
        switch (place.kind) {
        case Place::Kind::Text:
            At<std::string>(base, place.offset) = text;
            break;
        case Place::Kind::Amount:
            At<double>(base, place.offset) = std::strtod(text.c_str(), nullptr);
            break;
        case Place::Kind::Whole:
            At<int>(base, place.offset) = std::atoi(text.c_str());
            break;
        case Place::Kind::Field:
            static_cast<Field*>(base)->second = text;
            break;
        default:
            break;
        }
    }

    std::vector<Open> open;
    std::string text;
};

void OnStart(void* reader, const XML_Char* name, const XML_Char** attributes)
{
    static_cast<Reader*>(reader)->Start(name, attributes);
}

void OnEnd(void* reader, const XML_Char* /*name*/) { static_cast<Reader*>(reader)->End(); }

void OnText(void* reader, const XML_Char* characters, int length)
{
    static_cast<Reader*>(reader)->Take({characters, static_cast<std::size_t>(length)});
}

} // namespace

QuoteModel<std::string> ReadWithExpat(std::string_view text)
{
    const std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser(XML_ParserCreate(nullptr),
                                                                              &XML_ParserFree);
    QuoteModel<std::string> quote;
    Reader reader(quote);
    XML_SetUserData(parser.get(), &reader);
    XML_SetElementHandler(parser.get(), OnStart, OnEnd);
    XML_SetCharacterDataHandler(parser.get(), OnText);
    if (XML_Parse(parser.get(), text.data(), static_cast<int>(text.size()), XML_TRUE) != XML_STATUS_OK)
        return {};
    return quote;
}

} // namespace varnex3::benchmarks
