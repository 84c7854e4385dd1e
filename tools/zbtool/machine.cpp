#include "tools/zbtool/machine.h"

#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/json.h"

#include <zor_basis/system.h>
#include <zor_basis/timers.h>

#include <cstdio>
#include <filesystem>
#include <thread>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

enum Kind { TEXT, OTHER }; ///< how JSON writes it: in quotes, or as it is

struct Fact {
    char const* name;
    Kind kind;
    /// \return false if there is no answer
    bool (*ask)(std::string& answer);
};

bool take(bool known, Str const& text, std::string& answer) {
    answer = text.c_str();
    return known;
}

bool takeUser(bool (*ask)(BufStr<15>&), std::string& answer) {
    BufStr<15> text;
    bool const known = ask(text);
    return take(known, text, answer);
}

constexpr Fact FACTS[] = {
    {"root", TEXT, [](std::string& answer) { return take(!Sys::root().empty(), Sys::root(), answer); }},
    {"temp", TEXT, [](std::string& answer) { return take(!Sys::temp().empty(), Sys::temp(), answer); }},
    {"user", TEXT,
     [](std::string& answer) {
         return takeUser([](BufStr<15>& text) { return Sys::CurrentUser(text, false); }, answer);
     }},
    {"session-user", TEXT,
     [](std::string& answer) {
         return takeUser([](BufStr<15>& text) { return Sys::CurrentUser(text, true); }, answer);
     }},
    {"user-at-the-machine", TEXT, [](std::string& answer) { return takeUser(Sys::CurHumanUser, answer); }},
    {"default-login", TEXT, [](std::string& answer) { return takeUser(Sys::DefaultLogin, answer); }},
    {"domain", TEXT,
     [](std::string& answer) {
         return takeUser([](BufStr<15>& text) { return Sys::CurrentDomain(text, false); }, answer);
     }},
    {"user-domain", TEXT,
     [](std::string& answer) {
         return takeUser([](BufStr<15>& text) { return Sys::CurrentDomain(text, true); }, answer);
     }},
    {"folder", TEXT,
     [](std::string& answer) {
         answer = std::filesystem::current_path().generic_string();
         return true;
     }},
    {"folder-is-local", OTHER,
     [](std::string& answer) {
         answer = Sys::isLocalDisk(Str(std::filesystem::current_path().generic_string())) ? "true" : "false";
         return true;
     }},
    {"processors", OTHER,
     [](std::string& answer) {
         answer = std::to_string(std::thread::hardware_concurrency());
         return true;
     }},
    {"ticks-per-second", OTHER,
     [](std::string& answer) {
         answer = std::to_string(BaseTimer::Init());
         return true;
     }},
};

} // namespace

int describeMachine(MachineOptions const& options) {
    JsonObject object;
    for (Fact const& fact : FACTS) {
        std::string answer;
        bool const known = fact.ask(answer);
        if (options.json)
            object.addRaw(fact.name, !known ? "null" : fact.kind == TEXT ? jsonText(answer) : answer);
        else
            std::printf("%-20s %s\n", fact.name, known ? answer.c_str() : "-");
    }
    if (options.json) std::puts(object.text().c_str());
    return DONE;
}

} // namespace zbtool
