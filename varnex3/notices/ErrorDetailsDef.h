// What was wrong with a message.
#pragma once

#include "varnex3/notices/ErrorDetailsItem.h"
#include "varnex3/notices/RecordList.h"

namespace varnex3 {

class ErrorDetailsDef final : public Record
{
    VARNEX_RECORD(ErrorDetailsDef, "The error details of a message, in the order in which they were added. None is "
                                   "ever removed.");
    VARNEX_SERIALISE("The ErrorDetails group of every item, side by side; nothing when there is none.");
    VARNEX_PARSEXML(Text, "Appends one item, whatever the text, and has it read the text.");
    VARNEX_METHOD(Ref<ErrorDetailsItem>, Add, (), "Appends a new item and returns it.");
    VARNEX_INDEXED_READONLY(Ref<ErrorDetailsItem>, ErrorItems, (std::int16_t Index),
                            "The item at a position, from 0; nothing when there is none.");
    VARNEX_METHOD(Text, ErrorItemsDescCSV, (const Text& sDelimiter = u","),
                  "The descriptions that are not empty, each followed by the delimiter, without the last character: of "
                  "a longer delimiter the rest stays at the end, with an empty one the last description loses a "
                  "character. No items give the empty text; items without any description raise InvalidArgument (5).");
    VARNEX_READONLY(std::int32_t, Count, "Number of items.");

private:
    RecordList<ErrorDetailsItem> items;
    VARNEX_RECORD_END;
};

} // namespace varnex3
