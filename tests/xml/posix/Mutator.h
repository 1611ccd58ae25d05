// Damages documents, the same way on every machine: the generator's numbers are fixed by the language, and no
// library's distribution is used.
#pragma once

#include <array>
#include <random>
#include <string>
#include <string_view>

namespace varnex3::xml::referees {

inline constexpr std::array<std::string_view, 46> kTokens = {"<",
                                                             ">",
                                                             "&",
                                                             "\"",
                                                             "'",
                                                             "=",
                                                             "/",
                                                             "/>",
                                                             "</",
                                                             "<a>",
                                                             "</a>",
                                                             "<a/>",
                                                             "<!--",
                                                             "-->",
                                                             "--",
                                                             "<![CDATA[",
                                                             "]]>",
                                                             "]",
                                                             "<?",
                                                             "?>",
                                                             "<?xml ?>",
                                                             "<?a b?>",
                                                             "&amp;",
                                                             "&lt;",
                                                             "&#65;",
                                                             "&#x41;",
                                                             "&#0;",
                                                             "&#xD800;",
                                                             "&#x110000;",
                                                             "&none;",
                                                             "&#",
                                                             ";",
                                                             ":",
                                                             " x:y='1'",
                                                             " xmlns:x='urn:x'",
                                                             " xmlns=''",
                                                             " xml:space='preserve'",
                                                             " xmlns:xml='urn:x'",
                                                             "\t",
                                                             "\r",
                                                             "\n",
                                                             " ",
                                                             "\xC3\xA9",
                                                             "\xEF\xBF\xBE",
                                                             "\xED\xA0\x80",
                                                             "<!DOCTYPE a>"};

class Mutator
{
public:
    // One mutation, sometimes more.
    std::string Mutate(std::string bytes)
    {
        do
            MutateOnce(bytes);
        while (Below(3) == 0);
        return bytes;
    }

    // A number from 0 to below the limit.
    std::size_t Below(std::size_t limit) { return limit == 0 ? 0 : numbers() % limit; }

private:
    void MutateOnce(std::string& bytes)
    {
        const std::size_t at = Below(bytes.size());
        switch (Below(bytes.empty() ? 1 : 8)) {
        case 0: // behind a tag, where much is allowed
            bytes.insert(bytes.find('>', at) + 1, kTokens[Below(kTokens.size())]);
            break;
        case 1:
            bytes.insert(at, kTokens[Below(kTokens.size())]);
            break;
        case 2:
            bytes[at] = static_cast<char>(bytes[at] ^ (1 << Below(8)));
            break;
        case 3:
            bytes[at] = static_cast<char>(Below(256));
            break;
        case 4:
            bytes.erase(at, 1 + Below(12));
            break;
        case 5:
            std::swap(bytes[at], bytes[Below(bytes.size())]);
            break;
        case 6:
            bytes.insert(Below(bytes.size()), bytes.substr(at, Below(60)));
            break;
        default:
            if (Below(4) == 0)
                bytes.resize(at);
        }
    }

    std::mt19937 numbers{20260101};
};

} // namespace varnex3::xml::referees
