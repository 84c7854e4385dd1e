#include "zor_basis/text/auto_ptr_cstr.h"

#include <gtest/gtest.h>

#include <cstring>
#include <limits>
#include <new>
#include <type_traits>

// These tests request more memory than exists, which the address sanitizer permits only with this option.
extern "C" [[gnu::visibility("default")]] char const* __asan_default_options() { return "allocator_may_return_null=1"; }

static_assert(!std::is_copy_constructible_v<Auto_ptr_CStr> && !std::is_copy_assignable_v<Auto_ptr_CStr>);

TEST(AutoPtrCStr, breathes) {
    Auto_ptr_CStr buffer(8U);
    EXPECT_STREQ(buffer.c_str(), "");
    EXPECT_EQ(buffer.length(), 8U);
    std::strcpy(buffer, "12345678");
    EXPECT_STREQ(buffer.c_str(), "12345678");
}

TEST(AutoPtrCStr, has_two_bytes_more_than_its_length) {
    for (unsigned n : {0U, 1U, 2U, 15U, 4096U}) {
        Auto_ptr_CStr buffer(n);
        EXPECT_EQ(buffer.length(), n);
        std::memset(buffer, 'x', n + 2);
        buffer.assureTerm0();
    }
}

TEST(AutoPtrCStr, holds_a_text_with_its_terminator) {
    Auto_ptr_CStr buffer(std::string("a\0bc", 4));
    EXPECT_EQ(buffer.length(), 4U);
    EXPECT_EQ(std::memcmp(buffer.c_str(), "a\0bc", 5), 0);
    EXPECT_EQ(Auto_ptr_CStr("abc").length(), 3U);
    EXPECT_EQ(Auto_ptr_CStr(std::string()).length(), 0U);
    EXPECT_STREQ(Auto_ptr_CStr(std::string()).c_str(), "");
}

TEST(AutoPtrCStr, Kept_text_14_the_last_counted_byte_becomes_the_terminator) {
    Auto_ptr_CStr text(std::string("abc"));
    text.assureTerm0();
    EXPECT_STREQ(text.c_str(), "ab");
    Auto_ptr_CStr full(4U);
    std::memcpy(full, "wxyz!", 6);
    full.assureTerm0();
    EXPECT_STREQ(full.c_str(), "wxy");
    Auto_ptr_CStr none(0U);
    none.assureTerm0();
    EXPECT_STREQ(none.c_str(), "");
}

TEST(AutoPtrCStr, throws_where_no_memory_can_be_had) {
    std::uint64_t const most = std::numeric_limits<std::uint64_t>::max();
    for (std::uint64_t n : {most, most - 1, most - 2, most / 2}) EXPECT_THROW(Auto_ptr_CStr{n}, std::bad_alloc) << n;
}
