// process_child STEP...: a program for others to start. Without steps it exits with 9.
//   exit CODE        exits with this code
//   words FILE W...  writes the words W, a line each, into a file, which appears whole
//   until FILE       exits with 7 when there is such a file, with 8 when there is none for a minute

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <thread>

namespace fs = std::filesystem;

namespace {

void writeWords(std::string const& path, int count, char** words) {
    {
        std::ofstream file(path + ".part", std::ios::binary);
        for (int i = 0; i < count; ++i) file << words[i] << '\n';
    }
    fs::rename(path + ".part", path);
}

int waitFor(char const* path) {
    auto const end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
    while (std::chrono::steady_clock::now() < end) {
        if (fs::exists(path)) return 7;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return 8;
}

} // namespace

int main(int argc, char** argv) {
    if (argc == 1) return 9;
    if (argc < 3) return 2;
    if (std::strcmp(argv[1], "exit") == 0) return std::atoi(argv[2]);
    if (std::strcmp(argv[1], "until") == 0) return waitFor(argv[2]);
    if (std::strcmp(argv[1], "words") != 0) return 2;
    writeWords(argv[2], argc - 3, argv + 3);
    return 0;
}
