// Threads in tests, also where the compiler's library has none: std::thread is missing from the one for Windows.
#pragma once

#include <functional>
#include <list>

#ifdef _WIN32
#include <windows.h>
#else
#include <thread>
#endif

namespace varnex3::tests {

#ifdef _WIN32
class Thread
{
public:
    explicit Thread(std::function<void()> action_)
        : action(std::move(action_)), handle(CreateThread(nullptr, 0, &Run, &action, 0, nullptr))
    {}
    ~Thread()
    {
        WaitForSingleObject(handle, INFINITE);
        CloseHandle(handle);
    }
    Thread(const Thread&) = delete;
    Thread& operator=(const Thread&) = delete;

private:
    static DWORD WINAPI Run(void* action)
    {
        (*static_cast<std::function<void()>*>(action))();
        return 0;
    }

    std::function<void()> action;
    HANDLE handle;
};
#else
using Thread = std::jthread;
#endif

// Does something on several threads at once.
inline void OnThreads(int count, const std::function<void()>& action)
{
    std::list<Thread> threads; // each stays where it is, and is waited for at the end
    for (int i = 0; i < count; ++i)
        threads.emplace_back(action);
}

} // namespace varnex3::tests
