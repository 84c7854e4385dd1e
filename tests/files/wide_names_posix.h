/// \file
/// Names of the file system as wide text, and the names that a folder holds.

#ifndef TESTS_FILES_WIDE_NAMES_POSIX_H
#define TESTS_FILES_WIDE_NAMES_POSIX_H

#include "basis/files/os_path_posix.h"

#include <zor_basis/files.h>

#include <gtest/gtest.h>

#include <set>
#include <string>

using WideText = std::basic_string<ZOR_Basis::WChar>;

inline WideText wideOf(std::string const& name) {
    ZOR_Basis::WBStr wide;
    ZOR_Basis::wideName(name.c_str(), wide);
    return {wide.wstr(), wide.size()};
}
inline std::string narrowOf(WideText const& name) {
    ZOR_Basis::BufStr<255> narrow;
    ZOR_Basis::narrowName(name.c_str(), narrow);
    return {narrow.c_str(), narrow.size()};
}

inline std::set<WideText> namesIn(std::string const& folder, ZOR_Basis::LookForType type = ZOR_Basis::LOOK_ALL) {
    std::set<WideText> names;
    ZOR_Basis::DirIteratorW list(type, wideOf(folder).c_str());
    while (ZOR_Basis::WChar const* name = list->next()) names.insert(name);
    EXPECT_EQ(list->lastError(), 18u);
    return names;
}

#endif
