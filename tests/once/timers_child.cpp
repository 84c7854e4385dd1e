// timers_child STEP...: the registry of timer managers from its very first use, each case in a process of its own.
//   mgr       TimerMgr::Mgr()
//   new       an active manager "child" with one timer
//   get       TimerMgr::Get("child"): prints "found" or "none"
//   rip=N     TimerMgr::setRip(N)
//   report    a report of the manager "child", if there is one: prints "report"
//   folder    where the last file was opened or the last directory made, as the platform layer recorded it
//   race      many threads use the registry for the first time: prints "one" if all got the same

#include <zor_basis/timers.h>

#include <xos_host.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

void make() {
    TimerMgr* const manager = TimerMgr::New("child", 0);
    manager->setActive(true);
    TimerMgr::create(manager, "timer", 0, false);
}

void report() {
    TimerMgr* const manager = TimerMgr::Get("child");
    if (manager == nullptr) return;
    manager->reset(true);
    std::puts("report");
}

void race() {
    constexpr std::size_t THREADS = 8;
    std::atomic<bool> go{false};
    std::vector<TimerMgrMgr*> found(THREADS);
    std::vector<std::thread> threads;
    for (TimerMgrMgr*& place : found) {
        threads.emplace_back([&go, &place] {
            while (!go) std::this_thread::yield();
            place = TimerMgr::Mgr();
        });
    }
    go = true;
    for (std::thread& thread : threads) thread.join();
    bool same = found[0] != nullptr;
    for (TimerMgrMgr const* one : found) same = same && one == found[0];
    std::puts(same ? "one" : "many");
}

void printFolder() {
    char const* const made = xos_HostLastCall("xos_DirCreateEx");
    std::printf("made %s\n", made != nullptr ? made : "nothing");
    char const* const opened = xos_HostLastCall("xos_FileOpen");
    std::printf("opened %s\n", opened != nullptr ? opened : "nothing");
}

} // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        char const* const step = argv[i];
        if (std::strcmp(step, "mgr") == 0) {
            TimerMgr::Mgr();
        } else if (std::strcmp(step, "new") == 0) {
            make();
        } else if (std::strcmp(step, "get") == 0) {
            std::puts(TimerMgr::Get("child") != nullptr ? "found" : "none");
        } else if (std::strncmp(step, "rip=", 4) == 0) {
            TimerMgr::setRip(std::atoi(step + 4));
        } else if (std::strcmp(step, "report") == 0) {
            report();
        } else if (std::strcmp(step, "folder") == 0) {
            printFolder();
        } else if (std::strcmp(step, "race") == 0) {
            race();
        } else {
            return 2;
        }
    }
    return 0;
}
