// An inbox folder as a list of message summaries.
#pragma once

#include "varnex3/core/KeyedList.h"
#include "varnex3/inbox/MessageDef.h"

namespace varnex3 {

// An index is a position, from 0, when it is a number or a text that is one; any other text is a key. The key of a file
// is its name; a key that looks like a number is therefore reached by its position only.
class Xalo_Messages final : public Record
{
    VARNEX_RECORD(Xalo_Messages, "The messages of an inbox folder, in the order in which they were added.");
    VARNEX_METHOD(
        bool, ParseFiles, (const Text& sFolderPath, std::int32_t* ErrorNo = nullptr, Text* ErrorMessage = nullptr),
        "Adds a summary of every file of the folder whose extension is xml, in any letter case, in name order; "
        "subfolders are not visited. A file that is not well-formed gets an entry with ParseError set. False when "
        "the folder does not exist (30030), or when a file cannot be read or its name is a key already (457): the "
        "scan ends there, ErrorNo and ErrorMessage say why, and what was added before stays. On success both stay "
        "as they were.");
    VARNEX_METHOD(
        Variant, Remove, (const Variant& Index),
        "Removes an entry; a position out of range does nothing, an unknown key raises KeyNotFound (32811). The "
        "result is always Empty.");
    VARNEX_INDEXED_READONLY(
        Ref<MessageDef>, MessageItems, (const Variant& Index),
        "An entry; nothing when the list is empty or the position is out of range. An unknown key adds an empty "
        "entry under that key and raises ObjectRequired (424).");
    VARNEX_METHOD(Ref<MessageDef>, Add, (const Text& Key),
                  "Appends a new summary and returns it. A key that is there already raises DuplicateKey (457).");
    VARNEX_READONLY(std::int16_t, Count, "Number of entries; more than 32,767 raise Overflow (6).");

private:
    std::optional<std::size_t> PositionInRange(std::int32_t position) const;
    void AddFiles(const Text& folder);

    KeyedList<Ref<MessageDef>> messages;
    VARNEX_RECORD_END;
};

} // namespace varnex3
