/// \file
/// Calls of the system that name the thread's user and the computer as a test wants it.

#ifndef TESTS_SYSTEM_SYSTEM_SAYS_WIN_H
#define TESTS_SYSTEM_SYSTEM_SAYS_WIN_H

#include "basis/platform/windows_api_win.h"

#include <cstring>
#include <map>

/// What the system says of the thread's user and of the computer; null makes the call fail.
inline char const* threadUser = nullptr;
inline std::map<int, char const*> computerNames;

inline BOOL give(char const* text, char* buffer, DWORD* n) {
    if (text == nullptr) return FALSE;
    std::size_t const length = std::strlen(text);
    if (*n <= length) {
        *n = static_cast<DWORD>(length + 1);
        SetLastError(ERROR_MORE_DATA);
        return FALSE;
    }
    std::strcpy(buffer, text);
    *n = static_cast<DWORD>(length);
    return TRUE;
}
inline BOOL WINAPI userName(char* buffer, DWORD* n) { return give(threadUser, buffer, n); }
inline BOOL WINAPI computerName(COMPUTER_NAME_FORMAT format, char* buffer, DWORD* n) {
    return give(computerNames[format], buffer, n);
}

#endif
