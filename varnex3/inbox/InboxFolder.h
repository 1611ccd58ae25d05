// The message files of a folder, and their bytes.
#pragma once

#include <string>
#include <vector>

#include "varnex3/core/Text.h"
#include "varnex3/xml/Document.h"

namespace varnex3 {

// An open folder. Errors are the library's, with the system's reason and the name of the file.
class InboxFolder
{
public:
    struct File
    {
        Text name;
        std::string nativeName; // as the system has it
    };

    // Raises FolderMissing when there is no such folder, another error when it cannot be read.
    explicit InboxFolder(const Text& path);
    ~InboxFolder();
    InboxFolder(const InboxFolder&) = delete;
    InboxFolder& operator=(const InboxFolder&) = delete;

    // The files directly in the folder whose extension is xml, in any letter case, in the order of their names by
    // 16-bit units. Folders and other things that are no files are passed over.
    std::vector<File> MessageFiles() const;

    // Loads a file; false when it is not well-formed. Raises FileNotFound, PermissionDenied or DeviceInputOutput when
    // it cannot be read.
    bool Load(const File& file, xml::Document& document);

    // The folder's path as given, a separator where needed, and the name.
    Text PathOf(const File& file) const;

private:
    Text path;
    int folder = -1;
    std::string bytes; // of the file read last: its room is used again
};

} // namespace varnex3
