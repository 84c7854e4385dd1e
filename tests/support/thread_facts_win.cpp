// The sibling is thread_facts_posix.cpp.

#include "host/windows_api.h"
#include "tests/support/thread_facts.h"

#include <vector>
#include <winternl.h>

std::string nameOfThisThread() {
    using GetDescription = HRESULT(WINAPI*)(HANDLE, PWSTR*);
    auto* const found =
        reinterpret_cast<void*>(GetProcAddress(GetModuleHandleA("kernel32.dll"), "GetThreadDescription"));
    wchar_t* wide = nullptr;
    if (found == nullptr || FAILED(reinterpret_cast<GetDescription>(found)(GetCurrentThread(), &wide))) {
        return "no names here";
    }
    char name[128] = "";
    WideCharToMultiByte(CP_ACP, 0, wide, -1, name, sizeof name, nullptr, nullptr);
    LocalFree(wide);
    return name;
}

std::size_t const LONGEST_THREAD_NAME = 63;

// From the list of all processes: Wine's `GetProcessHandleCount` says 0.
std::size_t openHandles() {
    using Query = NTSTATUS(NTAPI*)(SYSTEM_INFORMATION_CLASS, void*, ULONG, ULONG*);
    auto* const found =
        reinterpret_cast<void*>(GetProcAddress(GetModuleHandleA("ntdll.dll"), "NtQuerySystemInformation"));
    if (found == nullptr) return 0;
    std::vector<char> list(1 << 16);
    ULONG size = 0;
    while (reinterpret_cast<Query>(found)(SystemProcessInformation, list.data(), static_cast<ULONG>(list.size()),
                                          &size) != 0) {
        if (list.size() > (1U << 24)) return 0;
        list.resize(2 * list.size());
    }
    for (char const* place = list.data();;) {
        auto const* const process = reinterpret_cast<SYSTEM_PROCESS_INFORMATION const*>(place);
        auto const id = reinterpret_cast<std::uintptr_t>(process->UniqueProcessId);
        if (id == GetCurrentProcessId()) return process->HandleCount;
        if (process->NextEntryOffset == 0) return 0;
        place += process->NextEntryOffset;
    }
}
