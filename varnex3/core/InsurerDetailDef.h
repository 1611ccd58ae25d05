// The further named fields of a party.
#pragma once

#include "varnex3/core/KeyedList.h"
#include "varnex3/core/Rows.h"

namespace varnex3 {

// An index is a position, from 0, when it is a number or a text that is one; any other text is a field name. A field
// whose name looks like a number is therefore reached by its position only.
class InsurerDetailDef final : public Record
{
    VARNEX_RECORD(InsurerDetailDef,
                  "An ordered list of named fields of a repairer or an insurer, names and values texts.");
    VARNEX_METHOD(void, Add, (const Text& sFieldName, const Text& sValue),
                  "Appends a field. A name that is there already raises DuplicateKey (457).");
    VARNEX_INDEXED(
        Text, Values, (const Variant& Index),
        "Value of a field by name or position. Reading an unknown name adds it with an empty value; reading a "
        "position out of range gives the empty text. Setting replaces the value of a name that is there, and "
        "does nothing for another name or for any position.");
    VARNEX_INDEXED_READONLY(
        Text, Fields, (const Variant& Index),
        "Name of the field at a position; out of range raises SubscriptOutOfRange (9), an index that "
        "is no number TypeMismatch (13).");
    VARNEX_READONLY(std::int16_t, Count, "Number of fields.");

public:
    // The fields in order, for the records that write them.
    const KeyedList<Text>& All() const { return fields; }

    // Add for texts that nobody else needs, and so are not copied.
    void Take(Text fieldName, Text value);

private:
    KeyedList<Text> fields;
    VARNEX_RECORD_END;
};

} // namespace varnex3
