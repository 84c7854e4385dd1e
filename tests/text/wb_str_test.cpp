#include "zor_basis/text/wb_str.h"

#include "tests/support/table.h"
#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

using namespace ZOR_Basis;

namespace {

using WText = std::basic_string<WChar>;

#if defined(__GNUC__)
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor" // as WBStr itself, never deleted through a base
#endif

/// Records its calls of the heap.
class Recording : public WBStr {
public:
    using WBStr::operator=;
    std::vector<std::uint64_t> blocks;
    int released = 0;
    bool zeroed = true;

protected:
    WChar* alloc(std::uint64_t count) override {
        blocks.push_back(count);
        WChar* block = WBStr::alloc(count);
        zeroed = zeroed && std::all_of(block, block + count, [](WChar unit) { return unit == 0; });
        return block;
    }
    void free() override {
        ++released;
        WBStr::free();
    }
};

} // namespace

TEST(WBStr, breathes) {
    WBStr name(ZB_W("tray"));
    name += WChar('1');
    name.insert(0, ZB_W("upper "));
    EXPECT_TRUE(name == ZB_W("upper tray1"));
    EXPECT_EQ(name.size(), 11U);
}

TEST(WBStr, holds_255_units_by_appending_and_254_by_assigning) {
    WText const text(255, WChar('x'));
    EXPECT_EQ(WBStr(text.c_str()).sizeBuf(), 256U);
    WBStr appended;
    appended.add(text.c_str());
    EXPECT_EQ(appended.sizeBuf(), 255U);
    EXPECT_TRUE(isInside(appended));
}

TEST(WBStr, its_virtual_operations_make_and_release_every_block) {
    Recording s;
    s = WText(300, WChar('x')).c_str();
    EXPECT_EQ(s.blocks, std::vector<std::uint64_t>{302}) << "capacity 301 and the terminator";
    EXPECT_EQ(s.released, 0) << "the inside area is never released";
    s.add(ZB_W("yz"));
    EXPECT_EQ(s.blocks.back(), 303U);
    EXPECT_EQ(s.released, 1);
    s.insert(1, ZB_W("abc"));
    EXPECT_EQ(s.blocks.back(), 306U);
    EXPECT_EQ(s.released, 2);
    s.toUpper(WText(400, WChar('q')).c_str());
    EXPECT_EQ(s.blocks.back(), 401U);
    EXPECT_EQ(s.released, 3);
    s.extendBuf(500);
    EXPECT_EQ(s.blocks.back(), 501U);
    EXPECT_EQ(s.released, 4);
    EXPECT_EQ(s.blocks.size(), 5U);
    EXPECT_TRUE(s.zeroed);
}

TEST(WBStr, sets_its_size_without_looking) {
    WBStr s(ZB_W("abcdef"));
    s.setSize(2);
    EXPECT_TRUE(s == ZB_W("ab"));
    s.getBuf()[2] = 'x';
    s.setSize(4);
    EXPECT_EQ(s.size(), 4U);
    EXPECT_EQ(contentOf(s), (WText{'a', 'b', 'x', 'd'}));
}

TEST(WBStr, changes_case_up_to_the_terminator) {
    WBStr s(ZB_W("aB-cD"));
    s.toUpper();
    EXPECT_TRUE(s == ZB_W("AB-CD"));
    s[2] = 0;
    s.toLower();
    EXPECT_EQ(contentOf(s), (WText{'a', 'b', 0, 'C', 'D'}));
}

TEST(WBStr, becomes_a_text_in_the_other_case) {
    struct Case {
        Row row;
        WChar const* source;
        std::uint64_t n;
        WText lower;
        WText upper;
    };
    for (Case const& c :
         {Case{{}, ZB_W("aB1"), 0, {'a', 'b', '1'}, {'A', 'B', '1'}}, Case{{}, ZB_W("aB1"), 2, {'a', 'b'}, {'A', 'B'}},
          Case{{}, ZB_W("aB1"), 5, {'a', 'b', '1', 0, 0}, {'A', 'B', '1', 0, 0}}, Case{{}, ZB_W(""), 0, {}, {}},
          Case{{}, nullptr, 4, {}, {}}}) {
        SCOPED_TRACE(c.row);
        WBStr s(ZB_W("an older and longer text"));
        EXPECT_EQ(&s.toLower(c.source, c.n), &s);
        EXPECT_EQ(contentOf(s), c.lower);
        EXPECT_EQ(&s.toUpper(c.source, c.n), &s);
        EXPECT_EQ(contentOf(s), c.upper);
        EXPECT_TRUE(isTerminated(s) && isInside(s));
    }
    WBStr own(ZB_W("xaBc"));
    own.toUpper(own.wstr() + 1);
    EXPECT_TRUE(own == ZB_W("ABC"));
    WBStr far(WText(600, WChar('a')).c_str());
    far.toUpper(far.wstr(), 700);
    EXPECT_EQ(contentOf(far).substr(0, 601), WText(600, WChar('A')) + WChar());
}

TEST(WBStr, Kept_wide_03_a_new_block_has_room_for_the_changed_text_alone) {
    WText const text(255, WChar('a'));
    WBStr s;
    s.toUpper(text.c_str());
    EXPECT_EQ(s.sizeBuf(), 255U);
    EXPECT_FALSE(isInside(s)) << "a capacity of 255 is below 255 + 1";
    EXPECT_EQ(contentOf(s), WText(255, WChar('A')));
    WBStr fits;
    fits.toUpper(text.c_str(), 254);
    EXPECT_TRUE(isInside(fits));
    Recording again;
    again.toUpper(text.c_str());
    again.toUpper(text.c_str());
    EXPECT_EQ(again.blocks, (std::vector<std::uint64_t>{256, 256})) << "its own capacity is too small again";
    again.toUpper(text.c_str(), 254);
    EXPECT_EQ(again.blocks.size(), 2U);
}
