#include "tests/zbtool/prepared_child_posix.h"
#include "tests/zbtool/tool.h"

#include "tests/support/memory_folder_posix.h"
#include "tests/support/skip.h"

#include <gtest/gtest.h>

#include <chrono>
#include <csignal>
#include <sched.h>
#include <sys/mount.h>
#include <sys/resource.h>
#include <thread>

namespace fs = std::filesystem;

namespace {

TEST(CopyPosix, tells_what_another_user_may_not_read) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolder(tool / "job/closed");
    put(tool / "job/secret", "text");
    makeFolder(tool / "free");
    fs::permissions(tool / "free", fs::perms::all);
    fs::permissions(tool / "job/secret", fs::perms::none);
    auto const file = PreparedChild({ZBTOOL, "copy", "job", "free/copy"}, tool.path(), becomeNobody).wait();
    EXPECT_EQ(file.code, 1);
    EXPECT_TRUE(isOneLineAbout(file.errors, "job/secret"));
    fs::remove(tool / "job/secret");
    fs::permissions(tool / "job/closed", fs::perms::none);
    fs::remove_all(tool / "free/copy");
    auto const folder = PreparedChild({ZBTOOL, "copy", "job", "free/copy"}, tool.path(), becomeNobody).wait();
    EXPECT_EQ(folder.code, 1);
    EXPECT_TRUE(isOneLineAbout(folder.errors, "job/closed"));
    EXPECT_EQ(folder.errors, "zbtool: job/closed: Permission denied\n");
}

TEST(CopyPosix, tells_where_another_user_may_not_write) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolder(tool / "job");
    put(tool / "job/file", "text");
    makeFolder(tool / "closed");
    fs::permissions(tool / "closed", fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_exec);
    auto const end = PreparedChild({ZBTOOL, "copy", "job", "closed/copy"}, tool.path(), becomeNobody).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_EQ(end.errors, "zbtool: cannot copy 'job' to 'closed/copy': Permission denied\n");
}

TEST(CopyPosix, keeps_links_and_the_permissions_of_closed_folders) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolder(tool / "job/closed/below");
    put(tool / "job/closed/below/file", "text");
    fs::create_symlink("closed", tool / "job/link");
    auto const readable =
        fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec;
    fs::permissions(tool / "job/closed", readable);
    makeFolder(tool / "free/onto");
    for (char const* folder : {"free", "free/onto"}) fs::permissions(tool / folder, fs::perms::all);
    // The second goes file by file, as the target is there.
    makeFolder(tool / "free/onto/job");
    fs::permissions(tool / "free/onto/job", fs::perms::all);
    for (char const* target : {"free/new", "free/onto"}) {
        SCOPED_TRACE(target);
        auto const end = PreparedChild({ZBTOOL, "copy", "job", target}, tool.path(), becomeNobody).wait();
        EXPECT_EQ(end.code, 0) << end.errors;
    }
    for (char const* copy : {"free/new", "free/onto/job"}) {
        SCOPED_TRACE(copy);
        std::string const top = tool / copy;
        EXPECT_EQ(textOf(top + "/closed/below/file"), "text");
        EXPECT_EQ(fs::read_symlink(top + "/link"), "closed");
        EXPECT_EQ(fs::status(top + "/closed").permissions(), readable);
    }
    for (char const* folder : {"job/closed", "free/new/closed", "free/onto/job/closed"})
        fs::permissions(tool / folder, fs::perms::owner_all);
}

TEST(CopyPosix, leaves_nothing_half_copied_on_a_full_disk) {
    if (::geteuid() != 0) CASE_CANNOT_HOLD("only root can mount a small disk");
    Tool tool;
    makeFolder(tool / "job");
    put(tool / "job/small", "text");
    put(tool / "job/large", std::string(3 << 20, 'L'));
    makeFolder(tool / "disk");
    auto const mountDisk = [] {
        return ::unshare(CLONE_NEWNS) == 0 && ::mount("none", "/", nullptr, MS_REC | MS_PRIVATE, nullptr) == 0 &&
               ::mount("tmpfs", "disk", "tmpfs", 0, "size=1m") == 0;
    };
    std::string const script = ZBTOOL + " copy job disk/copy; echo $?; find disk -name '.*' -o -name large";
    auto const end = PreparedChild({"sh", "-c", script}, tool.path(), mountDisk).wait();
    if (end.code == 126) CASE_CANNOT_HOLD("this root may not mount");
    EXPECT_EQ(end.output, "1\n");
    EXPECT_EQ(end.errors, "zbtool: cannot copy 'job/large' to 'disk/copy/large': No space left on device\n");
}

