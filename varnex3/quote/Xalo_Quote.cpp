#include "varnex3/quote/Xalo_Quote.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_Quote);

void Xalo_Quote::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_Quote");
    xml.Append(objVersionField);
    xml.Append(objSourceField);
    xml.Append(objDestinationField);
    xml.Always("MessageNo", sMessageNoField);
    xml.Append(objInsurerField);
    xml.Append(objRepairerField);
    xml.Append(objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.IfSet("QuoteDate", dtQuoteDateField);
    xml.Append(objVarnexStatusField);
    xml.Append(objInspectionReqestedField);
    xml.Append(objQuoteDetailsField);
    xml.Append(objVehicleField);
    xml.Append(objVehicleDetailsField);
    xml.Append(objHourlyRatesField);
    xml.IfSet("Defines", sDefinesField);
    xml.Append(objQuoteItemsField);
    xml.Append(objTotalsField);
    xml.Append(objAssessmentField);
    xml.Append(objCustomerField);
    xml.Always("ImageCount", std::int32_t{iImageCountField});
    xml.CloseMessage("Xalo_Quote");
}

void Xalo_Quote::Read(const XmlSection& section)
{
    section.ReadInto(objVersionField, "Xalo_Quote/Version");
    section.ReadInto(objSourceField, "Xalo_Quote/Source");
    section.ReadInto(objDestinationField, "Xalo_Quote/Destination");
    sMessageNoField = section.TextAt("Xalo_Quote/MessageNo");
    section.ReadInto(objInsurerField, "Xalo_Quote/Insurer");
    section.ReadInto(objRepairerField, "Xalo_Quote/Repairer");
    section.ReadInto(objClaimHeaderField, "Xalo_Quote/ClaimHeader");
    sQuoteNoField = section.TextAt("Xalo_Quote/QuoteNo");
    dtQuoteDateField = section.TimestampAt("Xalo_Quote/QuoteDate"); // may be left out by Write
    section.ReadIntoWhereUsed(objVarnexStatusField, "Xalo_Quote/VarnexStatus");
    section.ReadIntoWhereUsed(objInspectionReqestedField, "Xalo_Quote/Inspection"); // not the name that Write writes
    section.ReadInto(objQuoteDetailsField, "Xalo_Quote/QuoteDetails");
    section.ReadInto(objVehicleField, "Xalo_Quote/Vehicle");
    section.ReadInto(objVehicleDetailsField, "Xalo_Quote/VehicleDetails");
    section.ReadInto(objHourlyRatesField, "Xalo_Quote/HourlyRates");
    sDefinesField = section.TextAt("Xalo_Quote/Defines");
    section.ReadInto(objQuoteItemsField, "Xalo_Quote/QuoteItems");
    section.ReadInto(objTotalsField, "Xalo_Quote/Totals");
    section.ReadIntoWhereUsed(objAssessmentField, "Xalo_Quote/Assessment");
    section.ReadInto(objCustomerField, "Xalo_Quote/Customer");
    iImageCountField = section.Int16At("Xalo_Quote/ImageCount");
}

} // namespace varnex3
