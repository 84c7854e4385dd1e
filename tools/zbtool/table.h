/// \file
/// A table and its forms: plain text, CSV, JSON. html_page.h has the fourth.

#ifndef TOOLS_ZBTOOL_TABLE_H
#define TOOLS_ZBTOOL_TABLE_H

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace zbtool {

struct Cell {
    Cell(std::string newText) : text(std::move(newText)) {}
    Cell(std::int64_t newNumber) : text(std::to_string(newNumber)), number(newNumber), isNumber(true) {}

    std::string text;
    std::int64_t number = 0;
    bool isNumber = false;
};

struct Column {
    std::string name;
    bool isNumeric = false;
    /// In an HTML page each cell has a bar whose length tells its number.
    bool hasBar = false;
};

struct Table {
    std::vector<Column> columns;
    std::vector<std::vector<Cell>> rows;

    /// Sorts by a column: numbers from the largest, texts from the first; equal rows keep their order.
    /// \param reversed  sorts the other way round
    /// \return false if there is no such column
    bool sort(std::string const& column, bool reversed);
};

/// Columns side by side, numbers to the right with their digits grouped.
std::string plainText(Table const& table);
/// With the names in the first line, quoted where necessary (RFC 4180).
std::string csvText(Table const& table);
/// An array of objects, one in a line.
std::string jsonRows(Table const& table);

/// "1,234,567".
std::string groupedDigits(std::int64_t number);

} // namespace zbtool

#endif
