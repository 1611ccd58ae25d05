#include "Suite.h"

#include <algorithm>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace varnex3::xml::conformance {
namespace {

std::ifstream Open(const std::string& path)
{
    std::ifstream file(path);
    if (!file)
        throw std::runtime_error(path + " cannot be read; tests/conformance/fetch brings the documents");
    return file;
}

Verdict VerdictOf(std::string_view type)
{
    if (type == "not-wf")
        return Verdict::NotWellFormed;
    if (type == "error")
        return Verdict::Either;
    if (type == "valid" || type == "invalid")
        return Verdict::WellFormed;
    throw std::runtime_error("the catalogue has a test of unknown type: " + std::string(type));
}

std::string WithoutZeroBytes(std::string_view bytes)
{
    std::string kept(bytes);
    std::erase(kept, '\0');
    return kept;
}

// Drops everything up to and including the mark; everything when the mark is absent.
void SkipPast(std::string_view& text, std::string_view mark)
{
    const std::size_t at = text.find(mark);
    text.remove_prefix(at == text.npos ? text.size() : at + mark.size());
}

// Leaves the text at its DOCTYPE, or at whatever other than comments and instructions comes first.
void SkipToDoctype(std::string_view& text)
{
    for (;;) {
        text.remove_prefix(std::min(text.find('<'), text.size()));
        if (text.starts_with("<!--"))
            SkipPast(text, "-->");
        else if (text.starts_with("<?"))
            SkipPast(text, "?>");
        else
            return;
    }
}

} // namespace

std::vector<Case> ReadCatalogue()
{
    std::ifstream file = Open(VARNEX3_CONFORMANCE_DATA "/catalogue.tsv");
    std::vector<Case> cases;
    std::string id, type, path;
    while (std::getline(file, id, '\t') && std::getline(file, type, '\t') && std::getline(file, path))
        cases.push_back({id, VerdictOf(type), VARNEX3_CONFORMANCE_DATA "/documents/" + path});
    return cases;
}

std::map<std::string, Deviation> ReadDeviations()
{
    std::ifstream file = Open(VARNEX3_CONFORMANCE_DEVIATIONS);
    std::map<std::string, Deviation> deviations;
    for (std::string line; std::getline(file, line);) {
        if (line.empty() || line.front() == '#')
            continue;
        std::istringstream fields(line);
        std::string id;
        Deviation deviation;
        if (!(fields >> id >> deviation.code) || !std::getline(fields >> std::ws, deviation.justification)
            || !deviations.emplace(id, deviation).second)
            throw std::runtime_error("deviations.txt: not an id, a code and a justification, or listed twice: " + line);
    }
    return deviations;
}

bool HasInternalSubset(std::string_view bytes)
{
    const std::string narrow = WithoutZeroBytes(bytes);
    std::string_view text = narrow;
    SkipToDoctype(text);
    if (!text.starts_with("<!DOCTYPE"))
        return false;

    // Outside quotes, the subset's bracket or the end of the declaration comes first.
    while (!text.empty() && text.front() != '[' && text.front() != '>') {
        const char c = text.front();
        text.remove_prefix(1);
        if (c == '"' || c == '\'')
            SkipPast(text, std::string_view(&c, 1));
    }
    return text.starts_with('[');
}

} // namespace varnex3::xml::conformance
