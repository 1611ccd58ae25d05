// Where records find the description of a code.
#pragma once

#include <memory>
#include <optional>

#include "varnex3/core/RowSet.h"

namespace varnex3 {

// The rows of a reference set, such as u"REPAIRMODELTYPE" with an empty filter: a column Code and a column Description.
// Never null. Without a database it is a set that was never opened, and nothing is raised; what the database itself
// refuses is raised as DBExecSP says.
//
// Each program has one definition of it: that of modDBAccess, or the one of NoDatabase.cpp for a program without
// databases.
std::shared_ptr<RowSet> GetReferenceSet(TextView first, TextView second);

// The description of a code, found as RowSet::Find does: the first row counts, upper and lower case are alike. Nothing
// when there is none, and in a set that was never opened. A code with an apostrophe raises kMalformedCriterion.
std::optional<Text> FindDescription(RowSet& set, TextView code);

} // namespace varnex3
