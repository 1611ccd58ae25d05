#include "varnex3/quote/VarnexStatusDef.h"

#include "varnex3/quote/OneLine.h"

namespace varnex3 {

VARNEX_DEFINE(VarnexStatusDef);

namespace {

struct StatusRow
{
    VarnexStatusEnum type;
    TextView recognised; // by the getters
    TextView written;    // by the setter of StatusType
    TextView words;
};

constexpr StatusRow kStatuses[] = {
    {VarnexStatusEnum::Authorised, u"A", u"A", u"Quote Authorised"},
    {VarnexStatusEnum::AuthorityWithdrawn, u"AWD", u"AWD", u"Authority Withdrawn"},
    {VarnexStatusEnum::AuthorityWithheld, u"AWH", u"AWH", u"Authority Withheld"},
    {VarnexStatusEnum::CashSettlement, u"CS", u"CS", u"Cash Settlement"},
    {VarnexStatusEnum::Quoted, u"QT", u"QR", u"Quoted"}, // written under another code
    {VarnexStatusEnum::TotalLossDetermined, u"TLD", u"TLD", u"Total Loss Determined"},
    {VarnexStatusEnum::TotalLossRequested, u"TLR", u"TLR", u"Total Loss Requested"},
};

const StatusRow* Recognise(TextView code)
{
    for (const StatusRow& status : kStatuses)
        if (EqualsIgnoringCase(status.recognised, code))
            return &status;
    return nullptr;
}

} // namespace

VarnexStatusEnum VarnexStatusDef::StatusType()
{
    const StatusRow* const status = Recognise(sStatus);
    return status ? status->type : VarnexStatusEnum::Authorised;
}

void VarnexStatusDef::StatusType(VarnexStatusEnum value)
{
    for (const StatusRow& status : kStatuses)
        if (status.type == value)
            sStatus = status.written; // any other number leaves the code as it was
}

Text VarnexStatusDef::StatusTypeText() const
{
    const StatusRow* const status = Recognise(sStatus);
    return status ? Text(status->words) : Text();
}

void VarnexStatusDef::Write(XmlWriter& xml) const
{
    const bool isWritten = IsSet(sStatus) || IsSet(sReason);
    if (!isWritten)
        return;

    xml.Open("VarnexStatus");
    xml.IfSet("Status", sStatus);
    xml.IfSet("Reason", OnOneLine(sReason));
    xml.Close("VarnexStatus");
}

void VarnexStatusDef::Read(const XmlSection& section)
{
    sStatus = section.TextAt("VarnexStatus/Status");
    sReason = section.TextAt("VarnexStatus/Reason");
}

} // namespace varnex3
