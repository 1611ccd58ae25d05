// A message is parsed once and read through its sections. What comes out, values and errors, is what comes out when
// each section is cut out as text and loaded again by its record.
#pragma once

#include <random>

#include "tests/Printing.h"
#include "varnex3/core/Json.h"
#include "varnex3/core/modGeneral.h"

namespace varnex3::tests {

struct SectionForm
{
    Name property;
    Text element;
    Text least;               // what must be in it to be read
    std::vector<Text> inside; // elements that may be in it, at any depth
};

using SectionForms = std::vector<SectionForm>;

// The sections that all of these messages begin with.
inline SectionForms Envelope()
{
    return {
        {"VersionField", u"Version", u"", {u"XaloVersion"}},
        {"SourceField",
         u"Source",
         u"<OrgType/><AppVersion>1</AppVersion><AppName> </AppName><TimeStamp>2004-05-06</TimeStamp>",
         {u"OrgType", u"AppName", u"TimeStamp"}},
        {"DestinationField", u"Destination", u"<OrgType>&#32;</OrgType>", {u"OrgType"}},
        {"InsurerField", u"Insurer", u"<UnderwriterName>U</UnderwriterName>", {u"UnderwriterName", u"InsurerDetail"}},
        {"RepairerField",
         u"Repairer",
         u"<RepairerID>1</RepairerID><RepairerName/>",
         {u"RepairerID", u"RepairerName", u"Repairer"}},
        {"ClaimHeaderField", u"ClaimHeader", u"", {u"VehicleID", u"InsuranceClaimNo", u"ReinstatementNo"}},
    };
}

inline SectionForm Vehicle() { return {"VehicleField", u"Vehicle", u"", {u"Make", u"Vehicle", u"Description"}}; }

// Texts of sections in which what could make a difference comes together: white space and xml:space, prefixes,
// comments, CDATA, references, repeated and nested elements, values of every type and of none.
class Texts
{
public:
    explicit Texts(unsigned seed) : random(seed) {}

    std::size_t Below(std::size_t limit) { return random() % limit; }

    Text Section(const SectionForm& form)
    {
        if (Below(12) == 0)
            return {};
        const Text pieces = Pieces(form.inside, 0);
        const Text content = Below(2) == 0 ? form.least + pieces : pieces + form.least;
        return u"<" + form.element + Attributes() + u">" + content + u"</" + form.element + u">";
    }

private:
    Text Pieces(const std::vector<Text>& names, int depth)
    {
        static const Text between[] = {u"", u"\r\n\t ", u"<!-- c -->", u"<?p i?>", u"text"};
        Text text;
        for (std::size_t count = Below(4); count > 0; --count)
            text += between[Below(std::size(between))] + Element(names, depth);
        return text;
    }

    Text Element(const std::vector<Text>& names, int depth)
    {
        const Text name = (Below(20) == 0 ? u"p:" : u"") + names[Below(names.size())];
        const Text content = depth < 3 && Below(3) == 0 ? Pieces(names, depth + 1) : Value();
        return content.empty() ? u"<" + name + Attributes() + u"/>"
                               : u"<" + name + Attributes() + u">" + content + u"</" + name + u">";
    }

    Text Attributes()
    {
        static const Text attributes[] = {u"",
                                          u"",
                                          u"",
                                          u" a=\"1\"",
                                          u" xml:space=\"preserve\"",
                                          u" xml:space=\"default\"",
                                          u" xmlns:q=\"urn:q\" FieldName='f&lt;'"};
        return attributes[Below(std::size(attributes))];
    }

    Text Value()
    {
        static const Text numbers[] = {u"1", u"2.5", u"7", u"0", u"1<!-- 0 -->2", u"<![CDATA[3]]>", u" 4 "};
        static const Text others[] = {
            u"",  u" ",  u"&#32;",     u"\r\n",        u"<![CDATA[ ]]>", u"2004-05-06T10:00:00+10:00",
            u"A", u"CP", u"&lt;&amp;", u"é€\U0001F600"};
        return Below(10) != 0 ? numbers[Below(std::size(numbers))] : others[Below(std::size(others))];
    }

    std::mt19937 random;
};

struct Outcome
{
    std::string error; // "none", or what was raised
    std::string json;  // every section
};

template <class Read>
Outcome OutcomeOf(Record& message, const SectionForms& forms, Read read)
{
    Outcome outcome{"none", {}};
    try {
        read();
    } catch (const Error& error) {
        outcome.error = error.what();
    }
    for (const SectionForm& form : forms)
        outcome.json += ToJson(*std::get<Ref<Record>>(Get(message, form.property))) + "\n";
    return outcome;
}

template <class Message>
Outcome ReadWhole(const SectionForms& forms, const Text& text)
{
    const auto message = New<Message>();
    return OutcomeOf(*message, forms, [&] { XmlSection::ReadText(*message, text); });
}

template <class Message>
Outcome ReadByFragments(const SectionForms& forms, const Text& text)
{
    const auto message = New<Message>();
    xml::Document document;
    document.LoadText(text);
    return OutcomeOf(*message, forms, [&] {
        for (const SectionForm& form : forms) {
            Variant markup = GetNodeXML(document.Root(), ToText(Message::ClassName) + u"/" + form.element);
            Call(*std::get<Ref<Record>>(Get(*message, form.property)), "ParseXML", {&markup, 1});
        }
    });
}

// Both readings of many texts; how many of them were read to the end, and how many were not.
template <class Message>
std::pair<int, int> CompareReadings(const SectionForms& forms, const Text& own, unsigned seed)
{
    Texts texts(seed);
    int read = 0;
    int failed = 0;
    for (int i = 0; i < 1500; ++i) {
        Text text = u"<" + ToText(Message::ClassName) + u" xmlns:p=\"urn:p\""
                    + (texts.Below(4) == 0 ? u" xml:space=\"preserve\">" : u">") + own;
        for (const SectionForm& form : forms)
            text += texts.Section(form);
        text += u"</" + ToText(Message::ClassName) + u">";
        CAPTURE(text);
        const Outcome whole = ReadWhole<Message>(forms, text);
        const Outcome byFragments = ReadByFragments<Message>(forms, text);
        CHECK(whole.error == byFragments.error);
        CHECK(whole.json == byFragments.json);
        ++(whole.error == "none" ? read : failed);
    }
    return {read, failed};
}

// Each section varied alone, in a message that otherwise has just what it must have.
template <class Message>
void CompareSections(const SectionForms& forms, const Text& own)
{
    Texts texts(5);
    for (const SectionForm& varied : forms) {
        CAPTURE(std::string(varied.property));
        int different = 0;
        for (int i = 0; i < 200; ++i) {
            Text text = u"<" + ToText(Message::ClassName) + u" xmlns:p=\"urn:p\">" + own;
            for (const SectionForm& form : forms)
                text += &form == &varied ? texts.Section(form)
                                         : u"<" + form.element + u">" + form.least + u"</" + form.element + u">";
            text += u"</" + ToText(Message::ClassName) + u">";
            const Outcome whole = ReadWhole<Message>(forms, text);
            const Outcome byFragments = ReadByFragments<Message>(forms, text);
            different += whole.error != byFragments.error || whole.json != byFragments.json;
        }
        CHECK(different == 0);
    }
}

} // namespace varnex3::tests
