// The sibling is places_posix.cpp.

#include "host/windows_api.h"
#include "tests/stress/places.h"

#include <tlhelp32.h>

namespace stress {

namespace {

/// Wine says 0, but gives a new handle the first place that is free.
std::uint64_t countHandles() {
    DWORD count = 0;
    if (GetProcessHandleCount(GetCurrentProcess(), &count) != 0 && count != 0) return count;
    constexpr std::uintptr_t STEP = 4;
    HANDLE const next = CreateEventA(nullptr, FALSE, FALSE, nullptr);
    CloseHandle(next);
    return reinterpret_cast<std::uintptr_t>(next) / STEP;
}

std::uint64_t countThreads() {
    std::uint64_t count = 0;
    HANDLE const snapshot = CreateToolhelp32Snapshot(TH32CS_SNAPTHREAD, 0);
    THREADENTRY32 entry{};
    entry.dwSize = sizeof entry;
    for (BOOL isThere = Thread32First(snapshot, &entry); isThere != 0; isThere = Thread32Next(snapshot, &entry)) {
        if (entry.th32OwnerProcessID == GetCurrentProcessId()) ++count;
    }
    CloseHandle(snapshot);
    return count;
}

std::uint64_t countMappings() {
    std::uint64_t count = 0;
    MEMORY_BASIC_INFORMATION region{};
    for (char const* place = nullptr; VirtualQuery(place, &region, sizeof region) != 0;
         place = static_cast<char const*>(region.BaseAddress) + region.RegionSize) {
        // One for each allocation.
        if (region.State != MEM_FREE && region.BaseAddress == region.AllocationBase) ++count;
    }
    return count;
}

} // namespace

std::filesystem::path stressFolder() { return std::filesystem::temp_directory_path(); }

Holdings holdings() { return {countHandles(), countThreads(), countMappings()}; }

} // namespace stress
