/// \file
/// Why a fetch has failed, as the calling thread's last error. Twins: reason_posix.cpp, reason_win.cpp.

#ifndef HOST_XOS_URL_REASON_H
#define HOST_XOS_URL_REASON_H

namespace host {

/// What no call of the system says.
enum class Reason {
    badArgument,   ///< EINVAL; 87
    unknownScheme, ///< EPROTONOSUPPORT; 12006
    notFound,      ///< ENOENT; 2
    forbidden,     ///< EACCES; 5
    directory,     ///< EISDIR; 5
    tooManySteps,  ///< ELOOP; 12156
    badAnswer      ///< EPROTO; 12152
};

/// Sets the last error. \return false
bool failFor(Reason reason);
/// Sets the last error by the status of an answer that is no good one. \return false
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
