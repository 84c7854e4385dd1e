// The sibling is shell_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/system/shell.h"
#include "host/xos_basics/system/shell_line.h"

#include <cstdlib>
#include <string>

namespace host {

namespace {

constexpr std::int64_t DIRECTORY_FAILED = 1;

bool isDirectory(std::string const& path) {
    DWORD const attributes = GetFileAttributesA(path.c_str());
    return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
}

std::string interpreter() {
    char const* const configured = std::getenv("COMSPEC");
    return configured != nullptr && *configured != '\0' ? configured : "cmd.exe";
}

bool start(ShellLine const& line, PROCESS_INFORMATION& process) {
    // Between the outer quotes everything is the command's own.
    std::string arguments = "\"" + interpreter() + "\" /d /s /c \"" + line.command + "\"";
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    char const* const directory = line.directory.empty() ? nullptr : line.directory.c_str();
    return CreateProcessA(nullptr, arguments.data(), nullptr, nullptr, FALSE, CREATE_NO_WINDOW, nullptr, directory,
                          &startup, &process) != 0;
}

std::int64_t waitForExit(HANDLE process) {
    DWORD code = 0;
    WaitForSingleObject(process, INFINITE);
    GetExitCodeProcess(process, &code);
    return static_cast<std::int64_t>(code);
}

} // namespace

bool runInShell(char const* commandLine, std::int64_t* exitCode) {
    ShellLine const line = splitShellLine(commandLine);
    if (!line.directory.empty() && !isDirectory(line.directory)) {
        if (exitCode != nullptr) *exitCode = DIRECTORY_FAILED;
        return true;
    }
    PROCESS_INFORMATION process{};
    if (!start(line, process)) return false;
    if (exitCode != nullptr) *exitCode = waitForExit(process.hProcess);
    CloseHandle(process.hThread);
    CloseHandle(process.hProcess);
    return true;
}

} // namespace host
