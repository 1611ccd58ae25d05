"""One repair job from the request to the payment, in the eight messages that insurer and repairer send each other:
python3 repair_job.py [MESSAGES [OUTBOX]]. The insurer's are read from the first folder; the repairer's are written into
the second."""

import sys
from dataclasses import dataclass
from datetime import datetime
from pathlib import Path

import varnex3
from answer_request import answer
from varnex3 import UpdateStatusEnum, VarnexStatusEnum


@dataclass
class Folders:
    messages: Path
    outbox: "Path | None"  # without it nothing is written

    def receive(self, message, file: str):
        message.ParseXML((self.messages / file).read_text(encoding="utf-8"))
        return message

    def send(self, message, file: str) -> None:
        if self.outbox:
            (self.outbox / file).write_bytes(message.Serialise().encode())


def tell(number: str, source, what: str, outcome: str) -> None:
    """A line of the summary: who sent which message when, and what came of it."""
    sender = "insurer" if source.OrgType == "INS" else "repairer"
    print(f"{number}  {source.TimeStamp:%Y-%m-%d}  {sender:10}{what:21}{outcome}")


def in_words(figures) -> str:
    """Payment details, and those that the insurer expected, have the same figures."""
    return (f"{figures.TotalExcludingTax:.2f} + {figures.TotalTaxAmount:.2f} tax"
            f" - {figures.ExcessToCollect:.2f} excess = {figures.TotalPayableAmount:.2f}")


def items_of(quote) -> list:
    items = quote.QuoteItemsField
    return [items.QuoteItems(i) for i in range(items.Count)]


def about(message, quote, number: str, sent: datetime):
    """What every later message repeats of the quote. The insurer is of another class there: it may be left out."""
    message.VersionField = quote.VersionField
    message.SourceField.OrgType = quote.SourceField.OrgType
    message.SourceField.AppName = quote.SourceField.AppName
    message.SourceField.AppVersion = quote.SourceField.AppVersion
    message.SourceField.TimeStamp = sent
    message.DestinationField = quote.DestinationField
    message.MessageNoField = number
    message.InsurerField.UnderwriterName = quote.InsurerField.UnderwriterName
    message.RepairerField = quote.RepairerField
    message.ClaimHeaderField = quote.ClaimHeaderField
    message.QuoteNoField = quote.QuoteNoField
    message.VehicleField = quote.VehicleField
    return message


def fill_figures(figures, totals, excess: float) -> None:
    figures.RepairerTaxInvoiceNo = "INV-2291"  # nothing of the figures is written without it
    figures.TaxInvoiceDate = datetime(2008, 5, 26)
    figures.TotalExcludingTax = totals.GrandTotalExTax
    figures.TotalTaxAmount = totals.TaxAmount
    figures.TotalIncludingTax = totals.GrandTotalExTax + totals.TaxAmount
    figures.ExcessToCollect = excess
    figures.TotalPayableAmount = figures.TotalIncludingTax - excess
    figures.TaxRate = totals.TaxRate


def correct(figures, expected) -> None:
    """The figures of the invoice as the insurer expects them."""
    figures.TotalExcludingTax = expected.TotalExcludingTax
    figures.TotalTaxAmount = expected.TotalTaxAmount
    figures.TotalIncludingTax = expected.TotalIncludingTax
    figures.TotalPayableAmount = expected.TotalPayableAmount


def tell_job(request) -> None:
    vehicle = request.VehicleField
    print(f"Claim {request.ClaimHeaderField.InsuranceClaimNo}, {vehicle.Description} {vehicle.RegistrationNo}: "
          f"{request.InsurerField.UnderwriterName} and {request.RepairerField.RepairerName}\n")


# ---- the messages, in their order


def answer_request(folders: Folders):
    request = folders.receive(varnex3.Xalo_RequestForQuote(), "request.xml")
    tell_job(request)
    tell(request.MessageNoField, request.SourceField, "Request for quote",
         request.RequestDetailsField.IncidentDescription)
    quote = answer(request)
    folders.send(quote, "quote.xml")
    totals = quote.TotalsField
    tell(quote.MessageNoField, quote.SourceField, "Quote",
         f"{totals.GrandTotalExTax:.2f} + {totals.TaxAmount:.2f} tax")
    for item in items_of(quote):
        print(f"      {item.ItemNo}  {item.Description:34}{item.QuoteItemValue:8.2f}")
    return quote


