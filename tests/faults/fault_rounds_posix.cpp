// The sibling is fault_rounds_win.cpp. fault_rounds [NAME]: makes each call of the platform layer and each allocation
// of every scenario fail, once at every index and from every index on. Each round has a process of its own.
//
// In a round the scenario runs some times with the fault, each time in a new folder. Its result has to be true: after a
// success the folder is as after a run without faults; after a failure every file in it has its former or its future
// content. Blocks and descriptors must not become more with every run. Finally the scenario has to succeed without
// faults on another thread, which would wait forever for a lock that was not given back. An abort is permitted if an
// allocation fails, and is counted; nothing else may end the process.

#include "tests/faults/allocations_posix.h"
#include "tests/faults/round.h"
#include "tests/faults/scenario.h"
#include "tests/support/fallible_calls.h"
#include "tests/support/memory_folder_posix.h"
#include "tests/support/thread_facts.h"

#include <xos_host.h>

#include <execinfo.h>
#include <sys/mman.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <iterator>
#include <map>
#include <new>
#include <string_view>
#include <thread>

namespace {

constexpr std::size_t CALLS = std::size(FALLIBLE_CALLS);
constexpr std::uint32_t FOREVER = 0xFFFFFFFF;
constexpr unsigned LONGEST_ROUND_S = 60;
constexpr int MOST_SHOWN = 4;

/// What fails in a round. \param call  an index of FALLIBLE_CALLS; -1: allocations; -2: nothing
struct Fault {
    int call;
    std::uint64_t index;
    bool lasts;
    /// The scenario has succeeded before, so that what is made at the first use exists.
    bool isLater;
};

/// What a round tells the process that started it, in memory that both have.
struct Report {
    std::uint64_t calls[CALLS];
    std::uint64_t allocations;
    bool wasHit;
    bool succeeded;
    char problem[400];
};

class Round {
public:
    Round(Scenario const& scenario, std::string const& folder, Report& report)
        : scenario_(scenario), folder_(folder), report_(report) {}

    /// In a process of its own. \return its exit code: 0 or 1, with a problem
    int run(Fault const& fault);
    /// Without faults; notes what could fail.
    int runToCount();

private:
    Place newPlace();
    bool act(Place const& place) const;
    bool actWith(Fault const& fault, Place const& place);
    bool isAsPromised(Place const& place, bool succeeded, Snapshot const& before);
    bool isStillUsable();
    bool complain(std::string const& what, std::string const& detail = "");

