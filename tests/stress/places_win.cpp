// The sibling is places_posix.cpp.

#include "host/windows_api.h"
#include "tests/stress/places.h"
#include "tests/support/thread_facts.h"

#include <tlhelp32.h>

namespace stress {

namespace {

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

Holdings holdings() { return {openHandles(), countThreads(), countMappings()}; }

} // namespace stress
