// The sibling is process_win.cpp.

#include "basis/system/process_impl.h"

#include "basis/files/last_error.h"
#include "basis/files/os_path_posix.h"
#include "basis/system/command_line.h"
#include "basis/system/process_calls_posix.h"
#include "basis/system/unawaited_posix.h"

#include <cerrno>
#include <climits>
#include <csignal>

#include <dlfcn.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace ZOR_Basis {
namespace {

// The C library's declarations of these two cannot be used from C++ everywhere.
int openProcess(pid_t process) { return static_cast<int>(syscall(SYS_pidfd_open, process, 0)); }
int signalDescriptor(int process, int signal) {
    return static_cast<int>(syscall(SYS_pidfd_send_signal, process, signal, nullptr, 0));
}

} // namespace

ProcessCalls processCalls{posix_spawn, posix_spawnp, waitid, openProcess, poll, signalDescriptor, kill, close};

namespace {

constexpr int SIGNALLED = 128;
constexpr int WITHOUT_LIMIT = -1;
/// Where a program is looked for.
constexpr bool ALONG_THE_PATH = true;
constexpr bool AS_NAMED = false;
constexpr std::size_t MOST_UNAWAITED = 4096;

/// Collects an ended child from the system. \return false if it is not, or no longer, a child of this process
bool takeEnd(idtype_t kind, int process, int flags, siginfo_t& end) {
    while (processCalls.waitFor(kind, static_cast<id_t>(process), &end, WEXITED | flags) != 0) {
        if (errno != EINTR) return false;
    }
    return true;
}

/// Also true if another caller has already collected it.
bool giveUp(pid_t child) {
    siginfo_t end{};
    return !takeEnd(P_PID, child, WNOHANG, end) || end.si_pid != 0;
}

constinit Unawaited<MOST_UNAWAITED, giveUp> unawaited;

/// The standard descriptors and no blocked signals.
class SpawnSettings {
public:
    SpawnSettings() {
        posix_spawn_file_actions_init(&actions_);
        error_ = posix_spawn_file_actions_addclosefrom_np(&actions_, STDERR_FILENO + 1);
        posix_spawnattr_init(&attributes_);
        sigset_t none;
        sigemptyset(&none);
        posix_spawnattr_setsigmask(&attributes_, &none);
        posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSIGMASK);
    }
    SpawnSettings(SpawnSettings const&) = delete;
    SpawnSettings& operator=(SpawnSettings const&) = delete;
    ~SpawnSettings() {
        KeepLastError const keep;
        posix_spawnattr_destroy(&attributes_);
        posix_spawn_file_actions_destroy(&actions_);
    }

    bool start(char const* program, bool search, char* const* words, pid_t& child) const {
        auto const spawn = search ? processCalls.spawnFromPath : processCalls.spawn;
        // These report failure by their results only.
        int const error =
            error_ != 0 ? error_ : spawn(&child, OsPath(program), &actions_, &attributes_, words, environ);
        if (error != 0) errno = error;
        return error == 0;
    }

private:
    posix_spawn_file_actions_t actions_;
    posix_spawnattr_t attributes_;
    int error_;
};

/// A process that was found by its identifier.
class OpenProcess {
public:
    explicit OpenProcess(pid_t process) : descriptor_(processCalls.openProcess(process)) {}
    OpenProcess(OpenProcess const&) = delete;
    OpenProcess& operator=(OpenProcess const&) = delete;
    ~OpenProcess() {
        if (!isOpen()) return;
        KeepLastError const keep;
        processCalls.close(descriptor_);
    }

    bool isOpen() const { return descriptor_ >= 0; }

    bool hasEnded(int timeoutMs) const {
        pollfd wanted{descriptor_, POLLIN, 0};
        int ready = 0;
        while ((ready = processCalls.awaitDescriptor(&wanted, 1, timeoutMs)) < 0 && errno == EINTR) {}
        return ready > 0;
    }

    /// Collects an ended child, which would otherwise remain in the process table.
    void takeLeftovers() const {
        siginfo_t end{};
        takeEnd(P_PIDFD, descriptor_, WNOHANG, end);
    }

    bool kill() const { return processCalls.signalDescriptor(descriptor_, SIGKILL) == 0; }

private:
    int const descriptor_;
};

/// 0, which is no process, for a number that cannot be one.
pid_t processOf(unsigned long processId) { return processId <= INT_MAX ? static_cast<pid_t>(processId) : 0; }

bool start(char const* application, char const* commandLine, pid_t& child) {
    SpawnSettings const settings;
    if (detail::isNothing(commandLine)) {
        char* const words[] = {const_cast<char*>(application), nullptr};
        return settings.start(application, AS_NAMED, words, child);
    }
    // Blanks before the name of a program do not make an empty name.
    if (application == nullptr) commandLine += std::strspn(commandLine, " \t");
    CommandLine const line(commandLine);
    if (line.words() == nullptr) return refuse(Reason::NO_MEMORY);
    return application != nullptr ? settings.start(application, AS_NAMED, line.words(), child)
                                  : settings.start(line.words()[0], ALONG_THE_PATH, line.words(), child);
}

/// \param take  collects the child afterwards; otherwise that is left to the application, which made it
bool awaitEnd(pid_t process, bool take) {
    OpenProcess const open(process);
    if (!open.isOpen()) {
        // Children can be awaited without a descriptor.
        siginfo_t end{};
        return errno == ENOSYS && takeEnd(P_PID, process, take ? 0 : WNOWAIT, end);
    }
    if (!open.hasEnded(WITHOUT_LIMIT)) return false;
    if (take) open.takeLeftovers();
    return true;
}

} // namespace

bool ProcessImpl::create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode) {
    pid_t child = 0;
    if (!start(application, commandLine, child)) return false;
    if (processId != nullptr) {
        *processId = static_cast<unsigned long>(child);
        unawaited.add(child);
        return true;
    }
    siginfo_t end{};
    if (takeEnd(P_PID, child, 0, end) && exitCode != nullptr)
        *exitCode = end.si_code == CLD_EXITED ? end.si_status : SIGNALLED + end.si_status;
    return true;
}

bool ProcessImpl::wait(unsigned long processId) {
    pid_t const process = processOf(processId);
    if (process == 0) return refuse(Reason::NO_PROCESS);
    bool const isOurs = unawaited.remove(process);
    bool const hasEnded = awaitEnd(process, isOurs);
    bool const isGone = errno == ESRCH || errno == ECHILD;
    KeepLastError const whyNotEnded;
    if (isOurs && !hasEnded && !isGone) unawaited.add(process);
    return hasEnded;
}

bool ProcessImpl::terminate(unsigned long processId) {
    pid_t const process = processOf(processId);
    if (process == 0) return refuse(Reason::NO_PROCESS);
    OpenProcess const open(process);
    if (!open.isOpen()) return errno == ENOSYS && processCalls.signalProcess(process, SIGKILL) == 0;
    if (open.hasEnded(0)) return refuse(Reason::NO_PROCESS);
    return open.kill();
}

void* ProcessImpl::findFunction(void* module, char const* name) {
    void* const function = dlsym(module, name);
    if (function == nullptr) refuse(Reason::NOT_FOUND);
    return function;
}

} // namespace ZOR_Basis
