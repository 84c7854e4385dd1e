#include <zor_basis/walk/file_iterator.h>

#include <zor_basis/walk/file_count_visitor.h>
#include <zor_basis/walk/file_iter_visitor.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "tests/walk/recorder.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <iterator>

using namespace ZOR_Basis;

namespace {

using Found = std::multiset<std::string>;

struct FileIteratorTest : testing::Test {
    FileIteratorTest() { xos_HostCallsReset(); }
    ~FileIteratorTest() override { xos_HostFailClear(); }

    void fill() {
        makeFolder(scratch / "d/e");
        put(scratch / "a.txt", "12345");
        put(scratch / "b.dat", "");
        put(scratch / "d/c.txt", "c");
        put(scratch / "d/e/f.TXT", "f");
    }

    Found walked(LookForType type, char const* wildcard, bool deep, FileCondition* condition = nullptr) const {
        Recorder seen;
        FileIterator it(scratch.path().c_str(), type, wildcard, condition);
        EXPECT_TRUE(it.doIt(&seen, deep, false));
        return seen.below(scratch.path());
    }

    static Found listed(FileIterator& it) {
        Found names;
        while (char const* name = it.next()) names.insert(name);
        return names;
    }

    /// The last call of a function, without the scratch folder's path.
    std::string last(char const* function) const {
        char const* const call = xos_HostLastCall(function);
        std::string text = call != nullptr ? call : "none";
        std::size_t const own = text.find(scratch.path());
        return own != std::string::npos ? text.replace(own, scratch.path().size(), "*") : text;
    }

    static void expectAllClosed() { EXPECT_EQ(xos_HostCalls("xos_DirOpenEx"), xos_HostCalls("xos_DirClose")); }

    Scratch scratch;
};

struct OnlyWith : FileCondition {
    explicit OnlyWith(char letter) : letter_(letter) {}
    bool acceptName(FileIterator* it, char const* name) override {
        asked = it;
        return std::string(name).find(letter_) != std::string::npos;
    }
    bool acceptEntry(FileEntry* entry) override {
        return std::string(entry->getName().c_str()).find(letter_) != std::string::npos;
    }
    FileIterator* asked = nullptr;

private:
    char letter_;
};

} // namespace

TEST_F(FileIteratorTest, gives_directories_the_size_0) {
    fill();
    Recorder seen;
    EXPECT_TRUE(FileIterator(scratch.path(), LOOK_BOTH, nullptr, nullptr).doIt(&seen, true, false));
    std::multiset<std::string> sizes;
    for (FileEntry const& entry : seen.entries)
        sizes.insert(std::string(entry.getName().c_str()) + " " + std::to_string(entry.getSize()));
    EXPECT_EQ(sizes, (Found{"a.txt 5", "b.dat 0", "d 0", "c.txt 1", "e 0", "f.TXT 1"}));
    for (FileEntry const& entry : seen.entries) EXPECT_GT(entry.getTime(), 0);
}

TEST_F(FileIteratorTest, breathes) {
    fill();
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true), (Found{"a.txt", "b.dat", "d/", "d/c.txt", "d/e/", "d/e/f.TXT"}));
    expectAllClosed();
}

