// ending_child HOW: uses the library before and after main.
//   begin   prints which functions of the platform layer were called before main
//   end     three threads use the library while main returns and a static object uses it in its destructor
//   pause   the same, but the threads end before the static object does

#include "host/xos_basics/control/functions.h"

#include <zor_basis/log.h>
#include <zor_basis/memory.h>
#include <zor_basis/system.h>
#include <zor_basis/timers.h>

#include <xos_host.h>

#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Never destroyed: it owns threads that may not be joined, and they use it.
struct Tools {
    Log log{"ending"};
    TimerMgr* timers = TimerMgr::New("ending", 4);
    std::vector<std::thread> threads;
};
Tools* tools = nullptr;
constexpr int THREADS = 3;
std::atomic<bool> mustEnd{false};
bool threadsEnd = false;

void useAll(std::uint64_t timer) {
    tools->log.out("line of %d", static_cast<int>(timer));
    TimerMgr::start(tools->timers, timer);
    FPath const temp = Sys::temp();
    {
        VDPTempDir const folder;
        if (!folder.status() || folder.path().size() <= temp.size()) std::_Exit(3);
    }
    MemMgr* const small = MemMgr::makeSmlBlk(16, 4, 64, 8);
    small->free(small->alloc());
    delete small;
    MemMgr* const standard = MemMgr::makeStd();
    standard->free(standard->alloc(100), 100);
    TimerMgr::stop(tools->timers, timer);
}

void endThreads() {
    mustEnd = true;
    for (std::thread& thread : tools->threads) thread.join();
}

/// In the destructor of a static object.
struct LastUser {
    ~LastUser() {
        if (tools == nullptr) return;
        auto const end = std::chrono::steady_clock::now() + std::chrono::milliseconds(100);
        while (std::chrono::steady_clock::now() < end) useAll(4);
        if (threadsEnd) endThreads();
        std::puts("used to the end");
        std::fflush(stdout);
    }
} const lastUser;

void useInThreads() {
    tools = new Tools;
    tools->timers->setActive(true);
    for (std::uint64_t timer : {1, 2, 3, 4}) TimerMgr::create(tools->timers, "stage", timer, true);
    for (std::uint64_t timer = 1; timer <= THREADS; ++timer) {
        tools->threads.emplace_back([timer] {
            while (!mustEnd) useAll(timer);
        });
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
}

void printCalls() {
    for (host::FunctionFacts const& function : host::FUNCTIONS) {
        std::string const name{function.name};
        if (xos_HostCalls(name.c_str()) != 0) std::puts(name.c_str());
    }
    std::puts("no other");
}

} // namespace

int main(int argc, char** argv) {
    std::string const how = argc > 1 ? argv[1] : "";
    threadsEnd = how == "pause";
    if (how == "begin") {
        printCalls();
    } else {
        useInThreads();
    }
    return 0;
}
