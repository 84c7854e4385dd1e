#include "bench/support/tree.h"

#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <random>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace fs = std::filesystem;

namespace {

constexpr std::size_t LARGEST = 16 * 1024;

std::string makeTree(std::string const& path) {
    std::mt19937 random{7};
    std::vector<std::string> folders{path};
    fs::create_directory(path);
    for (int i = 1; i < SOURCE_FOLDERS; ++i) {
        folders.push_back(folders[static_cast<std::size_t>((i - 1) / 8)] + "/folder-" + std::to_string(i));
        fs::create_directory(folders.back());
    }
    std::string const content(LARGEST, 'x');
    for (int i = 0; i < SOURCE_FILES; ++i) {
        std::ofstream{folders[static_cast<std::size_t>(i % SOURCE_FOLDERS)] + "/document-" + std::to_string(i) + ".txt"}
            .write(content.data(), static_cast<std::streamsize>(random() % (LARGEST + 1)));
    }
    return path;
}

} // namespace

Workplace::Workplace() {
    fs::path const base = fs::exists("/dev/shm") ? fs::path{"/dev/shm"} : fs::temp_directory_path();
    path_ = (base / ("zb-bench-" + std::to_string(::getpid()))).string();
    fs::create_directory(path_);
}

Workplace::~Workplace() {
    std::error_code ignored;
    fs::remove_all(path_, ignored);
}

Workplace const& workplace() {
    static Workplace const place;
    return place;
}

std::string const& sourceTree() {
    static std::string const top = makeTree(workplace() / "tree");
    return top;
}

bool run(std::initializer_list<char const*> command) {
    std::vector<char*> arguments;
    for (char const* word : command) { arguments.push_back(const_cast<char*>(word)); }
    arguments.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    for (int stream : {STDOUT_FILENO, STDERR_FILENO})
        ::posix_spawn_file_actions_addopen(&actions, stream, "/dev/null", O_WRONLY, 0);
    pid_t child = 0;
    int status = -1;
    bool const good = ::posix_spawnp(&child, arguments[0], &actions, nullptr, arguments.data(), environ) == 0 &&
                      ::waitpid(child, &status, 0) == child && status == 0;
    ::posix_spawn_file_actions_destroy(&actions);
    return good;
}
