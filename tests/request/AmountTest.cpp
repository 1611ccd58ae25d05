// Amounts that cannot be written: what no rule file can hold.
#include <limits>

#include "tests/Printing.h"
#include "varnex3/quote/Xalo_Quote.h"
#include "varnex3/request/Xalo_RequestForQuote.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();

template <class Action>
Text DescriptionOf(Action action)
{
    try {
        action();
        return u"none";
    } catch (const Error& error) {
        return error.Description();
    }
}

} // namespace

TEST_CASE("An infinite or undefined amount raises 6 in the name of its record, the element named")
{
    for (const double amount : {kInfinity, -kInfinity, kNotANumber}) {
        const auto details = New<RequestDetailsDef>();
        details->ExcessToCollect(amount);
        CHECK(RaisedBy([&] { details->Serialise(); }) == "6 RequestDetailsDef.Serialise");
        CHECK(DescriptionOf([&] { details->Serialise(); }).starts_with(u"ExcessToCollect: "));
        const auto totals = New<TotalsDef>();
        totals->TaxRate(amount);
        CHECK(RaisedBy([&] { totals->Serialise(); }) == "6 TotalsDef.Serialise");
        CHECK(DescriptionOf([&] { totals->Serialise(); }).starts_with(u"TaxRate: "));
    }
}

TEST_CASE("The error of an amount comes through the whole message, in the name of the record that has the amount")
{
    const auto quote = New<Xalo_Quote>();
    quote->QuoteDetailsField()->QuoteType(u"A");
    quote->QuoteDetailsField()->OwnersContributionToCollect()->Reason(u"x");
    quote->QuoteDetailsField()->OwnersContributionToCollect()->Value(kInfinity);
    CHECK(RaisedBy([&] { quote->Serialise(); }) == "6 OwnersContributionToCollectDef.Serialise");
    quote->QuoteDetailsField()->ExcessToCollect(kInfinity);
    CHECK(RaisedBy([&] { quote->Serialise(); }) == "6 QuoteDetailsDef.Serialise");
    const auto request = New<Xalo_RequestForQuote>();
    request->RequestDetailsField()->ExcessToCollect(kNotANumber);
    CHECK(RaisedBy([&] { request->Serialise(); }) == "6 RequestDetailsDef.Serialise");
}

TEST_CASE("Not-a-number is not greater than 0: an amount that is written only then is left out, and causes nothing")
{
    const auto details = New<RequestDetailsDef>();
    const Text before = details->Serialise();
    details->SumInsured(kNotANumber);
    CHECK(details->Serialise() == before);
    details->SumInsured(kInfinity);
    CHECK(RaisedBy([&] { details->Serialise(); }) == "6 RequestDetailsDef.Serialise");
    const auto rates = New<HourlyRatesDef>();
    rates->PaintHourlyRate(kNotANumber);
    CHECK(rates->Serialise() == u"");
    rates->RepairHourlyRate(1);
    CHECK(RaisedBy([&] { rates->Serialise(); }) == "6 HourlyRatesDef.Serialise");
}

TEST_CASE("A date outside the years 100 to 9999 raises 6 when it is written")
{
    const auto quote = New<Xalo_Quote>();
    quote->QuoteDateField(Date{1e9});
    CHECK(RaisedBy([&] { quote->Serialise(); }) == "6 modFunctions.FormatDate");
}