    Scenario const& scenario_;
    std::string const folder_;
    Report& report_;
    Snapshot after_;
    /// To remove a file takes memory too.
    bool canLeaveTemporary_ = false;
    int places_ = 0;
};

bool Round::complain(std::string const& what, std::string const& detail) {
    if (report_.problem[0] == '\0') {
        std::snprintf(report_.problem, sizeof report_.problem, "%s %s", what.c_str(), detail.c_str());
    }
    return false;
}

Place Round::newPlace() {
    Place const place{folder_ + "/" + std::to_string(places_++)};
    makeFolder(place.path);
    scenario_.prepare(place);
    return place;
}

bool Round::act(Place const& place) const {
    try {
        return scenario_.act(place);
    } catch (std::bad_alloc const&) { return false; }
}

void begin(Fault const& fault) {
    std::uint32_t const times = fault.lasts ? FOREVER : 1;
    if (fault.call >= 0) {
        xos_HostFail(FALLIBLE_CALLS[fault.call], static_cast<std::uint32_t>(fault.index), times);
    } else if (fault.call == -1) {
        allocations::failFrom(fault.index, times);
    }
}

bool Round::actWith(Fault const& fault, Place const& place) {
    xos_HostCallsReset();
    begin(fault);
    bool const succeeded = act(place);
    std::uint64_t const allocated = allocations::stopFailing();
    xos_HostFailClear();
    std::uint64_t const reached = fault.call >= 0 ? xos_HostCalls(FALLIBLE_CALLS[fault.call]) : allocated;
    if (fault.call != -2 && reached > fault.index) report_.wasHit = true;
    return succeeded;
}

bool Round::isAsPromised(Place const& place, bool succeeded, Snapshot const& before) {
    std::string const broken =
        brokenPromise(scenario_.promise, succeeded, canLeaveTemporary_, before, after_, snapshotOf(place.path));
    return broken.empty() || complain(broken);
}

bool Round::isStillUsable() {
    bool succeeded = false;
    std::thread([&] { succeeded = act(newPlace()); }).join();
    return succeeded || complain("it fails afterwards without a fault");
}

int Round::run(Fault const& fault) {
    canLeaveTemporary_ = fault.call == -1 && fault.lasts;
    // The future content, found without the process's first uses.
    pid_t const helper = ::fork();
    if (helper == 0) {
        Place const place{folder_ + "/after"};
        makeFolder(place.path);
        scenario_.prepare(place);
        ::_exit(act(place) ? 0 : 1);
    }
    int status = 0;
    ::waitpid(helper, &status, 0);
    after_ = snapshotOf(folder_ + "/after");
    if (fault.isLater && !act(newPlace())) return complain("it fails without a fault"), 1;
    Growth blocks(allocations::living);
    Growth handles([] { return static_cast<std::int64_t>(openHandles()); });
    for (int i = 0; i < RUNS; ++i) {
        bool succeeded = false;
        {
            Place const place = newPlace();
            Snapshot const before = snapshotOf(place.path);
            succeeded = actWith(fault, place);
            if (!isAsPromised(place, succeeded, before)) return 1;
        }
        if (i == 0) report_.succeeded = succeeded;
        blocks.look();
        handles.look();
    }
    if (blocks.isSteady()) return complain("memory is lost"), 1;
    if (handles.isSteady()) return complain("a descriptor is lost"), 1;
    return isStillUsable() ? 0 : 1;
}

int Round::runToCount() {
    Place const place = newPlace();
    xos_HostCallsReset();
    allocations::failFrom(0, 0);
    bool const succeeded = act(place);
    report_.allocations = allocations::stopFailing();
    for (std::size_t i = 0; i < CALLS; ++i) report_.calls[i] = xos_HostCalls(FALLIBLE_CALLS[i]);
    return succeeded ? 0 : 1;
}

/// The totals of all rounds.
struct Totals {
    std::uint64_t platform = 0, allocation = 0, failed = 0, absorbed = 0, aborted = 0, problems = 0;
    std::map<std::string, std::uint64_t> aborts;
};

class Driver {
public:
    Driver()
        : report_(*static_cast<Report*>(
              ::mmap(nullptr, sizeof(Report), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0))),
          scratch_(memoryFolder()) {}

    void drive(Scenario const& scenario);
    int tell() const;

private:
    /// Runs something in a process of its own. \return how that ended, as `waitpid` says
    template <class Run>
    int apart(Run const& run);
    /// \return whether the fault occurred
    bool tryFault(Scenario const& scenario, Fault const& fault);
    void judge(Scenario const& scenario, Fault const& fault, int status);
    void eachIndex(Scenario const& scenario, int call, std::uint64_t expected);

