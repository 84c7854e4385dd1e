// The sibling is places_posix.cpp.

#include "host/windows_api.h"
#include "tests/stress/places.h"

#include <tlhelp32.h>
#include <vector>
#include <winternl.h>

namespace stress {

namespace {

// From the list of all processes: Wine's `GetProcessHandleCount` says 0.
std::uint64_t countHandles() {
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
