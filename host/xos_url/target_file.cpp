#include "host/xos_url/target_file.h"

#include "host/xos_url/reason.h"
#include "host/xos_url/url_files.h"

#include <atomic>
#include <utility>

namespace host {

namespace {

std::string temporaryName(std::string const& path) {
    static std::atomic<unsigned> count{0};
    return path + "." + std::to_string(processNumber()) + "-" + std::to_string(++count) + ".part";
}

/// Names of an earlier process of the same number may lie about.
constexpr int MOST_ATTEMPTS = 100;

} // namespace

TargetFile::TargetFile(std::string path) : path_(std::move(path)) {}

TargetFile::~TargetFile() {
    KeepReason const keep;
    if (file_ != nullptr) std::fclose(file_);
    if (!temporary_.empty()) removeFile(temporary_);
}

bool TargetFile::open() {
    for (int attempt = 0; attempt < MOST_ATTEMPTS && file_ == nullptr; ++attempt) {
        std::string name = temporaryName(path_);
        file_ = createNewFile(name);
        if (file_ != nullptr) temporary_ = std::move(name);
    }
    return file_ != nullptr;
}

bool TargetFile::write(void const* data, std::size_t size) { return std::fwrite(data, 1, size, file_) == size; }

bool TargetFile::commit() {
    if (std::fclose(std::exchange(file_, nullptr)) != 0 || !replaceFile(temporary_, path_)) return false;
    temporary_.clear();
    return true;
}

} // namespace host
