#include "tools/zbtool/table.h"

#include "tools/zbtool/json.h"

#include <algorithm>

namespace zbtool {
namespace {

std::string csvCell(std::string const& text) {
    if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
    std::string quoted = "\"";
    for (char c : text) quoted.append(c == '"' ? 2 : 1, c);
    return quoted + "\"";
}

template <class Line>
std::string csvLine(Line const& cells, std::string const& (*textOf)(typename Line::value_type const&)) {
    std::string line;
    for (auto const& cell : cells) line += (&cell == &cells.front() ? "" : ",") + csvCell(textOf(cell));
    return line + "\r\n";
}

std::string shown(Cell const& cell) { return cell.isNumber ? groupedDigits(cell.number) : cell.text; }

/// A text of UTF-8 in as many places as it has characters.
std::string padded(std::string const& text, std::size_t width, bool toTheRight) {
    auto const isFirst = [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; };
    auto const length = static_cast<std::size_t>(std::count_if(text.begin(), text.end(), isFirst));
    std::string const blanks(width > length ? width - length : 0, ' ');
    return toTheRight ? blanks + text : text + blanks;
}

std::vector<std::size_t> widthsOf(Table const& table) {
    std::vector<std::size_t> widths;
    for (Column const& column : table.columns) widths.push_back(column.name.size());
    for (auto const& row : table.rows) {
        for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], shown(row[i]).size());
    }
    return widths;
}

std::string withoutEndBlanks(std::string line) {
    line.erase(line.find_last_not_of(' ') + 1);
    return line + "\n";
}

} // namespace

bool Table::sort(std::string const& column, bool reversed) {
    auto const isNamed = [&](Column const& candidate) { return candidate.name == column; };
    auto const place = std::find_if(columns.begin(), columns.end(), isNamed);
    if (place == columns.end()) return false;
    auto const index = static_cast<std::size_t>(place - columns.begin());
    auto const isBefore = [&](std::vector<Cell> const& a, std::vector<Cell> const& b) {
        Cell const& first = reversed ? b[index] : a[index];
        Cell const& second = reversed ? a[index] : b[index];
        return place->isNumeric ? first.number > second.number : first.text < second.text;
    };
    std::stable_sort(rows.begin(), rows.end(), isBefore);
    return true;
}

std::string plainText(Table const& table) {
    std::vector<std::size_t> const widths = widthsOf(table);
    std::string text;
    std::string line;
    for (std::size_t i = 0; i < widths.size(); ++i)
        line += padded(table.columns[i].name, widths[i], table.columns[i].isNumeric) + "  ";
    text += withoutEndBlanks(line);
    for (auto const& row : table.rows) {
        line.clear();
        for (std::size_t i = 0; i < row.size(); ++i)
            line += padded(shown(row[i]), widths[i], table.columns[i].isNumeric) + "  ";
        text += withoutEndBlanks(line);
    }
    return text;
}

std::string csvText(Table const& table) {
    std::string text = csvLine(table.columns, [](Column const& column) -> std::string const& { return column.name; });
    for (auto const& row : table.rows)
        text += csvLine(row, [](Cell const& cell) -> std::string const& { return cell.text; });
    return text;
}

std::string jsonRows(Table const& table) {
    std::string text;
    for (auto const& row : table.rows) {
        JsonObject object;
        for (std::size_t i = 0; i < row.size(); ++i)
            object.addRaw(table.columns[i].name, row[i].isNumber ? row[i].text : jsonText(row[i].text));
        text += (text.empty() ? "\n  " : ",\n  ") + object.text();
    }
    return "[" + text + "\n]\n";
}

std::string groupedDigits(std::int64_t number) {
    std::string text = std::to_string(number);
    std::size_t const first = number < 0 ? 1 : 0;
    for (std::size_t at = text.size(); at > first + 3;) text.insert(at -= 3, ",");
    return text;
}

} // namespace zbtool
