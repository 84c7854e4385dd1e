#include "host/xos_basics/control/control.h"
#include "host/xos_basics/result.h"
#include "host/xos_basics/system/shell.h"

#include "basis/platform/xos_basics.h"

extern "C" int xos_ShellExecuteEx(char const* commandLine, int64_t* result) {
    auto const execute = [=] {
        return host::given(commandLine) && host::runInShell(commandLine, result) ? 0 : host::FAILED;
    };
    return host::call(host::Function::xos_ShellExecuteEx, host::FAILED, execute, commandLine, result);
}
