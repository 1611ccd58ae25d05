// Writes the lines of a record, each by a verb that says when the line is written.
//
// Every line stands at the level of the groups open around it, one TAB a level, and ends with CR LF. Values are written
// as they are; what is to be escaped is handed over escaped (EscapeXML).
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <utility>

#include "varnex3/core/Date.h"
#include "varnex3/core/Record.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

class XmlWriter
{
public:
    // The text of a record: what its Write writes, at the level of its class (T::kLevel).
    template <class T>
    static Text TextOf(const T& record);

    // Whether a child would write anything at all.
    template <class T>
    static bool Writes(const Child<T>& child);

    // A group's start tag and end tag; the lines between them stand one level deeper.
    void Open(Name group);
    void Close(Name group);

    // The same for a group that is written only when something is written inside it.
    struct Mark
    {
        Name group;
        std::size_t before = 0; // how much was written before the start tag
        std::size_t inside = 0; // and with it
    };
    Mark OpenUnlessEmpty(Name group);
    void CloseUnlessEmpty(const Mark& mark);

    // A value line, whatever the value: <name>value</name>. Dates are written as yyyy-mm-dd, amounts as "0.00".
    void Always(Name element, TextView value);
    void Always(Name element, Date value);
    void Always(Name element, double amount);
    void Always(Name element, std::int32_t value);

    // A value line, unless the text is empty or the date is the zero date.
    void IfSet(Name element, TextView value);
    void IfSet(Name element, Date value);

    // A value line with an attribute, whatever the values: <name attribute="about">value</name>.
    void AlwaysWithAttribute(Name element, Name attribute, TextView about, TextView value);

    // What a child record writes.
    template <class T>
    void Append(const Child<T>& child);

private:
    XmlWriter(std::span<char16_t> room_, int level_) : room(room_), level(level_) {}

    void StartLine();
    void EndLine() { Put(TextView(u"\r\n")); }
    void PutStartTag(Name element);
    void PutEndTag(Name element);
    void Put(TextView text);
    void Put(Name name);

    // Room for the text: what does not fit is counted only, so that the second time the room is exact.
    std::span<char16_t> room;
    std::size_t length = 0;
    int level;
};

template <class T>
Text XmlWriter::TextOf(const T& record)
{
    constexpr std::size_t kUsualRoom = 2048;
    std::array<char16_t, kUsualRoom> usual; // NOLINT(cppcoreguidelines-pro-type-member-init): filled by the writer
    XmlWriter first(usual, T::kLevel);
    record.Write(first);
    if (first.length <= usual.size())
        return {usual.data(), first.length};

    Text text(first.length, u'\0');
    XmlWriter second(text, T::kLevel);
    record.Write(second);
    return text;
}

template <class T>
bool XmlWriter::Writes(const Child<T>& child)
{
    XmlWriter counter({}, T::kLevel);
    child->Write(counter);
    return counter.length > 0;
}

template <class T>
void XmlWriter::Append(const Child<T>& child)
{
    const int outer = std::exchange(level, T::kLevel);
    child->Write(*this);
    level = outer;
}

} // namespace varnex3
