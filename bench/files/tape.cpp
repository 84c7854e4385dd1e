#include "bench/files/tape.h"

#include <cstring>
#include <vector>

namespace {

class Tape final : public ZOR_Basis::IFile {
public:
    std::uint64_t read(void* buffer, std::uint64_t n) override {
        std::memcpy(buffer, bytes_.data() + at_, n);
        at_ += n;
        return n;
    }
    std::uint64_t write(void const* buffer, std::uint64_t n) override {
        std::memcpy(bytes_.data() + at_, buffer, n);
        at_ += n;
        return n;
    }
    bool flush() override { return true; }
    std::int64_t seek(int, int) override {
        at_ = 0;
        return 0;
    }
    bool isOpen() override { return true; }

private:
    std::vector<char> bytes_ = std::vector<char>(1 << 20);
    std::uint64_t at_ = 0;
};

} // namespace

std::unique_ptr<ZOR_Basis::IFile> makeTape() { return std::make_unique<Tape>(); }
