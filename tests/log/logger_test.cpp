#include "tests/host/support/system_error.h"
#include "tests/log/driven_logger.h"
#include "tests/support/table.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>

using namespace ZOR_Basis;
using testing::ElementsAre;
using testing::StartsWith;

namespace {

using LoggerTest = DrivenLoggers;

constexpr std::size_t BLOCK = LoggerImpl::BLOCK_SIZE;

std::string lineOf(std::size_t sizeWithEnd, char c = 'x') { return std::string(sizeWithEnd - 1, c); }

} // namespace

TEST_F(LoggerTest, breathes) {
    LoggerImpl& logger = start();
    write(logger, "first");
    write(logger, "second");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "first\nsecond\n");
    EXPECT_THAT(opened, ElementsAre("a " + file(0)));
}

TEST_F(LoggerTest, makes_its_folder_at_the_start_with_all_parents) {
    std::filesystem::remove_all(scratchRoot() / "tmp");
    start();
    EXPECT_TRUE(std::filesystem::is_directory(folder() + "/" + name()));
    EXPECT_TRUE(std::filesystem::is_empty(folder() + "/" + name()));
    start("a/b c/d");
    EXPECT_TRUE(std::filesystem::is_directory(folder() + "/a/b c/d"));
    EXPECT_THAT(opened, ElementsAre()) << "no file";
}

TEST_F(LoggerTest, registers_an_alert_of_8192_ms_that_asks_for_as_many_again) {
    LoggerImpl const& logger = start();
    std::string const call = xos_HostLastCall("HQ_Basis::AlertTimer::New");
    EXPECT_THAT(call, StartsWith("8192, 0x"));
    std::size_t const second = call.find(", ");
    std::size_t const third = call.rfind(", ");
    auto const callback = reinterpret_cast<HQ_Basis::AlertTimer::Callback>(
        static_cast<std::uintptr_t>(std::strtoull(call.c_str() + second + 2, nullptr, 16)));
    auto* const context =
        reinterpret_cast<void*>(static_cast<std::uintptr_t>(std::strtoull(call.c_str() + third + 2, nullptr, 16)));
    EXPECT_EQ(context, &logger);
    EXPECT_EQ(callback({logger.alertId(), context}), 8192u);
}

