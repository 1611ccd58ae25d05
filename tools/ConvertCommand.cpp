#include "ConvertCommand.h"

#include <algorithm>
#include <system_error>

#include "DisplayText.h"
#include "FileText.h"
#include "MessageOutput.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/Json.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

constexpr Name kOperation = "convert";

std::string ReadBytes(const Text& path)
{
    try {
        return xml::ReadFile(path);
    } catch (const std::system_error& error) {
        throw FileError(error.code().value(), kOperation, path);
    }
}

// By its first character: a message's XML begins with another one.
bool IsJson(std::string_view bytes)
{
    constexpr std::string_view kMark = "\xEF\xBB\xBF";
    if (bytes.starts_with(kMark))
        bytes.remove_prefix(kMark.size());
    return bytes.substr(std::min(bytes.find_first_not_of(" \t\r\n"), bytes.size())).starts_with('{');
}

void RequireWellFormed(const xml::Document& document)
{
    const xml::ParseError& fault = document.Error();
    if (fault)
        Raise(ErrorNumber::InvalidArgument, kOperation,
              u"line " + ToUtf16(std::to_string(fault.line)) + u", column " + ToUtf16(std::to_string(fault.column))
                  + u": " + ToUtf16(Printable(fault.reason)));
}

Ref<Record> ReadXml(std::string_view bytes)
{
    xml::Document document;
    document.LoadBytes(bytes);
    RequireWellFormed(document);
    const Text root = document.DocumentElement().Name();
    const ClassInfo* const info = FindMessageClass(ToUtf8(root));
    if (!info)
        Raise(ErrorNumber::InvalidArgument, kOperation, u"the root element " + Quoted(root) + u" is no message's");
    if (!CanRead(*info))
        Raise(ErrorNumber::InvalidArgument, kOperation, u"a message of the type " + root + u" can only be written");

    Ref<Record> message = info->create();
    Variant text = DecodeFileText(bytes);
    Call(*message, "ParseXML", {&text, 1});
    return message;
}

} // namespace

Status Convert(const ConvertOptions& options, const Console& console)
{
    const Text path = xml::FromNativePath(options.file);
    const std::string bytes = ReadBytes(path);
    const bool isJson = IsJson(bytes);
    const MessageFormat other = isJson ? MessageFormat::Xml : MessageFormat::Json;
    const MessageFormat format = options.to.empty() ? other : MessageFormatNamed(options.to);
    std::string converted;
    try {
        converted = BytesOf(isJson ? *FromNamedJson(bytes, &FindMessageClass) : *ReadXml(bytes), format);
    } catch (const Error& error) {
        console.errors.Paragraph(Printable(path) + ": " + Printable(error.Description()), 4);
        return Status::Findings;
    }
    return WriteMessage(converted, format, options.output, console);
}

} // namespace varnex3::tool
