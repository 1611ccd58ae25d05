// The members of a list record, by position from 0 in the order of adding.
#pragma once

#include <cstdint>
#include <vector>

#include "varnex3/core/Record.h"

namespace varnex3 {

template <class T>
class RecordList
{
public:
    std::size_t Count() const { return records.size(); }

    // Appends a new record and gives it.
    Ref<T> Add()
    {
        records.push_back(New<T>());
        return records.back();
    }

    // The record at a position; nothing outside the list.
    Ref<T> At(std::int16_t position) const
    {
        const auto index = static_cast<std::size_t>(position);
        return position >= 0 && index < records.size() ? records[index] : nullptr;
    }

    const std::vector<Ref<T>>& All() const { return records; }

private:
    std::vector<Ref<T>> records;
};

} // namespace varnex3
