// flags_child STEP...: the mode flags from their very first use, each case in a process of its own. Prints one line a
// step.
//   set loaded vdp vps qdb vipp ppml    calls the function of that name and prints its result
//   config=FOLDER                       where the configuration is from now on
//   calls                               the loads, readings and releases so far
//   last                                the arguments of the last load, and the keys of the last reading
//   race                                many threads ask for VIPP simultaneously: prints their results in order

#include <zor_basis/flat.h>

#include <xos_host.h>

#include <atomic>
#include <cstdio>
#include <cstring>
#include <thread>
#include <vector>

namespace {

struct Function {
    char const* name;
    int (*call)();
};

constexpr Function FUNCTIONS[] = {{"set", setVDPFlagsFromCFG},
                                  {"loaded", isVDPFlagsSetFromCFG},
                                  {"vdp", isVDPON},
                                  {"vps", isVPSON},
                                  {"qdb", isQDBON},
                                  {"vipp", isVIPPON},
                                  {"ppml", isPPMLON}};

bool callFunction(char const* step) {
    for (Function const& function : FUNCTIONS) {
        if (std::strcmp(step, function.name) != 0) continue;
        std::printf("%d\n", function.call());
        return true;
    }
    return false;
}

void printCalls() {
    std::printf("%d loads, %d readings, %d releases\n", static_cast<int>(xos_HostCalls("cfg_GroupLoadFromFile")),
                static_cast<int>(xos_HostCalls("cfg_KeyGetOpt_Bool")),
                static_cast<int>(xos_HostCalls("cfg_GroupDelete")));
}

void printLast() {
    std::printf("load %s\n", xos_HostLastCall("cfg_GroupLoadFromFile"));
    char const* const reading = xos_HostLastCall("cfg_KeyGetOpt_Bool");
    if (reading != nullptr) std::printf("reading %s\n", std::strchr(reading, ' ') + 1);
    char const* const release = xos_HostLastCall("cfg_GroupDelete");
    if (release != nullptr) std::printf("release %s\n", std::strchr(release, ' ') + 1);
}

void race() {
    std::atomic<bool> go{false};
    std::vector<int> results(8, -1);
    std::vector<std::thread> threads;
    for (int& result : results) {
        threads.emplace_back([&go, &result] {
            while (!go) std::this_thread::yield();
            result = isVIPPON();
        });
    }
    go = true;
    for (std::thread& thread : threads) thread.join();
    for (int const result : results) std::printf("%d", result);
    std::puts("");
}

} // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        if (callFunction(argv[i])) continue;
        if (std::strncmp(argv[i], "config=", 7) == 0) {
            xos_HostSetConfigDir(argv[i] + 7);
        } else if (std::strcmp(argv[i], "calls") == 0) {
            printCalls();
        } else if (std::strcmp(argv[i], "last") == 0) {
            printLast();
        } else if (std::strcmp(argv[i], "race") == 0) {
            race();
        } else {
            return 2;
        }
    }
    return 0;
}
