// What `FStat` asks of the system and of the platform layer, with both replaced: clock, sleep, status and last error.

#include <zor_basis/files/f_stat.h>

#include "basis/files/system_calls.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <vector>

using namespace ZOR_Basis;

namespace {

/// A network whose entry is found at the n-th look, and whose failures have the given reasons.
struct Network {
    std::vector<std::uint32_t> reasons; // of each failed look; the last one goes on for ever
    std::uint64_t found = ~std::uint64_t{0};
    std::uint64_t msPerSleep = 1000;

    std::uint64_t looks = 0;
    std::uint64_t now = 5'000'000'000;
    std::vector<std::uint32_t> sleeps;
};

Network network;

bool look(char const*, xos_Stat& record) {
    if (++network.looks < network.found) return false;
    record.st_mode_ = MODE_FILE;
    record.st_size_ = 77;
    return true;
}

std::uint32_t reason() {
    std::uint64_t const index = network.looks - 1;
    return index < network.reasons.size() ? network.reasons[index] : network.reasons.back();
}

void rest(std::uint32_t ms) {
    network.sleeps.push_back(ms);
    network.now += network.msPerSleep;
}

std::uint64_t tick() { return network.now; }

struct FStatCalls : testing::Test {
    FStatCalls() { network = {}; }
    ~FStatCalls() override {
        systemCalls = real_;
        xos_HostFailClear();
    }

    static void replaceAll() {
        systemCalls.status = look;
        systemCalls.lastError = reason;
        systemCalls.sleep = rest;
        systemCalls.tick = tick;
    }

    SystemCalls const real_ = systemCalls;
};

std::vector<std::uint32_t> repeated(std::uint32_t reason, int times) {
    return std::vector<std::uint32_t>(static_cast<std::size_t>(times), reason);
}

std::vector<std::uint32_t> operator+(std::vector<std::uint32_t> a, std::vector<std::uint32_t> const& b) {
    a.insert(a.end(), b.begin(), b.end());
    return a;
}

} // namespace

TEST_F(FStatCalls, retry_transient_failures_as_often_as_each_reason_allows) {
    struct Case {
        Row row;
        std::vector<std::uint32_t> reasons;
        std::uint64_t looks;
    };
    for (Case const& c : {
             Case{{}, {0}, 1},
             Case{{}, {2}, 1},
             Case{{}, {3}, 1},
             Case{{}, {64}, 7},
             Case{{}, {1326}, 101},
             Case{{}, {5}, 6},
             Case{{}, {64, 2}, 2},
             Case{{}, {64, 64, 53}, 3},
             Case{{}, {5, 5, 5, 5, 5, 2}, 6},
             // Denials and logon failures give the tries for a lost network back.
             Case{{}, {5, 64}, 8},
             Case{{}, {5, 5, 5, 5, 5, 64}, 12},
             Case{{}, {1326, 1326, 64}, 9},
             Case{{}, repeated(64, 6) + repeated(5, 9), 12},
             Case{{}, repeated(1326, 100) + repeated(64, 1), 107},
         }) {
        SCOPED_TRACE(c.row);
        network = {};
        network.reasons = c.reasons;
        replaceAll();
        FStat entry;
        EXPECT_FALSE(entry.updateMultiRetryNetwork("//server/share/file", false));
        EXPECT_FALSE(entry.exist());
        EXPECT_EQ(network.looks, c.looks);
        EXPECT_EQ(network.sleeps, repeated(1000, static_cast<int>(c.looks) - 1));
    }
}

