#include "host/xos_url/url_files.h"

#include "host/xos_url/reason.h"

namespace host {

namespace {

/// \param descriptor  is closed if it cannot become a stream
std::FILE* streamOf(int descriptor, char const* mode) {
    std::FILE* const stream = descriptorStream(descriptor, mode);
    if (stream != nullptr) return stream;
    KeepReason const keep;
    closeDescriptor(descriptor);
    return nullptr;
}

} // namespace

std::FILE* createNewFile(std::string const& path) {
    int const descriptor = newDescriptor(path);
    if (descriptor < 0) return nullptr;
    std::FILE* const stream = streamOf(descriptor, "wb");
    if (stream != nullptr) return stream;
    KeepReason const keep;
    removeFile(path);
    return nullptr;
}

std::FILE* openRegularFile(std::string const& path) {
    int const descriptor = regularDescriptor(path);
    return descriptor < 0 ? nullptr : streamOf(descriptor, "rb");
}

} // namespace host
