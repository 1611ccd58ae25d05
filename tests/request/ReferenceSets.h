// The reference sets of this program: what a test says that the database has.
#pragma once

#include <functional>
#include <memory>

#include "varnex3/core/ReferenceSet.h"

namespace varnex3::tests {

// As long as this lives, GetReferenceSet gives what the function gives; otherwise a set that was never opened.
class GivenReferenceSets
{
public:
    using Answer = std::function<std::shared_ptr<RowSet>(TextView, TextView)>;

    explicit GivenReferenceSets(Answer answer);
    ~GivenReferenceSets();
    GivenReferenceSets(const GivenReferenceSets&) = delete;
    GivenReferenceSets& operator=(const GivenReferenceSets&) = delete;
};

// The repair models as a workshop's database has them.
std::shared_ptr<RowSet> RepairModels();

} // namespace varnex3::tests
