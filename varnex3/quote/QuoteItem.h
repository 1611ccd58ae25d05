// One line of a quote.
#pragma once

#include <span>

#include "varnex3/quote/QuoteHoursDef.h"
#include "varnex3/quote/QuoteItemMiscellaneous.h"
#include "varnex3/quote/QuoteItemPaintLabour.h"
#include "varnex3/quote/QuoteItemPaintMaterials.h"
#include "varnex3/quote/QuoteItemPart.h"
#include "varnex3/quote/QuoteItemTowing.h"

namespace varnex3 {

VARNEX_ENUM(QuoteItemTypeEnum, "The kinds of quote item.", (QuoteItemRemoveReplace, 0, "Removing and replacing."),
            (QuoteItemRepair, 1, "Repairing."), (QuoteItemPaintLabour, 2, "Labour of painting."),
            (QuoteItemPaintMaterials, 3, "Materials of painting."), (QuoteItemPart, 4, "A part."),
            (QuoteItemMiscellaneous, 5, "A miscellaneous cost."), (QuoteItemMechanical, 6, "Mechanical work."),
            (QuoteItemTowing, 7, "Towing."));

VARNEX_ENUM(UpdateStatusEnum, "What happened to an item since the last quote.", (Accepted, 0, "Accepted."),
            (AcknowledgedDelete, 1, "Its deletion was acknowledged."), (Added, 3, "Added."), (Changed, 4, "Changed."),
            (Deleted, 5, "Deleted."));

class QuoteItem final : public Record
{
    using RemoveReplaceHours = Child<QuoteHoursDef, &NewHours<QuoteHoursTypeEnum::RemoveReplace>>;
    using RepairHours = Child<QuoteHoursDef, &NewHours<QuoteHoursTypeEnum::Repair>>;
    using MechanicalHours = Child<QuoteHoursDef, &NewHours<QuoteHoursTypeEnum::Mechanical>>;

    VARNEX_RECORD(QuoteItem, "One line of a quote: its number, description and value, and one kind of work.");
    VARNEX_SERIALISE("The QuoteItem element, always; of the kind records the one that QuoteItemType names.");
    VARNEX_PARSEXML(Text,
                    "Reads every value; an absent one is 0 or the empty text, only ReportOn stays as it was. The last "
                    "kind that is there sets QuoteItemType, QuoteItemTypeString and TypeDescription; without any they "
                    "stay as they were. More than one kind is noted in ErrorMessage.");
    VARNEX_PROPERTY(std::int16_t, iItemNo, ItemNo, "Number of the item; always written.");
    VARNEX_PROPERTY(Text, sCode, Code, "Code of the item.");
    VARNEX_PROPERTY(Text, sDescription, Description, "Description of the item.");
    VARNEX_PROPERTY(double, dQuoteItemValue, QuoteItemValue, "Value of the item in dollars; always written.");
    VARNEX_PROPERTY(RemoveReplaceHours, objRemoveReplace, RemoveReplace, "Hours of removing and replacing.");
    VARNEX_PROPERTY(RepairHours, objRepair, Repair, "Hours of repairing.");
    VARNEX_PROPERTY(Child<QuoteItemPaintLabour>, objPaintLabour, PaintLabour, "Labour of painting.");
    VARNEX_PROPERTY(Child<QuoteItemPaintMaterials>, objPaintMaterials, PaintMaterials, "Materials of painting.");
    VARNEX_PROPERTY(Child<QuoteItemPart>, objPart, Part, "The part.");
    VARNEX_PROPERTY(Child<QuoteItemMiscellaneous>, objMiscellaneous, Miscellaneous, "The miscellaneous cost.");
    VARNEX_PROPERTY(MechanicalHours, objMechanical, Mechanical, "Hours of mechanical work.");
    VARNEX_PROPERTY(Child<QuoteItemTowing>, objTowing, Towing, "Towing.");
    VARNEX_PROPERTY(RareText, sComment, Comment, "Comment on the item.");
    VARNEX_PROPERTY(Text, sUpdateStatus, UpdateStatus,
                    "What happened to the item: ACCEPTED, ACKNOWLEDGEDDELETE, ADDED, CHANGED or DELETED, in any letter "
                    "case; written as it is.");
    VARNEX_PROPERTY(bool, bReportOn, ReportOn, "Whether the item is to be reported on; reading never makes it false.");
    VARNEX_PROPERTY(RareText, sDefines, Defines, "Definitions that the item uses.");
    VARNEX_PROPERTY(QuoteItemTypeEnum, eQuoteItemType, QuoteItemType,
                    "The kind that is written; none for a number outside the enumeration.");
    VARNEX_READONLY(Text, ErrorMessage,
                    "\",Quote item contain more than one item type.\", once for each reading of several kinds.");
    VARNEX_PROPERTY(WordText, sQuoteItemTypeString, QuoteItemTypeString, "Code of the kind, set by reading.");
    VARNEX_PROPERTY(WordText, sTypeDescription, TypeDescription, "The kind in words, set by reading.");
    VARNEX_ACCESSORS(
        Text, UpdateStatusCode,
        "Code of UpdateStatus: P, K, A, C or D in the order of its words. A code set here shows only while "
        "UpdateStatus is none of them.");
    VARNEX_ACCESSORS(
        UpdateStatusEnum, UpdateStatusType,
        "The value of UpdateStatus; while that is no known word, the value last set or found here. Setting "
        "one of the enumeration sets UpdateStatus, too.");

public:
    static constexpr int kLevel = 2;

private:
    void WriteKind(XmlWriter& xml) const;
    void Become(std::span<const bool> isThere);

    RareText sErrorMessage;
    RareText sUpdateStatusCode;
    UpdateStatusEnum eUpdateStatusType{};
    VARNEX_RECORD_END;
};

} // namespace varnex3
