// What dictionaries do not use of it is tested here; the rest stands in the tests of saving them.

#include "basis/files/replacement.h"

#include "tests/support/scratch.h"
#include "xos_host.h"

#include <zor_basis/files/file.h>

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

constexpr int WHOLE_NEW = File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY;

struct ReplacementOfAFile : testing::Test {
    ~ReplacementOfAFile() override { xos_HostFailClear(); }

    static bool write(Replacement& replacement, std::string const& text) {
        return replacement.content().write(text.data(), text.size()) == text.size();
    }

    Scratch scratch;
    std::string const path = scratch / "file";
};

} // namespace

TEST_F(ReplacementOfAFile, shows_the_new_content_once_it_is_in_place) {
    put(path, "old");
    Replacement replacement;
    ASSERT_TRUE(replacement.open(path.c_str(), WHOLE_NEW));
    EXPECT_TRUE(write(replacement, "new"));
    EXPECT_EQ(textOf(path), "old");
    EXPECT_EQ(scratch.content().size(), 2u) << "the new content lies beside the old one";
    EXPECT_TRUE(replacement.putInPlace());
    EXPECT_EQ(textOf(path), "new");
    EXPECT_EQ(scratch.content(), Names{"file"});
}

TEST_F(ReplacementOfAFile, leaves_the_old_content_where_it_is_given_up) {
    put(path, "old");
    {
        Replacement replacement;
        ASSERT_TRUE(replacement.open(path.c_str(), WHOLE_NEW));
        EXPECT_TRUE(write(replacement, "new"));
    }
    EXPECT_EQ(textOf(path), "old");
    EXPECT_EQ(scratch.content(), Names{"file"});
}

TEST_F(ReplacementOfAFile, removes_what_could_not_be_put_in_place) {
    {
        Replacement replacement;
        ASSERT_TRUE(replacement.open(path.c_str(), WHOLE_NEW));
        EXPECT_TRUE(write(replacement, "new"));
        ASSERT_EQ(xos_HostFail("xos_FileMove", 0, 1), 0);
        EXPECT_FALSE(replacement.putInPlace());
    }
    EXPECT_EQ(scratch.content(), Names{});
}
