// A message on its way out of the program: as XML or as JSON, to the standard output or into a file.
#pragma once

#include <string>
#include <vector>

#include "Status.h"
#include "Terminal.h"
#include "varnex3/core/Interface.h"

namespace varnex3::tool {

// The classes of whole messages, in the order of the documentation.
std::vector<const ClassInfo*> MessageClasses();

// The class of a message by its name, or null.
const ClassInfo* FindMessageClass(Name name);

// The same for what a person typed: with or without Xalo_, in any letter case.
const ClassInfo* FindMessageClassLike(Name typed);

// The name of a message's class without Xalo_.
Name ShortNameOf(const ClassInfo& message);

bool CanRead(const ClassInfo& message);

enum class MessageFormat
{
    Xml,
    Json
};

// "xml", "json".
MessageFormat MessageFormatNamed(const std::string& name);

// A message as its Serialise, or as JSON, in lines of two blanks a level. Raises what Serialise raises.
std::string BytesOf(Record& message, MessageFormat format);

// Writes them into a file, by the name that the system has for it, or without one to the standard output. XML that is
// not well-formed, as some texts make it, is written and told: a finding.
Status WriteMessage(const std::string& bytes, MessageFormat format, const std::string& file, const Console& console);

} // namespace varnex3::tool
