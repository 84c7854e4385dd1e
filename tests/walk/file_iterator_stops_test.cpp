#include <zor_basis/walk/file_iterator.h>

#include "tests/support/table.h"

#include "tests/walk/walked_folder.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileIteratorStops : WalkedFolder {};

/// Writes down, as one letter each, what a walk asks for: "s" whether to stop, "p" an entry, "n" a name of the listing.
/// Says stop from one of the questions on, and fails for entries of one name.
struct Asked : FileVisitor {
    bool perform(FileEntry* entry) override {
        addNames();
        steps += 'p';
        return failing != entry->getName().c_str();
    }
    bool stop() override {
        addNames();
        steps += 's';
        return ++questions > last;
    }
    /// The names that the platform was asked for since.
    void addNames() {
        std::uint64_t const taken = xos_HostCalls("xos_DirNextEx");
        steps.append(taken - names, 'n');
        names = taken;
    }
    std::string taken() {
        addNames();
        return steps;
    }

    std::string steps;
    std::string failing = "none";
    std::uint64_t questions = 0;
    std::uint64_t last = static_cast<std::uint64_t>(-1);
    std::uint64_t names = xos_HostCalls("xos_DirNextEx");
};

struct Refuses : FileCondition {
    bool acceptEntry(FileEntry*) override { return false; }
};

} // namespace

TEST_F(FileIteratorStops, Kept_walk_05_gives_the_last_result) {
    makeFolder(scratch / "d");
    put(scratch / "a", "");
    Recorder seen;
    seen.failing = {"a"};
    FileIterator it(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr);
    EXPECT_FALSE(it.doIt(&seen, false, false)) << "the last result of the pass";
    EXPECT_TRUE(it.doIt(&seen, true, false)) << "the sub-directory has nothing that fails";
    put(scratch / "d/a", "");
    EXPECT_TRUE(it.doIt(&seen, true, false)) << "nor a directory below it, where the last pass has nothing to enter";
    std::filesystem::remove_all(scratch / "d");
    EXPECT_TRUE(it.doIt(&seen, true, false)) << "without sub-directories the deep pass is true";
    EXPECT_FALSE(it.doIt(&seen, true, true));
}

TEST_F(FileIteratorStops, Kept_walk_05_lets_a_later_success_hide_a_failure) {
    put(scratch / "a", "");
    put(scratch / "b", "");
    FileIterator it(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr);
    Recorder order;
    it.doIt(&order, false, false);
    ASSERT_EQ(order.entries.size(), 2u);
    Recorder seen;
    seen.failing = {order.entries[0].getName().c_str()};
    EXPECT_TRUE(it.doIt(&seen, false, false));
    EXPECT_EQ(seen.paths.size(), 2u);
}

TEST_F(FileIteratorStops, leaves_the_result_as_it_was_for_what_the_condition_drops) {
    put(scratch / "a", "");
    Recorder seen;
    seen.failing = {"a"};
    OnlyWith condition('z');
    EXPECT_TRUE(FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, &condition).doIt(&seen, false, true));
    EXPECT_TRUE(seen.paths.empty());
}

TEST_F(FileIteratorStops, stops_at_the_first_failure_where_it_is_asked_to) {
    fill();
    Recorder seen;
    seen.failing = {"a.txt", "b.dat", "d", "c.txt", "e", "f.TXT"};
    FileIterator it(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr);
    EXPECT_FALSE(it.doIt(&seen, true, true));
    EXPECT_EQ(seen.paths.size(), 1u);
    Recorder all;
    all.failing = seen.failing;
    EXPECT_TRUE(it.doIt(&all, true, false));
    EXPECT_EQ(all.paths.size(), 6u);
    expectAllClosed();
}

TEST_F(FileIteratorStops, brings_a_failure_up_from_below) {
    fill();
    makeFolder(scratch / "d/e/g");
    put(scratch / "d/e/g/last", "");
    Recorder seen;
    seen.failing = {"c.txt"};
    EXPECT_FALSE(FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr).doIt(&seen, true, true));
    EXPECT_EQ(seen.paths.size(), 3u) << "a.txt, b.dat, c.txt, and nothing below d";
    expectAllClosed();
}

TEST_F(FileIteratorStops, asks_no_sibling_once_a_folder_below_has_failed) {
    for (char const* folder : {"d", "e", "f"}) {
        makeFolder(scratch / (std::string(folder) + "/a/b"));
        put(scratch / (std::string(folder) + "/a/b/bad"), "");
    }
    Recorder seen;
    seen.failing = {"bad"};
    EXPECT_FALSE(FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr).doIt(&seen, true, true));
    EXPECT_EQ(seen.paths.size(), 1u);
    Recorder all;
    all.failing = seen.failing;
    FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr).doIt(&all, true, false);
    EXPECT_EQ(all.paths.size(), 3u) << "of a walk that ignores failures";
    expectAllClosed();
}

TEST_F(FileIteratorStops, ends_at_every_level_when_the_visitor_stops_it) {
    fill();
    for (std::size_t most = 0; most <= 6; ++most) {
        SCOPED_TRACE(most);
        Recorder seen;
        seen.most = most;
        EXPECT_TRUE(FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&seen, true, false));
        EXPECT_EQ(seen.paths.size(), most);
    }
    Recorder failing;
    failing.failing = {"a.txt", "b.dat", "d"};
    failing.most = 3;
    EXPECT_FALSE(FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&failing, true, false))
        << "the result reached stays";
    expectAllClosed();
}

