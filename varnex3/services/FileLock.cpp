#include "varnex3/services/FileLock.h"

#include <cerrno>
#include <system_error>

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

namespace varnex3 {

namespace {

constexpr mode_t kMode = 0660; // not for everyone: who can open the file can hold the lock for ever

[[noreturn]] void Fail(int error, const std::string& name)
{
    throw std::system_error(error, std::generic_category(), name);
}

bool Lock(int handle)
{
    while (flock(handle, LOCK_EX) != 0)
        if (errno != EINTR)
            return false;
    return true;
}

} // namespace

FileLock::FileLock(const std::string& name) : handle(open(name.c_str(), O_RDONLY | O_CREAT | O_CLOEXEC, kMode))
{
    if (handle < 0)
        Fail(errno, name);
    if (!Lock(handle)) {
        const int error = errno;
        close(handle);
        Fail(error, name);
    }
}

FileLock::~FileLock() { close(handle); }

} // namespace varnex3
