#include "varnex3/quote/QuoteDetailsDef.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteDetailsDef);

namespace {

struct ModelRow
{
    RepairModelTypeEnum id;
    TextView code; // letter case counts
};

constexpr ModelRow kRepairModels[] = {
    {RepairModelTypeEnum::Assessing, u"A"},
    {RepairModelTypeEnum::Allocated, u"CP"},
    {RepairModelTypeEnum::Tendering, u"T"},
};

} // namespace

Text QuoteDetailsDef::QuoteType() { return sQuoteType; }

void QuoteDetailsDef::QuoteType(Text value) { sQuoteType = std::move(value); }

RepairModelTypeEnum QuoteDetailsDef::QuoteTypeID()
{
    for (const ModelRow& model : kRepairModels)
        if (model.code == sQuoteType)
            return model.id;
    return RepairModelTypeEnum::Assessing;
}

void QuoteDetailsDef::QuoteTypeID(RepairModelTypeEnum value)
{
    for (const ModelRow& model : kRepairModels)
        if (model.id == value)
            sQuoteType = model.code; // any other number leaves the code as it was
}

Text QuoteDetailsDef::QuoteTypeString() const { return FindDescription(*repairModels, sQuoteType).value_or(Text()); }

void QuoteDetailsDef::Write(XmlWriter& xml) const
{
    // The owner's contribution alone does not cause the element.
    const bool isWritten = IsSet(sQuoterName) || IsSet(sOpenText) || IsSet(sQuoteType) || IsSet(dtEstimatedStartDate)
                           || IsSet(dtEstimatedEndDate) || dExcessToCollect > 0;
    if (!isWritten)
        return;

    xml.Open("QuoteDetails");
    xml.IfSet("QuoteType", sQuoteType);
    xml.IfSet("EstimatedStartDate", dtEstimatedStartDate);
    xml.IfSet("EstimatedEndDate", dtEstimatedEndDate);
    xml.Always("ExcessToCollect", dExcessToCollect); // 0 and less, too
    xml.Append(objOwnersContributionToCollect);
    xml.IfSet("OpenText", Escaped(sOpenText));
    xml.IfSet("QuoterName", sQuoterName);
    xml.Close("QuoteDetails");
}

void QuoteDetailsDef::Read(const XmlSection& section)
{
    sQuoteType = section.TextAt("QuoteDetails/QuoteType");
    dtEstimatedStartDate = section.TimestampAt("QuoteDetails/EstimatedStartDate", Date());
    dtEstimatedEndDate = section.TimestampAt("QuoteDetails/EstimatedEndDate", Date());
    dExcessToCollect = section.NumberAt("QuoteDetails/ExcessToCollect");
    section.ReadIntoWhereUsed(objOwnersContributionToCollect, "QuoteDetails/OwnersContributionToCollect");
    sOpenText = section.TextAt("QuoteDetails/OpenText");
    sQuoterName = section.TextAt("QuoteDetails/QuoterName");
}

} // namespace varnex3
