#include <zor_basis/walk/file_iterator.h>

#include <zor_basis/walk/file_count_visitor.h>

#include "tests/support/table.h"

#include "tests/walk/walked_folder.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileIteratorAtThePlatform : WalkedFolder {};

} // namespace

TEST_F(FileIteratorAtThePlatform, Kept_walk_02_reports_what_has_gone_as_a_directory) {
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

TEST_F(FileIteratorAtThePlatform, opens_listings_as_its_settings_say) {
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

TEST_F(FileIteratorAtThePlatform, hands_its_settings_down) {
    fill();
    Recorder seen;
    EXPECT_TRUE(
        FileIterator::doIt(Str(scratch.path()), LOOK_FILES | LOOK_ANYCASE, &seen, "F.*", nullptr, true, true, true));
    EXPECT_EQ(seen.below(scratch.path()), Found{"d/e/f.TXT"});
    EXPECT_EQ(last("xos_DirOpenEx"), "\"*/d/e\", null, 0x4000000");
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), 3u);
}

TEST_F(FileIteratorAtThePlatform, asks_the_platform_for_what_the_system_lost_unless_encrypted) {
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

TEST_F(FileIteratorAtThePlatform, survives_every_failing_call_of_the_platform) {
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
