// The name of a customer who is a person.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

class PersonalNameDef final : public Record
{
    VARNEX_RECORD(PersonalNameDef, "The personal name of a customer.");
    VARNEX_SERIALISE("The PersonalName group, at level 2; nothing when all values are empty.");
    VARNEX_PARSEXML(Variant, "Reads every value; an absent element gives the empty text.");
    VARNEX_READONLY(Text, FullName, "Forename, a blank when there is one, and surname; without the title.");
    VARNEX_PROPERTY(Text, sForname, Forname, "Forename, spelled so in the message language; written as it is.");
    VARNEX_PROPERTY(Text, sTitle, Title, "Title; escaped when written.");
    VARNEX_PROPERTY(Text, sSurname, Surname, "Surname; written as it is, empty too.");
    VARNEX_PROPERTY(Text, sHomePhone, HomePhone, "Telephone number at home.");
    static constexpr int kLevel = 2; // inside the customer
    VARNEX_RECORD_END;
};

} // namespace varnex3
