// Feeds the committed inputs to their targets, once each. Fails if a target has none.

#include "fuzz/target.h"

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace {

int replay(FuzzTarget const& target, std::filesystem::path const& folder) {
    int replayed = 0;
    std::error_code missing;
    for (auto const& entry : std::filesystem::directory_iterator(folder, missing)) {
        std::ifstream file(entry.path(), std::ios::binary);
        std::string const bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
        // Seen only if it aborts.
        std::printf("%s: %s", target.name, entry.path().filename().string().c_str());
        std::fflush(stdout);
        target.run(reinterpret_cast<unsigned char const*>(bytes.data()), bytes.size());
        std::printf("\n");
        ++replayed;
    }
    std::printf("%s: %d inputs replayed\n", target.name, replayed);
    return replayed;
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) return 2;
    bool isComplete = !FuzzTarget::all().empty();
    for (FuzzTarget const* target : FuzzTarget::all()) {
        isComplete = replay(*target, std::filesystem::path(argv[1]) / target->name) > 0 && isComplete;
    }
    return isComplete ? 0 : 1;
}
