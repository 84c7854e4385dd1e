#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

namespace {

class HostConfiguration : public testing::Test {
protected:
    HostConfiguration() {
        clear();
        xos_HostSetConfigDir(scratch.path().c_str());
    }
    ~HostConfiguration() override { clear(); }

    static void clear() {
        xos_HostSetConfigDir(nullptr);
        xos_HostSetRoot(nullptr);
        setVariable("XOS_CONFIG", "");
        setVariable("XOS_ROOT", "");
    }

    /// Writes a group and reads one switch of it.
    int read(std::string const& text, char const* key, int fallback) const {
        put(scratch / "group.cfg", text);
        cfg_Group* const group = cfg_GroupLoadFromFile("group", 0, 0, 0);
        EXPECT_NE(group, nullptr);
        int const value = cfg_KeyGetOpt_Bool(group, key, fallback);
        cfg_GroupDelete(group, 0);
        return value;
    }

    Scratch scratch;
};

TEST_F(HostConfiguration, reads_a_switch) {
    EXPECT_EQ(read("vipp = true\n", "vipp", 0), 1);
    EXPECT_EQ(read("vipp = false\n", "vipp", 1), 0);
}

TEST_F(HostConfiguration, reads_lines_as_they_are_written) {
    struct Case {
        Row row;
        char const* text;
        int value;
    };
    constexpr int FALLBACK = 7;
    for (Case const& c : {
             Case{{}, "key = true", 1},
             Case{{}, "key=yes", 1},
             Case{{}, "  key\t=\ton  \r\n", 1},
             Case{{}, "key = 1", 1},
             Case{{}, "key = false", 0},
             Case{{}, "key = no", 0},
             Case{{}, "key = off", 0},
             Case{{}, "key = 0", 0},
             Case{{}, "key = TRUE", 1},
             Case{{}, "key = Off", 0},
             Case{{}, "# key = true", FALLBACK},
             Case{{}, "   # key = true", FALLBACK},
             Case{{}, "key = true # as it was", 1},
             Case{{}, "key = true#1", FALLBACK},
             Case{{}, "", FALLBACK},
             Case{{}, "\n\n\r\n  \nkey = 1\n", 1},
             Case{{}, "other = 1", FALLBACK},
             Case{{}, "Key = 1", FALLBACK},
             Case{{}, "key = 1\nkey = 0", 0},
             Case{{}, "key = 0\nkey = 1", 1},
             Case{{}, "\xEF\xBB\xBFkey = 1", 1},
             Case{{}, "key = a = 1", FALLBACK},
             Case{{}, "key =", FALLBACK},
             Case{{}, "key = 2", FALLBACK},
             Case{{}, "key = tru", FALLBACK},
             Case{{}, "key = truee", FALLBACK},
         }) {
        SCOPED_TRACE(c.row);
        testing::internal::CaptureStderr();
        EXPECT_EQ(read(c.text, "key", FALLBACK), c.value);
        testing::internal::GetCapturedStderr();
    }
}

TEST_F(HostConfiguration, reports_a_malformed_line_once_and_skips_it) {
    std::string const text = "first = 1\nwhat is this\n= 1\nkey = on\n";
    testing::internal::CaptureStderr();
    EXPECT_EQ(read(text, "key", 0), 1);
    EXPECT_EQ(read(text, "first", 0), 1);
    std::string const reported = testing::internal::GetCapturedStderr();
    std::string const file = scratch / "group.cfg";
    std::size_t const second = reported.find(file + ":2: ");
    std::size_t const third = reported.find(file + ":3: ");
    EXPECT_NE(second, std::string::npos) << reported;
    EXPECT_NE(third, std::string::npos) << reported;
    EXPECT_EQ(reported.find(file, third + 1), std::string::npos) << "once only: " << reported;
    EXPECT_EQ(reported.find(file + ":1:"), std::string::npos);
    EXPECT_EQ(reported.find(file + ":4:"), std::string::npos);
}

TEST_F(HostConfiguration, reports_a_value_that_is_no_switch_once) {
    testing::internal::CaptureStderr();
    EXPECT_EQ(read("key = perhaps\n", "key", 3), 3);
    EXPECT_EQ(read("key = perhaps\n", "key", 4), 4);
    std::string const reported = testing::internal::GetCapturedStderr();
    std::string const place = (scratch / "group.cfg") + ":1: ";
    EXPECT_EQ(reported.find(place), 0u) << reported;
    EXPECT_EQ(reported.find(place, 1), std::string::npos) << reported;
}

TEST_F(HostConfiguration, has_no_group_where_there_is_no_file) {
    makeFolder(scratch / "folder.cfg");
    put(scratch / "outside.cfg", "key = 1\n");
    makeFolder(scratch / "inner");
    xos_HostSetConfigDir((scratch / "inner").c_str());
    for (char const* const name :
         {"missing", "", "../outside", "..\\outside", static_cast<char const*>(nullptr), "folder"}) {
        clearSystemError();
        EXPECT_EQ(cfg_GroupLoadFromFile(name, 0, 0, 0), nullptr);
        EXPECT_NE(systemError(), 0);
    }
    xos_HostSetConfigDir(scratch.path().c_str());
    EXPECT_EQ(cfg_GroupLoadFromFile("folder", 0, 0, 0), nullptr);
}

TEST_F(HostConfiguration, gives_the_fallback_without_group_or_key) {
    put(scratch / "group.cfg", "key = 1\n");
    cfg_Group* const group = cfg_GroupLoadFromFile("group", 0, 0, 0);
    EXPECT_EQ(cfg_KeyGetOpt_Bool(nullptr, "key", 5), 5);
    EXPECT_EQ(cfg_KeyGetOpt_Bool(group, nullptr, 5), 5);
    EXPECT_EQ(cfg_KeyGetOpt_Bool(group, "", 5), 5);
    cfg_GroupDelete(group, 0);
    cfg_GroupDelete(nullptr, 0);
}

TEST_F(HostConfiguration, keeps_a_group_as_it_was_loaded) {
    put(scratch / "group.cfg", "key = 1\n");
    cfg_Group* const before = cfg_GroupLoadFromFile("group", 0, 0, 0);
    put(scratch / "group.cfg", "key = 0\n");
    cfg_Group* const after = cfg_GroupLoadFromFile("group", 0, 0, 0);
    EXPECT_EQ(cfg_KeyGetOpt_Bool(before, "key", 9), 1);
    EXPECT_EQ(cfg_KeyGetOpt_Bool(after, "key", 9), 0);
    cfg_GroupDelete(before, 0);
    cfg_GroupDelete(after, 0);
}

TEST_F(HostConfiguration, is_found_in_the_folder_set_in_the_environments_and_beneath_the_root) {
    makeFolder(scratch / "set");
    makeFolder(scratch / "environment");
    makeFolder(scratch / "root/config");
    put(scratch / "set/g.cfg", "key = 0");
    put(scratch / "environment/g.cfg", "key = 1");
    put(scratch / "root/config/g.cfg", "key = on\nroot = on\n");
    auto const value = [](char const* key) {
        cfg_Group* const group = cfg_GroupLoadFromFile("g", 0, 0, 0);
        int const found = cfg_KeyGetOpt_Bool(group, key, 9);
        cfg_GroupDelete(group, 0);
        return found;
    };
    xos_HostSetRoot((scratch / "root").c_str());
    setVariable("XOS_CONFIG", scratch / "environment");
    xos_HostSetConfigDir((scratch / "set").c_str());
    EXPECT_EQ(value("key"), 0);
    xos_HostSetConfigDir(nullptr);
    EXPECT_EQ(value("key"), 1);
    EXPECT_EQ(value("root"), 9);
    setVariable("XOS_CONFIG", "");
    EXPECT_EQ(value("root"), 1);
    xos_HostSetRoot((scratch / "root/").c_str());
    EXPECT_EQ(value("root"), 1);
}

TEST_F(HostConfiguration, is_the_environments_in_a_new_process) {
    put(scratch / "child.cfg", "key = on\n");
    Child configured{programBeside("host_child"), {"switch", "child", "key", "7"}, {{"XOS_CONFIG", scratch.path()}}};
    EXPECT_EQ(configured.wait(), 1);
    makeFolder(scratch / "config");
    put(scratch / "config/child.cfg", "key = off\n");
    Child rooted{programBeside("host_child"), {"switch", "child", "key", "7"}, {{"XOS_ROOT", scratch.path()}}};
    EXPECT_EQ(rooted.wait(), 0);
    Child missing{programBeside("host_child"), {"switch", "nothing", "key", "7"}, {{"XOS_CONFIG", scratch.path()}}};
    EXPECT_EQ(missing.wait(), 98);
}

} // namespace
