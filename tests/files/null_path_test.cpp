// A null path is an empty one, and that is what the platform layer gets.

#include <zor_basis/files/dir.h>
#include <zor_basis/files/f_stat.h>
#include <zor_basis/files/file.h>

#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(NullPath, is_handed_on_as_the_empty_one) {
    struct Case {
        Row row;
        char const* function;
        char const* arguments;
        bool (*call)();
    };
    constexpr int CRT = File::FILE_CRT | File::FILE_READ;
    for (Case const& c : {
             Case{{}, "xos_FileOpen", "\"\", 0x42", [] { return File(nullptr, File::FILE_READ, false).isOpen(); }},
             Case{{}, "xos_FileOpen", "\"\", 0x54", [] { return File::New(nullptr, false); }},
             Case{{}, "xos_FileRemove", "\"\", 0x400", [] { return File::Rem(nullptr, true, false); }},
             Case{{}, "xos_FileCopy", "\"\", \"a\", 1", [] { return File::Copy(nullptr, "a", true, false); }},
             Case{{}, "xos_FileCopy", "\"a\", \"\", 0", [] { return File::Copy("a", nullptr, false, false); }},
             Case{{}, "xos_FileMove", "\"\", \"a\", 1", [] { return File::Move(nullptr, "a", true, false); }},
             Case{{}, "xos_FileMove", "\"zb/a\", \"\", 0", [] { return File::Move("zb/a", nullptr, false, false); }},
             Case{{}, "xos_FileRemove", "\"\", 0x400", [] { return File::Move("zb/a", nullptr, false, false); }},
             Case{{}, "xos_FileHardLink", "\"a\", \"\"", [] { return File::LinkOrCopy(nullptr, "a", true, false); }},
             Case{{},
                  "xos_FileCopy",
                  "\"zb/a\", \"\", 1",
                  [] { return File::LinkOrCopy("zb/a", nullptr, true, false); }},
             Case{{}, "xos_FileHardLink", "\"\", \"zb/a\"", [] { return Dir::Link("zb/a", nullptr); }},
             Case{{}, "xos_FileHardLink", "\"a\", \"\"", [] { return Dir::Link(nullptr, "a"); }},
             Case{{}, "xos_DirCreateEx", "\"\", 0", [] { return Dir::New(nullptr, false); }},
             Case{{}, "xos_DirCopy", "\"\", \"a\", 0x200", [] { return Dir::Copy(nullptr, "a", true, false, false); }},
             Case{{},
                  "xos_DirCopy",
                  "\"zb/a\", \"\", 0x0",
                  [] { return Dir::Copy("zb/a", nullptr, false, false, false); }},
             Case{{}, "xos_DirMove", "\"\", \"zb-a\", 0x0", [] { return Dir::Move(nullptr, "zb-a", false, false); }},
             Case{{}, "xos_DirCopy", "\"zb/a\", \"\", 0x201", [] { return Dir::Move("zb/a", nullptr, true, false); }},
             Case{{}, "xos_FileStatByNameEx", "\"\", RECORD, 0x4000", [] { return FStat::exist(nullptr); }},
             Case{{}, "xos_FileStatByNameEx", "\"\", RECORD, 0x4000", [] { return Dir::Exist(nullptr); }},
             Case{{}, nullptr, "", [] { return File(nullptr, CRT, true).isOpen(); }},
             Case{{}, nullptr, "", [] { return File(nullptr, CRT, false).isOpen(); }},
             Case{{}, nullptr, "", [] { return File(static_cast<WChar const*>(nullptr), CRT).isOpen(); }},
             Case{{}, nullptr, "", [] { return FStat(static_cast<WChar const*>(nullptr)).exist(); }},
             Case{{}, nullptr, "", [] { return Dir::NewW(nullptr, false); }},
         }) {
        SCOPED_TRACE(c.row);
        xos_HostCallsReset();
        EXPECT_FALSE(c.call());
        if (c.function == nullptr) continue;
        ASSERT_NE(xos_HostCalls(c.function), 0u);
        std::string text = xos_HostLastCall(c.function);
        std::string const expected = c.arguments;
        // An address is another one each time.
        if (std::size_t const record = expected.find("RECORD"); record != std::string::npos)
            text.replace(record, text.find(',', record) - record, "RECORD");
        EXPECT_EQ(text, expected);
    }
}
