#include "tests/log/driven_logger.h"
#include "tests/support/table.h"

#include <algorithm>
#include <cstdlib>

using namespace ZOR_Basis;

namespace {

using LoggerImplDriven = DrivenLoggers;

} // namespace

TEST_F(LoggerImplDriven, breathes) {
    LoggerImpl& logger = start();
    write(logger, "first");
    write(logger, "second");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "first\nsecond\n");
    EXPECT_EQ(opened, (std::vector<std::string>{"a " + file(0)}));
}

TEST_F(LoggerImplDriven, makes_its_folder_at_the_start_with_all_parents) {
    std::filesystem::remove_all(scratchRoot() / "tmp");
    start();
    EXPECT_TRUE(std::filesystem::is_directory(folder() + "/" + name()));
    EXPECT_TRUE(std::filesystem::is_empty(folder() + "/" + name()));
    start("a/b c/d");
    EXPECT_TRUE(std::filesystem::is_directory(folder() + "/a/b c/d"));
    EXPECT_TRUE(opened.empty()) << "no file";
}

TEST_F(LoggerImplDriven, registers_an_alert_of_8192_ms_that_asks_for_as_many_again) {
    LoggerImpl const& logger = start();
    std::string const call = xos_HostLastCall("HQ_Basis::AlertTimer::New");
    EXPECT_TRUE(call.starts_with("8192, 0x")) << call;
    std::size_t const second = call.find(", ");
    std::size_t const third = call.rfind(", ");
    auto const callback = reinterpret_cast<HQ_Basis::AlertTimer::Callback>(
        static_cast<std::uintptr_t>(std::strtoull(call.c_str() + second + 2, nullptr, 16)));
    auto* const context =
        reinterpret_cast<void*>(static_cast<std::uintptr_t>(std::strtoull(call.c_str() + third + 2, nullptr, 16)));
    EXPECT_EQ(context, &logger);
    EXPECT_EQ(callback({logger.alertId(), context}), 8192u);
}

TEST_F(LoggerImplDriven, touches_no_file_while_lines_come) {
    LoggerImpl& logger = start();
    for (int i = 0; i < 10'000; ++i) write(logger, "a line of the log");
    EXPECT_TRUE(opened.empty());
    EXPECT_FALSE(exists(file(0)));
}

TEST_F(LoggerImplDriven, writes_a_block_that_is_being_filled_after_a_period_of_silence) {
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

TEST_F(LoggerImplDriven, counts_silence_from_the_last_line) {
    LoggerImpl& logger = start();
    for (int i = 0; i < 5; ++i) {
        write(logger, "line");
        tickAfter(PERIOD - 1, logger);
        EXPECT_EQ(content(0), "");
    }
    tickAfter(1, logger);
    EXPECT_EQ(content(0), "line\nline\nline\nline\nline\n");
}

TEST_F(LoggerImplDriven, counts_silence_from_the_last_write_too) {
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

namespace {

constexpr std::size_t FULL = LoggerImpl::BLOCK_SIZE;

struct SecondLine {
    Row row;
    std::size_t before, line;
    /// Bytes in the file at the next tick, without a period of silence: only the full block.
    std::size_t writtenAtOnce;
};

SecondLine const SECOND_LINES[] = {
    {{}, FULL - 100, 98, 0},     {{}, FULL - 100, 99, 0},       {{}, FULL - 100, 100, FULL},
    {{}, FULL - 100, 101, FULL}, {{}, FULL - 1, 1, FULL},       {{}, FULL - 1, 2, FULL},
    {{}, FULL - 1, 1023, FULL},  {{}, FULL - 1023, 1023, FULL}, {{}, FULL - 1023, 1022, 0},
};

} // namespace

TEST_F(LoggerImplDriven, begins_a_block_when_the_line_fills_or_passes_the_room) {
    for (SecondLine const& c : SECOND_LINES) {
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

TEST_F(LoggerImplDriven, opens_the_file_once_a_block) {
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

TEST_F(LoggerImplDriven, has_a_file_for_each_session) {
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

TEST_F(LoggerImplDriven, Kept_log_02_a_session_without_a_line_has_an_empty_file_unless_it_is_the_first) {
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

TEST_F(LoggerImplDriven, opens_the_file_of_an_idle_log_again_each_period) {
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

TEST_F(LoggerImplDriven, appends_to_what_is_there) {
    LoggerImpl& logger = start();
    put(file(0), "old\n");
    write(logger, "new");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "old\nnew\n");
}

TEST_F(LoggerImplDriven, loses_no_line_that_comes_while_it_writes) {
    LoggerImpl& logger = start();
    std::string all = "first\n";
    write(logger, "first");
    int left = 0;
    // While the block is being written, it becomes full, and then another becomes the current one.
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

TEST_F(LoggerImplDriven, keeps_sessions_apart_that_begin_while_it_writes) {
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
