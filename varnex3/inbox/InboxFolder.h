// The message files of a folder, and their bytes.
#pragma once

#include <string>
#include <vector>

#include "varnex3/core/Text.h"
#include "varnex3/xml/Document.h"
#include "varnex3/xml/Folder.h"

namespace varnex3 {

// An open folder. Errors are the library's, with the system's reason and the name of the file.
class InboxFolder
{
public:
    // Raises FolderMissing when there is no such folder, another error when it cannot be read.
    explicit InboxFolder(const Text& path);

    // The names of the files directly in the folder whose extension is xml, in any letter case, in their order by
    // 16-bit units. Folders and other things that are no files are passed over.
    std::vector<Text> FileNames() const;

    // Loads a file; false when it is not well-formed. Raises FileNotFound, PermissionDenied or DeviceInputOutput when
    // it cannot be read.
    bool Load(const Text& name, xml::Document& document);

    // The folder's path as given, a separator where needed, and the name.
    Text PathOf(const Text& name) const { return folder.PathOf(name); }

private:
    std::size_t Read(const Text& name);

    xml::Folder folder;
    std::string bytes; // of the file read last: its room is used again
};

} // namespace varnex3