TEST_F(LoggerTest, touches_no_file_while_lines_come) {
    LoggerImpl& logger = start();
    for (int i = 0; i < 10'000; ++i) write(logger, "a line of the log");
    EXPECT_THAT(opened, ElementsAre());
    EXPECT_FALSE(exists(file(0)));
}

TEST_F(LoggerTest, writes_a_block_that_is_being_filled_after_a_period_of_silence) {
    struct Case {
        Row row;
        std::uint32_t start, passed;
        bool isWritten;
    };
    for (Case const& c : {
             Case{{}, 1000, 0, false},
             Case{{}, 1000, 8191, false},
             Case{{}, 1000, 8192, true},
             Case{{}, 1000, 100'000, true},
             Case{{}, 0xFFFF'FF00, 8191, false}, // the count wraps
             Case{{}, 0xFFFF'FF00, 8192, true},
             Case{{}, 0x7FFF'FFF0, 8191, false},
             Case{{}, 0x7FFF'FFF0, 8192, true},
             Case{{}, 5, 0xFFFF'FFFF, true},
         }) {
        SCOPED_TRACE(c.row);
        std::filesystem::remove(file(0));
        LoggerImpl& logger = start();
        handClock = c.start;
        write(logger, "line");
        tickAfter(c.passed, logger);
        EXPECT_EQ(content(0), c.isWritten ? "line\n" : "");
        EXPECT_EQ(exists(file(0)), c.isWritten);
    }
}

TEST_F(LoggerTest, counts_silence_from_the_last_line) {
    LoggerImpl& logger = start();
    for (int i = 0; i < 5; ++i) {
        write(logger, "line");
        tickAfter(PERIOD - 1, logger);
        EXPECT_EQ(content(0), "");
    }
    tickAfter(1, logger);
    EXPECT_EQ(content(0), "line\nline\nline\nline\nline\n");
}

TEST_F(LoggerTest, counts_silence_from_the_last_write_too) {
    LoggerImpl& logger = start();
    std::string const first = lineOf(BLOCK, 'a');
    write(logger, first); // fills a block: the next begins
    write(logger, "tail");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), first + "\n") << "writing the full block was no silence";
    tickAfter(PERIOD - 1, logger);
    EXPECT_EQ(content(0), first + "\n");
    tickAfter(1, logger);
    EXPECT_EQ(content(0), first + "\ntail\n");
}

TEST_F(LoggerTest, begins_a_block_when_the_line_fills_or_passes_the_room) {
    struct Case {
        Row row;
        std::size_t before, line;
        /// What of it is in the file at once, without silence: the full block alone.
        std::size_t writtenAtOnce;
    };
    for (Case const& c : {
             Case{{}, BLOCK - 100, 98, 0},
             Case{{}, BLOCK - 100, 99, 0},
             Case{{}, BLOCK - 100, 100, BLOCK},
             Case{{}, BLOCK - 100, 101, BLOCK},
             Case{{}, BLOCK - 1, 1, BLOCK},
             Case{{}, BLOCK - 1, 2, BLOCK},
             Case{{}, BLOCK - 1, 1023, BLOCK},
             Case{{}, BLOCK - 1023, 1023, BLOCK},
             Case{{}, BLOCK - 1023, 1022, 0},
         }) {
        SCOPED_TRACE(c.row);
        std::filesystem::remove(file(0));
        opened.clear();
        LoggerImpl& logger = start();
        std::string const all = lineOf(c.before, 'a') + "\n" + lineOf(c.line, 'b') + "\n";
        write(logger, lineOf(c.before, 'a'));
        write(logger, lineOf(c.line, 'b'));
        tick(logger);
        EXPECT_EQ(content(0), all.substr(0, c.writtenAtOnce));
        tickAfter(PERIOD, logger);
        EXPECT_EQ(content(0), all);
        EXPECT_EQ(opened.size(), c.writtenAtOnce == 0 ? 1u : 2u) << "the second block, even an empty one";
    }
}

TEST_F(LoggerTest, opens_the_file_once_a_block) {
    LoggerImpl& logger = start();
    std::string all;
    for (int i = 0; i < 1000; ++i) {
        std::string const line = "line number " + std::to_string(i);
        write(logger, line);
        all += line + "\n";
    }
    tick(logger);
    EXPECT_EQ(opened.size(), all.size() / BLOCK);
    EXPECT_EQ(content(0), all.substr(0, all.size() / BLOCK * BLOCK));
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), all);
}

TEST_F(LoggerTest, has_a_file_for_each_session) {
    LoggerImpl& logger = start();
    write(logger, "before");
    logger.newSession();
    write(logger, "after");
    tick(logger);
    EXPECT_EQ(content(0), "before\n") << "an earlier session waits for no silence";
    EXPECT_FALSE(exists(file(1)));
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "before\n");
    EXPECT_EQ(content(1), "after\n");
    for (int session = 2; session <= 12; ++session) {
        logger.newSession();
        write(logger, std::to_string(session));
    }
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(11), "11\n");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(12), "12\n");
}

TEST_F(LoggerTest, Kept_log_02_a_session_without_a_line_has_an_empty_file_unless_it_is_the_first) {
    LoggerImpl& logger = start();
    tickAfter(PERIOD, logger);
    logger.newSession();
    logger.newSession();
    write(logger, "second");
    logger.newSession();
    tick(logger);
    tickAfter(PERIOD, logger);
    EXPECT_FALSE(exists(file(0)));
    EXPECT_TRUE(exists(file(1)));
    EXPECT_EQ(content(1), "");
    EXPECT_EQ(content(2), "second\n");
    EXPECT_TRUE(exists(file(3)));
    EXPECT_EQ(content(3), "");
}

