// Reference data: named data types, each with its codes and their descriptions.
#pragma once

#include "varnex3/core/Rows.h"
#include "varnex3/notices/RecordList.h"

namespace varnex3 {

class ReferenceDataDefDataTypeDataValue final : public Record
{
    VARNEX_RECORD(ReferenceDataDefDataTypeDataValue, "A code and its description.");
    VARNEX_SERIALISE("The DataValue group with both texts, empty ones too; nothing is escaped.");
    VARNEX_PARSEXML(Variant, "Reads both texts; an absent one is empty.");
    VARNEX_PROPERTY(Text, sCode, Code, "The code.");
    VARNEX_PROPERTY(Text, sDescription, Description, "What the code means.");

public:
    static constexpr int kLevel = 3;
    VARNEX_RECORD_END;
};

// More than 32,767 values are kept, written and read; Count alone then raises Overflow (6), and those that no 16-bit
// position reaches are not to be had one by one.
class ReferenceDataDefDataType final : public Record
{
    VARNEX_RECORD(ReferenceDataDefDataType, "A named list of codes, in the order in which they were added.");
    VARNEX_SERIALISE("The DataType group, always: the name as the attribute Name, not escaped, and every value.");
    VARNEX_PARSEXML(Text, "Reads the name from the element's first attribute, whatever that is called, and appends its "
                          "values. Raises ObjectNotSet (91) where the element is missing or has no attribute.");
    VARNEX_METHOD(Ref<ReferenceDataDefDataTypeDataValue>, Add, (), "Appends a new value and returns it.");
    VARNEX_INDEXED_READONLY(Ref<ReferenceDataDefDataTypeDataValue>, Items, (std::int16_t Index),
                            "The value at a position, from 0; nothing when there is none.");
    VARNEX_READONLY(std::int16_t, Count, "Number of values.");
    VARNEX_PROPERTY(Text, sNameAttribute, NameAttribute, "Name of the data type.");

public:
    static constexpr int kLevel = 2;

private:
    RecordList<ReferenceDataDefDataTypeDataValue> values;
    VARNEX_RECORD_END;
};

// More than 32,767 data types are kept, as the values of one are.
class ReferenceDataDef final : public Record
{
    VARNEX_RECORD(ReferenceDataDef, "A list of data types, in the order in which they were added.");
    VARNEX_SERIALISE("The ReferenceData group with every data type; written even when there is none.");
    VARNEX_PARSEXML(Text, "Appends a data type for each DataType element; those before them stay.");
    VARNEX_METHOD(Ref<ReferenceDataDefDataType>, Add, (), "Appends a new data type and returns it.");
    VARNEX_INDEXED_READONLY(Ref<ReferenceDataDefDataType>, Items, (std::int16_t Index),
                            "The data type at a position, from 0; nothing when there is none.");
    VARNEX_READONLY(std::int16_t, Count, "Number of data types.");

private:
    RecordList<ReferenceDataDefDataType> types;
    VARNEX_RECORD_END;
};

} // namespace varnex3
