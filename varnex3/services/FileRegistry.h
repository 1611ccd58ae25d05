// The registry of a system that has none: a .reg file for each root.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>

#include <sys/stat.h>

#include "varnex3/services/Registry.h"
#include "varnex3/services/RegistryFile.h"

namespace varnex3 {

// Reading needs the right to read the file and nothing else, and takes no lock; a file that is not there has no keys.
// A change is made under a lock that all processes share (the file's name and ".lock"), to the content the file has
// then, and replaces the file in one step: nobody's change is lost, and a reader sees the file before or after it. A
// file that was changed by other means is read again.
//
// A key is opened for reading and writing without the right to write: writing then ends in AccessDenied. A key that is
// open several times is one handle, so that handles nobody closes take no more memory each time.
class FileRegistry final : public Registry
{
public:
    // Where the file of a root is; asked at each operation. The empty text is no file.
    using Locate = std::function<Text(RegistryRoot)>;

    explicit FileRegistry(Locate locate_);

    RegistryStatus Open(RegistryRoot root, const std::string& path, RegistryKey& key) override;
    RegistryStatus Create(RegistryRoot root, const std::string& path, RegistryKey& key) override;
    QueriedValue Query(RegistryKey key, const std::string& name, std::span<char> buffer) override;
    RegistryStatus Set(RegistryKey key, const std::string& name, RegistryType type, std::string_view data) override;
    RegistryStatus Delete(RegistryRoot root, const std::string& path) override;
    RegistryStatus Close(RegistryKey key) override;

private:
    struct OpenKey
    {
        RegistryRoot root;
        std::string path; // as it was spelled first
        std::size_t count;
    };

    // By what it is seen that a file was changed.
    struct Stamp
    {
        dev_t device;
        ino_t number;
        off_t size;
        timespec changed;

        bool operator==(const Stamp& other) const;
    };

    // A file as it was read last.
    struct Content
    {
        Text path;
        std::optional<Stamp> stamp; // none: the file was not there
        bool isSettled = false;
        RegistryFile file;
    };

    static std::optional<Stamp> StampOf(const Text& path);
    static bool IsSettled(const Stamp& stamp);
    const RegistryFile& Current(RegistryRoot root);
    template <class Edit>
    RegistryStatus Change(RegistryRoot root, Edit edit);
    RegistryKey Enter(RegistryRoot root, const std::string& path);

    Locate locate;
    std::mutex mutex; // one operation at a time
    std::map<RegistryRoot, Content> contents;
    std::map<RegistryKey, OpenKey> openKeys;
    std::uintptr_t lastKey = 0;
};

} // namespace varnex3
