#include "host/xos_basics/control/calls.h"

#include "host/xos_basics/control/call_text.h"
#include "host/xos_basics/control/registry.h"
#include "host/xos_basics/wait/pause.h"

#include <algorithm>
#include <cstring>
#include <mutex>

namespace host {

namespace {

struct Reading {
    std::uint64_t stamp;
    CallSnapshot call;
};

/// Text offsets from a record that is being written are not to be trusted.
bool textsAreWhole(char const* kinds, CallSnapshot const& call) {
    for (std::size_t i = 0; kinds[i] != '\0'; ++i) {
        std::uint64_t const word = call.words[i];
        if (kinds[i] != 't' || word == NULL_TEXT) continue;
        if (word >= call.texts.size()) return false;
        auto const* const begin = reinterpret_cast<char const*>(call.texts.data() + word);
        if (std::memchr(begin, '\0', (call.texts.size() - word) * sizeof(std::uint64_t)) == nullptr) return false;
    }
    return true;
}

void copyTexts(CallSlot const& slot, std::vector<std::uint64_t>& texts) {
    TextBuffer const* const buffer = slot.texts.load(std::memory_order_acquire);
    std::uint64_t const used = slot.textWords.load(std::memory_order_acquire);
    texts.clear();
    for (std::size_t i = 0; buffer != nullptr && i < std::min<std::uint64_t>(used, buffer->words); ++i) {
        texts.push_back(buffer->data[i].load(std::memory_order_acquire));
    }
}

/// \return false: another call has been completed meanwhile, and one more may be written where this one stands
bool tryRead(CallRecord const& record, char const* kinds, Reading& reading) {
    std::uint64_t const number = record.completed.load(std::memory_order_acquire);
    CallSlot const& slot = record.slots[number % 2];
    reading.stamp = slot.stamp.load(std::memory_order_acquire);
    for (std::size_t i = 0; i < MAX_ARGUMENTS; ++i) {
        reading.call.words[i] = slot.words[i].load(std::memory_order_acquire);
    }
    if (std::strchr(kinds, 't') != nullptr) copyTexts(slot, reading.call.texts);
    return record.completed.load(std::memory_order_relaxed) == number && textsAreWhole(kinds, reading.call);
}

Reading readRecord(CallRecord const& record, char const* kinds) {
    Reading reading{};
    while (!tryRead(record, kinds, reading)) { pauseBriefly(); }
    return reading;
}

std::uint64_t callsSinceReset(ThreadCalls const& calls, std::size_t index) {
    return calls.records[index].completed.load(std::memory_order_acquire) - calls.completedAtReset[index];
}

} // namespace

std::uint64_t callsOf(Function function) {
    std::size_t const index = indexOf(function);
    std::lock_guard const lock{registryMutex};
    std::uint64_t sum = 0;
    for (ThreadCalls const* calls = registryHead; calls != nullptr; calls = calls->next) {
        sum += callsSinceReset(*calls, index);
    }
    return sum;
}

void resetCalls() {
    std::lock_guard const lock{registryMutex};
    for (ThreadCalls* calls = registryHead; calls != nullptr; calls = calls->next) {
        for (std::size_t i = 0; i < FUNCTION_COUNT; ++i) {
            calls->completedAtReset[i] = calls->records[i].completed.load(std::memory_order_acquire);
        }
    }
}

bool lastCallOf(Function function, std::string& text) {
    std::size_t const index = indexOf(function);
    char const* const kinds = factsOf(function).kinds;
    gatherTime();
    std::lock_guard const lock{registryMutex};
    ThreadCalls const* const sole = soleCaller[index].load(std::memory_order_relaxed);
    bool found = false;
    Reading last{};
    for (ThreadCalls const* calls = registryHead; calls != nullptr; calls = calls->next) {
        // Threads without memory for records of their own may write the spare ones together.
        if (calls == &spareThreadCalls || callsSinceReset(*calls, index) == 0) continue;
        Reading reading = readRecord(calls->records[index], kinds);
        // Without stamps it was the sole caller's.
        if (!found || reading.stamp > last.stamp || (reading.stamp == last.stamp && calls == sole)) {
            last = std::move(reading);
            found = true;
        }
    }
    if (found) text = callText(kinds, last.call);
    return found;
}

} // namespace host
