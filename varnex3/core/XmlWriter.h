// Writes the lines of a record, each by a verb that says when the line is written.
//
// Every line stands at the level of the groups open around it, one TAB a level, and ends with CR LF. Values are written
// as they are; what is to be escaped is handed over as Escaped(value).
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <utility>
#include <vector>

#include "varnex3/core/Date.h"
#include "varnex3/core/Escaped.h"
#include "varnex3/core/Record.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

class XmlWriter
{
public:
    // Characters that are written before any room is allocated. Most messages are shorter.
    static constexpr std::size_t kUsualRoom = std::size_t{24} * 1024;

    // The text of a record: what its Write writes, at the level of its class (T::kLevel).
    template <class T>
    static Text TextOf(const T& record);

    // Whether a child would write anything at all.
    template <class T, Ref<T> (*Make)()>
    static bool Writes(const Child<T, Make>& child);

    // A group's start tag and end tag; the lines between them stand one level deeper.
    void Open(Name group);
    void Close(Name group);

    // A group's start tag with an attribute, whatever the value: <group attribute="about">.
    void OpenWithAttribute(Name group, Name attribute, TextView about);

    // A start tag and end tag that are written only when something is written inside them.
    struct Mark
    {
        Name group;
        std::size_t before = 0; // how much was written before the start tag
        std::size_t inside = 0; // and with it
    };
    Mark OpenUnlessEmpty(Name group);
    void CloseUnlessEmpty(const Mark& mark);

    // The frame of a message: XML declaration and root start tag, at level 0. Some messages end without a line end.
    void OpenMessage(Name root);
    void CloseMessage(Name root) { Close(root); }
    void CloseMessageWithoutLineEnd(Name root);

    // A value line, whatever the value: <name>value</name>. Dates are written as yyyy-mm-dd, amounts as "0.00".
    void Always(Name element, TextView value);
    void Always(Name element, Escaped value);
    void Always(Name element, Date value);
    void Always(Name element, double amount);
    void Always(Name element, std::int32_t value);

    // A value line, unless the text is empty or the date is the zero date.
    void IfSet(Name element, TextView value);
    void IfSet(Name element, Escaped value);
    void IfSet(Name element, Date value);

    // A value line, only for an amount greater than 0.
    void IfPositive(Name element, double amount);

    // An empty element, <name/>, when the flag is true.
    void Flag(Name element, bool isSet);

    // A value line with an attribute, whatever the values: <name attribute="about">value</name>.
    void AlwaysWithAttribute(Name element, Name attribute, TextView about, TextView value);

    // Anything else that is one line.
    void Line(TextView text);
    void Line(Name before, Escaped value, Name after);

    // What a child record writes.
    template <class T, Ref<T> (*Make)()>
    void Append(const Child<T, Make>& child);

    // What several children write, one behind the other.
    template <class... Children>
    requires(sizeof...(Children) > 1) void Append(const Children&... children) { (Append(children), ...); }

    // What a record writes that stands in a list.
    template <class T>
    void Append(const Ref<T>& item);

    // What the records of a list write, one behind the other.
    template <class T>
    void AppendEach(const std::vector<Ref<T>>& items);

private:
    // The record is the class whose Serialise raises what goes wrong here. Without a text to keep a writer only counts.
    XmlWriter(std::span<char16_t> room_, bool keepsText_, int level_, Name record_)
        : room(room_), keepsText(keepsText_), level(level_), record(record_)
    {}

    // One line at this level, its parts one after the other: names, texts and single characters.
    template <class... Part>
    void PutLine(Part... parts);

    // Makes room for the length, with the text written before at its start: some of what is there already, or more.
    void Grow(std::size_t written);
    void Move(std::size_t written);
    Text Taken();

    // How far the innermost list has come, from which the room for the rest of it is guessed.
    struct ListProgress
    {
        std::size_t start = 0; // where the first item begins
        std::size_t done = 0;
        std::size_t count = 0;
    };

    std::span<char16_t> room;
    Text grown; // the room of a text that is longer than usual
    bool keepsText;
    std::size_t length = 0;
    ListProgress list;
    int level;
    Name record;
};

template <class T>
Text XmlWriter::TextOf(const T& record)
{
    std::array<char16_t, kUsualRoom> usual; // NOLINT(cppcoreguidelines-pro-type-member-init): filled by the writer
    XmlWriter writer(usual, true, T::kLevel, T::ClassName);
    record.Write(writer);
    return writer.Taken();
}

template <class T, Ref<T> (*Make)()>
bool XmlWriter::Writes(const Child<T, Make>& child)
{
    XmlWriter counter({}, false, T::kLevel, T::ClassName);
    child->Write(counter);
    return counter.length > 0;
}

template <class T, Ref<T> (*Make)()>
void XmlWriter::Append(const Child<T, Make>& child)
{
    Append(child.Held());
}

template <class T>
void XmlWriter::Append(const Ref<T>& item)
{
    const int outerLevel = std::exchange(level, T::kLevel);
    const Name outerRecord = std::exchange(record, T::ClassName);
    item->Write(*this);
    level = outerLevel;
    record = outerRecord;
}

template <class T>
void XmlWriter::AppendEach(const std::vector<Ref<T>>& items)
{
    const ListProgress outerList = std::exchange(list, {length, 0, items.size()});
    for (const Ref<T>& item : items) {
        Append(item);
        ++list.done;
    }
    list = outerList;
}

} // namespace varnex3
