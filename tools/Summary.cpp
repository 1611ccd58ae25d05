#include "Summary.h"

#include <algorithm>

namespace varnex3::tool {

std::span<const SummaryField> SummaryFields()
{
    static constexpr SummaryField fields[] = {
        {"Type", "MessageDescription", true},
        {"Root element", "MessageType"},
        {"Message no", "MessageNo", true},
        {"Quote no", "QuoteNo", true},
        {"Status", "VarnexStatusCode", true},
        {"Image no", "ImageNo"},
        {"Claim", "ClaimNo"},
        {"Registration", "Registration"},
        {"Vehicle", "VehicleDesciption"},
        {"Vehicle ID", "VehicleID"},
        {"Customer", "Customer"},
        {"Repairer ID", "RepairerID"},
    };
    return fields;
}

Text ValueOf(MessageDef& message, Name property) { return ToText(Get(message, property)); }

std::string EnumeratorText(const EnumInfo& enumeration, std::int32_t value)
{
    const auto found = std::ranges::find(enumeration.values, value, &Enumerator::value);
    return found == enumeration.values.end() ? std::to_string(value) : std::string(found->name);
}

bool IsMessage(MessageDef& message)
{
    return message.MessageTypeID() != XaloMessageTypeEnum::Xalo_Unknown || message.MessageType() == u"Xalo_Unknown";
}

} // namespace varnex3::tool
