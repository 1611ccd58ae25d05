#include "varnex3/inbox/MessageDef.h"

#include <system_error>

namespace varnex3 {

VARNEX_DEFINE(MessageDef);

namespace {

using enum XaloMessageTypeEnum;

struct TypeRow
{
    XaloMessageTypeEnum id;
    TextView recognised; // the root element that is read
    TextView written;    // what MessageTypeID sets
    TextView description;
};

constexpr TypeRow kMessageTypes[] = {
    {Xalo_Unknown, u"Xalo_Unknown", u"Xalo_Unknown", u"Unknown"},
    {Xalo_RequestForQuote, u"Xalo_RequestForQuote", u"Xalo_RequestForQuote", u"Request For Quote"},
    {Xalo_ScopeOfWork, u"Xalo_ScopeOfWork", u"Xalo_ScopeOfWork", u"Scope of Work"},
    {Xalo_DeclinedRepair, u"Xalo_Declined", u"Xalo_DeclinedRepair", u"Declined Repair"}, // arrives under another name
    {Xalo_Quote, u"Xalo_Quote", u"Xalo_Quote", u"Quote"},
    {Xalo_AuthorityWithdrawn, u"Xalo_AuthorityWithdrawn", u"Xalo_AuthorityWithdrawn", u"Authority Withdrawn"},
    {Xalo_JobCancelled, u"Xalo_JobCancelled", u"Xalo_JobCancelled", u"Job Cancelled"},
    {Xalo_TotalLoss, u"Xalo_TotalLoss", u"Xalo_TotalLoss", u"Total Loss"},
    {Xalo_TaxInvoice, u"Xalo_TaxInvoice", u"Xalo_TaxInvoice", u"Tax Invoice"},
    {Xalo_AdjustmentNote, u"Xalo_AdjustmentNote", u"Xalo_AdjustmentNote", u"Adjustment Note"},
    {Xalo_ReactivateInvoice, u"Xalo_ReactivateInvoice", u"Xalo_ReactivateInvoice", u"Reactivate Invoice"},
    {Xalo_PaymentAuthorised, u"Xalo_PaymentAuthorised", u"Xalo_PaymentAuthorised", u"Payment Authorised"},
    {Xalo_PaymentDeclined, u"Xalo_PaymentDeclined", u"Xalo_PaymentDeclined", u"Payment Declined"},
    {Xalo_Image, u"Xalo_Image", u"Xalo_Image", u"Image"},
    {Xalo_Error, u"Xalo_Error", u"Xalo_Error", u"Error"},
    {Xalo_VarnexVersionChange, u"Xalo_VarnexVersionChange", u"Xalo_VarnexVersionChange", u"Varnex Version Change"},
    {Xalo_VarnexReferenceData, u"Xalo_VarnexReferenceData", u"Xalo_VarnexReferenceData", u"Varnex Reference Data"},
};

const TypeRow* Find(XaloMessageTypeEnum id)
{
    for (const TypeRow& type : kMessageTypes)
        if (type.id == id)
            return &type;
    return nullptr;
}

Text Joined(const Text& first, const Text& second) { return Text(Trimmed(first + u" " + second)); }

} // namespace

Text MessageDef::MessageType() { return sMessageType; }

void MessageDef::MessageType(Text value)
{
    sMessageType = std::move(value);
    for (const TypeRow& type : kMessageTypes)
        if (type.recognised == sMessageType)
            eMessageTypeID = type.id; // an unknown name leaves the type as it was
}

XaloMessageTypeEnum MessageDef::MessageTypeID() { return eMessageTypeID; }

void MessageDef::MessageTypeID(XaloMessageTypeEnum value)
{
    eMessageTypeID = value;
    if (const TypeRow* const type = Find(value))
        sMessageType = type->written; // any other number leaves the name as it was
}

Text MessageDef::MessageDescription()
{
    if (const TypeRow* const type = Find(eMessageTypeID))
        sMessageDescription = type->description;
    return sMessageDescription;
}

void MessageDef::MessageDescription(Text value) { sMessageDescription = std::move(value); }

Text MessageDef::SourceXML()
{
    if (!bSourceIsCurrent)
        SourceXML(document.Xml());
    return sSourceXML;
}

void MessageDef::SourceXML(Text value)
{
    sSourceXML = std::move(value);
    bSourceIsCurrent = true;
}

Text MessageDef::ParseXML(const Text& sXML, const Text& sFileName_, const ByReference<Text>& sFilePath_)
{
    xml::Document loaded;
    if (loaded.LoadText(sXML)) {
        Adopt(std::move(loaded), sFileName_, sFilePath_);
        return {};
    }
    SourceXML(SourceXML()); // kept from the document that goes now
    bParseError = true;
    sErrorMessage = u"File: " + sFileName_ + u"; Error Line: "
                    + ToText(Variant(static_cast<std::int32_t>(loaded.Error().line))) + u"; Error Reason: '"
                    + loaded.Error().reason + u"'";
    document = std::move(loaded);
    return {};
}

void MessageDef::Adopt(xml::Document loaded, const Text& fileName, const Text& filePath)
{
    document = std::move(loaded);
    bLoaded = true;
    sFileName = fileName;
    sFilePath = filePath;
    MessageType(document.DocumentElement().Name());
    Summarise();
    bParseError = false;
    sErrorMessage.clear();
    bSourceIsCurrent = false;
}

void MessageDef::AdoptFile(xml::Document loaded, const Text& fileName, const Text& filePath)
{
    if (loaded.Root())
        Adopt(std::move(loaded), fileName, filePath);
    else
        ParseXML({}, fileName, filePath);
}

void MessageDef::Summarise()
{
    sMessageNo = ValueAt(eMessageTypeID == Xalo_Error ? "RelatesToMessageNo" : "MessageNo");
    sRegistration = ValueAt("Vehicle/RegistrationNo");
    sClaimNo = ValueAt("ClaimHeader/InsuranceClaimNo");
    sCustomer = Joined(ValueAt("Customer/PersonalName/Forname"), ValueAt("Customer/PersonalName/Surname"));
    sQuoteNo = ValueAt("QuoteNo");
    sVehicleDesciption = Joined(ValueAt("Vehicle/Make"), ValueAt("Vehicle/ModelID"));
    sVehicleID = ValueAt("ClaimHeader/VehicleID");
    sRepairerID = ValueAt("Repairer/RepairerID");
    sImageNo = ValueAt("ImageNo");
    sVarnexStatusCode = ValueAt("VarnexStatus/Status");
}

Text MessageDef::ValueAt(Name path) const { return document.DocumentElement().SelectSingle(path).Text(); }

Text MessageDef::saveToFile(const Variant& sFilePath_)
{
    if (!bLoaded)
        return {};
    constexpr Name kOperation = "MessageDef.saveToFile";
    const Text path = ToText(sFilePath_);
    if (!document.Root())
        Raise(ErrorNumber::PathFileAccess, kOperation, Quoted(path) + u" was not written: the document is empty");
    try {
        document.SaveFile(path);
    } catch (const std::system_error& error) {
        Raise(ErrorNumber::PathFileAccess, kOperation, FileError(error.code().value(), kOperation, path).Description());
    }
    return {};
}

} // namespace varnex3
