// The registry as the settings need it: one interface with two backs, the Windows API and text files.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "varnex3/core/Text.h"

namespace varnex3 {

// HKEY_LOCAL_MACHINE, the settings of every user, and HKEY_CURRENT_USER, one user's own.
enum class RegistryRoot
{
    LocalMachine,
    CurrentUser
};

// What a value is. Others exist; they are numbers without a name here.
enum class RegistryType : std::uint32_t
{
    Text = 1,
    ExpandableText = 2,
    Binary = 3,
    Number32 = 4,
    TextList = 7
};

// What an operation came to, by the numbers of Windows. Others exist there; all but the first are failures.
enum class RegistryStatus : std::uint32_t
{
    Done = 0,
    NotFound = 2,
    AccessDenied = 5,
    InvalidHandle = 6,
    Failed = 31,
    InvalidParameter = 87,
    DiskFull = 112,
    BadPath = 161,
    MoreData = 234,
    KeyDeleted = 1018
};

// An open key.
enum class RegistryKey : std::uintptr_t
{
    Invalid = 0
};

struct QueriedValue
{
    RegistryStatus status = RegistryStatus::Failed;
    RegistryType type = RegistryType::Text;
    std::size_t length = 0; // of the data, also when the buffer is too short for them
};

// Keys are paths under a root, their parts separated by backslashes, upper and lower case alike; so are the names of
// values, of which the empty one is the key's default value. Paths, names and the data of texts are in the system's
// code page. The data of a text end with a zero byte; a text that is set without one may come back with it, as on
// Windows. No operation throws.
class Registry
{
public:
    virtual ~Registry() = default;

    // Opens a key that is there with full access; `key` is Invalid after a failure.
    virtual RegistryStatus Open(RegistryRoot root, const std::string& path, RegistryKey& key) = 0;

    // Opens a key, created with its parents when it is not there.
    virtual RegistryStatus Create(RegistryRoot root, const std::string& path, RegistryKey& key) = 0;

    // Copies the data of a value into a buffer. A buffer that is too short: MoreData, and its content is undefined.
    virtual QueriedValue Query(RegistryKey key, const std::string& name, std::span<char> buffer) = 0;

    virtual RegistryStatus Set(RegistryKey key, const std::string& name, RegistryType type, std::string_view data) = 0;

    // Deletes a key with its values. A key that has keys below it stays: AccessDenied.
    virtual RegistryStatus Delete(RegistryRoot root, const std::string& path) = 0;

    virtual RegistryStatus Close(RegistryKey key) = 0;
};

// The registry of this system: its own on Windows, the files of Settings.h elsewhere. Any thread may use it.
Registry& SystemRegistry();

// Text to and from the system's code page: ANSI on Windows, UTF-8 elsewhere.
std::string ToCodePage(TextView text);
Text FromCodePage(std::string_view bytes);

} // namespace varnex3
