#include "varnex3/quote/QuoteItem.h"

#include <algorithm>

namespace varnex3 {

VARNEX_DEFINE(QuoteItem);

namespace {

struct Kind
{
    QuoteItemTypeEnum type;
    const char16_t* code;
    const char16_t* description;
};

// In the order in which they are read. Mechanical work counts as removing and replacing, paint materials and
// towing as miscellaneous.
constexpr Kind kKinds[] = {
    {QuoteItemTypeEnum::QuoteItemRemoveReplace, u"R&R", u"R&R"},
    {QuoteItemTypeEnum::QuoteItemRepair, u"RA", u"Repair"},
    {QuoteItemTypeEnum::QuoteItemPaintLabour, u"Paint", u"Paint"},
    {QuoteItemTypeEnum::QuoteItemPaintMaterials, u"MIS", u"Misc"},
    {QuoteItemTypeEnum::QuoteItemPart, u"Part", u"Part"},
    {QuoteItemTypeEnum::QuoteItemMiscellaneous, u"MIS", u"Misc"},
    {QuoteItemTypeEnum::QuoteItemMechanical, u"R&R", u"R&R"},
    {QuoteItemTypeEnum::QuoteItemTowing, u"MIS", u"Misc"},
};

struct UpdateStatusRow
{
    UpdateStatusEnum type;
    TextView word;
    TextView code;
};

constexpr UpdateStatusRow kUpdateStatuses[] = {
    {UpdateStatusEnum::Accepted, u"ACCEPTED", u"P"},
    {UpdateStatusEnum::AcknowledgedDelete, u"ACKNOWLEDGEDDELETE", u"K"},
    {UpdateStatusEnum::Added, u"ADDED", u"A"},
    {UpdateStatusEnum::Changed, u"CHANGED", u"C"},
    {UpdateStatusEnum::Deleted, u"DELETED", u"D"},
};

const UpdateStatusRow* FindUpdateStatus(TextView word)
{
    for (const UpdateStatusRow& row : kUpdateStatuses)
        if (EqualsIgnoringCase(row.word, word))
            return &row;
    return nullptr;
}

} // namespace

Text QuoteItem::ErrorMessage() const { return sErrorMessage.Held(); }

Text QuoteItem::UpdateStatusCode()
{
    if (const UpdateStatusRow* const row = FindUpdateStatus(sUpdateStatus))
        sUpdateStatusCode = row->code;
    return sUpdateStatusCode.Held();
}

void QuoteItem::UpdateStatusCode(Text value) { sUpdateStatusCode = std::move(value); } // UpdateStatus stays

UpdateStatusEnum QuoteItem::UpdateStatusType()
{
    if (const UpdateStatusRow* const row = FindUpdateStatus(sUpdateStatus))
        eUpdateStatusType = row->type;
    return eUpdateStatusType;
}

void QuoteItem::UpdateStatusType(UpdateStatusEnum value)
{
    eUpdateStatusType = value;
    for (const UpdateStatusRow& row : kUpdateStatuses)
        if (row.type == value)
            sUpdateStatus = row.word;
}

void QuoteItem::Write(XmlWriter& xml) const
{
    xml.Open("QuoteItem");
    xml.Always("ItemNo", iItemNo);
    xml.IfSet("Code", sCode);
    xml.IfSet("Description", sDescription);
    xml.Always("QuoteItemValue", dQuoteItemValue);
    WriteKind(xml);
    xml.IfSet("Comment", sComment);
    xml.IfSet("UpdateStatus", sUpdateStatus);
    xml.Flag("ReportOn", bReportOn);
    xml.IfSet("Defines", sDefines);
    xml.Close("QuoteItem");
}

void QuoteItem::WriteKind(XmlWriter& xml) const
{
    switch (eQuoteItemType) {
    case QuoteItemTypeEnum::QuoteItemRemoveReplace:
        return xml.Append(objRemoveReplace);
    case QuoteItemTypeEnum::QuoteItemRepair:
        return xml.Append(objRepair);
    case QuoteItemTypeEnum::QuoteItemPaintLabour:
        return xml.Append(objPaintLabour);
    case QuoteItemTypeEnum::QuoteItemPaintMaterials:
        return xml.Append(objPaintMaterials);
    case QuoteItemTypeEnum::QuoteItemPart:
        return xml.Append(objPart);
    case QuoteItemTypeEnum::QuoteItemMiscellaneous:
        return xml.Append(objMiscellaneous);
    case QuoteItemTypeEnum::QuoteItemMechanical:
        return xml.Append(objMechanical);
    case QuoteItemTypeEnum::QuoteItemTowing:
        return xml.Append(objTowing);
    }
}

void QuoteItem::Read(const XmlSection& section)
{
    iItemNo = section.Int16At("QuoteItem/ItemNo");
    sCode = section.TextAt("QuoteItem/Code");
    sDescription = section.TextAt("QuoteItem/Description");
    dQuoteItemValue = section.NumberAt("QuoteItem/QuoteItemValue");
    const bool isThere[] = {
        section.ReadIntoWhereUsed(objRemoveReplace, "QuoteItem/RemoveReplace"),
        section.ReadIntoWhereUsed(objRepair, "QuoteItem/Repair"),
        section.ReadIntoWhereUsed(objPaintLabour, "QuoteItem/PaintLabour"),
        section.ReadIntoWhereUsed(objPaintMaterials, "QuoteItem/PaintMaterials"),
        section.ReadIntoWhereUsed(objPart, "QuoteItem/Part"),
        section.ReadIntoWhereUsed(objMiscellaneous, "QuoteItem/Miscellaneous"),
        section.ReadIntoWhereUsed(objMechanical, "QuoteItem/Mechanical"),
        section.ReadIntoWhereUsed(objTowing, "QuoteItem/Towing"),
    };
    sComment = section.TextAt("QuoteItem/Comment");
    sUpdateStatus = section.TextAt("QuoteItem/UpdateStatus");
    bReportOn = bReportOn || section.Has("QuoteItem/ReportOn"); // its absence never makes it false
    sDefines = section.TextAt("QuoteItem/Defines");
    Become(isThere);
}

// The last kind that is there wins; without any the item stays what it is.
void QuoteItem::Become(std::span<const bool> isThere)
{
    for (std::size_t i = 0; i < isThere.size(); ++i) {
        if (!isThere[i])
            continue;
        eQuoteItemType = kKinds[i].type;
        sQuoteItemTypeString.Become(kKinds[i].code);
        sTypeDescription.Become(kKinds[i].description);
    }
    if (std::ranges::count(isThere, true) > 1)
        sErrorMessage += u",Quote item contain more than one item type."; // the fixed text, comma and all
}

} // namespace varnex3
