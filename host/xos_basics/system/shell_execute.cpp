#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/result.h"
#include "host/xos_basics/system/shell.h"

#include "basis/platform/xos_basics.h"

extern "C" int xos_ShellExecuteEx(char const* commandLine, int64_t* result) {
    if (host::failsNow(host::Function::xos_ShellExecuteEx, commandLine, result)) return host::FAILED;
    if (commandLine == nullptr) {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return host::FAILED;
    }
    return host::runInShell(commandLine, result) ? 0 : host::FAILED;
}
