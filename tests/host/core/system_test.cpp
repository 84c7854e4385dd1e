#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/host/support/child.h"
#include "tests/host/support/system_error.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <cstring>
#include <string>
#include <thread>

namespace {

using namespace std::chrono_literals;

int sign(int number) { return number < 0 ? -1 : static_cast<int>(number > 0); }

TEST(HostStrCmp, compares_bytes) {
    struct Case {
        Row row;
        char const* a;
        char const* b;
        int expected;
    };
    for (Case const& c : {Case{{}, "", "", 0}, Case{{}, "abc", "abc", 0}, Case{{}, "abc", "abd", -1},
                          Case{{}, "abc", "ab", 1}, Case{{}, "a", "A", 1}, Case{{}, "\x80", "a", 1},
                          Case{{}, nullptr, nullptr, 0}, Case{{}, nullptr, "", -1}, Case{{}, "", nullptr, 1}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(sign(xos_StrCmp(c.a, c.b)), c.expected);
    }
}

class HostRoot : public testing::Test {
protected:
    HostRoot() { clear(); }
    ~HostRoot() override { clear(); }

    static void clear() {
        xos_HostSetRoot(nullptr);
        setVariable("XOS_ROOT", "");
    }
};

TEST_F(HostRoot, is_empty_until_it_is_set) { EXPECT_STREQ(xos_FileSystemRoot(), ""); }

TEST_F(HostRoot, is_what_was_set_just_as_it_was_written) {
    for (char const* const root : {"/srv", "/srv/", "D:\\srv\\system\\", "relative", "/srv"}) {
        xos_HostSetRoot(root);
        EXPECT_STREQ(xos_FileSystemRoot(), root);
    }
}

TEST_F(HostRoot, comes_from_the_environment_where_it_is_not_set) {
    setVariable("XOS_ROOT", "/from/environment");
    EXPECT_STREQ(xos_FileSystemRoot(), "/from/environment");
    xos_HostSetRoot("/set");
    EXPECT_STREQ(xos_FileSystemRoot(), "/set");
    xos_HostSetRoot("");
    EXPECT_STREQ(xos_FileSystemRoot(), "/from/environment");
    xos_HostSetRoot("/set");
    xos_HostSetRoot(nullptr);
    EXPECT_STREQ(xos_FileSystemRoot(), "/from/environment");
}

TEST_F(HostRoot, is_copied_and_stays_readable_after_it_changed) {
    std::string text = "/first";
    xos_HostSetRoot(text.c_str());
    char const* const root = xos_FileSystemRoot();
    text.assign(text.size(), 'x');
    for (int i = 0; i < 100; ++i) { xos_HostSetRoot(std::to_string(i).c_str()); }
    EXPECT_STREQ(root, "/first");
}

TEST_F(HostRoot, is_the_environments_in_a_new_process) {
    Scratch const scratch;
    Child child{programBeside("host_child"), {"root", scratch / "answer"}, {{"XOS_ROOT", "/of/child"}}};
    EXPECT_EQ(child.wait(), 0);
    EXPECT_EQ(textOf(scratch / "answer"), "/of/child");
}

struct Heard {
    int line{0};
    std::string module;
    std::string message;
    int times{0};
};

void hear(int line, char const* module, char const* message, void* context) {
    auto& heard = *static_cast<Heard*>(context);
    heard = {line, module, message, heard.times + 1};
}

TEST(HostAssert, writes_module_line_and_message_and_returns) {
    testing::internal::CaptureStderr();
    xos_Assert(356, "zor_basis", "TimerMgr::add() - already registered!");
    xos_Assert(-1, nullptr, nullptr);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "zor_basis:356: TimerMgr::add() - already registered!\n:-1: \n");
}

TEST(HostAssert, tells_a_handler_instead) {
    Heard heard;
    xos_HostSetAssertHandler(hear, &heard);
    testing::internal::CaptureStderr();
    xos_Assert(100, "module", "message");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    EXPECT_EQ(heard.line, 100);
    EXPECT_EQ(heard.module, "module");
    EXPECT_EQ(heard.message, "message");
    xos_HostSetAssertHandler(nullptr, nullptr);
    testing::internal::CaptureStderr();
    xos_Assert(1, "m", "back");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "m:1: back\n");
    EXPECT_EQ(heard.times, 1);
}

TEST(HostAssert, lets_a_handler_assert_and_take_itself_away) {
    static Heard heard;
    auto* const handler = +[](int line, char const* module, char const* message, void*) {
        xos_HostSetAssertHandler(hear, &heard);
        xos_Assert(line + 1, module, message);
    };
    xos_HostSetAssertHandler(handler, nullptr);
    xos_Assert(1, "m", "nested");
    EXPECT_EQ(heard.line, 2);
    xos_HostSetAssertHandler(nullptr, nullptr);
}

void* resolve(void* module, char const* name) {
    return module == nullptr && std::strcmp(name, "known") == 0 ? reinterpret_cast<void*>(resolve) : nullptr;
}

constexpr std::uint32_t RESOLVER = 0xFFFF8006;

