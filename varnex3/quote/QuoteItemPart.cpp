#include "varnex3/quote/QuoteItemPart.h"

#include "varnex3/core/Error.h"

namespace varnex3 {

VARNEX_DEFINE(QuoteItemPart);
VARNEX_DEFINE(QuoteItemPartPartSource);

namespace {

struct Orientation
{
    TextView word;
    TextView code;
};

constexpr Orientation kOrientations[] = {
    {u"Left", u"L"},
    {u"Right", u"R"},
    {u"Other", u"O"},
};

struct Source
{
    PartSourceTypeEnum category;
    TextView element;
    TextView readCode; // what reading the element stores
};

constexpr Source kSources[] = {
    {PartSourceTypeEnum::Aftermarket, u"Aftermarket", u"A"},
    {PartSourceTypeEnum::Exchange, u"Exchange", u"X"},
    {PartSourceTypeEnum::Used, u"Used", u"U"},
    {PartSourceTypeEnum::OEM, u"OEM", u" "}, // one blank, where every other source has a letter
};

struct SourceCode
{
    TextView code;
    PartSourceTypeEnum category;
};

constexpr SourceCode kSourceCodes[] = {
    {u"A", PartSourceTypeEnum::Aftermarket}, {u"X", PartSourceTypeEnum::Exchange}, {u"C", PartSourceTypeEnum::Exchange},
    {u"U", PartSourceTypeEnum::Used},        {u"R", PartSourceTypeEnum::Used},
};

PartSourceTypeEnum CategoryOf(TextView code)
{
    for (const SourceCode& row : kSourceCodes)
        if (row.code == code)
            return row.category;
    return PartSourceTypeEnum::OEM; // every other code
}

} // namespace

// ---- QuoteItemPart

Text QuoteItemPart::PartOrientationCode() { return sPartOrientationCode; }

void QuoteItemPart::PartOrientationCode(Text value)
{
    sPartOrientationCode = ToUpper(std::move(value));
    for (const Orientation& row : kOrientations)
        if (row.code == sPartOrientationCode)
            sPartOrientation = row.word;
    if (sPartOrientationCode.empty())
        sPartOrientation = u"Other";
}

void QuoteItemPart::Write(XmlWriter& xml) const
{
    if (dPartValue <= 0 && iPartQuantity <= 0 && !IsSet(sPartOrientation))
        return;

    xml.Open("Part");
    xml.Always("PartValue", dPartValue);
    xml.Always("PartQuantity", iPartQuantity);
    xml.Always("PartOrientation", sPartOrientation);
    xml.Append(objPartSource);
    xml.Close("Part");
}

void QuoteItemPart::Read(const XmlSection& section)
{
    dPartValue = section.NumberAt("Part/PartValue");
    iPartQuantity = section.Int16At("Part/PartQuantity");
    sPartOrientation = section.TextAt("Part/PartOrientation");
    for (const Orientation& row : kOrientations)
        if (EqualsIgnoringCase(row.word, sPartOrientation))
            sPartOrientationCode = row.code;
    section.ReadIntoWhereUsed(objPartSource, "Part/PartSource");
}

// ---- QuoteItemPartPartSource

PartSourceTypeEnum QuoteItemPartPartSource::Category() { return eCategory; }

void QuoteItemPartPartSource::Category(PartSourceTypeEnum value) { eCategory = value; }

Text QuoteItemPartPartSource::PartSourceCode() { return sPartSourceCode; }

void QuoteItemPartPartSource::PartSourceCode(Text value)
{
    sPartSourceCode = ToUpper(std::move(value));
    eCategory = CategoryOf(sPartSourceCode);
}

void QuoteItemPartPartSource::Write(XmlWriter& xml) const
{
    xml.Open("PartSource");
    switch (eCategory) {
    case PartSourceTypeEnum::Aftermarket:
        xml.Always("Aftermarket", u""); // these three never write their part number
        break;
    case PartSourceTypeEnum::Exchange:
        xml.Always("Exchange", u"");
        break;
    case PartSourceTypeEnum::Used:
        xml.Always("Used", u"");
        break;
    case PartSourceTypeEnum::OEM:
        if (!IsSet(sPartNumber))
            Raise(ErrorNumber::PartNumberMissing, "QuoteItemPartPartSource.Serialise",
                  u"OEM \"PartNumber\" attribute is required field.");
        xml.AlwaysWithAttribute("OEM", "PartNumber", sPartNumber, u"");
        break;
    }
    xml.Close("PartSource");
}

void QuoteItemPartPartSource::Read(const XmlSection& section)
{
    const xml::Node child = section.FirstChildOf("PartSource");
    const Text name = child.Name();
    for (const Source& row : kSources)
        if (EqualsIgnoringCase(row.element, name)) {
            eCategory = row.category;
            sPartSourceCode = row.readCode;
        }
    if (child.AttributeCount() > 0)
        sPartNumber = child.AttributeValue(0);
}

} // namespace varnex3
