/// \file
/// The modes that tests open files with, the three backends for typed suites, and what a file asks of the platform
/// layer.

#ifndef TESTS_FILES_OPENED_FILE_H
#define TESTS_FILES_OPENED_FILE_H

#include "basis/files/system_calls.h"
#include "tests/files/last_call.h"

#include <zor_basis/files/file.h>

#include <gtest/gtest.h>

#include <string>

inline constexpr int BINARY = ZOR_Basis::File::FILE_BINARY | ZOR_Basis::File::FILE_SEQUENTIAL;
inline constexpr int READ = ZOR_Basis::File::FILE_READ | BINARY;
inline constexpr int WRITE = ZOR_Basis::File::FILE_WRITE | ZOR_Basis::File::FILE_TRUNC | BINARY;
inline constexpr int UPDATE = ZOR_Basis::File::FILE_READ | ZOR_Basis::File::FILE_WRITE | BINARY;

struct PlatformBackend {
    static constexpr int MODE = 0;
    static constexpr bool FLAG = false;
    static constexpr bool READS_LINES = true;
    static std::int64_t position(std::int64_t at) { return at; }
    static constexpr std::int64_t BAD_SEEK = 0;
};
struct StreamBackend {
    static constexpr int MODE = ZOR_Basis::File::FILE_CRT;
    static constexpr bool FLAG = true;
    static constexpr bool READS_LINES = true;
    static std::int64_t position(std::int64_t) { return 0; }
    static constexpr std::int64_t BAD_SEEK = -1;
};
struct DescriptorBackend {
    static constexpr int MODE = ZOR_Basis::File::FILE_CRT;
    static constexpr bool FLAG = false;
    static constexpr bool READS_LINES = false;
    static std::int64_t position(std::int64_t at) { return at; }
    static constexpr std::int64_t BAD_SEEK = -1;
};

template <class Backend>
struct FileOverBackend : testing::Test {
    bool open(ZOR_Basis::File& file, std::string const& name, int mode) const {
        return file.open((scratch / name).c_str(), mode | Backend::MODE, Backend::FLAG);
    }
    static std::string read(ZOR_Basis::File& file, std::uint64_t n) {
        std::string text(n, '?');
        std::uint64_t const bytes = file->read(text.data(), n);
        EXPECT_LE(bytes, n);
        return text.substr(0, bytes);
    }
    static bool write(ZOR_Basis::File& file, std::string const& text) {
        return file->write(text.data(), text.size()) == text.size();
    }

    Scratch scratch;
};

using Backends = testing::Types<PlatformBackend, StreamBackend, DescriptorBackend>;

struct CallsOfFiles : testing::Test {
    CallsOfFiles() { xos_HostCallsReset(); }
    ~CallsOfFiles() override {
        ZOR_Basis::systemCalls = real_;
        xos_HostFailClear();
    }

    std::string at(std::string const& name) const { return scratch / name; }
    std::string last(char const* function) const { return lastCallIn(scratch, function); }
    static std::basic_string<ZOR_Basis::WChar> wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

    Scratch scratch;
    ZOR_Basis::SystemCalls const real_ = ZOR_Basis::systemCalls;
};

#endif
