// One section of a message, as the record that reads it sees it: a document of its own whose root is the record's
// group element, read by verbs that say what an absent element means.
//
// A path begins at the section's own element: "Vehicle/RegistrationNo". In a section that is absent, or of another
// name, nothing is found.
#pragma once

#include <cstdint>

#include "varnex3/core/Date.h"
#include "varnex3/core/Record.h"
#include "varnex3/core/Text.h"
#include "varnex3/xml/Document.h"

namespace varnex3 {

class XmlSection
{
public:
    // The reader is the class whose ParseXML raises what goes wrong here.
    XmlSection(const xml::Node& element_, Name reader_) : element(element_), reader(reader_) {}

    // Loads a text and has a record read it. A text that is not well-formed is an empty document.
    template <class T>
    static void ReadText(T& record, TextView text);

    // Text of an element; absent gives "".
    Text TextAt(Name path) const;
    // Text of an element that must be there; an absent one raises ObjectNotSet.
    Text RequiredTextAt(Name path) const;

    // Number of an element; absent gives 0, text that is no number raises TypeMismatch, the empty text too.
    double NumberAt(Name path) const;
    std::int16_t Int16At(Name path) const;
    std::int32_t Int32At(Name path) const;

    // Whether there is such an element, whatever it holds.
    bool Has(Name path) const;

    // A time stamp: date and time of day, the zone dropped. Text that is no date raises TypeMismatch, and so does the
    // empty text of an element that is absent.
    Date TimestampAt(Name path) const;
    // The same, but the empty text, an absent element's too, gives what stands for it.
    Date TimestampAt(Name path, Date otherwise) const;

    // A time stamp of an element that must be there: date and time of day, the zone dropped. Text that is no date
    // raises TypeMismatch.
    Date RequiredTimestampAt(Name path) const;

    // Every element that the path leads to, in document order.
    xml::NodeList NodesAt(Name path) const;

    // The first node inside an element, a text or a comment too; an absent one when there is none.
    xml::Node FirstChildOf(Name path) const;

    // Every element of this tag name in the section, at any depth, in document order.
    xml::NodeList ElementsNamed(Name tagName) const;

    // The value of the first attribute of an element, whatever it is called; without one raises ObjectNotSet.
    Text FirstAttributeOf(const xml::Node& node) const;

    // Has a child record read the section at a path; an absent section is an empty document.
    template <class T, Ref<T> (*Make)()>
    void ReadInto(const Child<T, Make>& child, Name path) const;

    // The same, but no child is made to read an absent section, for records that an empty document leaves as they are
    // made: whether they read it or are made later is the same. Returns whether the section is there.
    template <class T, Ref<T> (*Make)()>
    bool ReadIntoWhereUsed(const Child<T, Make>& child, Name path) const;

    // Has a child record read a section that must be there; an absent one raises ObjectNotSet.
    template <class T>
    void ReadRequiredInto(const Child<T>& child, Name path) const;

private:
    xml::Node Find(Name path) const;
    xml::Node Require(Name path) const;
    template <class Convert>
    auto Converted(Name path, TextView text, Convert convert) const;

    xml::Node element;
    Name reader;
};

template <class T>
void XmlSection::ReadText(T& record, TextView text)
{
    xml::Document document;
    document.LoadText(text);
    record.Read(XmlSection(document.DocumentElement(), T::ClassName));
}

template <class T, Ref<T> (*Make)()>
void XmlSection::ReadInto(const Child<T, Make>& child, Name path) const
{
    child->Read(XmlSection(Find(path), T::ClassName));
}

template <class T>
void XmlSection::ReadRequiredInto(const Child<T>& child, Name path) const
{
    child->Read(XmlSection(Require(path), T::ClassName));
}

template <class T, Ref<T> (*Make)()>
bool XmlSection::ReadIntoWhereUsed(const Child<T, Make>& child, Name path) const
{
    const xml::Node section = Find(path);
    if (section || child.IsMade())
        child->Read(XmlSection(section, T::ClassName));
    return static_cast<bool>(section);
}

} // namespace varnex3
