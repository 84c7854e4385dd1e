// Saving a dictionary so that its file is always the old one or the whole new one.

#include "basis/files/system_calls.h"
#include "tests/once/dict_contents.h"
#include "tests/store/dict_files.h"
#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <zor_basis/system/process.h>

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <random>
#include <thread>

using namespace ZOR_Basis;

namespace {

struct DictSave : testing::Test {
    DictSave() {
        xos_HostCallsReset();
        dict.setPath(Str(path));
    }
    ~DictSave() override {
        xos_HostFailClear();
        systemCalls = real_;
    }

    bool writeWouldWrite() {
        std::uint64_t const opened = xos_HostCalls("xos_FileOpen");
        xos_HostFail("xos_FileOpen", 0, 1);
        dict.write();
        xos_HostFail("xos_FileOpen", 0, 0);
        return xos_HostCalls("xos_FileOpen") != opened;
    }
    /// The path of the temporary file that was opened last.
    static std::string lastOpened() {
        std::string const call = xos_HostLastCall("xos_FileOpen");
        return call.substr(1, call.find('"', 1) - 1);
    }

    Scratch scratch;
    std::string const path = scratch / "a dictionary";
    BlobDict dict;
    SystemCalls const real_ = systemCalls;
};

} // namespace

TEST_F(DictSave, breathes) {
    dict.set(blob("key"), blob("value"));
    EXPECT_TRUE(dict.save());
    BlobDict other{Str(path)};
    Blob value;
    EXPECT_TRUE(other.get(blob("key"), value));
    EXPECT_EQ(text(value), "value");
    EXPECT_EQ(other.found(), DICT_WHOLE);
    EXPECT_EQ(scratch.content(), Names{"a dictionary"});
}

TEST_F(DictSave, gives_the_bytes_that_writing_gives) {
    for (Pairs const& pairs : {
             Pairs{},
             Pairs{{"", ""}},
             Pairs{{std::string("k\0", 2), "\r\n"}, {"", std::string(258, 'v')}},
             Pairs{{"large", std::string(200'000, 'L')}, {"small", "1"}, {"exact", std::string(65'536, 'e')}},
             twoContents(0),
             twoContents(1),
         }) {
        fill(dict, pairs);
        EXPECT_TRUE(dict.save());
        EXPECT_EQ(textOf(path), fileOf(pairs));
        BlobDict other;
        other.setPath(Str(scratch / "written"));
        fill(other, {{"some", "thing"}});
        fill(other, pairs);
        EXPECT_TRUE(other.write());
        EXPECT_EQ(textOf(path), textOf(scratch / "written"));
    }
    EXPECT_EQ(scratch.content(), (Names{"a dictionary", "written"}));
}

TEST_F(DictSave, saves_whatever_counts_as_saved) {
    EXPECT_TRUE(dict.save());
    EXPECT_TRUE(exists(path)) << "a new one without entries";
    EXPECT_EQ(textOf(path), "");
    dict.set(blob("a"), blob("1"));
    dict.set(blob("b"), blob("2"));
    dict.set(blob("a"), blob("1"));
    EXPECT_FALSE(writeWouldWrite());
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(textOf(path), fileOf({{"b", "2"}, {"a", "1"}})) << "a value that is there already hides nothing";
    BlobDict other;
    other.set(blob("b"), blob(""));
    dict.intersect(other);
    EXPECT_FALSE(writeWouldWrite());
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(textOf(path), fileOf({{"b", "2"}}));
    dict.removeFirst();
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(textOf(path), "");
    dict.set(blob("c"), blob("3"));
    EXPECT_TRUE(dict.save());
    EXPECT_FALSE(writeWouldWrite()) << "what was saved need not be written";
}

