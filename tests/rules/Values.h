// What a rule's runner compares: values, texts and interfaces, as JSON and words.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <string_view>

#include "varnex3/core/Interface.h"
#include "varnex3/core/modFunctions.h"

namespace varnex3::tests {

using Json = nlohmann::ordered_json;
namespace fs = std::filesystem;

struct Failure : std::runtime_error
{
    using std::runtime_error::runtime_error;
};

inline std::string Shown(const Json& value) { return value.dump(-1, ' ', false, Json::error_handler_t::replace); }

[[noreturn]] inline void Differ(const Json& expected, const Json& got)
{
    throw Failure("expected " + Shown(expected) + ", got " + Shown(got));
}

inline std::string BytesOf(const fs::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    if (!stream)
        throw Failure("no file " + file.string());
    return {std::istreambuf_iterator<char>(stream), {}};
}

inline std::string FromBase64(const std::string& text)
{
    static const std::string digits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string bytes;
    unsigned bits = 0;
    int held = 0;
    for (const char c : text.substr(0, text.find('='))) {
        bits = bits << 6 | static_cast<unsigned>(digits.find(c));
        held += 6;
        if (held >= 8)
            bytes += static_cast<char>(bits >> (held -= 8) & 0xFF);
    }
    return bytes;
}

// Whether a text fits a pattern in which * stands for any characters, also none.
inline bool IsLike(std::string_view text, std::string_view pattern)
{
    if (pattern.empty())
        return text.empty();
    if (pattern[0] != '*')
        return !text.empty() && text[0] == pattern[0] && IsLike(text.substr(1), pattern.substr(1));
    for (std::size_t i = 0; i <= text.size(); ++i)
        if (IsLike(text.substr(i), pattern.substr(1)))
            return true;
    return false;
}

// ---------------------------------------------------------------- a value as JSON

struct AsJson
{
    Json operator()(EmptyValue) const { return nullptr; }
    Json operator()(const Text& text) const { return ToUtf8(text); }
    Json operator()(Date date) const { return {{"date", ToUtf8(FormatDate(date, 1))}}; }
    Json operator()(const Ref<Record>& record) const
    {
        return record ? Json{{"object", std::string(record->Class().name)}} : Json{{"nothing", true}};
    }
    Json operator()(auto number) const { return number; }
};

inline Json ToJson(const Variant& value) { return std::visit(AsJson(), value); }

// ---------------------------------------------------------------- an interface in words

inline std::string Words(const Type& type) { return std::string(type.name.empty() ? NameOf(type.kind) : type.name); }

inline std::string Words(const Parameter& parameter)
{
    const std::string words =
        (parameter.isOutput ? "out " : "") + std::string(parameter.name) + ": " + Words(parameter.type);
    return parameter.isOptional ? "[" + words + "]" : words;
}

inline std::string Words(const Member& member)
{
    std::string words(member.name);
    if (!member.IsProperty() || member.IsIndexed()) {
        words += "(";
        for (const Parameter& parameter : member.Parameters())
            words += (words.back() == '(' ? "" : ", ") + Words(parameter);
        words += ")";
    }
    if (member.type.kind != Kind::None)
        words += ": " + Words(member.type);
    return member.IsProperty() && !member.IsWritable() ? words + " (read-only)" : words;
}

} // namespace varnex3::tests
