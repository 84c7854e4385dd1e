// The sibling is thread_facts_posix.cpp.

#include "host/windows_api.h"
#include "tests/support/thread_facts.h"

#include <cstdint>

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

// Wine says 0, but gives a new handle the first place that is free.
std::size_t openHandles() {
    DWORD count = 0;
    if (GetProcessHandleCount(GetCurrentProcess(), &count) != 0 && count != 0) return count;
    constexpr std::uintptr_t STEP = 4;
    HANDLE const next = CreateEventA(nullptr, FALSE, FALSE, nullptr);
    CloseHandle(next);
    return reinterpret_cast<std::uintptr_t>(next) / STEP;
}
