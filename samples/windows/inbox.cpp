// Lists an inbox folder, a line a message: inbox.exe [FOLDER]
#include "early.h"

static void Print(const Object<_MessageDef>& message)
{
    VARIANT_BOOL isBroken = VARIANT_FALSE;
    Text words, number, description, registration, claim;
    Check(message->get_ParseError(&isBroken));
    if (isBroken) {
        Check(message->get_ErrorMessage(words.Out()));
        std::cout << words << '\n';
        return;
    }
    Check(message->get_MessageNo(number.Out()));
    Check(message->get_MessageDescription(description.Out()));
    Check(message->get_Registration(registration.Out()));
    Check(message->get_ClaimNo(claim.Out()));
    std::cout << number << ", " << description << ", " << registration << ", " << claim << '\n';
}

static void List(const std::wstring& folder)
{
    const Object<_Xalo_Messages> messages(__uuidof(Xalo_Messages));
    long number = 0;
    Text words;
    VARIANT_BOOL isWhole = VARIANT_FALSE;
    Check(messages->ParseFiles(Text(folder), &number, words.Out(), &isWhole));
    short count = 0;
    Check(messages->get_Count(&count));
    VARIANT index = {};
    for (index.vt = VT_I2; index.iVal < count; ++index.iVal) {
        Object<_MessageDef> message;
        Check(messages->get_MessageItems(index, message.Out()));
        Print(message);
    }
    std::cout << count << " messages\n";
    if (!isWhole)
        std::cout << "Error " << number << ": " << words << '\n';
}

int main(int count, char** arguments)
try {
    const Apartment apartment;
    const std::string folder = count > 1 ? arguments[1] : "samples\\inbox";
    List(std::wstring(folder.begin(), folder.end()));
} catch (const Failure& failure) {
    Print(failure);
    return 1;
}