TEST_F(LoggerTest, opens_the_file_of_an_idle_log_again_each_period) {
    LoggerImpl& logger = start();
    write(logger, "line");
    tickAfter(PERIOD, logger);
    tick(logger);
    EXPECT_EQ(opened.size(), 1u) << "once a tick, as the write ended the silence";
    std::filesystem::rename(file(0), file(77));
    tickAfter(PERIOD, logger);
    EXPECT_EQ(opened.size(), 2u);
    EXPECT_TRUE(exists(file(0)));
    EXPECT_EQ(content(0), "");
    write(logger, "next");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "next\n");
    EXPECT_EQ(content(77), "line\n") << "not written again";
}

TEST_F(LoggerTest, appends_to_what_is_there) {
    LoggerImpl& logger = start();
    put(file(0), "old\n");
    write(logger, "new");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "old\nnew\n");
}

TEST_F(LoggerTest, loses_no_line_that_comes_while_it_writes) {
    LoggerImpl& logger = start();
    std::string all = "first\n";
    write(logger, "first");
    int left = 0;
    // The block becomes full and then another is current, while it is being written.
    whileOpening = [&] {
        for (; left > 0; --left) {
            std::string const line = "line " + std::to_string(left);
            write(logger, line);
            all += line + "\n";
        }
    };
    for (int lines : {1, 1000, 10, 2000}) {
        left = lines;
        tickAfter(PERIOD, logger);
        EXPECT_EQ(left, 0);
    }
    whileOpening = nullptr;
    tickAfter(PERIOD, logger);
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), all);
}

TEST_F(LoggerTest, keeps_sessions_apart_that_begin_while_it_writes) {
    LoggerImpl& logger = start();
    write(logger, "zero");
    whileOpening = [&] {
        write(logger, "zero too");
        logger.newSession();
        write(logger, "one");
        whileOpening = nullptr;
    };
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "zero\nzero too\n");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "zero\nzero too\n");
    EXPECT_EQ(content(1), "one\n");
}

TEST_F(LoggerTest, ends_with_its_alert_at_the_tick_after_closing_when_it_never_had_a_buffer) {
    LoggerImpl* const logger = LoggerImpl::start(name().c_str());
    std::uint32_t const id = logger->alertId();
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    xos_HostCallsReset();
    logger->close();
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 0u) << "not before the tick";
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    EXPECT_EQ(xos_HostLastCall("HQ_Basis::AlertTimer::Delete"), std::to_string(id));
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    EXPECT_THAT(opened, ElementsAre());
}

TEST_F(LoggerTest, deletes_an_alert_that_outlived_it_when_it_comes_again) {
    LoggerImpl* const logger = LoggerImpl::start(name().c_str());
    std::uint32_t const id = logger->alertId();
    logger->close();
    xos_HostCallsReset();
    xos_HostFail("HQ_Basis::AlertTimer::Delete", 0, 1);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    // May lie where the other one was, and is none of that alert's business.
    LoggerImpl& successor = start();
    successor.newSession();
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    EXPECT_THAT(opened, ElementsAre());
    EXPECT_EQ(xos_HostLastCall("HQ_Basis::AlertTimer::Delete"), std::to_string(id));
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    tick(successor);
    EXPECT_EQ(opened.size(), 1u);
}

TEST_F(LoggerTest, loses_what_it_cannot_write_and_goes_on) {
    LoggerImpl& logger = start();
    std::string const first = lineOf(BLOCK, 'a');
    write(logger, first);
    write(logger, "tail");
    failsToOpen = true;
    tick(logger);
    tickAfter(PERIOD, logger);
    EXPECT_EQ(opened.size(), 2u);
    failsToOpen = false;
    write(logger, "later");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "later\n");
}

TEST_F(LoggerTest, goes_on_where_a_file_is_in_the_way_of_its_folder) {
    makeFolder(folder());
    put(folder() + "/" + name(), "in the way");
    LoggerImpl& logger = start();
    write(logger, "line");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(opened.size(), 1u);
    EXPECT_EQ(textOf(folder() + "/" + name()), "in the way");
}

