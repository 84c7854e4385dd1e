#include "basis/platform/xos_basics.h"
#include "tests/host/support/fault_scratch.h"

namespace {

struct HostDirectoryFaults : FaultScratch {};

} // namespace

TEST_F(HostDirectoryFaults, fail_each_function_once) {
    std::string const a = scratch / "a";
    std::string const b = scratch / "b";
    std::string const c = scratch / "c";
    failsOnce("xos_DirCreateEx", [&] { return xos_DirCreateEx(a.c_str(), 0) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_DirCreateEx")}, "\"" + a + "\", 0");
    put(scratch / "a/f", "f");
    failsOnce("xos_DirCopy", [&] { return xos_DirCopy(b.c_str(), a.c_str(), 0x201) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_DirCopy")}, "\"" + b + "\", \"" + a + "\", 0x201");
    failsOnce("xos_DirMove", [&] { return xos_DirMove(c.c_str(), b.c_str(), 1) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_DirMove")}, "\"" + c + "\", \"" + b + "\", 0x1");
    xos_Dir listing = 0;
    failsOnce("xos_DirOpenEx", [&] { return (listing = xos_DirOpenEx(a.c_str(), "*", 0x4000000)) != 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_DirOpenEx")}, "\"" + a + "\", \"*\", 0x4000000");
    failsOnce("xos_DirNextEx", [&] { return xos_DirNextEx(listing, 2, 0, 0x4000) != nullptr; });
    xos_DirClose(listing);
    failsOnce("xos_DirRemove", [&] { return xos_DirRemove(a.c_str(), 0x600) == 0; });
    EXPECT_EQ(std::string{xos_HostLastCall("xos_DirRemove")}, "\"" + a + "\", 0x600");
    EXPECT_EQ(scratch.content(), (Names{"c/", "c/f"}));
}

TEST_F(HostDirectoryFaults, count_what_cannot_fail) {
    std::uint64_t const forced = xos_HostCalls("xos_DirForceCaseAny");
    std::uint64_t const closed = xos_HostCalls("xos_DirClose");
    xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    xos_DirForceCaseAny(listing, 1);
    xos_DirClose(listing);
    EXPECT_EQ(xos_HostCalls("xos_DirForceCaseAny"), forced + 1);
    EXPECT_EQ(xos_HostCalls("xos_DirClose"), closed + 1);
    EXPECT_EQ(xos_HostFail("xos_DirForceCaseAny", 0, 1), -1);
    EXPECT_EQ(xos_HostFail("xos_DirClose", 0, 1), -1);
}
