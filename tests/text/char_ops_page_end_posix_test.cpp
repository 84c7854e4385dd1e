// Nothing behind a terminator is read, whatever length is given. The page behind the text is made unreadable, for Linux
// only; the Windows build has the same code.

#include "tests/text/last_page_posix.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(CharOpsAtPageEndPosix, is_read_up_to_its_terminator_only) {
    LastPage first;
    LastPage second;
    for (std::size_t size = 1; size < 400; size += size < 70 ? 1 : 9) {
        std::string const text(size, 'x');
        char const* a = first.textAtTheEnd(text);
        char const* b = second.textAtTheEnd(text);
        for (std::uint64_t claimed : {size, size + 1, size + 9, size + 40, size + 200, size + 5000}) {
            std::string padded = text;
            padded.resize(claimed);
            BufStr<255> const made(a, claimed);
            ASSERT_EQ(std::string(made, made.size()), padded) << size << ' ' << claimed;
            ASSERT_TRUE(Str(a, claimed) == Str(b, claimed));
            ASSERT_EQ(Str(a, claimed).compare(Str(b, claimed)), 0);
            ASSERT_TRUE(Str(a).beginWith(Str(b, claimed)));
            ASSERT_EQ(HeapStr(a, claimed).size(), claimed);
        }
        ASSERT_EQ(BufStr<15>(a).size(), size);
        for (std::size_t place = size > 40 ? size - 40 : 0; place < size; ++place) {
            std::string greater = text;
            greater[place] = 'y';
            char const* c = second.textAtTheEnd(greater);
            ASSERT_FALSE(Str(a, size) == Str(c, size)) << size << ' ' << place;
            ASSERT_EQ(Str(a, size).compare(Str(c, size)), -1) << size << ' ' << place;
            ASSERT_EQ(Str(c, size).compare(Str(a, size + 9)), 1) << size << ' ' << place;
        }
    }
}

TEST(CharOpsAtPageEndPosix, wide_text_is_read_up_to_its_terminator_only) {
    LastPage first;
    LastPage second;
    for (std::size_t size = 1; size < 300; ++size) {
        std::basic_string<WChar> const text(size, WChar('x'));
        WChar const* a = first.textAtTheEnd(text);
        WChar const* b = second.textAtTheEnd(text);
        ASSERT_EQ(WBStr(a, size + 40).size(), size + 40);
        ASSERT_TRUE(WStr(a, size + 40) == WStr(b, size + 40));
        ASSERT_EQ(WStr(a).compare(b, size + 40), 0);
    }
}
