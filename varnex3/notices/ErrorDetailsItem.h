// One thing that was wrong with a message: its severity, and up to four kinds of error.
#pragma once

#include <memory>

#include "varnex3/core/ReferenceSet.h"
#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(XaloErrorType, "The kinds of error. A detail without any has 0, which is none of them.",
            (Xalo_DataContentError, 1, "An element held a bad value."),
            (Xalo_MessageOrderError, 2, "A message arrived out of order."),
            (Xalo_MessageTypeError, 3, "The message was of a type that is not accepted."),
            (Xalo_MiscellaneousError, 4, "Anything else."));

class ErrorDetailsDefDataContentError final : public Record
{
    VARNEX_RECORD(ErrorDetailsDefDataContentError, "An element that held a bad value.");
    VARNEX_SERIALISE("The DataContentError group with the texts that are not empty; nothing when all are. Nothing is "
                     "escaped.");
    VARNEX_PARSEXML(Variant, "Reads the three texts; an absent one is empty.");
    VARNEX_PROPERTY(Text, sDescription, Description, "What is wrong.");
    VARNEX_PROPERTY(Text, sElementName, ElementName, "Name of the element.");
    VARNEX_PROPERTY(Text, sValue, Value, "The bad value.");

public:
    static constexpr int kLevel = 2;
    VARNEX_RECORD_END;
};

class ErrorDetailsDefMessageOrderError final : public Record
{
    VARNEX_RECORD(ErrorDetailsDefMessageOrderError, "A message that arrived out of order.");
    VARNEX_SERIALISE("The MessageOrderError group; nothing when the description is empty and both numbers are below 1. "
                     "Each number is written when the other one is greater than 0.");
    VARNEX_PARSEXML(Variant, "Reads description and numbers; an absent one is empty or 0. A number that is none raises "
                             "TypeMismatch (13), one beyond 16 bits Overflow (6).");
    VARNEX_PROPERTY(Text, sDescription, Description, "What is wrong.");
    VARNEX_PROPERTY(std::int16_t, iExpectedMessageNo, ExpectedMessageNo, "Number of the message that was expected.");
    VARNEX_PROPERTY(std::int16_t, iReceivedMessageNo, ReceivedMessageNo, "Number of the message that arrived.");

public:
    static constexpr int kLevel = 2;
    VARNEX_RECORD_END;
};

class ErrorDetailsDefMessageTypeError final : public Record
{
    VARNEX_RECORD(ErrorDetailsDefMessageTypeError, "A message of a type that is not accepted.");
    VARNEX_SERIALISE("The MessageTypeError group with the description; nothing when that is empty.");
    VARNEX_PARSEXML(Variant, "Reads the description; an absent one is empty.");
    VARNEX_PROPERTY(Text, sDescription, Description, "What is wrong.");

public:
    static constexpr int kLevel = 2;
    VARNEX_RECORD_END;
};

class ErrorDetailsDefMiscellaneousError final : public Record
{
    VARNEX_RECORD(ErrorDetailsDefMiscellaneousError, "An error of no other kind.");
    VARNEX_SERIALISE("The MiscellaneousError group with the description; nothing when that is empty.");
    VARNEX_PARSEXML(Variant, "Reads the description; an absent one is empty.");
    VARNEX_PROPERTY(Text, sDescription, Description, "What is wrong.");

public:
    static constexpr int kLevel = 2;
    VARNEX_RECORD_END;
};

// A new item loads the reference set of the severities, ERRORSEVERITY, and keeps it. Without a database the set is
// empty; what the database itself refuses is raised.
class ErrorDetailsItem final : public Record
{
    VARNEX_RECORD(ErrorDetailsItem, "One thing that was wrong with a message: a severity and the kinds of error.");
    VARNEX_PROPERTY(Text, sSeverityDescription, SeverityDescription,
                    "The severity in words, which reading finds in the reference set; never written.");
    VARNEX_SERIALISE("The ErrorDetails group, always: the severity and the kinds that are not empty.");
    VARNEX_PARSEXML_OF_MESSAGE(Text,
                               "Reads the severity and every kind that is there, and gives the item written again. "
                               "Absent kinds and a severity that the set does not have leave what they would set as "
                               "it was. A severity with an apostrophe cannot be looked up: 3001, unless there is no "
                               "set; the kinds are then not read.");
    VARNEX_READONLY(XaloErrorType, ErrorType, "The kind that was read last: of several the last in their order.");
    VARNEX_PROPERTY(Text, sSeverity, Severity, "Code of the severity; always written, as it is.");
    VARNEX_PROPERTY(Child<ErrorDetailsDefDataContentError>, objDataContentError, DataContentError,
                    "An element that held a bad value.");
    VARNEX_PROPERTY(Child<ErrorDetailsDefMessageOrderError>, objMessageOrderError, MessageOrderError,
                    "A message that arrived out of order.");
    VARNEX_PROPERTY(Child<ErrorDetailsDefMessageTypeError>, objMessageTypeError, MessageTypeError,
                    "A message of a type that is not accepted.");
    VARNEX_PROPERTY(Child<ErrorDetailsDefMiscellaneousError>, objMiscellaneousError, MiscellaneousError,
                    "An error of no other kind.");

public:
    // The descriptions that are not empty, each followed by the delimiter. The message type stands before the order.
    Text Descriptions(TextView delimiter) const;

private:
    template <class Kind>
    void ReadKind(const XmlSection& section, const Child<Kind>& kind, ElementPath path, XaloErrorType type);

    XaloErrorType eErrorType{};
    std::shared_ptr<RowSet> severities = GetReferenceSet(u"ERRORSEVERITY", u"");
    VARNEX_RECORD_END;
};

} // namespace varnex3
