// Reasons that only Windows has: those of the registry, which come as results, and of calls made to fail.

#include "tests/system/reasons_test.h"

#include <zor_basis/files.h>
#include <zor_basis/system.h>

#include "basis/system/process_calls_win.h"
#include "basis/system/query_calls_win.h"

#include <memory>

using namespace ZOR_Basis;

namespace {

BOOL WINAPI refuseLogon(LPCSTR, LPCSTR, LPCSTR, DWORD, DWORD, PHANDLE) {
    SetLastError(ERROR_LOGON_FAILURE);
    return FALSE;
}
BOOL WINAPI refuseToActAs(HANDLE) {
    SetLastError(ERROR_BAD_IMPERSONATION_LEVEL);
    return FALSE;
}
BOOL WINAPI admit(LPCSTR, LPCSTR, LPCSTR, DWORD, DWORD, PHANDLE token) {
    *token = nullptr;
    return TRUE;
}
BOOL WINAPI closeWithError(HANDLE) {
    SetLastError(ERROR_INVALID_HANDLE);
    return FALSE;
}
DWORD WINAPI failToConnect(LPCSTR, LPSTR, LPDWORD) { return ERROR_NOT_CONNECTED; }
HANDLE WINAPI refuseToOpen(DWORD, BOOL, DWORD) {
    SetLastError(ERROR_ACCESS_DENIED);
    return nullptr;
}

struct ReasonsWin : testing::Test {
    ~ReasonsWin() override {
        queryCalls = queries;
        processCalls = processes;
    }
    QueryCalls const queries = queryCalls;
    ProcessCalls const processes = processCalls;
};

} // namespace

TEST_F(ReasonsWin, of_the_registry_are_the_last_error) {
    expectReasons({
        Failure{{},
                0,
                ERROR_FILE_NOT_FOUND,
                [](auto&) {
                    FPath share;
                    return Sys::UnMap("q:\\x", share);
                }},
        Failure{{},
                0,
                ERROR_INVALID_PARAMETER,
                [](auto&) {
                    FPath share;
                    return Sys::UnMap("", share);
                }},
        Failure{{},
                0,
                ERROR_NOT_CONNECTED,
                [](auto&) {
                    FPath share;
                    queryCalls.connection = failToConnect;
                    return Sys::UnMapLogin("q:\\x", share);
                }},
        Failure{{},
                0,
                ERROR_FILE_NOT_FOUND,
                [](auto&) {
                    BufStr<255> domain;
                    return Sys::FullDomain("ZB-NOWHERE", domain);
                }},
    });
}

TEST_F(ReasonsWin, of_logging_on_outlast_the_closing_of_handles) {
    expectReasons({
        Failure{{},
                0,
                ERROR_LOGON_FAILURE,
                [](auto&) {
                    queryCalls.logonUser = refuseLogon;
                    return Sys::loginUser("jane", "secret", true) != nullptr;
                }},
        Failure{{},
                0,
                ERROR_BAD_IMPERSONATION_LEVEL,
                [](auto&) {
                    queryCalls.logonUser = admit;
                    queryCalls.impersonate = refuseToActAs;
                    queryCalls.closeHandle = closeWithError;
                    std::unique_ptr<SysHdl> const jane(Sys::loginUser("jane", "secret", true));
                    return Sys::impersonate(jane.get());
                }},
    });
}

TEST_F(ReasonsWin, of_processes_are_those_of_opening_them) {
    processCalls.openProcess = refuseToOpen;
    expectReasons({
        Failure{{}, 0, ERROR_ACCESS_DENIED, [](auto&) { return Process::Wait(4); }},
        Failure{{}, 0, ERROR_ACCESS_DENIED, [](auto&) { return Process::Terminate(4); }},
    });
}

TEST_F(ReasonsWin, of_files_that_another_program_holds) {
    auto const opens = [](Place const& in, int mode, bool flag) {
        HANDLE const held = CreateFileA(in.at("file").c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr);
        bool const isOpen = File(in.at("file").c_str(), File::FILE_READ | mode, flag).isOpen();
        DWORD const error = GetLastError();
        CloseHandle(held);
        SetLastError(error);
        return isOpen;
    };
    expectReasons({
        Failure{{}, 0, ERROR_SHARING_VIOLATION, [=](auto& in) { return opens(in, 0, false); }},
        Failure{{}, 0, ERROR_SHARING_VIOLATION, [=](auto& in) { return opens(in, File::FILE_CRT, false); }},
        Failure{{}, 0, ERROR_SHARING_VIOLATION, [=](auto& in) { return opens(in, File::FILE_CRT, true); }},
    });
}
