// A .reg file: read, looked up, edited.
#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/services/Registry.h"
#include "varnex3/services/RegistryLine.h"
#include "varnex3/xml/Encoding.h"

namespace varnex3 {

// The content of one file, in the format that the registry editor of Windows exports and imports: the head "REGEDIT4"
// or "Windows Registry Editor Version 5.00", keys in brackets, values below them, comments behind semicolons, deletions
// ([-key] and "name"=-). Later lines outrank earlier ones, as when the file is imported. Texts are UTF-8, with or
// without a byte order mark, or UTF-16 with one.
//
// An edit changes the lines of its key or value and leaves all others as they are, byte for byte: comments, blank
// lines, what is damaged, what belongs to another root. Encoding and line ends stay as they were.
class RegistryFile
{
public:
    // A value that holds, or a line that says nothing for a reason; line numbers count from 1.
    struct Entry
    {
        std::string path;
        std::string name;
        RegistryValue value;
        std::size_t line;
    };
    struct Damage
    {
        std::string text;
        std::string_view reason;
        std::size_t line;
    };

    // Nothing makes it fail: a line that cannot be read is damage. An empty file has no keys.
    RegistryFile(RegistryRoot root, std::string_view bytes);

    // What is to be written to the file.
    std::string Bytes() const;

    // Paths are those of Registry, without a backslash at the end.
    bool HasKey(std::string_view path) const;
    bool HasKeysBelow(std::string_view path) const; // not for the root
    std::optional<RegistryValue> Find(std::string_view path, std::string_view name) const;

    void CreateKey(std::string_view path);
    void SetValue(std::string_view path, std::string_view name, const RegistryValue& value); // creates the key
    void DeleteKey(std::string_view path);                                                   // its parents stay

    // In the order of the file.
    std::vector<Entry> Entries() const;
    std::vector<Damage> Damages() const;

private:
    // A line with those that continue it.
    struct Item
    {
        std::string text; // as it stands in the file, with the line ends
        std::size_t line = 0;
        RegistryDialect dialect = RegistryDialect::Version5;
        RegistryLine read;
        std::string path; // of the key it is or belongs to: without the root, folded
    };

    // A key that is there: which item says so last (none when only a key below it does), and which hold its values.
    struct KeyState
    {
        std::optional<std::size_t> item;
        std::map<std::string, std::size_t> values; // by their folded names
    };

    // The key that the lines being read belong to. Those below a damaged or foreign key are passed over.
    struct Scope
    {
        std::optional<std::string> path;
        bool isPassedOver = false;
        RegistryDialect dialect = RegistryDialect::Version5;
    };

    void Load(std::string_view text);
    Item NextItem(std::string_view& rest, std::size_t& line, RegistryDialect dialect) const;
    void Apply(std::size_t index, Scope& scope);
    void ApplyKey(std::size_t index, Scope& scope);
    void ApplyValue(std::size_t index, const Scope& scope);
    std::string_view FaultOf(const Item& item) const;
    void AddKey(std::size_t index);
    void EraseKeys(const std::string& path);

    const Item* ItemOf(std::string_view path, std::string_view name) const;
    std::string PathOf(const Item& item) const;
    std::string AllText() const;
    void AppendKey(std::string_view path);
    void Append(const std::string& line);
    void Insert(std::size_t index, const std::string& line);
    void Replace(std::size_t index, const RegistryValue& value);
    void InsertValue(std::string_view path, std::string_view name, const RegistryValue& value);

    RegistryRoot root;
    xml::Encoding encoding = xml::Encoding::Utf8;
    std::string mark; // the byte order mark
    std::string lineEnd = "\n";
    std::vector<Item> items;
    std::map<std::string, KeyState> keys; // by their folded paths
};

// "HKEY_LOCAL_MACHINE", "HKEY_CURRENT_USER".
Name RootName(RegistryRoot root);

} // namespace varnex3
