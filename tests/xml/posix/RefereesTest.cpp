// Mutated messages, judged by the engine and by two established parsers, expat and libxml2. All three must agree on
// what is well-formed, but for the differences named here; where they agree, the engine's tree must be libxml2's.
#include <doctest/doctest.h>

#include <algorithm>
#include <array>
#include <filesystem>

#include <expat.h>
#include <libxml/xmlerror.h>

#include "Mutator.h"
#include "Referees.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/Unicode.h"

using namespace varnex3::xml;
using namespace varnex3::xml::referees;

namespace {

// ---------------------------------------------------------------- the differences that are known

struct Opinions
{
    std::string_view bytes;
    ErrorCode ours;
    const Opinion& expat;
    const Opinion& libxml;
};

// UTF-16 is searched without its zero bytes.
bool Holds(std::string_view bytes, std::string_view part)
{
    std::string narrow(bytes);
    std::erase(narrow, '\0');
    return narrow.find(part) != narrow.npos;
}

bool IsAscii(std::string_view bytes)
{
    return std::ranges::none_of(bytes, [](char c) { return (c & 0x80) != 0; });
}

bool IsUtf16(std::string_view bytes) { return bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF"); }

bool HasByteOrderMark(std::string_view bytes) { return IsUtf16(bytes) || bytes.starts_with("\xEF\xBB\xBF"); }

bool HasExternalSubset(std::string_view bytes)
{
    return Holds(bytes, "<!DOCTYPE") && (Holds(bytes, "SYSTEM") || Holds(bytes, "PUBLIC"));
}

struct Difference
{
    const char* name;
    bool (*applies)(const Opinions&);
};

// Each names who stands alone, and in what.
constexpr std::array kDifferences = {
    Difference{"we refuse an internal subset",
               [](const Opinions& o) { return o.ours == ErrorCode::InternalSubset && o.expat.isAccepted; }},
    Difference{"we refuse entities that only an external subset may declare",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::UndefinedEntity && o.expat.isAccepted && o.libxml.isAccepted
                          && HasExternalSubset(o.bytes);
               }},
    Difference{"we let a byte order mark outrank the declared encoding",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::None && o.expat.error == XML_ERROR_UNKNOWN_ENCODING
                          && HasByteOrderMark(o.bytes);
               }},
    Difference{"expat takes any version number, libxml2 one that ends in a point",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidDeclaration && o.expat.isAccepted
                          && (!o.libxml.isAccepted || Holds(o.bytes, "1.\"") || Holds(o.bytes, "1.'"));
               }},
    Difference{"expat has the names of the fourth edition",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::None && o.expat.error == XML_ERROR_INVALID_TOKEN
                          && (o.libxml.isAccepted || o.libxml.error == XML_WAR_NS_URI) && !IsAscii(o.bytes);
               }},
    Difference{"expat lets three signs of Latin-1 be letters",
               [](const Opinions& o) {
                   return o.ours != ErrorCode::None && o.expat.isAccepted && !o.libxml.isAccepted
                          && o.bytes.find_first_of("\xAA\xB5\xBA") != o.bytes.npos
                          && (IsUtf16(o.bytes) || Holds(o.bytes, "ISO-8859-1"));
               }},
    Difference{"expat does not look for the second half of a surrogate pair",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidSequence && o.expat.isAccepted && !o.libxml.isAccepted
                          && IsUtf16(o.bytes);
               }},
    Difference{"expat knows fewer names of encodings",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::None && o.expat.error == XML_ERROR_UNKNOWN_ENCODING
                          && o.libxml.isAccepted;
               }},
    Difference{"libxml2 knows more encodings",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::UnknownEncoding && o.expat.error == XML_ERROR_UNKNOWN_ENCODING
                          && o.libxml.isAccepted;
               }},
    Difference{"libxml2 refuses the unassigned bytes of windows-1252",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::None && o.expat.isAccepted
                          && o.bytes.find_first_of("\x81\x8D\x8F\x90\x9D") != o.bytes.npos
                          && Holds(o.bytes, "windows-1252");
               }},
    Difference{"libxml2 wants the name of a namespace to be a URI",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::None && o.expat.isAccepted && o.libxml.error == XML_WAR_NS_URI;
               }},
    Difference{"libxml2 needs no blank after <!DOCTYPE",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidDoctype && !o.expat.isAccepted && o.libxml.isAccepted;
               }},
    Difference{"libxml2 takes an internal subset behind the DOCTYPE, too",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::TextOutsideRoot && o.expat.error == XML_ERROR_SYNTAX
                          && o.libxml.isAccepted && Holds(o.bytes, "<!DOCTYPE") && Holds(o.bytes, ">[");
               }},
    Difference{"libxml2 lets the name in a DOCTYPE have a stray colon",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidName && o.expat.error == XML_ERROR_SYNTAX && o.libxml.isAccepted
                          && Holds(o.bytes, "<!DOCTYPE");
               }},
    Difference{"libxml2 stops behind the root element at a zero byte",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidCharacter && o.expat.error == XML_ERROR_INVALID_TOKEN
                          && o.libxml.isAccepted && o.bytes.find('\0') != o.bytes.npos;
               }},
    Difference{"libxml2 stops behind the root element at bytes that US-ASCII does not have",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidSequence && o.expat.error == XML_ERROR_INVALID_TOKEN
                          && o.libxml.isAccepted && !IsAscii(o.bytes) && Holds(o.bytes, "US-ASCII");
               }},
    Difference{"libxml2 overlooks half a UTF-16 unit at the end",
               [](const Opinions& o) {
                   return o.ours == ErrorCode::InvalidSequence && !o.expat.isAccepted && o.libxml.isAccepted
                          && IsUtf16(o.bytes) && o.bytes.size() % 2 == 1;
               }},
};

