// The sibling is programs_posix.cpp.

#include "tests/faults/programs.h"

#include <zor_basis/system/process.h>

Program const SUCCEEDING = {"C:\\windows\\system32\\cmd.exe", "cmd /c exit 0"};

bool isAwaited(unsigned long processId) {
    // A process that has ended already cannot be found, so only the return counts.
    ZOR_Basis::Process::Wait(processId);
    return true;
}
