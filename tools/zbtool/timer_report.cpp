#include "tools/zbtool/timer_report.h"

#include <algorithm>

namespace zbtool {
namespace {

constexpr std::string_view STAMP = "Log timestamp (sec): ";
constexpr std::string_view UNIT = "Timers (mksec):";
constexpr std::string_view TITLES =
    "Function                                Count     Total          Average        Maximum        Maximum count  "
    "Minimum        Suspend total  Suspend Max    Notes                   ";
/// The columns of a row's last digits.
constexpr std::size_t COUNT_END = 48;
constexpr std::size_t ENDS[] = {63, 78, 93, 108, 123, 138, 153};
constexpr std::int64_t TimerRow::*FIELDS[] = {&TimerRow::total,         &TimerRow::average, &TimerRow::maximum,
                                              &TimerRow::maximumCount,  &TimerRow::minimum, &TimerRow::suspendTotal,
                                              &TimerRow::suspendMaximum};

bool isDigit(char c) { return c >= '0' && c <= '9'; }

/// Whether a group of three digits ends before a separator at an index.
bool isSeparator(std::string_view row, std::size_t at) {
    bool const isOther = !isDigit(row[at]) && row[at] != ' ' && row[at] != '-';
    return isOther && at > 0 && isDigit(row[at - 1]);
}

/// Reads a number from its last digit to the left. Groups of three digits are separated all or not at all, so that a
/// number which fills its column ends where it meets the one before.
/// \param begin  receives where it begins
bool readNumber(std::string_view row, std::size_t end, std::int64_t& number, std::size_t& begin) {
    if (end >= row.size() || !isDigit(row[end])) return false;
    bool const isGrouped = end >= 4 && isDigit(row[end - 1]) && isDigit(row[end - 2]) && isSeparator(row, end - 3);
    std::uint64_t value = 0;
    std::uint64_t weight = 1;
    int digits = 0;
    for (begin = end + 1; begin > 0; --begin) {
        std::size_t at = begin - 1;
        if (isGrouped && digits > 0 && digits % 3 == 0) {
            if (!isSeparator(row, at)) break;
            begin = at--;
        }
        if (!isDigit(row[at])) break;
        value += weight * static_cast<std::uint64_t>(row[at] - '0');
        weight *= 10;
        ++digits;
    }
    bool const isNegative = begin > 0 && row[begin - 1] == '-';
    begin -= isNegative ? 1 : 0;
    number = static_cast<std::int64_t>(isNegative ? 0 - value : value);
    return true;
}

bool readRow(std::string_view line, TimerRow& row) {
    std::size_t begin = 0;
    if (!readNumber(line, COUNT_END, row.count, begin)) return false;
    std::string_view const name = line.substr(0, begin);
    row.name = name.substr(0, name.find_last_not_of(' ') + 1);
    if (row.count == 0) return true;
    for (std::size_t i = 0; i < std::size(ENDS); ++i) {
        if (!readNumber(line, ENDS[i], row.*FIELDS[i], begin)) return false;
    }
    return true;
}

bool readStamp(std::string_view line, std::int64_t& time) {
    std::size_t begin = 0;
    return readNumber(line, line.size() - 1, time, begin) && begin == STAMP.size();
}

/// The parts of a report: three lines of head, and rows up to the next head.
class Lines {
public:
    Lines(std::string_view text, TimerReport& report) : text_(text), report_(report) {}

    /// A text that does not end with a line was cut.
    bool run() {
        bool const isWhole = text_.ends_with('\n');
        while (!text_.empty()) {
            std::string_view const line = next();
            if (!(line.starts_with(STAMP) ? readHead(line) : readBody(line))) return false;
        }
        return hasHead_ && isWhole;
    }
    int line() const { return line_; }

private:
    std::string_view next() {
        std::size_t const end = std::min(text_.find('\n'), text_.size());
        std::string_view line = text_.substr(0, end);
        text_.remove_prefix(std::min(end + 1, text_.size()));
        ++line_;
        if (line.ends_with('\r')) line.remove_suffix(1);
        return line;
    }

    bool readHead(std::string_view line) {
        std::int64_t time = 0;
        if (!readStamp(line, time) || next() != UNIT || next() != TITLES) return false;
        if (!hasHead_) report_.time = time;
        hasHead_ = true;
        return true;
    }

    bool readBody(std::string_view line) {
        TimerRow row;
        if (!hasHead_ || !readRow(line, row)) return false;
        report_.rows.push_back(std::move(row));
        return true;
    }

    std::string_view text_;
    TimerReport& report_;
    int line_ = 0;
    bool hasHead_ = false;
};

} // namespace

void TimerRow::add(TimerRow const& other) {
    if (other.count == 0) return;
    // A minimum of 0 stands for none yet.
    minimum = minimum == 0 ? other.minimum : other.minimum == 0 ? minimum : std::min(minimum, other.minimum);
    if (count == 0 || other.maximum > maximum) {
        maximum = other.maximum;
        maximumCount = other.maximumCount;
    }
    suspendMaximum = std::max(suspendMaximum, other.suspendMaximum);
    count += other.count;
    total += other.total;
    suspendTotal += other.suspendTotal;
    average = total / count;
}

bool readTimerReport(std::string_view text, TimerReport& report, std::string& reason) {
    Lines lines(text, report);
    if (lines.run()) return true;
    reason = "line " + std::to_string(lines.line()) + " does not belong to a timer report";
    return false;
}

std::vector<TimerRow> mergedRows(std::vector<TimerReport> const& reports) {
    std::vector<TimerRow> merged;
    std::map<std::string, std::size_t> places;
    for (TimerReport const& report : reports) {
        for (TimerRow const& row : report.rows) {
            auto const [place, isNew] = places.try_emplace(row.name, merged.size());
            if (isNew)
                merged.push_back(row);
            else
                merged[place->second].add(row);
        }
    }
    return merged;
}

} // namespace zbtool
