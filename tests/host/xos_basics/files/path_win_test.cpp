#include "host/xos_basics/files/path_win.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(HostPathWin, is_full_without_a_slash_at_its_end_unless_it_is_a_root) {
    struct Case {
        Row row;
        char const* path;
        wchar_t const* full;
        bool isRoot;
    };
    for (Case const& c : {
             Case{{}, "C:/a/b", L"\\\\?\\C:\\a\\b", false},
             Case{{}, "C:\\a\\.\\x\\..\\b\\", L"\\\\?\\C:\\a\\b", false},
             Case{{}, "C:/", L"\\\\?\\C:\\", true},
             Case{{}, "//server/share/a/", L"\\\\?\\UNC\\server\\share\\a", false},
             Case{{}, "//server/share", L"\\\\?\\UNC\\server\\share", true},
             Case{{}, "\\\\?\\C:\\a\\..", L"\\\\?\\C:\\a\\..", false},
         }) {
        SCOPED_TRACE(c.row);
        std::wstring full;
        EXPECT_TRUE(host::fullPath(c.path, full));
        EXPECT_EQ(full, c.full);
        EXPECT_EQ(host::isRoot(full), c.isRoot);
    }
}

TEST(HostPathWin, gets_the_form_without_a_limit_when_it_is_long) {
    std::wstring path;
    EXPECT_TRUE(host::systemPath("a/b", path));
    EXPECT_EQ(path, L"a\\b");
    EXPECT_TRUE(host::systemPath(("C:/" + std::string(250, 'x')).c_str(), path));
    EXPECT_EQ(path, L"\\\\?\\C:\\" + std::wstring(250, L'x'));
    EXPECT_FALSE(host::systemPath("", path));
    EXPECT_EQ(GetLastError(), static_cast<DWORD>(ERROR_PATH_NOT_FOUND));
}

TEST(HostPathWin, knows_where_its_last_name_begins) {
    struct Case {
        Row row;
        wchar_t const* path;
        std::size_t offset;
    };
    for (Case const& c : {Case{{}, L"", 0}, Case{{}, L"a", 0}, Case{{}, L"a\\b", 2}, Case{{}, L"C:b", 2},
                          Case{{}, L"C:\\", 3}, Case{{}, L"a\\b\\", 4}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(host::nameOffset(c.path), c.offset);
    }
    EXPECT_EQ(host::joined(L"", L"n"), L"n");
    EXPECT_EQ(host::joined(L"a", L"n"), L"a\\n");
    EXPECT_EQ(host::joined(L"C:\\", L"n"), L"C:\\n");
}

} // namespace
