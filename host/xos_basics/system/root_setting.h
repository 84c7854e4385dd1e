/// \file
/// The root of the file system as it is set.

#ifndef HOST_XOS_BASICS_SYSTEM_ROOT_SETTING_H
#define HOST_XOS_BASICS_SYSTEM_ROOT_SETTING_H

namespace host {

/// The result of `xos_FileSystemRoot`, without counting as a call of it. Valid forever.
char const* configuredRoot();

} // namespace host

#endif
