/// \file
/// A file that appears whole or not at all: written under another name in the same folder, then renamed.

#ifndef HOST_XOS_URL_TARGET_FILE_H
#define HOST_XOS_URL_TARGET_FILE_H

#include <cstddef>
#include <cstdio>
#include <string>

namespace host {

class TargetFile {
public:
    explicit TargetFile(std::string path);
    TargetFile(TargetFile const&) = delete;
    TargetFile& operator=(TargetFile const&) = delete;
    /// Leaves no trace of what was not committed.
    ~TargetFile();

    /// \return false: no file can be made there
    bool open();
    /// \return false: not everything could be written
    bool write(void const* data, std::size_t size);
    /// Puts what was written in the place of the target.
    /// \return false: it could not all be stored, or not be put there
    bool commit();

private:
    std::string const path_;
    std::string temporary_;
    std::FILE* file_{nullptr};
};

} // namespace host

#endif
