#include "basis/timers/report_file.h"
#include "basis/timers/timer_mgr_impl.h"
#include "basis/timers/timer_mgr_mgr.h"
#include "zor_basis/timers.h"

#include <xos_host.h>

#include "tests/support/scratch_root.h"
#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"
#include "tests/timers/report_model.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>
#include <thread>

namespace fs = std::filesystem;
using namespace ZOR_Basis;
using namespace std::string_literals;

namespace {

std::int64_t secondsToTell = 0;

class ReportFileInFolder : public testing::Test {
protected:
    ReportFileInFolder() {
        secondsToTell = 1'700'000'000;
        reportTime = [] { return secondsToTell; };
    }
    ~ReportFileInFolder() override {
        xos_HostFailClear();
        reportTime = original_;
        for (auto const& entry : fs::directory_iterator(folder())) fs::remove(entry);
    }

    /// The registry makes it.
    static fs::path folder() {
        TimerMgr::Mgr();
        return scratchRoot() / "timer";
    }
    static std::string content(std::string const& name) {
        std::ifstream file(folder() / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    static std::size_t files() {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(folder()), fs::directory_iterator()));
    }
    static void pileMicroseconds(PileTimer* timer, std::int64_t elapsed, std::int64_t suspended = 0) {
        std::int64_t const tick = OpenedPile::frequency() / 1'000'000;
        pileUp(*timer, elapsed * tick, suspended * tick);
    }

private:
    std::int64_t (*const original_)() = reportTime;
};

constexpr char HEAD[] =
    "Log timestamp (sec): 1700000000\n"
    "Timers (mksec):\n"
    "Function                                Count     Total          Average        Maximum        "
    "Maximum count  Minimum        Suspend total  Suspend Max    Notes                   \n";

} // namespace

TEST_F(ReportFileInFolder, is_written_byte_for_byte) {
    TimerMgrImpl manager("render", 2);
    PileTimer* const page = manager.createTimer("render page", 1, false);
    manager.createTimer("a stage that never ran", 0, true);
    PileTimer* const overlong = manager.createTimer("a name of more than forty bytes, which runs over", 0, false);
    for (std::int64_t elapsed : {5, 9, 9, 3}) pileMicroseconds(page, elapsed * 1000, elapsed == 3 ? 1234 : 0);
    pileMicroseconds(overlong, 1'234'567'890, 20);
    manager.setActive(true);
    manager.reset(true);
    std::string const expected =
        HEAD +
        "render page                                     4         26,000          6,500          9,000              2"
        "          3,000          1,234          1,234\0 \n"s +
        "a stage that never ran                          0                                                             "
        "                                              \n" +
        "a name of more than forty bytes, which runs over1  1,234,567,890  1,234,567,890  1,234,567,890              1"
        "  1,234,567,890             20             20\0 \n"s;
    EXPECT_EQ(content("1700000000_render_0.timer"), expected);
    EXPECT_EQ(files(), 1u);
}

TEST_F(ReportFileInFolder, starts_all_timers_afresh) {
    TimerMgrImpl manager("afresh", 0);
    manager.setActive(true);
    PileTimer* const timer = manager.createTimer("timer", 0, false);
    pileMicroseconds(timer, 5);
    manager.reset(true);
    secondsToTell += 1;
    manager.reset(true);
    EXPECT_NE(content("1700000000_afresh_0.timer").find(modelRow("timer", measuredOnce(5), ',')), std::string::npos);
    EXPECT_NE(content("1700000001_afresh_0.timer").find(modelRow("timer", {}, ',') + "\n"), std::string::npos);
    EXPECT_EQ(timer->id(), 0u);
    EXPECT_STREQ(timer->cname(), "timer");
}

TEST_F(ReportFileInFolder, is_not_written_without_print_or_by_an_inactive_manager) {
    TimerMgrImpl manager("silent", 0);
    manager.createTimer("timer", 0, false);
    manager.reset(true);
    manager.setActive(true);
    manager.reset(false);
    EXPECT_EQ(files(), 0u);
}

TEST_F(ReportFileInFolder, has_a_head_alone_without_timers) {
    TimerMgrImpl(nullptr, 9).resetTimers(true);
    EXPECT_EQ(content("1700000000__0.timer"), HEAD);
}

TEST_F(ReportFileInFolder, has_rows_by_id_whatever_the_order_of_making) {
    TimerMgrImpl manager("order", 30);
    for (int id : {20, 3, 11, 30, 1}) manager.createTimer(("t" + std::to_string(id)).c_str(), id, false);
    manager.resetTimers(true);
    std::string expected = HEAD;
    for (int id : {1, 3, 11, 20, 30}) expected += modelRow("t" + std::to_string(id), {}, ',') + "\n";
    EXPECT_EQ(content("1700000000_order_0.timer"), expected);
}

TEST_F(ReportFileInFolder, tells_seconds_as_a_signed_32_bit_number) {
    secondsToTell = 0x80000001;
    TimerMgrImpl("late", 0).resetTimers(true);
    EXPECT_EQ(content("-2147483647_late_0.timer").substr(0, 33), "Log timestamp (sec): -2147483647\n");
}

TEST_F(ReportFileInFolder, is_opened_for_appending_and_written_row_by_row) {
    TimerMgrImpl manager("calls", 0);
    for (int i = 0; i < 3; ++i) manager.createTimer("timer", 0, false);
    xos_HostCallsReset();
    manager.resetTimers(true);
    std::string const path = (folder() / "1700000000_calls_0.timer").generic_string();
    EXPECT_EQ(xos_HostLastCall("xos_FileOpen"), "\"" + path + "\", 0x400001c");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_FileWriteEx"), 4u) << "one for the head and one a row";
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 1u);
}

