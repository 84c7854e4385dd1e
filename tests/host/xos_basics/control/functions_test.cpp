#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "host/include/xos_host.h"
#include "tests/host/xos_basics/control/recorded_calls.h"

#include <gtest/gtest.h>

namespace {

constexpr char const* const CANNOT_FAIL[] = {"xos_MsCount",         "xos_StrCmp",   "xos_TaskSleep",  "xos_Assert",
                                             "xos_DirForceCaseAny", "xos_DirClose", "cfg_GroupDelete"};

constexpr char const* const CAN_FAIL[] = {"xos_SemMCreate",
                                          "xos_SemBCreate",
                                          "xos_SemNamedMutexCreate",
                                          "xos_SemTake",
                                          "xos_SemGive",
                                          "xos_SemDestroy",
                                          "xos_TaskCreate",
                                          "xos_FileOpen",
                                          "xos_FileCloseEx",
                                          "xos_FileReadEx",
                                          "xos_FileWriteEx",
                                          "xos_FileGetsEx",
                                          "xos_FileFlush",
                                          "xos_FileSeekEx",
                                          "xos_FileTellEx",
                                          "xos_FileRemove",
                                          "xos_FileCopy",
                                          "xos_FileMove",
                                          "xos_FileHardLink",
                                          "xos_FileStatByNameEx",
                                          "xos_DirCreateEx",
                                          "xos_DirRemove",
                                          "xos_DirCopy",
                                          "xos_DirMove",
                                          "xos_DirOpenEx",
                                          "xos_DirNextEx",
                                          "xos_FileSystemRoot",
                                          "xos_ShellExecuteEx",
                                          "xos_LibraryLoad",
                                          "xos_BasicsParamLookup",
                                          "cfg_GroupLoadFromFile",
                                          "cfg_KeyGetOpt_Bool",
                                          "xos_URLGet",
                                          "HQ_Basis::AlertTimer::New",
                                          "HQ_Basis::AlertTimer::Delete"};

struct HostFunctions : RecordedCalls {};

TEST_F(HostFunctions, refuses_to_fail_what_cannot_fail_or_does_not_exist) {
    for (char const* const name : CANNOT_FAIL) { EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name; }
    for (char const* const name : {"", "xos_FileMov", "xos_FileMoveEx", "New", "AlertTimer::New", "xos_HostFail"}) {
        EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name;
    }
    EXPECT_EQ(xos_HostFail(nullptr, 0, 1), -1);
}

TEST_F(HostFunctions, accepts_every_function_that_can_fail) {
    for (char const* const name : CAN_FAIL) { EXPECT_EQ(xos_HostFail(name, 3, 1), 0) << name; }
}

} // namespace
