#include "host/xos_basics/control/calls.h"

#include "host/xos_basics/control/call_text.h"
#include "host/xos_basics/control/registry.h"
#include "host/xos_basics/wait/pause.h"

#include <algorithm>
#include <cstring>
#include <mutex>

namespace host {

namespace {

std::uint64_t callsSince(std::uint64_t sequence, std::uint64_t base) {
    // An odd sequence is a call being noted, which may have been so at the reset already.
    return sequence / 2 - base / 2;
}

struct Reading {
    std::uint64_t sequence;
    std::uint64_t stamp;
    CallSnapshot call;
};

/// Text offsets from a record that is being written are not to be trusted.
bool textsAreWhole(char const* kinds, CallSnapshot const& call) {
    for (std::size_t i = 0; kinds[i] != '\0'; ++i) {
        std::uint64_t const word = call.words[i];
        if (kinds[i] != 't' || word == NULL_TEXT) { continue; }
        if (word >= call.texts.size()) { return false; }
        auto const* const begin = reinterpret_cast<char const*>(call.texts.data() + word);
        if (std::memchr(begin, '\0', (call.texts.size() - word) * sizeof(std::uint64_t)) == nullptr) { return false; }
    }
    return true;
}

void copyTexts(CallRecord const& record, std::vector<std::uint64_t>& texts) {
    TextBuffer const* const buffer = record.texts.load(std::memory_order_acquire);
    texts.clear();
    for (std::size_t i = 0; buffer != nullptr && i < buffer->words; ++i) {
        texts.push_back(buffer->data[i].load(std::memory_order_acquire));
    }
}

bool tryRead(CallRecord const& record, char const* kinds, Reading& reading) {
    reading.sequence = record.sequence.load(std::memory_order_acquire);
    if (reading.sequence % 2 != 0) { return false; }
    reading.stamp = record.stamp.load(std::memory_order_acquire);
    for (std::size_t i = 0; i < MAX_ARGUMENTS; ++i) {
        reading.call.words[i] = record.words[i].load(std::memory_order_acquire);
    }
    if (std::strchr(kinds, 't') != nullptr) { copyTexts(record, reading.call.texts); }
    return record.sequence.load(std::memory_order_relaxed) == reading.sequence && textsAreWhole(kinds, reading.call);
}

Reading readRecord(CallRecord const& record, char const* kinds) {
    Reading reading{};
    while (!tryRead(record, kinds, reading)) { pauseBriefly(); }
    return reading;
}

} // namespace

std::uint64_t callsOf(Function function) {
    std::size_t const index = indexOf(function);
    std::lock_guard const lock{registryMutex};
    std::uint64_t sum = 0;
    for (ThreadCalls const* calls = registryHead; calls != nullptr; calls = calls->next) {
        sum +=
            callsSince(calls->records[index].sequence.load(std::memory_order_acquire), calls->sequenceAtReset[index]);
    }
    return sum;
}

void resetCalls() {
    std::lock_guard const lock{registryMutex};
    for (ThreadCalls* calls = registryHead; calls != nullptr; calls = calls->next) {
        for (std::size_t i = 0; i < FUNCTION_COUNT; ++i) {
            calls->sequenceAtReset[i] = calls->records[i].sequence.load(std::memory_order_acquire);
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
        if (calls == &spareThreadCalls) {
            continue; // threads without memory for records of their own may write it together
        }
        Reading reading = readRecord(calls->records[index], kinds);
        if (callsSince(reading.sequence, calls->sequenceAtReset[index]) == 0) { continue; }
        // Without stamps it was the sole caller's.
        if (!found || reading.stamp > last.stamp || (reading.stamp == last.stamp && calls == sole)) {
            last = std::move(reading);
            found = true;
        }
    }
    if (found) { text = callText(kinds, last.call); }
    return found;
}

} // namespace host
