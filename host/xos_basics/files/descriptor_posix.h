/// \file
/// Owner of a file descriptor. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_FILES_DESCRIPTOR_POSIX_H
#define HOST_XOS_BASICS_FILES_DESCRIPTOR_POSIX_H

#include "host/xos_basics/files/path_posix.h"

#include <unistd.h>
#include <utility>

namespace host {

class Descriptor {
public:
    Descriptor() = default;
    explicit Descriptor(int number) : number_(number) {}
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    Descriptor& operator=(Descriptor&& other) noexcept {
        std::swap(number_, other.number_);
        return *this;
    }
    ~Descriptor() {
        if (number_ >= 0) {
            KeepErrno const keep;
            ::close(number_);
        }
    }

    int get() const { return number_; }
    int release() { return std::exchange(number_, -1); }
    explicit operator bool() const { return number_ >= 0; }

    /// The one place where a delayed write can still fail. An interrupted close has closed.
    bool close() { return ::close(std::exchange(number_, -1)) == 0 || errno == EINTR; }

private:
    int number_ = -1;
};

} // namespace host

#endif
