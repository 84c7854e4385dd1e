// The sibling is fault_rounds_posix.cpp. fault_rounds [NAME]: makes each call of the platform layer fail in every
// scenario, once at every index and from every index on. All rounds share one process, in which each scenario has
// succeeded before; allocations do not fail.

#include "tests/faults/round.h"
#include "tests/faults/scenario.h"
#include "tests/support/fallible_calls.h"
#include "tests/support/thread_facts.h"

#include <xos_host.h>

#include <cstdio>
#include <iterator>
#include <thread>

namespace {

constexpr std::uint32_t FOREVER = 0xFFFFFFFF;

struct Totals {
    std::uint64_t faults = 0, failed = 0, absorbed = 0, problems = 0;
};

class Driver {
public:
    /// The library asks for the root once.
    Driver() : root_(scratch_ / "system") { xos_HostSetRoot(root_.c_str()); }

    void drive(Scenario const& scenario);
    Totals const& totals() const { return totals_; }

private:
    Place newPlace(Scenario const& scenario);
    void complain(Scenario const& scenario, char const* call, std::uint32_t index, std::string const& what);
    /// \return whether the fault occurred
    bool tryFault(Scenario const& scenario, char const* call, std::uint32_t index, std::uint32_t times);
    bool actWith(Scenario const& scenario, char const* call, std::uint32_t index, std::uint32_t times,
                 std::string& broken);

    Scratch const scratch_;
    std::string const root_;
    Snapshot after_;
    Totals totals_;
    bool wasHit_ = false;
    int places_ = 0;
};

Place Driver::newPlace(Scenario const& scenario) {
    Place const place{scratch_ / std::to_string(places_++)};
    makeFolder(place.path);
    scenario.prepare(place);
    return place;
}

void Driver::complain(Scenario const& scenario, char const* call, std::uint32_t index, std::string const& what) {
    ++totals_.problems;
    std::printf("%s: %s %u: %s\n", scenario.name, call, index, what.c_str());
    std::fflush(stdout);
}

bool Driver::actWith(Scenario const& scenario, char const* call, std::uint32_t index, std::uint32_t times,
                     std::string& broken) {
    Place const place = newPlace(scenario);
    Snapshot const before = snapshotOf(place.path);
    xos_HostCallsReset();
    xos_HostFail(call, index, times);
    bool const succeeded = scenario.act(place);
    xos_HostFailClear();
    wasHit_ = xos_HostCalls(call) > index;
    broken = brokenPromise(scenario.promise, succeeded, false, before, after_, snapshotOf(place.path));
    std::error_code ignored;
    std::filesystem::remove_all(place.path, ignored);
    return succeeded;
}

bool Driver::tryFault(Scenario const& scenario, char const* call, std::uint32_t index, std::uint32_t times) {
    Growth handles([] { return static_cast<std::int64_t>(openHandles()); });
    bool succeeded = false;
    for (int i = 0; i < RUNS; ++i) {
        std::string broken;
        succeeded = actWith(scenario, call, index, times, broken);
        if (i == 0 && !wasHit_) return false;
        if (!broken.empty()) complain(scenario, call, index, broken);
        handles.look();
    }
    ++totals_.faults;
    ++(succeeded ? totals_.absorbed : totals_.failed);
    if (handles.isSteady()) complain(scenario, call, index, "a handle is lost");
    // On another thread, which would wait forever for a lock that was not given back.
    bool isUsable = false;
    std::thread([&] { isUsable = scenario.act(newPlace(scenario)); }).join();
    if (!isUsable) complain(scenario, call, index, "it fails afterwards without a fault");
    return true;
}

void Driver::drive(Scenario const& scenario) {
    Place const place = newPlace(scenario);
    if (!scenario.act(place)) return complain(scenario, "no call", 0, "it fails without a fault");
    after_ = snapshotOf(place.path);
    xos_HostCallsReset();
    scenario.act(newPlace(scenario));
    std::uint64_t calls[std::size(FALLIBLE_CALLS)];
    for (std::size_t i = 0; i < std::size(calls); ++i) calls[i] = xos_HostCalls(FALLIBLE_CALLS[i]);
    std::uint64_t const before = totals_.faults;
    for (std::size_t i = 0; i < std::size(calls); ++i) {
        if (calls[i] == 0 || FALLIBLE_CALLS[i] == LEFT_OUT) continue;
        for (std::uint32_t const times : {1U, FOREVER}) {
            if (times == FOREVER && scenario.without == Scenario::LASTING_FAULTS) continue;
            std::uint32_t index = 0;
            while (index < 2 * calls[i] + 10 && tryFault(scenario, FALLIBLE_CALLS[i], index, times)) ++index;
        }
    }
    std::printf("%-34s %6llu platform faults\n", scenario.name,
                static_cast<unsigned long long>(totals_.faults - before));
    std::fflush(stdout);
}

} // namespace

int main(int argc, char** argv) {
    std::string const wanted = argc > 1 ? argv[1] : "";
    Driver driver;
    for (Scenario const& scenario : allScenarios()) {
        if (std::string(scenario.name).find(wanted) != std::string::npos) driver.drive(scenario);
    }
    auto const number = [](std::uint64_t n) { return static_cast<unsigned long long>(n); };
    Totals const& totals = driver.totals();
    std::printf("%llu platform faults: %llu failures, %llu successes all the same, %llu problems\n",
                number(totals.faults), number(totals.failed), number(totals.absorbed), number(totals.problems));
    return totals.problems == 0 ? 0 : 1;
}
