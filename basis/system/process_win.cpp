// The sibling is process_posix.cpp.

#include "basis/system/process_impl.h"

#include "basis/files/last_error.h"
#include "basis/system/process_calls_win.h"

namespace ZOR_Basis {

ProcessCalls processCalls{CreateProcessA,     OpenProcess,      WaitForSingleObject,
                          GetExitCodeProcess, TerminateProcess, CloseHandle};

namespace {

class Handle {
public:
    explicit Handle(HANDLE handle) : handle_(handle) {}
    Handle(Handle const&) = delete;
    Handle& operator=(Handle const&) = delete;
    ~Handle() {
        if (handle_ == nullptr) return;
        KeepLastError const keep;
        processCalls.closeHandle(handle_);
    }
    HANDLE get() const { return handle_; }
    bool awaitEnd() const { return processCalls.waitFor(handle_, INFINITE) == WAIT_OBJECT_0; }

private:
    HANDLE const handle_;
};

/// Runs a call on a process that was opened. If opening failed, the call refuses the handle; callers need the reason of
/// the failed opening.
template <class Call>
bool onOpened(Handle const& process, Call call) {
    LastError const opening;
    bool const done = call();
    if (!done && process.get() == nullptr) opening.restore();
    return done;
}

} // namespace

bool ProcessImpl::create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode) {
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    PROCESS_INFORMATION created{};
    // Of the two forms of this call only the wide one writes to the command line.
    if (processCalls.createProcess(application, const_cast<char*>(commandLine), nullptr, nullptr, FALSE,
                                   CREATE_NEW_CONSOLE, nullptr, nullptr, &startup, &created) == FALSE) {
        return false;
    }
    Handle const thread(created.hThread);
    Handle const process(created.hProcess);
    if (processId != nullptr) {
        *processId = created.dwProcessId;
        return true;
    }
    process.awaitEnd();
    DWORD code = 0;
    if (exitCode != nullptr && processCalls.exitCodeOf(process.get(), &code) != FALSE)
        *exitCode = static_cast<int>(code);
    return true;
}

bool ProcessImpl::wait(unsigned long processId) {
    Handle const process(processCalls.openProcess(SYNCHRONIZE, FALSE, processId));
    return onOpened(process, [&] { return process.awaitEnd(); });
}

bool ProcessImpl::terminate(unsigned long processId) {
    Handle const process(processCalls.openProcess(PROCESS_TERMINATE, FALSE, processId));
    return onOpened(process, [&] { return processCalls.terminateProcess(process.get(), 0) != FALSE; });
}

void* ProcessImpl::findFunction(void* module, char const* name) {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(module), name));
}

} // namespace ZOR_Basis
