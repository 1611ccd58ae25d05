// One section of a message, as the record that reads it sees it: a document of its own whose root is the record's
// group element, read by verbs that say what an absent element means.
//
// A path begins at the section's own element: "Vehicle/RegistrationNo". In a section that is absent, or of another
// name, nothing is found.
#pragma once

#include <cstdint>
#include <optional>

#include "varnex3/core/Date.h"
#include "varnex3/core/ElementPath.h"
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
    Text TextAt(ElementPath path) const;
    // Text of an element that must be there; an absent one raises ObjectNotSet.
    Text RequiredTextAt(ElementPath path) const;

    // Number of an element; absent gives 0, text that is no number raises TypeMismatch, the empty text too.
    double NumberAt(ElementPath path) const;
    std::int16_t Int16At(ElementPath path) const;
    std::int32_t Int32At(ElementPath path) const;

    // Whether there is such an element, whatever it holds.
    bool Has(ElementPath path) const;

    // A time stamp: date and time of day, the zone dropped. Text that is no date raises TypeMismatch, and so does the
    // empty text of an element that is absent.
    Date TimestampAt(ElementPath path) const;
    // The same, but the empty text, an absent element's too, gives what stands for it.
    Date TimestampAt(ElementPath path, Date otherwise) const;

    // A time stamp of an element that must be there: date and time of day, the zone dropped. Text that is no date
    // raises TypeMismatch.
    Date RequiredTimestampAt(ElementPath path) const;

    // Every element that the path leads to, in document order.
    xml::NodeList NodesAt(ElementPath path) const;

    // The first node inside an element, a text or a comment too; an absent one when there is none.
    xml::Node FirstChildOf(ElementPath path) const;

    // Every element of this tag name in the section, at any depth, in document order.
    xml::NodeList ElementsNamed(Name tagName) const;

    // The value of the first attribute of an element, whatever it is called; without one raises ObjectNotSet.
    Text FirstAttributeOf(const xml::Node& node) const;

    // The same of an element that must be there; an absent one raises ObjectNotSet, too.
    Text RequiredFirstAttributeAt(ElementPath path) const { return FirstAttributeOf(Require(path)); }

    // Has a child record read the section at a path; an absent section is an empty document.
    template <class T, Ref<T> (*Make)()>
    void ReadInto(const Child<T, Make>& child, ElementPath path) const;

    // The same, but no child is made to read an absent section, for records that an empty document leaves as they are
    // made: whether they read it or are made later is the same. Returns whether the section is there.
    template <class T, Ref<T> (*Make)()>
    bool ReadIntoWhereUsed(const Child<T, Make>& child, ElementPath path) const;

    // Has a child record read a section that must be there; an absent one raises ObjectNotSet.
    template <class T>
    void ReadRequiredInto(const Child<T>& child, ElementPath path) const;

private:
    xml::Node Find(ElementPath path) const;
    xml::Node Require(ElementPath path) const;
    template <class Convert>
    auto Converted(ElementPath path, TextView text, Convert convert) const;
    template <class Convert>
    auto ConvertedOrZero(ElementPath path, Convert convert) const;

    bool BeginsHere(ElementPath path) const;
    const xml::ChildElements& Children() const;

    xml::Node element;
    Name reader;

    // What was found out about the element: nearly every path begins alike, and half of them lead to what is not there.
    mutable Name lastGroup;
    mutable bool isLastGroup = false;
    mutable std::optional<xml::ChildElements> children;
};

template <class T>
void XmlSection::ReadText(T& record, TextView text)
{
    xml::Document document;
    document.LoadText(text);
    const RecordRoom room(text.size()); // a record takes about as many bytes as its text has characters
    record.Read(XmlSection(document.DocumentElement(), T::ClassName));
}

template <class T, Ref<T> (*Make)()>
void XmlSection::ReadInto(const Child<T, Make>& child, ElementPath path) const
{
    child->Read(XmlSection(Find(path), T::ClassName));
}

template <class T>
void XmlSection::ReadRequiredInto(const Child<T>& child, ElementPath path) const
{
    child->Read(XmlSection(Require(path), T::ClassName));
}

template <class T, Ref<T> (*Make)()>
bool XmlSection::ReadIntoWhereUsed(const Child<T, Make>& child, ElementPath path) const
{
    const xml::Node section = Find(path);
    if (section || child.IsMade())
        child->Read(XmlSection(section, T::ClassName));
    return static_cast<bool>(section);
}

} // namespace varnex3
