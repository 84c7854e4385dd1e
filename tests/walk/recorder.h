/// \file
/// A visitor that writes down what it is shown, and fails and stops where a test wants it to.

#ifndef TESTS_WALK_RECORDER_H
#define TESTS_WALK_RECORDER_H

#include <zor_basis/walk/file_visitor.h>

#include <cstddef>
#include <set>
#include <string>
#include <vector>

struct Recorder : ZOR_Basis::FileVisitor {
    bool perform(ZOR_Basis::FileEntry* entry) override {
        paths.push_back(entry->getFullPath().c_str());
        entries.push_back(*entry);
        return failing.count(entry->getName().c_str()) == 0;
    }
    bool stop() override { return paths.size() >= most; }

    /// The full paths below a folder, a "/" behind those of directories, in any order.
    std::multiset<std::string> below(std::string const& folder) const {
        std::multiset<std::string> names;
        for (ZOR_Basis::FileEntry const& entry : entries) {
            std::string const path = entry.getFullPath().c_str();
            names.insert(path.substr(folder.size() + 1) + (entry.isDir() ? "/" : ""));
        }
        return names;
    }

    std::vector<std::string> paths;
    std::vector<ZOR_Basis::FileEntry> entries;
    std::set<std::string> failing;
    std::size_t most = static_cast<std::size_t>(-1);
};

#endif
