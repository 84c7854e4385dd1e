/// \file
/// Makes the workplace the root folder of the library, for families that write beneath it.

#ifndef BENCH_SUPPORT_SCRATCH_ROOT_H
#define BENCH_SUPPORT_SCRATCH_ROOT_H

#include "bench/support/tree.h"

#include <xos_host.h>

#include <filesystem>
#include <string>

struct ScratchRoot {
    /// \param folder  is made in it
    explicit ScratchRoot(std::string const& folder) {
        std::filesystem::create_directory(workplace() / folder);
        xos_HostSetRoot((workplace() / "").c_str());
    }
};

#endif
