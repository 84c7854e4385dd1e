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

TargetFile::TargetFile(std::string path) : _path(std::move(path)) {}

TargetFile::~TargetFile() {
    KeepReason const keep;
    if (_file != nullptr) { std::fclose(_file); }
    if (!_temporary.empty()) { removeFile(_temporary); }
}

bool TargetFile::open() {
    for (int attempt = 0; attempt < MOST_ATTEMPTS && _file == nullptr; ++attempt) {
        std::string const name = temporaryName(_path);
        _file = createNewFile(name);
        if (_file != nullptr) { _temporary = name; }
    }
    return _file != nullptr;
}

bool TargetFile::write(void const* data, std::size_t size) { return std::fwrite(data, 1, size, _file) == size; }

bool TargetFile::commit() {
    if (std::fclose(std::exchange(_file, nullptr)) != 0 || !replaceFile(_temporary, _path)) { return false; }
    _temporary.clear();
    return true;
}

} // namespace host
