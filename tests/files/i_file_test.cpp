#include <zor_basis/files/i_file.h>

#include <gtest/gtest.h>

#include <memory>

using namespace ZOR_Basis;

namespace {

/// A backend with nothing but what it must have.
struct BareFile : IFile {
    explicit BareFile(int& closings) : closings_(closings) {}
    ~BareFile() override { ++closings_; }
    std::uint64_t read(void* /*buffer*/, std::uint64_t /*n*/) override { return 0; }
    std::uint64_t write(void const* /*buffer*/, std::uint64_t /*n*/) override { return 0; }
    bool flush() override { return false; }
    std::int64_t seek(int /*origin*/, int /*offset*/) override { return 0; }
    bool isOpen() override { return open; }

    bool open = false;

private:
    int& closings_;
};

} // namespace

TEST(IFile, has_no_lines_of_its_own_and_touches_no_buffer) {
    int closings = 0;
    BareFile file(closings);
    char line[] = "##";
    EXPECT_EQ(file.getline(line, sizeof line), 0u);
    EXPECT_STREQ(line, "##");
}

TEST(IFile, is_closed_through_its_interface) {
    int closings = 0;
    std::unique_ptr<IFile> file = std::make_unique<BareFile>(closings);
    EXPECT_EQ(closings, 0);
    file.reset();
    EXPECT_EQ(closings, 1);
}

TEST(IFile, is_false_while_it_is_not_open) {
    int closings = 0;
    BareFile file(closings);
    EXPECT_TRUE(!file);
    file.open = true;
    EXPECT_FALSE(!file);
}
