#include "basis/timers/timer_slots.h"
#include "zor_basis/timers/pile_timer.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(TimerSlots, fills_a_slot_in_place_and_grows_for_one_beyond) {
    PileTimer a("a", false), b("b", false);
    TimerSlots slots(8);
    EXPECT_EQ(slots.find(0), nullptr);
    slots.put(&a, 5);
    EXPECT_EQ(slots.size(), 6u);
    for (std::uint64_t id : {0, 4, 6, 7, 100}) EXPECT_EQ(slots.find(id), nullptr) << id;
    EXPECT_EQ(slots.find(5), &a);
    slots.put(&b, 2);
    slots.put(&b, 5);
    EXPECT_EQ(slots.size(), 6u);
    EXPECT_EQ(slots.find(5), &b);
    EXPECT_EQ(slots.find(2), &b);
    slots.put(&a, 40);
    EXPECT_EQ(slots.find(40), &a);
    EXPECT_EQ(slots.find(5), &b);
}
