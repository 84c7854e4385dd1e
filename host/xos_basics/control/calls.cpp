// The record of calls as others read it, and calls on behalf of other modules.

#include "host/include/xos_host.h"
#include "host/xos_basics/control/call_text.h"
#include "host/xos_basics/control/control.h"

#include <algorithm>
#include <array>
#include <mutex>
#include <string>
#include <string_view>
#include <thread>

namespace host {

namespace {

std::uint64_t callsSinceReset(CallRecord const& record) {
    return record.sequence.load(std::memory_order_acquire) / 2 - record.callsAtReset;
}

using Words = std::array<std::uint64_t, MAX_ARGUMENTS>;

bool tryCopy(CallRecord const& record, Words& words) {
    std::uint64_t const before = record.sequence.load(std::memory_order_acquire);
    for (std::size_t i = 0; i < MAX_ARGUMENTS; ++i) { words[i] = record.words[i].load(std::memory_order_acquire); }
    return before % 2 == 0 && record.sequence.load(std::memory_order_relaxed) == before;
}

std::string argumentText(char kind, std::uint64_t word, CallTexts const& texts) {
    if (!isText(kind)) return numberText(kind, word);
    return word == NULL_TEXT ? "null" : '"' + std::string(texts.text(word)) + '"';
}

std::string callText(std::string_view kinds, CallRecord& record) {
    std::lock_guard const lock{record.texts};
    Words words{};
    while (!tryCopy(record, words)) { std::this_thread::yield(); }
    std::string text;
    for (std::size_t i = 0; i < kinds.size(); ++i) {
        text += (i == 0 ? "" : ", ") + argumentText(kinds[i], words[i], record.texts);
    }
    return text;
}

/// A quick function's call by the asking thread itself comes last in the present era.
CallRecord* lastRecordOf(Function function, ThreadCalls& mine) {
    CallRecord& own = mine.records[indexOf(function)];
    if (own.era == registry.era.load(std::memory_order_relaxed)) return &own;
    ThreadCalls* const last = registry.lastCaller[indexOf(function)].load(std::memory_order_acquire);
    return last == nullptr ? nullptr : &last->records[indexOf(function)];
}

/// \param arguments  are words, for a text its address
void noteCall(Function function, ThreadCalls& mine, std::uint64_t const* arguments, std::size_t count) {
    std::string_view const kinds = factsOf(function).kinds;
    CallRecord& record = mine.records[indexOf(function)];
    std::uint64_t const begun = beginCall(function, record);
    for (std::size_t i = 0; i < std::min(count, kinds.size()); ++i) {
        if (isText(kinds[i])) {
            record.addText(i, reinterpret_cast<char const*>(arguments[i]));
        } else {
            record.addWord(i, arguments[i]);
        }
    }
    endCall(function, record, mine, begun);
}

} // namespace

} // namespace host

uint64_t xos_HostCalls(char const* name) {
    host::Function const function = host::functionNamed(name);
    if (function == host::Function::NONE) return 0;
    std::lock_guard const lock{host::registry.mutex};
    std::uint64_t sum = 0;
    for (host::ThreadCalls const* calls = host::registry.first; calls != nullptr; calls = calls->next) {
        sum += host::callsSinceReset(calls->records[host::indexOf(function)]);
    }
    return sum;
}

void xos_HostCallsReset(void) {
    std::lock_guard const lock{host::registry.mutex};
    for (host::ThreadCalls* calls = host::registry.first; calls != nullptr; calls = calls->next) {
        for (host::CallRecord& record : calls->records) { record.callsAtReset += host::callsSinceReset(record); }
    }
    for (auto& last : host::registry.lastCaller) { last.store(nullptr, std::memory_order_relaxed); }
    // Last, as a quick call in the old era would not be noted as the last one.
    host::beginEra();
}

char const* xos_HostLastCall(char const* name) {
    host::Function const function = host::functionNamed(name);
    host::ThreadCalls* const mine = host::threadCalls();
    if (function == host::Function::NONE || mine == nullptr) return nullptr;
    std::lock_guard const lock{host::registry.mutex};
    host::CallRecord* const last = host::lastRecordOf(function, *mine);
    host::beginEra();
    if (last == nullptr) return nullptr;
    mine->lastCallText = host::callText(host::factsOf(function).kinds, *last);
    return mine->lastCallText.c_str();
}

int xos_HostEnter(char const* name, uint64_t const* arguments, uint32_t count) {
    host::Function const function = host::functionNamed(name);
    if (function == host::Function::NONE) return 0;
    host::ThreadCalls* const mine = host::threadCalls();
    if (mine != nullptr) host::noteCall(function, *mine, arguments, count);
    return host::failsOnDemand(function) ? 1 : 0;
}
