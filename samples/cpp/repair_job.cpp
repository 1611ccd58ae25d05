// One repair job from the request to the payment, in the eight messages that insurer and repairer send each other:
// repair_job [MESSAGES [OUTBOX]]. The insurer's are read from the first folder; the repairer's are written into the
// second.
#include <iomanip>
#include <iostream>
#include <varnex3/varnex3.h>
#include <varnex3/xml/Files.h>

#include "answer.h"

using namespace varnex3;

static std::string Money(double amount) { return ToUtf8(FormatAmount(amount)); }

static std::string Day(Date date) { return ToUtf8(FormatDate(date, 0)); }

// A line of the summary: who sent which message when, and what came of it.
static void Tell(const Text& number, SourceDef& source, const char* what, const std::string& outcome)
{
    const char* const sender = source.OrgType() == u"INS" ? "insurer" : "repairer";
    std::cout << ToUtf8(number) << "  " << Day(source.TimeStamp()) << "  " << std::left << std::setw(10) << sender
              << std::setw(21) << what << outcome << '\n';
}

static void TellItems(QuoteItemsDef& items)
{
    for (std::int16_t i = 0; i < items.Count(); ++i) {
        const auto item = items.QuoteItems(i);
        std::cout << "      " << item->ItemNo() << "  " << std::left << std::setw(34) << ToUtf8(item->Description())
                  << std::right << std::setw(8) << Money(item->QuoteItemValue()) << '\n';
    }
}

// Payment details, and those that the insurer expected, have the same figures.
template <class Figures>
static std::string InWords(Figures& figures)
{
    return Money(figures.TotalExcludingTax()) + " + " + Money(figures.TotalTaxAmount()) + " tax - "
           + Money(figures.ExcessToCollect()) + " excess = " + Money(figures.TotalPayableAmount());
}

struct Folders
{
    Text messages;
    Text outbox; // empty: nothing is written
};

template <class Message>
static Ref<Message> Receive(const Folders& folders, TextView file)
{
    const auto message = New<Message>();
    message->ParseXML(ToUtf16(xml::ReadFile(folders.messages + u"/" + Text(file))));
    return message;
}

template <class Message>
static void Send(Message& message, const Folders& folders, TextView file)
{
    if (!folders.outbox.empty())
        xml::WriteFileAtomically(folders.outbox + u"/" + Text(file), ToUtf8(message.Serialise()));
}

// What every later message repeats of the quote. The insurer is a record of another class there: it may be left out.
template <class Message>
static Ref<Message> NewAbout(Xalo_Quote& quote, TextView number, const CivilDate& sent)
{
    const auto message = New<Message>();
    message->VersionField(quote.VersionField());
    message->SourceField()->OrgType(quote.SourceField()->OrgType());
    message->SourceField()->AppName(quote.SourceField()->AppName());
    message->SourceField()->AppVersion(quote.SourceField()->AppVersion());
    message->SourceField()->TimeStamp(*DateFrom(sent));
    message->DestinationField(quote.DestinationField());
    message->MessageNoField(Text(number));
    message->InsurerField()->UnderwriterName(quote.InsurerField()->UnderwriterName());
    message->RepairerField(quote.RepairerField());
    message->ClaimHeaderField(quote.ClaimHeaderField());
    message->QuoteNoField(quote.QuoteNoField());
    message->VehicleField(quote.VehicleField());
    return message;
}

static void FillFigures(PaymentDetailsDef& figures, TotalsDef& totals, double excess)
{
    figures.RepairerTaxInvoiceNo(u"INV-2291"); // nothing of the figures is written without it
    figures.TaxInvoiceDate(*DateFrom({2008, 5, 26}));
    figures.TotalExcludingTax(totals.GrandTotalExTax());
    figures.TotalTaxAmount(totals.TaxAmount());
    figures.TotalIncludingTax(totals.GrandTotalExTax() + totals.TaxAmount());
    figures.ExcessToCollect(excess);
    figures.TotalPayableAmount(figures.TotalIncludingTax() - excess);
    figures.TaxRate(totals.TaxRate());
}

// The figures of the invoice as the insurer expects them.
static void Correct(PaymentDetailsDef& figures, ExpectedPaymentDetailsDef& expected)
{
    figures.TotalExcludingTax(expected.TotalExcludingTax());
    figures.TotalTaxAmount(expected.TotalTaxAmount());
    figures.TotalIncludingTax(expected.TotalIncludingTax());
    figures.TotalPayableAmount(expected.TotalPayableAmount());
}

static void TellJob(Xalo_RequestForQuote& request)
{
    std::cout << "Claim " << ToUtf8(request.ClaimHeaderField()->InsuranceClaimNo()) << ", "
              << ToUtf8(request.VehicleField()->Description()) << ' '
              << ToUtf8(request.VehicleField()->RegistrationNo()) << ": "
              << ToUtf8(request.InsurerField()->UnderwriterName()) << " and "
              << ToUtf8(request.RepairerField()->RepairerName()) << "\n\n";
}

// ---- the messages, in their order

static Ref<Xalo_Quote> AnswerRequest(const Folders& folders)
{
    const auto request = Receive<Xalo_RequestForQuote>(folders, u"request.xml");
    TellJob(*request);
    Tell(request->MessageNoField(), *request->SourceField(), "Request for quote",
         ToUtf8(request->RequestDetailsField()->IncidentDescription()));
    const auto quote = answer::Answer(*request);
    Send(*quote, folders, u"quote.xml");
    Tell(quote->MessageNoField(), *quote->SourceField(), "Quote",
         Money(quote->TotalsField()->GrandTotalExTax()) + " + " + Money(quote->TotalsField()->TaxAmount()) + " tax");
    TellItems(*quote->QuoteItemsField());
    return quote;
}

