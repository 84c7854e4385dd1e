/// \file
/// Accounts of the password database.

#ifndef BASIS_SYSTEM_ACCOUNTS_POSIX_H
#define BASIS_SYSTEM_ACCOUNTS_POSIX_H

#include "zor_basis/text/buf_str.h"

#include <sys/types.h>

namespace ZOR_Basis {

struct Account {
    BufStr<15> name;
    uid_t user = 0;
    gid_t group = 0;
};

bool findAccount(uid_t user, Account& account);
bool findAccount(char const* name, Account& account);

} // namespace ZOR_Basis

#endif
