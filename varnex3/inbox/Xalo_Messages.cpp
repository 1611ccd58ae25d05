#include "varnex3/inbox/Xalo_Messages.h"

#include "varnex3/inbox/InboxFolder.h"

namespace varnex3 {

VARNEX_DEFINE(Xalo_Messages);

bool Xalo_Messages::ParseFiles(const Text& sFolderPath, std::int32_t* ErrorNo, Text* ErrorMessage)
{
    try {
        AddFiles(sFolderPath);
        return true;
    } catch (...) {
        const Error error = CurrentError("Xalo_Messages.ParseFiles");
        if (ErrorNo)
            *ErrorNo = error.Number();
        if (ErrorMessage)
            *ErrorMessage = error.Description();
        return false;
    }
}

void Xalo_Messages::AddFiles(const Text& folder)
{
    InboxFolder inbox(folder);
    for (const Text& name : inbox.FileNames()) {
        xml::Document document;
        inbox.Load(name, document);
        Add(name)->AdoptFile(std::move(document), name, inbox.PathOf(name)); // every file gets an entry
    }
}

Variant Xalo_Messages::Remove(const Variant& Index)
{
    if (messages.Count() == 0)
        return Empty;
    const std::optional<std::int32_t> position = PositionFrom(Index);
    if (!position)
        messages.Remove(ToText(Index), "Xalo_Messages.Remove");
    else if (const std::optional<std::size_t> inRange = PositionInRange(*position))
        messages.RemoveAt(*inRange);
    return Empty;
}

Ref<MessageDef> Xalo_Messages::MessageItems(const Variant& Index)
{
    if (messages.Count() == 0)
        return nullptr;
    if (const std::optional<std::int32_t> position = PositionFrom(Index)) {
        const std::optional<std::size_t> inRange = PositionInRange(*position);
        return inRange ? messages.ItemAt(*inRange) : nullptr;
    }
    const Text key = ToText(Index);
    const Ref<MessageDef>* found = messages.Find(key);
    if (!found)
        found = &messages.Add(key, nullptr, "Xalo_Messages.MessageItems"); // looking an unknown key up adds it
    if (!*found)
        Raise(ErrorNumber::ObjectRequired, "Xalo_Messages.MessageItems", u"the entry " + Quoted(key) + u" is empty");
    return *found;
}

Ref<MessageDef> Xalo_Messages::Add(const Text& Key)
{
    return messages.Add(Key, New<MessageDef>(), "Xalo_Messages.Add");
}

std::int16_t Xalo_Messages::Count() const { return CountOf(messages.Count(), "Xalo_Messages.Count"); }

std::optional<std::size_t> Xalo_Messages::PositionInRange(std::int32_t position) const
{
    const bool isInRange = position >= 0 && static_cast<std::size_t>(position) < messages.Count();
    return isInRange ? std::optional(static_cast<std::size_t>(position)) : std::nullopt;
}

} // namespace varnex3
