#include "varnex3/core/PartyFields.h"

namespace varnex3 {

void WriteFields(XmlWriter& xml, Name element, const InsurerDetailDef& fields)
{
    const KeyedList<Text>& all = fields.All();
    for (std::size_t i = 0; i < all.Count(); ++i)
        xml.AlwaysWithAttribute(element, "FieldName", all.KeyAt(i), all.ItemAt(i));
}

void WriteSetFields(XmlWriter& xml, Name element, const InsurerDetailDef& fields)
{
    const KeyedList<Text>& all = fields.All();
    for (std::size_t i = 0; i < all.Count(); ++i)
        if (IsSet(all.ItemAt(i)))
            xml.AlwaysWithAttribute(element, "FieldName", all.KeyAt(i), all.ItemAt(i));
}

void ReadFields(const XmlSection& section, Name element, InsurerDetailDef& fields)
{
    for (const xml::Node& field : section.ElementsNamed(element))
        fields.Take(section.FirstAttributeOf(field), field.Text());
}

} // namespace varnex3
