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
    T& Add(const Text& key, T item, Name operation)
    {
        auto entry = std::make_unique<Entry>(Entry{key, std::move(item)});
        if (!index.emplace(entry->key, entry.get()).second)
            Raise(ErrorNumber::DuplicateKey, operation, u"the key " + Quoted(key) + u" is already in the list");
        entries.push_back(std::move(entry));
        return entries.back()->item;
    }

    // The item of a key, or null.
    T* Find(TextView key)
    {
        const auto found = index.find(key);
        return found == index.end() ? nullptr : &found->second->item;
    }

    // Precondition of these: position < Count().
    const Text& KeyAt(std::size_t position) const { return entries[position]->key; }
    T& ItemAt(std::size_t position) { return entries[position]->item; }
    const T& ItemAt(std::size_t position) const { return entries[position]->item; }
    void RemoveAt(std::size_t position)
    {
        index.erase(entries[position]->key);
        entries.erase(entries.begin() + static_cast<std::ptrdiff_t>(position));
    }

    // Raises KeyNotFound on behalf of the operation when there is no such key.
    void Remove(TextView key, Name operation)
    {
        const auto found = index.find(key);
        if (found == index.end())
            Raise(ErrorNumber::KeyNotFound, operation, u"the key " + Quoted(key) + u" is not in the list");
        const auto entry = std::ranges::find(entries, found->second, &std::unique_ptr<Entry>::get);
        index.erase(found);
        entries.erase(entry);
    }

private:
    struct Entry
    {
        Text key;
        T item;
    };

    std::vector<std::unique_ptr<Entry>> entries;
    std::unordered_map<TextView, Entry*> index; // the views look into the entries, which stay where they are
};

} // namespace varnex3