TEST_F(ReportFileInFolder, Kept_timers_08_of_the_same_second_is_appended) {
    TimerMgrImpl manager("again", 0);
    PileTimer* const timer = manager.createTimer("timer", 0, false);
    pileMicroseconds(timer, 5);
    manager.resetTimers(true);
    manager.resetTimers(true);
    EXPECT_EQ(content("1700000000_again_0.timer"),
              HEAD + modelRow("timer", measuredOnce(5), ',') + "\n" + HEAD + modelRow("timer", {}, ',') + "\n");
}

TEST_F(ReportFileInFolder, Kept_timers_10_resets_also_where_nothing_can_be_written) {
    for (char const* function : {"xos_FileOpen", "xos_FileWriteEx", "xos_FileCloseEx", "xos_SemTake"}) {
        SCOPED_TRACE(function);
        TimerMgrImpl manager("fails", 0);
        OpenedPile const clean("timer", true);
        PileTimer* const timer = manager.createTimer("timer", 0, false);
        pileMicroseconds(timer, 5);
        xos_HostFail(function, 0, 100);
        manager.resetTimers(true);
        xos_HostFailClear();
        BufStr<255> line, untouched;
        timer->print(line, 1);
        clean.print(untouched, 1);
        EXPECT_EQ(line, untouched);
        pileMicroseconds(timer, 7);
        secondsToTell += 1;
        manager.resetTimers(true);
        EXPECT_EQ(content(std::to_string(secondsToTell) + "_fails_0.timer").substr(sizeof HEAD - 1),
                  modelRow("timer", measuredOnce(7), ',') + "\n");
    }
}

TEST_F(ReportFileInFolder, makes_its_folder_again_where_it_was_removed) {
    Assertions heard;
    TimerMgrImpl manager("again", 0);
    fs::remove_all(folder());
    manager.resetTimers(true);
    EXPECT_EQ(content("1700000000_again_0.timer"), HEAD);
    EXPECT_EQ(heard.take(), "");
    xos_HostCallsReset();
    manager.resetTimers(true);
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 0u) << "an existing folder is not made again";
    fs::remove_all(folder());
    manager.resetTimers(false);
    EXPECT_FALSE(fs::exists(folder())) << "only for a report";
    fs::create_directories(folder());
}

TEST_F(ReportFileInFolder, tells_that_it_cannot_be_opened) {
    Assertions heard;
    TimerMgrImpl manager("lost", 0);
    PileTimer* const timer = manager.createTimer("timer", 0, false);
    pileMicroseconds(timer, 5);
    std::string const message = "zor_basis TimerMgr::reset() - cannot open the report " +
                                (folder() / "1700000000_lost_0.timer").generic_string();
    auto const expectTold = [&](char const* how) {
        manager.resetTimers(true);
        std::string const told = heard.take();
        EXPECT_EQ(told.substr(told.find(' ') + 1), message + ";") << how;
    };
    xos_HostFail("xos_FileOpen", 0, 1);
    xos_HostCallsReset();
    expectTold("a file that cannot be opened");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 1u) << "it is not tried again";
    EXPECT_NE(content("1700000000_lost_0.timer").find("Log"), 0u);
    fs::remove_all(folder());
    xos_HostFail("xos_DirCreateEx", 0, 1);
    expectTold("a folder that cannot be made");
    std::ofstream(folder()) << "no folder";
    expectTold("a file in the folder's place");
    fs::remove(folder());
    fs::create_directories(folder());
    manager.resetTimers(true);
    EXPECT_EQ(heard.take(), "");
    EXPECT_EQ(content("1700000000_lost_0.timer"), HEAD + modelRow("timer", {}, ',') + "\n") << "the timers were reset";
}

TEST_F(ReportFileInFolder, lacks_just_the_row_whose_write_fails) {
    for (std::uint32_t skip : {0u, 1u, 2u}) {
        secondsToTell += 1;
        TimerMgrImpl manager("part", 0);
        for (char const* name : {"a", "b"}) manager.createTimer(name, 0, false);
        xos_HostFail("xos_FileWriteEx", skip, 1);
        manager.resetTimers(true);
        std::string head = HEAD;
        head.replace(head.find("1700000000"), 10, std::to_string(secondsToTell));
        std::string expected;
        if (skip != 0) expected += head;
        if (skip != 1) expected += modelRow("a", {}, ',') + "\n";
        if (skip != 2) expected += modelRow("b", {}, ',') + "\n";
        EXPECT_EQ(content(std::to_string(secondsToTell) + "_part_0.timer"), expected);
    }
}

TEST_F(ReportFileInFolder, may_be_written_while_threads_pile) {
    TimerMgrImpl manager("busy", 3);
    PileTimer* const timer = manager.createTimer("timer", 1, true);
    manager.setActive(true);
    std::thread worker([timer, &manager] {
        for (int i = 0; i < 2000; ++i) BaseTimerAuto const scope(timer, &manager, true, false);
    });
    for (int i = 0; i < 20; ++i) manager.reset(true);
    manager.setActive(false);
    worker.join();
    EXPECT_EQ(content("1700000000_busy_0.timer").size(), 20 * (sizeof HEAD - 1 + 157));
}

TEST(ReportTime, is_that_of_the_system) {
    std::int64_t const before = std::time(nullptr);
    std::int64_t const told = reportTime();
    EXPECT_GE(told, before);
    EXPECT_LE(told, std::time(nullptr));
}
