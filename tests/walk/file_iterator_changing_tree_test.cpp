// Trees that change while they are walked: what is untouched is reported once, what has gone is no failure.

#include <zor_basis/walk.h>

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>

using namespace ZOR_Basis;

namespace {

constexpr int FILES = 300;

/// Counts how often each name is reported, and does something to the tree at every entry.
struct Meddler : FileVisitor {
    explicit Meddler(std::function<void(std::string const&)> work) : meddle(std::move(work)) {}
    bool perform(FileEntry* entry) override {
        std::string const name = entry->getName().c_str();
        ++times[name];
        if (++entries > 10 * FILES) return false; // a walk that feeds itself would never end
        meddle(name);
        return true;
    }
    std::function<void(std::string const&)> meddle;
    std::map<std::string, int> times;
    int entries = 0;
};

struct FileIteratorInAChangingTree : testing::Test {
    FileIteratorInAChangingTree() {
        for (int i = 0; i < FILES; ++i) put(scratch / file(i), "x");
        makeFolder(scratch / "folder/inner");
        put(scratch / "folder/inner/deep", "x");
    }
    static std::string file(int i) { return "file-" + std::to_string(i); }
    bool walk(FileVisitor& visitor) const {
        return FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&visitor, true, true);
    }

    Scratch scratch;
};

} // namespace

TEST_F(FileIteratorInAChangingTree, may_lose_the_entry_that_is_visited) {
    Meddler meddler([this](std::string const& name) {
        if (name.starts_with("file-")) std::filesystem::remove(scratch / name);
    });
    EXPECT_TRUE(walk(meddler));
    for (int i = 0; i < FILES; ++i) EXPECT_EQ(meddler.times[file(i)], 1) << i;
    EXPECT_EQ(meddler.times["deep"], 1);
    EXPECT_EQ(scratch.content(), (Names{"folder/", "folder/inner/", "folder/inner/deep"}));
}

TEST_F(FileIteratorInAChangingTree, may_lose_all_of_itself) {
    Meddler meddler([this](std::string const&) {
        for (auto const& entry : std::filesystem::directory_iterator(scratch.path()))
            std::filesystem::remove_all(entry.path());
    });
    EXPECT_TRUE(walk(meddler));
    EXPECT_LE(meddler.entries, FILES + 1);
    for (auto const& [name, times] : meddler.times) EXPECT_EQ(times, 1) << name;
    EXPECT_EQ(meddler.times.count("deep"), 0u);
}

TEST_F(FileIteratorInAChangingTree, may_grow) {
    int made = 0;
    Meddler meddler([this, &made](std::string const&) {
        if (made < FILES) put(scratch / ("new-" + std::to_string(made++)), "x");
    });
    EXPECT_TRUE(walk(meddler));
    for (int i = 0; i < FILES; ++i) EXPECT_EQ(meddler.times[file(i)], 1) << i;
    for (auto const& [name, times] : meddler.times) EXPECT_EQ(times, 1) << name;
}

TEST_F(FileIteratorInAChangingTree, may_lose_a_directory_that_was_reported) {
    Meddler meddler([this](std::string const& name) {
        if (name == "folder") std::filesystem::remove_all(scratch / name);
    });
    EXPECT_TRUE(walk(meddler));
    EXPECT_EQ(meddler.times["folder"], 1);
    EXPECT_EQ(meddler.times.count("inner"), 0u);
}

TEST_F(FileIteratorInAChangingTree, may_turn_a_file_into_a_directory) {
    Meddler meddler([this](std::string const& name) {
        if (name != file(7)) return;
        std::filesystem::remove(scratch / name);
        makeFolder(scratch / name);
        put(scratch / (name + "/below"), "x");
    });
    EXPECT_TRUE(walk(meddler));
    EXPECT_EQ(meddler.times["below"], 1); // its parent is listed once more for its sub-directories
}
