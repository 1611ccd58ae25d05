// The texts of a list record, by position from 0 in the order of adding.
#pragma once

#include <vector>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Text.h"

namespace varnex3 {

// A list may grow beyond what its count can say, a 16-bit integer. The count then raises Overflow on behalf of the
// record's Count, and so does everything that asks for it.
class TextList
{
public:
    explicit TextList(Name countOperation_) : countOperation(countOperation_) {}

    std::int16_t Count() const { return CountOf(texts.size(), countOperation); }
    void Add(TextView text) { texts.emplace_back(text); }

    // The text at a position; "" outside the list.
    Text At(std::int32_t position) const { return IsInside(position) ? texts[Index(position)] : Text(); }

    // Replaces the text at a position; does nothing outside the list.
    void Set(std::int32_t position, TextView text)
    {
        if (IsInside(position))
            texts[Index(position)] = text;
    }

    std::vector<Text>::const_iterator begin() const { return texts.begin(); }
    std::vector<Text>::const_iterator end() const { return texts.end(); }

private:
    static std::size_t Index(std::int32_t position) { return static_cast<std::size_t>(position); }
    bool IsInside(std::int32_t position) const { return position >= 0 && position < Count(); }

    std::vector<Text> texts;
    Name countOperation;
};

} // namespace varnex3
