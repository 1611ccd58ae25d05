// The document: one face for trees over UTF-8 and over UTF-16.
#include "varnex3/xml/Document.h"

#include <algorithm>
#include <cassert>
#include <limits>
#include <variant>

#include "varnex3/xml/Encoding.h"
#include "varnex3/xml/Fault.h"
#include "varnex3/xml/Files.h"
#include "varnex3/xml/MarkupWriter.h"
#include "varnex3/xml/Parser.h"
#include "varnex3/xml/Query.h"
#include "varnex3/xml/Tree.h"

namespace varnex3::xml {
namespace {

constexpr std::size_t usualCount = 16; // of the elements that a path leads to
constexpr std::uint64_t longestText = std::numeric_limits<std::uint32_t>::max();

ParseError TooLarge() { return {ErrorCode::TooLarge, 1, 1, u"The text is longer than 4,294,967,295 characters"}; }

const ParseError& ErrorOfNothing()
{
    static const ParseError error{ErrorCode::NoRootElement, 1, 1, u"There is no root element"};
    return error;
}

// How much of a text decides whether it is well-formed. One that starts with neither markup nor white space fails
// there: the rest of it need not be copied.
template <class Char>
std::size_t DecisiveLength(std::basic_string_view<Char> text)
{
    constexpr std::size_t longestCharacter = 4;
    const bool mayBeWellFormed = text.empty() || text[0] == '<' || IsBlank(text[0]);
    return mayBeWellFormed ? text.size() : std::min(text.size(), longestCharacter);
}

// The attribute of an element at a position, namespace declarations not counted. Precondition: there is one.
template <class Char>
const TreeAttribute& NamedAttribute(const Tree<Char>& tree, NodeIndex element, std::size_t position)
{
    const TreeAttribute* at = tree.FirstAttribute(element);
    for (;; at = tree.NextAttribute(at))
        if (!IsNamespaceDeclaration(tree.AttributeName(*at)) && position-- == 0)
            return *at;
}

// A whole file, read into the buffer it is parsed in. One that grows meanwhile is followed to its end.
TextBuffer<char> ReadAll(InputFile& file)
{
    TextBuffer<char> bytes(file.Room());
    std::size_t length = 0;
    for (;;) {
        length += file.Read(bytes.Data() + length, bytes.Size() - length);
        if (length < bytes.Size())
            break;
        TextBuffer<char> larger(bytes.Size() * 2);
        std::copy_n(bytes.Data(), length, larger.Data());
        bytes = std::move(larger);
    }
    bytes.Shorten(length);
    return bytes;
}

} // namespace

struct Document::Content
{
    std::variant<Tree<char>, Tree<char16_t>> tree;
    ParseError error;

    // Replaces a document's content by what the action loads; by nothing, when it throws.
    template <class Action>
    static bool Replace(std::unique_ptr<Content>& content, Action load)
    {
        content.reset();
        auto loaded = std::make_unique<Content>();
        load(*loaded);
        content = std::move(loaded);
        return !content->error;
    }

    template <class Char>
    void Load(TextBuffer<Char> text, std::size_t offset)
    {
        Tree<Char> parsed;
        error = Parse(std::move(text), offset, parsed);
        if (!error)
            tree = std::move(parsed);
    }

    // Bytes in any encoding. The action gives the first of them, as many as are asked for, as a buffer to parse in.
    template <class TakeFirst>
    void LoadBytes(std::string_view bytes, TakeFirst takeFirst)
    {
        const EncodingFacts facts = DetectEncoding(bytes);
        const std::string_view text = bytes.substr(facts.markLength);
        if (text.size() > longestText)
            error = TooLarge();
        else if (facts.encoding == Encoding::Utf8)
            Load(takeFirst(facts.markLength + DecisiveLength(text)), facts.markLength);
        else
            LoadDecoded(text, facts);
    }

    void LoadDecoded(std::string_view bytes, const EncodingFacts& facts);
    void LoadUtf16(std::string_view bytes, Encoding encoding);
    void LoadAscii(std::string_view bytes);

