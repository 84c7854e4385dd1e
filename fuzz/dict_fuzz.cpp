// Any bytes as a dictionary's file: what is loaded is what a plain reading finds, and comes back when saved.

#include "fuzz/target.h"

#include <zor_basis/containers/dict.h>

#include <atomic>
#include <chrono>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <map>
#include <string>

using namespace ZOR_Basis;

namespace {

using BlobDict = Dict<Blob, Blob>;
using Contents = std::map<std::string, std::string>;

struct Folder {
    Folder() {
        auto const now = std::chrono::system_clock::now().time_since_epoch().count();
        path = std::filesystem::temp_directory_path() / ("zb-fuzz-dict-" + std::to_string(now));
        std::filesystem::create_directory(path);
    }
    ~Folder() {
        std::error_code ignored;
        std::filesystem::remove_all(path, ignored);
    }
    std::filesystem::path path;
};

bool nextField(std::string const& bytes, std::size_t& at, std::string& out) {
    std::uint32_t n = 0;
    if (bytes.size() - at < sizeof n) return false;
    std::memcpy(&n, bytes.data() + at, sizeof n);
    at += sizeof n;
    if (bytes.size() - at < n) return false;
    out = bytes.substr(at, n);
    at += n;
    return true;
}

Contents plainReading(std::string const& bytes) {
    Contents contents;
    std::size_t at = 0;
    std::string key;
    std::string value;
    while (nextField(bytes, at, key) && nextField(bytes, at, value)) contents[key] = value;
    return contents;
}

std::string text(Blob const& blob) { return blob.size() != 0 ? std::string(blob.val(), blob.size()) : std::string(); }

Contents contentsOf(BlobDict& dict) {
    require(dict.isConsistent());
    Contents contents;
    for (auto const& entry : dict) contents[text(entry.key)] = text(entry.value);
    require(contents.size() == dict.size());
    return contents;
}

void runDict(unsigned char const* data, std::size_t size) {
    static Folder const folder;
    std::string const path = (folder.path / "dict").generic_string();
    std::string const bytes(reinterpret_cast<char const*>(data), size);
    std::ofstream(path, std::ios::binary | std::ios::trunc).write(bytes.data(), static_cast<std::streamsize>(size));
    BlobDict dict{Str(path)};
    Contents const contents = contentsOf(dict);
    require(contents == plainReading(bytes));

    Blob const extra(5, "\0new\1");
    dict.set(extra, extra);
    dict.rm(extra);
    if (contents.count(text(extra)) != 0) return;
    require(dict.write());
    BlobDict again{Str(path)};
    require(contentsOf(again) == contents);
}

FuzzTarget const DICT("dict", runDict);

} // namespace
