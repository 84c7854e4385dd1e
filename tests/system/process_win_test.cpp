// How the system is called on Windows, and each of its calls failing in turn.

#include <zor_basis/system/process.h>

#include "basis/system/process_calls_win.h"

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/thread_facts.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

char threadPlace;
char processPlace;
HANDLE const THREAD = &threadPlace;
HANDLE const PROCESS = &processPlace;
constexpr DWORD NO_WAIT = WAIT_FAILED;

/// What the system was asked for, in order, and what it answers.
std::vector<std::string> calls;
bool works = true;
DWORD waitResult = WAIT_OBJECT_0;

std::string nameOf(HANDLE handle) {
    if (handle == THREAD) return "thread";
    return handle == PROCESS ? "process" : handle == nullptr ? "null" : "another";
}

BOOL WINAPI create(LPCSTR application, LPSTR line, LPSECURITY_ATTRIBUTES processSecurity,
                   LPSECURITY_ATTRIBUTES threadSecurity, BOOL inherit, DWORD flags, LPVOID environment, LPCSTR folder,
                   LPSTARTUPINFOA startup, LPPROCESS_INFORMATION created) {
    calls.push_back(std::string("create ") + (application != nullptr ? application : "null") + " " +
                    (line != nullptr ? line : "null") + " " + std::to_string(flags));
    EXPECT_EQ(processSecurity, nullptr);
    EXPECT_EQ(threadSecurity, nullptr);
    EXPECT_EQ(inherit, FALSE);
    EXPECT_EQ(environment, nullptr);
    EXPECT_EQ(folder, nullptr);
    EXPECT_EQ(startup->cb, sizeof(STARTUPINFOA));
    for (std::size_t i = sizeof startup->cb; i < sizeof *startup; ++i)
        EXPECT_EQ(reinterpret_cast<char const*>(startup)[i], 0);
    EXPECT_EQ(created->hProcess, nullptr);
    EXPECT_EQ(created->hThread, nullptr);
    if (!works) return FALSE;
    *created = {PROCESS, THREAD, 4711, 4712};
    return TRUE;
}
HANDLE WINAPI open(DWORD rights, BOOL inherit, DWORD id) {
    calls.push_back("open " + std::to_string(rights) + " " + std::to_string(inherit) + " " + std::to_string(id));
    return works ? PROCESS : nullptr;
}
DWORD WINAPI waitFor(HANDLE handle, DWORD ms) {
    calls.push_back("wait " + nameOf(handle) + (ms == INFINITE ? "" : " limited"));
    return waitResult;
}
BOOL WINAPI exitCode(HANDLE handle, LPDWORD code) {
    calls.push_back("code " + nameOf(handle));
    if (!works) return FALSE;
    *code = 0xC0000005;
    return TRUE;
}
BOOL WINAPI noExitCode(HANDLE, LPDWORD code) {
    *code = 99;
    return FALSE;
}
BOOL WINAPI terminate(HANDLE handle, UINT code) {
    calls.push_back("terminate " + nameOf(handle) + " " + std::to_string(code));
    return works && handle == PROCESS ? TRUE : FALSE;
}
BOOL WINAPI closeHandle(HANDLE handle) {
    calls.push_back("close " + nameOf(handle));
    return TRUE;
}

using Calls = std::vector<std::string>;

/// A system of our own.
struct ProcessCallsWin : testing::Test {
    ProcessCallsWin() {
        calls.clear();
        works = true;
        waitResult = WAIT_OBJECT_0;
        processCalls = {create, open, waitFor, exitCode, terminate, closeHandle};
    }
    ~ProcessCallsWin() override { processCalls = real; }

    ProcessCalls const real = processCalls;
};

} // namespace

TEST_F(ProcessCallsWin, create_and_await) {
    int code = 55;
    EXPECT_TRUE(Process::Create("app.exe", nullptr, "app \"a b\"", &code));
    EXPECT_EQ(calls, (Calls{"create app.exe app \"a b\" 16", "wait process", "code process", "close process",
                            "close thread"}));
    EXPECT_EQ(code, static_cast<int>(0xC0000005));
}

TEST_F(ProcessCallsWin, create_and_await_without_asking_for_the_code) {
    EXPECT_TRUE(Process::Create(nullptr, nullptr, "app", nullptr));
    EXPECT_EQ(calls, (Calls{"create null app 16", "wait process", "close process", "close thread"}));
}

