#include "basis/platform/windows_api_win.h"
#include "tests/support/http_server.h"
#include "tests/support/wait_for.h"
#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>
#include <vector>

namespace fs = std::filesystem;

namespace {

constexpr DWORD_PTR CONSOLE_ATTRIBUTE = 0x20016; // which not all headers have

/// The program on a console of its own, on which the test can press Ctrl-C.
class ToolOnConsole {
public:
    ToolOnConsole(std::string const& folder, std::string const& arguments) {
        for (Pipe* const pipe : {&input_, &output_}) CreatePipe(&pipe->read, &pipe->write, nullptr, 0);
        if (!makeConsole() || !startOnConsole(folder, arguments))
            ADD_FAILURE() << "not started, error " << GetLastError();
        // Ctrl-C reaches all processes on a console, so the test visits it, and itself ignores it.
        FreeConsole();
        SetConsoleCtrlHandler(ignore, TRUE);
        waitFor([&] { return AttachConsole(process_.dwProcessId) != 0; });
    }
    ~ToolOnConsole() {
        FreeConsole();
        SetConsoleCtrlHandler(ignore, FALSE);
        if (console_ != nullptr) functionOf<void(WINAPI*)(void*)>("ClosePseudoConsole")(console_);
        for (HANDLE const handle :
             {process_.hThread, process_.hProcess, input_.read, input_.write, output_.read, output_.write}) {
            if (handle != nullptr) CloseHandle(handle);
        }
    }
    ToolOnConsole(ToolOnConsole const&) = delete;
    ToolOnConsole& operator=(ToolOnConsole const&) = delete;

    bool interrupt() const { return GenerateConsoleCtrlEvent(CTRL_C_EVENT, 0) != 0; }
    DWORD wait() const {
        DWORD code = 0;
        WaitForSingleObject(process_.hProcess, 60'000);
        GetExitCodeProcess(process_.hProcess, &code);
        return code;
    }

private:
    struct Pipe {
        HANDLE read = nullptr;
        HANDLE write = nullptr;
    };

    static BOOL WINAPI ignore(DWORD) { return TRUE; }

    template <class Function>
    static Function functionOf(char const* name) {
        return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(GetModuleHandleA("kernel32"), name)));
    }

    bool makeConsole() {
        using Make = HRESULT(WINAPI*)(COORD, HANDLE, HANDLE, DWORD, void**);
        auto const make = functionOf<Make>("CreatePseudoConsole");
        return make != nullptr && make(COORD{80, 25}, input_.read, output_.write, 0, &console_) == S_OK;
    }

    bool startOnConsole(std::string const& folder, std::string const& arguments) {
        SIZE_T size = 0;
        InitializeProcThreadAttributeList(nullptr, 1, 0, &size);
        std::vector<char> room(size);
        STARTUPINFOEXA startup{};
        startup.StartupInfo.cb = sizeof startup;
        startup.lpAttributeList = reinterpret_cast<LPPROC_THREAD_ATTRIBUTE_LIST>(room.data());
        std::string line = "\"" + programBeside("zbtool") + "\" " + arguments;
        return InitializeProcThreadAttributeList(startup.lpAttributeList, 1, 0, &size) &&
               UpdateProcThreadAttribute(startup.lpAttributeList, 0, CONSOLE_ATTRIBUTE, console_, sizeof console_,
                                         nullptr, nullptr) &&
               CreateProcessA(nullptr, line.data(), nullptr, nullptr, FALSE, EXTENDED_STARTUPINFO_PRESENT, nullptr,
                              folder.c_str(), &startup.StartupInfo, &process_);
    }

    Pipe input_;
    Pipe output_;
    void* console_ = nullptr;
    PROCESS_INFORMATION process_{};
};

TEST(InterruptionWin, stops_a_copy_between_two_files) {
    Tool tool;
    constexpr int FILES = 1'000;
    makeFolder(tool / "job");
    for (int i = 0; i < FILES; ++i) put(tool / ("job/" + std::to_string(i)), std::string(20'000, 'x'));
    makeFolder(tool / "spool/job"); // so that the files go one by one
    ToolOnConsole const child(tool.path(), "copy job spool");
    EXPECT_TRUE(waitFor([&] { return !fs::is_empty(tool / "spool/job"); }));
    EXPECT_TRUE(child.interrupt()) << GetLastError();
    EXPECT_EQ(child.wait(), static_cast<DWORD>(STATUS_CONTROL_C_EXIT));
    int files = 0;
    for (auto const& file : fs::directory_iterator(tool / "spool/job")) {
        EXPECT_EQ(file.file_size(), 20'000u) << file.path();
        ++files;
    }
    EXPECT_LT(files, FILES);
}

TEST(InterruptionWin, finishes_the_file_that_is_being_fetched) {
    Tool tool;
    std::string const whole = answer("200 OK", std::string(100'000, 'x'));
    std::atomic<bool> isInterrupted{false};
    HttpServer server({{"/slow", [&](Socket socket, HttpRequest const&) {
                            sendAll(socket, whole.data(), 60'000);
                            waitFor([&] { return isInterrupted.load(); });
                            sendAll(socket, whole.data() + 60'000, whole.size() - 60'000);
                        }}});
    ToolOnConsole const child(tool.path(), "url get " + server.url("/slow") + " page");
    EXPECT_TRUE(waitFor([&] { return tool.content().size() > 1; }));
    EXPECT_TRUE(child.interrupt()) << GetLastError();
    std::this_thread::sleep_for(std::chrono::milliseconds(500));
    isInterrupted = true;
    EXPECT_EQ(child.wait(), static_cast<DWORD>(STATUS_CONTROL_C_EXIT));
    EXPECT_EQ(tool.content(), Names{"page"});
    EXPECT_EQ(fs::file_size(tool / "page"), 100'000u);
}

} // namespace
