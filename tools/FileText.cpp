#include "FileText.h"

#include "varnex3/xml/Encoding.h"

namespace varnex3::tool {

Text DecodeFileText(std::string_view bytes)
{
    const xml::EncodingFacts facts = xml::DetectEncoding(bytes);
    bytes.remove_prefix(facts.markLength);
    switch (facts.encoding) {
    case xml::Encoding::Utf16LittleEndian:
    case xml::Encoding::Utf16BigEndian:
        return Text(xml::Utf16FromBytes(bytes, facts.encoding).View());
    case xml::Encoding::Latin1:
    case xml::Encoding::Windows1252:
        return ToUtf16(xml::Utf8FromSingleBytes(bytes, facts.encoding).View());
    case xml::Encoding::Unknown:
        return ToUtf16(xml::Utf8FromSingleBytes(bytes, xml::Encoding::Latin1).View());
    case xml::Encoding::Utf8:
    case xml::Encoding::Ascii:
        break;
    }
    return ToUtf16(bytes);
}

} // namespace varnex3::tool
