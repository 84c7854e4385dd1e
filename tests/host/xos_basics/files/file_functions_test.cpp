#include "basis/platform/xos_basics.h"
#include "tests/host/support/fault_scratch.h"
#include "tests/support/thread_facts.h"

namespace {

struct HostFileFaults : FaultScratch {};

} // namespace

TEST_F(HostFileFaults, fail_each_function_of_whole_files_once) {
    put(scratch / "a", "a");
    std::string const a = scratch / "a";
    std::string const b = scratch / "b";
    std::string const c = scratch / "c";
    failsOnce("xos_FileCopy", [&] { return xos_FileCopy(b.c_str(), a.c_str(), 0) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_FileCopy")}, "\"" + b + "\", \"" + a + "\", 0");
    failsOnce("xos_FileMove", [&] { return xos_FileMove(c.c_str(), b.c_str(), 1) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_FileMove")}, "\"" + c + "\", \"" + b + "\", 1");
    failsOnce("xos_FileHardLink", [&] { return xos_FileHardLink(a.c_str(), b.c_str()) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_FileHardLink")}, "\"" + a + "\", \"" + b + "\"");
    xos_Stat record{};
    failsOnce("xos_FileStatByNameEx", [&] { return xos_FileStatByNameEx(a.c_str(), &record, 0x4000) == 0; });
    failsOnce("xos_FileRemove", [&] { return xos_FileRemove(a.c_str(), 0x400) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_FileRemove")}, "\"" + a + "\", 0x400");
    EXPECT_EQ(scratch.content(), (Names{"b", "c"}));
}

TEST_F(HostFileFaults, fail_each_function_of_an_open_file_once) {
    xos_File file = 0;
    failsOnce("xos_FileOpen", [&] { return (file = xos_FileOpen((scratch / "f").c_str(), 0x17)) != 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_FileOpen")}, "\"" + (scratch / "f") + "\", 0x17");
    failsOnce("xos_FileWriteEx", [&] { return xos_FileWriteEx(file, "ab\ncd\n", 6, 0, 0) != 0; });
    EXPECT_EQ(textOf(scratch / "f"), "ab\ncd\n");
    failsOnce("xos_FileSeekEx", [&] { return xos_FileSeekEx(file, 1, 0, 0) == 0; });
    failsOnce("xos_FileTellEx", [&] { return xos_FileTellEx(file, 0) == 1; });
    char buffer[8] = "unread";
    failsOnce("xos_FileReadEx", [&] { return xos_FileReadEx(file, buffer, 1, 0, 0) == 1; });
    EXPECT_STREQ(buffer, "bnread");
    failsOnce("xos_FileGetsEx", [&] { return xos_FileGetsEx(file, buffer, 8, 0) == buffer; });
    EXPECT_STREQ(buffer, "\n");
    failsOnce("xos_FileFlush", [&] { return xos_FileFlush(file) == 0; });
    EXPECT_EQ(xos_FileTellEx(file, 0), 3);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}

TEST_F(HostFileFaults, say_minus_one_for_a_position_that_is_not_told) {
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x16);
    ASSERT_EQ(xos_HostFail("xos_FileTellEx", 0, 1), 0);
    EXPECT_EQ(xos_FileTellEx(file, 0), -1);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}

TEST_F(HostFileFaults, fail_a_close_that_closes_all_the_same) {
    std::size_t const before = openHandles();
    ASSERT_EQ(xos_HostFail("xos_FileCloseEx", 0, 10), 0);
    for (int round = 0; round < 10; ++round) {
        xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x16);
        ASSERT_NE(file, 0U) << round;
        clearSystemError();
        ASSERT_NE(xos_FileCloseEx(file, 0), 0);
        ASSERT_EQ(systemError(), INJECTED_ERROR);
        ASSERT_EQ(openHandles(), before) << round;
    }
}
