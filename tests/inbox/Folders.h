// A folder of files that goes when the test ends.
#pragma once

#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>
#include <string_view>

#include "varnex3/core/Text.h"

namespace varnex3::tests {

class Folder
{
public:
    Folder()
    {
        std::string name = (std::filesystem::temp_directory_path() / "varnex3-test-XXXXXX").string();
        if (!mkdtemp(name.data()))
            throw std::runtime_error("no temporary folder");
        path = name;
    }
    ~Folder() { std::filesystem::remove_all(path); }
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    const std::filesystem::path& Path() const { return path; }
    std::filesystem::path Path(std::string_view name) const { return path / name; }
    Text Name() const { return ToUtf16(path.string()); }
    Text Name(std::string_view name) const { return ToUtf16(Path(name).string()); }

    void Write(std::string_view name, std::string_view bytes) const
    {
        std::ofstream(Path(name), std::ios::binary) << bytes;
    }

private:
    std::filesystem::path path;
};

inline std::string BytesOf(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

} // namespace varnex3::tests
