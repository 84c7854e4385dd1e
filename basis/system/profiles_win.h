/// \file
/// The profiles of users who are logged on, under HKEY_USERS.

#ifndef BASIS_SYSTEM_PROFILES_WIN_H
#define BASIS_SYSTEM_PROFILES_WIN_H

#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis {

struct Profile {
    /// The name of its key, and the logon name in it.
    BufStr<255> key;
    BufStr<15> user;
};

/// The n-th profile that has an interactive session and a logon name, counted from 0, in the order of the registry.
/// \return false, with both texts empty, where there are no more
bool profileOfSession(unsigned n, Profile& profile);

/// Whether a profile is that of a domain: one of the domains that it names, in any case of the letters. True also where
/// it names none.
bool isOfDomain(Profile const& profile, BufStr<15> const& domain);

} // namespace ZOR_Basis

#endif
