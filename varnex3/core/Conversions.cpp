#include "varnex3/core/Conversions.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <limits>
#include <string>
#include <system_error>

#include "varnex3/core/Error.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3 {

namespace {

template <class... F>
struct Overloaded : F...
{
    using F::operator()...;
};
template <class... F>
Overloaded(F...) -> Overloaded<F...>;

[[noreturn]] void Mismatch(TextView value, TextView wanted)
{
    throw Error(ErrorNumber::TypeMismatch, {}, Quoted(value) + u" is not " + Text(wanted));
}

[[noreturn]] void RecordIsNot(const Ref<Record>& record, TextView wanted)
{
    throw Error(ErrorNumber::TypeMismatch, {}, (record ? u"an object is not " : u"nothing is not ") + Text(wanted));
}

[[noreturn]] void Outside(TextView value, TextView type)
{
    throw Error(ErrorNumber::Overflow, {}, Quoted(value) + u" is outside the range of " + Text(type));
}

constexpr bool IsDigit(char16_t c) { return c >= u'0' && c <= u'9'; }

// Reads a text from left to right; each step says whether it found what it looked for.
class Scanner
{
public:
    explicit Scanner(TextView text) : rest(text) {}

    bool AtEnd() const { return rest.empty(); }
    bool Take(char16_t c)
    {
        if (rest.empty() || rest.front() != c)
            return false;
        rest.remove_prefix(1);
        return true;
    }
    // As many digits as there are, at most this many; their count.
    std::size_t TakeDigits(std::int32_t& value, std::size_t most)
    {
        std::size_t count = 0;
        for (value = 0; count < most && !rest.empty() && IsDigit(rest.front()); ++count) {
            value = value * 10 + (rest.front() - u'0');
            rest.remove_prefix(1);
        }
        return count;
    }

private:
    TextView rest;
};

// The narrow form of a text that has the form of a number, ready for from_chars; nothing when it has another form.
std::optional<std::string> NumberForm(TextView text)
{
    text = Trimmed(text);
    std::string form;
    form.reserve(text.size());
    std::size_t i = 0;
    const auto digits = [&] {
        const std::size_t start = i;
        for (; i < text.size() && IsDigit(text[i]); ++i)
            form += static_cast<char>(text[i]);
        return i - start;
    };
    if (i < text.size() && (text[i] == u'-' || text[i] == u'+')) {
        if (text[i] == u'-')
            form += '-';
        ++i;
    }
    std::size_t count = digits();
    if (i < text.size() && text[i] == u'.') {
        form += '.';
        ++i;
        count += digits();
    }
    if (count == 0)
        return std::nullopt;
    if (i < text.size() && (text[i] == u'e' || text[i] == u'E')) {
        form += 'e';
        ++i;
        if (i < text.size() && (text[i] == u'-' || text[i] == u'+'))
            form += static_cast<char>(text[i++]);
        if (digits() == 0)
            return std::nullopt;
    }
    return i == text.size() ? std::optional(form) : std::nullopt;
}

// Whether a number that from_chars finds out of range is too small rather than too large: its first digit that
// counts stands behind the decimal point even after the exponent has moved it.
bool IsTooSmall(std::string_view form)
{
    const std::size_t e = form.find('e');
    const std::string_view mantissa = form.substr(0, e);
    const std::size_t first = mantissa.find_first_of("123456789");
    const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
    const double place = static_cast<double>(point) - static_cast<double>(first);
    const bool hasNegativeExponent = e != std::string_view::npos && e + 1 < form.size() && form[e + 1] == '-';
    std::string_view exponentDigits = e == std::string_view::npos ? std::string_view() : form.substr(e + 1);
    exponentDigits.remove_prefix(std::min(exponentDigits.find_first_not_of("+-0"), exponentDigits.size()));
    const double exponent = exponentDigits.size() > 9 ? 1e9
                            : exponentDigits.empty()  ? 0
                                                      : std::stod(std::string(exponentDigits));
    return place + (hasNegativeExponent ? -exponent : exponent) < 0;
}

// Takes the number of a text that is digits with at most one point among them; false for every other text. A quotient
// of two numbers that are exact is rounded once, so the result is the nearest double, as that of from_chars.
bool TakePlainNumber(TextView text, double& number)
{
    constexpr std::size_t kMostExactDigits = 15;
    constexpr double kPowers[] = {1e0, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14};
    if (text.empty() || text.size() > kMostExactDigits)
        return false;
    std::int64_t digits = 0;
    const auto takeDigits = [&](std::size_t i) {
        for (; i < text.size() && IsDigit(text[i]); ++i)
            digits = digits * 10 + (text[i] - u'0');
        return i;
    };
    std::size_t fraction = takeDigits(0);
    if (fraction < text.size()) {
        ++fraction; // the point
        if (text[fraction - 1] != u'.' || text.size() == 1 || takeDigits(fraction) < text.size())
            return false;
    }
    number = static_cast<double>(digits) / kPowers[text.size() - fraction];
    return true;
}

// Nothing when the text does not have the form of a number.
std::optional<double> TryNumber(TextView text)
{
    if (double plain = 0; TakePlainNumber(text, plain))
        return plain;
    const std::optional<std::string> form = NumberForm(text);
    if (!form)
        return std::nullopt;
    double value = 0;
    const auto [end, fault] = std::from_chars(form->data(), form->data() + form->size(), value);
    if (fault != std::errc::result_out_of_range)
        return value;
    if (!IsTooSmall(*form))
        Outside(text, u"a number");
    return 0.0;
}

template <class Integer>
std::optional<Integer> Rounded(double number)
{
    const double rounded = std::nearbyint(number); // halves to even: the default rounding mode
    const bool isInRange =
        rounded >= std::numeric_limits<Integer>::min() && rounded <= std::numeric_limits<Integer>::max();
    return isInRange ? std::optional(static_cast<Integer>(rounded)) : std::nullopt;
}

constexpr TextView kInt16 = u"a 16-bit integer";
constexpr TextView kInt32 = u"a 32-bit integer";

template <class Integer>
Integer IntegerFrom(TextView text, TextView type)
{
    if (const std::optional<Integer> integer = Rounded<Integer>(NumberFrom(text)))
        return *integer;
    Outside(text, type);
}

template <class Integer>
Integer ToInteger(const Variant& value, TextView type)
{
    if (const std::optional<Integer> integer = Rounded<Integer>(ToDouble(value)))
        return *integer;
    Outside(ToText(value), type);
}

Text Widened(const char* first, const char* last) { return {first, last}; }

template <class T>
Text Decimal(T value)
{
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), value).ptr;
    return Widened(digits.data(), end);
}

} // namespace

