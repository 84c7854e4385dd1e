// The sibling is query_calls_posix.cpp.

#include "basis/system/query_calls_win.h"

namespace ZOR_Basis {

QueryCalls queryCalls{RegOpenKeyExA, RegCloseKey,        RegQueryValueExA, RegEnumKeyExA,           RegEnumValueA,
                      GetUserNameA,  GetComputerNameExA, LogonUserA,       ImpersonateLoggedOnUser, RevertToSelf,
                      CloseHandle,   GetVolumePathNameA, GetDriveTypeA,    WNetGetConnectionA};

} // namespace ZOR_Basis
