#include "MessageOutput.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <system_error>

#include "DisplayText.h"
#include "varnex3/Library.h"
#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/Json.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

constexpr Name kPrefix = "Xalo_";

// Xalo_Messages is a list of messages, and writes none.
bool IsMessageClass(const ClassInfo& info) { return info.name.starts_with(kPrefix) && FindMember(info, "Serialise"); }

std::string JsonTextOf(Record& message)
{
    constexpr int kIndent = 2;
    nlohmann::ordered_json named;
    named[std::string(message.Class().name)] = nlohmann::ordered_json::parse(ToJson(message));
    return named.dump(kIndent) + "\n";
}

void WriteBytes(const std::string& bytes, const std::string& file, const Console& console)
{
    if (file.empty()) {
        console.out.Stream() << bytes;
        return;
    }
    const Text path = xml::FromNativePath(file);
    try {
        xml::WriteFileAtomically(path, bytes);
    } catch (const std::system_error& error) {
        throw FileError(error.code().value(), "WriteMessage", path);
    }
}

} // namespace

std::vector<const ClassInfo*> MessageClasses()
{
    std::vector<const ClassInfo*> messages;
    for (const ClassInfo* const info : Classes())
        if (IsMessageClass(*info))
            messages.push_back(info);
    return messages;
}

const ClassInfo* FindMessageClass(Name name)
{
    const ClassInfo* const info = FindClass(name);
    return info && IsMessageClass(*info) ? info : nullptr;
}

const ClassInfo* FindMessageClassLike(Name typed)
{
    const Text name = ToText(typed);
    for (const ClassInfo* const info : MessageClasses())
        if (EqualsIgnoringCase(ToText(info->name), name) || EqualsIgnoringCase(ToText(ShortNameOf(*info)), name))
            return info;
    return nullptr;
}

Name ShortNameOf(const ClassInfo& message) { return message.name.substr(kPrefix.size()); }

bool CanRead(const ClassInfo& message) { return FindMember(message, "ParseXML"); }

MessageFormat MessageFormatNamed(const std::string& name)
{
    return name == "json" ? MessageFormat::Json : MessageFormat::Xml;
}

std::string BytesOf(Record& message, MessageFormat format)
{
    return format == MessageFormat::Json ? JsonTextOf(message) : ToUtf8(ToText(Call(message, "Serialise")));
}

Status WriteMessage(const std::string& bytes, MessageFormat format, const std::string& file, const Console& console)
{
    WriteBytes(bytes, file, console);
    xml::Document document;
    if (format == MessageFormat::Json || document.LoadBytes(bytes))
        return Status::Fine;
    const xml::ParseError& fault = document.Error();
    console.errors.Paragraph("varnex3: what was written is not well-formed: line " + std::to_string(fault.line)
                                 + ", column " + std::to_string(fault.column) + ": " + Printable(fault.reason),
                             4);
    return Status::Findings;
}

} // namespace varnex3::tool
