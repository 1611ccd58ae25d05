#include "IdentifyCommand.h"

#include <algorithm>
#include <nlohmann/json.hpp>

#include "DisplayText.h"
#include "MessageFile.h"
#include "RootTag.h"
#include "Summary.h"
#include "Table.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

using Json = nlohmann::ordered_json;

struct Identity
{
    Text path;
    Text root;
    Text description; // of the type; empty when it is no message
    Text reason;      // why it is none
    XaloMessageTypeEnum type{};
    bool isReadable = true;

    bool IsMessage() const { return !description.empty(); }
};

Identity IdentityOfRoot(const Text& path, const RootTag& tag)
{
    if (tag.name.empty())
        return {path, {}, {}, tag.reason};
    const Ref<MessageDef> message = New<MessageDef>();
    message->MessageType(tag.name);
    if (!IsMessage(*message))
        return {path, tag.name, {}, u"The root element is not that of a message"};
    return {path, tag.name, message->MessageDescription(), {}, message->MessageTypeID()};
}

Identity IdentityOf(const Text& path)
{
    try {
        return IdentityOfRoot(path, ReadRootTag(path));
    } catch (...) {
        return {path, {}, {}, ReasonIn(CurrentError({}), {}), {}, false};
    }
}

Json JsonOf(const Identity& identity)
{
    Json json{{"FilePath", ToUtf8(identity.path)}, {"isMessage", identity.IsMessage()}};
    if (!identity.root.empty())
        json["MessageType"] = ToUtf8(identity.root);
    if (identity.IsMessage()) {
        json["MessageTypeID"] = EnumeratorText(EnumerationOf(identity.type), static_cast<std::int32_t>(identity.type));
        json["MessageDescription"] = ToUtf8(identity.description);
    } else {
        json["error"] = {{"kind", identity.isReadable ? "no message" : "unreadable"},
                         {"reason", ToUtf8(identity.reason)}};
    }
    return json;
}

std::vector<Cell> RowOf(const Identity& identity)
{
    if (identity.IsMessage())
        return {{Printable(identity.path)}, {Printable(identity.description)}, {Printable(identity.root)}};
    const std::string state = identity.isReadable ? "no message" : "unreadable";
    return {{Printable(identity.path)}, {state, Style::Bad}, {Printable(identity.root)}};
}

bool AreAllMessages(const std::vector<Identity>& identities)
{
    return std::ranges::all_of(identities, &Identity::IsMessage);
}

void PrintTable(Terminal& terminal, const std::vector<Identity>& identities)
{
    Table table({{"File", 22, 3}, {"Type", 10, 2}, {"Root element", 12, 1}});
    for (const Identity& identity : identities)
        table.Add(RowOf(identity));
    table.Print(terminal);

    if (AreAllMessages(identities))
        return;
    terminal.Line();
    for (const Identity& identity : identities)
        if (!identity.IsMessage())
            terminal.Paragraph(Printable(identity.path) + ": " + Printable(identity.reason), 4);
}

} // namespace

Status Identify(const IdentifyOptions& options, const Console& console)
{
    std::vector<Identity> identities;
    for (const std::string& file : options.files) {
        identities.push_back(IdentityOf(xml::FromNativePath(file)));
        if (options.isJson)
            console.out.Line(JsonLine(JsonOf(identities.back())));
    }
    if (!options.isJson)
        PrintTable(console.out, identities);
    return AreAllMessages(identities) ? Status::Fine : Status::Findings;
}

} // namespace varnex3::tool
