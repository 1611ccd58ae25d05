#include "varnex3/notices/ReferenceDataDef.h"

namespace varnex3 {

VARNEX_DEFINE(ReferenceDataDef);
VARNEX_DEFINE(ReferenceDataDefDataType);
VARNEX_DEFINE(ReferenceDataDefDataTypeDataValue);

// ---- ReferenceDataDef

Ref<ReferenceDataDefDataType> ReferenceDataDef::Add() { return types.Add(); }

Ref<ReferenceDataDefDataType> ReferenceDataDef::Items(std::int16_t Index) { return types.At(Index); }

std::int16_t ReferenceDataDef::Count() const { return CountOf(types.Count(), "ReferenceDataDef.Count"); }

void ReferenceDataDef::Write(XmlWriter& xml) const
{
    xml.Open("ReferenceData"); // also without any data type
    xml.AppendEach(types.All());
    xml.Close("ReferenceData");
}

void ReferenceDataDef::Read(const XmlSection& section)
{
    for (const xml::Node& type : section.NodesAt("ReferenceData/DataType"))
        Add()->Read(XmlSection(type, ReferenceDataDefDataType::ClassName));
}

// ---- ReferenceDataDefDataType

Ref<ReferenceDataDefDataTypeDataValue> ReferenceDataDefDataType::Add() { return values.Add(); }

Ref<ReferenceDataDefDataTypeDataValue> ReferenceDataDefDataType::Items(std::int16_t Index) { return values.At(Index); }

std::int16_t ReferenceDataDefDataType::Count() const
{
    return CountOf(values.Count(), "ReferenceDataDefDataType.Count");
}

void ReferenceDataDefDataType::Write(XmlWriter& xml) const
{
    xml.OpenWithAttribute("DataType", "Name", sNameAttribute);
    xml.AppendEach(values.All());
    xml.Close("DataType");
}

void ReferenceDataDefDataType::Read(const XmlSection& section)
{
    sNameAttribute = section.RequiredFirstAttributeAt("DataType"); // whatever it is called
    for (const xml::Node& value : section.NodesAt("DataType/DataValue"))
        Add()->Read(XmlSection(value, ReferenceDataDefDataTypeDataValue::ClassName));
}

// ---- ReferenceDataDefDataTypeDataValue

void ReferenceDataDefDataTypeDataValue::Write(XmlWriter& xml) const
{
    xml.Open("DataValue");
    xml.Always("Code", sCode);
    xml.Always("Description", sDescription);
    xml.Close("DataValue");
}

void ReferenceDataDefDataTypeDataValue::Read(const XmlSection& section)
{
    sCode = section.TextAt("DataValue/Code");
    sDescription = section.TextAt("DataValue/Description");
}

} // namespace varnex3
