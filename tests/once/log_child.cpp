// log_child HOW: closes a log that has a buffer and watches its alert, which never returns. HOW it got the buffer and
// was closed: by a "line" and `init`, by a new "session" and `init`, by a line and being "destroyed".

#include <zor_basis/log.h>

#include "tests/support/wait_for.h"

#include <xos_host.h>

#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <thread>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

std::atomic<bool> hasReturned{false};

/// The alert of the log is the first of the process, or one of the next.
void fireAlert() {
    constexpr std::uint32_t LAST_TRIED = 16;
    std::uint32_t id = 1;
    while (id <= LAST_TRIED && xos_HostAlertFire(id) != 0) ++id;
    hasReturned = true;
}

bool isThere(fs::path const& file) {
    std::error_code ignored;
    return fs::exists(file, ignored);
}

bool holds(fs::path const& file, std::string const& line) {
    std::ifstream stream(file);
    std::string read;
    return std::getline(stream, read) && read == line;
}

/// Fails while the file is open.
bool isRemoved(fs::path const& file) {
    std::error_code ignored;
    return fs::remove(file, ignored);
}

} // namespace

int main(int argc, char** argv) {
    std::string const how = argc > 1 ? argv[1] : "";
    auto log = std::make_unique<Log>("child");
    bool const bySession = how == "session";
    if (bySession) {
        log->newSession();
    } else {
        log->out("%s", "line");
    }
    if (how == "destroyed") {
        log.reset();
    } else {
        log->init(nullptr);
    }
    std::thread(fireAlert).detach();
    fs::path const file = fs::path("tmp") / "zb_log" / "child" / (bySession ? "1.log" : "0.log");
    if (waitFor([&] { return bySession ? isThere(file) : holds(file, "line"); })) std::puts("written");
    for (int i = 0; i < 3; ++i) {
        if (waitFor([&] { return isRemoved(file); }) && waitFor([&] { return isThere(file); })) {
            std::puts("opened again");
        }
    }
    std::puts(hasReturned ? "returned" : "still running");
    return 0;
}
