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
    std::int32_t Int32At(Name path) const;

    // A time stamp of an element that must be there: date and time of day, the zone dropped. Text that is no date
    // raises TypeMismatch.
    Date RequiredTimestampAt(Name path) const;

    // Every element of this tag name in the section, at any depth, in document order.
    xml::NodeList ElementsNamed(Name tagName) const;

    // The value of the first attribute of an element, whatever it is called; without one raises ObjectNotSet.
    Text FirstAttributeOf(const xml::Node& node) const;

    // Has a child record read the section at a path; an absent section is an empty document.
    template <class T>
    void ReadInto(const Child<T>& child, Name path) const;

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

template <class T>
void XmlSection::ReadInto(const Child<T>& child, Name path) const
{
    child->Read(XmlSection(Find(path), T::ClassName));
}

} // namespace varnex3
