// Reads a request for quote and answers it with a quote: answer_request [REQUEST [QUOTE]]
#include <iostream>
#include <varnex3/varnex3.h>
#include <varnex3/xml/Files.h>

#include "answer.h"

using namespace varnex3;

int main(int count, char** arguments)
{
    const Text requestFile = ToUtf16(count > 1 ? arguments[1] : "samples/messages/request.xml");
    const Text quoteFile = ToUtf16(count > 2 ? arguments[2] : "quote.xml");
    try {
        const auto request = New<Xalo_RequestForQuote>();
        request->ParseXML(ToUtf16(xml::ReadFile(requestFile)));
        const auto quote = answer::Answer(*request);
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
