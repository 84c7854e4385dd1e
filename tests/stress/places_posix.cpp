// The sibling is places_win.cpp.

#include "tests/stress/places.h"
#include "tests/support/memory_folder_posix.h"
#include "tests/support/thread_facts.h"

#include <algorithm>
#include <fstream>
#include <iterator>

namespace stress {

std::filesystem::path stressFolder() { return memoryFolder(); }

Holdings holdings() {
    std::filesystem::directory_iterator const threads{"/proc/self/task"};
    std::ifstream maps("/proc/self/maps");
    auto const regions = std::count(std::istreambuf_iterator<char>(maps), std::istreambuf_iterator<char>(), '\n');
    return {openHandles(), static_cast<std::uint64_t>(std::distance(begin(threads), end(threads))),
            static_cast<std::uint64_t>(regions)};
}

} // namespace stress
