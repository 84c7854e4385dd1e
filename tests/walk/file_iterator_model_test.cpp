// Walks over random trees against a plain model of the order.

#include <zor_basis/files/f_path.h>
#include <zor_basis/walk/file_iterator.h>

#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/walk/recorder.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

using Paths = std::vector<std::string>;

Paths names(std::string const& folder, LookForType kind) {
    Paths list;
    FileIterator it(folder.c_str(), kind, nullptr, nullptr);
    while (char const* name = it.next()) list.push_back(name);
    return list;
}

bool isReported(std::string const& path, LookForType type) {
    bool const folder = std::filesystem::is_directory(path);
    return type == LOOK_BOTH || folder == (type != LOOK_FILES);
}

/// First all of the folder's own entries, then each sub-directory as a whole.
void expect(std::string const& folder, LookForType type, char const* wildcard, bool deep, Paths& out) {
    for (std::string const& name : names(folder, LOOK_BOTH)) {
        std::string const path = folder + "/" + name;
        bool const fits = wildcard == nullptr || FPath::matchWildCard(wildcard, name.c_str());
        if (name != "__MACOS" && fits && isReported(path, type)) out.push_back(path);
    }
    if (!deep) return;
    for (std::string const& name : names(folder, LOOK_DIRS)) {
        if (name != "__MACOS") expect(folder + "/" + name, type, wildcard, deep, out);
    }
}

/// Fills a folder and, down to a depth, its sub-directories.
void grow(std::string const& folder, unsigned depth, std::mt19937_64& random) {
    constexpr char const* NAMES[] = {"a.txt", "b.dat", "c", "d.txt", "__MACOS", "e"};
    for (char const* name : NAMES) {
        std::string const path = folder + "/" + name;
        switch (random() % 3) {
        case 0:
            put(path, "x");
            break;
        case 1:
            std::filesystem::create_directory(path);
            if (depth != 0) grow(path, depth - 1, random);
            break;
        default:
            break;
        }
    }
}

} // namespace

TEST(FileIteratorModel, reports_random_trees_in_the_order_of_the_model) {
    std::mt19937_64 random = randomSource();
    std::uint64_t const trees = randomSteps(6);
    std::size_t seenAtAll = 0;
    for (std::uint64_t tree = 0; tree < trees; ++tree) {
        Scratch scratch;
        grow(scratch.path(), 2, random);
        for (LookForType const type : {LOOK_ALL, LOOK_FILES, LOOK_DIRS, LOOK_BOTH}) {
            for (char const* wildcard : {static_cast<char const*>(nullptr), "*.txt", "?"}) {
                for (bool const deep : {false, true}) {
                    Paths expected;
                    expect(scratch.path(), type, wildcard, deep, expected);
                    Recorder seen;
                    FileIterator it(scratch.path().c_str(), type, wildcard, nullptr);
                    EXPECT_TRUE(it.doIt(&seen, deep, true));
                    EXPECT_EQ(seen.paths, expected) << "tree " << tree << " type " << type << " deep " << deep;
                    seenAtAll += expected.size();

                    if (expected.empty()) continue;
                    std::size_t const most = random() % expected.size();
                    Recorder stopped;
                    stopped.most = most;
                    it.doIt(&stopped, deep, false);
                    EXPECT_EQ(stopped.paths,
                              Paths(expected.begin(), expected.begin() + static_cast<std::ptrdiff_t>(most)));
                }
            }
        }
    }
    EXPECT_GT(seenAtAll, 0u);
}
