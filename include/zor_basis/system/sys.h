/// \file
/// `Sys`: what there is to know about the system that the component runs on.
///
/// Declares the root folder and the temporary folder of the installation. All paths here have forward slashes and none
/// at the end.
///
/// \thread  thread-safe

#ifndef ZOR_BASIS_SYSTEM_SYS_H
#define ZOR_BASIS_SYSTEM_SYS_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"

namespace ZOR_Basis {

class ZB_API Sys {
public:
    /// The root folder: the one that the platform layer is configured with, else the current folder at the first call.
    /// One slash at its end is taken away, and then a last component "system", so that the parent of that is the root.
    /// \kept root-01: a current folder of 512 bytes or more gives the empty path at the first call; later ones, which
    ///     know how much room it needs, find it
    /// \return a path that lives as long as the process and never changes; the empty path while there is none. On Linux
    ///         a root of "/" is the empty path too; what is made from it is absolute nonetheless ("/tmp", "/timer")
    /// \cost the system is asked once, or, while the root is empty, at each call
    static FPath const& root();
    /// Copies the root. \return whether it is not empty
    static bool root(FPath& out);

    /// The folder "tmp" in the root folder. It need not exist.
    /// \return a path that lives as long as the process; while the root is empty, as long as the thread's next call
    static FPath const& temp();
};

} // namespace ZOR_Basis

#endif
