/// \file
/// One line on a terminal that tells how far a copy is. Silent where the output is no terminal.

#ifndef EXAMPLES_COPY_JOB_PROGRESS_LINE_H
#define EXAMPLES_COPY_JOB_PROGRESS_LINE_H

#include <chrono>
#include <cstdint>

class ProgressLine {
public:
    ProgressLine();
    /// Counts an entry of so many bytes.
    void add(std::uint64_t bytes);
    /// Leaves the line as it stands.
    void finish();

private:
    using Clock = std::chrono::steady_clock;
    void show(Clock::time_point now);

    bool const visible_;
    Clock::time_point const start_ = Clock::now();
    Clock::time_point nextShow_ = start_;
    std::uint64_t entries_ = 0;
    std::uint64_t bytes_ = 0;
};

#endif
