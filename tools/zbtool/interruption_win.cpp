// The sibling is interruption_posix.cpp.

#include "tools/zbtool/interruption.h"

#include <atomic>
#include <windows.h>

namespace zbtool {
namespace {

std::atomic<bool> received{false};

BOOL WINAPI note(DWORD event) {
    // At the second time the next handler ends the program, which is the system's.
    if (received.exchange(true)) return FALSE;
    // After any other event the system ends the program as soon as this function returns.
    if (event != CTRL_C_EVENT && event != CTRL_BREAK_EVENT) Sleep(INFINITE);
    return TRUE;
}

} // namespace

void watchForInterruption(void (*)()) { SetConsoleCtrlHandler(note, TRUE); }

bool isInterrupted() { return received.load(std::memory_order_relaxed); }

void endAsInterrupted() { ExitProcess(STATUS_CONTROL_C_EXIT); }

} // namespace zbtool
