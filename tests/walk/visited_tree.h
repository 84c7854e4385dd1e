/// \file
/// A small tree for visitors, and an empty folder beside it.

#ifndef TESTS_WALK_VISITED_TREE_H
#define TESTS_WALK_VISITED_TREE_H

#include "tests/support/scratch.h"
#include "xos_host.h"

#include <zor_basis/walk.h>

#include <gtest/gtest.h>

struct VisitedTree : testing::Test {
    VisitedTree() {
        makeFolder(scratch / "src/d/e");
        makeFolder(scratch / "dst");
        put(scratch / "src/a", "aa");
        put(scratch / "src/d/b", "bbb");
        put(scratch / "src/d/e/c", "cccc");
    }
    ~VisitedTree() override { xos_HostFailClear(); }

    ZOR_Basis::FPath at(char const* name) const { return {(scratch / name).c_str()}; }
    bool walk(char const* from, ZOR_Basis::FileVisitor& visitor, ZOR_Basis::LookForType type = ZOR_Basis::LOOK_BOTH,
              bool stopOnFalse = true) const {
        return ZOR_Basis::FileIterator(at(from), type, nullptr, nullptr).doIt(&visitor, false, stopOnFalse);
    }
    ZOR_Basis::FileEntry entry(char const* dir, char const* name) const { return {at(dir), name, 0}; }

    Scratch scratch;
};

#endif
