// A quote as plain structures, and once for all peers what stands where in its XML: each peer brings an archive that
// reads or writes a group, a text, a number, and is led through the whole message by it.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace varnex3::benchmarks {

// One of the eight kinds of work on an item; which members count depends on the kind.
template <class String>
struct WorkModel
{
    double amount = 0; // hours or dollars
    double rate = 0;
    int quantity = 0;
    String about; // paint group, orientation, type of sublet
    String whom;  // part number, repairer of the sublet
    bool sources[4] = {};
};

enum Kind
{
    RemoveReplace,
    Repair,
    PaintLabour,
    PaintMaterials,
    Part,
    Miscellaneous,
    Mechanical,
    Towing
};

template <class String>
struct ItemModel
{
    int number = 0;
    String code;
    String description;
    double value = 0;
    int kind = RemoveReplace;
    WorkModel<String> work;
    String comment;
    String updateStatus;
    bool isReported = false;
    String defines;
};

template <class String>
struct QuoteModel
{
    String version, senderType, appVersion, appName, timeStamp, receiverType, messageNo;
    String underwriter;
    std::vector<std::pair<String, String>> insurerFields;
    String repairerId, repairerName;
    std::vector<std::pair<String, String>> repairerFields;
    String vehicleId, claimNo;
    int reinstatementNo = 0;
    String quoteNo, quoteDate, status, reason;
    String quoteType, startDate, endDate, openText, quoter, ownerReason;
    double excess = 0, ownerValue = 0;
    String registration, engineNo, vin, buildDate, make, model, series, equipment, body, vehicle;
    String odometer, cylinders, transmission, colour, paintGroup, trimCode, paintCode, optionCode, location, suburb;
    bool isInKilometres = false, isInMiles = false;
    double engineSize = 0;
    double mechanicalRate = 0, paintRate = 0, repairRate = 0, removeReplaceRate = 0;
    String defines;
    std::vector<ItemModel<String>> items;
    double total = 0, taxRate = 0, tax = 0;
    String assessed, assessor, assessorPhone, assessorMobile, assessorFax, assessorEmail;
    String title, forname, surname, homePhone, company, businessPhone, fax, mobilePhone;
    int imageCount = 0;
};

template <class Archive, class String>
void DescribeHours(Archive& to, WorkModel<String>& work)
{
    to.Amount("Hours", work.amount);
    to.AmountIfPositive("HourlyRate", work.rate);
}

template <class Archive, class String>
void DescribePaintLabour(Archive& to, WorkModel<String>& work)
{
    DescribeHours(to, work);
    to.Text("OtherPaintGroup", work.about);
}

template <class Archive, class String>
void DescribePart(Archive& to, WorkModel<String>& work)
{
    to.Amount("PartValue", work.amount);
    to.Whole("PartQuantity", work.quantity);
    to.Text("PartOrientation", work.about);
    to.Group("PartSource", [&] {
        to.Flag("Aftermarket", work.sources[0]);
        to.Flag("Exchange", work.sources[1]);
        to.Flag("Used", work.sources[2]);
        to.FlagWith("OEM", "PartNumber", work.sources[3], work.whom);
    });
}

template <class Archive, class String>
void DescribeMiscellaneous(Archive& to, WorkModel<String>& work)
{
    to.Amount("MiscellaneousValue", work.amount);
    if (to.Wants(work.about) || to.Wants(work.whom))
        to.Group("Sublet", [&] {
            to.Text("SubletType", work.about);
            to.Text("SubletRepairerName", work.whom);
        });
}

template <class Archive, class String>
void DescribeItem(Archive& to, ItemModel<String>& item)
{
    to.Whole("ItemNo", item.number);
    to.Text("Code", item.code);
    to.Text("Description", item.description);
    to.Amount("QuoteItemValue", item.value);
    to.Case("RemoveReplace", item.kind, RemoveReplace, [&] { DescribeHours(to, item.work); });
    to.Case("Repair", item.kind, Repair, [&] { DescribeHours(to, item.work); });
    to.Case("PaintLabour", item.kind, PaintLabour, [&] { DescribePaintLabour(to, item.work); });
    to.Case("PaintMaterials", item.kind, PaintMaterials, [&] { to.Amount("PaintValue", item.work.amount); });
    to.Case("Part", item.kind, Part, [&] { DescribePart(to, item.work); });
    to.Case("Miscellaneous", item.kind, Miscellaneous, [&] { DescribeMiscellaneous(to, item.work); });
    to.Case("Mechanical", item.kind, Mechanical, [&] { DescribeHours(to, item.work); });
    to.Case("Towing", item.kind, Towing, [&] { to.Amount("TowingValue", item.work.amount); });
    to.Text("Comment", item.comment);
    to.Text("UpdateStatus", item.updateStatus);
    to.Flag("ReportOn", item.isReported);
    to.Text("Defines", item.defines);
}

