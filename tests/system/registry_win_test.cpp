#include "basis/system/registry_win.h"

#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

constexpr char KEY[] = "Software\\zb_registry_test";

struct RegistryKeyWin : RegistryScratch {};

} // namespace

TEST_F(RegistryKeyWin, reads_texts_as_long_as_its_first_buffer) {
    struct Case {
        Row row;
        std::size_t size; ///< in bytes, with the terminator
        RegistryKey::Growth growth;
        bool isRead;
    };
    for (Case const& c : {
             Case{{}, 2, RegistryKey::FIXED, true},
             Case{{}, VALUE_ROOM, RegistryKey::FIXED, true},
             Case{{}, VALUE_ROOM + 1, RegistryKey::FIXED, false},
             Case{{}, VALUE_ROOM + 1, RegistryKey::ONCE, true},
             Case{{}, 40 * VALUE_ROOM, RegistryKey::ONCE, true},
         }) {
        SCOPED_TRACE(c.row);
        std::string const text(c.size - 1, 't');
        set(HKEY_CURRENT_USER, KEY, "value", text);
        Blob buffer;
        RegistryKey const key(HKEY_CURRENT_USER, KEY);
        ASSERT_EQ(key.read("value", buffer, c.growth), c.isRead);
        if (c.isRead) { EXPECT_EQ(std::string(buffer.val(), buffer.size() - 1), text); }
    }
}

TEST_F(RegistryKeyWin, knows_which_values_there_are_and_reads_texts_only) {
    setRaw(HKEY_CURRENT_USER, KEY, "number", "ab", REG_DWORD);
    set(HKEY_CURRENT_USER, KEY, "text", "abc");
    RegistryKey const key(HKEY_CURRENT_USER, KEY);
    EXPECT_TRUE(key.isOpen() && key.has("number") && key.has("text"));
    EXPECT_FALSE(key.has("none"));
    BufStr<15> text("before");
    EXPECT_FALSE(key.read("number", text));
    EXPECT_FALSE(key.read("none", text));
    EXPECT_STREQ(text.c_str(), "before");
    EXPECT_TRUE(key.read("text", text));
    EXPECT_STREQ(text.c_str(), "abc");
}

TEST_F(RegistryKeyWin, has_nothing_where_it_could_not_be_opened) {
    RegistryKey const key(HKEY_CURRENT_USER, "Software\\zb_no_such_key");
    BufStr<15> text("before");
    EXPECT_FALSE(key.isOpen() || key.has("value") || key.read("value", text));
    EXPECT_STREQ(text.c_str(), "before");
}
