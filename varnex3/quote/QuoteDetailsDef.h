// A quote's kind, dates and excess.
#pragma once

#include <memory>

#include "varnex3/core/ReferenceSet.h"
#include "varnex3/core/Rows.h"
#include "varnex3/quote/OwnersContributionToCollectDef.h"

namespace varnex3 {

VARNEX_ENUM(RepairModelTypeEnum, "How it is decided who repairs.", (Assessing, 0, "The damage is assessed: A."),
            (Allocated, 1, "The job is allocated to the repairer: CP."), (Tendering, 2, "Repairers tender: T."));

// A new record loads the reference set of the repair models, REPAIRMODELTYPE, and keeps it. Without a database the set
// is empty; what the database itself refuses is raised.
class QuoteDetailsDef final : public Record
{
    VARNEX_RECORD(QuoteDetailsDef, "The quote's kind, dates and excess.");
    VARNEX_SERIALISE("The QuoteDetails group; nothing when no value causes it. The owner's contribution does not, nor "
                     "an excess of 0 or less.");
    VARNEX_PARSEXML(Variant, "Reads every value; absent elements give empty values, an empty date the zero date. "
                             "QuoteTypeID is derived from the code that is read. Text that is no date or no number "
                             "raises TypeMismatch (13).");
    VARNEX_ACCESSORS(Text, QuoteType, "Code of the repair model: A, CP or T.");
    VARNEX_PROPERTY(Date, dtEstimatedStartDate, EstimatedStartDate, "When the repair is expected to begin.");
    VARNEX_PROPERTY(Date, dtEstimatedEndDate, EstimatedEndDate, "When the repair is expected to end.");
    VARNEX_PROPERTY(double, dExcessToCollect, ExcessToCollect,
                    "Excess to collect from the owner, in dollars; written whenever the group is.");
    VARNEX_PROPERTY(Child<OwnersContributionToCollectDef>, objOwnersContributionToCollect, OwnersContributionToCollect,
                    "What the owner is to pay.");
    VARNEX_PROPERTY(Text, sOpenText, OpenText, "Free text; escaped when written.");
    VARNEX_PROPERTY(Text, sQuoterName, QuoterName, "Who made the quote; written as it is.");
    VARNEX_ACCESSORS(RepairModelTypeEnum, QuoteTypeID,
                     "Repair model, derived from QuoteType; 0 for any code but CP and T, letter case counts. Setting "
                     "0, 1 or 2 sets the code, another number nothing.");
    VARNEX_READONLY(Text, QuoteTypeString,
                    "Description of QuoteType from the reference set, empty when it is not there. A code with an "
                    "apostrophe cannot be looked up: 3001, unless there is no set.");

private:
    Text sQuoteType;
    std::shared_ptr<RowSet> repairModels = GetReferenceSet(u"REPAIRMODELTYPE", u"");
    VARNEX_RECORD_END;
};

} // namespace varnex3
