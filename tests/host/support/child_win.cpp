// The sibling is child_posix.cpp.

#include "host/windows_api.h"
#include "tests/host/support/child.h"

#include <cstdlib>
#include <psapi.h>

namespace {

constexpr DWORD KILLED = 0xDEAD;
constexpr DWORD LONGEST_WAIT_MS = 30'000;

std::string ownFolder() {
    char path[MAX_PATH] = "";
    GetModuleFileNameA(nullptr, path, MAX_PATH);
    std::string const text = path;
    return text.substr(0, text.find_last_of('\\'));
}

HANDLE handleOf(std::int64_t process) { return reinterpret_cast<HANDLE>(process); }

} // namespace

Child::Child(std::string const& program, Words const& arguments, Environment const& environment) {
    std::string line = "\"" + program + "\"";
    for (std::string const& argument : arguments) { line += " \"" + argument + "\""; }
    for (auto const& [name, value] : environment) { SetEnvironmentVariableA(name.c_str(), value.c_str()); }
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    PROCESS_INFORMATION process{};
    if (CreateProcessA(nullptr, line.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr, &startup, &process) != 0) {
        CloseHandle(process.hThread);
        process_ = reinterpret_cast<std::int64_t>(process.hProcess);
    }
    for (auto const& variable : environment) { SetEnvironmentVariableA(variable.first.c_str(), nullptr); }
}

Child::~Child() {
    if (process_ != 0) {
        kill();
        wait();
    }
}

void Child::kill() { TerminateProcess(handleOf(process_), KILLED); }

int Child::wait() {
    DWORD code = 0;
    if (WaitForSingleObject(handleOf(process_), LONGEST_WAIT_MS) != WAIT_OBJECT_0 ||
        GetExitCodeProcess(handleOf(process_), &code) == 0) {
        return -1;
    }
    CloseHandle(handleOf(process_));
    process_ = 0;
    return code == KILLED ? -1 : static_cast<int>(code);
}

std::string programBeside(std::string const& name) { return ownFolder() + "\\" + name + ".exe"; }

std::string libraryFile(std::string const& name) { return ownFolder() + "\\" + name + ".dll"; }

std::uint64_t peakMemory() {
    PROCESS_MEMORY_COUNTERS counters{};
    K32GetProcessMemoryInfo(GetCurrentProcess(), &counters, sizeof counters);
    return counters.PeakWorkingSetSize;
}

void setVariable(std::string const& name, std::string const& value) { _putenv((name + "=" + value).c_str()); }
