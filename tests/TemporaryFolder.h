// A folder of files that goes when the test ends.
#pragma once

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/core/Text.h"
#include "varnex3/xml/Files.h"

namespace varnex3::tests {

// A path as the library takes it.
inline Text NameOf(const std::filesystem::path& path)
{
#ifdef _WIN32
    return path.u16string();
#else
    return xml::FromNativePath(path.native());
#endif
}

inline std::string BytesOf(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

class TemporaryFolder
{
public:
    TemporaryFolder()
    {
        std::random_device random;
        do
            path = std::filesystem::temp_directory_path() / ("varnex3-test-" + std::to_string(random()));
        while (!std::filesystem::create_directory(path));
    }
    ~TemporaryFolder()
    {
        std::error_code whatIsLeft;
        std::filesystem::remove_all(path, whatIsLeft);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::filesystem::path& Path() const { return path; }
    std::filesystem::path Path(const std::filesystem::path& name) const { return path / name; }
    Text Name() const { return NameOf(path); }
    Text Name(const std::filesystem::path& name) const { return NameOf(Path(name)); }

    void Write(const std::filesystem::path& name, std::string_view bytes) const
    {
        std::ofstream(Path(name), std::ios::binary) << bytes;
    }

    // The names of what is in it, in their order.
    std::vector<Text> Names() const
    {
        std::vector<Text> names;
        for (const std::filesystem::directory_entry& entry : std::filesystem::directory_iterator(path))
            names.push_back(NameOf(entry.path().filename()));
        std::ranges::sort(names);
        return names;
    }

private:
    std::filesystem::path path;
};

} // namespace varnex3::tests
