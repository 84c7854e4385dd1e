// Linux only, as the page behind a text is taken away here: nothing behind the size is read. The Windows build has the
// same code.

#include <zor_basis/files/f_path.h>
#include <zor_basis/system/parse.h>

#include <gtest/gtest.h>

#include <sys/mman.h>

#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::size_t PAGE_SIZE = 4096;

/// Three pages, of which only the middle one can be read.
class OnePage {
public:
    OnePage() {
        void* const pages = mmap(nullptr, 3 * PAGE_SIZE, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        begin_ = static_cast<char*>(pages) + PAGE_SIZE;
        mprotect(begin_ - PAGE_SIZE, PAGE_SIZE, PROT_NONE);
        mprotect(begin_ + PAGE_SIZE, PAGE_SIZE, PROT_NONE);
    }
    ~OnePage() { munmap(begin_ - PAGE_SIZE, 3 * PAGE_SIZE); }
    OnePage(OnePage const&) = delete;
    OnePage& operator=(OnePage const&) = delete;

    ZB_Parse atTheEnd(std::string const& text) const {
        std::memcpy(begin_ + PAGE_SIZE - text.size(), text.data(), text.size());
        return {begin_ + PAGE_SIZE - text.size(), static_cast<int>(text.size())};
    }
    ZB_Parse atTheFront(std::string const& text) const {
        std::memcpy(begin_, text.data(), text.size());
        return {begin_, static_cast<int>(text.size())};
    }

private:
    char* begin_;
};

} // namespace

TEST(ParseAtThePagesEndPosix, reads_no_byte_outside_of_the_text) {
    OnePage const page;
    char out[401];
    for (std::size_t size = 1; size < 300; ++size) {
        SCOPED_TRACE(size);
        for (char const* end : {"", "\n", " ", "\n  \r"}) {
            std::string const text = std::string(size, 'x') + end;
            bool const hasEnd = *end == '\n';
            for (bool const front : {false, true}) {
                auto const parse = [&] { return front ? page.atTheFront(text) : page.atTheEnd(text); };
                ZB_Parse lines = parse();
                int length = 0;
                ASSERT_EQ(lines.getLine(400, out, &length), hasEnd);
                ASSERT_EQ(length, static_cast<int>(size + (*end == ' ' ? 1 : 0)));
                ASSERT_FALSE(lines.getLine(400, out, &length));
                ASSERT_EQ(length, 0);
                lines.skipBlanks();
                ASSERT_TRUE(lines.isDataEnd());
                ASSERT_FALSE(parse().checkLine("y"));
                ASSERT_EQ(parse().checkLine(std::string(size, 'x').c_str()),
                          size <= 256 && (*end != ' ' || size == 256));
                FPath path;
                ASSERT_FALSE(parse().getCleanFileName(path, false, true));
                ASSERT_EQ(path.size(), std::min<std::size_t>(255, size + (*end == ' ' ? 1 : 0)));
            }
        }
    }
}

TEST(ParseAtThePagesEndPosix, skips_blanks_up_to_the_end_only) {
    OnePage const page;
    for (std::size_t size = 1; size < 100; ++size) {
        std::string const text(size, ' ');
        ZB_Parse blanks = page.atTheEnd(text);
        ASSERT_EQ(blanks.skipBlanks(), ' ');
        ASSERT_EQ(blanks.skipBlanks(), 0);
        char out[2];
        ASSERT_FALSE(page.atTheEnd(text).getLine(1, out, nullptr));
        ASSERT_TRUE(page.atTheEnd(text).checkLine(""));
        FPath path("before");
        ASSERT_FALSE(page.atTheEnd(text).getCleanFileName(path, false, false));
        ASSERT_STREQ(path.c_str(), "before");
    }
}