    template <class Action>
    auto Visit(Action action) const
    {
        return std::visit(action, tree);
    }
};

// Every encoding but UTF-8, which is parsed where it is. The bytes are without byte order mark.
void Document::Content::LoadDecoded(std::string_view bytes, const EncodingFacts& facts)
{
    switch (facts.encoding) {
    case Encoding::Utf16LittleEndian:
    case Encoding::Utf16BigEndian:
        return LoadUtf16(bytes, facts.encoding);
    case Encoding::Latin1:
    case Encoding::Windows1252:
        return Load(Utf8FromSingleBytes(bytes, facts.encoding), 0);
    case Encoding::Ascii:
        return LoadAscii(bytes);
    default:
        break;
    }
    const Fault<char> fault{ErrorCode::UnknownEncoding, facts.nameAt, "The encoding '%1' is not supported", facts.name};
    error = Report(fault, bytes);
}

void Document::Content::LoadUtf16(std::string_view bytes, Encoding encoding)
{
    TextBuffer<char16_t> text = Utf16FromBytes(bytes, encoding);
    if (bytes.size() % 2 == 0)
        return Load(std::move(text), 0);
    const std::u16string_view all = text.View();
    error = Report<char16_t>({ErrorCode::InvalidSequence, all.data() + all.size(), "The text ends within a character"},
                             all);
}

void Document::Content::LoadAscii(std::string_view bytes)
{
    const auto other = std::find_if(bytes.begin(), bytes.end(), [](char c) { return Unit(c) >= 0x80; });
    if (other == bytes.end())
        return Load(TextBuffer<char>(bytes), 0);
    const char* at = bytes.data() + (other - bytes.begin());
    error = Report<char>({ErrorCode::InvalidSequence, at, "The %c is not US-ASCII, which is declared"}, bytes);
}

// ---- Document

Document::Document() = default;
Document::~Document() = default;
Document::Document(Document&& other) noexcept = default;
Document& Document::operator=(Document&& other) noexcept = default;

bool Document::LoadText(std::u16string_view text)
{
    if (text.substr(0, 1) == u"\uFEFF")
        text.remove_prefix(1);
    return Content::Replace(content, [&](Content& loaded) {
        if (text.size() > longestText)
            loaded.error = TooLarge();
        else
            loaded.Load(TextBuffer<char16_t>(text.substr(0, DecisiveLength(text))), 0);
    });
}

bool Document::LoadBytes(std::string_view bytes)
{
    return Content::Replace(content, [&](Content& loaded) {
        loaded.LoadBytes(bytes, [&](std::size_t length) { return TextBuffer<char>(bytes.substr(0, length)); });
    });
}

bool Document::LoadFile(std::u16string_view path)
{
    return Content::Replace(content, [&](Content& loaded) {
        InputFile file(path);
        if (file.Size() > longestText) {
            loaded.error = TooLarge();
            return;
        }
        TextBuffer<char> bytes = ReadAll(file);
        loaded.LoadBytes(bytes.View(), [&](std::size_t length) {
            bytes.Shorten(length);
            return std::move(bytes);
        });
    });
}

const ParseError& Document::Error() const { return content ? content->error : ErrorOfNothing(); }

Node Document::Root() const { return content && !content->error ? Node(this, documentIndex) : Node(); }

Node Document::DocumentElement() const
{
    Node node = Root().FirstChild();
    while (node && node.Type() != NodeType::Element)
        node = node.NextSibling();
    return node;
}

std::u16string Document::Xml() const { return Root().Xml(); }

void Document::SaveFile(std::u16string_view path) const
{
    assert(content && !content->error);
    const auto write = [&]<class Char>(const Tree<Char>& tree) {
        std::basic_string<Char> markup;
        MarkupWriter<Char>(tree, markup).Document(true);
        if constexpr (sizeof(Char) == 1)
            WriteFileAtomically(path, markup);
        else
            WriteFileAtomically(path, ToUtf8(markup));
    };
    content->Visit(write);
}

// ---- Node

NodeType Node::Type() const
{
    if (!document)
        return NodeType::None;
    return document->content->Visit([this](const auto& tree) { return tree.Type(index); });
}

std::u16string Node::Name() const
{
    switch (Type()) {
    case NodeType::None:
        return u"";
    case NodeType::Document:
        return u"#document";
    case NodeType::Text:
        return u"#text";
    case NodeType::CData:
        return u"#cdata-section";
    case NodeType::Comment:
        return u"#comment";
    case NodeType::Element:
    case NodeType::Instruction:
        break;
    }
    return document->content->Visit([this](const auto& tree) {
        std::u16string name;
        AppendPlain(name, tree.Name(index));
        return name;
    });
}

bool Node::IsElement(std::string_view name) const
{
    return document && document->content->Visit([&](const auto& tree) { return IsNamed(tree, index, name); });
}

std::u16string Node::Text() const
{
    if (!document)
        return {};
    return document->content->Visit([this]<class Char>(const Tree<Char>& tree) -> std::u16string {
        if constexpr (sizeof(Char) == sizeof(char16_t))
            if (tree.IsPlainLeaf(index))
                return std::u16string(tree.Content(index));
        std::u16string text;
        tree.AppendText(text, index);
        return text;
    });
}

std::u16string_view Node::Text(std::u16string& room) const
{
    if (!document)
        return {};
    return document->content->Visit([&]<class Char>(const Tree<Char>& tree) -> std::u16string_view {
        if constexpr (sizeof(Char) == sizeof(char16_t))
            if (tree.IsPlainLeaf(index))
                return tree.Content(index);
        room.clear();
        tree.AppendText(room, index);
        return room;
    });
}

std::u16string Node::Xml() const
{
    if (!document)
        return u"";
    return document->content->Visit([this]<class Char>(const Tree<Char>& tree) -> std::u16string {
        std::basic_string<Char> markup;
        MarkupWriter<Char> writer(tree, markup);
        index == documentIndex ? writer.Document(false) : writer.Node(index);
        if constexpr (sizeof(Char) == 1)
            return ToUtf16(markup);
        else
            return markup;
    });
}

Node Node::FirstChild() const
{
    if (!document)
        return {};
    const NodeIndex child = document->content->Visit([this](const auto& tree) { return tree.FirstChild(index); });
    return child != noNode ? Node(document, child) : Node();
}

Node Node::NextSibling() const
{
    if (!document)
        return {};
    const NodeIndex next = document->content->Visit([this](const auto& tree) { return tree.NextSibling(index); });
    return next != noNode ? Node(document, next) : Node();
}

std::size_t Node::AttributeCount() const
{
    if (!document)
        return 0;
    return document->content->Visit([this](const auto& tree) {
        std::size_t count = 0;
        for (auto at = tree.FirstAttribute(index); at; at = tree.NextAttribute(at))
            count += IsNamespaceDeclaration(tree.AttributeName(*at)) ? 0u : 1u;
        return count;
    });
}

Attribute Node::AttributeAt(std::size_t position) const
{
    return document->content->Visit([&](const auto& tree) {
        const TreeAttribute& at = NamedAttribute(tree, index, position);
        Attribute attribute;
        AppendPlain(attribute.name, tree.AttributeName(at));
        tree.AppendValue(attribute.value, at);
        return attribute;
    });
}

std::u16string Node::AttributeValue(std::size_t position) const
{
    return document->content->Visit([&](const auto& tree) {
        std::u16string value;
        tree.AppendValue(value, NamedAttribute(tree, index, position));
        return value;
    });
}

Node Node::SelectSingle(std::string_view path) const
{
    if (!document)
        return {};
    const NodeIndex found =
        document->content->Visit([&](const auto& tree) { return PathSearch(tree, index, path).Found(); });
    return found != noNode ? Node(document, found) : Node();
}

NodeList Node::Select(std::string_view path) const
{
    NodeList found;
    if (document)
        document->content->Visit([&](const auto& tree) {
            for (PathSearch search(tree, index, path); search.Found() != noNode; search.Next()) {
                if (found.empty())
                    found.reserve(usualCount);
                found.push_back(Node(document, search.Found()));
            }
        });
    return found;
}

NodeList Node::ElementsByTagName(std::string_view name) const
{
    NodeList found;
    if (document)
        document->content->Visit([&](const auto& tree) {
            for (NodeIndex at = index + 1; at < tree.End(index); ++at)
                if (EndsPath(tree, at, index, Path::AtLastStep(name)))
                    found.push_back(Node(document, at));
        });
    return found;
}

// ---- ChildElements

ChildElements::ChildElements(const Node& parent) : document(parent.document) // NOLINT: firsts are set with their bits
{
    if (!document)
        return;
    document->content->Visit([&](const auto& tree) {
        const NodeIndex end = tree.End(parent.index);
        for (NodeIndex child = parent.index + 1; child < end; child = tree.End(child)) {
            const std::uint8_t bit = NameBit(tree.Name(child));
            if (!tree.IsElement(child) || Has(bits, bit))
                continue;
            bits |= NameSet{1} << bit;
            firsts[bit] = child;
        }
    });
}

Node ChildElements::First(std::string_view name, std::uint8_t bit) const
{
    if (!MayHave(bit))
        return {};
    const NodeIndex found =
        document->content->Visit([&](const auto& tree) { return FindFrom(tree, firsts[bit], name); });
    return found != noNode ? Node(document, found) : Node();
}

} // namespace varnex3::xml
