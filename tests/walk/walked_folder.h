/// \file
/// A folder to walk, and what the platform layer was asked for on the way.

#ifndef TESTS_WALK_WALKED_FOLDER_H
#define TESTS_WALK_WALKED_FOLDER_H

#include "tests/support/scratch.h"
#include "tests/walk/recorder.h"
#include "xos_host.h"

#include <zor_basis/walk/file_iterator.h>

#include <gtest/gtest.h>

#include <set>
#include <string>

using Found = std::multiset<std::string>;

struct WalkedFolder : testing::Test {
    WalkedFolder() { xos_HostCallsReset(); }
    ~WalkedFolder() override { xos_HostFailClear(); }

    void fill() {
        makeFolder(scratch / "d/e");
        put(scratch / "a.txt", "12345");
        put(scratch / "b.dat", "");
        put(scratch / "d/c.txt", "c");
        put(scratch / "d/e/f.TXT", "f");
    }

    Found walked(ZOR_Basis::LookForType type, char const* wildcard, bool deep,
                 ZOR_Basis::FileCondition* condition = nullptr) const {
        Recorder seen;
        ZOR_Basis::FileIterator it(scratch.path().c_str(), type, wildcard, condition);
        EXPECT_TRUE(it.doIt(&seen, deep, false));
        return seen.below(scratch.path());
    }

    static Found listed(ZOR_Basis::FileIterator& it) {
        Found names;
        while (char const* name = it.next()) names.insert(name);
        return names;
    }

    /// The last call of a function, without the scratch folder's path.
    std::string last(char const* function) const {
        char const* const call = xos_HostLastCall(function);
        std::string text = call != nullptr ? call : "none";
        std::size_t const own = text.find(scratch.path());
        return own != std::string::npos ? text.replace(own, scratch.path().size(), "*") : text;
    }

    static void expectAllClosed() { EXPECT_EQ(xos_HostCalls("xos_DirOpenEx"), xos_HostCalls("xos_DirClose")); }

    Scratch scratch;
};

/// Accepts names and entries that contain a letter.
struct OnlyWith : ZOR_Basis::FileCondition {
    explicit OnlyWith(char letter) : letter_(letter) {}
    bool acceptName(ZOR_Basis::FileIterator* it, char const* name) override {
        asked = it;
        return std::string(name).find(letter_) != std::string::npos;
    }
    bool acceptEntry(ZOR_Basis::FileEntry* entry) override {
        return std::string(entry->getName().c_str()).find(letter_) != std::string::npos;
    }
    ZOR_Basis::FileIterator* asked = nullptr;

private:
    char letter_;
};

#endif
