// Names beyond the code page, made, listed and opened.

#include <zor_basis/files.h>

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <set>

using namespace ZOR_Basis;

namespace {

using WideText = std::basic_string<WChar>;

WideText const ODD = L"\u4E2D\u6587 \u0434\u043E\u043A \xD83D\xDDA8";

WideText wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

} // namespace

TEST(DirIteratorNamesWin, reach_beyond_the_code_page) {
    Scratch scratch;
    WideText const folder = wide(scratch.path()) + L"/" + ODD;
    EXPECT_TRUE(Dir::NewW((folder + L"\\" + ODD).c_str(), true));
    EXPECT_TRUE(Dir::NewForW((folder + L"/deeper/file").c_str()));
    WideText const path = folder + L"/file \u20AC\u0141";
    {
        File file(path.c_str(), 0x3A);
        ASSERT_TRUE(file.isOpen());
        EXPECT_EQ(file->write("123", 3), 3u);
    }
    FStat const entry(path.c_str());
    EXPECT_TRUE(entry.isFile());
    EXPECT_EQ(entry.size(), 3u);
    EXPECT_TRUE(FStat(folder.c_str()).isDir());
    std::set<WideText> names;
    DirIteratorW list(LOOK_ALL, folder.c_str());
    while (WChar const* name = list->next()) names.insert(name);
    EXPECT_EQ(names, (std::set<WideText>{ODD, L"deeper", L"file \u20AC\u0141"}));
    File file;
    ASSERT_TRUE(file.openW(path.c_str(), 0x31));
    char text[4] = {};
    EXPECT_EQ(file->read(text, 4), 3u);
    EXPECT_STREQ(text, "123");
}
