// Messages read through their sections as each section's record reads its own markup.
#include "tests/MessageSections.h"
#include "varnex3/outcomes/Xalo_JobCancelled.h"
#include "varnex3/outcomes/Xalo_PaymentAuthorised.h"
#include "varnex3/outcomes/Xalo_PaymentDeclined.h"

using namespace varnex3;
using namespace varnex3::tests;

namespace {

SectionForms EnvelopeAnd(std::initializer_list<SectionForm> own)
{
    SectionForms forms = Envelope();
    forms.insert(forms.end(), own);
    return forms;
}

SectionForms SectionsOfAuthority()
{
    return EnvelopeAnd({Vehicle(),
                        {"PayAuthorityDetailsField",
                         u"PayAuthorityDetails",
                         u"",
                         {u"RepairerTaxInvoiceNo", u"PayAuthorisedDate", u"PaymentAmount"}}});
}

SectionForms SectionsOfRefusal()
{
    const std::vector<Text> figures = {u"RepairerTaxInvoiceNo",
                                       u"TaxInvoiceDate",
                                       u"TotalExcludingTax",
                                       u"TotalTaxAmount",
                                       u"TaxRate",
                                       u"OwnersContributionToCollect",
                                       u"Value",
                                       u"Reason"};
    return EnvelopeAnd({Vehicle(),
                        {"LastInvoiceDetailsField", u"LastInvoiceDetails", u"", figures},
                        {"ExpectedPaymentDetailsField", u"ExpectedPaymentDetails", u"", figures}});
}

template <class Message>
void CheckReadings(const SectionForms& forms, unsigned seed)
{
    const auto [read, failed] = CompareReadings<Message>(forms, u"", seed);
    CHECK(read > 100);
    CHECK(failed > 100);
}

} // namespace

TEST_CASE("Each section reads from the whole message as from its own markup")
{
    CompareSections<Xalo_PaymentAuthorised>(SectionsOfAuthority(), u"");
    CompareSections<Xalo_PaymentDeclined>(SectionsOfRefusal(), u"");
    CompareSections<Xalo_JobCancelled>(Envelope(), u"");
}

TEST_CASE("The whole message reads as its sections one by one, also to the same error")
{
    CheckReadings<Xalo_PaymentAuthorised>(SectionsOfAuthority(), 21);
    CheckReadings<Xalo_PaymentDeclined>(SectionsOfRefusal(), 22);
    CheckReadings<Xalo_JobCancelled>(Envelope(), 23);
}
