// A thread that runs a function. These compilers have no std::thread.
#pragma once

#include <windows.h>

#include <functional>
#include <utility>

namespace varnex3::tests {

class Thread
{
public:
    explicit Thread(std::function<void()> work_)
        : work(std::move(work_)), handle(CreateThread(nullptr, 0, &Run, this, 0, nullptr))
    {}
    ~Thread()
    {
        Join();
        CloseHandle(handle);
    }
    Thread(const Thread&) = delete;
    Thread& operator=(const Thread&) = delete;

    // Waits for its end, and serves the calls that others send to this thread's objects meanwhile.
    void Join()
    {
        while (MsgWaitForMultipleObjects(1, &handle, FALSE, INFINITE, QS_ALLINPUT) == WAIT_OBJECT_0 + 1) {
            MSG message;
            while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE))
                DispatchMessageW(&message);
        }
    }

private:
    static DWORD WINAPI Run(void* self)
    {
        static_cast<Thread*>(self)->work();
        return 0;
    }

    std::function<void()> work;
    HANDLE handle;
};

} // namespace varnex3::tests
