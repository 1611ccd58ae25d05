#include "varnex3/core/ReferenceSet.h"

#include "varnex3/core/Conversions.h"

namespace varnex3 {

std::optional<Text> FindDescription(RowSet& set, TextView code)
{
    set.MoveFirst();
    set.Find(u"Code = '" + Text(code) + u"'");
    return set.EndOfRows() ? std::nullopt : std::optional(ToText(set.Field(u"Description")));
}

} // namespace varnex3
