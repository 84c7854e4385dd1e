// The sibling is named_mutex_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/semaphores/named_mutex.h"

#include <new>
#include <string>

namespace host {

/// The kernel's own mutex is recursive, shared by name, and handed to the next in line when its holder dies.
class NamedMutex {
public:
    explicit NamedMutex(HANDLE handle) : handle_(handle) {}

    int take() {
        DWORD const result = WaitForSingleObject(handle_, INFINITE);
        return result == WAIT_OBJECT_0 || result == WAIT_ABANDONED ? 0 : -1;
    }

    int give() { return ReleaseMutex(handle_) != 0 ? 0 : -1; }

private:
    HANDLE handle_;
};

namespace {

/// User names are not longer.
constexpr DWORD NAME_SIZE = 257;

/// One name in all sessions of a user.
std::wstring objectName(int id) {
    wchar_t user[NAME_SIZE] = L"";
    DWORD size = NAME_SIZE;
    GetUserNameW(user, &size);
    return L"Global\\xos-mutex-" + std::wstring(user) + L"-" + std::to_wstring(id);
}

} // namespace

NamedMutex* openNamed(int id) {
    HANDLE const handle = CreateMutexW(nullptr, FALSE, objectName(id).c_str());
    if (handle == nullptr) return nullptr;
    auto* const mutex = new (std::nothrow) NamedMutex(handle);
    if (mutex == nullptr) {
        CloseHandle(handle);
        setLastError(Error::NO_MEMORY);
    }
    return mutex;
}

int takeNamed(NamedMutex& mutex) { return mutex.take(); }

int giveNamed(NamedMutex& mutex) { return mutex.give(); }

} // namespace host