template <class Archive, class Quote>
void DescribeParties(Archive& to, Quote& quote)
{
    to.Group("Version", [&] { to.Text("XaloVersion", quote.version); });
    to.Group("Source", [&] {
        to.Text("OrgType", quote.senderType);
        to.Text("AppVersion", quote.appVersion);
        to.Text("AppName", quote.appName);
        to.Text("TimeStamp", quote.timeStamp);
    });
    to.Group("Destination", [&] { to.Text("OrgType", quote.receiverType); });
    to.Text("MessageNo", quote.messageNo);
    to.Group("Insurer", [&] {
        to.Text("UnderwriterName", quote.underwriter);
        to.Fields("InsurerDetail", "FieldName", quote.insurerFields);
    });
    to.Group("Repairer", [&] {
        to.Text("RepairerID", quote.repairerId);
        to.Text("RepairerName", quote.repairerName);
        to.Fields("RepairerDetails", "FieldName", quote.repairerFields);
    });
    to.Group("ClaimHeader", [&] {
        to.Text("VehicleID", quote.vehicleId);
        to.Text("InsuranceClaimNo", quote.claimNo);
        to.Whole("ReinstatementNo", quote.reinstatementNo);
    });
}

template <class Archive, class Quote>
void DescribeDetails(Archive& to, Quote& quote)
{
    to.Text("QuoteNo", quote.quoteNo);
    to.Text("QuoteDate", quote.quoteDate);
    if (to.Wants(quote.status) || to.Wants(quote.reason))
        to.Group("VarnexStatus", [&] {
            to.Text("Status", quote.status);
            to.Text("Reason", quote.reason);
        });
    to.Group("QuoteDetails", [&] {
        to.Text("QuoteType", quote.quoteType);
        to.Text("EstimatedStartDate", quote.startDate);
        to.Text("EstimatedEndDate", quote.endDate);
        to.Amount("ExcessToCollect", quote.excess);
        if (to.Wants(quote.ownerReason))
            to.Group("OwnersContributionToCollect", [&] {
                to.Amount("Value", quote.ownerValue);
                to.Text("Reason", quote.ownerReason);
            });
        to.Text("OpenText", quote.openText);
        to.Text("QuoterName", quote.quoter);
    });
}

template <class Archive, class Quote>
void DescribeVehicle(Archive& to, Quote& quote)
{
    to.Group("Vehicle", [&] {
        to.Text("RegistrationNo", quote.registration);
        to.Text("EngineNo", quote.engineNo);
        to.Text("VIN", quote.vin);
        to.Text("BuildDate", quote.buildDate);
        to.Text("Make", quote.make);
        to.Text("ModelID", quote.model);
        to.Text("Series", quote.series);
        to.Text("EquipmentLevel", quote.equipment);
        to.Text("BodyStyle", quote.body);
        to.Text("Description", quote.vehicle);
    });
    to.Group("VehicleDetails", [&] {
        to.Group("Odometer", [&] {
            to.Text("OdometerReading", quote.odometer);
            to.Flag("OdometerUnitKm", quote.isInKilometres);
            to.Flag("OdometerUnitMiles", quote.isInMiles);
        });
        to.AmountIfPositive("EngineSize", quote.engineSize);
        to.Text("NoOfCylinders", quote.cylinders);
        to.Text("Transmission", quote.transmission);
        to.Text("Colour", quote.colour);
        to.Text("ManufacturerPaintGroup", quote.paintGroup);
        to.Text("ManufacturerTrimCode", quote.trimCode);
        to.Text("PaintCode", quote.paintCode);
        to.Text("OptionCode", quote.optionCode);
        to.Text("VehicleLocation", quote.location);
        to.Text("VehicleSuburb", quote.suburb);
    });
    to.Group("HourlyRates", [&] {
        to.Amount("MechanicalHourlyRate", quote.mechanicalRate);
        to.Amount("PaintHourlyRate", quote.paintRate);
        to.Amount("RepairHourlyRate", quote.repairRate);
        to.Amount("RemoveReplaceHourlyRate", quote.removeReplaceRate);
    });
}

template <class Archive, class Quote>
void DescribeCustomer(Archive& to, Quote& quote)
{
    to.Group("Customer", [&] {
        to.Group("PersonalName", [&] {
            to.Text("Title", quote.title);
            to.Text("Forname", quote.forname);
            to.Text("Surname", quote.surname);
            to.Text("HomePhone", quote.homePhone);
        });
        to.Text("CompanyName", quote.company);
        to.Text("BusinessPhone", quote.businessPhone);
        to.Text("Fax", quote.fax);
        to.Text("MobilePhone", quote.mobilePhone);
    });
}

template <class Archive, class Quote>
void DescribeQuote(Archive& to, Quote& quote)
{
    DescribeParties(to, quote);
    DescribeDetails(to, quote);
    DescribeVehicle(to, quote);
    to.Text("Defines", quote.defines);
    to.Group("QuoteItems", [&] { to.Each("QuoteItem", quote.items, [&](auto& item) { DescribeItem(to, item); }); });
    to.Group("Totals", [&] {
        to.Amount("GrandTotalExTax", quote.total);
        to.Amount("TaxRate", quote.taxRate);
        to.Amount("TaxAmount", quote.tax);
    });
    if (to.Wants(quote.assessed))
        to.Group("Assessment", [&] {
            to.Text("AssessmentDate", quote.assessed);
            to.Text("AssessorName", quote.assessor);
            to.Text("AssessorPhone", quote.assessorPhone);
            to.Text("AssessorMobile", quote.assessorMobile);
            to.Text("AssessorFax", quote.assessorFax);
            to.Text("AssessorEmail", quote.assessorEmail);
        });
    DescribeCustomer(to, quote);
    to.Whole("ImageCount", quote.imageCount);
}

} // namespace varnex3::benchmarks
