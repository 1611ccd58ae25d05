// Reference sets for programs without a database: each is a set that was never opened.
#include "varnex3/core/ReferenceSet.h"

namespace varnex3 {

std::shared_ptr<RowSet> GetReferenceSet(TextView /*first*/, TextView /*second*/) { return std::make_shared<RowSet>(); }

} // namespace varnex3
