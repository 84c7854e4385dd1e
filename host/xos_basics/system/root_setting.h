/// \file
/// The root of the file system as it is set.

#ifndef HOST_XOS_BASICS_SYSTEM_ROOT_SETTING_H
#define HOST_XOS_BASICS_SYSTEM_ROOT_SETTING_H

namespace host {

/// What `xos_FileSystemRoot` answers, without counting as a call of it. Valid for ever.
char const* configuredRoot();

} // namespace host

#endif
