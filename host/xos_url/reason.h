/// \file
/// Why a fetch has failed, as the calling thread's last error. Twins: reason_posix.cpp, reason_win.cpp.

#ifndef HOST_XOS_URL_REASON_H
#define HOST_XOS_URL_REASON_H

namespace host {

/// What no call of the system says.
enum class Reason {
    BAD_ARGUMENT,   ///< EINVAL; 87
    UNKNOWN_SCHEME, ///< EPROTONOSUPPORT; 12006
    NOT_FOUND,      ///< ENOENT; 2
    FORBIDDEN,      ///< EACCES; 5
    DIRECTORY,      ///< EISDIR; 5
    TOO_MANY_STEPS, ///< ELOOP; 12156
    BAD_ANSWER,     ///< EPROTO; 12152
    NO_MEMORY       ///< ENOMEM; 8
};

/// Sets the last error.
/// \return false
bool failFor(Reason reason);
/// Sets the last error by the status of an answer that is no good one.
/// \return false
bool failForStatus(long status);

/// The last error while something is cleared away.
class KeepReason {
public:
    KeepReason();
    KeepReason(KeepReason const&) = delete;
    KeepReason& operator=(KeepReason const&) = delete;
    ~KeepReason();

private:
    unsigned long code_;
};

} // namespace host

#endif
