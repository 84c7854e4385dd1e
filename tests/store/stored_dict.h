/// \file
/// A dictionary with a file of its own, and what a plain reading finds in such a file.

#ifndef TESTS_STORE_STORED_DICT_H
#define TESTS_STORE_STORED_DICT_H

#include "tests/store/dict_files.h"
#include "tests/support/scratch.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>

/// A plain reading of a file: the complete records, as the list then has them.
inline Pairs plainReading(std::string const& bytes) {
    Pairs pairs;
    std::size_t at = 0;
    auto const next = [&](std::string& out) {
        std::uint32_t n = 0;
        if (bytes.size() - at < 4) return false;
        std::memcpy(&n, bytes.data() + at, 4);
        at += 4;
        if (bytes.size() - at < n) return false;
        out = bytes.substr(at, n);
        at += n;
        return true;
    };
    Pair pair;
    while (next(pair.first) && next(pair.second)) {
        auto const found =
            std::find_if(pairs.begin(), pairs.end(), [&](Pair const& known) { return known.first == pair.first; });
        if (found != pairs.end()) {
            found->second = pair.second;
        } else {
            pairs.insert(pairs.begin(), pair);
        }
    }
    return pairs;
}

/// How far a file is understood, read plainly.
inline std::size_t plainEnd(std::string const& bytes) {
    std::size_t end = 0;
    for (std::size_t at = 0, fields = 1;; ++fields) {
        std::uint32_t n = 0;
        if (bytes.size() - at < 4) return end;
        std::memcpy(&n, bytes.data() + at, 4);
        if (bytes.size() - at - 4 < n) return end;
        at += 4 + n;
        if (fields % 2 == 0) end = at;
    }
}

inline void expectFound(BlobDict const& dict, std::string const& bytes) {
    EXPECT_EQ(dict.understood(), plainEnd(bytes));
    EXPECT_EQ(dict.found(), plainEnd(bytes) == bytes.size() ? ZOR_Basis::DICT_WHOLE : ZOR_Basis::DICT_PART);
}

inline Pairs content(BlobDict& dict) {
    EXPECT_TRUE(dict.isConsistent());
    Pairs pairs;
    for (BlobEntry const& entry : dict) pairs.emplace_back(text(entry.key), text(entry.value));
    return pairs;
}

struct StoredDict : testing::Test {
    StoredDict() { xos_HostCallsReset(); }
    ~StoredDict() override { xos_HostFailClear(); }

    /// Whether `write` would write: it then opens the file.
    static bool needsSaving(BlobDict& dict) {
        std::uint64_t const opened = xos_HostCalls("xos_FileOpen");
        xos_HostFail("xos_FileOpen", 0, 1);
        dict.write();
        xos_HostFail("xos_FileOpen", 0, 0);
        return xos_HostCalls("xos_FileOpen") != opened;
    }

    Scratch scratch;
    std::string const path = scratch / "a dictionary";
};

#endif
