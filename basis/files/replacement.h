/// \file
/// The new content of a file while it is written beside the old one.

#ifndef BASIS_FILES_REPLACEMENT_H
#define BASIS_FILES_REPLACEMENT_H

#include "basis/files/file_backends.h"
#include "zor_basis/files/f_path.h"

#include <optional>

namespace ZOR_Basis {

/// Whatever fails, and at whatever moment the process ends, the path leads to the old content or to the whole new one.
///
/// The temporary file lies in the folder of the one that is replaced, as only a rename within one file system is one
/// step. The system makes it exclusively, for which the platform layer has no function; the platform layer does
/// everything else.
///
/// \error every failure leaves its reason as the thread's last error
class Replacement {
public:
    Replacement() = default;
    Replacement(Replacement const&) = delete;
    Replacement& operator=(Replacement const&) = delete;
    /// Removes what was written, unless it is in place. The last error stays.
    ~Replacement();

    /// Makes and opens the temporary file. It gets the owner and the permissions of the file that is replaced, as far
    /// as the system allows. A link stays, and what it leads to is replaced.
    /// \param mode  as for `File::open`
    /// \error also if the existing entry may not be written or is not a file
    bool open(char const* path, int mode);
    /// The file that receives the content.
    /// \pre it is open
    IFile& content() { return *file_; }
    /// Flushes the content to the disk and then renames the temporary file.
    bool putInPlace();

private:
    bool makeTemporary();

    FPath target_;
    FPath temporary_; // empty while there is none
    std::optional<FileXosBasics> file_;
};

} // namespace ZOR_Basis

#endif
