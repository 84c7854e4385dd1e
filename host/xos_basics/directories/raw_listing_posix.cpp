// The sibling is raw_listing_win.cpp.

#include "host/xos_basics/directories/raw_listing.h"

#include "host/xos_basics/directories/dirents_posix.h"
#include "host/xos_basics/files/descriptor_posix.h"

namespace host {

namespace {

class DirentListing final : public RawListing {
public:
    explicit DirentListing(Descriptor directory) : directory_(std::move(directory)) {}

    char const* next() override { return dirents_.next(directory_.get()) ? dirents_.name() : nullptr; }
    bool isDirectory() override { return S_ISDIR(dirents_.type(directory_.get())); }

private:
    Descriptor directory_;
    Dirents dirents_;
};

} // namespace

std::unique_ptr<RawListing> RawListing::open(char const* path) {
    Descriptor directory{::open(systemPath(path).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC)};
    if (!directory) return nullptr;
    return std::make_unique<DirentListing>(std::move(directory));
}

} // namespace host
