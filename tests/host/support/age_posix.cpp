// The sibling is age_win.cpp.

#include "tests/host/support/status.h"

void setAge(std::string const& path, std::chrono::hours age) {
    std::filesystem::last_write_time(path, std::filesystem::file_time_type::clock::now() - age);
}