TEST_F(FStatCalls, retry_logon_failures_for_two_minutes_at_most) {
    struct Case {
        Row row;
        std::uint64_t msPerSleep;
        std::uint64_t looks;
    };
    for (Case const& c : {
             Case{{}, 60'000, 4}, // 0, 60,000 and 120,000 are within, 180,000 is not
             Case{{}, 60'001, 3}, Case{{}, 120'000, 3}, Case{{}, 120'001, 2}, Case{{}, 1200, 101},
             Case{{}, 1201, 101}, // the hundred and first failure comes first
         }) {
        SCOPED_TRACE(c.row);
        network = {};
        network.reasons = {1326};
        network.msPerSleep = c.msPerSleep;
        replaceAll();
        FStat entry;
        EXPECT_FALSE(entry.updateMultiRetryNetwork("x", false));
        EXPECT_EQ(network.looks, c.looks);
    }
}

TEST_F(FStatCalls, watch_the_clock_for_logon_failures_only) {
    network.reasons = {64};
    network.msPerSleep = 1'000'000;
    replaceAll();
    FStat entry;
    EXPECT_FALSE(entry.updateMultiRetryNetwork("x", false));
    EXPECT_EQ(network.looks, 7u);
}

TEST_F(FStatCalls, end_as_soon_as_the_entry_is_there) {
    for (std::uint64_t found : {1u, 2u, 5u}) {
        network = {};
        network.reasons = {64};
        network.found = found;
        replaceAll();
        FStat entry;
        EXPECT_TRUE(entry.updateMultiRetryNetwork("x", false));
        EXPECT_EQ(entry.size(), 77u);
        EXPECT_EQ(network.looks, found);
        EXPECT_EQ(network.sleeps.size(), found - 1);
    }
}

TEST_F(FStatCalls, ask_the_platform_layer_where_the_system_finds_nothing) {
    Scratch scratch;
    put(scratch / "f", "123456");
    std::string const path = scratch / "f";
    systemCalls.status = [](char const*, xos_Stat&) { return false; };
    xos_HostCallsReset();

    FStat entry;
    EXPECT_FALSE(entry.update(path.c_str(), false));
    EXPECT_EQ(xos_HostCalls("xos_FileStatByNameEx"), 0u);
    EXPECT_TRUE(entry.update(path.c_str()));
    EXPECT_EQ(entry.type(), FStat::ST_FILE);
    EXPECT_EQ(entry.size(), 6u);
    EXPECT_NE(entry.modified(), 0);
    std::string const last = xos_HostLastCall("xos_FileStatByNameEx");
    EXPECT_EQ(last.substr(0, path.size() + 4), "\"" + path + "\", ");
    EXPECT_EQ(last.substr(last.rfind(' ')), " 0x4000");
    EXPECT_TRUE(FStat(path.c_str()).isFile());
    EXPECT_FALSE(FStat(path.c_str(), false).exist());
    EXPECT_TRUE(FStat(scratch.path().c_str()).isDir());

    ASSERT_EQ(xos_HostFail("xos_FileStatByNameEx", 0, 1), 0);
    EXPECT_FALSE(entry.update(path.c_str(), true));
    EXPECT_FALSE(entry.exist());
    EXPECT_EQ(entry.size(), 0u);
    EXPECT_TRUE(entry.update(path.c_str(), true));
}

TEST_F(FStatCalls, spare_the_platform_layer_where_the_system_knows) {
    Scratch scratch;
    xos_HostCallsReset();
    EXPECT_TRUE(FStat::isDir(scratch.path().c_str()));
    std::basic_string<WChar> const missing(3, ZB_W('x'));
    EXPECT_FALSE(FStat(missing.c_str()).exist());
    EXPECT_EQ(xos_HostCalls("xos_FileStatByNameEx"), 0u);
}

TEST_F(FStatCalls, tell_the_kind_by_the_type_bits_of_the_mode) {
    struct Case {
        Row row;
        std::uint16_t mode;
        FStat::StatMode kind;
        FStat::StatMode wideKind;
    };
    static std::uint16_t mode;
    systemCalls.status = [](char const*, xos_Stat& record) {
        record = {1, 2, mode, 1, 0, 0, 0, 10, 20, 30, 40};
        return true;
    };
    systemCalls.statusWide = [](WChar const*, xos_Stat& record) {
        record = {1, 2, mode, 1, 0, 0, 0, 10, 20, 30, 40};
        return true;
    };
    for (Case const& c : {
             Case{{}, 0x81FF, FStat::ST_FILE, FStat::ST_FILE},
             Case{{}, 0x41FF, FStat::ST_DIR, FStat::ST_DIR},
             Case{{}, 0xA1FF, FStat::ST_LINK, FStat::ST_FILE},
             Case{{}, 0x6000, FStat::ST_OTHER, FStat::ST_FILE},
             Case{{}, 0x2000, FStat::ST_OTHER, FStat::ST_FILE},
             Case{{}, 0x1000, FStat::ST_OTHER, FStat::ST_FILE},
             Case{{}, 0xC000, FStat::ST_OTHER, FStat::ST_FILE},
             Case{{}, 0x0FFF, FStat::ST_OTHER, FStat::ST_FILE},
         }) {
        SCOPED_TRACE(c.row);
        mode = c.mode;
        FStat entry("x");
        EXPECT_EQ(entry.type(), c.kind);
        EXPECT_EQ(entry.size(), 10u);
        EXPECT_EQ(entry.accessed(), 20);
        EXPECT_EQ(entry.modified(), 30);
        EXPECT_EQ(entry.created(), 40);
        EXPECT_TRUE(entry.updateW(ZB_W("x")));
        EXPECT_EQ(entry.type(), c.wideKind);
        EXPECT_EQ(entry.size(), 10u);
        EXPECT_EQ(entry.accessed(), 20);
        EXPECT_EQ(entry.modified(), 30);
        EXPECT_EQ(entry.created(), 40);
    }
}

TEST_F(FStatCalls, Kept_stat_02_see_a_file_in_everything_wide_that_is_no_directory) {
    systemCalls.statusWide = [](WChar const*, xos_Stat& record) {
        record.st_mode_ = 0x6000;
        return true;
    };
    FStat const entry(ZB_W("/dev/disk"));
    EXPECT_TRUE(entry.isFile());
}
