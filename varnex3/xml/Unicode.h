// Text between UTF-8, which files and foreign callers speak, and the 16-bit Unicode used everywhere inside.
#pragma once

#include <string>
#include <string_view>

namespace varnex3::xml {

// UTF-16 from UTF-8. A malformed sequence becomes U+FFFD; the three-byte form of a lone surrogate, which ToUtf8
// writes, comes back as that surrogate. ToUtf16("caf\xC3\xA9") is u"café".
std::u16string ToUtf16(std::string_view utf8);

// Appends to what is there already.
void AppendUtf16(std::u16string& to, std::string_view utf8);

// UTF-8 from UTF-16. A lone surrogate, which a 16-bit text may hold, is written in its three-byte form, so that
// ToUtf16(ToUtf8(text)) == text for every text.
std::string ToUtf8(std::u16string_view text);

} // namespace varnex3::xml
