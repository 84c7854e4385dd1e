#include <zor_basis/system/process.h>

#include <xos_host.h>

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "tests/support/thread_facts.h"

#include <gtest/gtest.h>

#include <climits>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

#ifdef _WIN32
constexpr char LIBRARY[] = "kernel32.dll";
constexpr char FUNCTION[] = "GetCurrentProcessId";
#else
constexpr char LIBRARY[] = "libc.so.6";
constexpr char FUNCTION[] = "getpid";
#endif

std::string quoted(std::string const& text) { return '"' + text + '"'; }

struct ProcessOfThisUser : testing::Test {
    ~ProcessOfThisUser() override {
        xos_HostFailClear();
        xos_HostSetResolver(nullptr);
    }

    std::string lineOf(std::string const& steps) const { return quoted(program) + " " + steps; }

    std::string const program = programBeside("process_child");
    Scratch scratch;
};

} // namespace

TEST_F(ProcessOfThisUser, breathes) {
    int code = -1;
    EXPECT_TRUE(Process::Create(nullptr, nullptr, lineOf("exit 3").c_str(), &code));
    EXPECT_EQ(code, 3);
}

TEST_F(ProcessOfThisUser, is_awaited_and_gives_its_exit_code) {
    for (int const expected : {0, 1, 77, 255}) {
        int code = -1;
        EXPECT_TRUE(Process::Create(nullptr, nullptr, lineOf("exit " + std::to_string(expected)).c_str(), &code));
        EXPECT_EQ(code, expected);
    }
    EXPECT_TRUE(Process::Create(nullptr, nullptr, lineOf("exit 4").c_str(), nullptr)) << "nobody asks";
}

TEST_F(ProcessOfThisUser, is_started_by_its_path) {
    int code = -1;
    EXPECT_TRUE(Process::Create(program.c_str(), nullptr, "any-name exit 5", &code));
    EXPECT_EQ(code, 5);
    EXPECT_TRUE(Process::Create(program.c_str(), nullptr, nullptr, &code)) << "no further words";
    EXPECT_EQ(code, 9);
    EXPECT_TRUE(Process::Create(program.c_str(), nullptr, "", &code));
    EXPECT_EQ(code, 9);
    EXPECT_TRUE(Process::Create(nullptr, nullptr, quoted(program).c_str(), &code));
    EXPECT_EQ(code, 9);
}

TEST_F(ProcessOfThisUser, takes_its_words_apart_itself) {
    std::string const file = scratch / "words";
    std::string const line =
        lineOf("words " + quoted(file) + " plain \"two words\" \"\" a\\b \"c\\\\\" \\\"d\\\" $HOME 'e f' g&h >i");
    int code = -1;
    ASSERT_TRUE(Process::Create(nullptr, nullptr, line.c_str(), &code));
    EXPECT_EQ(code, 0);
    EXPECT_EQ(textOf(file), "plain\ntwo words\n\na\\b\nc\\\n\"d\"\n$HOME\n'e\nf'\ng&h\n>i\n");
}

TEST_F(ProcessOfThisUser, Kept_process_01_runs_by_itself_and_leaves_no_exit_code) {
    std::string const file = scratch / "go";
    unsigned long id = 0;
    int code = 55;
    ASSERT_TRUE(Process::Create(nullptr, &id, lineOf("until " + quoted(file)).c_str(), &code));
    EXPECT_EQ(code, 0);
    EXPECT_NE(id, 0u);
    // It cannot end before the file is there, and then not before it has been seen.
    std::thread starter([&file] { put(file, "go"); });
    Process::Wait(id);
    starter.join();
}

TEST_F(ProcessOfThisUser, is_not_there) {
    std::string const missing = programBeside("no_such_program");
    struct Case {
        Row row;
        char const* application;
        std::string line;
    };
    for (Case const& c : {
             Case{{}, missing.c_str(), "x"},
             Case{{}, missing.c_str(), ""},
             Case{{}, nullptr, quoted(missing) + " x"},
             Case{{}, nullptr, "zb_no_such_program"},
             Case{{}, "", "x"},
             Case{{}, scratch.path().c_str(), "x"},
             Case{{}, nullptr, ""},
             Case{{}, nullptr, "  "},
             Case{{}, nullptr, "\"\""},
         }) {
        SCOPED_TRACE(c.row);
        unsigned long id = 12345;
        int code = 55;
        EXPECT_FALSE(Process::Create(c.application, &id, c.line.c_str(), &code));
        EXPECT_EQ(id, 12345u);
        EXPECT_EQ(code, 0);
        EXPECT_FALSE(Process::Create(c.application, nullptr, c.line.c_str(), nullptr));
    }
    int code = 55;
    EXPECT_FALSE(Process::Create(nullptr, nullptr, nullptr, &code));
    EXPECT_EQ(code, 0);
}

