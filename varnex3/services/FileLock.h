// A lock between processes, and between the threads of one.
#pragma once

#include <string>

namespace varnex3 {

// Held from construction to destruction, and given up when the process ends in any way. The lock is on a file of its
// own, made where it is not there and left there: a file that is replaced cannot carry its lock.
class FileLock
{
public:
    // Waits for its turn. Throws std::system_error when the file cannot be made, opened or locked.
    explicit FileLock(const std::string& name);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;

private:
    int handle;
};

} // namespace varnex3