TEST_F(LoggerTest, goes_on_whichever_platform_call_fails) {
    for (char const* function :
         {"xos_SemMCreate", "xos_SemTake", "xos_SemGive", "xos_SemDestroy", "xos_DirCreateEx", "xos_FileSystemRoot"}) {
        for (std::uint32_t skip : {0u, 1u, 2u, 3u, 4u}) {
            SCOPED_TRACE(std::string(function) + " after " + std::to_string(skip));
            std::filesystem::remove_all(scratchRoot() / "tmp");
            xos_HostFail(function, skip, 1);
            LoggerImpl* const logger = LoggerImpl::start(name().c_str());
            write(*logger, "line");
            logger->newSession();
            write(*logger, "next");
            handClock += PERIOD;
            HQ_Basis::AlertTimer::Alert const alert{logger->alertId(), logger};
            EXPECT_EQ(xos_HostAlertFire(alert.id), 0);
            handClock += PERIOD;
            EXPECT_EQ(xos_HostAlertFire(alert.id), 0);
            if (std::strcmp(function, "xos_DirCreateEx") != 0) {
                EXPECT_EQ(content(0), "line\n");
                EXPECT_EQ(content(1), "next\n");
            }
            xos_HostFailClear();
            HQ_Basis::AlertTimer::Delete(alert.id);
            delete logger;
        }
    }
}

TEST_F(LoggerTest, needs_its_alert) {
    xos_HostFail("HQ_Basis::AlertTimer::New", 0, 1);
    xos_HostCallsReset();
    EXPECT_EQ(LoggerImpl::start(name().c_str()), nullptr);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), xos_HostCalls("xos_SemMCreate"));
}

/* Written on demand */

TEST_F(LoggerTest, writes_all_that_it_holds_when_it_is_flushed) {
    LoggerImpl& logger = start();
    EXPECT_TRUE(logger.flush());
    EXPECT_THAT(opened, ElementsAre()) << "there is nothing to write";
    std::string const filler = lineOf(BLOCK - 10);
    write(logger, filler);
    write(logger, "goes on in the second block");
    logger.newSession();
    write(logger, "next session");
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), filler + "\ngoes on in the second block\n");
    EXPECT_EQ(content(1), "next session\n");
    write(logger, "later");
    EXPECT_TRUE(logger.flush());
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(1), "next session\nlater\n");
    EXPECT_EQ(opened.size(), 4u);
}

TEST_F(LoggerTest, goes_on_as_ever_after_a_flush) {
    LoggerImpl& logger = start();
    write(logger, "flushed");
    logger.flush();
    write(logger, "waits");
    tick(logger);
    EXPECT_EQ(content(0), "flushed\n") << "is being filled still";
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "flushed\nwaits\n");
}

TEST_F(LoggerTest, keeps_what_it_cannot_flush) {
    LoggerImpl& logger = start();
    write(logger, "first");
    logger.newSession();
    write(logger, "second");
    failsToOpen = true;
    EXPECT_FALSE(logger.flush());
    EXPECT_EQ(opened.size(), 1u) << "stops at the first failure, so that lines keep their order";
    failsToOpen = false;
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "first\n");
    EXPECT_EQ(content(1), "second\n");
}

TEST_F(LoggerTest, leaves_the_reason_why_it_cannot_be_flushed) {
    LoggerImpl& logger = start();
    std::filesystem::create_directory(file(0));
    write(logger, "line");
    clearSystemError();
    EXPECT_FALSE(logger.flush());
    int const whenDirectory = systemError();
    std::filesystem::remove(file(0));
    std::filesystem::remove(folder() + "/" + name());
    clearSystemError();
    EXPECT_FALSE(logger.flush());
    int const whenFolderMissing = systemError();
    EXPECT_NE(whenDirectory, 0);
    EXPECT_NE(whenFolderMissing, 0);
    EXPECT_NE(whenDirectory, whenFolderMissing);
    std::filesystem::create_directory(folder() + "/" + name());
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "line\n");
}

TEST_F(LoggerTest, flushes_what_was_there_and_ends_although_lines_come_meanwhile) {
    LoggerImpl& logger = start();
    write(logger, "there");
    whileOpening = [&] { write(logger, "meanwhile"); };
    EXPECT_TRUE(logger.flush());
    whileOpening = nullptr;
    EXPECT_EQ(opened.size(), 1u);
    EXPECT_EQ(content(0), "there\n");
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "there\nmeanwhile\n");
}
