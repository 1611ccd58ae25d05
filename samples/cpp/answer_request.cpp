// Reads a request for quote and answers it with a quote: answer_request [REQUEST [QUOTE]]
#include <iostream>
#include <varnex3/varnex3.h>
#include <varnex3/xml/Files.h>

using namespace varnex3;
using ItemKind = QuoteItemTypeEnum;

// Who answers whom. A program of yours sends its own name and the time that it is; here the answer is always the same.
static void AddressAnswer(Xalo_Quote& quote, Xalo_RequestForQuote& request)
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
static void RepeatRequest(Xalo_Quote& quote, Xalo_RequestForQuote& request)
{
    quote.VersionField(request.VersionField());
    quote.InsurerField(request.InsurerField());
    quote.RepairerField(request.RepairerField());
    quote.ClaimHeaderField(request.ClaimHeaderField());
    quote.VehicleField(request.VehicleField());
    quote.CustomerField(request.CustomerField());
}

static void FillHeader(Xalo_Quote& quote, Xalo_RequestForQuote& request)
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

static Ref<QuoteItem> AddItem(QuoteItemsDef& items, ItemKind kind, TextView description, double value)
{
    const auto item = items.Add();
    item->ItemNo(static_cast<std::int16_t>(items.Count()));
    item->QuoteItemType(kind); // which of the item's kinds is written
    item->Description(Text(description));
    item->QuoteItemValue(value);
    return item;
}

static void AddHours(QuoteHoursDef& work, double hours, double hourlyRate)
{
    work.Hours(hours);
    work.HourlyRate(hourlyRate);
}

static void AddWork(QuoteItemsDef& items, HourlyRatesDef& rates)
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

static void AddPaint(QuoteItemsDef& items, HourlyRatesDef& rates)
{
    const auto labour =
        AddItem(items, ItemKind::QuoteItemPaintLabour, u"Paint tailgate and bumper", 4 * rates.PaintHourlyRate());
    labour->PaintLabour()->Hours(4);
    const auto materials = AddItem(items, ItemKind::QuoteItemPaintMaterials, u"Paint materials", 158.4);
    materials->PaintMaterials()->PaintValue(158.4);
}

static void AddParts(QuoteItemsDef& items)
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

static void AddOthers(QuoteItemsDef& items)
{
    const auto sensor = AddItem(items, ItemKind::QuoteItemMiscellaneous, u"Calibrate parking sensors", 120);
    sensor->Miscellaneous()->MiscellaneousValue(120);
    sensor->Miscellaneous()->Sublet()->SubletType(u"Electrical");
    sensor->Miscellaneous()->Sublet()->SubletRepairerName(u"Ferny Ridge Auto Electrics");
    AddItem(items, ItemKind::QuoteItemTowing, u"Tow from roundabout", 148)->Towing()->TowingValue(148);
}

static void AddUp(Xalo_Quote& quote)
{
    constexpr double kTaxRate = 10;
    double total = 0;
    for (std::int16_t i = 0; i < quote.QuoteItemsField()->Count(); ++i)
        total += quote.QuoteItemsField()->QuoteItems(i)->QuoteItemValue();
    quote.TotalsField()->GrandTotalExTax(total);
    quote.TotalsField()->TaxRate(kTaxRate);
    quote.TotalsField()->TaxAmount(total * kTaxRate / 100);
}

static Ref<Xalo_Quote> Answer(Xalo_RequestForQuote& request)
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

int main(int count, char** arguments)
{
    const Text requestFile = ToUtf16(count > 1 ? arguments[1] : "samples/messages/request.xml");
    const Text quoteFile = ToUtf16(count > 2 ? arguments[2] : "quote.xml");
    try {
        const auto request = New<Xalo_RequestForQuote>();
        request->ParseXML(ToUtf16(xml::ReadFile(requestFile)));
        const auto quote = Answer(*request);
        xml::WriteFileAtomically(quoteFile, ToUtf8(quote->Serialise()));
        std::cout << "Claim " << ToUtf8(quote->ClaimHeaderField()->InsuranceClaimNo()) << ", "
                  << ToUtf8(quote->VehicleField()->Description()) << ": " << quote->QuoteItemsField()->Count()
                  << " items, " << ToUtf8(FormatAmount(quote->TotalsField()->GrandTotalExTax())) << " and "
                  << ToUtf8(FormatAmount(quote->TotalsField()->TaxAmount())) << " tax\n";
        return 0;
    } catch (const std::exception& error) { // one of the library's, or a file that the system refuses
        std::cout << error.what() << '\n';
        return 1;
    }
}
