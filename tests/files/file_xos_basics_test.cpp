#include <zor_basis/files/file.h>

#include "tests/support/table.h"

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileXosBasicsAtThePlatform : CallsOfFiles {};

} // namespace

TEST_F(FileXosBasicsAtThePlatform, translates_the_mode_for_the_platform) {
    struct Case {
        Row row;
        int mode;
        bool flag;
        char const* flags;
    };
    for (Case const& c : {
             Case{{}, 0x000, false, "0x40"},
             Case{{}, 0x001, false, "0x42"},
             Case{{}, 0x002, false, "0x54"},
             Case{{}, 0x004, false, "0x48"},
             Case{{}, 0x008, false, "0x41"},
             Case{{}, 0x010, false, "0x40"},
             Case{{}, 0x020, false, "0x40"},
             Case{{}, 0x080, false, "0x0"},
             Case{{}, 0x200, false, "0x4000040"},
             Case{{}, 0x001, true, "0x2"},
             Case{{}, 0x081, true, "0x2"},
             Case{{}, 0x00F, false, "0x5f"},
             Case{{}, 0x31, true, "0x2"},
             Case{{}, 0x3A, true, "0x15"},
             Case{{}, 0x226, false, "0x400005c"},
             Case{{}, 0x226, true, "0x400001c"},
             Case{{}, 0x2BF, true, "0x400001f"},
         }) {
        SCOPED_TRACE(c.row);
        File file(at("f").c_str(), c.mode, c.flag);
        EXPECT_EQ(last("xos_FileOpen"), std::string("\"f\", ") + c.flags);
    }
}

TEST_F(FileXosBasicsAtThePlatform, hands_every_argument_to_the_platform) {
    put(at("f"), "one\ntwo\n");
    File file(at("f").c_str(), 0x13);
    char text[64];
    auto const rest = [this](char const* function) {
        std::string const call = last(function);
        return call.substr(call.find(", "));
    };
    auto const behindBuffer = [&](char const* function) {
        std::string const call = rest(function);
        return call.substr(call.find(", ", 2));
    };
    EXPECT_EQ(file->read(text, 3), 3u);
    EXPECT_EQ(behindBuffer("xos_FileReadEx"), ", 3, 0, 0");
    EXPECT_EQ(file->getline(text, sizeof text), 1u);
    EXPECT_EQ(behindBuffer("xos_FileGetsEx"), ", 64, 0");
    EXPECT_EQ(file->seek(2, -4), 4);
    EXPECT_EQ(rest("xos_FileSeekEx"), ", -4, 2, 0");
    EXPECT_EQ(rest("xos_FileTellEx"), ", 0");
    EXPECT_EQ(file->write("TW", 2), 2u);
    EXPECT_EQ(behindBuffer("xos_FileWriteEx"), ", 2, 0, 0");
    EXPECT_TRUE(file->flush());
    EXPECT_EQ(xos_HostCalls("xos_FileFlush"), 1u);
    file.close();
    EXPECT_EQ(rest("xos_FileCloseEx"), ", 0");
    EXPECT_EQ(textOf(at("f")), "one\nTWo\n");
}

TEST_F(FileXosBasicsAtThePlatform, reports_what_the_platform_fails_at) {
    put(at("f"), "one\ntwo\n");
    File file;
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(file.open(at("f").c_str(), 0x13));
    EXPECT_TRUE(!*file.ptr());
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 0u);
    ASSERT_TRUE(file.open(at("f").c_str(), 0x13));
    char text[64] = {};
    xos_HostFail("xos_FileReadEx", 0, 1);
    EXPECT_EQ(file->read(text, 1), 0u);
    xos_HostFail("xos_FileGetsEx", 0, 1);
    text[63] = 'x';
    EXPECT_EQ(file->getline(text, sizeof text), 0u);
    EXPECT_EQ(text[63], '\0');
    xos_HostFail("xos_FileWriteEx", 0, 1);
    EXPECT_EQ(file->write("x", 1), 0u);
    xos_HostFail("xos_FileFlush", 0, 1);
    EXPECT_FALSE(file->flush());
    std::uint64_t const told = xos_HostCalls("xos_FileTellEx");
    xos_HostFail("xos_FileSeekEx", 0, 1);
    EXPECT_EQ(file->seek(0, 3), 0);
    EXPECT_EQ(xos_HostCalls("xos_FileTellEx"), told);
    xos_HostFail("xos_FileTellEx", 0, 1);
    EXPECT_EQ(file->seek(0, 3), -1);
    xos_HostFail("xos_FileCloseEx", 0, 1);
    file.close();
    EXPECT_EQ(file.ptr(), nullptr);
    EXPECT_EQ(textOf(at("f")), "one\ntwo\n");
}
