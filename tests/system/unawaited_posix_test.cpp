#include "basis/system/unawaited_posix.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Children up to this one have ended; those that were given up.
pid_t lastEnded = 0;
std::vector<pid_t> givenUp;

bool giveUp(pid_t child) {
    if (child > lastEnded) return false;
    givenUp.push_back(child);
    return true;
}

using Children = Unawaited<8, giveUp>;
using Ids = std::vector<pid_t>;

struct UnawaitedPosix : testing::Test {
    UnawaitedPosix() {
        lastEnded = 0;
        givenUp.clear();
    }
    void add(pid_t first, pid_t last) {
        for (pid_t child = first; child <= last; ++child) children.add(child);
    }
    Children children;
};

} // namespace

TEST_F(UnawaitedPosix, are_kept_while_there_is_room) {
    lastEnded = 100;
    add(1, 8);
    EXPECT_EQ(givenUp, Ids{});
}

TEST_F(UnawaitedPosix, are_given_up_by_the_older_half) {
    lastEnded = 100;
    add(1, 9);
    EXPECT_EQ(givenUp, (Ids{1, 2, 3, 4}));
    add(10, 13);
    EXPECT_EQ(givenUp, (Ids{1, 2, 3, 4, 5, 6, 7, 8}));
}

TEST_F(UnawaitedPosix, are_kept_while_they_run) {
    lastEnded = 2;
    add(1, 9);
    EXPECT_EQ(givenUp, (Ids{1, 2}));
    lastEnded = 100;
    add(10, 11);
    EXPECT_EQ(givenUp, (Ids{1, 2, 3, 4, 5, 6}));
}

TEST_F(UnawaitedPosix, are_not_remembered_where_all_run) {
    add(1, 20);
    EXPECT_EQ(givenUp, Ids{});
    lastEnded = 100;
    add(21, 21);
    EXPECT_EQ(givenUp, (Ids{1, 2, 3, 4}));
    add(22, 25);
    EXPECT_EQ(givenUp, (Ids{1, 2, 3, 4, 5, 6, 7, 8})) << "and never 9 to 20";
}

TEST_F(UnawaitedPosix, are_the_callers_again) {
    lastEnded = 100;
    add(1, 8);
    for (pid_t const child : {1, 3, 8, 77}) children.remove(child);
    add(9, 11);
    EXPECT_EQ(givenUp, Ids{}) << "room for three";
    add(12, 12);
    EXPECT_EQ(givenUp, (Ids{2, 4, 5, 6}));
}
