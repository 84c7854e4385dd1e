/// \file
/// System calls of the module that fail on demand. The test program's own functions stand in for the system's, in the
/// module too.

#ifndef TESTS_HOST_XOS_BASICS_FILES_FAILING_CALLS_POSIX_H
#define TESTS_HOST_XOS_BASICS_FILES_FAILING_CALLS_POSIX_H

#include <sys/types.h>

/// Makes a call fail while it exists; several may exist, for different calls.
class FailingCall {
public:
    /// \param skip  calls that succeed before
    FailingCall(char const* name, int error, int skip = 0, int times = 1);
    ~FailingCall();
    FailingCall(FailingCall const&) = delete;
    FailingCall& operator=(FailingCall const&) = delete;

    /// Whether it has come to that.
    bool hasFailed() const { return hasFailed_; }
    /// \return whether a call has to fail now, with errno set
    static bool failsNow(char const* name);

private:
    char const* const name_;
    int const error_;
    int skip_;
    int times_;
    bool hasFailed_ = false;
    FailingCall* const former_;
};

/// All permissions that files had when `fchmod` gave them others, since it was 0.
extern mode_t permissionsBeforeChange;

#endif