    Report& report_;
    Scratch scratch_;
    Totals totals_;
    /// Problems of the present call of the present scenario.
    int shown_ = 0;
};

/// Shows where a round has crashed. `addr2line` makes lines of it.
void showPlace(int signal) {
    void* places[32];
    ::backtrace_symbols_fd(places, ::backtrace(places, 32), STDERR_FILENO);
    ::signal(signal, SIG_DFL);
    ::raise(signal);
}

template <class Run>
int Driver::apart(Run const& run) {
    report_ = Report{};
    std::string const folder = scratch_ / "round";
    makeFolder(folder);
    pid_t const child = ::fork();
    if (child == 0) {
        rlimit const noCore{0, 0};
        ::setrlimit(RLIMIT_CORE, &noCore);
        ::alarm(LONGEST_ROUND_S);
        // Without a root, files lie in the working folder.
        if (::chdir(folder.c_str()) != 0) ::_exit(2);
        ::signal(SIGSEGV, showPlace);
        ::_exit(run(folder));
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    std::filesystem::remove_all(folder);
    return status;
}

void Driver::judge(Scenario const& scenario, Fault const& fault, int status) {
    bool const isAllocation = fault.call == -1;
    if (WIFSIGNALED(status) && WTERMSIG(status) == SIGABRT && isAllocation) {
        ++totals_.aborted;
        ++totals_.aborts[scenario.name];
        return;
    }
    if (WIFEXITED(status) && WEXITSTATUS(status) == 0) {
        ++(report_.succeeded ? totals_.absorbed : totals_.failed);
        return;
    }
    ++totals_.problems;
    if (++shown_ > MOST_SHOWN) return;
    std::string const what = WIFSIGNALED(status) ? ::strsignal(WTERMSIG(status)) : report_.problem;
    std::printf("%s: %s %llu%s%s: %s\n", scenario.name, isAllocation ? "allocation" : FALLIBLE_CALLS[fault.call],
                static_cast<unsigned long long>(fault.index), fault.lasts ? " and on" : "",
                fault.isLater ? ", later" : "", what.c_str());
    std::fflush(stdout);
}

bool Driver::tryFault(Scenario const& scenario, Fault const& fault) {
    int const status = apart([&](std::string const& folder) { return Round(scenario, folder, report_).run(fault); });
    bool const ended = WIFEXITED(status) && WEXITSTATUS(status) == 0;
    if (ended && !report_.wasHit) return false;
    ++(fault.call == -1 ? totals_.allocation : totals_.platform);
    judge(scenario, fault, status);
    return true;
}

void Driver::eachIndex(Scenario const& scenario, int call, std::uint64_t expected) {
    shown_ = 0;
    if (call == -1 && scenario.without == Scenario::ALLOCATION_FAULTS) return;
    for (bool const isLater : {false, true}) {
        for (bool const lasts : {false, true}) {
            if (lasts && scenario.without == Scenario::LASTING_FAULTS) continue;
            std::uint64_t index = 0;
            while (index < 2 * expected + 10 && tryFault(scenario, {call, index, lasts, isLater})) ++index;
        }
    }
}

void Driver::drive(Scenario const& scenario) {
    int const status = apart([&](std::string const& folder) { return Round(scenario, folder, report_).runToCount(); });
    if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
        ++totals_.problems;
        std::printf("%s: it fails without a fault\n", scenario.name);
        return;
    }
    Report const counted = report_;
    Totals const before = totals_;
    for (std::size_t i = 0; i < CALLS; ++i) {
        if (counted.calls[i] != 0 && FALLIBLE_CALLS[i] != LEFT_OUT)
            eachIndex(scenario, static_cast<int>(i), counted.calls[i]);
    }
    eachIndex(scenario, -1, counted.allocations);
    std::printf("%-34s %6llu platform faults %6llu allocation faults\n", scenario.name,
                static_cast<unsigned long long>(totals_.platform - before.platform),
                static_cast<unsigned long long>(totals_.allocation - before.allocation));
    std::fflush(stdout);
}

int Driver::tell() const {
    auto const number = [](std::uint64_t n) { return static_cast<unsigned long long>(n); };
    std::printf("%llu platform faults, %llu allocation faults: %llu failures, %llu successes all the same, "
                "%llu aborts for want of memory, %llu problems\n",
                number(totals_.platform), number(totals_.allocation), number(totals_.failed), number(totals_.absorbed),
                number(totals_.aborted), number(totals_.problems));
    for (auto const& [name, count] : totals_.aborts) std::printf("aborts: %s %llu\n", name.c_str(), number(count));
    return totals_.problems == 0 ? 0 : 1;
}

} // namespace

int main(int argc, char** argv) {
    std::string const wanted = argc > 1 ? argv[1] : "";
    void* first[1];
    ::backtrace(first, 1); // loads what it needs
    Driver driver;
    bool isKnown = false;
    for (Scenario const& scenario : allScenarios()) {
        if (std::string(scenario.name).find(wanted) == std::string::npos) continue;
        isKnown = true;
        driver.drive(scenario);
    }
    if (isKnown) return driver.tell();
    std::printf("There is no scenario %s. There are:\n", wanted.c_str());
    for (Scenario const& scenario : allScenarios()) std::printf("%s\n", scenario.name);
    return 2;
}
