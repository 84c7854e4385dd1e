/// \file
/// Module `hq_basis`: periodic alerts on threads of the framework.

#ifndef BASIS_PLATFORM_HQ_BASIS_H
#define BASIS_PLATFORM_HQ_BASIS_H

#include "basis/platform/platform_api.h"

#include <cstdint>

namespace HQ_Basis {

class XOS_API AlertTimer {
public:
    struct Alert {
        std::uint32_t id;
        void* context;
    };
    /// Runs on a thread of the framework. \return the next period in ms
    using Callback = std::uint32_t (*)(Alert const&);

    /// \return the alert's id; 0 on failure
    static std::uint32_t New(std::uint32_t periodMs, Callback callback, void* context);
    /// Ends an alert; also from inside its own callback.
    static void Delete(std::uint32_t id);
};

} // namespace HQ_Basis

#endif
