// Fills records of any class with values, by their interface tables alone: what a test of a thousand messages reads.
//
//     RecordGenerator generator(seed);
//     generator.Let("VehicleDetailsDefOdometer.OdometerReading", [](RecordGenerator& any) { return any.NumberText();
//     }); generator.Fill(*quote);
//
// The same seed gives the same record. Texts hold letters, signs and characters beyond 16 bits, but none that markup
// means something by; amounts have two decimals; dates lie between 1900 and 2064, whole seconds.
#pragma once

#include <functional>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "varnex3/core/Interface.h"

namespace varnex3::tests {

class RecordGenerator
{
public:
    // How much is set differs from one record to the next: some are nearly empty, some are full.
    explicit RecordGenerator(unsigned seed) : random(seed), fullness(std::vector{0.1, 0.5, 0.9, 1.0}[seed % 4]) {}

    // For a member, "Class.Member", whose type does not say all that its values have to be.
    using Source = std::function<Variant(RecordGenerator&)>;
    void Let(const std::string& member, Source source) { sources[member] = std::move(source); }

    // Sets some of the properties that can be set, fills every child, and adds to a list what it can hold.
    void Fill(Record& record)
    {
        for (const Member& member : record.Class().members) {
            if (member.type.kind == Kind::Object && member.IsProperty() && !member.IsIndexed())
                Fill(*std::get<Ref<Record>>(Get(record, member.name)));
            else if (member.IsProperty() && !member.IsIndexed() && member.IsWritable() && Chance(fullness))
                Put(record, member.name, ValueFor(record.Class(), member));
            else if (member.name == "Add")
                AddSome(record, member);
        }
    }

    std::int32_t Between(std::int32_t least, std::int32_t most)
    {
        return std::uniform_int_distribution<std::int32_t>(least, most)(random);
    }

    Text SomeText()
    {
        static const std::vector<Text> pieces = {u"Front bumper", u"O'Neill", u"x",      u"Z\u00FCrich",
                                                 u"100 %",        u"4>3",     u"\u65E5", u"\U0001F697",
                                                 u" (left)",      u"a/b #1;"};
        Text text = pieces[static_cast<std::size_t>(Between(0, 2))]; // never blanks alone
        for (std::int32_t more = Between(0, 3); more > 0; --more)
            text += pieces[static_cast<std::size_t>(Between(0, static_cast<std::int32_t>(pieces.size()) - 1))];
        return text;
    }

    // For what is escaped when it is written.
    Text AnyText() { return SomeText() + u"<&>\"'&amp;]]>"; }

    Text NumberText() { return ToUtf16(std::to_string(Between(-10, 300000))); }

    double Amount() { return Between(-100000, 100000000) / 100.0; }

    Date SomeDate() { return {Between(1, 60000) + Between(0, 86399) / 86400.0}; }

private:
    bool Chance(double ofOne) { return std::uniform_real_distribution<>(0, 1)(random) < ofOne; }

    Variant ValueFor(const ClassInfo& info, const Member& member)
    {
        const auto source = sources.find(std::string(info.name) + "." + std::string(member.name));
        return source == sources.end() ? ValueOf(member.type) : source->second(*this);
    }

    Variant ValueOf(const Type& type)
    {
        switch (type.kind) {
        case Kind::Text:
            return SomeText();
        case Kind::Double:
            return Amount();
        case Kind::Date:
            return SomeDate();
        case Kind::Int16:
            return Between(-32768, 32767);
        case Kind::Int32:
            return Between(-2147483647, 2147483647);
        case Kind::Boolean:
            return Chance(0.5);
        case Kind::Enumeration:
            return type.enumeration->values[static_cast<std::size_t>(Between(0, Last(*type.enumeration)))].value;
        default:
            return Empty;
        }
    }

    static std::int32_t Last(const EnumInfo& enumeration)
    {
        return static_cast<std::int32_t>(enumeration.values.size()) - 1;
    }

    // A list of records gives the new one to fill; a list of texts takes them, its keys all different.
    void AddSome(Record& list, const Member& add)
    {
        for (std::int32_t i = Between(0, 5); i > 0 && Chance(fullness); --i) {
            std::vector<Variant> arguments;
            for (const Parameter& parameter : add.Parameters())
                arguments.push_back(arguments.empty() ? Variant(SomeText() + ToUtf16(std::to_string(i)))
                                                      : ValueOf(parameter.type));
            const Variant added = Call(list, add.name, arguments);
            if (const auto* const record = std::get_if<Ref<Record>>(&added))
                Fill(**record);
        }
    }

    std::mt19937 random;
    double fullness;
    std::map<std::string, Source> sources;
};

} // namespace varnex3::tests
