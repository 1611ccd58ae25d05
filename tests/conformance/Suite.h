// The W3C conformance documents on disk, the verdicts of their catalogue, and our list of deviations from them.
#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace varnex3::xml::conformance {

// What the catalogue says of a document: "error" leaves the outcome to the parser.
enum class Verdict
{
    WellFormed,
    NotWellFormed,
    Either
};

struct Case
{
    std::string id;
    Verdict verdict = Verdict::Either;
    std::string path; // absolute
};

// A document on which the engine differs from the catalogue, knowingly.
struct Deviation
{
    int code = 0; // the ErrorCode the engine gives; 0 when it loads the document
    std::string justification;
};

// Every document of the catalogue that `fetch` left. Throws std::runtime_error when it is not there.
std::vector<Case> ReadCatalogue();

// By id. A line reads "id code justification"; "#" starts a comment line. Throws std::runtime_error for a line that
// reads otherwise, an id listed twice included.
std::map<std::string, Deviation> ReadDeviations();

// Whether a DOCTYPE with an internal subset stands in front of the root element. Looks at the bytes by itself, so that
// it can judge the engine; UTF-16 is read by leaving out the zero bytes.
bool HasInternalSubset(std::string_view bytes);

} // namespace varnex3::xml::conformance
