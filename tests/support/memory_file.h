/// \file
/// A file in memory that counts its calls and has limited room.

#ifndef TESTS_SUPPORT_MEMORY_FILE_H
#define TESTS_SUPPORT_MEMORY_FILE_H

#include <zor_basis/files/i_file.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <string>

class MemoryFile : public ZOR_Basis::IFile {
public:
    explicit MemoryFile(std::string const& bytes = "") : content(bytes) {}

    std::uint64_t read(void* buffer, std::uint64_t n) override {
        ++reads;
        n = std::min<std::uint64_t>(n, content.size() - position);
        if (n != 0) std::memcpy(buffer, content.data() + position, n);
        position += n;
        return n;
    }
    std::uint64_t write(void const* buffer, std::uint64_t n) override {
        ++writes;
        n = std::min<std::uint64_t>(n, room);
        room -= n;
        content.append(static_cast<char const*>(buffer), n);
        return n;
    }
    bool flush() override { return true; }
    std::int64_t seek(int, int) override { return -1; }
    bool isOpen() override { return true; }

    std::string content;
    std::uint64_t position = 0;
    std::uint64_t room = ~std::uint64_t{0};
    int reads = 0;
    int writes = 0;
};

#endif