// The insurer sends the quote back with its status, and an item changed.
static bool IsAuthorised(const Folders& folders)
{
    const auto authority = Receive<Xalo_Quote>(folders, u"authority.xml");
    Tell(authority->MessageNoField(), *authority->SourceField(), "Quote, with status",
         ToUtf8(authority->VarnexStatusField()->StatusTypeText()));
    for (std::int16_t i = 0; i < authority->QuoteItemsField()->Count(); ++i) {
        const auto item = authority->QuoteItemsField()->QuoteItems(i);
        if (item->UpdateStatusType() == UpdateStatusEnum::Changed)
            std::cout << "      " << item->ItemNo() << "  changed to " << Money(item->QuoteItemValue()) << '\n';
    }
    return authority->VarnexStatusField()->StatusType() == VarnexStatusEnum::Authorised;
}

// The workshop overlooks the change, and bills what it had quoted.
static Ref<PaymentDetailsDef> Bill(Xalo_Quote& quote, const Folders& folders)
{
    const auto invoice = NewAbout<Xalo_TaxInvoice>(quote, u"5014", {2008, 5, 26, 16, 30, 0});
    invoice->TaxInvoiceDetail()->TaxInvoice(true);
    invoice->TaxInvoiceDetail()->CompletionDate(*DateFrom({2008, 5, 23}));
    invoice->TaxInvoiceDetail()->Description(u"Repairs as quoted");
    FillFigures(*invoice->PaymentDetailsField(), *quote.TotalsField(), quote.QuoteDetailsField()->ExcessToCollect());
    Send(*invoice, folders, u"tax-invoice.xml");
    Tell(invoice->MessageNoField(), *invoice->SourceField(), "Tax invoice", InWords(*invoice->PaymentDetailsField()));
    return invoice->PaymentDetailsField();
}

static Ref<ExpectedPaymentDetailsDef> ReceiveRefusal(const Folders& folders)
{
    const auto refusal = Receive<Xalo_PaymentDeclined>(folders, u"payment-declined.xml");
    Tell(refusal->MessageNoField(), *refusal->SourceField(), "Payment declined",
         InWords(*refusal->ExpectedPaymentDetailsField()));
    std::cout << "      " << ToUtf8(refusal->ReasonField()) << '\n';
    return refusal->ExpectedPaymentDetailsField();
}

static void Adjust(Xalo_Quote& quote, PaymentDetailsDef& figures, ExpectedPaymentDetailsDef& expected,
                   const Folders& folders)
{
    const auto note = NewAbout<Xalo_AdjustmentNote>(quote, u"5016", {2008, 6, 2, 9, 5, 20});
    note->AdjustmentNoteDetailsField()->AdjustmentNote(true);
    note->AdjustmentNoteDetailsField()->AdjustmentNoteDate(*DateFrom({2008, 6, 2}));
    note->AdjustmentNoteDetailsField()->SupplyDifferenceAmount(expected.TotalExcludingTax()
                                                               - figures.TotalExcludingTax());
    note->AdjustmentNoteDetailsField()->StatutoryStatement(u"This document is an adjustment note");
    Correct(figures, expected);
    note->PaymentDetailsField(Ref<PaymentDetailsDef>(&figures));
    Send(*note, folders, u"adjustment-note.xml");
    Tell(note->MessageNoField(), *note->SourceField(), "Adjustment note",
         Money(note->AdjustmentNoteDetailsField()->SupplyDifferenceAmount()) + " without tax");
}

static void Reactivate(Xalo_Quote& quote, PaymentDetailsDef& figures, const Folders& folders)
{
    const auto message = NewAbout<Xalo_ReactivateInvoice>(quote, u"5017", {2008, 6, 2, 9, 7, 44});
    message->ReActivateInvoiceDateField(*DateFrom({2008, 6, 2}));
    message->PaymentDetailsField(Ref<PaymentDetailsDef>(&figures));
    message->OpenTextField(u"Sensors now as authorised");
    Send(*message, folders, u"reactivate-invoice.xml");
    Tell(message->MessageNoField(), *message->SourceField(), "Invoice reactivated", InWords(figures));
}

static void ReceivePayment(const Folders& folders)
{
    const auto payment = Receive<Xalo_PaymentAuthorised>(folders, u"payment-authorised.xml");
    const auto details = payment->PayAuthorityDetailsField();
    Tell(payment->MessageNoField(), *payment->SourceField(), "Payment authorised",
         Money(details->PaymentAmount()) + " of " + ToUtf8(details->RepairerTaxInvoiceNo()) + " on "
             + Day(details->PayAuthorisedDate()));
}

static void DoJob(const Folders& folders)
{
    const auto quote = AnswerRequest(folders);
    if (!IsAuthorised(folders))
        return;
    const auto figures = Bill(*quote, folders);
    const auto expected = ReceiveRefusal(folders);
    Adjust(*quote, *figures, *expected, folders);
    Reactivate(*quote, *figures, folders);
    ReceivePayment(folders);
}

int main(int count, char** arguments)
{
    try {
        DoJob({ToUtf16(count > 1 ? arguments[1] : "samples/messages"), ToUtf16(count > 2 ? arguments[2] : "")});
        return 0;
    } catch (const std::exception& error) { // one of the library's, or a file that the system refuses
        std::cout << error.what() << '\n';
        return 1;
    }
}
