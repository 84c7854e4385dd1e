// root_child PLAN...: what depends on the root folder, each case in a process of its own. Prints one line a step.
//   root SEARCH     Sys::root(), between "<" and ">"
//   root2           the same again
//   temp            Sys::temp()
//   copy            Sys::root(out) and its result
//   fake PATH       whether the path is fake, and its translation, narrow
//   wide PATH       the same, wide
//   pathroot        WcPath::pathRoot
//   set PATH        makes it WcPath::pathRoot
//   clear           empties that
//   ask             what many threads get for Sys::root() simultaneously, and how often the platform layer was asked
//   race EXPECTED   translates "/scsi0", wide, in many threads, and prints how many results differ
//   refill EXPECTED the same again and again, each time with WcPath::pathRoot emptied before

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>
#include <zor_basis/system/sys.h>
#include <zor_basis/text/convert.h>

#include <xos_host.h>

#include <atomic>
#include <cstdio>
#include <cstring>
#include <set>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

void print(Str const& text) { std::printf("<%s>\n", text.c_str()); }

void print(WStr const& text) {
    BufStr<255> narrow;
    Convert::WideToUtf8(text, narrow);
    print(narrow);
}

void narrow(char const* text) {
    FPath inPlace(text);
    inPlace.translateRoot();
    FPath copied;
    copied.translateRoot(text);
    FPath const tagged(text, TranslPath());
    bool const same = inPlace == copied && copied == tagged;
    std::printf("%s %s ", FPath::isFake(text) ? "fake" : "plain", same ? "" : "DIFFERENT");
    print(inPlace);
}

void wide(char const* text) {
    WBStr units;
    Convert::Utf8ToWide(text, units);
    WcPath inPlace(units);
    inPlace.translateRoot();
    WcPath copied;
    copied.translateRoot(units);
    std::printf("%s %s ", WcPath::isFake(units) ? "fake" : "plain", inPlace == copied ? "" : "DIFFERENT");
    print(static_cast<WStr const&>(inPlace));
}

/// Runs a function in threads that start simultaneously.
template <class Function>
void inThreads(unsigned n, Function function) {
    std::atomic<unsigned> waiting{n};
    std::vector<std::thread> threads;
    for (unsigned i = 0; i < n; ++i) {
        threads.emplace_back([&, i] {
            --waiting;
            while (waiting != 0) std::this_thread::yield();
            function(i);
        });
    }
    for (std::thread& thread : threads) thread.join();
}

void ask() {
    constexpr unsigned THREADS = 32;
    std::vector<FPath const*> answers(THREADS);
    inThreads(THREADS, [&](unsigned i) { answers[i] = &Sys::root(); });
    std::set<FPath const*> const different(answers.begin(), answers.end());
    std::printf("%d calls, %d paths, ", static_cast<int>(xos_HostCalls("xos_FileSystemRoot")),
                static_cast<int>(different.size()));
    print(static_cast<Str const&>(*answers.front()));
}

/// Counts the translations that differ from the expected one.
int wrongTranslations(char const* expected, unsigned times) {
    WBStr units;
    Convert::Utf8ToWide(expected, units);
    std::atomic<int> wrong{0};
    inThreads(4, [&](unsigned) {
        for (unsigned i = 0; i < times; ++i) {
            WcPath path;
            path.translateRoot(ZB_W("/scsi0"));
            if (path.size() != units.size() || std::memcmp(path.wstr(), units.wstr(), 2 * units.size()) != 0) ++wrong;
        }
    });
    return wrong;
}

void race(char const* expected) { std::printf("%d wrong\n", wrongTranslations(expected, 1000)); }

void refill(char const* expected) {
    int wrong = 0;
    for (int round = 0; round < 40; ++round) {
        WcPath::pathRoot.clear();
        wrong += wrongTranslations(expected, 20);
    }
    std::printf("%d wrong\n", wrong);
}

void set(char const* text) {
    WBStr units;
    Convert::Utf8ToWide(text, units);
    WcPath::pathRoot = static_cast<WStr const&>(units);
}

void copyRoot() {
    FPath out("old");
    std::printf("%s ", Sys::root(out) ? "true" : "false");
    print(static_cast<Str const&>(out));
}

/// What can be asked for on the command line. \param value  the argument behind it, where one is needed
struct Step {
    char const* name;
    bool hasValue;
    void (*perform)(char const* value);
};

constexpr Step STEPS[] = {
    {"root", false, [](char const*) { print(static_cast<Str const&>(Sys::root())); }},
    {"temp", false, [](char const*) { print(static_cast<Str const&>(Sys::temp())); }},
    {"copy", false, [](char const*) { copyRoot(); }},
    {"fake", true, narrow},
    {"wide", true, wide},
    {"pathroot", false, [](char const*) { print(static_cast<WStr const&>(WcPath::pathRoot)); }},
    {"set", true, set},
    {"clear", false, [](char const*) { WcPath::pathRoot.clear(); }},
    {"ask", false, [](char const*) { ask(); }},
    {"race", true, race},
    {"refill", true, refill},
};

Step const* stepOf(char const* name) {
    for (Step const& step : STEPS) {
        if (std::strcmp(step.name, name) == 0) return &step;
    }
    return nullptr;
}

} // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        Step const* const step = stepOf(argv[i]);
        if (step == nullptr || (step->hasValue && ++i == argc)) return 2;
        step->perform(argv[i]);
    }
    return 0;
}
