#include "varnex3/notices/ErrorDetailsDef.h"

#include "varnex3/core/Error.h"

namespace varnex3 {

VARNEX_DEFINE(ErrorDetailsDef);

Ref<ErrorDetailsItem> ErrorDetailsDef::Add() { return items.Add(); }

Ref<ErrorDetailsItem> ErrorDetailsDef::ErrorItems(std::int16_t Index) { return items.At(Index); }

Text ErrorDetailsDef::ErrorItemsDescCSV(const Text& sDelimiter)
{
    if (items.Count() == 0)
        return {};
    Text joined;
    for (const Ref<ErrorDetailsItem>& item : items.All())
        joined += item->Descriptions(sDelimiter);
    if (joined.empty())
        Raise(ErrorNumber::InvalidArgument, "ErrorDetailsDef.ErrorItemsDescCSV",
              u"Description: '' in every item leaves no character to cut");
    joined.pop_back(); // one character, however long the delimiter
    return joined;
}

std::int32_t ErrorDetailsDef::Count() const { return static_cast<std::int32_t>(items.Count()); }

void ErrorDetailsDef::Write(XmlWriter& xml) const { xml.AppendEach(items.All()); }

void ErrorDetailsDef::Read(const XmlSection& section) { Add()->Read(section); }

} // namespace varnex3
