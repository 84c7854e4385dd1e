#include "basis/timers/timer_mgr_impl.h"
#include "basis/timers/timer_mgr_mgr.h"

#include "tests/support/scratch_root.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// A registry is never destroyed, and neither is the list that holds them.
TimerMgrMgr& newRegistry() {
    static auto* const registries = new std::vector<TimerMgrMgr*>;
    return *registries->emplace_back(new TimerMgrMgr);
}

} // namespace

TEST(TimerMgrMgr, finds_the_first_manager_that_fits) {
    TimerMgrMgr& registry = newRegistry();
    TimerMgrImpl a("a", 0), b("b", 0), again("a", 0);
    auto const named = [&registry](char const* name) {
        return registry.find([name](TimerMgrImpl const& manager) { return manager.name() == name; });
    };
    EXPECT_EQ(named("a"), nullptr);
    for (TimerMgrImpl* manager : {&b, &a, &again}) registry.add(manager);
    EXPECT_EQ(named("a"), &a);
    EXPECT_EQ(named("b"), &b);
    EXPECT_EQ(named("c"), nullptr);
    EXPECT_EQ(registry.find([](TimerMgrImpl const&) { return true; }), &b);
}

TEST(TimerMgrMgr, keeps_the_first_rip_number_other_than_0) {
    TimerMgrMgr& registry = newRegistry();
    EXPECT_EQ(registry.rip(), 0);
    for (int rip : {0, -7, 9, 0}) registry.setRip(rip);
    EXPECT_EQ(registry.rip(), -7);
}

TEST(TimerMgrMgr, makes_its_folder_beneath_the_root) {
    std::filesystem::path const folder = scratchRoot() / "timer";
    std::filesystem::remove_all(folder);
    EXPECT_EQ(newRegistry().dir().c_str(), folder.generic_string());
    EXPECT_TRUE(std::filesystem::is_directory(folder));
    EXPECT_EQ(newRegistry().dir().c_str(), folder.generic_string()) << "one that exists counts as made";
}
