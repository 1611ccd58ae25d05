#include "varnex3/notices/ErrorDetailsItem.h"

namespace varnex3 {

VARNEX_DEFINE(ErrorDetailsItem);
VARNEX_DEFINE(ErrorDetailsDefDataContentError);
VARNEX_DEFINE(ErrorDetailsDefMessageOrderError);
VARNEX_DEFINE(ErrorDetailsDefMessageTypeError);
VARNEX_DEFINE(ErrorDetailsDefMiscellaneousError);

XaloErrorType ErrorDetailsItem::ErrorType() const { return eErrorType; }

Text ErrorDetailsItem::Descriptions(TextView delimiter) const
{
    Text joined;
    for (const Text& description : {objDataContentError->Description(), objMessageTypeError->Description(),
                                    objMessageOrderError->Description(), objMiscellaneousError->Description()})
        if (IsSet(description))
            joined.append(description).append(delimiter);
    return joined;
}

void ErrorDetailsItem::Write(XmlWriter& xml) const
{
    xml.Open("ErrorDetails");
    xml.Always("Severity", sSeverity);
    xml.Append(objDataContentError);
    xml.Append(objMessageOrderError);
    xml.Append(objMessageTypeError);
    xml.Append(objMiscellaneousError);
    xml.Close("ErrorDetails");
}

void ErrorDetailsItem::Read(const XmlSection& section)
{
    sSeverity = section.TextAt("ErrorDetails/Severity");
    sSeverityDescription = FindDescription(*severities, sSeverity).value_or(sSeverityDescription);
    ReadKind(section, objDataContentError, "ErrorDetails/DataContentError", XaloErrorType::Xalo_DataContentError);
    ReadKind(section, objMessageOrderError, "ErrorDetails/MessageOrderError", XaloErrorType::Xalo_MessageOrderError);
    ReadKind(section, objMessageTypeError, "ErrorDetails/MessageTypeError", XaloErrorType::Xalo_MessageTypeError);
    ReadKind(section, objMiscellaneousError, "ErrorDetails/MiscellaneousError", XaloErrorType::Xalo_MiscellaneousError);
}

// One that is absent keeps its values.
template <class Kind>
void ErrorDetailsItem::ReadKind(const XmlSection& section, const Child<Kind>& kind, ElementPath path,
                                XaloErrorType type)
{
    if (!section.Has(path))
        return;
    section.ReadInto(kind, path);
    eErrorType = type;
}

// ---- the kinds

void ErrorDetailsDefDataContentError::Write(XmlWriter& xml) const
{
    if (!IsSet(sDescription) && !IsSet(sElementName) && !IsSet(sValue))
        return;

    xml.Open("DataContentError");
    xml.IfSet("Description", sDescription);
    xml.IfSet("ElementName", sElementName);
    xml.IfSet("Value", sValue);
    xml.Close("DataContentError");
}

void ErrorDetailsDefDataContentError::Read(const XmlSection& section)
{
    sDescription = section.TextAt("DataContentError/Description");
    sElementName = section.TextAt("DataContentError/ElementName");
    sValue = section.TextAt("DataContentError/Value");
}

void ErrorDetailsDefMessageOrderError::Write(XmlWriter& xml) const
{
    if (!IsSet(sDescription) && iExpectedMessageNo < 1 && iReceivedMessageNo < 1)
        return;

    xml.Open("MessageOrderError");
    xml.IfSet("Description", sDescription);
    if (iReceivedMessageNo > 0) // crossed: each number depends on the other one
        xml.Always("ExpectedMessageNo", iExpectedMessageNo);
    if (iExpectedMessageNo > 0)
        xml.Always("ReceivedMessageNo", iReceivedMessageNo);
    xml.Close("MessageOrderError");
}

void ErrorDetailsDefMessageOrderError::Read(const XmlSection& section)
{
    sDescription = section.TextAt("MessageOrderError/Description");
    iExpectedMessageNo = section.Int16At("MessageOrderError/ExpectedMessageNo");
    iReceivedMessageNo = section.Int16At("MessageOrderError/ReceivedMessageNo");
}

void ErrorDetailsDefMessageTypeError::Write(XmlWriter& xml) const
{
    if (!IsSet(sDescription))
        return;

    xml.Open("MessageTypeError");
    xml.Always("Description", sDescription);
    xml.Close("MessageTypeError");
}

void ErrorDetailsDefMessageTypeError::Read(const XmlSection& section)
{
    sDescription = section.TextAt("MessageTypeError/Description");
}

void ErrorDetailsDefMiscellaneousError::Write(XmlWriter& xml) const
{
    if (!IsSet(sDescription))
        return;

    xml.Open("MiscellaneousError");
    xml.Always("Description", sDescription);
    xml.Close("MiscellaneousError");
}

void ErrorDetailsDefMiscellaneousError::Read(const XmlSection& section)
{
    sDescription = section.TextAt("MiscellaneousError/Description");
}

} // namespace varnex3