double NumberFrom(TextView text)
{
    if (double plain = 0; TakePlainNumber(text, plain)) // most are, and the others take longer
        return plain;
    if (const std::optional<double> number = TryNumber(text))
        return *number;
    Mismatch(text, u"a number");
}

Date DateFrom(TextView text)
{
    const std::size_t last = text.find_last_not_of(u' ');
    Scanner scanner(text.substr(0, last == TextView::npos ? 0 : last + 1));
    CivilDate civil{0, 0, 0, 0, 0, 0};
    const bool hasDay = scanner.TakeDigits(civil.year, 4) == 4 && scanner.Take(u'-')
                        && scanner.TakeDigits(civil.month, 2) > 0 && scanner.Take(u'-')
                        && scanner.TakeDigits(civil.day, 2) > 0;
    const bool hasTime = hasDay && !scanner.AtEnd();
    const bool isTime = hasTime && (scanner.Take(u' ') || scanner.Take(u'T')) && scanner.TakeDigits(civil.hour, 2) > 0
                        && scanner.Take(u':') && scanner.TakeDigits(civil.minute, 2) == 2
                        && (scanner.AtEnd() || (scanner.Take(u':') && scanner.TakeDigits(civil.second, 2) == 2));
    const bool isWhole = hasDay && (isTime || !hasTime) && scanner.AtEnd();
    const std::optional<Date> date = isWhole ? DateFrom(civil) : std::nullopt;
    if (!date)
        Mismatch(text, u"a date");
    return *date;
}

double ToDouble(const Variant& value)
{
    return std::visit(Overloaded{[](EmptyValue) { return 0.0; }, [](const Text& text) { return NumberFrom(text); },
                                 [](bool flag) { return flag ? -1.0 : 0.0; }, // True is -1 to automation hosts
                                 [](Date date) { return date.serial; },
                                 [](const Ref<Record>& record) -> double { RecordIsNot(record, u"a number"); },
                                 [](auto number) { return static_cast<double>(number); }},
                      value);
}

std::int16_t Int16From(TextView text) { return IntegerFrom<std::int16_t>(text, kInt16); }

std::int32_t Int32From(TextView text) { return IntegerFrom<std::int32_t>(text, kInt32); }

std::int16_t ToInt16(const Variant& value) { return ToInteger<std::int16_t>(value, kInt16); }

std::int32_t ToInt32(const Variant& value) { return ToInteger<std::int32_t>(value, kInt32); }

bool ToBoolean(const Variant& value)
{
    const Text* const text = std::get_if<Text>(&value);
    if (!text)
        return ToDouble(value) != 0;
    if (EqualsIgnoringCase(*text, u"True"))
        return true;
    if (EqualsIgnoringCase(*text, u"False"))
        return false;
    if (const std::optional<double> number = TryNumber(*text))
        return *number != 0;
    Mismatch(*text, u"a Boolean");
}

Date ToDate(const Variant& value)
{
    if (const Text* const text = std::get_if<Text>(&value))
        return DateFrom(*text);
    const Date date{ToDouble(value)};
    CivilFrom(date); // raises outside the years 100 to 9999
    return date;
}

