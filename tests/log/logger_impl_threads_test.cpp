#include "tests/log/driven_logger.h"
#include "tests/support/random_steps.h"

#include <atomic>
#include <map>
#include <sstream>
#include <thread>

using namespace ZOR_Basis;

namespace {

constexpr int WRITERS = 8;

class LoggerImplThreads : public DrivenLoggers {
protected:
    /// Lets eight threads write numbered lines while the alert writes them to the file as often as it can.
    /// \param afterLine  is called after each line with its number
    template <class AfterLine>
    static void writeInThreads(LoggerImpl& logger, std::uint64_t lines, AfterLine afterLine) {
        std::atomic<int> writing{WRITERS};
        std::vector<std::thread> threads;
        for (int writer = 0; writer < WRITERS; ++writer) {
            threads.emplace_back([&, writer] {
                std::string const who = "writer " + std::to_string(writer) + " line ";
                for (std::uint64_t i = 0; i < lines; ++i) {
                    write(logger, who + std::to_string(i) + " ends");
                    afterLine(i);
                }
                --writing;
            });
        }
        while (writing != 0) tickAfter(PERIOD, logger);
        for (std::thread& thread : threads) thread.join();
    }
};

/// Expects every line of every writer once and whole, and each writer's lines in order.
void expectAllLines(std::string const& text, std::uint64_t lines) {
    std::map<int, std::uint64_t> next;
    std::istringstream all(text);
    std::uint64_t count = 0;
    for (std::string line; std::getline(all, line); ++count) {
        int writer = -1;
        unsigned long long number = 0;
        char end[8] = "";
        ASSERT_EQ(std::sscanf(line.c_str(), "writer %d line %llu %7s", &writer, &number, end), 3) << line;
        ASSERT_STREQ(end, "ends");
        ASSERT_EQ(number, next[writer]++) << "of writer " << writer;
    }
    EXPECT_EQ(count, WRITERS * lines);
}

} // namespace

TEST_F(LoggerImplThreads, lose_no_line_whatever_is_written_meanwhile) {
    LoggerImpl& logger = start();
    std::uint64_t const lines = randomSteps(2000);
    auto const newSession = [&](std::uint64_t i) {
        if (i % 500 == 77) logger.newSession();
    };
    writeInThreads(logger, lines, newSession);
    tickAfter(PERIOD, logger);
    tickAfter(PERIOD, logger);
    std::string all;
    for (int session = 0; exists(file(session)) || exists(file(session + 1)); ++session) all += content(session);
    expectAllLines(all, lines);
}

TEST_F(LoggerImplThreads, flush_each_line_once_and_in_order_while_the_alert_writes_too) {
    LoggerImpl& logger = start();
    std::uint64_t const lines = randomSteps(2000);
    auto const flush = [&](std::uint64_t i) {
        if (i % 100 == 99) { EXPECT_TRUE(logger.flush()); }
    };
    writeInThreads(logger, lines, flush);
    EXPECT_TRUE(logger.flush());
    expectAllLines(content(0), lines);
}