TEST(HostParameters, give_the_resolver_that_was_set) {
    xos_HostSetResolver(resolve);
    xos_HostResolver found = nullptr;
    EXPECT_EQ(xos_BasicsParamLookup(RESOLVER, &found, sizeof found), 8);
    ASSERT_EQ(found, resolve);
    EXPECT_NE(found(nullptr, "known"), nullptr);
    xos_HostSetResolver(nullptr);
}

TEST(HostParameters, are_unknown_otherwise) {
    void* out = nullptr;
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, &out, sizeof out), 1) << "none was set";
    xos_HostSetResolver(resolve);
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER + 1, &out, sizeof out), 1);
    EXPECT_LT(xos_BasicsParamLookup(0, &out, sizeof out), 1);
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, &out, sizeof out - 1), 1) << "no room";
    EXPECT_LT(xos_BasicsParamLookup(RESOLVER, nullptr, sizeof out), 1);
    EXPECT_EQ(out, nullptr) << "nothing was stored";
    xos_HostSetResolver(nullptr);
}

TEST(HostLibrary, is_loaded_by_path) {
    std::string const path = libraryFile("hq_basis");
    void* const library = xos_LibraryLoad(path.c_str());
    ASSERT_NE(library, nullptr);
    EXPECT_EQ(xos_LibraryLoad(path.c_str()), library) << "once loaded it stays the same";
}

TEST(HostLibrary, takes_both_slash_kinds) {
    std::string path = libraryFile("hq_basis");
    std::replace(path.begin(), path.end(), '/', '\\');
    EXPECT_NE(xos_LibraryLoad(path.c_str()), nullptr);
    std::replace(path.begin(), path.end(), '\\', '/');
    EXPECT_NE(xos_LibraryLoad(path.c_str()), nullptr);
}

TEST(HostLibrary, is_null_when_there_is_none) {
    Scratch const scratch;
    put(scratch / "text.so", "no library");
    std::string const text = scratch / "text.so";
    for (char const* const name : {"no-such-library", "", text.c_str(), static_cast<char const*>(nullptr)}) {
        clearSystemError();
        EXPECT_EQ(xos_LibraryLoad(name), nullptr);
        EXPECT_NE(systemError(), 0);
    }
}

bool waitForText(std::string const& path, std::string const& start) {
    auto const end = std::chrono::steady_clock::now() + 30s;
    while (textOf(path).substr(0, start.size()) != start) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(2ms);
    }
    return true;
}

TEST(HostShell, waits_and_gives_the_exit_code) {
    struct Case {
        Row row;
        char const* command;
        std::int64_t code;
    };
    for (Case const& c : {Case{{}, "exit 0", 0}, Case{{}, "exit 1", 1}, Case{{}, "exit 42", 42},
                          Case{{}, "cd & exit 5", 5}, Case{{}, "cd & ", 0}, Case{{}, "", 0}}) {
        SCOPED_TRACE(c.row);
        std::int64_t code = 99;
        EXPECT_EQ(xos_ShellExecuteEx(c.command, &code), 0);
        EXPECT_EQ(code, c.code);
    }
}

TEST(HostShell, succeeds_whatever_the_command_does) {
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx("no-such-command-anywhere", &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_EQ(xos_ShellExecuteEx("exit 3", nullptr), 0);
}

TEST(HostShell, fails_without_a_command_line) {
    std::int64_t code = 99;
    clearSystemError();
    EXPECT_NE(xos_ShellExecuteEx(nullptr, &code), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(code, 99);
}

TEST(HostShell, does_not_wait_without_a_slot) {
    Scratch const scratch;
    auto const start = std::chrono::steady_clock::now();
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + scratch.path() + "& echo first>one").c_str(), nullptr), 0);
    EXPECT_TRUE(waitForText(scratch / "one", "first"));
    EXPECT_LT(std::chrono::steady_clock::now() - start, 30s);
}

class HostShellDirectory : public testing::TestWithParam<char const*> {};

TEST_P(HostShellDirectory, is_changed_to_before_the_command_runs) {
    Scratch const scratch;
    std::string const folder = scratch / GetParam();
    makeFolder(folder);
    std::int64_t code = 99;
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + folder + "& echo there>mark").c_str(), &code), 0);
    EXPECT_EQ(code, 0);
    EXPECT_EQ(textOf(folder + "/mark").substr(0, 5), "there");
}

INSTANTIATE_TEST_SUITE_P(Names, HostShellDirectory,
                         testing::Values("plain", "with blank", "R&D", "it's", "100%", "-", "a(b)", "deep/er"));

TEST(HostShell, runs_no_command_when_the_directory_fails) {
    Scratch const scratch;
    std::int64_t code = 0;
    std::string const mark = scratch / "mark";
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + (scratch / "missing") + "& echo ran>" + mark).c_str(), &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_FALSE(exists(mark));
    put(scratch / "file", "");
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + (scratch / "file") + "& echo ran>" + mark).c_str(), &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_FALSE(exists(mark));
}

TEST(HostShell, takes_a_backslash_for_a_separator) {
    Scratch const scratch;
    makeFolder(scratch / "a/b");
    std::int64_t code = 99;
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + scratch.path() + "\\a\\b& echo there>mark").c_str(), &code), 0);
    EXPECT_EQ(textOf(scratch / "a/b/mark").substr(0, 5), "there");
}

} // namespace
