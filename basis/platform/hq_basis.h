/// \file
/// Module `hq_basis`: periodic alerts on threads of the framework.
///
/// An alert calls a function back again and again, on whatever thread of the framework is free, never twice at the same
/// time. A callback that never returns costs a thread and holds up no other alert and not the end of the process.

#ifndef BASIS_PLATFORM_HQ_BASIS_H
#define BASIS_PLATFORM_HQ_BASIS_H

#include "basis/platform/platform_api.h"

#include <cstdint>

namespace HQ_Basis {

class XOS_API AlertTimer {
public:
    /// What a callback learns of its alert; borrowed for the call.
    struct Alert {
        std::uint32_t id;
        void* context;
    };

    /// \return the time in ms from now, the end of this call, to the next; stand-alone: 0 counts as 1
    using Callback = std::uint32_t (*)(Alert const&);

    /// Calls `callback` after `periodMs` milliseconds, and then after whatever it returns, until the alert is deleted.
    /// \param context  handed to the callback, otherwise untouched
    /// \return the alert's id; 0 on failure, also for a null callback
    static std::uint32_t New(std::uint32_t periodMs, Callback callback, void* context);

    /// Ends an alert; also from inside its own callback, whose return value then counts for nothing. Nothing for an id that
    /// there is not.
    ///
    /// Stand-alone: a callback that runs on another thread is waited for, so that its context may go afterwards; but no
    /// longer than a second, as it might never return.
    static void Delete(std::uint32_t id);
};

} // namespace HQ_Basis

#endif