TEST_F(DictSave, asks_the_platform_in_a_fixed_order) {
    put(path, "old");
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.save());
    std::string const temporary = lastOpened();
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileOpen")), "\"" + temporary + "\", 0x15");
    EXPECT_EQ(temporary.substr(0, scratch.path().size() + 5), scratch.path() + "/.zb-") << "in the same folder";
    EXPECT_EQ(std::string(xos_HostLastCall("xos_FileMove")), "\"" + path + "\", \"" + temporary + "\", 1");
    for (char const* function :
         {"xos_FileOpen", "xos_FileWriteEx", "xos_FileFlush", "xos_FileCloseEx", "xos_FileMove"}) {
        EXPECT_EQ(xos_HostCalls(function), 1u) << function;
    }
    EXPECT_EQ(xos_HostCalls("xos_FileRemove"), 0u);
    struct Case {
        Row row;
        char const* failing;
        std::uint64_t flushed, closed, moved, removed;
    };
    for (Case const& c : {
             Case{{}, "xos_FileOpen", 0, 0, 0, 1},
             Case{{}, "xos_FileWriteEx", 0, 1, 0, 1},
             Case{{}, "xos_FileFlush", 1, 1, 0, 1},
             Case{{}, "xos_FileCloseEx", 1, 1, 0, 1},
             Case{{}, "xos_FileMove", 1, 1, 1, 1},
         }) {
        SCOPED_TRACE(c.row);
        xos_HostCallsReset();
        xos_HostFail(c.failing, 0, 1);
        EXPECT_FALSE(dict.save());
        EXPECT_EQ(xos_HostCalls("xos_FileFlush"), c.flushed);
        EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), c.closed);
        EXPECT_EQ(xos_HostCalls("xos_FileMove"), c.moved);
        EXPECT_EQ(xos_HostCalls("xos_FileRemove"), c.removed);
    }
}

TEST_F(DictSave, leaves_the_old_file_whichever_call_fails) {
    Pairs const pairs = twoContents(0);
    for (std::string const old : {"", "what was there"}) {
        for (char const* function :
             {"xos_FileOpen", "xos_FileWriteEx", "xos_FileFlush", "xos_FileCloseEx", "xos_FileMove"}) {
            fill(dict, pairs);
            if (!old.empty()) put(path, old);
            Names const before = scratch.content();
            for (std::uint32_t skip = 0;; ++skip) {
                SCOPED_TRACE(std::string(function) + " " + std::to_string(skip));
                ASSERT_LT(skip, 20u);
                ASSERT_EQ(xos_HostFail(function, skip, 1), 0);
                bool const done = dict.save();
                std::uint32_t const reason = systemCalls.lastError();
                xos_HostFailClear();
                if (done) break;
                EXPECT_EQ(reason, GENERAL_FAILURE) << "the reason of the failure, past the clean-up";
                EXPECT_EQ(scratch.content(), before) << "nothing is left behind";
                EXPECT_EQ(textOf(path), old);
                EXPECT_TRUE(writeWouldWrite());
            }
            EXPECT_EQ(textOf(path), fileOf(pairs));
            std::filesystem::remove(path);
        }
    }
}

TEST_F(DictSave, fails_where_no_file_can_be) {
    dict.set(blob("a"), blob("1"));
    makeFolder(scratch / "folder");
    struct Case {
        Row row;
        std::string path;
        std::set<std::uint32_t> reasons;
    };
    std::string const top = scratch.path();
    for (Case const& c : {
             Case{{}, "", {FILE_NOT_FOUND, PATH_NOT_FOUND}},
             Case{{}, top + "/no/folder", {FILE_NOT_FOUND, PATH_NOT_FOUND}},
             Case{{}, top + "/folder", {ACCESS_DENIED, GENERAL_FAILURE}},
         }) {
        SCOPED_TRACE(c.row);
        dict.setPath(Str(c.path));
        EXPECT_FALSE(dict.save());
        EXPECT_EQ(c.reasons.count(systemCalls.lastError()), 1u) << systemCalls.lastError();
        EXPECT_EQ(scratch.content(), Names{"folder/"});
        EXPECT_TRUE(writeWouldWrite());
    }
    EXPECT_EQ(xos_HostCalls("xos_FileMove"), 0u);
}