TEST_F(ProcessCallsWin, create_and_let_run) {
    unsigned long id = 0;
    int code = 55;
    EXPECT_TRUE(Process::Create("app.exe", &id, nullptr, &code));
    EXPECT_EQ(calls, (Calls{"create app.exe null 16", "close process", "close thread"}));
    EXPECT_EQ(id, 4711u);
    EXPECT_EQ(code, 0);
}

TEST_F(ProcessCallsWin, create_that_fails) {
    works = false;
    unsigned long id = 5;
    int code = 55;
    EXPECT_FALSE(Process::Create("app.exe", &id, nullptr, &code));
    EXPECT_EQ(calls, (Calls{"create app.exe null 16"}));
    EXPECT_EQ(id, 5u);
    EXPECT_EQ(code, 0);
}

TEST_F(ProcessCallsWin, exit_code_that_cannot_be_had) {
    processCalls.exitCodeOf = noExitCode;
    int code = 55;
    EXPECT_TRUE(Process::Create("app.exe", nullptr, nullptr, &code));
    EXPECT_EQ(code, 0);
    waitResult = NO_WAIT;
    EXPECT_TRUE(Process::Create("app.exe", nullptr, nullptr, &code)) << "it was started";
    EXPECT_EQ(calls.back(), "close thread");
}

TEST_F(ProcessCallsWin, wait) {
    EXPECT_TRUE(Process::Wait(77));
    EXPECT_EQ(calls, (Calls{"open " + std::to_string(SYNCHRONIZE) + " 0 77", "wait process", "close process"}));
    for (DWORD const result : {DWORD{WAIT_FAILED}, DWORD{WAIT_ABANDONED}, DWORD{WAIT_TIMEOUT}}) {
        waitResult = result;
        EXPECT_FALSE(Process::Wait(77));
        EXPECT_EQ(calls.back(), "close process");
    }
    calls.clear();
    works = false;
    EXPECT_FALSE(Process::Wait(77));
    EXPECT_EQ(calls, (Calls{"open " + std::to_string(SYNCHRONIZE) + " 0 77", "wait null"})) << "nothing to close";
}

TEST_F(ProcessCallsWin, terminate) {
    EXPECT_TRUE(Process::Terminate(77));
    EXPECT_EQ(calls,
              (Calls{"open " + std::to_string(PROCESS_TERMINATE) + " 0 77", "terminate process 0", "close process"}));
    calls.clear();
    works = false;
    EXPECT_FALSE(Process::Terminate(77));
    EXPECT_EQ(calls, (Calls{"open " + std::to_string(PROCESS_TERMINATE) + " 0 77", "terminate null 0"}));
}

/* The system itself */

namespace {

/// A process that runs until it is told, and whose identifier stays its own as long as this object lives.
class Running {
public:
    Running() {
        std::string const line = '"' + programBeside("process_child") + "\" until \"" + file_ + '"';
        EXPECT_TRUE(Process::Create(nullptr, &id, line.c_str(), nullptr));
        kept_ = OpenProcess(PROCESS_QUERY_INFORMATION | SYNCHRONIZE, FALSE, id);
        EXPECT_NE(kept_, nullptr);
    }
    ~Running() { CloseHandle(kept_); }

    void go() const { put(file_, "go"); }
    DWORD exitCode() const {
        DWORD code = STILL_ACTIVE;
        GetExitCodeProcess(kept_, &code);
        return code;
    }

    unsigned long id = 0;

private:
    Scratch scratch_;
    std::string const file_ = scratch_ / "go";
    HANDLE kept_ = nullptr;
};

} // namespace

TEST(ProcessWin, is_awaited_by_its_identifier) {
    std::size_t const before = openHandles();
    {
        std::vector<std::unique_ptr<Running>> all;
        for (int i = 0; i < 10; ++i) all.push_back(std::make_unique<Running>());
        for (auto const& one : all) EXPECT_EQ(one->exitCode(), DWORD{STILL_ACTIVE});
        for (auto const& one : all) {
            one->go();
            EXPECT_TRUE(Process::Wait(one->id));
            EXPECT_EQ(one->exitCode(), 7u);
            EXPECT_TRUE(Process::Wait(one->id)) << "as long as somebody keeps it";
        }
    }
    EXPECT_EQ(openHandles(), before);
}

TEST(ProcessWin, is_ended_with_exit_code_0) {
    Running const one;
    EXPECT_TRUE(Process::Terminate(one.id));
    EXPECT_TRUE(Process::Wait(one.id));
    EXPECT_EQ(one.exitCode(), 0u);
}
