// The quote that answers a request: what a workshop's program would take from its own data.
#pragma once

#include <varnex3/varnex3.h>

namespace answer {

using namespace varnex3;
using ItemKind = QuoteItemTypeEnum;

// Who answers whom. A program of yours sends its own name and the time that it is; here the answer is always the same.
inline void AddressAnswer(Xalo_Quote& quote, Xalo_RequestForQuote& request)
{
    quote.SourceField()->OrgType(u"REP");
    quote.SourceField()->AppName(u"Workshop");
    quote.SourceField()->AppVersion(u"2.1");
    quote.SourceField()->TimeStamp(*DateFrom({2008, 5, 14, 11, 20, 5}));
    quote.DestinationField()->OrgType(request.SourceField()->OrgType());
    quote.MessageNoField(u"5012");
    quote.QuoteNoField(u"Q005933");
    quote.QuoteDateField(*DateFrom({2008, 5, 14}));
}

// What the insurer said goes back as it came: a record may belong to several messages.
inline void RepeatRequest(Xalo_Quote& quote, Xalo_RequestForQuote& request)
{
    quote.VersionField(request.VersionField());
    quote.InsurerField(request.InsurerField());
    quote.RepairerField(request.RepairerField());
    quote.ClaimHeaderField(request.ClaimHeaderField());
    quote.VehicleField(request.VehicleField());
    quote.CustomerField(request.CustomerField());
}

inline void FillHeader(Xalo_Quote& quote, Xalo_RequestForQuote& request)
{
    const auto details = quote.QuoteDetailsField();
    details->QuoteType(request.RequestDetailsField()->RequestType());
    details->EstimatedStartDate(*DateFrom({2008, 5, 19}));
    details->EstimatedEndDate(*DateFrom({2008, 5, 23}));
    details->ExcessToCollect(request.RequestDetailsField()->ExcessToCollect());
    details->OpenText(u"Boot floor to be measured once bumper & lining are off"); // escaped when it is written
    details->QuoterName(u"J. Merriweather");
    quote.VehicleDetailsField()->Odometer()->OdometerReading(u"41870");
    quote.VehicleDetailsField()->Colour(u"Saltbush Green");
    quote.HourlyRatesField()->RemoveReplaceHourlyRate(82);
    quote.HourlyRatesField()->RepairHourlyRate(82);
    quote.HourlyRatesField()->PaintHourlyRate(88);
    quote.HourlyRatesField()->MechanicalHourlyRate(104);
}

inline Ref<QuoteItem> AddItem(QuoteItemsDef& items, ItemKind kind, TextView description, double value)
{
    const auto item = items.Add();
    item->ItemNo(static_cast<std::int16_t>(items.Count()));
    item->QuoteItemType(kind); // which of the item's kinds is written
    item->Description(Text(description));
    item->QuoteItemValue(value);
    return item;
}

inline void AddHours(QuoteHoursDef& work, double hours, double hourlyRate)
{
    work.Hours(hours);
    work.HourlyRate(hourlyRate);
}

inline void AddWork(QuoteItemsDef& items, HourlyRatesDef& rates)
{
    const double removing = rates.RemoveReplaceHourlyRate();
    const double repairing = rates.RepairHourlyRate();
    const double mechanical = rates.MechanicalHourlyRate();
    AddHours(*AddItem(items, ItemKind::QuoteItemRemoveReplace, u"Remove and replace rear bumper", 2.25 * removing)
                  ->RemoveReplace(),
             2.25, removing);
    AddHours(*AddItem(items, ItemKind::QuoteItemRepair, u"Repair tailgate", 3.5 * repairing)->Repair(), 3.5, repairing);
    AddHours(
        *AddItem(items, ItemKind::QuoteItemMechanical, u"Check rear wheel alignment", 0.5 * mechanical)->Mechanical(),
        0.5, mechanical);
}

inline void AddPaint(QuoteItemsDef& items, HourlyRatesDef& rates)
{
    const auto labour =
        AddItem(items, ItemKind::QuoteItemPaintLabour, u"Paint tailgate and bumper", 4 * rates.PaintHourlyRate());
    labour->PaintLabour()->Hours(4);
    const auto materials = AddItem(items, ItemKind::QuoteItemPaintMaterials, u"Paint materials", 158.4);
    materials->PaintMaterials()->PaintValue(158.4);
}

inline void AddParts(QuoteItemsDef& items)
{
    const auto bumper = AddItem(items, ItemKind::QuoteItemPart, u"Rear bumper bar", 385);
    bumper->Part()->PartValue(385);
    bumper->Part()->PartQuantity(1);
    bumper->Part()->PartSource()->Category(PartSourceTypeEnum::OEM); // the source that needs a part number
    bumper->Part()->PartSource()->PartNumber(u"CR-52159-0V2");
    const auto lamp = AddItem(items, ItemKind::QuoteItemPart, u"Tail lamp", 96.6);
    lamp->Part()->PartValue(96.6);
    lamp->Part()->PartQuantity(1);
    lamp->Part()->PartOrientationCode(u"R");
    lamp->Part()->PartSource()->Category(PartSourceTypeEnum::Used);
}

inline void AddOthers(QuoteItemsDef& items)
{
    const auto sensor = AddItem(items, ItemKind::QuoteItemMiscellaneous, u"Calibrate parking sensors", 120);
    sensor->Miscellaneous()->MiscellaneousValue(120);
    sensor->Miscellaneous()->Sublet()->SubletType(u"Electrical");
    sensor->Miscellaneous()->Sublet()->SubletRepairerName(u"Ferny Ridge Auto Electrics");
    AddItem(items, ItemKind::QuoteItemTowing, u"Tow from roundabout", 148)->Towing()->TowingValue(148);
}

inline void AddUp(Xalo_Quote& quote)
{
    constexpr double kTaxRate = 10;
    double total = 0;
    for (std::int16_t i = 0; i < quote.QuoteItemsField()->Count(); ++i)
        total += quote.QuoteItemsField()->QuoteItems(i)->QuoteItemValue();
    quote.TotalsField()->GrandTotalExTax(total);
    quote.TotalsField()->TaxRate(kTaxRate);
    quote.TotalsField()->TaxAmount(total * kTaxRate / 100);
}

inline Ref<Xalo_Quote> Answer(Xalo_RequestForQuote& request)
{
    const auto quote = New<Xalo_Quote>();
    AddressAnswer(*quote, request);
    RepeatRequest(*quote, request);
    FillHeader(*quote, request);
    AddWork(*quote->QuoteItemsField(), *quote->HourlyRatesField());
    AddPaint(*quote->QuoteItemsField(), *quote->HourlyRatesField());
    AddParts(*quote->QuoteItemsField());
    AddOthers(*quote->QuoteItemsField());
    AddUp(*quote);
    return quote;
}

} // namespace answer
