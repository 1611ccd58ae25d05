// Any record as JSON, and JSON as a record.
#pragma once

#include <string>
#include <string_view>

#include "varnex3/core/Interface.h"

namespace varnex3 {

// The properties of a record in interface order, as one JSON object on one line, UTF-8. Texts are strings, dates
// "yyyy-mm-ddThh:mm:ss", enumerations the name of their constant (the number when there is none), children objects or
// null. An indexed property of a class that has a Count is an array of its items. A lone surrogate, which UTF-8
// cannot carry, becomes U+FFFD; a number that is not finite null.
std::string ToJson(Record& record);

// Stores what a JSON object (UTF-8), as ToJson writes it, says of the record's properties; a property that it leaves
// out stays as it is. Dates may have every form of Conversions.h, enumerations may be numbers. A child's object goes
// into the child. The arrays of a list are appended to it, item by item; a list of fields has one array for the names
// and one for the values. Read-only properties are passed over. Some properties are two views of one value, a code and
// its number: one of them will do, and both have to agree.
//
// Errors have the source "FromJson", unless a record raised them, and name the property by its path from the record,
// such as "QuoteItemsField.QuoteItems[3].ItemNo": NoSuchMember (438) for an unknown one, TypeMismatch (13) and
// Overflow (6) for a value that is not of its type, InvalidArgument (5) for one that does not agree with the others
// and, with line and column, for a text that is not JSON. What was stored before stays.
void FromJson(Record& record, std::string_view json);

// A new record of the class that a JSON object of one name names: {"DestinationDef": {"OrgType": "INS"}}. find gives a
// class by its name, or null, which is NoSuchMember. Paths begin with the class.
Ref<Record> FromNamedJson(std::string_view json, const ClassInfo* (*find)(Name));

} // namespace varnex3
