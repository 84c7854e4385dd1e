#include <zor_basis/log.h>

#include "tests/log/driven_logger.h"
#include "tests/support/child.h"

#include <cstring>
#include <new>
#include <thread>

using namespace ZOR_Basis;

namespace {

/// A log whose logger the test controls; only the test closes it.
class LogLines : public DrivenLoggers {
protected:
    Log& make() { return *new (memory_) Log(name().c_str()); }
    static LoggerImpl& loggerOf(Log const& log) {
        LoggerImpl* logger = nullptr;
        std::memcpy(&logger, &log, sizeof logger);
        return *logger;
    }
    /// Full blocks come first, and the last one a period later.
    static std::string writtenBy(Log const& log) {
        std::filesystem::remove(file(0));
        tickAfter(PERIOD, loggerOf(log));
        tickAfter(PERIOD, loggerOf(log));
        return content(0);
    }
    static void end(Log& log) {
        HQ_Basis::AlertTimer::Delete(loggerOf(log).alertId());
        delete &loggerOf(log);
    }

private:
    alignas(Log) unsigned char memory_[sizeof(Log)];
};

} // namespace

TEST_F(LogLines, are_the_texts_of_printf_one_a_line) {
    Log& log = make();
    log.out("%s %d %.3f", "text", -5, 2.0625);
    log.out("nothing to convert");
    log.out("%s", "");
    log.out("two\nlines");
    log.out("%e and %5s|%-5d|%%", 12.5, "abc", 42);
    EXPECT_EQ(writtenBy(log), "text -5 2.062\nnothing to convert\n\ntwo\nlines\n1.250000e+01 and   abc|42   |%\n");
    end(log);
}

TEST_F(LogLines, have_at_most_1022_characters) {
    Log& log = make();
    for (std::size_t size : {1021u, 1022u, 1023u, 1024u, 5000u, 100'000u}) {
        std::string const text(size, 'x');
        std::string const expected = text.substr(0, 1022) + "\n";
        log.out("%s", text.c_str());
        EXPECT_EQ(writtenBy(log), expected) << size;
        log.out("%s %e", text.c_str(), 0.5);
        EXPECT_EQ(writtenBy(log), (text + " 5.000000e-01").substr(0, 1022) + "\n") << size;
        log.out("%*d", static_cast<int>(size), 1);
        EXPECT_EQ(writtenBy(log), (std::string(size - 1, ' ') + "1").substr(0, 1022) + "\n") << size;
    }
    end(log);
}

TEST_F(LogLines, end_at_the_first_zero) {
    Log& log = make();
    log.out("be%cfore", 0);
    log.out("%c", 0);
    log.out("next");
    EXPECT_EQ(writtenBy(log), "be\n\nnext\n");
    end(log);
}

TEST_F(LogLines, are_not_made_of_a_null_format) {
    Log& log = make();
    char const* const none = nullptr;
    log.out(none);
    EXPECT_EQ(writtenBy(log), "");
    EXPECT_TRUE(opened.empty());
    end(log);
}

TEST_F(LogLines, go_to_the_next_session_when_asked_to) {
    Log& log = make();
    log.out("zero");
    log.newSession();
    log.out("one");
    tickAfter(PERIOD, loggerOf(log));
    tickAfter(PERIOD, loggerOf(log));
    EXPECT_EQ(content(0), "zero\n");
    EXPECT_EQ(content(1), "one\n");
    end(log);
}

TEST_F(LogLines, of_a_switched_off_log_go_nowhere) {
    xos_HostFail("HQ_Basis::AlertTimer::New", 0, 1);
    Log log(name().c_str());
    log.out("text");
    log.newSession();
    EXPECT_TRUE(opened.empty());
}

TEST_F(LogLines, switch_to_a_new_log_in_session_0) {
    Log& log = make();
    log.newSession();
    LoggerImpl& old = loggerOf(log);
    EXPECT_NE(&old, nullptr);
    HQ_Basis::AlertTimer::Delete(old.alertId());
    log.init(name().c_str()); // closes the old one, whose alert is gone
    EXPECT_NE(&loggerOf(log), &old);
    log.out("fresh");
    EXPECT_EQ(writtenBy(log), "fresh\n");
    end(log);
    delete &old;
}

TEST_F(LogLines, of_a_log_that_never_had_one_let_it_end) {
    xos_HostCallsReset();
    { Log const log(name().c_str()); }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 0u);
    // Ids of alerts ascend, so this one follows the log's.
    std::uint32_t const after = HQ_Basis::AlertTimer::New(
        PERIOD, [](auto const&) { return PERIOD; }, nullptr);
    EXPECT_EQ(xos_HostAlertFire(after - 1), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    EXPECT_EQ(xos_HostAlertFire(after - 1), -1);
    HQ_Basis::AlertTimer::Delete(after);
}

TEST_F(LogLines, of_many_threads_come_whole) {
    Log& log = make();
    std::vector<std::thread> threads;
    for (int writer = 0; writer < 4; ++writer) {
        threads.emplace_back([&log, writer] {
            for (int i = 0; i < 500; ++i) log.out("writer %d %s %.3f", writer, "in a thread", i / 8.0);
        });
    }
    for (std::thread& thread : threads) thread.join();
    std::string const all = writtenBy(log);
    EXPECT_EQ(std::count(all.begin(), all.end(), '\n'), 2000);
    for (int writer = 0; writer < 4; ++writer) {
        EXPECT_NE(all.find("writer " + std::to_string(writer) + " in a thread 62.375\n"), std::string::npos);
    }
    end(log);
}

// The thread of a closed log never ends, so this runs in a process of its own.

TEST_F(LogLines, Kept_log_01_of_a_closed_log_are_written_and_its_file_is_then_opened_for_ever) {
    for (char const* how : {"line", "session", "destroyed"}) {
        SCOPED_TRACE(how);
        Scratch const root;
        ChildResult const result = run({"log_child", {how}, {{"XOS_ROOT", root.path()}}, root.path()});
        EXPECT_EQ(result.exitCode, 0);
        EXPECT_EQ(result.output, "written\nopened again\nopened again\nopened again\nstill running\n");
    }
}
