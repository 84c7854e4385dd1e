// Any bytes as the values of a timer, its name and the separator: the row is the one of a plain model.

#include "fuzz/target.h"

#include "basis/timers/report_row.h"
#include "tests/timers/report_model.h"

#include <zor_basis/timers/thousands_separator.h>

#include <string>

using namespace ZOR_Basis;

namespace {

/// Larger numbers reach into the next column, which the model does not follow.
constexpr std::int64_t LARGEST_FIELD = 999'999'999;
constexpr std::size_t LONGEST_NAME = 200;

/// Mostly small, so that all lengths occur.
std::int64_t number(RandomBytes& bytes) {
    auto const value = static_cast<std::int64_t>(bytes.word() >> (bytes.byte() % 64)) % LARGEST_FIELD;
    return value;
}

void requireRow(RandomBytes& bytes, std::string const& name) {
    RowNumbers shown{.count = number(bytes), .total = number(bytes), .average = number(bytes)};
    shown.max = number(bytes);
    shown.maxCount = number(bytes);
    shown.min = number(bytes);
    shown.suspendTotal = number(bytes);
    shown.suspendMax = number(bytes);
    ReportRow::Values const values{shown.count,    shown.total, shown.average,      shown.max,
                                   shown.maxCount, shown.min,   shown.suspendTotal, shown.suspendMax};
    BufStr<255> line("before");
    ReportRow::format(line, Str(name), values);
    require(bytesOfRow(line) == modelRow(name, shown, thousandsSeparator()));
}

void requirePlaced(std::int64_t value, char separator) {
    std::string const text = grouped(value, separator);
    std::string line(40, '.');
    ReportRow::placeNumber(line.data(), value, line.size(), separator, false);
    require(line == std::string(39 - text.size(), '.') + text + '.');
}

void requireConverted(std::int64_t ticks, std::int64_t frequency) {
    std::int64_t const ms = ReportRow::convert(ticks, 1000, frequency);
    // In 128 bits nothing overflows.
    __extension__ using Wide = __int128;
    require(static_cast<std::uint64_t>(ms) == static_cast<std::uint64_t>(Wide{ticks} * 1000 / frequency));
}

void runTimerRow(unsigned char const* data, std::size_t size) {
    RandomBytes bytes(data, size);
    char const separator = ",.'\0"[bytes.byte() % 4];
    setThousandsSeparator(separator);
    requirePlaced(static_cast<std::int64_t>(bytes.word()), separator);
    requireConverted(static_cast<std::int64_t>(bytes.word()), 1 + static_cast<std::int64_t>(bytes.word() >> 16));
    std::string name;
    for (std::uint64_t n = bytes.below(LONGEST_NAME); n > 0; --n) name += static_cast<char>(bytes.byte() | 1);
    requireRow(bytes, name);
}

FuzzTarget const TIMER_ROW("timer_row", runTimerRow);

} // namespace
