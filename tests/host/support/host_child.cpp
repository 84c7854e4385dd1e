// What tests need a process of their own for. host_child VERB [ARGUMENTS]: the exit code is the answer, or the answer
// is written to a file.

#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/support/scratch.h"

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <thread>

namespace {

constexpr int BAD_VERB = 99;

void takeNamed(char const* id) {
    static std::uint32_t word = 0;
    xos_SemTake(xos_SemNamedMutexCreate(std::atoi(id), 0, 0, &word));
}

void giveNamed(char const* id) { xos_SemGive(xos_SemNamedMutexCreate(std::atoi(id), 0, 0, nullptr)); }

/// hold ID MARK: takes the mutex twice, says so, and never gives it.
int hold(char** arguments) {
    takeNamed(arguments[0]);
    takeNamed(arguments[0]);
    put(arguments[1], "held");
    std::this_thread::sleep_for(std::chrono::minutes{1});
    return 0;
}

/// count ID FILE TIMES: adds 1 to the number in the file, so many times, each under the mutex.
int count(char** arguments) {
    for (int i = 0; i < std::atoi(arguments[2]); ++i) {
        takeNamed(arguments[0]);
        put(arguments[1], std::to_string(std::stoi(textOf(arguments[1])) + 1));
        giveNamed(arguments[0]);
    }
    return 0;
}

/// root FILE: writes what the environment says the root is.
int root(char** arguments) {
    put(arguments[0], xos_FileSystemRoot());
    return 0;
}

/// switch GROUP KEY FALLBACK: the value of a switch; 98 when there is no such group.
int switchValue(char** arguments) {
    cfg_Group* const group = cfg_GroupLoadFromFile(arguments[0], 0, 0, 0);
    if (group == nullptr) return 98;
    int const value = cfg_KeyGetOpt_Bool(group, arguments[1], std::atoi(arguments[2]));
    cfg_GroupDelete(group, 0);
    return value;
}

/// failures FILE: writes how six creations of a mutex and three of an alert went, + good and - failed.
int failures(char** arguments) {
    std::string results;
    for (int i = 0; i < 6; ++i) { results += xos_SemMCreate() != 0 ? '+' : '-'; }
    for (int i = 0; i < 3; ++i) {
        auto* const never = +[](HQ_Basis::AlertTimer::Alert const&) { return std::uint32_t{60'000}; };
        results += HQ_Basis::AlertTimer::New(60'000, never, nullptr) != 0 ? '+' : '-';
    }
    put(arguments[0], results);
    return 0;
}

[[noreturn]] void stayForEver() {
    for (;;) { std::this_thread::sleep_for(std::chrono::hours{1}); }
}

/// stuck: ends while an alert and a task never return.
int stuck(char**) {
    static std::atomic<int> entered{0};
    auto const callback = +[](HQ_Basis::AlertTimer::Alert const&) -> std::uint32_t {
        ++entered;
        stayForEver();
    };
    HQ_Basis::AlertTimer::New(1, callback, nullptr);
    xos_TaskParams params{};
    params.entry = +[](void*) {
        ++entered;
        stayForEver();
    };
    xos_TaskCreate(&params);
    while (entered != 2) { std::this_thread::sleep_for(std::chrono::milliseconds{1}); }
    return 7;
}

struct Verb {
    char const* name;
    int arguments;
    int (*run)(char**);
};

constexpr Verb VERBS[] = {{"hold", 2, hold},          {"count", 3, count},       {"root", 1, root},
                          {"switch", 3, switchValue}, {"failures", 1, failures}, {"stuck", 0, stuck}};

} // namespace

int main(int count, char** arguments) {
    for (Verb const& verb : VERBS) {
        if (count == verb.arguments + 2 && arguments[1] == std::string(verb.name)) return verb.run(arguments + 2);
    }
    return BAD_VERB;
}
