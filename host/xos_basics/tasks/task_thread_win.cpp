// The sibling is task_thread_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/tasks/task_thread.h"

#include <limits>
#include <memory>
#include <new>
#include <process.h>

namespace host {

namespace {

struct Start {
    void (*run)(void*);
    void* argument;
};

unsigned __stdcall runStart(void* start) {
    std::unique_ptr<Start> const own{static_cast<Start*>(start)};
    own->run(own->argument);
    return 0;
}

/// Absent before Windows 10.
using SetDescription = HRESULT(WINAPI*)(HANDLE, PCWSTR);

SetDescription findSetDescription() {
    FARPROC const found = GetProcAddress(GetModuleHandleA("kernel32.dll"), "SetThreadDescription");
    return reinterpret_cast<SetDescription>(reinterpret_cast<void*>(found));
}

} // namespace

bool startThread(void (*run)(void*), void* argument, std::uint64_t stackSize) {
    if (stackSize > std::numeric_limits<unsigned>::max()) {
        setLastError(Error::NO_MEMORY);
        return false;
    }
    std::unique_ptr<Start> start{new (std::nothrow) Start{run, argument}};
    if (start == nullptr) {
        setLastError(Error::NO_MEMORY);
        return false;
    }
    std::uintptr_t const thread = _beginthreadex(nullptr, static_cast<unsigned>(stackSize), runStart, start.get(),
                                                 STACK_SIZE_PARAM_IS_A_RESERVATION, nullptr);
    if (thread == 0) return false;
    static_cast<void>(start.release()); // the thread's now
    CloseHandle(reinterpret_cast<HANDLE>(thread));
    return true;
}

void nameThisThread(TaskName const& name) {
    static SetDescription const setDescription = findSetDescription();
    wchar_t wide[sizeof(TaskName)] = L"";
    MultiByteToWideChar(CP_ACP, 0, name.data(), -1, wide, static_cast<int>(sizeof(TaskName)));
    if (setDescription != nullptr) setDescription(GetCurrentThread(), wide);
}

} // namespace host
