// An insertion-ordered list whose items have a unique text key.
#pragma once

#include <algorithm>
#include <memory>
#include <unordered_map>
#include <vector>

#include "varnex3/core/Error.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

// Keys are compared by their characters, letter case included. Positions count from 0 in the order of adding; removing
// closes the gap.
template <class T>
class KeyedList
{
public:
    std::size_t Count() const { return entries.size(); }

    // Adds an item at the end. Raises DuplicateKey on behalf of the operation when the key is there already; the list
    // is then unchanged.
    T& Add(Text key, T item, Name operation)
    {
        if (FindEntry(key))
            Raise(ErrorNumber::DuplicateKey, operation, u"the key " + Quoted(key) + u" is already in the list");
        entries.push_back(std::make_unique<Entry>(Entry{std::move(key), std::move(item)}));
        if (entries.size() == kFew + 1)
            for (const auto& entry : entries)
                index.emplace(entry->key, entry.get());
        else if (entries.size() > kFew)
            index.emplace(entries.back()->key, entries.back().get());
        return entries.back()->item;
    }

    // The item of a key, or null.
    T* Find(TextView key)
    {
        Entry* const found = FindEntry(key);
        return found ? &found->item : nullptr;
    }

    // Precondition of these: position < Count().
    const Text& KeyAt(std::size_t position) const { return entries[position]->key; }
    T& ItemAt(std::size_t position) { return entries[position]->item; }
    const T& ItemAt(std::size_t position) const { return entries[position]->item; }
    void RemoveAt(std::size_t position)
    {
        index.erase(entries[position]->key);
        entries.erase(entries.begin() + static_cast<std::ptrdiff_t>(position));
        if (entries.size() == kFew)
            index.clear();
    }

    // Raises KeyNotFound on behalf of the operation when there is no such key.
    void Remove(TextView key, Name operation)
    {
        const Entry* const found = FindEntry(key);
        if (!found)
            Raise(ErrorNumber::KeyNotFound, operation, u"the key " + Quoted(key) + u" is not in the list");
        const auto entry = std::ranges::find(entries, found, &std::unique_ptr<Entry>::get);
        RemoveAt(static_cast<std::size_t>(entry - entries.begin()));
    }

private:
    struct Entry
    {
        Text key;
        T item;
    };

    Entry* FindEntry(TextView key) const
    {
        if (entries.size() > kFew) {
            const auto found = index.find(key);
            return found == index.end() ? nullptr : found->second;
        }
        const auto found = std::ranges::find(entries, key, [](const auto& entry) { return TextView(entry->key); });
        return found == entries.end() ? nullptr : found->get();
    }

    static constexpr std::size_t kFew = 8; // that many keys are looked through faster than an index is made

    std::vector<std::unique_ptr<Entry>> entries;
    // Of more than a few entries; empty for fewer. The views look into the entries, which stay where they are.
    std::unordered_map<TextView, Entry*> index;
};

} // namespace varnex3
