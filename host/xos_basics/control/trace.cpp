#include "host/xos_basics/control/trace.h"

#include "host/include/xos_host.h"
#include "host/xos_basics/control/call_text.h"
#include "host/xos_basics/control/faults.h"
#include "host/xos_basics/control/trace_file.h"
#include "host/xos_basics/last_error.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <new>

namespace host {

namespace {

constinit TraceFile traceFile = NO_TRACE_FILE;

bool startTrace(char const* path) {
    if (path == nullptr || *path == '\0') return false;
    traceFile = openTrace(path);
    if (traceFile == NO_TRACE_FILE) {
        std::fprintf(stderr, "XOS_TRACE: \"%s\" cannot be opened, error %lu\n", path, lastError());
        return false;
    }
    watchAllCalls();
    return true;
}

[[maybe_unused]] bool const isStartedAtLoad = startTrace(std::getenv("XOS_TRACE"));

std::string wordText(char kind, std::uint64_t word) {
    auto const* const text = reinterpret_cast<char const*>(static_cast<std::uintptr_t>(word));
    switch (kind) {
    case 't':
        return traceText(text);
    case 'l':
        return traceUrl(text);
    case 's':
        return traceSecret(text);
    case 'v':
        return "void";
    default:
        return numberText(kind, word);
    }
}

std::string beginOfLine(FunctionFacts const& facts, std::uint64_t const* arguments, std::size_t count) {
    auto const now = std::chrono::floor<std::chrono::microseconds>(std::chrono::system_clock::now());
    std::string line = utcText(now) + ' ' + std::to_string(processNumber()) + '/' + std::to_string(threadNumber());
    line.append(" ").append(facts.name).append("(");
    for (std::size_t i = 0; i < std::min(count, facts.kinds.size()); ++i) {
        line += (i == 0 ? "" : ", ") + wordText(facts.kinds[i], arguments[i]);
    }
    return line += ") = ";
}

} // namespace

bool isTracing() { return traceFile != NO_TRACE_FILE; }

TracedCall::TracedCall(Function function, std::uint64_t const* arguments, std::size_t count)
    : function_{function}, errorBefore_{lastError()} {
    try {
        line_ = beginOfLine(factsOf(function), arguments, count);
    } catch (std::bad_alloc const&) { line_.clear(); }
    restoreLastError(0);
    begin_ = std::chrono::steady_clock::now();
}

void TracedCall::end(std::uint64_t result, bool hasFailed) {
    std::chrono::duration<double, std::micro> const elapsed = std::chrono::steady_clock::now() - begin_;
    unsigned long const error = lastError();
    char tail[64];
    if (hasFailed && error != 0) {
        std::snprintf(tail, sizeof tail, ", error %lu, %.1f us\n", error, elapsed.count());
    } else {
        std::snprintf(tail, sizeof tail, ", %.1f us\n", elapsed.count());
    }
    try {
        if (!line_.empty()) writeTrace(traceFile, line_ + wordText(factsOf(function_).result, result) + tail);
    } catch (std::bad_alloc const&) { static_cast<void>(tail); }
    restoreLastError(error == 0 ? errorBefore_ : error);
}

} // namespace host

void* xos_HostTraceBegin(char const* name, uint64_t const* arguments, uint32_t count) {
    host::Function const function = host::functionNamed(name);
    if (!host::isTracing() || function == host::Function::NONE) return nullptr;
    return new (std::nothrow) host::TracedCall{function, arguments, count};
}

void xos_HostTraceEnd(void* traced, uint64_t result, int hasFailed) {
    auto* const call = static_cast<host::TracedCall*>(traced);
    if (call == nullptr) return;
    call->end(result, hasFailed != 0);
    delete call;
}