TEST(CopyPosix, leaves_nothing_of_a_file_that_grows_too_large) {
    Tool tool;
    put(tool / "large", std::string(20 << 20, 'L'));
    auto const limit = [] {
        rlimit const most{1 << 20, 1 << 20};
        std::signal(SIGXFSZ, SIG_IGN);
        return ::setrlimit(RLIMIT_FSIZE, &most) == 0;
    };
    auto const end = PreparedChild({ZBTOOL, "copy", "large", "copy"}, tool.path(), limit).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_EQ(end.errors, "zbtool: cannot copy 'large' to 'copy': File too large\n");
    EXPECT_EQ(tool.content(), Names{"large"});
}

/// Waits until something beside the first entries is in a folder.
bool waitForMore(Scratch const& folder, std::size_t than) {
    auto const end = std::chrono::steady_clock::now() + std::chrono::seconds(20);
    while (std::chrono::steady_clock::now() < end) {
        auto const entries = std::distance(fs::directory_iterator(folder.path()), {});
        if (static_cast<std::size_t>(entries) > than) return true;
        std::this_thread::sleep_for(std::chrono::microseconds(200));
    }
    return false;
}

auto const AS_IT_IS = [] { return true; };

TEST(CopyPosix, leaves_nothing_when_interrupted_within_a_large_file) {
    Tool tool(memoryFolder());
    put(tool / "large", std::string(300 << 20, 'L'));
    bool interrupted = false;
    for (int i = 0; i < 5 && !interrupted; ++i) {
        PreparedChild child({ZBTOOL, "copy", "large", "copy"}, tool.path(), AS_IT_IS);
        EXPECT_TRUE(waitForMore(tool, 1));
        ::kill(child.process(), SIGINT);
        ::kill(child.process(), SIGTERM); // no longer patient
        auto const end = child.wait();
        EXPECT_EQ(end.errors, "");
        EXPECT_EQ(end.signal, SIGINT);
        interrupted = !exists(tool / "copy");
        fs::remove(tool / "copy");
        EXPECT_EQ(tool.content(), Names{"large"});
    }
    EXPECT_TRUE(interrupted);
}

TEST(CopyPosix, stops_between_two_files_when_interrupted) {
    Tool tool(memoryFolder());
    constexpr int FILES = 4'000;
    makeFolder(tool / "job");
    for (int i = 0; i < FILES; ++i) put(tool / ("job/" + std::to_string(i)), std::string(20'000, 'x'));
    makeFolder(tool / "spool/job"); // so that the files go one by one
    PreparedChild child({ZBTOOL, "copy", "job", "spool"}, tool.path(), AS_IT_IS);
    Scratch const& spool = tool;
    while (fs::is_empty(spool / "spool/job")) std::this_thread::sleep_for(std::chrono::microseconds(200));
    ::kill(child.process(), SIGINT);
    auto const end = child.wait();
    EXPECT_EQ(end.signal, SIGINT);
    EXPECT_EQ(end.errors, "");
    int files = 0;
    for (auto const& file : fs::directory_iterator(tool / "spool/job")) {
        EXPECT_EQ(file.file_size(), 20'000u) << file.path();
        ++files;
    }
    EXPECT_LT(files, FILES);
}

TEST(CopyPosix, goes_to_another_file_system_by_move) {
    Tool tool;
    Tool other(memoryFolder());
    makeFolder(tool / "job/below");
    put(tool / "job/below/file", "text");
    if (fs::path(tool.path()).parent_path() == fs::path(other.path()).parent_path())
        CASE_CANNOT_HOLD("there is one file system only");
    EXPECT_EQ(tool.run({"move", "job", other / "job"}).code, 0);
    EXPECT_EQ(textOf(other / "job/below/file"), "text");
    EXPECT_FALSE(exists(tool / "job"));

    // Nor does a move fill up a folder there.
    makeFolder(tool / "job");
    put(tool / "job/new", "text");
    makeFolder(other / "job/job");
    put(other / "job/job/older", "text");
    EXPECT_EQ(tool.run({"move", "--overwrite", "job", other / "job"}).code, 1);
    EXPECT_TRUE(exists(tool / "job/new"));
    EXPECT_EQ(other.content("job/job"), Names{"older"});
}

TEST(CopyPosix, keeps_the_source_of_a_move_that_cannot_be_copied) {
    Tool tool;
    Tool other(memoryFolder());
    put(tool / "large", std::string(3 << 20, 'L'));
    auto const limit = [] {
        rlimit const most{1 << 20, 1 << 20};
        std::signal(SIGXFSZ, SIG_IGN);
        return ::setrlimit(RLIMIT_FSIZE, &most) == 0;
    };
    auto const end = PreparedChild({ZBTOOL, "move", "large", other / "large"}, tool.path(), limit).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_TRUE(isOneLineAbout(end.errors, "'large'"));
    EXPECT_TRUE(exists(tool / "large"));
    EXPECT_EQ(other.content(), Names{});
}

} // namespace
