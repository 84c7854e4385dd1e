/// \file
/// A folder for one test, and plain functions that create and examine its content.

#ifndef TESTS_SUPPORT_SCRATCH_H
#define TESTS_SUPPORT_SCRATCH_H

#include <atomic>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <string>

class Scratch {
public:
    Scratch() : Scratch(std::filesystem::temp_directory_path()) {}
    explicit Scratch(std::filesystem::path const& where) {
        static std::atomic<unsigned> counter{0};
        auto const now = std::chrono::system_clock::now().time_since_epoch().count();
        path_ = (where / ("zb-test-" + std::to_string(now) + "-" + std::to_string(counter++))).generic_string();
        std::filesystem::create_directory(path_);
    }
    ~Scratch() {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    Scratch(Scratch const&) = delete;
    Scratch& operator=(Scratch const&) = delete;

    std::string const& path() const { return path_; }
    std::string operator/(std::string const& name) const { return path_ + "/" + name; }

    /// Everything in the folder, at any depth, relative to it; a directory with a slash at its end.
    std::set<std::string> content(std::string const& folder = "") const {
        std::set<std::string> names;
        std::filesystem::path const top = folder.empty() ? path_ : *this / folder;
        for (auto const& entry : std::filesystem::recursive_directory_iterator(top)) {
            bool const folderLike = entry.is_directory() && !entry.is_symlink();
            names.insert(entry.path().lexically_relative(top).generic_string() + (folderLike ? "/" : ""));
        }
        return names;
    }

private:
    std::string path_;
};

using Names = std::set<std::string>;

inline void put(std::string const& path, std::string const& text) {
    std::ofstream{path, std::ios::binary | std::ios::trunc}.write(text.data(),
                                                                  static_cast<std::streamsize>(text.size()));
}

inline std::string textOf(std::string const& path) {
    std::ifstream file{path, std::ios::binary};
    return {std::istreambuf_iterator<char>{file}, std::istreambuf_iterator<char>{}};
}

inline bool exists(std::string const& path) { return std::filesystem::exists(std::filesystem::symlink_status(path)); }

inline void makeFolder(std::string const& path) { std::filesystem::create_directories(path); }

#endif
