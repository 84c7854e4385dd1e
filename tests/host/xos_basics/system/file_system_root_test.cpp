#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

namespace {

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

} // namespace
