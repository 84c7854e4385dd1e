// The sibling is child_posix.cpp.

#include "tests/support/child.h"

#include "basis/platform/windows_api_win.h"

#include <map>

namespace {

std::string quoted(std::string const& argument) {
    std::string text = "\"";
    std::size_t backslashes = 0;
    for (char c : argument) {
        if (c == '"') text.append(backslashes + 1, '\\');
        backslashes = c == '\\' ? backslashes + 1 : 0;
        text.push_back(c);
    }
    return text.append(backslashes, '\\') + "\"";
}

/// This process's environment with the child's changes, as `CreateProcess` takes it.
std::string environmentOf(Child const& child) {
    std::map<std::string, std::string> variables;
    char* const block = GetEnvironmentStringsA();
    for (char const* entry = block; *entry != '\0'; entry += std::string(entry).size() + 1) {
        std::string const text = entry;
        std::size_t const equals = text.find('=', 1);
        if (equals != std::string::npos) variables[text.substr(0, equals)] = text.substr(equals + 1);
    }
    FreeEnvironmentStringsA(block);
    for (auto const& [name, value] : child.environment) {
        if (value.empty()) {
            variables.erase(name);
        } else {
            variables[name] = value;
        }
    }
    std::string text;
    for (auto const& [name, value] : variables) text += name + "=" + value + '\0';
    return text + '\0';
}

std::string readAll(HANDLE pipe) {
    std::string text;
    char buffer[4096];
    for (DWORD n = 0; ReadFile(pipe, buffer, sizeof buffer, &n, nullptr) && n > 0;) text.append(buffer, n);
    std::string lines;
    for (char c : text) {
        if (c != '\r') lines.push_back(c);
    }
    return lines;
}

/// A file as one of a child's streams, closed at the end of the scope; without a name the stream of this process.
class Stream {
public:
    Stream(std::string const& name, DWORD access, DWORD creation, DWORD standard) : isOwn_(!name.empty()) {
        SECURITY_ATTRIBUTES inherited{sizeof(SECURITY_ATTRIBUTES), nullptr, TRUE};
        handle_ = isOwn_ ? CreateFileA(name.c_str(), access, FILE_SHARE_READ, &inherited, creation, 0, nullptr)
                         : GetStdHandle(standard);
    }
    ~Stream() {
        if (isOwn_) CloseHandle(handle_);
    }
    Stream(Stream const&) = delete;
    Stream& operator=(Stream const&) = delete;

    HANDLE get() const { return handle_; }

private:
    bool isOwn_;
    HANDLE handle_;
};

/// Wine gives up a process that does not come up within seconds, as may happen on a busy machine.
constexpr int ATTEMPTS_TO_START = 3;

/// Starts a process that writes to the end of a pipe.
bool start(Child const& child, HANDLE output, PROCESS_INFORMATION& process) {
    std::string const program = programBeside(child.program);
    std::string commandLine = quoted(program);
    for (std::string const& argument : child.arguments) commandLine += " " + quoted(argument);
    std::string environment = environmentOf(child);
    Stream const input(child.inputFile, GENERIC_READ, OPEN_EXISTING, STD_INPUT_HANDLE);
    Stream const errors(child.errorFile, GENERIC_WRITE, CREATE_ALWAYS, STD_ERROR_HANDLE);
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdInput = input.get();
    startup.hStdOutput = output;
    startup.hStdError = errors.get();
    char const* const folder = child.folder.empty() ? nullptr : child.folder.c_str();
    for (int attempt = 1; attempt <= ATTEMPTS_TO_START; ++attempt) {
        if (CreateProcessA(program.c_str(), commandLine.data(), nullptr, nullptr, TRUE, 0, environment.data(), folder,
                           &startup, &process) != 0) {
            return true;
        }
        if (GetLastError() != ERROR_INTERNAL_ERROR) return false;
    }
    return false;
}

} // namespace

std::string programBeside(std::string const& name) {
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, MAX_PATH);
    std::string const own = path;
    return own.substr(0, own.find_last_of("\\/") + 1) + name + ".exe";
}

ChildResult run(Child const& child) {
    SECURITY_ATTRIBUTES inherited{sizeof(SECURITY_ATTRIBUTES), nullptr, TRUE};
    HANDLE readEnd = nullptr;
    HANDLE writeEnd = nullptr;
    if (!CreatePipe(&readEnd, &writeEnd, &inherited, 0)) return {};
    SetHandleInformation(readEnd, HANDLE_FLAG_INHERIT, 0);
    PROCESS_INFORMATION process{};
    bool const started = start(child, writeEnd, process);
    DWORD const reason = GetLastError();
    CloseHandle(writeEnd);
    ChildResult result;
    if (!started) result.output = "not started, error " + std::to_string(reason);
    if (started) {
        result.output = readAll(readEnd);
        WaitForSingleObject(process.hProcess, INFINITE);
        DWORD code = 0;
        if (GetExitCodeProcess(process.hProcess, &code)) result.exitCode = static_cast<int>(code);
        CloseHandle(process.hThread);
        CloseHandle(process.hProcess);
    }
    CloseHandle(readEnd);
    return result;
}