Text ToText(const Variant& value)
{
    return std::visit(Overloaded{[](EmptyValue) { return Text(); }, [](const Text& text) { return text; },
                                 [](bool flag) { return flag ? Text(u"True") : Text(u"False"); },
                                 [](Date date) {
                                     const Text day = FormatDate(date, 0);
                                     const Text time = FormatDate(date, 1).substr(11);
                                     return time == u"00:00:00" ? day : day + u" " + time;
                                 },
                                 [](const Ref<Record>& record) -> Text { RecordIsNot(record, u"a text"); },
                                 [](auto number) { return Decimal(number); }},
                      value);
}

std::optional<std::int32_t> PositionFrom(const Variant& index)
{
    if (const Text* const text = std::get_if<Text>(&index)) {
        const std::optional<double> number = TryNumber(*text);
        return number ? std::optional(ToInt32(*number)) : std::nullopt;
    }
    if (std::holds_alternative<Date>(index) || std::holds_alternative<Ref<Record>>(index))
        return std::nullopt;
    return ToInt32(index);
}

std::int16_t CountOf(std::size_t count, Name operation)
{
    if (count > static_cast<std::size_t>(std::numeric_limits<std::int16_t>::max()))
        Raise(ErrorNumber::Overflow, operation,
              u"the count " + Decimal(count) + u" is outside the range of a 16-bit integer");
    return static_cast<std::int16_t>(count);
}

NumberText::NumberText(std::int32_t value)
{
    PutDigits(static_cast<std::uint64_t>(std::abs(std::int64_t{value})));
    if (value < 0)
        Put('-');
}

bool NumberText::PutAmount(double amount)
{
    // Both the double and its shortest decimal text differ from the amount by far less than this share of a hundredth.
    constexpr double kNear = 1e-3;
    constexpr double kMost = 1e10;
    const double size = std::abs(amount);
    if (!(size < kMost)) // not a number, too
        return false;

    const double hundredths = size * 100;
    auto value = static_cast<std::uint64_t>(hundredths);
    const double rest = hundredths - static_cast<double>(value);
    if (std::abs(rest - 0.5) < kNear)
        return false;

    value += rest > 0.5 ? 1 : 0;
    PutPair(value % 100);
    Put('.');
    PutDigits(value / 100);
    if (amount < 0 && value > 0)
        Put('-');
    return true;
}

// In front of what is there already, as the next two are.
void NumberText::PutDigits(std::uint64_t value)
{
    for (; value >= 100; value /= 100)
        PutPair(value % 100);
    if (value >= 10)
        PutPair(value);
    else
        Put(static_cast<char>('0' + value));
}

// Two digits at a time: half the divisions.
void NumberText::PutPair(std::uint64_t value)
{
    static constexpr auto kPairs = [] {
        std::array<std::array<char16_t, 2>, 100> pairs{};
        for (std::size_t i = 0; i < pairs.size(); ++i)
            pairs[i] = {static_cast<char16_t>(u'0' + i / 10), static_cast<char16_t>(u'0' + i % 10)};
        return pairs;
    }();
    start -= 2;
    std::ranges::copy(kPairs[static_cast<std::size_t>(value)], room.begin() + static_cast<std::ptrdiff_t>(start));
}

Text FormatAmount(double amount)
{
    if (NumberText text; text.PutAmount(amount))
        return Text(text.View());
    if (!std::isfinite(amount))
        throw Error(ErrorNumber::Overflow, {}, u"an amount that is not a finite number");

    // The shortest digits and their exponent: d.ddde+xx.
    std::array<char, 32> shortest{};
    const auto end = std::to_chars(shortest.data(), shortest.data() + shortest.size(), std::abs(amount),
                                   std::chars_format::scientific)
                         .ptr;
    const std::string_view scientific(shortest.data(), static_cast<std::size_t>(end - shortest.data()));
    const std::size_t e = scientific.find('e');
    const int exponent = std::stoi(std::string(scientific.substr(e + 1)));
    std::string digits(1, scientific[0]);
    if (e > 2)
        digits += scientific.substr(2, e - 2);

    // The digits up to the hundredths; the first one dropped decides.
    const int kept = exponent + 3;
    const bool roundsUp =
        kept >= 0 && static_cast<std::size_t>(kept) < digits.size() && digits[static_cast<std::size_t>(kept)] >= '5';
    digits.resize(static_cast<std::size_t>(std::max(kept, 0)), '0');
    digits.insert(0, static_cast<std::size_t>(std::max(4 - std::max(kept, 0), 1)), '0'); // room for the carry
    if (roundsUp) {
        std::size_t i = digits.size() - 1;
        for (; digits[i] == '9'; --i)
            digits[i] = '0';
        ++digits[i];
    }
    const bool isZero = digits.find_first_not_of('0') == std::string::npos;
    const std::size_t leading = std::min(digits.find_first_not_of('0'), digits.size() - 3);
    Text text = amount < 0 && !isZero ? u"-" : u"";
    text.append(digits.begin() + static_cast<std::ptrdiff_t>(leading), digits.end() - 2);
    return text.append(1, u'.').append(digits.end() - 2, digits.end());
}

} // namespace varnex3
