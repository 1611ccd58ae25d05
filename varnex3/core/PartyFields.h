// How the four party records write and read their further named fields.
#pragma once

#include "varnex3/core/InsurerDetailDef.h"

namespace varnex3 {

// One line a field, in list order, name and value as they are: <RepairerDetails
// FieldName="Phone">...</RepairerDetails>.
void WriteFields(XmlWriter& xml, Name element, const InsurerDetailDef& fields);

// The same without the fields whose value is empty.
void WriteSetFields(XmlWriter& xml, Name element, const InsurerDetailDef& fields);

// Appends every element of this name, at any depth: the value of its first attribute, whatever that is called, is the
// field's name. The list is not cleared first.
void ReadFields(const XmlSection& section, Name element, InsurerDetailDef& fields);

} // namespace varnex3
