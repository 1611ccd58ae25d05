#include "ShowCommand.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <system_error>

#include "DisplayText.h"
#include "MessageFile.h"
#include "MessagePage.h"
#include "OwnValues.h"
#include "RecordTree.h"
#include "Sections.h"
#include "SourceExcerpt.h"
#include "Summary.h"
#include "varnex3/core/Json.h"
#include "varnex3/quote/VarnexStatusDef.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;

void PrintFault(Terminal& terminal, const MessageFile& file, std::string_view bytes)
{
    const std::string number = std::to_string(file.fault.line);
    const std::string gutter = std::string(number.size(), ' ') + " | ";
    const std::size_t width = terminal.Width() - std::min(terminal.Width() - 1, gutter.size());
    const SourceExcerpt excerpt = ExcerptAt(bytes, file.fault, width);
    terminal.Paragraph(FindingOf(file, file.message->FilePath()), 4);
    terminal.Line();
    terminal.Line(number + " | " + excerpt.text);
    terminal.Line(gutter + std::string(excerpt.caret, ' ') + terminal.Styled(Style::Bad, "^"));
}

// A property of the summary; a status in words, with its code.
Text InWords(MessageDef& message, Name property)
{
    const Text value = ValueOf(message, property);
    const auto status = New<VarnexStatusDef>();
    if (property == "VarnexStatusCode")
        status->Status(value);
    const Text words = status->StatusTypeText();
    return words.empty() ? value : words + u" (" + value + u")";
}

enum class Extent
{
    Whole,
    Head // what the message is, not what it says
};

// The number that the summary has of an error report is another message's: the page says so.
bool IsWanted(MessageDef& message, const SummaryField& field, Extent extent)
{
    const bool isOfOther = field.property == "MessageNo" && message.MessageTypeID() == XaloMessageTypeEnum::Xalo_Error;
    return extent == Extent::Whole || (field.isHead && !isOfOther);
}

void PrintSummary(Terminal& terminal, MessageDef& message, Extent extent)
{
    PrintField(terminal, 0, "File", Printable(message.FileName()));
    for (const SummaryField& field : SummaryFields()) {
        const Text value = InWords(message, field.property);
        if (!value.empty() && IsWanted(message, field, extent))
            PrintField(terminal, 0, field.label, Printable(value));
    }
}

void PrintSection(Terminal& terminal, const Section& section)
{
    terminal.Line();
    terminal.Line(terminal.Styled(Style::Heading, section.element));
    PrintRecord(terminal, 1, *section.record);
    if (section.error)
        for (const std::string& line : Wrapped(Printable(ToUtf16(section.error->what())), terminal.Width() - 2))
            terminal.Line("  " + terminal.Styled(Style::Bad, line));
}

// What a message holds and nothing else tells, as the tree that it is in the file.
void PrintOthers(Terminal& terminal, const std::vector<ElementLine>& values)
{
    if (values.empty())
        return;
    terminal.Line();
    terminal.Line(terminal.Styled(Style::Heading, "Also in the message"));
    for (const ElementLine& value : values)
        if (value.text)
            PrintField(terminal, value.depth + 1, Printable(value.name), Printable(*value.text));
        else
            PrintGroup(terminal, value.depth + 1, Printable(value.name));
}

Json JsonOf(const Error& error)
{
    return {{"number", error.Number()}, {"source", ToUtf8(error.Source())}, {"reason", ToUtf8(error.Description())}};
}

// A list of more records than a count can say has no JSON.
Json JsonOf(Record& record)
{
    try {
        return Json::parse(ToJson(record));
    } catch (const Error& error) {
        return {{"error", JsonOf(error)}};
    }
}

Json JsonOf(const std::vector<Section>& sections)
{
    Json json = Json::object();
    for (const Section& section : sections) {
        Json& record = json[std::string(section.element)] = JsonOf(*section.record);
        if (section.error)
            record["error"] = JsonOf(*section.error);
    }
    return json;
}

Json JsonOf(const std::vector<ElementLine>& values)
{
    Json json = Json::array();
    for (const ElementLine& value : values) {
        Json& line = json.emplace_back(Json{{"depth", value.depth}, {"element", ToUtf8(value.name)}});
        if (value.text)
            line["text"] = ToUtf8(*value.text);
    }
    return json;
}

void AddOwnValues(Json& json, const std::vector<OwnValue>& values)
{
    for (const OwnValue& value : values) {
        json[std::string(value.element)] = ToUtf8(value.text);
        if (value.error)
            json["error"] = JsonOf(*value.error);
    }
}

std::string ReadBytes(const Text& path)
{
    try {
        return xml::ReadFile(path);
    } catch (const std::system_error& error) {
        throw FileError(error.code().value(), "show", path);
    }
}

Text FileNameIn(const Text& path) { return path.substr(path.rfind(u'/') + 1); }

// All that a file says below its root.
struct Content
{
    explicit Content(const xml::Document& document)
        : sections(ReadSections(document)), values(ReadOwnValues(document)), others(ReadOtherValues(document, sections))
    {}

    bool IsRead() const
    {
        const auto hasError = [](const auto& part) { return part.error.has_value(); };
        return std::ranges::none_of(sections, hasError) && std::ranges::none_of(values, hasError);
    }

    std::vector<Section> sections;
    std::vector<OwnValue> values;
    std::vector<ElementLine> others;
};

void PrintJson(Terminal& terminal, const MessageFile& file, const Content& content)
{
    Json json = tool::JsonOf(file);
    AddOwnValues(json, content.values);
    json["sections"] = JsonOf(content.sections);
    if (!content.others.empty())
        json["others"] = JsonOf(content.others);
    terminal.Line(JsonLine(json));
}

void PrintTree(Terminal& terminal, MessageDef& message, const Content& content)
{
    PrintSummary(terminal, message, Extent::Whole);
    for (const Section& section : content.sections)
        PrintSection(terminal, section);
    std::vector<ElementLine> others;
    for (const OwnValue& value : content.values)
        others.push_back({0, ToText(value.element), value.text});
    others.insert(others.end(), content.others.begin(), content.others.end());
    PrintOthers(terminal, others);
}

void PrintWhole(Terminal& terminal, MessageDef& message, const Content& content)
{
    if (!HasPage(message))
        return PrintTree(terminal, message, content);
    PrintSummary(terminal, message, Extent::Head);
    PrintPage(terminal, content.values, content.sections);
    PrintOthers(terminal, content.others);
}

} // namespace

Status Show(const ShowOptions& options, const Console& console)
{
    const Text path = xml::FromNativePath(options.file);
    const std::string bytes = ReadBytes(path);
    xml::Document document;
    document.LoadBytes(bytes);
    const Content content(document);
    const MessageFile file(std::move(document), FileNameIn(path), path);

    if (options.isJson)
        PrintJson(console.out, file, content);
    else if (file.IsBroken())
        PrintFault(console.out, file, bytes);
    else
        PrintWhole(console.out, *file.message, content);
    return file.IsFine() && content.IsRead() ? Status::Fine : Status::Findings;
}

} // namespace varnex3::tool
