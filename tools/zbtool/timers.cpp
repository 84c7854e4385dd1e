#include "tools/zbtool/timers.h"

#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/html_page.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/timer_report.h"
#include "tools/zbtool/whole_file.h"

#include <zor_basis/files.h>

#include <algorithm>
#include <cstdio>
#include <ctime>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

constexpr char TIMER[] = "timer";
constexpr char TOTAL[] = "total";

struct Field {
    char const* name;
    std::int64_t TimerRow::*value;
    bool hasBar;
};

constexpr Field COLUMNS[] = {
    {"count", &TimerRow::count, false},
    {TOTAL, &TimerRow::total, true},
    {"average", &TimerRow::average, true},
    {"maximum", &TimerRow::maximum, false},
    {"maximum-count", &TimerRow::maximumCount, false},
    {"minimum", &TimerRow::minimum, false},
    {"suspended", &TimerRow::suspendTotal, false},
    {"suspended-maximum", &TimerRow::suspendMaximum, false},
};

Table mergedTable(std::vector<TimerReport> const& reports) {
    Table table{{{TIMER}}, {}};
    for (Field const& field : COLUMNS) table.columns.push_back({field.name, true, field.hasBar});
    for (TimerRow const& row : mergedRows(reports)) {
        table.rows.push_back({row.name});
        for (Field const& field : COLUMNS) table.rows.back().emplace_back(row.*field.value);
    }
    return table;
}

/// The row of a timer in one report, all of it 0 if the report does not have the timer.
TimerRow rowOf(TimerReport const& report, std::string const& name) {
    for (TimerRow const& row : mergedRows({report})) {
        if (row.name == name) return row;
    }
    return {};
}

/// In percent of the first; 0 if there is nothing to compare with.
std::int64_t changeOf(std::int64_t first, std::int64_t last) {
    return first == 0
               ? 0
               : static_cast<std::int64_t>(100.0 * static_cast<double>(last - first) / static_cast<double>(first));
}

/// Beside each other the averages of each report, and how much the last differs from the first.
Table comparedTable(std::vector<TimerReport> const& reports) {
    Table table{{{TIMER}}, {}};
    for (std::size_t i = 1; i <= reports.size(); ++i) {
        table.columns.push_back({"count-" + std::to_string(i), true, false});
        table.columns.push_back({"average-" + std::to_string(i), true, true});
    }
    table.columns.push_back({"change-%", true, false});
    for (TimerRow const& merged : mergedRows(reports)) {
        table.rows.push_back({merged.name});
        for (TimerReport const& report : reports) {
            TimerRow const row = rowOf(report, merged.name);
            table.rows.back().emplace_back(row.count);
            table.rows.back().emplace_back(row.average);
        }
        std::int64_t const first = table.rows.back()[2].number;
        table.rows.back().emplace_back(changeOf(first, table.rows.back().back().number));
    }
    return table;
}

std::string timeText(std::int64_t seconds) {
    auto const time = static_cast<std::time_t>(seconds);
    std::tm const* const parts = std::gmtime(&time);
    char text[64];
    std::size_t const size = parts == nullptr ? 0 : std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S UTC", parts);
    return std::string(text, size);
}

bool readReports(std::vector<std::string> const& paths, std::vector<TimerReport>& reports) {
    for (std::string const& path : paths) {
        TimerReport& report = reports.emplace_back();
        report.path = path;
        std::string text;
        std::string reason;
        if (!readWhole(path, text, reason) || !readTimerReport(text, report, reason)) return complain(path, reason);
    }
    return true;
}

/// Complains if the page would replace a report, or any other file without being told to.
bool mayWritePage(TimersOptions const& options) {
    auto const isPage = [&](std::string const& report) { return isSameFile(report, options.html); };
    if (std::any_of(options.reports.begin(), options.reports.end(), isPage))
        return complain(options.html, "is one of the reports");
    return options.overwrite || !FStat::exist(options.html.c_str()) || complain(options.html, "exists already");
}

bool writePage(TimersOptions const& options, std::vector<TimerReport> const& reports, Table const& table,
               std::string const& sortedBy) {
    bool const isText = sortedBy == TIMER;
    HtmlPage page{options.compare ? "Timer reports compared" : "Timer report", {}, sortedBy, isText != options.reverse};
    for (std::size_t i = 0; i < reports.size(); ++i) {
        std::string const number = reports.size() > 1 ? std::to_string(i + 1) + ". " : "";
        page.notes.push_back(number + reports[i].path + ", " + timeText(reports[i].time));
    }
    page.notes.push_back("Durations in microseconds.");
    std::string reason;
    if (!writeWhole(options.html, htmlText(page, table), reason)) return complain(options.html, reason);
    std::puts(shownName(options.html).c_str());
    return true;
}

} // namespace

int timers(TimersOptions const& options) {
    if (options.compare && options.reports.size() < 2) {
        complain("timers", "--compare requires two reports or more; see zbtool timers --help");
        return MISUSED;
    }
    if (!options.html.empty() && !mayWritePage(options)) return FAILED;
    std::vector<TimerReport> reports;
    if (!readReports(options.reports, reports)) return FAILED;
    Table table = options.compare ? comparedTable(reports) : mergedTable(reports);
    std::string const sortedBy = !options.sortBy.empty() ? options.sortBy : options.compare ? "change-%" : TOTAL;
    if (!table.sort(sortedBy, options.reverse)) {
        std::string names;
        for (Column const& column : table.columns) names += " " + column.name;
        complain("--sort " + options.sortBy, "no such column; there are:" + names);
        return MISUSED;
    }
    if (!options.html.empty()) return exitCodeOf(writePage(options, reports, table, sortedBy));
    std::string const text = options.json ? jsonRows(table) : options.csv ? csvText(table) : plainText(table);
    std::fputs(shownLines(text).c_str(), stdout);
    return DONE;
}

} // namespace zbtool
