// Lists an inbox folder, a line a message: inbox [FOLDER]
#include <iostream>
#include <varnex3/varnex3.h>

using namespace varnex3;

static void Print(MessageDef& message)
{
    if (message.ParseError())
        std::cout << ToUtf8(message.ErrorMessage()) << '\n';
    else
        std::cout << ToUtf8(message.MessageNo()) << ", " << ToUtf8(message.MessageDescription()) << ", "
                  << ToUtf8(message.Registration()) << ", " << ToUtf8(message.ClaimNo()) << '\n';
}

int main(int count, char** arguments)
{
    const auto messages = New<Xalo_Messages>();
    std::int32_t number = 0;
    Text words;
    const bool isWhole = messages->ParseFiles(ToUtf16(count > 1 ? arguments[1] : "samples/inbox"), &number, &words);
    for (std::int16_t i = 0; i < messages->Count(); ++i)
        Print(*messages->MessageItems(i));
    std::cout << messages->Count() << " messages\n";
    if (!isWhole)
        std::cout << "Error " << number << ": " << ToUtf8(words) << '\n';
    return isWhole ? 0 : 1;
}
