/// \file
/// The Windows calls of the system queries, in one table, so that tests can make each call fail.

#ifndef BASIS_SYSTEM_QUERY_CALLS_WIN_H
#define BASIS_SYSTEM_QUERY_CALLS_WIN_H

#include "basis/platform/windows_api_win.h"

#include <winnetwk.h>

namespace ZOR_Basis {

struct QueryCalls {
    decltype(&RegOpenKeyExA) openKey;
    decltype(&RegCloseKey) closeKey;
    decltype(&RegQueryValueExA) queryValue;
    decltype(&RegEnumKeyExA) enumKey;
    decltype(&RegEnumValueA) enumValue;
    decltype(&GetUserNameA) userName;
    decltype(&GetComputerNameExA) computerName;
    decltype(&LogonUserA) logonUser;
    decltype(&ImpersonateLoggedOnUser) impersonate;
    decltype(&RevertToSelf) revertToSelf;
    decltype(&CloseHandle) closeHandle;
    decltype(&GetVolumePathNameA) volumePath;
    decltype(&GetDriveTypeA) driveType;
    decltype(&WNetGetConnectionA) connection;
};

/// Replaced by tests only, while nothing else runs.
extern QueryCalls queryCalls;

} // namespace ZOR_Basis

#endif
