// The sibling is programs_win.cpp.

#include "tests/faults/programs.h"

#include <zor_basis/system/process.h>

Program const SUCCEEDING = {"/bin/true", "/bin/true"};

bool isAwaited(unsigned long processId) { return ZOR_Basis::Process::Wait(processId); }
