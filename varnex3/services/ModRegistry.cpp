#include "varnex3/services/ModRegistry.h"

#include <array>
#include <charconv>
#include <cmath>
#include <limits>
#include <optional>
#include <system_error>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"

namespace varnex3 {

namespace {

constexpr std::size_t kBufferSize = 1024;
using Buffer = std::array<char, kBufferSize>;

// Data without the zero byte that ends a text.
std::string_view WithoutTerminator(std::string_view data)
{
    if (!data.empty() && data.back() == '\0')
        data.remove_suffix(1);
    return data;
}

// The hexadecimal digits of the bytes, last byte first, read as one number. Each byte stands without leading zeros.
Text NumberText(std::string_view bytes)
{
    std::string digits;
    for (std::size_t i = bytes.size(); i-- > 0;) {
        std::array<char, 2> byteDigits{};
        const auto end = std::to_chars(byteDigits.begin(), byteDigits.end(), static_cast<unsigned char>(bytes[i]), 16);
        digits.append(byteDigits.begin(), end.ptr);
    }
    std::uint64_t number = 0;
    const auto [end, fault] = std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
    return fault == std::errc() ? ToUtf16(std::to_string(number)) : Text();
}

Text ValueText(RegistryType type, std::string_view data)
{
    switch (type) {
    case RegistryType::Text:
        return FromCodePage(data);
    case RegistryType::Number32:
        return NumberText(data);
    default:
        return {};
    }
}

std::size_t CountDigits(TextView text, std::size_t start)
{
    std::size_t count = 0;
    while (start + count < text.size() && text[start + count] >= u'0' && text[start + count] <= u'9')
        ++count;
    return count;
}

bool IsSign(TextView text, std::size_t i) { return i < text.size() && (text[i] == u'+' || text[i] == u'-'); }

// As much of the beginning as is a number; nothing when none of it is.
TextView NumericPart(TextView text)
{
    text = Trimmed(text);
    std::size_t end = IsSign(text, 0) ? 1 : 0;
    std::size_t count = CountDigits(text, end);
    end += count;
    if (end < text.size() && text[end] == u'.') {
        const std::size_t decimals = CountDigits(text, end + 1);
        count += decimals;
        end += 1 + decimals;
    }
    if (count == 0)
        return {};
    if (end < text.size() && ToLower(text[end]) == u'e') {
        const std::size_t exponent = end + (IsSign(text, end + 1) ? 2 : 1);
        const std::size_t digits = CountDigits(text, exponent);
        end = digits > 0 ? exponent + digits : end; // "2 each", "2e": no exponent
    }
    return text.substr(0, end);
}

// The number a text begins with, rounded; 0 when it begins with none. Nothing for a number that no double holds.
std::optional<double> WholeNumber(TextView text)
{
    const TextView numericPart = NumericPart(text);
    if (numericPart.empty())
        return 0.0;
    try {
        return std::nearbyint(NumberFrom(numericPart)); // halves to even: the default rounding mode
    } catch (const Error&) {
        return std::nullopt;
    }
}

// Four times the remainder of 256, lowest byte first. -1 is FF 00 00 00, as truncating division has it.
std::string NumberBytes(double number)
{
    std::string bytes;
    while (bytes.size() < 4) {
        bytes += static_cast<char>(static_cast<int>(std::fmod(number, 256)));
        number = std::trunc(number / 256);
    }
    return bytes;
}

// What is to be written over a value of a type whose bytes were read into the buffer.
std::optional<std::string> DataFor(RegistryType type, TextView sValue, const Buffer& buffer)
{
    if (type == RegistryType::Text)
        return ToCodePage(sValue);
    if (type != RegistryType::Number32)
        return std::string(buffer.begin(), buffer.end()); // all of it, however short the value was
    const std::optional<double> number = WholeNumber(sValue);
    return number ? std::optional(NumberBytes(*number)) : std::nullopt;
}

// The data of a text of any length; nothing when there is no such text.
std::optional<std::string> QueryText(RegistryKey key, const std::string& name, Registry& registry)
{
    std::string data(kBufferSize, '\0');
    QueriedValue value = registry.Query(key, name, data);
    while (value.status == RegistryStatus::MoreData && value.length > data.size()) {
        data.resize(value.length);
        value = registry.Query(key, name, data);
    }
    if (value.status != RegistryStatus::Done || value.type != RegistryType::Text)
        return std::nullopt;
    data.resize(value.length);
    return data;
}

// The user's own setting. One that is there but empty is a setting.
Text PerUserSetting(TextView sApp, TextView sSection, TextView sKey, const Text& sDefault, Registry& registry)
{
    RegistryKey key{};
    if (registry.Open(RegistryRoot::CurrentUser, ToCodePage(PerUserKey(sApp, sSection)), key) != RegistryStatus::Done)
        return sDefault;
    const std::optional<std::string> data = QueryText(key, ToCodePage(sKey), registry);
    registry.Close(key);
    return data ? FromCodePage(WithoutTerminator(*data)) : sDefault;
}

// Copies a setting to the machine-wide place. The key that is deleted is not the one the user's settings are read
// from, so the user's value stays where it is.
void Migrate(const Text& path, TextView sKey, const Text& value, Registry& registry)
{
    if (!SetRegValue(RegistryRoot::LocalMachine, path, sKey, value, registry)) {
        CreateRegKey(RegistryRoot::LocalMachine, path, registry);
        SetRegValue(RegistryRoot::LocalMachine, path, sKey, value, registry);
    }
    DeleteRegKey(RegistryRoot::CurrentUser, path + u"\\" + Text(sKey) + u"\\", registry);
}

} // namespace

Text GetAppSetting(TextView sApp, TextView sSection, TextView sKey, const Text& sDefault, const bool& bNoMigrate,
                   Registry& registry)
{
    const Text path = u"SOFTWARE\\" + Text(sApp) + u"\\" + Text(sSection);
    Text result = QueryRegValue(RegistryRoot::LocalMachine, path, sKey, registry);
    if (!result.empty())
        return result;
    result = PerUserSetting(sApp, sSection, sKey, sDefault, registry);
    if (!result.empty() && !bNoMigrate)
        Migrate(path, sKey, result, registry); // the default too
    return result;
}

Text PerUserKey(TextView sApp, TextView sSection)
{
    return u"Software\\VB and VBA Program Settings\\" + Text(sApp) + u"\\" + Text(sSection);
}

Text QueryRegValue(RegistryRoot hRoot, TextView sKeyPath, TextView sValueName, Registry& registry)
{
    RegistryKey key{};
    if (registry.Open(hRoot, ToCodePage(sKeyPath), key) != RegistryStatus::Done)
        return {};
    Buffer buffer{};
    const QueriedValue value = registry.Query(key, ToCodePage(sValueName), buffer);
    if (value.status != RegistryStatus::Done) {
        registry.Close(key);
        return {};
    }
    if (value.length == 0)
        return {}; // and the key stays open
    Text text = ValueText(value.type, WithoutTerminator({buffer.data(), value.length}));
    registry.Close(key);
    return text;
}

bool SetRegValue(RegistryRoot hRoot, TextView sKeyPath, TextView sValueName, TextView sValue, Registry& registry)
{
    RegistryKey key{};
    if (registry.Open(hRoot, ToCodePage(sKeyPath), key) != RegistryStatus::Done) {
        registry.Close(key); // not a handle: nothing comes of it
        return false;
    }
    const std::string name = ToCodePage(sValueName);
    Buffer buffer{};
    const QueriedValue old = registry.Query(key, name, buffer);
    const bool isNew = old.status == RegistryStatus::NotFound;
    if (!isNew && old.status != RegistryStatus::Done) {
        registry.Close(key);
        return false;
    }
    const RegistryType type = isNew ? RegistryType::Text : old.type;
    const std::optional<std::string> data = DataFor(type, sValue, buffer);
    const bool isWritten = data && registry.Set(key, name, type, *data) == RegistryStatus::Done;
    registry.Close(key);
    return isWritten;
}

void CreateRegKey(RegistryRoot hRoot, TextView sKeyPath, Registry& registry)
{
    RegistryKey key{};
    registry.Create(hRoot, ToCodePage(sKeyPath), key);
    registry.Close(key);
}

void DeleteRegKey(RegistryRoot hRoot, TextView sKeyPath, Registry& registry)
{
    registry.Delete(hRoot, ToCodePage(sKeyPath));
}

} // namespace varnex3
