#include "tests/host/xos_url/fetched_files.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <string>

namespace {

class HostFileUrl : public FetchedFiles {
protected:
    /// The path of a file in the scratch folder as it stands in a URL.
    std::string inUrl(std::string const& name) const {
        std::string const path = scratch / name;
        return path.front() == '/' ? path : "/" + path;
    }
};

TEST_F(HostFileUrl, copies_a_file) {
    std::string const text = std::string("a\0b\r\n\x1A", 6) + std::string(300'000, 'z');
    put(scratch / "source", text);
    for (char const* const start : {"file://", "file:", "file://localhost", "FILE://LocalHost"}) {
        SCOPED_TRACE(start);
        EXPECT_EQ(get(start + inUrl("source"), scratch / "target"), 0);
        EXPECT_EQ(textOf(scratch / "target"), text);
        std::filesystem::remove(scratch / "target");
    }
    EXPECT_EQ(scratch.content(), Names{"source"});
}

TEST_F(HostFileUrl, resolves_escapes_and_leaves_query_and_fragment_out) {
    put(scratch / "with blank", "blank");
    put(scratch / "a%b", "percent");
    put(scratch / "x", "x");
    struct Case {
        Row row;
        char const* name;
        char const* text;
    };
    for (Case const& c :
         {Case{{}, "with%20blank", "blank"}, Case{{}, "with blank", "blank"}, Case{{}, "a%25b", "percent"},
          Case{{}, "%78", "x"}, Case{{}, "x?query", "x"}, Case{{}, "x#fragment", "x"}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(get("file://" + inUrl(c.name), scratch / "target"), 0);
        EXPECT_EQ(textOf(scratch / "target"), c.text);
    }
}

TEST_F(HostFileUrl, fails_without_a_regular_file) {
    makeFolder(scratch / "folder");
    put(scratch / "x", "x");
    for (char const* const name : {"missing", "folder", "x%00", "x%", "x%7", "%zz"}) {
        SCOPED_TRACE(name);
        EXPECT_NE(get("file://" + inUrl(name), scratch / "target"), 0);
    }
    EXPECT_NE(get("file://no-such-host.invalid" + inUrl("x"), scratch / "target"), 0);
    EXPECT_EQ(scratch.content(), (Names{"folder/", "x"}));
}

TEST_F(HostFileUrl, may_be_its_own_target) {
    put(scratch / "same", "the same");
    EXPECT_EQ(get("file://" + inUrl("same"), scratch / "same"), 0);
    EXPECT_EQ(textOf(scratch / "same"), "the same");
}

TEST_F(HostFileUrl, takes_both_slash_kinds_in_the_target) {
    put(scratch / "source", "text");
    makeFolder(scratch / "deep");
    EXPECT_EQ(get("file://" + inUrl("source"), scratch.path() + "\\deep\\target"), 0);
    EXPECT_EQ(textOf(scratch / "deep/target"), "text");
}

} // namespace
