#include "host/xos_basics/control/faults.h"

#include "host/include/xos_host.h"
#include "host/xos_basics/last_error.h"

#include <algorithm>
#include <charconv>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

namespace host {

constinit std::array<std::atomic<std::uint64_t>, FUNCTION_COUNT> faults{};

namespace {

constexpr int SKIP_SHIFT = 32;
constexpr std::uint64_t ONE_SKIPPED = std::uint64_t{1} << SKIP_SHIFT;
/// Calls to skip but no failures: all calls are watched.
constexpr std::uint64_t WATCHED = ONE_SKIPPED;
constinit std::atomic<bool> areAllWatched{false};

bool hasFailures(std::uint64_t fault) { return static_cast<std::uint32_t>(fault) != 0; }

std::uint64_t withoutFailures() { return areAllWatched ? WATCHED : 0; }

/// Takes the number behind the last ":" off the end of `text`.
bool takeNumber(std::string_view& text, std::uint32_t& number) {
    std::size_t const colon = text.rfind(':');
    if (colon == std::string_view::npos) return false;
    char const* const end = text.data() + text.size();
    auto const parsed = std::from_chars(text.data() + colon + 1, end, number);
    text = text.substr(0, colon);
    return parsed.ec == std::errc{} && parsed.ptr == end;
}

bool injectEntry(std::string_view entry) {
    std::uint32_t skip = 0;
    std::uint32_t times = 0;
    // From the end, as two of the names contain colons.
    bool const hasNumbers = takeNumber(entry, times) && takeNumber(entry, skip);
    return hasNumbers && xos_HostFail(std::string(entry).c_str(), skip, times) == 0;
}

bool injectAll(std::string_view list) {
    while (!list.empty()) {
        std::string const entry{list.substr(0, list.find(','))};
        list.remove_prefix(std::min(list.size(), entry.size() + 1));
        if (injectEntry(entry)) continue;
        std::fprintf(stderr, "XOS_FAULTS: \"%s\" is not NAME:SKIP:TIMES of a function that can fail\n", entry.c_str());
    }
    return true;
}

char const* const listAtLoad = std::getenv("XOS_FAULTS");
[[maybe_unused]] bool const isReadAtLoad = listAtLoad != nullptr && injectAll(listAtLoad);

} // namespace

bool takesInjectedFailure(Function function) {
    std::atomic<std::uint64_t>& fault = faults[indexOf(function)];
    for (std::uint64_t seen = fault.load(std::memory_order_relaxed); hasFailures(seen);) {
        bool const fails = seen < ONE_SKIPPED;
        std::uint64_t const left = seen - (fails ? 1 : ONE_SKIPPED);
        std::uint64_t const next = hasFailures(left) ? left : withoutFailures();
        if (!fault.compare_exchange_weak(seen, next, std::memory_order_relaxed)) continue;
        if (fails) setLastError(Error::INJECTED);
        return fails;
    }
    return false;
}

void watchAllCalls() {
    areAllWatched = true;
    for (std::atomic<std::uint64_t>& fault : faults) {
        std::uint64_t none = 0; // otherwise XOS_FAULTS has asked for a failure
        fault.compare_exchange_strong(none, WATCHED, std::memory_order_relaxed);
    }
}

} // namespace host

int xos_HostFail(char const* name, uint32_t skip, uint32_t times) {
    host::Function const function = host::functionNamed(name);
    if (function == host::Function::NONE || (host::factsOf(function).traits & host::CAN_FAIL) == 0) return -1;
    std::uint64_t const fault = std::uint64_t{skip} << host::SKIP_SHIFT | times;
    host::faults[host::indexOf(function)].store(times == 0 ? host::withoutFailures() : fault,
                                                std::memory_order_relaxed);
    return 0;
}

void xos_HostFailClear(void) {
    for (std::atomic<std::uint64_t>& fault : host::faults) {
        fault.store(host::withoutFailures(), std::memory_order_relaxed);
    }
}
