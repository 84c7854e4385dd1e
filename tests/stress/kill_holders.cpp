// Holders of a named mutex are killed while a thread of this process and another process wait for it.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"

#include "basis/platform/xos_basics.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/wait_for.h"

#include <atomic>
#include <cstdlib>

namespace stress {
namespace {

xos_Sem mutexOf(std::string const& id) { return xos_SemNamedMutexCreate(std::stoi(id), 0, 0, nullptr); }

/// hold ID MARK: takes the mutex twice, says so, and never gives it.
int hold(std::vector<std::string> const& arguments) {
    xos_Sem const mutex = mutexOf(arguments.at(0));
    if (xos_SemTake(mutex) != 0 || xos_SemTake(mutex) != 0) return 1;
    put(arguments.at(1), "held");
    std::this_thread::sleep_for(std::chrono::minutes(1));
    return 0;
}

/// count ID FILE: adds a byte to the file, under the mutex.
int count(std::vector<std::string> const& arguments) {
    xos_Sem const mutex = mutexOf(arguments.at(0));
    if (xos_SemTake(mutex) != 0) return 1;
    std::string const text = textOf(arguments.at(1));
    put(arguments.at(1), text + ".");
    return xos_SemGive(mutex);
}

void killHolder(std::string const& id, std::string const& folder, std::uint64_t kill, Findings& findings) {
    std::string const mark = folder + "/held";
    std::filesystem::remove(mark);
    Child holder{programBeside("stress"), {"--as", "hold", id, mark}};
    if (!findings.expect(waitFor([&] { return exists(mark); }), "the mutex was not taken")) return;
    Child contender{programBeside("stress"), {"--as", "count", id, folder + "/count"}};
    std::atomic<bool> isTaken{false};
    bool isHeld = false;
    std::thread waiter([&] {
        xos_Sem const mutex = mutexOf(id);
        if (xos_SemTake(mutex) == 0) isTaken = true;
        xos_SemGive(mutex);
    });
    std::this_thread::sleep_for(std::chrono::microseconds(100 * (kill % 20)));
    isHeld = !isTaken;
    holder.kill();
    if (!findings.expect(waitFor([&] { return isTaken.load(); }), "a thread hangs")) std::_Exit(1);
    waiter.join();
    findings.expect(isHeld, "the mutex was taken twice");
    findings.expect(contender.wait() == 0, "a process hangs or fails");
    findings.expect(textOf(folder + "/count").size() == kill + 1, "a process did not get the mutex");
}

} // namespace

void killHolders(std::uint64_t kills, Findings& findings) {
    Scratch const scratch(stressFolder());
    auto const now = std::chrono::system_clock::now().time_since_epoch().count();
    std::string const id = std::to_string(100'000 + static_cast<std::uint64_t>(now) % 1'000'000'000);
    for (std::uint64_t kill = 0; kill < kills; ++kill) killHolder(id, scratch.path(), kill, findings);
}

Roles holderRoles() { return {{"hold", hold}, {"count", count}}; }

} // namespace stress
