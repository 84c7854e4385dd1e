// What paths make of the root folder, which is found once in a process: each case has a child of its own.

#include "basis/files/root_folder_impl.h"

#include "tests/support/root_child.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

namespace {

bool const ONE_FILE_SYSTEM = ZOR_Basis::RootFolder::HAS_ONE_FILE_SYSTEM;

} // namespace

TEST(RootFolderOfPaths, is_the_parent_of_a_folder_system) {
    struct Case {
        Row row;
        char const *root, *narrow, *wide;
    };
    for (Case const& c : {
             Case{{}, "/srv/system", "fake  </srv/x>\n", "fake  </srv>\n"},
             Case{{}, "/srv/system/", "fake  </srv/x>\n", "fake  </srv>\n"},
             Case{{}, "/srv/systems", "fake  </srv/systems/x>\n", "fake  </srv/systems>\n"},
             Case{{}, "/srv/System", "fake  </srv/System/x>\n", "fake  </srv/System>\n"},
             Case{{}, "/srv/system/system", "fake  </srv/system/x>\n", "fake  </srv/system>\n"},
             // The parent of a bare "system" has no text, so nothing can be translated to it.
             Case{{}, "system", "plain  </scsi0/x>\n", "fake  <>\n"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(stepsUnder(c.root, {"fake", "/scsi0/x"}), c.narrow);
        EXPECT_EQ(stepsUnder(c.root, {"wide", "/scsi0"}), c.wide);
    }
}

TEST(RootFolderOfPaths, is_not_translated_to_itself_where_it_is_a_fake_root) {
    EXPECT_EQ(stepsUnder("/scsi0", {"fake", "/scsi0", "fake", "/scsi0/x", "fake", "/JS_Root/x"}),
              "plain  </scsi0>\nplain  </scsi0/x>\nfake  </scsi0/x>\n");
    EXPECT_EQ(stepsUnder("/JS_Root/a", {"fake", "/JS_Root/a/x", "fake", "/JS_Root/b", "fake", "/scsi0"}),
              "plain  </JS_Root/a/x>\nfake  </JS_Root/a/b>\nfake  </JS_Root/a>\n");
}

TEST(RootFolderOfPaths, makes_nothing_fake_while_it_is_empty_unless_it_is_the_whole_file_system) {
    EXPECT_EQ(stepsUnder("system", {"fake", "/scsi0", "fake", "/JS_Root/x", "fake", "\\scsi0", "fake", "/"}),
              "plain  </scsi0>\nplain  </JS_Root/x>\nplain  <\\scsi0>\nplain  </>\n");
    for (char const* slash : {"/", "/system", "\\"}) {
        SCOPED_TRACE(slash);
        EXPECT_EQ(stepsUnder(slash, {"fake", "/scsi0/x", "fake", "/JS_Root"}),
                  ONE_FILE_SYSTEM ? "fake  </x>\nfake  </>\n" : "plain  </scsi0/x>\nplain  </JS_Root>\n");
    }
}

TEST(RootFolderOfPaths, is_asked_for_by_one_thread_while_the_others_wait) {
    for (int i = 0; i < 10; ++i) EXPECT_EQ(stepsUnder("/srv/print", {"ask"}), "1 calls, 1 paths, </srv/print>\n");
}

TEST(RootFolderOfPaths, is_one_text_in_wide_paths_of_all_threads) {
    struct Case {
        Row row;
        std::string root, expected;
    };
    for (Case const& c : {
             Case{{}, "/srv/print", "/srv/print"},
             Case{{},
                  "/srv/gr\xC3\xB6\xC3\x9F"
                  "e",
                  "/srv/gr\xC3\xB6\xC3\x9F"
                  "e"},
             Case{{}, "/" + std::string(300, 'r'), "/" + std::string(300, 'r')},
             Case{{}, "/srv/a folder with a long name\xFF", ""}, // not UTF-8: never to be seen
             Case{{}, "/", ONE_FILE_SYSTEM ? "/" : ""},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(stepsUnder(c.root, {"race", c.expected}), "0 wrong\n");
        EXPECT_EQ(stepsUnder(c.root, {"refill", c.expected}), "0 wrong\n");
    }
}

TEST(RootFolderOfPaths, is_in_wide_paths_what_the_application_sets) {
    EXPECT_EQ(stepsUnder("/srv", {"set", "/own", "wide", "/scsi0", "pathroot", "race", "/own"}),
              "fake  </own>\n</own>\n0 wrong\n")
        << "before the first use";
    EXPECT_EQ(stepsUnder("/srv", {"wide", "/scsi0", "set", "/own", "wide", "/scsi0", "wide", "/own", "pathroot"}),
              "fake  </srv>\nfake  </own>\nfake  </own>\n</own>\n")
        << "at any time";
    EXPECT_EQ(stepsUnder("/srv", {"wide", "/scsi0", "set", "/own", "clear", "wide", "/scsi0", "pathroot"}),
              "fake  </srv>\nfake  </srv>\n</srv>\n")
        << "filled again once it is empty";
    EXPECT_EQ(stepsUnder("/srv\xFF", {"set", "/own", "race", "/own"}), "0 wrong\n");
    EXPECT_EQ(stepsUnder("/", {"set", "/own", "race", "/own", "clear", "race", ONE_FILE_SYSTEM ? "/" : ""}),
              "0 wrong\n0 wrong\n")
        << "also where the root is the whole file system";
}
