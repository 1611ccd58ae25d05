// The summary of one received message file.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(XaloMessageTypeEnum, "The types of message, recognised by the name of the root element.",
            (Xalo_Unknown, 0, "A message of no known type."),
            (Xalo_RequestForQuote, 1, "The insurer asks for a quote."), (Xalo_ScopeOfWork, 2, "The work to be done."),
            (Xalo_DeclinedRepair, 3, "The repairer declines the job."), (Xalo_Quote, 4, "The repairer's quote."),
            (Xalo_AuthorityWithdrawn, 5, "The insurer withdraws its authority."),
            (Xalo_JobCancelled, 6, "The job is cancelled."), (Xalo_TotalLoss, 7, "The vehicle is a total loss."),
            (Xalo_TaxInvoice, 8, "The repairer's tax invoice."),
            (Xalo_AdjustmentNote, 9, "A correction of an invoice."),
            (Xalo_ReactivateInvoice, 10, "A request to reactivate an invoice."),
            (Xalo_PaymentAuthorised, 11, "The insurer authorises a payment."),
            (Xalo_PaymentDeclined, 12, "The insurer declines a payment."), (Xalo_Image, 13, "Notice of an image."),
            (Xalo_Error, 14, "Report of a message that was not accepted."),
            (Xalo_VarnexVersionChange, 15, "Notice of a version change."),
            (Xalo_VarnexReferenceData, 16, "Reference data."));

class MessageDef final : public Record
{
    VARNEX_RECORD(MessageDef, "The summary of one received message: its type and a dozen key values.");
    VARNEX_PROPERTY(Text, sImageNo, ImageNo, "Image number.");
    VARNEX_METHOD(
        Text, saveToFile, (const Variant& sFilePath),
        "Writes the message, UTF-8, to a file, atomically; nothing before the first successful ParseXML. A file "
        "that cannot be written, or a document that a failed ParseXML left empty, raises PathFileAccess (75) and "
        "leaves the old file as it was. The result is always empty.");
    VARNEX_METHOD(
        Text, ParseXML, (const Text& sXML, const Text& sFileName, const ByReference<Text>& sFilePath),
        "Reads a message of any type. A text that is not well-formed sets ParseError and ErrorMessage and leaves "
        "everything else as it was. The result is always empty.");
    VARNEX_PROPERTY(Text, sRepairerID, RepairerID, "Identifier of the repairer.");
    VARNEX_PROPERTY(Text, sFileName, FileName, "Name of the message's file; empty until a text was read.");
    VARNEX_PROPERTY(Text, sFilePath, FilePath, "Full path of the message's file; empty until a text was read.");
    VARNEX_ACCESSORS(Text, MessageType, "Name of the root element. Setting a recognised name sets MessageTypeID, too.");
    VARNEX_ACCESSORS(XaloMessageTypeEnum, MessageTypeID, "Type of the message. Setting 0 to 16 sets MessageType, too.");
    VARNEX_ACCESSORS(Text, MessageDescription,
                     "The message's type in words; a text set here shows only while MessageTypeID is outside 0 to 16.");
    VARNEX_PROPERTY(Text, sQuoteNo, QuoteNo, "Quote number.");
    VARNEX_PROPERTY(Text, sMessageNo, MessageNo, "Message number; of an error message the number it relates to.");
    VARNEX_PROPERTY(Text, sRegistration, Registration, "Registration number of the vehicle.");
    VARNEX_PROPERTY(Text, sClaimNo, ClaimNo, "Claim number.");
    VARNEX_PROPERTY(Text, sCustomer, Customer, "Forename and surname of the customer.");
    VARNEX_PROPERTY(Text, sVehicleDesciption, VehicleDesciption,
                    "Make and model of the vehicle; the name is spelled so.");
    VARNEX_PROPERTY(Text, sVehicleID, VehicleID, "The insurer's identifier of the vehicle.");
    VARNEX_PROPERTY(bool, bParseError, ParseError, "Whether the last ParseXML met a text that is not well-formed.");
    VARNEX_PROPERTY(Text, sErrorMessage, ErrorMessage, "File, line and reason of the failure; empty after a success.");
    VARNEX_ACCESSORS(Text, SourceXML, "The message written out again as text.");
    VARNEX_PROPERTY(Text, sVarnexStatusCode, VarnexStatusCode, "Status code of a quote.");
    VARNEX_PROPERTY(Text, sVarnexStatusDescription, VarnexStatusDescription, "For the host alone: never filled here.");

public:
    // Summarises a document that is loaded already, and keeps it: the same as ParseXML of its text.
    // Precondition: it is not empty.
    void Adopt(xml::Document loaded, const Text& fileName, const Text& filePath);

    // The same for what was loaded from a file. A file that is not well-formed reads as an empty text: the summary
    // then tells of that one's failure, whatever the file's own; the document's error has the true one.
    void AdoptFile(xml::Document loaded, const Text& fileName, const Text& filePath);

private:
    Text ValueAt(Name path) const;
    void Summarise();

    Text sMessageType;
    XaloMessageTypeEnum eMessageTypeID{};
    Text sMessageDescription;
    Text sSourceXML;
    xml::Document document;
    bool bLoaded = false;         // once a text was read, for good
    bool bSourceIsCurrent = true; // false while sSourceXML is still to be made from the document
    VARNEX_RECORD_END;
};

} // namespace varnex3
