#include "varnex3/services/RegistryFile.h"

#include <algorithm>
#include <utility>

namespace varnex3 {

namespace {

using Kind = RegistryLine::Kind;

constexpr std::string_view kHead = "Windows Registry Editor Version 5.00";

constexpr Name kNoHead = "the file does not begin with \"Windows Registry Editor Version 5.00\" or \"REGEDIT4\"";
constexpr Name kNotMachine = "the key is not below HKEY_LOCAL_MACHINE";
constexpr Name kNotUser = "the key is not below HKEY_CURRENT_USER";
constexpr Name kRootDeletion = "a root cannot be deleted";
constexpr Name kNoKey = "the value stands below no key";

bool IsWide(xml::Encoding encoding)
{
    return encoding == xml::Encoding::Utf16LittleEndian || encoding == xml::Encoding::Utf16BigEndian;
}

std::string ToBytes(TextView text, xml::Encoding encoding)
{
    const bool isHighFirst = encoding == xml::Encoding::Utf16BigEndian;
    std::string bytes;
    bytes.reserve(text.size() * 2);
    for (const char16_t unit : text) {
        const auto high = static_cast<char>(unit >> 8);
        const auto low = static_cast<char>(unit & 0xFF);
        bytes += isHighFirst ? high : low;
        bytes += isHighFirst ? low : high;
    }
    return bytes;
}

// The text up to and with the first line end.
std::string_view FirstLine(std::string_view text)
{
    const std::size_t end = text.find('\n');
    return text.substr(0, end == std::string_view::npos ? end : end + 1);
}

std::string_view WithoutLineEnd(std::string_view line)
{
    if (line.ends_with('\n'))
        line.remove_suffix(1);
    if (line.ends_with('\r'))
        line.remove_suffix(1);
    return line;
}

std::string_view LineEndOf(std::string_view line) { return line.substr(WithoutLineEnd(line).size()); }

bool IsBelow(std::string_view path, std::string_view above)
{
    return path.size() > above.size() && path[above.size()] == '\\' && path.starts_with(above);
}

std::string_view ParentOf(std::string_view path)
{
    const std::size_t end = path.rfind('\\');
    return path.substr(0, end == std::string_view::npos ? 0 : end);
}

bool IsValue(Kind kind) { return kind == Kind::Value || kind == Kind::ValueDeletion; }

bool IsKey(Kind kind) { return kind == Kind::Key || kind == Kind::KeyDeletion; }

// Also when the key is damaged or below another root.
bool StartsKey(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(" \t");
    return first != std::string_view::npos && text[first] == '[';
}

} // namespace

Name RootName(RegistryRoot root)
{
    return root == RegistryRoot::LocalMachine ? "HKEY_LOCAL_MACHINE" : "HKEY_CURRENT_USER";
}

RegistryFile::RegistryFile(RegistryRoot root_, std::string_view bytes) : root(root_)
{
    const xml::EncodingFacts facts = xml::DetectEncoding(bytes);
    encoding = IsWide(facts.encoding) ? facts.encoding : xml::Encoding::Utf8;
    mark = bytes.substr(0, facts.markLength);
    const std::string_view content = bytes.substr(mark.size());
    if (IsWide(encoding))
        Load(ToUtf8(xml::Utf16FromBytes(content, encoding).View()));
    else
        Load(content);
}

std::string RegistryFile::Bytes() const
{
    return mark + (IsWide(encoding) ? ToBytes(ToUtf16(AllText()), encoding) : AllText());
}

std::string RegistryFile::AllText() const
{
    std::string text;
    for (const Item& item : items)
        text += item.text;
    return text;
}

// ---- reading

void RegistryFile::Load(std::string_view text)
{
    if (const std::string_view first = LineEndOf(FirstLine(text)); !first.empty())
        lineEnd = first;
    items.clear();
    keys.clear();
    keys[""]; // the root is always there

    Scope scope;
    for (std::size_t line = 1; !text.empty();) {
        items.push_back(NextItem(text, line, scope.dialect));
        Apply(items.size() - 1, scope);
    }
}

RegistryFile::Item RegistryFile::NextItem(std::string_view& rest, std::size_t& line, RegistryDialect dialect) const
{
    Item item;
    item.line = line;
    const auto take = [&] {
        const std::string_view taken = FirstLine(rest);
        item.text += taken;
        rest.remove_prefix(taken.size());
        ++line;
        return WithoutLineEnd(taken);
    };
    std::string joined(take());
    bool goesOn = IsContinued(joined);
    while (goesOn && IsContinuation(WithoutLineEnd(FirstLine(rest)))) {
        const std::string_view next = take();
        joined.erase(joined.rfind('\\'));
        joined += next;
        goesOn = EndsInBackslash(next);
    }
    item.read = ReadRegistryLine(joined, dialect);
    return item;
}

// What an item says changes what the items before it said.
void RegistryFile::Apply(std::size_t index, Scope& scope)
{
    Item& item = items[index];
    if (item.read.kind == Kind::Head) // there are several when files were put together
        scope.dialect = item.read.dialect;
    item.dialect = scope.dialect;
    if (IsKey(item.read.kind))
        ApplyKey(index, scope);
    else if (IsValue(item.read.kind))
        ApplyValue(index, scope);
    else if (StartsKey(item.text))
        scope = {std::nullopt, true, scope.dialect}; // a damaged key: nobody knows whose the values below it are
}

// Why a key in brackets says nothing; empty when it does.
std::string_view RegistryFile::FaultOf(const Item& item) const
{
    const std::string_view key = item.read.key;
    const std::string_view rootPart = key.substr(0, key.find('\\'));
    if (FoldedName(rootPart) != FoldedName(RootName(root)))
        return root == RegistryRoot::LocalMachine ? kNotMachine : kNotUser;
    if (item.read.kind == Kind::KeyDeletion && rootPart.size() == key.size())
        return kRootDeletion;
    return {};
}

void RegistryFile::ApplyKey(std::size_t index, Scope& scope)
{
    Item& item = items[index];
    if (const std::string_view fault = FaultOf(item); !fault.empty()) {
        item.read.kind = Kind::Damaged;
        item.read.reason = fault;
        scope = {std::nullopt, true, scope.dialect};
        return;
    }
    item.path = FoldedName(PathOf(item));
    if (item.read.kind == Kind::KeyDeletion) {
        EraseKeys(item.path);
        scope = {std::nullopt, false, scope.dialect};
    } else {
        AddKey(index);
        scope = {item.path, false, scope.dialect};
    }
}

void RegistryFile::ApplyValue(std::size_t index, const Scope& scope)
{
    Item& item = items[index];
    if (!scope.path) {
        item.read.kind = scope.isPassedOver ? Kind::Remark : Kind::Damaged;
        item.read.reason = kNoKey;
        return;
    }
    item.path = *scope.path;
    if (item.read.kind == Kind::Value)
        keys[item.path].values[FoldedName(item.read.name)] = index;
    else
        keys[item.path].values.erase(FoldedName(item.read.name));
}

// A key is there together with those above it.
void RegistryFile::AddKey(std::size_t index)
{
    std::string_view path = items[index].path;
    keys[items[index].path].item = index;
    for (path = ParentOf(path); !path.empty(); path = ParentOf(path))
        keys.try_emplace(std::string(path));
}

void RegistryFile::EraseKeys(const std::string& path)
{
    keys.erase(path);
    std::erase_if(keys, [&](const auto& key) { return IsBelow(key.first, path); });
}

// As written, without the root.
std::string RegistryFile::PathOf(const Item& item) const
{
    return item.read.key.size() > RootName(root).size() ? item.read.key.substr(RootName(root).size() + 1) : "";
}

// ---- looking up

bool RegistryFile::HasKey(std::string_view path) const { return keys.contains(FoldedName(path)); }

bool RegistryFile::HasKeysBelow(std::string_view path) const
{
    const std::string above = FoldedName(path) + "\\";
    const auto next = keys.lower_bound(above);
    return next != keys.end() && next->first.starts_with(above);
}

const RegistryFile::Item* RegistryFile::ItemOf(std::string_view path, std::string_view name) const
{
    const auto key = keys.find(FoldedName(path));
    if (key == keys.end())
        return nullptr;
    const auto value = key->second.values.find(FoldedName(name));
    return value == key->second.values.end() ? nullptr : &items[value->second];
}

std::optional<RegistryValue> RegistryFile::Find(std::string_view path, std::string_view name) const
{
    const Item* const item = ItemOf(path, name);
    return item != nullptr ? std::optional(item->read.value) : std::nullopt;
}

std::vector<RegistryFile::Entry> RegistryFile::Entries() const
{
    std::vector<Entry> entries;
    for (const auto& [path, key] : keys)
        for (const auto& [name, index] : key.values)
            entries.push_back(
                {PathOf(items[*key.item]), items[index].read.name, items[index].read.value, items[index].line});
    std::ranges::sort(entries, {}, &Entry::line);
    return entries;
}

std::vector<RegistryFile::Damage> RegistryFile::Damages() const
{
    std::vector<Damage> damages;
    const auto report = [&](const Item& item, std::string_view reason) {
        damages.push_back({std::string(WithoutLineEnd(item.text)), reason, item.line});
    };
    const auto first = std::ranges::find_if(items, [](const Item& item) { return item.read.kind != Kind::Remark; });
    if (first != items.end() && first->read.kind != Kind::Head)
        report(*first, kNoHead);
    for (const Item& item : items)
        if (item.read.kind == Kind::Damaged)
            report(item, item.read.reason);
    return damages;
}

// ---- editing: the lines are changed and read again

void RegistryFile::CreateKey(std::string_view path)
{
    if (!HasKey(path))
        AppendKey(path);
}

void RegistryFile::AppendKey(std::string_view path)
{
    if (items.empty())
        Append(std::string(kHead));
    Append("");
    Append("[" + std::string(RootName(root)) + (path.empty() ? "" : "\\") + std::string(path) + "]");
    Load(AllText());
}

void RegistryFile::SetValue(std::string_view path, std::string_view name, const RegistryValue& value)
{
    if (const Item* const item = ItemOf(path, name))
        Replace(static_cast<std::size_t>(item - items.data()), value);
    else
        InsertValue(path, name, value);
    Load(AllText());
}

void RegistryFile::DeleteKey(std::string_view path)
{
    const std::string folded = FoldedName(path);
    const auto parent = std::string(ParentOf(path));
    std::erase_if(items, [&](const Item& item) {
        return item.path == folded && (item.read.kind == Kind::Key || IsValue(item.read.kind));
    });
    Load(AllText());
    CreateKey(parent); // which was there, if only because of this one
}

void RegistryFile::Append(const std::string& line) { Insert(items.size(), line); }

void RegistryFile::Insert(std::size_t index, const std::string& line)
{
    if (index > 0 && LineEndOf(items[index - 1].text).empty())
        items[index - 1].text += lineEnd;
    Item item;
    item.text = line + lineEnd;
    items.insert(items.begin() + static_cast<std::ptrdiff_t>(index), std::move(item));
}

void RegistryFile::Replace(std::size_t index, const RegistryValue& value)
{
    Item& item = items[index];
    const std::string beforeData = item.text.substr(0, item.read.dataAt);
    item.text =
        WrittenValue(beforeData, value, item.dialect, lineEnd) + item.read.remark + std::string(LineEndOf(item.text));
}

// Behind the last line of the key that is not a remark.
void RegistryFile::InsertValue(std::string_view path, std::string_view name, const RegistryValue& value)
{
    const std::string folded = FoldedName(path);
    if (!HasKey(path) || !keys[folded].item)
        AppendKey(path);
    std::size_t last = *keys[folded].item;
    for (std::size_t i = last + 1; i < items.size() && !StartsKey(items[i].text); ++i)
        last = items[i].read.kind == Kind::Remark ? last : i;
    Insert(last + 1, WrittenValue(WrittenName(name), value, items[last].dialect, lineEnd));
}

} // namespace varnex3
