#include "FolderReading.h"

#include <cerrno>
#include <memory>
#include <system_error>
#include <vector>

#include <dirent.h>
#include <fcntl.h>
#include <unistd.h>

namespace varnex3::benchmarks {
namespace {

struct CloseFolder
{
    void operator()(DIR* folder) const { closedir(folder); }
};

[[noreturn]] void Throw(const std::string& what) { throw std::system_error(errno, std::generic_category(), what); }

std::size_t ReadFile(int folder, const char* name, std::vector<char>& buffer)
{
    const int file = openat(folder, name, O_RDONLY | O_CLOEXEC);
    if (file < 0)
        Throw(name);

    std::size_t total = 0;
    ssize_t count = 0;
    do { // a message fits the buffer, so this is one read
        count = read(file, buffer.data(), buffer.size());
        total += count > 0 ? static_cast<std::size_t>(count) : 0;
    } while (count == static_cast<ssize_t>(buffer.size()));
    close(file);
    return total;
}

} // namespace

std::size_t ReadEveryFile(const std::string& folder)
{
    const std::unique_ptr<DIR, CloseFolder> listing(opendir(folder.c_str()));
    if (!listing)
        Throw(folder);

    std::vector<char> buffer(256 * 1024);
    std::size_t total = 0;
    while (const dirent* entry = readdir(listing.get()))
        if (entry->d_type == DT_REG)
            total += ReadFile(dirfd(listing.get()), entry->d_name, buffer);
    return total;
}

} // namespace varnex3::benchmarks
