// A module that logs, for programs that load and unload it.

#include "tests/once/unload_module.h"

#include <zor_basis/log.h>

#include <new>

extern "C" void logOneLine(int isKept) {
    // Not on the heap, where a log that is kept would count as lost memory.
    alignas(ZOR_Basis::Log) static unsigned char memory[sizeof(ZOR_Basis::Log)];
    auto* const log = new (memory) ZOR_Basis::Log("module");
    log->out("line 1");
    if (isKept == 0) log->~Log();
}