def is_authorised(folders: Folders) -> bool:
    """The insurer sends the quote back with its status, and an item changed."""
    authority = folders.receive(varnex3.Xalo_Quote(), "authority.xml")
    status = authority.VarnexStatusField
    tell(authority.MessageNoField, authority.SourceField, "Quote, with status", status.StatusTypeText)
    for item in items_of(authority):
        if item.UpdateStatusType == UpdateStatusEnum.Changed:
            print(f"      {item.ItemNo}  changed to {item.QuoteItemValue:.2f}")
    return status.StatusType == VarnexStatusEnum.Authorised


def bill(quote, folders: Folders):
    """The workshop overlooks the change, and bills what it had quoted."""
    invoice = about(varnex3.Xalo_TaxInvoice(), quote, "5014", datetime(2008, 5, 26, 16, 30))
    invoice.TaxInvoiceDetail.TaxInvoice = True
    invoice.TaxInvoiceDetail.CompletionDate = datetime(2008, 5, 23)
    invoice.TaxInvoiceDetail.Description = "Repairs as quoted"
    fill_figures(invoice.PaymentDetailsField, quote.TotalsField, quote.QuoteDetailsField.ExcessToCollect)
    folders.send(invoice, "tax-invoice.xml")
    tell(invoice.MessageNoField, invoice.SourceField, "Tax invoice", in_words(invoice.PaymentDetailsField))
    return invoice.PaymentDetailsField


def receive_refusal(folders: Folders):
    refusal = folders.receive(varnex3.Xalo_PaymentDeclined(), "payment-declined.xml")
    expected = refusal.ExpectedPaymentDetailsField
    tell(refusal.MessageNoField, refusal.SourceField, "Payment declined", in_words(expected))
    print(f"      {refusal.ReasonField}")
    return expected


def adjust(quote, figures, expected, folders: Folders) -> None:
    note = about(varnex3.Xalo_AdjustmentNote(), quote, "5016", datetime(2008, 6, 2, 9, 5, 20))
    details = note.AdjustmentNoteDetailsField
    details.AdjustmentNote = True
    details.AdjustmentNoteDate = datetime(2008, 6, 2)
    details.SupplyDifferenceAmount = expected.TotalExcludingTax - figures.TotalExcludingTax
    details.StatutoryStatement = "This document is an adjustment note"
    correct(figures, expected)
    note.PaymentDetailsField = figures
    folders.send(note, "adjustment-note.xml")
    tell(note.MessageNoField, note.SourceField, "Adjustment note", f"{details.SupplyDifferenceAmount:.2f} without tax")


def reactivate(quote, figures, folders: Folders) -> None:
    message = about(varnex3.Xalo_ReactivateInvoice(), quote, "5017", datetime(2008, 6, 2, 9, 7, 44))
    message.ReActivateInvoiceDateField = datetime(2008, 6, 2)
    message.PaymentDetailsField = figures
    message.OpenTextField = "Sensors now as authorised"
    folders.send(message, "reactivate-invoice.xml")
    tell(message.MessageNoField, message.SourceField, "Invoice reactivated", in_words(figures))


def receive_payment(folders: Folders) -> None:
    payment = folders.receive(varnex3.Xalo_PaymentAuthorised(), "payment-authorised.xml")
    details = payment.PayAuthorityDetailsField
    tell(payment.MessageNoField, payment.SourceField, "Payment authorised",
         f"{details.PaymentAmount:.2f} of {details.RepairerTaxInvoiceNo} on {details.PayAuthorisedDate:%Y-%m-%d}")


def do_job(folders: Folders) -> None:
    quote = answer_request(folders)
    if not is_authorised(folders):
        return
    figures = bill(quote, folders)
    expected = receive_refusal(folders)
    adjust(quote, figures, expected, folders)
    reactivate(quote, figures, folders)
    receive_payment(folders)


def main(messages: str = "samples/messages", outbox: str = "") -> int:
    try:
        do_job(Folders(Path(messages), Path(outbox) if outbox else None))
    except (varnex3.Error, OSError) as error:
        print(error)
        return 1
    return 0


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:3]))
