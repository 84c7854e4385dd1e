/// \file
/// One line on a terminal that tells how far the work is. Nothing is shown where standard error is no terminal.

#ifndef TOOLS_ZBTOOL_PROGRESS_H
#define TOOLS_ZBTOOL_PROGRESS_H

#include <atomic>
#include <chrono>
#include <cstdint>
#include <mutex>
#include <string>

namespace zbtool {

/// What there is to do, or what has been done.
struct Amount {
    std::uint64_t entries = 0;
    std::uint64_t bytes = 0;
};

/// The line's text.
/// \param total  is unknown where its entries are 0
std::string progressText(char const* what, Amount done, Amount total, double seconds);

/// \thread `add`, `done` and `hide` are thread-safe
class Progress {
public:
    /// \param what  is a word such as "copying"
    explicit Progress(char const* what);
    /// Removes the line.
    ~Progress();
    Progress(Progress const&) = delete;
    Progress& operator=(Progress const&) = delete;

    /// Tells whether there is a line at all, so that it is worth knowing the total.
    static bool isVisible();
    /// Removes the line until there is news, so that another can be printed.
    static void hide();

    void setTotal(Amount total) { total_ = total; }
    void add(Amount amount);
    Amount done() const { return {entries_, bytes_}; }
    double seconds() const;

private:
    using Clock = std::chrono::steady_clock;
    void show();

    char const* const what_;
    bool const visible_;
    Clock::time_point const start_ = Clock::now();
    Clock::time_point nextShow_ = start_;
    Amount total_;
    std::atomic<std::uint64_t> entries_{0};
    std::atomic<std::uint64_t> bytes_{0};
    std::mutex showing_;
};

/// "12.3 MiB".
std::string sizeText(std::uint64_t bytes);

} // namespace zbtool

#endif
