#include "MessageFile.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <utility>

#include "DisplayText.h"
#include "varnex3/core/Json.h"
#include "varnex3/xml/Characters.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;

// What JSON itself leaves as it is beyond ASCII.
std::string JsonEscape(char32_t control)
{
    constexpr const char* digits = "0123456789abcdef";
    std::string escape = "\\u";
    for (int shift = 12; shift >= 0; shift -= 4)
        escape += digits[control >> shift & 0xF];
    return escape;
}

// A lone surrogate, which a file's name may hold, becomes U+FFFD when the text is written.
Json ErrorOf(const MessageFile& file)
{
    if (file.IsUnreadable())
        return {{"kind", "unreadable"},
                {"number", file.failure->Number()},
                {"reason", ToUtf8(ReasonIn(*file.failure, file.message->FilePath()))}};
    return {{"kind", "broken"},
            {"line", file.fault.line},
            {"column", file.fault.column},
            {"reason", ToUtf8(file.fault.reason)}};
}

} // namespace

Text ReasonIn(const Error& error, const Text& path)
{
    const Text start = Quoted(path) + u": ";
    const bool isNamed = error.Description().starts_with(start);
    return isNamed ? error.Description().substr(start.size()) : error.Description();
}

MessageFile::MessageFile(xml::Document loaded, const Text& name, const Text& path) : fault(loaded.Error())
{
    message->AdoptFile(std::move(loaded), name, path);
    message->FileName(name);
    message->FilePath(path);
}

MessageFile::MessageFile(const Error& error, const Text& name, const Text& path) : failure(error)
{
    message->FileName(name);
    message->FilePath(path);
}

MessageFile ReadMessageFile(InboxFolder& inbox, const Text& name)
{
    const Text path = inbox.PathOf(name);
    try {
        xml::Document document;
        inbox.Load(name, document);
        return {std::move(document), name, path};
    } catch (const Error& error) {
        return {error, name, path};
    }
}

std::string FindingOf(const MessageFile& file, const Text& name)
{
    if (file.IsUnreadable())
        return Printable(name) + ": " + Printable(ReasonIn(*file.failure, file.message->FilePath()));
    return Printable(name) + ":" + std::to_string(file.fault.line) + ":" + std::to_string(file.fault.column) + ": "
           + Printable(file.fault.reason);
}

Json JsonOf(const MessageFile& file)
{
    Json json = Json::parse(ToJson(*file.message));
    if (!file.IsFine())
        json["error"] = ErrorOf(file);
    return json;
}

std::string JsonLineOf(const MessageFile& file) { return JsonLine(JsonOf(file)); }

std::string JsonLine(const Json& json)
{
    const std::string dump = json.dump(-1, ' ', false, Json::error_handler_t::replace);
    std::string line;
    const char* const end = dump.data() + dump.size();
    for (const char* p = dump.data(); p < end;) {
        const xml::CodePoint point = xml::DecodePoint(p, end);
        const std::size_t length = std::max(point.length, std::uint32_t{1});
        if (point.length > 0 && IsControl(point.value))
            line += JsonEscape(point.value);
        else
            line.append(p, length);
        p += length;
    }
    return line;
}

} // namespace varnex3::tool
