// A part on a quote item, and where it comes from.
#pragma once

#include "varnex3/core/Rows.h"

namespace varnex3 {

VARNEX_ENUM(PartSourceTypeEnum, "Where a part comes from.", (Aftermarket, 0, "A maker other than the vehicle's."),
            (Exchange, 1, "An exchanged part."), (Used, 2, "A used part."),
            (OEM, 3, "The vehicle's maker; the only source that needs a part number, and writes it."));

class QuoteItemPartPartSource final : public Record
{
    VARNEX_RECORD(QuoteItemPartPartSource, "Where a part comes from; written by its part only.");
    VARNEX_PARSEXML(Text,
                    "Reads category and code from the name of the first child of PartSource, and the part number from "
                    "that child's first attribute, whatever it is called. What is not there, or is not known, leaves "
                    "the values as they were.");
    VARNEX_PROPERTY(Text, sPartNumber, PartNumber, "Part number; written for an OEM part only.");
    VARNEX_ACCESSORS(
        PartSourceTypeEnum, Category,
        "Where the part comes from; names the element written. Setting it leaves PartSourceCode as it is.");
    VARNEX_ACCESSORS(Text, PartSourceCode,
                     "Code of the source. Setting stores it in upper case and sets Category: A is Aftermarket, X and C "
                     "are Exchange, U and R are Used, every other code, the empty one included, is OEM. Reading a text "
                     "stores A, X, U, or one blank for OEM.");

public:
    static constexpr int kLevel = 4;

    // What the part writes: the PartSource group. Raises PartNumberMissing (30101) for an OEM part without a number.
    void Write(XmlWriter& xml) const;

private:
    PartSourceTypeEnum eCategory{};
    Text sPartSourceCode;
    VARNEX_RECORD_END;
};

class QuoteItemPart final : public Record
{
    VARNEX_RECORD(QuoteItemPart, "A part: its value, quantity, side and source.");
    VARNEX_SERIALISE(
        "The Part element; nothing when value and quantity are 0 or less and the orientation is empty. An OEM source "
        "without a part number raises error 30101.");
    VARNEX_PARSEXML(
        Text, "Reads every value; an absent one is 0 or the empty text. An orientation of left, right or other, in "
              "any letter case, sets PartOrientationCode; any other leaves it as it was.");
    VARNEX_PROPERTY(double, dPartValue, PartValue, "Value in dollars.");
    VARNEX_PROPERTY(std::int16_t, iPartQuantity, PartQuantity, "Number of parts.");
    VARNEX_PROPERTY(Text, sPartOrientation, PartOrientation,
                    "Side of the vehicle in words. Setting it leaves PartOrientationCode as it is.");
    VARNEX_PROPERTY(Child<QuoteItemPartPartSource>, objPartSource, PartSource, "Where the part comes from.");
    VARNEX_ACCESSORS(
        Text, PartOrientationCode,
        "Code of the side. Setting stores it in upper case and sets PartOrientation: L is Left, R is Right, "
        "O and the empty code are Other; any other code leaves it as it was.");

public:
    static constexpr int kLevel = 3;

private:
    Text sPartOrientationCode;
    VARNEX_RECORD_END;
};

} // namespace varnex3