TEST_F(FileIteratorTest, walks_the_kinds_of_its_type) {
    fill();
    struct Case {
        Row row;
        LookForType type;
        Found shallow;
        Found deep;
    };
    for (Case const& c : {
             Case{{}, LOOK_FILES, {"a.txt", "b.dat"}, {"a.txt", "b.dat", "d/c.txt", "d/e/f.TXT"}},
             Case{{}, LOOK_DIRS, {"d/"}, {"d/", "d/e/"}},
             Case{{}, LOOK_ALL, {"d/"}, {"d/", "d/e/"}},
             Case{{}, LOOK_BOTH, {"a.txt", "b.dat", "d/"}, {"a.txt", "b.dat", "d/", "d/c.txt", "d/e/", "d/e/f.TXT"}},
             Case{{}, LOOK_ALL | LOOK_ANYCASE, {"d/"}, {"d/", "d/e/"}},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(walked(c.type, nullptr, false), c.shallow);
        EXPECT_EQ(walked(c.type, "", true), c.deep);
    }
}

TEST_F(FileIteratorTest, Kept_walk_01_lists_everything_where_a_walk_reports_directories) {
    fill();
    struct Case {
        Row row;
        LookForType type;
        Found flat;
    };
    for (Case const& c : {
             Case{{}, LOOK_ALL, {"a.txt", "b.dat", "d"}},
             Case{{}, LOOK_FILES, {"a.txt", "b.dat"}},
             Case{{}, LOOK_DIRS, {"d"}},
             Case{{}, LOOK_BOTH, {"a.txt", "b.dat", "d"}},
         }) {
        SCOPED_TRACE(c.row);
        FileIterator it(scratch.path().c_str(), c.type, nullptr, nullptr);
        EXPECT_EQ(listed(it), c.flat);
    }
    EXPECT_EQ(walked(LOOK_ALL, nullptr, false), Found{"d/"});
}

TEST_F(FileIteratorTest, fills_in_the_entry) {
    fill();
    Recorder seen;
    FileIterator(Str(scratch.path()), LOOK_FILES, "a*", nullptr).doIt(&seen, false, true);
    ASSERT_EQ(seen.entries.size(), 1u);
    FileEntry const& entry = seen.entries[0];
    FStat const status((scratch / "a.txt").c_str());
    EXPECT_STREQ(entry.getDir(), scratch.path().c_str());
    EXPECT_STREQ(entry.getName(), "a.txt");
    EXPECT_STREQ(entry.getFullPath(), (scratch / "a.txt").c_str());
    EXPECT_EQ(entry.getSize(), 5u);
    EXPECT_EQ(entry.getTime(), status.modified());
    EXPECT_NE(entry.getTime(), 0);
    EXPECT_EQ(entry.getType(), FStat::ST_FILE);
}

TEST_F(FileIteratorTest, Kept_walk_02_reports_what_has_gone_as_a_directory) {
    put(scratch / "a", "text");
    struct : FileCondition {
        bool acceptEntry(FileEntry* entry) override {
            for (char const* name : {"/a", "/b"}) std::filesystem::remove(std::string(entry->getDir().c_str()) + name);
            return true;
        }
    } remover;
    put(scratch / "b", "text");
    Recorder seen;
    FileIterator it(scratch.path().c_str(), LOOK_FILES, nullptr, &remover);
    it.doIt(&seen, false, false);
    ASSERT_GE(seen.entries.size(), 1u);
    EXPECT_TRUE(seen.entries[0].isFile()) << "looked at before it went";
    for (std::size_t i = 1; i < seen.entries.size(); ++i) {
        EXPECT_EQ(seen.entries[i].getType(), FStat::ST_DIR);
        EXPECT_EQ(seen.entries[i].getSize(), 0u);
        EXPECT_EQ(seen.entries[i].getTime(), 0);
    }
}

TEST_F(FileIteratorTest, Kept_walk_03_passes_over_one_name_in_walks_only) {
    makeFolder(scratch / "d/__MACOS/in");
    makeFolder(scratch / "__MACOS");
    makeFolder(scratch / "__MACOSX");
    put(scratch / "__MACOS/x", "");
    put(scratch / "d/__MACOS/y", "");
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true), (Found{"__MACOSX/", "d/"}));
    FileIterator it(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr);
    EXPECT_EQ(listed(it), (Found{"__MACOS", "__MACOSX", "d"}));
}

TEST_F(FileIteratorTest, Kept_walk_03_passes_over_a_file_of_that_name) {
    put(scratch / "__MACOS", "");
    put(scratch / "__macos2", "");
    EXPECT_EQ(walked(LOOK_FILES, nullptr, true), Found{"__macos2"});
}

TEST_F(FileIteratorTest, Kept_walk_04_enters_directories_that_do_not_match) {
    fill();
    EXPECT_EQ(walked(LOOK_BOTH, "*.txt", true), (Found{"a.txt", "d/c.txt"}));
    EXPECT_EQ(walked(LOOK_BOTH | LOOK_ANYCASE, "*.tXt", true), (Found{"a.txt", "d/c.txt", "d/e/f.TXT"}));
    OnlyWith condition('f');
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true, &condition), Found{"d/e/f.TXT"});
}

