#include "tests/faults/round.h"

#include <chrono>
#include <thread>

namespace {

std::string differenceAfterSuccess(Snapshot const& after, Snapshot const& now) {
    for (auto const& [name, content] : after) {
        if (now.count(name) == 0) return "success without " + name;
        if (now.at(name) != content) return "success with another content of " + name;
    }
    for (auto const& [name, content] : now) {
        if (after.count(name) == 0) return "success with a left-over: " + name;
    }
    return "";
}

} // namespace

Snapshot snapshotOf(std::string const& folder) {
    Snapshot found;
    for (auto const& entry : std::filesystem::recursive_directory_iterator(folder)) {
        std::string const name = entry.path().lexically_relative(folder).generic_string();
        found[name] = entry.is_directory() && !entry.is_symlink() ? "/" : textOf(entry.path().string());
    }
    return found;
}

std::string brokenPromise(Scenario::Promise promise, bool succeeded, bool canLeaveTemporary, Snapshot const& before,
                          Snapshot const& after, Snapshot const& now) {
    if (promise == Scenario::NAMES) return "";
    if (succeeded && promise != Scenario::WHAT_IS_LISTED) {
        std::string const difference = differenceAfterSuccess(after, now);
        if (!difference.empty() || now == after) return difference;
    }
    for (auto const& [name, content] : now) {
        auto const isContentOf = [&file = name, &text = content](Snapshot const& other) {
            auto const place = other.find(file);
            return place != other.end() && place->second == text;
        };
        if (isContentOf(before) || isContentOf(after)) continue;
        bool const isKnown = before.count(name) != 0 || after.count(name) != 0;
        if (!isKnown && canLeaveTemporary && name.find(".tmp") != std::string::npos) continue;
        if (isKnown && promise == Scenario::PIECES) continue;
        return (isKnown ? "a partial file: " : "a left-over: ") + name;
    }
    return "";
}

void Growth::look() {
    // What threads release behind the result is given a moment.
    int const moment = times_ + 1 < RUNS_TO_GROW ? 0 : 100;
    for (int i = 0; i < moment && count_() > last_; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    std::int64_t const now = count_();
    times_ = now > last_ ? times_ + 1 : 0;
    last_ = now;
}

Scenarios allScenarios() {
    Scenarios all;
    for (auto const& group :
         {textScenarios(), storeScenarios(), fileScenarios(), walkScenarios(), threadScenarios(), systemScenarios()}) {
        all.insert(all.end(), group.begin(), group.end());
    }
    return all;
}