TEST_F(FileIteratorStops, asks_whether_to_stop_before_each_name_and_between_its_passes) {
    makeFolder(scratch / "none");
    makeFolder(scratch / "two");
    put(scratch / "two/a", "");
    put(scratch / "two/b", "");
    makeFolder(scratch / "passed/__MACOS");
    makeFolder(scratch / "deep/e");
    put(scratch / "deep/e/f", "");
    Refuses refuses;
    struct Case {
        Row row;
        char const* folder;
        LookForType type;
        bool deep, stopOnFalse;
        char const* failing;
        FileCondition* condition;
        char const* steps;
    };
    for (Case const& c : {
             // a question before every name, also before the one that is no more, and one behind the shallow pass
             Case{{}, "none", LOOK_BOTH, false, false, "", nullptr, "sns"},
             Case{{}, "two", LOOK_BOTH, false, false, "", nullptr, "snpsnpsns"},
             Case{{}, "two", LOOK_BOTH, false, true, "", nullptr, "snpsnpsns"},
             Case{{}, "two", LOOK_DIRS, false, false, "", nullptr, "sns"},
             // names that are refused or passed over have had theirs
             Case{{}, "two", LOOK_BOTH, false, false, "", &refuses, "snsnsns"},
             Case{{}, "passed", LOOK_BOTH, false, false, "", nullptr, "snsns"},
             // a failure that ends the walk is followed by none
             Case{{}, "deep", LOOK_BOTH, false, true, "e", nullptr, "snp"},
             Case{{}, "deep", LOOK_BOTH, true, true, "e", nullptr, "snp"},
             Case{{}, "deep", LOOK_BOTH, false, false, "e", nullptr, "snpsns"},
             // a folder that cannot be listed: only the one between the passes
             Case{{}, "missing", LOOK_BOTH, false, false, "", nullptr, "s"},
             Case{{}, "missing", LOOK_BOTH, true, true, "", nullptr, "s"},
             // the deep pass asks before every directory, and the walk of that one asks for itself
             Case{{}, "none", LOOK_BOTH, true, false, "", nullptr, "snssn"},
             Case{{}, "passed", LOOK_BOTH, true, false, "", nullptr, "snsnssnsn"},
             Case{{},
                  "deep",
                  LOOK_BOTH,
                  true,
                  false,
                  "",
                  nullptr,
                  "snpsns"
                  "sn"
                  "snpsns"
                  "sn"
                  "sn"},
             Case{{},
                  "deep",
                  LOOK_FILES,
                  true,
                  false,
                  "",
                  nullptr,
                  "sns"
                  "sn"
                  "snpsns"
                  "sn"
                  "sn"},
             Case{{},
                  "deep",
                  LOOK_FILES,
                  true,
                  true,
                  "f",
                  nullptr,
                  "sns"
                  "sn"
                  "snp"},
         }) {
        SCOPED_TRACE(c.row);
        Asked asked;
        asked.failing = c.failing;
        FileIterator((scratch / c.folder).c_str(), c.type, nullptr, c.condition).doIt(&asked, c.deep, c.stopOnFalse);
        EXPECT_EQ(asked.taken(), c.steps);
    }
}

TEST_F(FileIteratorStops, asks_each_level_once_more_when_it_is_stopped) {
    makeFolder(scratch / "d/e");
    put(scratch / "d/e/f", "");
    // The whole walk is snpsns sn snpsns sn snpsns sn sn sn.
    char const* const steps[] = {
        "s"
        "s", // in the shallow pass: behind it, once more, and no deep pass
        "snps"
        "s",
        "snpsns", // between the passes
        "snpsns"
        "s", // in the deep pass: that was the top level
        "snpsns"
        "sn"
        "s"
        "s"
        "s", // in the directory's: the pass above asks again
        "snpsns"
        "sn"
        "snps"
        "s"
        "s",
        "snpsns"
        "sn"
        "snpsns"
        "s",
        "snpsns"
        "sn"
        "snpsns"
        "s"
        "s",
        "snpsns"
        "sn"
        "snpsns"
        "sn"
        "s"
        "s"
        "s"
        "s",
    };
    for (std::uint64_t last = 0; last < std::size(steps); ++last) {
        SCOPED_TRACE(last);
        Asked asked;
        asked.last = last;
        EXPECT_TRUE(FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&asked, true, true));
        EXPECT_EQ(asked.taken(), steps[last]);
    }
    expectAllClosed();
}

TEST_F(FileIteratorStops, asks_in_each_of_its_building_blocks) {
    makeFolder(scratch / "two");
    put(scratch / "two/a", "");
    put(scratch / "two/b", "");
    FileIterator it((scratch / "two").c_str(), LOOK_BOTH, nullptr, nullptr);
    Asked shallow, deep, ride, deepRide;
    EXPECT_TRUE(it.shallowIteration(&shallow, false));
    EXPECT_EQ(shallow.taken(), "snpsnpsn") << "nothing behind the pass";
    deep.names = xos_HostCalls("xos_DirNextEx");
    EXPECT_TRUE(it.deepIteration(&deep, false));
    EXPECT_EQ(deep.taken(), "sn");
    EXPECT_TRUE(it.shallowRide(&ride, false));
    EXPECT_EQ(ride.questions, 1u) << "without an open listing";
    EXPECT_TRUE(it.deepRide(&deepRide, false));
    EXPECT_EQ(deepRide.questions, 1u);
}
