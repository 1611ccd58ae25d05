#include "RootTag.h"

#include <algorithm>
#include <optional>
#include <string>

#include "FileText.h"
#include "varnex3/xml/Characters.h"
#include "varnex3/xml/Encoding.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tool {

namespace {

constexpr TextView kBlanks = u" \t\r\n";
constexpr Name kNoRoot = "There is no root element";

RootTag Nothing(Name reason) { return {{}, ToText(reason)}; }

bool IsName(TextView text)
{
    const char16_t* const end = text.data() + text.size();
    for (const char16_t* p = text.data(); p < end;) {
        const xml::CodePoint point = xml::DecodePoint(p, end);
        const bool isFirst = p == text.data();
        if (point.length == 0 || !(isFirst ? xml::IsNameStart(point.value) : xml::IsNameCharacter(point.value)))
            return false;
        p += point.length;
    }
    return !text.empty();
}

// Walks over what may stand before the root element. Each step says nothing while the answer lies further on in the
// file than the text goes.
class Prolog
{
public:
    explicit Prolog(TextView text) : rest(text) {}

    std::optional<RootTag> Find()
    {
        while (true) {
            rest.remove_prefix(std::min(rest.find_first_not_of(kBlanks), rest.size()));
            if (rest.empty() || IsCutOff(u"<!--") || IsCutOff(u"<!DOCTYPE"))
                return {};
            if (rest.starts_with(u"<!DOCTYPE")) {
                if (std::optional<RootTag> answer = PassDoctype())
                    return answer;
            } else if (rest.starts_with(u"<!--")) {
                PassBehind(u"-->", 4);
            } else if (rest.starts_with(u"<?")) {
                PassBehind(u"?>", 2);
            } else {
                return AtTag();
            }
        }
    }

private:
    bool IsCutOff(TextView opening) const { return rest.size() < opening.size() && opening.starts_with(rest); }

    void PassBehind(TextView closing, std::size_t from)
    {
        const std::size_t found = rest.find(closing, from);
        rest.remove_prefix(found == TextView::npos ? rest.size() : found + closing.size());
    }

    std::optional<RootTag> PassDoctype()
    {
        char16_t quote = 0;
        for (std::size_t i = 0; i < rest.size(); ++i) {
            const char16_t c = rest[i];
            if (quote != 0)
                quote = c == quote ? u'\0' : quote;
            else if (c == u'"' || c == u'\'')
                quote = c;
            else if (c == u'[')
                return Nothing("The DOCTYPE has declarations of its own, which are refused");
            else if (c == u'>') {
                rest.remove_prefix(i + 1);
                return {};
            }
        }
        rest = {};
        return {};
    }

    std::optional<RootTag> AtTag() const
    {
        if (rest.front() != u'<')
            return Nothing("There is text where the root element should start");
        const std::size_t end = rest.find_first_of(u" \t\r\n/>", 1);
        if (end == TextView::npos)
            return {};
        const TextView name = rest.substr(1, end - 1);
        return IsName(name) ? RootTag{Text(name), {}} : Nothing("The root tag has no proper name");
    }

    TextView rest;
};

// The answer from the first bytes of a file; nothing when it takes more of them.
std::optional<RootTag> RootTagIn(std::string_view bytes)
{
    const xml::EncodingFacts facts = xml::DetectEncoding(bytes);
    if (facts.encoding == xml::Encoding::Unknown)
        return RootTag{{}, u"The encoding '" + ToUtf16(facts.name) + u"' is not known"};
    return Prolog(DecodeFileText(bytes)).Find();
}

} // namespace

RootTag ReadRootTag(TextView path)
{
    xml::InputFile file(path);
    std::string bytes;
    for (std::size_t step = 4096;; step = bytes.size()) { // doubled, so that a long comment takes linear time
        const std::size_t before = bytes.size();
        bytes.resize(before + step);
        bytes.resize(before + file.Read(bytes.data() + before, step));
        if (std::optional<RootTag> answer = RootTagIn(bytes))
            return *answer;
        if (bytes.size() < before + step)
            return Nothing(kNoRoot);
    }
}

} // namespace varnex3::tool
