// The customer of a job: a person, a company, or both.
#pragma once

#include "varnex3/core/PersonalNameDef.h"

namespace varnex3 {

VARNEX_ENUM(CustomerTypeEnum, "Whether a customer is a person or a company.", (Personal, 0, "A person."),
            (Company, 1, "A company."));

class CustomerDef final : public Record
{
    VARNEX_RECORD(CustomerDef, "The customer of a job.");
    VARNEX_SERIALISE(
        "The Customer group with the values that are not empty; nothing when all are, the personal name included.");
    VARNEX_PARSEXML(Variant, "Reads every value but CustomerType; an absent element gives the empty text.");
    VARNEX_PROPERTY(Text, sCompanyName, CompanyName, "Name of the company; escaped when written.");
    VARNEX_PROPERTY(Text, sBusinessPhone, BusinessPhone, "Telephone number at work.");
    VARNEX_PROPERTY(Text, sFax, Fax, "Fax number.");
    VARNEX_PROPERTY(Text, sMobilePhone, MobilePhone, "Mobile telephone number.");
    VARNEX_PROPERTY(CustomerTypeEnum, eCustomerType, CustomerType, "For the host alone: never written, never read.");
    VARNEX_PROPERTY(Child<PersonalNameDef>, objPersonalName, PersonalName, "Personal name.");
    VARNEX_RECORD_END;
};

} // namespace varnex3
