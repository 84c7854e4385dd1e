// The root folder is found once in a process, so each case has a child of its own; the rule that makes a root of a
// folder is tested directly.

#include "basis/files/root_folder.h"
#include "basis/files/root_folder_impl.h"

#include "tests/support/root_child.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace fs = std::filesystem;
using ZOR_Basis::RootFolder::fromFolder;

namespace {

bool const ONE_FILE_SYSTEM = ZOR_Basis::RootFolder::HAS_ONE_FILE_SYSTEM;

} // namespace

TEST(RootFolder, is_made_of_a_folder) {
    struct Case {
        Row row;
        char const *folder, *root;
    };
    for (Case const& c : {
             Case{{}, "D:\\srv\\system\\", "D:/srv"},
             Case{{}, "D:\\srv\\systems", "D:/srv/systems"},
             Case{{}, "D:/srv/system", "D:/srv"},
             Case{{}, "D:/srv/System", "D:/srv/System"},
             Case{{}, "/srv/mysystem/", "/srv/mysystem"},
             Case{{}, "/srv//", "/srv/"}, // one slash only
             Case{{}, "/srv/system//", "/srv/system/"},
             Case{{}, "/srv/system/system", "/srv/system"}, // once only
             Case{{}, "/srv\\a/b", "/srv/a/b"},
             Case{{}, "/system", ""},
             Case{{}, "system", ""},
             Case{{}, "/", ""},
             Case{{}, "", ""},
         }) {
        SCOPED_TRACE(c.row);
        auto const root = fromFolder(c.folder);
        EXPECT_STREQ(root.text.c_str(), c.root);
        EXPECT_EQ(root.isFileSystem, ONE_FILE_SYSTEM && c.folder[0] == '/' && c.root[0] == '\0');
    }
}

TEST(SysRoot, is_the_configured_one) {
    EXPECT_EQ(stepsUnder("/srv/print/system/", {"root", "root", "copy", "temp"}),
              "</srv/print>\n</srv/print>\ntrue </srv/print>\n</srv/print/tmp>\n");
}

TEST(SysRoot, is_the_current_folder_without_a_configured_one) {
    fs::path const folder = fs::canonical(fs::temp_directory_path());
    std::string const expected = fromFolder(folder.string().c_str()).text.c_str();
    EXPECT_EQ(stepsUnder("", {"root", "temp"}, folder.string()), "<" + expected + ">\n<" + expected + "/tmp>\n");
    EXPECT_EQ(stepsUnder("/srv", {"root"}, folder.string(), "xos_FileSystemRoot:0:1"), "<" + expected + ">\n")
        << "a platform layer that does not know";
}

TEST(SysRoot, takes_the_place_of_fake_roots) {
    EXPECT_EQ(
        stepsUnder("/srv", {"fake", "/scsi0/tmp/x", "fake", "/JS_Root", "fake", "\\scsi0\\x", "fake", "/JS_Root/"}),
        "fake  </srv/tmp/x>\nfake  </srv>\nfake  </srv\\x>\nfake  </srv/>\n");
    EXPECT_EQ(
        stepsUnder("/srv", {"fake", "/scsi01/x", "fake", "scsi0/x", "fake", "/SCSI0", "fake", "//scsi0", "fake", ""}),
        "plain  </scsi01/x>\nplain  <scsi0/x>\nplain  </SCSI0>\nplain  <//scsi0>\nplain  <>\n");
    EXPECT_EQ(stepsUnder("/scsi0", {"fake", "/scsi0/x", "fake", "/JS_Root/x"}), "plain  </scsi0/x>\nfake  </scsi0/x>\n")
        << "what lies under the root already is never translated";
}

TEST(WcPathRoot, Kept_path_08_compares_whole_paths) {
    EXPECT_EQ(stepsUnder("/srv", {"wide", "/scsi0", "wide", "\\JS_Root", "wide", "/scsi0/tmp", "wide", "/scsi0/",
                                  "wide", "scsi0", "pathroot"}),
              "fake  </srv>\nfake  </srv>\nplain  </scsi0/tmp>\nplain  </scsi0/>\nplain  <scsi0>\n</srv>\n");
    EXPECT_EQ(stepsUnder("/srv", {"wide", "/srv"}), "fake  </srv>\n");
    EXPECT_EQ(stepsUnder("/srv/print", {"wide", "/srv/print"}), "fake  </srv/printrint>\n")
        << "six characters make place";
    EXPECT_EQ(stepsUnder("/srv\xFF", {"wide", "/scsi0", "pathroot"}), "fake  <>\n<>\n") << "not UTF-8: no wide root";
}

TEST(SysRoot, leaves_what_is_made_from_it_absolute_where_it_is_the_whole_file_system_on_linux) {
    std::string const bare = ONE_FILE_SYSTEM ? "/" : "";
    std::string const temp = ONE_FILE_SYSTEM ? "/tmp" : "tmp";
    EXPECT_EQ(stepsUnder("/", {"copy", "temp", "wide", "/scsi0"}), "false <>\n<" + temp + ">\nfake  <" + bare + ">\n");
}