TEST_F(ProcessOfThisUser, is_not_found_under_an_identifier_that_there_is_not) {
    for (unsigned long const id : {0UL, 0x7FFFFFFEUL, 0xFFFFFFFFUL, ULONG_MAX}) {
        SCOPED_TRACE(id);
        EXPECT_FALSE(Process::Wait(id));
        EXPECT_FALSE(Process::Terminate(id));
    }
}

TEST_F(ProcessOfThisUser, leaves_nothing_open) {
    std::string const line = lineOf("exit 6");
    int code = 0;
    ASSERT_TRUE(Process::Create(nullptr, nullptr, line.c_str(), &code));
    std::size_t const before = openHandles();
    for (int i = 0; i < 30; ++i) {
        ASSERT_TRUE(Process::Create(nullptr, nullptr, line.c_str(), &code));
        ASSERT_EQ(code, 6);
    }
    EXPECT_EQ(openHandles(), before);
}

TEST_F(ProcessOfThisUser, is_awaited_by_many_threads_at_once) {
    std::vector<std::thread> threads;
    std::vector<int> codes(4, -1);
    for (std::size_t i = 0; i < codes.size(); ++i) {
        threads.emplace_back([this, &codes, i] {
            std::string const line = lineOf("exit " + std::to_string(i + 1));
            for (int round = 0; round < 5; ++round) Process::Create(nullptr, nullptr, line.c_str(), &codes[i]);
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(codes, (std::vector<int>{1, 2, 3, 4}));
}

/* Libraries */

TEST_F(ProcessOfThisUser, loads_libraries_and_finds_their_functions) {
    void* const library = Process::loadLib(LIBRARY);
    ASSERT_NE(library, nullptr);
    EXPECT_EQ(std::string(xos_HostLastCall("xos_LibraryLoad")), quoted(LIBRARY));
    EXPECT_EQ(Process::loadLib(LIBRARY), library);
    EXPECT_NE(Process::ptrFunc(FUNCTION, library), nullptr);
    EXPECT_EQ(Process::ptrFunc("zb_no_such_function", library), nullptr);
    EXPECT_EQ(Process::ptrFunc("", library), nullptr);
    EXPECT_EQ(Process::ptrFunc(nullptr, library), nullptr);
}

TEST_F(ProcessOfThisUser, finds_a_function_that_works) {
    void* const function = Process::ptrFunc(FUNCTION, Process::loadLib(LIBRARY));
    ASSERT_NE(function, nullptr);
    auto* const ownId = reinterpret_cast<unsigned (*)()>(function);
    EXPECT_NE(ownId(), 0u);
    EXPECT_EQ(ownId(), ownId());
}

TEST_F(ProcessOfThisUser, loads_no_library_that_is_not_there) {
    EXPECT_EQ(Process::loadLib("zb_no_such_library"), nullptr);
    EXPECT_EQ(Process::loadLib(""), nullptr);
    EXPECT_EQ(Process::loadLib(nullptr), nullptr);
    xos_HostFail("xos_LibraryLoad", 0, 1);
    EXPECT_EQ(Process::loadLib(LIBRARY), nullptr);
}

namespace {

int resolved = 0;
void* moduleAsked = &resolved;

void* resolver(void* module, char const* name) {
    moduleAsked = module;
    return name == nullptr || std::string(name) == "known" ? &resolved : nullptr;
}

} // namespace

TEST_F(ProcessOfThisUser, asks_the_platform_where_there_is_no_module) {
    EXPECT_EQ(Process::ptrFunc("known", nullptr), nullptr) << "without a resolver";
    xos_HostSetResolver(resolver);
    EXPECT_EQ(Process::ptrFunc("known", nullptr), &resolved);
    EXPECT_EQ(moduleAsked, nullptr);
    EXPECT_EQ(Process::ptrFunc("unknown", nullptr), nullptr);
    EXPECT_EQ(Process::ptrFunc(nullptr, nullptr), &resolved) << "the resolver's business";
    std::string const call = xos_HostLastCall("xos_BasicsParamLookup");
    EXPECT_EQ(call.substr(0, 12), "0xffff8006, ");
    EXPECT_EQ(call.substr(call.rfind(' ')), " 8");
    xos_HostFail("xos_BasicsParamLookup", 0, 1);
    EXPECT_EQ(Process::ptrFunc("known", nullptr), nullptr);
    EXPECT_EQ(Process::ptrFunc("known", nullptr), &resolved);
}
