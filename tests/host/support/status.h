/// \file
/// Status, protection and times in tests of both targets.

#ifndef TESTS_HOST_SUPPORT_STATUS_H
#define TESTS_HOST_SUPPORT_STATUS_H

#include "basis/platform/xos_basics.h"

#include <chrono>
#include <filesystem>
#include <string>

constexpr unsigned KIND_MASK = 0xF000;
constexpr unsigned KIND_FILE = 0x8000;
constexpr unsigned KIND_DIRECTORY = 0x4000;
constexpr unsigned KIND_LINK = 0xA000;

/// All zero where there is nothing.
inline xos_Stat statusOf(std::string const& path) {
    xos_Stat record{};
    xos_FileStatByNameEx(path.c_str(), &record, 0x4000);
    return record;
}

inline unsigned kindOf(std::string const& path) { return statusOf(path).st_mode_ & KIND_MASK; }

inline void writeProtect(std::string const& path) {
    namespace fs = std::filesystem;
    fs::permissions(path, fs::perms::owner_write | fs::perms::group_write | fs::perms::others_write,
                    fs::perm_options::remove);
}

/// Makes an entry older. Twins: age_posix.cpp, age_win.cpp.
void setAge(std::string const& path, std::chrono::hours age);

#endif
