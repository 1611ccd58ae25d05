#include "varnex3/request/ClaimantTypeDef.h"

namespace varnex3 {

VARNEX_DEFINE(ClaimantTypeDef);

Text ClaimantTypeDef::ClaimantTypeValue() const
{
    switch (eClaimantType) {
    case ClaimantTypeEnum::OtherParty:
        return u"OtherParty";
    case ClaimantTypeEnum::Insured:
        return u"Insured";
    }
    return {};
}

void ClaimantTypeDef::Read(const XmlSection& section)
{
    if (section.Has("ClaimantType/OtherParty")) // wins when both are there
        eClaimantType = ClaimantTypeEnum::OtherParty;
    else if (section.Has("ClaimantType/Insured"))
        eClaimantType = ClaimantTypeEnum::Insured;
}

} // namespace varnex3
