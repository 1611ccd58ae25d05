// One message file as the program met it: its summary, and what is wrong with it.
#pragma once

#include <nlohmann/json_fwd.hpp>
#include <optional>
#include <string>

#include "varnex3/core/Error.h"
#include "varnex3/inbox/InboxFolder.h"
#include "varnex3/inbox/MessageDef.h"

namespace varnex3::tool {

struct MessageFile
{
    // Takes over what a file was loaded into.
    MessageFile(xml::Document loaded, const Text& name, const Text& path);
    // A file that could not be read.
    MessageFile(const Error& error, const Text& name, const Text& path);

    bool IsBroken() const { return static_cast<bool>(fault); }
    bool IsUnreadable() const { return failure.has_value(); }
    bool IsFine() const { return !IsBroken() && !IsUnreadable(); }

    Ref<MessageDef> message = New<MessageDef>(); // of a broken file: without values, but with its name
    xml::ParseError fault;                       // the file's own, not the empty document's that the summary tells of
    std::optional<Error> failure;
};

// Reads a file of an inbox; one that cannot be read is an answer, too.
MessageFile ReadMessageFile(InboxFolder& inbox, const Text& name);

// What the system said about a file, without the path that the library's description starts with.
Text ReasonIn(const Error& error, const Text& path);

// Where and why a file is broken, "name:line:column: reason", or why it cannot be read, "name: reason"; printable.
std::string FindingOf(const MessageFile& file, const Text& name);

// The properties of the summary, and for a file that is not fine an object "error".
nlohmann::ordered_json JsonOf(const MessageFile& file);

// On one line, UTF-8, control characters as \u009B.
std::string JsonLineOf(const MessageFile& file);
std::string JsonLine(const nlohmann::ordered_json& json);

} // namespace varnex3::tool
