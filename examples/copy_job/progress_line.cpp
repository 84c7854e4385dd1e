#include "examples/copy_job/progress_line.h"

#include "examples/copy_job/terminal.h"

#include <cstdio>

namespace {

// Showing every entry of thousands a second would take longer than copying it.
constexpr std::chrono::milliseconds BETWEEN_SHOWS(20);
constexpr double MEBIBYTE = 1024.0 * 1024.0;

} // namespace

ProgressLine::ProgressLine() : visible_(outputIsTerminal()) {}

void ProgressLine::add(std::uint64_t bytes) {
    ++entries_;
    bytes_ += bytes;
    if (!visible_) return;
    Clock::time_point const now = Clock::now();
    if (now < nextShow_) return;
    nextShow_ = now + BETWEEN_SHOWS;
    show(now);
}

void ProgressLine::finish() {
    if (!visible_) return;
    show(Clock::now());
    std::putchar('\n');
}

void ProgressLine::show(Clock::time_point now) {
    double const seconds = std::chrono::duration<double>(now - start_).count();
    double const mebibytes = static_cast<double>(bytes_) / MEBIBYTE;
    std::printf("\rcopying  %llu entries, %.1f MiB, %.1f MiB/s ", static_cast<unsigned long long>(entries_), mebibytes,
                seconds > 0 ? mebibytes / seconds : 0.0);
    std::fflush(stdout);
}