TEST_F(FileIteratorTest, Kept_walk_05_gives_the_last_result) {
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

TEST_F(FileIteratorTest, Kept_walk_05_lets_a_later_success_hide_a_failure) {
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

TEST_F(FileIteratorTest, leaves_the_result_as_it_was_for_what_the_condition_drops) {
    put(scratch / "a", "");
    Recorder seen;
    seen.failing = {"a"};
    OnlyWith condition('z');
    EXPECT_TRUE(FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, &condition).doIt(&seen, false, true));
    EXPECT_TRUE(seen.paths.empty());
}

TEST_F(FileIteratorTest, Kept_walk_06_takes_a_missing_directory_for_an_empty_one) {
    Recorder seen;
    FileIterator it((scratch / "none").c_str(), LOOK_BOTH, nullptr, nullptr);
    EXPECT_TRUE(it.doIt(&seen, true, true));
    EXPECT_TRUE(it.shallowIteration(&seen, true));
    EXPECT_TRUE(it.deepIteration(&seen, true));
    EXPECT_TRUE(it.shallowRide(&seen, true));
    EXPECT_TRUE(it.deepRide(&seen, true));
    EXPECT_TRUE(seen.paths.empty());
    EXPECT_FALSE(it.start(true));
    EXPECT_EQ(it.next(), nullptr);
}

TEST_F(FileIteratorTest, stops_at_the_first_failure_where_it_is_asked_to) {
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

TEST_F(FileIteratorTest, brings_a_failure_up_from_below) {
    fill();
    makeFolder(scratch / "d/e/g");
    put(scratch / "d/e/g/last", "");
    Recorder seen;
    seen.failing = {"c.txt"};
    EXPECT_FALSE(FileIterator(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr).doIt(&seen, true, true));
    EXPECT_EQ(seen.paths.size(), 3u) << "a.txt, b.dat, c.txt, and nothing below d";
    expectAllClosed();
}

TEST_F(FileIteratorTest, ends_at_every_level_when_the_visitor_stops_it) {
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

namespace {

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

TEST_F(FileIteratorTest, asks_whether_to_stop_before_each_name_and_between_its_passes) {
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

TEST_F(FileIteratorTest, asks_each_level_once_more_when_it_is_stopped) {
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

TEST_F(FileIteratorTest, asks_in_each_of_its_building_blocks) {
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

TEST_F(FileIteratorTest, opens_listings_as_its_settings_say) {
    fill();
    std::filesystem::remove_all(scratch / "d");
    Recorder seen;
    FileIterator it(LOOK_FILES | LOOK_ANYCASE);
    it.setPath(scratch.path().c_str());
    it.doIt(&seen, false, false);
    EXPECT_EQ(last("xos_DirOpenEx"), "\"*\", null, 0x0");
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), 1u);
    it.setWildCard("*.dat");
    it.setCrypted(true);
    it.setType(LOOK_FILES);
    it.doIt(&seen, false, false);
    EXPECT_EQ(last("xos_DirOpenEx"), "\"*\", \"*.dat\", 0x4000000");
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), 1u);
    it.setType(LOOK_FILES | LOOK_ANYCASE);
    it.deepIteration(&seen, false);
    EXPECT_EQ(last("xos_DirOpenEx"), "\"*\", null, 0x4000000") << "the deep pass opens without the wildcard";
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), 1u) << "nor does it heed the case";
    std::string const next = last("xos_DirNextEx");
    EXPECT_NE(next.find(", 1, 0, 0x4000"), std::string::npos) << next;
}

TEST_F(FileIteratorTest, hands_its_settings_down) {
    fill();
    Recorder seen;
    EXPECT_TRUE(
        FileIterator::doIt(Str(scratch.path()), LOOK_FILES | LOOK_ANYCASE, &seen, "F.*", nullptr, true, true, true));
    EXPECT_EQ(seen.below(scratch.path()), Found{"d/e/f.TXT"});
    EXPECT_EQ(last("xos_DirOpenEx"), "\"*/d/e\", null, 0x4000000");
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), 3u);
}

TEST_F(FileIteratorTest, asks_the_platform_for_what_the_system_lost_unless_encrypted) {
    struct Remover : FileVisitor {
        bool perform(FileEntry* entry) override {
            gone += entry->isDir() ? 1 : 0;
            for (char const* name : {"/a", "/b"}) std::filesystem::remove(std::string(entry->getDir().c_str()) + name);
            return true;
        }
        std::uint64_t gone = 0;
    };
    for (bool const crypted : {false, true}) {
        put(scratch / "a", "");
        put(scratch / "b", "");
        xos_HostCallsReset();
        Remover remover;
        FileIterator it(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr);
        it.setCrypted(crypted);
        it.doIt(&remover, false, false);
        EXPECT_EQ(xos_HostCalls("xos_FileStatByNameEx"), crypted ? 0 : remover.gone);
    }
}

