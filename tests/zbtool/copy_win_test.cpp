#include "basis/platform/windows_api_win.h"
#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

/// A file that no one else may open, for a scope.
class ClosedFile {
public:
    explicit ClosedFile(std::string const& path)
        : handle_(CreateFileA(path.c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr)) {}
    ~ClosedFile() { CloseHandle(handle_); }
    ClosedFile(ClosedFile const&) = delete;
    ClosedFile& operator=(ClosedFile const&) = delete;

private:
    HANDLE handle_;
};

TEST(CopyWin, tells_what_it_may_not_touch) {
    Tool tool;
    makeFolder(tool / "job");
    put(tool / "job/file", "text");
    put(tool / "job/other", "text");
    ClosedFile const closed(tool / "job/file");
    struct Case {
        std::vector<std::string> arguments;
        char const* about;
    };
    Case const cases[] = {
        {{"copy", "job", "copy"}, "'job/file'"},
        {{"move", "job/file", "new"}, "'job/file'"},
        {{"timers", "job/file"}, "job/file"},
        {{"dict", "job/file", "list"}, "job/file"},
        {{"dict", "job/file", "set", "a", "b"}, "job/file"},
        {{"crypt", "encrypt", "job/file", "new", "--secret-file", "job/other"}, "job/file"},
        {{"url", "get", "file:///" + tool.path() + "/job/file", "new"}, "new"},
        {{"delete", "--yes", "job"}, "job/file"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.arguments[0]);
        ToolResult const result = tool.run(c.arguments);
        EXPECT_EQ(result.code, 1);
        EXPECT_TRUE(isOneLineAbout(result.errors, c.about));
        EXPECT_TRUE(exists(tool / "job/file"));
        EXPECT_FALSE(exists(tool / "new"));
    }
    EXPECT_FALSE(exists(tool / "job/other")) << "what is free is deleted";
}

} // namespace
