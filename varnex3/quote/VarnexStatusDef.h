// How far a quote has come.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(VarnexStatusEnum, "The status of a quote.", (Authorised, 0, "The insurer authorises the repair."),
            (AuthorityWithdrawn, 1, "The insurer takes its authority back."),
            (AuthorityWithheld, 2, "The insurer does not give its authority."),
            (CashSettlement, 3, "The insurer pays the owner instead."), (Quoted, 4, "The repairer has quoted."),
            (TotalLossDetermined, 5, "The vehicle is a total loss."),
            (TotalLossRequested, 6, "The repairer asks for a total loss."));

class VarnexStatusDef final : public Record
{
    VARNEX_RECORD(VarnexStatusDef, "The status of a quote, and why.");
    VARNEX_SERIALISE("The VarnexStatus group with what is not empty; nothing when both are. The reason stands on one "
                     "line: each line end in it, CR LF or LF, becomes a blank. Nothing is escaped.");
    VARNEX_PARSEXML(Variant, "Reads both values; an absent element gives the empty text.");
    VARNEX_PROPERTY(Text, sStatus, Status, "Code of the status.");
    VARNEX_PROPERTY(Text, sReason, Reason, "Why the quote has this status.");
    VARNEX_ACCESSORS(VarnexStatusEnum, StatusType,
                     "Kind of the status, derived from Status in any letter case; 0 for an unknown code. Setting 0 to "
                     "6 sets the code, another number nothing. Quoted is set as QR but derived from QT alone.");
    VARNEX_READONLY(Text, StatusTypeText, "The status in words; empty for an unknown code, QR too.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
