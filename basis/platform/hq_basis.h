/// \file
/// Module `hq_basis`: periodic alerts on threads of the framework.
///
/// An alert calls a function repeatedly, on any free thread of the framework, never twice at the same time. A callback
/// that never returns costs a thread, but delays neither another alert nor the end of the process.

#ifndef BASIS_PLATFORM_HQ_BASIS_H
#define BASIS_PLATFORM_HQ_BASIS_H

#include "basis/platform/platform_api.h"

#include <cstdint>

namespace HQ_Basis {

class XOS_API AlertTimer {
public:
    /// The alert that a callback is called for; borrowed for the call.
    struct Alert {
        std::uint32_t id;
        void* context;
    };

    /// \return the time in ms from the end of this call to the next; stand-alone: 0 counts as 1
    using Callback = std::uint32_t (*)(Alert const&);

    /// Calls `callback` after `periodMs` milliseconds, and then after the time that it returns, until the alert is
    /// deleted.
    /// \param context  is passed to the callback, otherwise untouched
    /// \return the alert's id; 0 on failure, also for a null callback
    static std::uint32_t New(std::uint32_t periodMs, Callback callback, void* context);

    /// Ends an alert, also from inside its own callback, whose return value is then ignored. Does nothing for an
    /// unknown id.
    ///
    /// Stand-alone: the call waits for a callback that runs on another thread, so that its context may be destroyed
    /// afterwards; but at most for a second, because the callback might never return.
    static void Delete(std::uint32_t id);
};

} // namespace HQ_Basis

#endif
