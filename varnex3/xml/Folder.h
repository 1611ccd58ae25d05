// The files of a folder.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/xml/Files.h"

namespace varnex3::xml {

// An open folder. It stays the same one when it is renamed meanwhile (on Windows it is found by its path each time).
// Throws std::system_error with the system's reason, by the numbers of <cerrno> on every system.
class Folder
{
public:
    explicit Folder(std::u16string_view path_);
    ~Folder();
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    // The names of the files directly in it that are wanted, in no order. Folders and other things that are no files
    // are passed over; a link counts as what it leads to, and one that leads nowhere as a file that will not be found.
    std::vector<std::u16string> FileNames(const std::function<bool(std::u16string_view name)>& isWanted) const;

    // The folder's path as given, a separator where needed, and the name: "/inbox/a.xml", "C:\inbox\a.xml".
    std::u16string PathOf(std::u16string_view name) const;

private:
    friend class InputFile;

    std::u16string path;
#ifndef _WIN32
    int handle;
#endif
};

} // namespace varnex3::xml
