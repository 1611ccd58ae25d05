// What an adjustment note changes.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class AdjustmentNoteDetailsDef final : public Record
{
    VARNEX_RECORD(AdjustmentNoteDetailsDef, "That the message is an adjustment note, and by how much it adjusts.");
    VARNEX_SERIALISE(
        "The AdjustmentNoteDetails group; nothing when AdjustmentNote is False, whatever the other values.");
    VARNEX_PROPERTY(bool, bAdjustmentNote, AdjustmentNote,
                    "Whether the message is an adjustment note; written as an empty element.");
    VARNEX_PROPERTY(Date, dtAdjustmentNoteDate, AdjustmentNoteDate,
                    "Date of the note; written as a day, left out when it is the zero date.");
    VARNEX_PROPERTY(double, dSupplyDifferenceAmount, SupplyDifferenceAmount,
                    "By how much the supply differs, in dollars; written whenever the group is.");
    VARNEX_PROPERTY(Text, sStatutoryStatement, StatutoryStatement,
                    "The statement that the law asks for; written as it is whenever the group is.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
