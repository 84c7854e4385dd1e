// The sibling is child_win.cpp.

#include "tests/host/support/child.h"

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace {

std::vector<char*> pointers(Words& words) {
    std::vector<char*> result;
    for (std::string& word : words) { result.push_back(word.data()); }
    result.push_back(nullptr);
    return result;
}

std::filesystem::path ownFolder() { return std::filesystem::read_symlink("/proc/self/exe").parent_path(); }

} // namespace

Child::Child(std::string const& program, Words const& arguments, Environment const& environment) {
    Words words{program};
    words.insert(words.end(), arguments.begin(), arguments.end());
    Words variables;
    for (auto const& [name, value] : environment) { variables.push_back(name + "=" + value); }
    for (char** variable = environ; *variable != nullptr; ++variable) { variables.emplace_back(*variable); }
    pid_t child = 0;
    if (posix_spawn(&child, program.c_str(), nullptr, nullptr, pointers(words).data(), pointers(variables).data()) ==
        0) {
        process_ = child;
    }
}

Child::~Child() {
    if (process_ != 0) {
        kill();
        wait();
    }
}

void Child::kill() { ::kill(static_cast<pid_t>(process_), SIGKILL); }

int Child::wait() {
    auto const end = std::chrono::steady_clock::now() + std::chrono::seconds{30};
    while (std::chrono::steady_clock::now() < end) {
        int status = 0;
        if (waitpid(static_cast<pid_t>(process_), &status, WNOHANG) == process_) {
            process_ = 0;
            return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds{1});
    }
    return -1;
}

std::string programBeside(std::string const& name) { return (ownFolder() / name).string(); }

std::string libraryFile(std::string const& name) {
    return (ownFolder().parent_path() / "lib" / ("lib" + name + ".so")).string();
}

std::uint64_t peakMemory() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<std::uint64_t>(usage.ru_maxrss) * 1024;
}

void setVariable(std::string const& name, std::string const& value) {
    if (value.empty()) {
        unsetenv(name.c_str());
    } else {
        setenv(name.c_str(), value.c_str(), 1);
    }
}
