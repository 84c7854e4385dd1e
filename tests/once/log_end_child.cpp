// log_end_child HOW: logs LINES numbered lines and ends. HOW it ends:
//   return    main returns, the log's destructor has run
//   open      main returns, the log is never destroyed
//   session   as open, with every hundredth line beginning a new session
//   static    as open, the last line comes from the destructor of a static object
//   thread    a thread calls exit while main sleeps
//   busy      main calls exit while other threads log to the same log and to others
//   sudden    by _Exit, which is no normal end

#include <zor_basis/log.h>

#include <chrono>
#include <cstdlib>
#include <string>
#include <thread>

using namespace ZOR_Basis;

namespace {

constexpr int LINES = 2001;

/// Never destroyed.
Log* kept = nullptr;
Log* others[2] = {};
bool isLoggedToAtTheEnd = false;

struct Latecomer {
    ~Latecomer() {
        if (isLoggedToAtTheEnd) kept->out("line %d", LINES + 1);
    }
} const latecomer;

void logLines(Log& log, bool inSessions = false) {
    for (int i = 1; i <= LINES; ++i) {
        if (inSessions && i % 100 == 0) log.newSession();
        log.out("line %d", i);
    }
}

[[noreturn]] void sleepForEver() {
    for (;;) std::this_thread::sleep_for(std::chrono::seconds(1));
}

[[noreturn]] void exitInThread(Log& log) {
    std::thread([&log] {
        logLines(log);
        std::exit(0);
    }).detach();
    sleepForEver();
}

void logForEver(Log& log) {
    std::thread([&log] {
        for (;;) log.out("other");
    }).detach();
}

void exitAmongBusyThreads(Log& log) {
    logForEver(log);
    for (Log*& other : others) logForEver(*(other = new Log("other")));
    logLines(log);
    std::exit(0);
}

} // namespace

int main(int argc, char** argv) {
    std::string const how = argc > 1 ? argv[1] : "";
    if (how == "return") {
        Log log("child");
        logLines(log);
        return 0;
    }
    kept = new Log("child");
    if (how == "thread") exitInThread(*kept);
    if (how == "busy") exitAmongBusyThreads(*kept);
    isLoggedToAtTheEnd = how == "static";
    logLines(*kept, how == "session");
    if (how == "sudden") std::_Exit(0);
    return 0;
}
