#include "zor_basis/flat.h"

#include "basis/files/last_error.h"
#include "basis/platform/xos_basics.h"
#include "zor_basis/text/buf_str.h"

namespace {

constexpr int ATTEMPTS = 5;
constexpr std::uint32_t PAUSE_MS = 500;

} // namespace

bool ZB_runCommand(char const* command, char const* directory, bool noResult) {
    // kept flat-03: without a directory the interpreter stays where it is.
    ZOR_Basis::BufStr<255> line("cd ");
    line.add(directory).add("& ").add(command);
    std::int64_t result = 0;
    for (int attempt = 0; attempt < ATTEMPTS; ++attempt) {
        if (xos_ShellExecuteEx(line.c_str(), noResult ? nullptr : &result) == 0) return true;
        ZOR_Basis::KeepLastError const keep;
        xos_TaskSleep(PAUSE_MS);
    }
    return false;
}
