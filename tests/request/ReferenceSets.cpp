#include "tests/request/ReferenceSets.h"

namespace varnex3 {

namespace {

tests::GivenReferenceSets::Answer& CurrentAnswer()
{
    static tests::GivenReferenceSets::Answer answer;
    return answer;
}

} // namespace

std::shared_ptr<RowSet> GetReferenceSet(TextView first, TextView second)
{
    return CurrentAnswer() ? CurrentAnswer()(first, second) : std::make_shared<RowSet>();
}

namespace tests {

GivenReferenceSets::GivenReferenceSets(Answer answer) { CurrentAnswer() = std::move(answer); }

GivenReferenceSets::~GivenReferenceSets() { CurrentAnswer() = nullptr; }

std::shared_ptr<RowSet> RepairModels()
{
    const auto row = [](TextView code, const Variant& description) { return RowSet::Row{Text(code), description}; };
    return std::make_shared<RowSet>(
        std::vector<Text>{u"Code", u"Description"},
        std::vector<RowSet::Row>{row(u"A", Text(u"Assessing")), row(u"CP", Text(u"Allocated")),
                                 row(u"T", Text(u"Tendering")), row(u"t", Text(u"never found")), row(u"N", Empty)});
}

} // namespace tests
} // namespace varnex3
