// Texts behind which nothing can be read, for Linux only; the Windows build has the same code.

#include "tests/text/last_page_posix.h"
#include "zor_basis/ground/hashing.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(HashDjb2PageEndPosix, reads_nothing_behind_the_terminator) {
    LastPage page;
    for (std::size_t size = 0; size <= 100; ++size) {
        std::string const text(size, '\x9C');
        ASSERT_EQ(hashDjb2(page.textAtTheEnd(text), 0), hashDjb2((text + '\0' + text).c_str(), size)) << size;
    }
}
