// Conversions between UTF-8 and UTF-16, sixteen ASCII characters at a time where the processor can.
#include "varnex3/xml/Unicode.h"

#include <algorithm>
#include <array>

#include "varnex3/xml/Characters.h"
#include "varnex3/xml/Scan.h"

namespace varnex3::xml {
namespace {

constexpr char32_t replacement = 0xFFFD;

// Copies ASCII characters to wider or narrower ones as far as they go.
template <class From, class To>
const From* CopyAscii(const From* from, const From* end, To*& to)
{
#ifdef VARNEX3_XML_SSE2
    for (; end - from >= detail::blockSize; from += detail::blockSize, to += detail::blockSize)
        if (!detail::CopyAsciiBlock(from, to))
            break;
#endif
    while (from < end && Unit(*from) < 0x80)
        *to++ = static_cast<To>(*from++);
    return from;
}

// The bytes of a malformed sequence that one replacement stands for: the start of a sequence as far as it is one.
std::size_t MalformedLength(const char* p, const char* end)
{
    const std::uint32_t wanted = detail::LeadOf(Unit(*p)).length;
    const char* next = p + 1;
    while (next < end && static_cast<std::uint32_t>(next - p) < wanted && (Unit(*next) & 0xC0) == 0x80)
        ++next;
    return static_cast<std::size_t>(next - p);
}

} // namespace

std::u16string ToUtf16(std::string_view utf8)
{
    std::u16string text;
    AppendUtf16(text, utf8);
    return text;
}

void AppendUtf16(std::u16string& to, std::string_view utf8)
{
    const std::size_t before = to.size();
    to.resize(before + utf8.size()); // no sequence has more units than bytes
    char16_t* out = to.data() + before;
    const char* end = utf8.data() + utf8.size();
    for (const char* p = utf8.data();;) {
        p = CopyAscii(p, end, out);
        if (p == end)
            break;
        const CodePoint point = DecodePoint(p, end, true);
        out = PutPoint(out, point.length != 0 ? point.value : replacement);
        p += point.length != 0 ? point.length : MalformedLength(p, end);
    }
    to.resize(static_cast<std::size_t>(out - to.data()));
}

std::string ToUtf8(std::u16string_view text)
{
    std::string utf8;
    utf8.reserve(text.size());
    std::array<char, 256> block; // what is ASCII, in between
    const char16_t* end = text.data() + text.size();
    for (const char16_t* p = text.data(); p < end;) {
        char* out = block.data();
        p = CopyAscii(p, p + std::min<std::ptrdiff_t>(end - p, block.size()), out);
        utf8.append(block.data(), out);
        for (; p < end && *p >= 0x80; ++p) {
            const CodePoint point = DecodePoint(p, end);
            AppendPoint(utf8, point.length != 0 ? point.value : *p);
            p += point.length == 2 ? 1 : 0;
        }
    }
    return utf8;
}

} // namespace varnex3::xml
