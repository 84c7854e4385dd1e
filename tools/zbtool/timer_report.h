/// \file
/// Timer reports: reading them, and adding up what several tell of a timer.

#ifndef TOOLS_ZBTOOL_TIMER_REPORT_H
#define TOOLS_ZBTOOL_TIMER_REPORT_H

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace zbtool {

/// Durations are in microseconds. All but the count are 0 if that is 0.
struct TimerRow {
    std::string name;
    std::int64_t count = 0;
    std::int64_t total = 0;
    std::int64_t average = 0;
    std::int64_t maximum = 0;
    std::int64_t maximumCount = 0; ///< which measurement was the longest, from 1
    std::int64_t minimum = 0;
    std::int64_t suspendTotal = 0;
    std::int64_t suspendMaximum = 0;

    bool operator==(TimerRow const&) const = default;
    /// Adds what another report tells of the same timer. The longest measurement keeps the number in its own report.
    void add(TimerRow const& other);
};

struct TimerReport {
    std::string path;
    std::int64_t time = 0; ///< of the first part, in seconds since 1970 UTC
    std::vector<TimerRow> rows;
};

/// Reads the text of a report file, which may contain several reports of the same second.
/// \param reason  receives what is wrong and in which line
/// \return whether all of it was understood
bool readTimerReport(std::string_view text, TimerReport& report, std::string& reason);

/// Merges rows of the same name, in the order in which the names come first.
std::vector<TimerRow> mergedRows(std::vector<TimerReport> const& reports);

} // namespace zbtool

#endif