TEST_F(DictSave, takes_no_name_that_another_file_has) {
    systemCalls.tick = []() -> std::uint64_t { return 77; };
    dict.set(blob("a"), blob("1"));
    EXPECT_TRUE(dict.save());
    std::string const used = lastOpened();
    std::size_t const digits = used.rfind('-') + 1;
    auto const counter = std::stoull(used.substr(digits));
    auto const named = [&](unsigned long long n) { return used.substr(0, digits) + std::to_string(n) + ".tmp"; };
    ASSERT_EQ(named(counter), used);
    for (unsigned long long n = 1; n <= 3; ++n) put(named(counter + n), "another's");
    dict.set(blob("a"), blob("2"));
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(lastOpened(), named(counter + 4));
    EXPECT_EQ(textOf(path), fileOf({{"a", "2"}}));
    EXPECT_EQ(scratch.content().size(), 4u);
    for (unsigned long long n = 1; n <= 3; ++n) EXPECT_EQ(textOf(named(counter + n)), "another's");

    for (unsigned long long n = 5; n <= 104; ++n) put(named(counter + n), "another's");
    dict.set(blob("a"), blob("3"));
    EXPECT_FALSE(dict.save()) << "a hundred names, and then it ends";
    EXPECT_EQ(textOf(path), fileOf({{"a", "2"}}));
    EXPECT_TRUE(dict.save());
}

TEST_F(DictSave, saves_in_the_current_folder) {
    std::filesystem::path const before = std::filesystem::current_path();
    std::filesystem::current_path(scratch.path());
    for (char const* name : {"bare", "./bare", ".bare"}) {
        dict.setPath(name);
        dict.set(blob("a"), blob(name));
        EXPECT_TRUE(dict.save()) << name;
        EXPECT_EQ(textOf(name), fileOf({{"a", name}}));
        EXPECT_TRUE(dict.save()) << name;
    }
    std::filesystem::current_path(before);
    EXPECT_EQ(scratch.content(), (Names{".bare", "bare"}));
}

TEST_F(DictSave, takes_both_slash_kinds_and_long_names) {
    makeFolder(scratch / "a b");
    dict.set(blob("a"), blob("1"));
    dict.setPath(Str(scratch.path() + "\\a b\\dictionary"));
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(textOf(scratch / "a b/dictionary"), fileOf({{"a", "1"}}));
    Scratch const near(std::filesystem::temp_directory_path());
    std::string const name(150, 'n');
    dict.setPath(Str(near / name));
    EXPECT_TRUE(dict.save());
    EXPECT_TRUE(dict.save());
    EXPECT_EQ(near.content(), Names{name});
}

TEST_F(DictSave, leaves_one_of_two_contents_when_its_process_is_killed) {
    std::string const contents[] = {fileOf(twoContents(0)), fileOf(twoContents(1))};
    auto const program = programBeside("dict_child");
    std::string const commandLine = "\"" + program + "\" \"" + path + "\"";
    std::mt19937 random(20261122);
    int seen[2] = {};
    constexpr int ROUNDS = 25;
    for (int round = 0; round < ROUNDS; ++round) {
        std::filesystem::remove(path);
        unsigned long process = 0;
        ASSERT_TRUE(Process::Create(nullptr, &process, commandLine.c_str(), nullptr));
        auto const end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
        while (!exists(path) && std::chrono::steady_clock::now() < end) std::this_thread::yield();
        std::this_thread::sleep_for(std::chrono::microseconds(random() % 30'000));
        ASSERT_TRUE(Process::Terminate(process));
        Process::Wait(process);
        std::string const content = textOf(path);
        ASSERT_TRUE(content == contents[0] || content == contents[1]) << "round " << round << ": " << content.size();
        ++seen[content == contents[1] ? 1 : 0];
        for (std::string const& name : scratch.content()) {
            EXPECT_TRUE(name == "a dictionary" || name.compare(0, 4, ".zb-") == 0) << name;
        }
    }
    EXPECT_GT(seen[0], 0);
    EXPECT_GT(seen[1], 0);
}