// "" when the difference is none of these, which is a fault.
std::string NameOfDifference(const Opinions& opinions)
{
    const auto found =
        std::ranges::find_if(kDifferences, [&](const Difference& known) { return known.applies(opinions); });
    return found == kDifferences.end() ? "" : found->name;
}

// ---------------------------------------------------------------- the trees, a line an element

void List(Node node, std::string& to)
{
    for (; node; node = node.NextSibling()) {
        if (node.Type() != NodeType::Element)
            continue;
        to += ToUtf8(node.Name());
        for (std::size_t i = 0; i < node.AttributeCount(); ++i)
            to += " @" + ToUtf8(node.AttributeAt(i).name) + "=" + ToUtf8(node.AttributeAt(i).value);
        to += " = " + ToUtf8(node.Text()) + "\n";
        List(node.FirstChild(), to);
    }
}

std::string WithoutWhite(std::string text)
{
    std::erase_if(text, [](char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n'; });
    return text;
}

// libxml2's tree does not tell white space that a reference stands for, which is kept, from white space as such.
bool TreesAgree(std::string_view bytes, const std::string& ours, const std::string& theirs)
{
    return ours == theirs || (Holds(bytes, "&#") && WithoutWhite(ours) == WithoutWhite(theirs));
}

std::string Printable(std::string_view bytes)
{
    std::string text;
    for (const char c : bytes) {
        constexpr std::string_view digits = "0123456789ABCDEF";
        const auto byte = static_cast<unsigned char>(c);
        if (byte >= 0x20 && byte < 0x7F)
            text += c;
        else
            text.append("\\x").append({digits[byte >> 4], digits[byte & 15]});
    }
    return text;
}

std::string FirstDifference(const std::string& ours, const std::string& theirs)
{
    const auto [a, b] = std::ranges::mismatch(ours, theirs);
    const std::size_t at = static_cast<std::size_t>(a - ours.begin());
    const std::size_t from = at - std::min<std::size_t>(at, 40);
    return Printable(ours.substr(from, 80)) + " instead of " + Printable(theirs.substr(from, 80));
}

// ---------------------------------------------------------------- the seeds

constexpr std::array<std::string_view, 3> kInlineSeeds = {
    "<?xml version=\"1.0\" standalone='yes'?>\r\n<!-- head --><?go now?>\n<p:a xmlns:p=\"urn:p\" xmlns='urn:d' p:x='1' "
    "x=\"&lt;2&#x20;\t3\n\">\n\t<b xml:space=\"preserve\"> <c/> </b>text &amp; \xC3\xA9<![CDATA[ <&]]]]> "
    "]]&gt;<d:e xmlns:d='urn:p' xmlns:q='urn:q' q:x='' d:x=''/><!-- - --><?p q?><f>&#65;&#x1F600;</f> \xE2\x82\xAC "
    "</p:a>\n<!-- tail -->",
    "<!DOCTYPE Version SYSTEM \"Version.dtd\"><Version><XaloVersion>1.6</XaloVersion><Empty></Empty> <None/></Version>",
    "<?xml version='1.0' encoding='US-ASCII'?><a b='c' d='e'><f>g</f>\r<h\n i = 'j'\t>k</h\n></a>",
};

std::vector<std::string> Seeds()
{
    std::vector<std::string> seeds(kInlineSeeds.begin(), kInlineSeeds.end());
    const auto samples = std::filesystem::path(VARNEX3_SOURCE_DIR) / "samples" / "inbox";
    std::vector<std::filesystem::path> paths;
    for (const auto& entry : std::filesystem::directory_iterator(samples))
        if (entry.is_regular_file())
            paths.push_back(entry.path());
    std::ranges::sort(paths); // the folder's order differs between machines
    for (const auto& path : paths)
        seeds.push_back(ReadFile(FromNativePath(path.native())));
    return seeds;
}

// ---------------------------------------------------------------- the hearing

class Panel
{
public:
    void Hear(const std::string& bytes)
    {
        ++heard;
        Document document;
        document.LoadBytes(bytes);
        const Opinion expat = AskExpat(bytes);
        const Opinion libxml = AskLibxml(bytes);
        const bool isAccepted = !document.Error();
        if (isAccepted != expat.isAccepted || isAccepted != libxml.isAccepted)
            HearDifference({bytes, document.Error().code, expat, libxml});
        else if (isAccepted)
            CompareTrees(bytes, document, libxml.tree);
    }

    int heard = 0;
    int accepted = 0; // by all three
    int different = 0;

private:
    void HearDifference(const Opinions& opinions)
    {
        ++different;
        INFO(Printable(opinions.bytes));
        CHECK_MESSAGE(NameOfDifference(opinions) != "", "mutant ", heard, ": ours ", static_cast<int>(opinions.ours),
                      ", expat ", opinions.expat.error, ", libxml2 ",
                      opinions.libxml.isAccepted ? 0 : opinions.libxml.error);
    }

    void CompareTrees(std::string_view bytes, const Document& document, const std::string& theirs)
    {
        ++accepted;
        std::string ours;
        List(document.Root().FirstChild(), ours);
        INFO(Printable(bytes));
        CHECK_MESSAGE(TreesAgree(bytes, ours, theirs), "mutant ", heard, ": ", FirstDifference(ours, theirs));
    }
};

} // namespace

TEST_CASE("mutated messages: the engine, expat and libxml2 agree on what is well-formed, and on the tree")
{
    constexpr int kMutants = 20'000;
    const std::vector<std::string> seeds = Seeds();
    REQUIRE(seeds.size() > kInlineSeeds.size());

    Panel panel;
    for (const std::string& seed : seeds)
        panel.Hear(seed);
    Mutator mutator;
    for (int i = 0; i < kMutants; ++i)
        panel.Hear(mutator.Mutate(seeds[mutator.Below(seeds.size())]));

    MESSAGE(panel.heard, " documents: ", panel.accepted, " accepted by all three, ", panel.different,
            " with a known difference");
    CHECK(panel.accepted > kMutants / 10); // else the trees were hardly compared
}
