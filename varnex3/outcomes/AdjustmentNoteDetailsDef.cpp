#include "varnex3/outcomes/AdjustmentNoteDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(AdjustmentNoteDetailsDef);

void AdjustmentNoteDetailsDef::Write(XmlWriter& xml) const
{
    if (!bAdjustmentNote)
        return;

    xml.Open("AdjustmentNoteDetails");
    xml.Flag("AdjustmentNote", bAdjustmentNote);
    xml.IfSet("AdjustmentNoteDate", dtAdjustmentNoteDate);
    xml.Always("SupplyDifferenceAmount", dSupplyDifferenceAmount);
    xml.Always("StatutoryStatement", sStatutoryStatement);
    xml.Close("AdjustmentNoteDetails");
}

} // namespace varnex3