TEST_F(FileIteratorTest, lists_names_flat) {
    fill();
    FileIterator it(Str(scratch.path()), LOOK_FILES | LOOK_ANYCASE, "*.TXT", nullptr);
    EXPECT_EQ(listed(it), Found{"a.txt"}) << "opened by itself, with wildcard and case";
    EXPECT_EQ(listed(it), Found{"a.txt"}) << "and again after the end";
    expectAllClosed();
    ASSERT_TRUE(it.start(false));
    EXPECT_EQ(listed(it), (Found{"a.txt", "b.dat"}));
    ASSERT_TRUE(it.start(true));
    ASSERT_TRUE(it.start(true)) << "a second start closes the first";
    EXPECT_STREQ(it.next(), "a.txt");
    it.finish();
    it.finish();
    expectAllClosed();
    OnlyWith condition('b');
    FileIterator some(scratch.path().c_str(), LOOK_FILES, nullptr, &condition);
    EXPECT_EQ(listed(some), Found{"b.dat"});
    EXPECT_EQ(condition.asked, &some);
}

TEST_F(FileIteratorTest, copies_its_settings_but_not_its_listing) {
    fill();
    {
        FileIterator it(scratch.path().c_str(), LOOK_FILES, "a*", nullptr);
        ASSERT_TRUE(it.start(true));
        FileIterator copy(it);
        EXPECT_STREQ(copy.next(), "a.txt");
        EXPECT_STREQ(it.next(), "a.txt");
        copy = it;
        EXPECT_EQ(it.next(), nullptr);
        EXPECT_STREQ(copy.next(), "a.txt") << "assigning closes and begins again";
    }
    expectAllClosed();
}

TEST_F(FileIteratorTest, survives_every_failing_call_of_the_platform) {
    fill();
    for (char const* function : {"xos_DirOpenEx", "xos_DirNextEx"}) {
        SCOPED_TRACE(function);
        Found const whole = walked(LOOK_BOTH, nullptr, true);
        xos_HostCallsReset();
        walked(LOOK_BOTH, nullptr, true);
        auto const calls = static_cast<std::uint32_t>(xos_HostCalls(function));
        ASSERT_GE(calls, 6u);
        for (std::uint32_t skip = 0; skip < calls; ++skip) {
            SCOPED_TRACE(skip);
            xos_HostCallsReset();
            ASSERT_EQ(xos_HostFail(function, skip, 1), 0);
            Found const found = walked(LOOK_BOTH, nullptr, true);
            xos_HostFailClear();
            for (std::string const& path : found) EXPECT_EQ(whole.count(path), 1u) << path;
            EXPECT_LE(xos_HostCalls("xos_DirClose"), xos_HostCalls("xos_DirOpenEx"));
            EXPECT_GE(xos_HostCalls("xos_DirClose") + 1, xos_HostCalls("xos_DirOpenEx")) << "only the failed one stays";
        }
    }
    ASSERT_EQ(xos_HostFail("xos_DirOpenEx", 0, 1), 0);
    EXPECT_EQ(walked(LOOK_FILES, nullptr, true), (Found{"d/c.txt", "d/e/f.TXT"})) << "the shallow pass alone fails";
    ASSERT_EQ(xos_HostFail("xos_DirOpenEx", 1, 1), 0);
    EXPECT_EQ(walked(LOOK_FILES, nullptr, true), (Found{"a.txt", "b.dat"})) << "the deep pass alone fails";
}

TEST_F(FileIteratorTest, Kept_walk_07_starts_a_walk_in_every_directory_reported) {
    fill();
    Recorder inner;
    FileIterator second(LOOK_FILES);
    FileIterVisitor each(&second, &inner, false, true);
    FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&each, false, true);
    EXPECT_EQ(inner.below(scratch.path()), Found{"d/c.txt"});
    FileIterVisitor deep(&second, &inner, true, true);
    inner = Recorder();
    FileEntry directory(FStat::ST_DIR, Str(scratch.path()), "d", 0, 0);
    EXPECT_TRUE(deep.perform(&directory));
    EXPECT_EQ(inner.below(scratch.path()), (Found{"d/c.txt", "d/e/f.TXT"}));
    inner.failing = {"c.txt"};
    EXPECT_FALSE(deep.perform(&directory));
    FileEntry file(FStat::ST_FILE, Str(scratch.path()), "d", 0, 0);
    EXPECT_TRUE(deep.perform(&file)) << "no directory";
    EXPECT_STREQ(second.next(), "c.txt") << "the iterator stays where it walked last";
}

TEST(FileConditionBase, keeps_everything) {
    FileCondition all;
    FileEntry entry(FStat::ST_FILE, Str("d"), "n", 0, 0);
    EXPECT_TRUE(all.acceptName(nullptr, "n"));
    EXPECT_TRUE(all.acceptEntry(&entry));
}

TEST(FileVisitorBase, never_stops) {
    struct : FileVisitor {
        bool perform(FileEntry* /*entry*/) override { return true; }
    } visitor;
    EXPECT_FALSE(visitor.stop());
}
