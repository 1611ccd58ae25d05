"""Reads a request for quote and answers it with a quote: python3 answer_request.py [REQUEST [QUOTE]]"""

import sys
from datetime import datetime
from pathlib import Path

import varnex3
from varnex3 import PartSourceTypeEnum, QuoteItemTypeEnum


def address_answer(quote, request) -> None:
    """Who answers whom. A program of yours sends its own name and the time; here the answer is always the same."""
    quote.SourceField.OrgType = "REP"
    quote.SourceField.AppName = "Workshop"
    quote.SourceField.AppVersion = "2.1"
    quote.SourceField.TimeStamp = datetime(2008, 5, 14, 11, 20, 5)
    quote.DestinationField.OrgType = request.SourceField.OrgType
    quote.MessageNoField = "5012"
    quote.QuoteNoField = "Q005933"
    quote.QuoteDateField = datetime(2008, 5, 14)


def repeat_request(quote, request) -> None:
    """What the insurer said goes back as it came: a record may belong to several messages."""
    quote.VersionField = request.VersionField
    quote.InsurerField = request.InsurerField
    quote.RepairerField = request.RepairerField
    quote.ClaimHeaderField = request.ClaimHeaderField
    quote.VehicleField = request.VehicleField
    quote.CustomerField = request.CustomerField


def fill_header(quote, request) -> None:
    details = quote.QuoteDetailsField
    details.QuoteType = request.RequestDetailsField.RequestType
    details.EstimatedStartDate = datetime(2008, 5, 19)
    details.EstimatedEndDate = datetime(2008, 5, 23)
    details.ExcessToCollect = request.RequestDetailsField.ExcessToCollect
    details.OpenText = "Boot floor to be measured once bumper & lining are off"  # escaped when it is written
    details.QuoterName = "J. Merriweather"
    quote.VehicleDetailsField.Odometer.OdometerReading = "41870"
    quote.VehicleDetailsField.Colour = "Saltbush Green"
    quote.HourlyRatesField.RemoveReplaceHourlyRate = 82
    quote.HourlyRatesField.RepairHourlyRate = 82
    quote.HourlyRatesField.PaintHourlyRate = 88
    quote.HourlyRatesField.MechanicalHourlyRate = 104


def add_item(items, kind: QuoteItemTypeEnum, description: str, value: float):
    item = items.Add()
    item.ItemNo = items.Count
    item.QuoteItemType = kind  # which of the item's kinds is written
    item.Description = description
    item.QuoteItemValue = value
    return item


def add_hours(work, hours: float, hourly_rate: float) -> None:
    work.Hours = hours
    work.HourlyRate = hourly_rate


def add_work(items, rates) -> None:
    removing = rates.RemoveReplaceHourlyRate
    repairing = rates.RepairHourlyRate
    mechanical = rates.MechanicalHourlyRate
    item = add_item(items, QuoteItemTypeEnum.QuoteItemRemoveReplace, "Remove and replace rear bumper", 2.25 * removing)
    add_hours(item.RemoveReplace, 2.25, removing)
    item = add_item(items, QuoteItemTypeEnum.QuoteItemRepair, "Repair tailgate", 3.5 * repairing)
    add_hours(item.Repair, 3.5, repairing)
    item = add_item(items, QuoteItemTypeEnum.QuoteItemMechanical, "Check rear wheel alignment", 0.5 * mechanical)
    add_hours(item.Mechanical, 0.5, mechanical)


def add_paint(items, rates) -> None:
    value = 4 * rates.PaintHourlyRate
    labour = add_item(items, QuoteItemTypeEnum.QuoteItemPaintLabour, "Paint tailgate and bumper", value)
    labour.PaintLabour.Hours = 4
    materials = add_item(items, QuoteItemTypeEnum.QuoteItemPaintMaterials, "Paint materials", 158.4)
    materials.PaintMaterials.PaintValue = 158.4


def add_parts(items) -> None:
    bumper = add_item(items, QuoteItemTypeEnum.QuoteItemPart, "Rear bumper bar", 385)
    bumper.Part.PartValue = 385
    bumper.Part.PartQuantity = 1
    bumper.Part.PartSource.Category = PartSourceTypeEnum.OEM  # the source that needs a part number
    bumper.Part.PartSource.PartNumber = "CR-52159-0V2"
    lamp = add_item(items, QuoteItemTypeEnum.QuoteItemPart, "Tail lamp", 96.6)
    lamp.Part.PartValue = 96.6
    lamp.Part.PartQuantity = 1
    lamp.Part.PartOrientationCode = "R"
    lamp.Part.PartSource.Category = PartSourceTypeEnum.Used


def add_others(items) -> None:
    sensor = add_item(items, QuoteItemTypeEnum.QuoteItemMiscellaneous, "Calibrate parking sensors", 120)
    sensor.Miscellaneous.MiscellaneousValue = 120
    sensor.Miscellaneous.Sublet.SubletType = "Electrical"
    sensor.Miscellaneous.Sublet.SubletRepairerName = "Ferny Ridge Auto Electrics"
    towing = add_item(items, QuoteItemTypeEnum.QuoteItemTowing, "Tow from roundabout", 148)
    towing.Towing.TowingValue = 148


def add_up(quote) -> None:
    tax_rate = 10
    items = quote.QuoteItemsField
    total = sum(items.QuoteItems(i).QuoteItemValue for i in range(items.Count))
    quote.TotalsField.GrandTotalExTax = total
    quote.TotalsField.TaxRate = tax_rate
    quote.TotalsField.TaxAmount = total * tax_rate / 100


def answer(request) -> varnex3.Record:
    quote = varnex3.Xalo_Quote()
    address_answer(quote, request)
    repeat_request(quote, request)
    fill_header(quote, request)
    add_work(quote.QuoteItemsField, quote.HourlyRatesField)
    add_paint(quote.QuoteItemsField, quote.HourlyRatesField)
    add_parts(quote.QuoteItemsField)
    add_others(quote.QuoteItemsField)
    add_up(quote)
    return quote


def main(request_file: str = "samples/messages/request.xml", quote_file: str = "quote.xml") -> int:
    try:
        request = varnex3.Xalo_RequestForQuote()
        request.ParseXML(Path(request_file).read_text(encoding="utf-8"))
        quote = answer(request)
        Path(quote_file).write_bytes(quote.Serialise().encode())
    except (varnex3.Error, OSError) as error:
        print(error)
        return 1
    totals = quote.TotalsField
    print(f"Claim {quote.ClaimHeaderField.InsuranceClaimNo}, {quote.VehicleField.Description}: "
          f"{quote.QuoteItemsField.Count} items, {totals.GrandTotalExTax:.2f} and {totals.TaxAmount:.2f} tax")
    return 0


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:3]))
