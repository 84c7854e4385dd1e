#include "host/xos_basics/control/faults.h"

#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <array>
#include <mutex>

namespace host {

constinit std::atomic<std::uint32_t> armedFaults{0};

namespace {

struct Rule {
    std::uint32_t skip;
    std::uint32_t times;
};

constinit QuickMutex mutex;
constinit std::array<Rule, FUNCTION_COUNT> rules{};

void setRule(Rule& rule, Rule wanted) {
    bool const was = rule.times != 0;
    bool const is = wanted.times != 0;
    rule = wanted;
    if (was != is) armedFaults.fetch_add(is ? 1 : std::uint32_t(-1), std::memory_order_relaxed);
}

bool countsDown(Function function) {
    std::lock_guard const lock{mutex};
    Rule& rule = rules[indexOf(function)];
    if (rule.times == 0) return false;
    if (rule.skip != 0) {
        --rule.skip;
        return false;
    }
    setRule(rule, {0, rule.times - 1});
    return true;
}

} // namespace

bool takesInjectedFailure(Function function) {
    bool const fails = countsDown(function);
    if (fails) setLastError(Error::injected);
    return fails;
}

bool injectFailure(char const* name, std::uint32_t skip, std::uint32_t times) {
    Function const function = functionNamed(name);
    if (function == Function::none || !factsOf(function).canFail) return false;
    std::lock_guard const lock{mutex};
    setRule(rules[indexOf(function)], {skip, times});
    return true;
}

void clearFailures() {
    std::lock_guard const lock{mutex};
    for (Rule& rule : rules) { setRule(rule, {0, 0}); }
}

} // namespace host
