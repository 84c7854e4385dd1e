// Transfers that the system cuts short or interrupts.

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <fcntl.h>
#include <pthread.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

namespace {

using namespace std::chrono_literals;

/// A signal that interrupts system calls and does nothing else.
struct InterruptingSignal {
    InterruptingSignal() {
        struct sigaction action {};
        action.sa_handler = [](int) { seen.fetch_add(1); };
        ::sigaction(SIGUSR1, &action, &before);
        seen = 0;
    }
    ~InterruptingSignal() { ::sigaction(SIGUSR1, &before, nullptr); }

    static inline std::atomic<int> seen{0};
    struct sigaction before {};
};

/// Sends the signal to a thread until told to stop.
class Interrupter {
public:
    explicit Interrupter(pthread_t target)
        : thread_([this, target] {
              while (!stop_) {
                  ::pthread_kill(target, SIGUSR1);
                  std::this_thread::sleep_for(300us);
              }
          }) {}
    ~Interrupter() {
        stop_ = true;
        thread_.join();
    }

private:
    std::atomic<bool> stop_{false};
    std::thread thread_;
};

struct FileSizeLimit {
    explicit FileSizeLimit(rlim_t most) : handler(std::signal(SIGXFSZ, SIG_IGN)) {
        ::getrlimit(RLIMIT_FSIZE, &before);
        rlimit const limit{most, before.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FileSizeLimit() {
        ::setrlimit(RLIMIT_FSIZE, &before);
        std::signal(SIGXFSZ, handler);
    }
    rlimit before{};
    void (*handler)(int);
};

} // namespace

TEST(HostFileTransfersPosix, complete_a_read_that_is_interrupted_and_comes_in_pieces) {
    Scratch const scratch;
    InterruptingSignal const interrupting;
    std::string const path = scratch / "pipe";
    ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
    for (std::size_t size : {1'000UL, 100'000UL}) {
        std::thread writer{[&] {
            int const out = ::open(path.c_str(), O_WRONLY);
            std::string const piece(size / 10, 'x');
            for (int i = 0; i < 10; ++i) {
                std::this_thread::sleep_for(2ms);
                EXPECT_EQ(::write(out, piece.data(), piece.size()), static_cast<ssize_t>(piece.size()));
            }
            ::close(out);
        }};
        Interrupter const interrupter{::pthread_self()};
        xos_File const in = xos_FileOpen(path.c_str(), 0x02);
        EXPECT_NE(in, 0U);
        std::string text(size + 10, '#');
        EXPECT_EQ(xos_FileReadEx(in, text.data(), size, 0, 0), size);
        EXPECT_EQ(text, std::string(size, 'x') + std::string(10, '#'));
        EXPECT_EQ(xos_FileReadEx(in, text.data(), size, 0, 0), 0U);
        EXPECT_EQ(xos_FileCloseEx(in, 0), 0);
        writer.join();
    }
    EXPECT_GT(InterruptingSignal::seen, 0);
}

TEST(HostFileTransfersPosix, complete_a_line_that_comes_in_pieces) {
    Scratch const scratch;
    InterruptingSignal const interrupting;
    std::string const path = scratch / "pipe";
    ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
    std::thread writer{[&] {
        int const out = ::open(path.c_str(), O_WRONLY);
        for (char const* piece : {"on", "e\ntw", "o", "\n"}) {
            std::this_thread::sleep_for(2ms);
            EXPECT_GT(::write(out, piece, std::char_traits<char>::length(piece)), 0);
        }
        ::close(out);
    }};
    Interrupter const interrupter{::pthread_self()};
    xos_File const in = xos_FileOpen(path.c_str(), 0x02);
    char line[16];
    EXPECT_STREQ(xos_FileGetsEx(in, line, sizeof line, 0), "one\n");
    EXPECT_STREQ(xos_FileGetsEx(in, line, sizeof line, 0), "two\n");
    EXPECT_EQ(xos_FileTellEx(in, 0), -1);
    EXPECT_NE(xos_FileSeekEx(in, 0, 0, 0), 0);
    EXPECT_EQ(xos_FileGetsEx(in, line, sizeof line, 0), nullptr);
    EXPECT_EQ(xos_FileCloseEx(in, 0), 0);
    writer.join();
}

TEST(HostFileTransfersPosix, complete_a_write_that_is_interrupted_half_way) {
    Scratch const scratch;
    InterruptingSignal const interrupting;
    std::string const path = scratch / "pipe";
    ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
    std::string const text(1 << 20, 'y');
    std::uint64_t written = 0;
    std::thread reader{[&] {
        int const in = ::open(path.c_str(), O_RDONLY);
        std::string got;
        char piece[20'000];
        for (ssize_t count = 0; (count = ::read(in, piece, sizeof piece)) != 0;) {
            if (count > 0) got.append(piece, static_cast<std::size_t>(count));
            std::this_thread::sleep_for(500us);
        }
        ::close(in);
        EXPECT_TRUE(got == text);
    }};
    {
        Interrupter const interrupter{::pthread_self()};
        xos_File const out = xos_FileOpen(path.c_str(), 0x04);
        written = xos_FileWriteEx(out, text.data(), text.size(), 0, 0);
        EXPECT_EQ(xos_FileFlush(out), 0);
        EXPECT_EQ(xos_FileCloseEx(out, 0), 0);
    }
    reader.join();
    EXPECT_EQ(written, text.size());
    EXPECT_GT(InterruptingSignal::seen, 0);
}

TEST(HostFileTransfersPosix, report_what_a_limit_let_through) {
    Scratch const scratch;
    FileSizeLimit const limit{10'000};
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x14);
    std::string const text(64'000, 'z');
    EXPECT_EQ(xos_FileWriteEx(file, text.data(), text.size(), 0, 0), 10'000U);
    EXPECT_EQ(errno, EFBIG);
    EXPECT_EQ(xos_FileWriteEx(file, text.data(), 1, 0, 0), 0U);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
    EXPECT_EQ(textOf(scratch / "f"), std::string(10'000, 'z'));
}

TEST(HostFileTransfersPosix, leave_no_part_of_a_copy_that_a_limit_stops) {
    Scratch const scratch;
    for (std::size_t size : {20'000UL, 500'000UL}) {
        put(scratch / "a", std::string(size, 'a'));
        put(scratch / "b", "old");
        FileSizeLimit const limit{10'000};
        EXPECT_NE(xos_FileCopy((scratch / "c").c_str(), (scratch / "a").c_str(), 0), 0);
        EXPECT_EQ(errno, EFBIG);
        EXPECT_NE(xos_FileCopy((scratch / "b").c_str(), (scratch / "a").c_str(), 1), 0);
        EXPECT_EQ(textOf(scratch / "b"), "old");
        EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
    }
}

TEST(HostFileTransfersPosix, report_a_device_that_is_full) {
    xos_File const file = xos_FileOpen("/dev/full", 0x04);
    ASSERT_NE(file, 0U);
    EXPECT_EQ(xos_FileWriteEx(file, "x", 1, 0, 0), 0U);
    EXPECT_EQ(errno, ENOSPC);
    EXPECT_EQ(xos_FileFlush(file), 0);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}
