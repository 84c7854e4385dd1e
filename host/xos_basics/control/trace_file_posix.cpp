// The sibling is trace_file_win.cpp.

#include "host/xos_basics/control/trace_file.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace host {

TraceFile openTrace(char const* path) {
    if (std::strcmp(path, "-") == 0) return STDERR_FILENO;
    return open(path, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NOCTTY, 0600);
}

void writeTrace(TraceFile file, std::string_view line) {
    while (!line.empty()) {
        ssize_t const count = write(static_cast<int>(file), line.data(), line.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return;
        line.remove_prefix(static_cast<std::size_t>(count));
    }
}

std::uint64_t processNumber() { return static_cast<std::uint64_t>(getpid()); }

std::uint64_t threadNumber() { return static_cast<std::uint64_t>(syscall(SYS_gettid)); }

} // namespace host
