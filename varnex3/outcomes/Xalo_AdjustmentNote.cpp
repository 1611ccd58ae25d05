#include "varnex3/outcomes/Xalo_AdjustmentNote.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_AdjustmentNote);

void Xalo_AdjustmentNote::Write(XmlWriter& xml) const
{
    xml.OpenMessage("Xalo_AdjustmentNote");
    xml.Append(objVersionField, objSourceField, objDestinationField);
    xml.IfSet("MessageNo", sMessageNoField);
    xml.Append(objInsurerField, objRepairerField, objClaimHeaderField);
    xml.IfSet("QuoteNo", sQuoteNoField);
    xml.Append(objVehicleField, objAdjustmentNoteDetailsField, objPaymentDetailsField);
    if (IsSet(sOpenTextField))
        xml.Line(u"<OpenText>" + sOpenTextField + u"</OpenTextField>"); // not the start tag's name
    xml.CloseMessage("Xalo_AdjustmentNote");
}

} // namespace varnex3
