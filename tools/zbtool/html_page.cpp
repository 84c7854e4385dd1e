#include "tools/zbtool/html_page.h"

#include <algorithm>
#include <cstdio>

namespace zbtool {
namespace {

constexpr char STYLE[] = R"(
:root { color-scheme: light dark; --ink: #1b1f24; --paper: #ffffff; --faint: #59636e; --line: #d1d9e0;
        --head: #f3f5f7; --bar: #8fb8ea; }
@media (prefers-color-scheme: dark) {
  :root { --ink: #e6edf3; --paper: #0d1117; --faint: #9198a1; --line: #3d444d; --head: #161b22; --bar: #2c5c95; }
}
body { font: 15px/1.45 system-ui, sans-serif; color: var(--ink); background: var(--paper); margin: 2rem auto;
       max-width: 80rem; padding: 0 1rem; }
h1 { font-size: 1.4rem; margin: 0 0 .3rem; }
p { color: var(--faint); margin: .1rem 0; }
.wide { overflow-x: auto; margin-top: 1.2rem; }
table { border-collapse: collapse; width: 100%; font-variant-numeric: tabular-nums; }
th { background: var(--head); text-align: left; vertical-align: bottom; }
td { white-space: nowrap; }
th, td { border-bottom: 1px solid var(--line); padding: .35rem .6rem; }
th.number, td.number { text-align: right; }
td.bar { min-width: 8rem; }
td.bar i { display: block; height: .3rem; margin-left: auto; border-radius: 2px; background: var(--bar); }
th button { all: unset; cursor: pointer; }
th button:focus-visible { outline: 2px solid var(--bar); outline-offset: 2px; }
th[aria-sort=ascending]::after { content: " \25B2"; }
th[aria-sort=descending]::after { content: " \25BC"; }
)";

constexpr char SCRIPT[] = R"(
const table = document.querySelector("table"), heads = [...table.tHead.rows[0].cells], body = table.tBodies[0];
const keyOf = (row, i, numeric) => numeric ? Number(row.cells[i].dataset.value) : row.cells[i].textContent;
function sort(i) {
  const head = heads[i], numeric = head.classList.contains("number"), now = head.getAttribute("aria-sort");
  const ascending = now ? now === "descending" : !numeric;
  const sign = ascending ? 1 : -1;
  const rows = [...body.rows].sort((a, b) => {
    const x = keyOf(a, i, numeric), y = keyOf(b, i, numeric);
    return x < y ? -sign : x > y ? sign : 0;
  });
  body.append(...rows);
  heads.forEach(other => other.removeAttribute("aria-sort"));
  head.setAttribute("aria-sort", ascending ? "ascending" : "descending");
}
heads.forEach((head, i) => {
  const button = document.createElement("button");
  button.textContent = head.textContent;
  button.addEventListener("click", () => sort(i));
  head.replaceChildren(button);
});
)";

std::string escaped(std::string const& text) {
    std::string out;
    for (char c : text) {
        switch (c) {
        case '&':
            out += "&amp;";
            break;
        case '<':
            out += "&lt;";
            break;
        case '>':
            out += "&gt;";
            break;
        case '"':
            out += "&quot;";
            break;
        default:
            out.push_back(c);
        }
    }
    return out;
}

std::string headOf(HtmlPage const& page, Table const& table) {
    std::string text = "<thead><tr>";
    for (Column const& column : table.columns) {
        text += column.isNumeric ? "<th class=\"number\" scope=\"col\"" : "<th scope=\"col\"";
        if (column.name == page.sortedBy)
            text += page.isAscending ? " aria-sort=\"ascending\"" : " aria-sort=\"descending\"";
        text += ">" + escaped(column.name) + "</th>";
    }
    return text + "</tr></thead>\n";
}

/// The largest number of each column that has bars.
std::vector<std::int64_t> largestOf(Table const& table) {
    std::vector<std::int64_t> largest(table.columns.size(), 0);
    for (auto const& row : table.rows) {
        for (std::size_t i = 0; i < row.size(); ++i) largest[i] = std::max(largest[i], row[i].number);
    }
    return largest;
}

std::string barOf(std::int64_t number, std::int64_t largest) {
    double const share = largest > 0 && number > 0 ? static_cast<double>(number) / static_cast<double>(largest) : 0;
    char text[64];
    std::snprintf(text, sizeof text, "<i style=\"width:%.1f%%\"></i>", 100 * share);
    return text;
}

std::string cellText(Cell const& cell, Column const& column, std::int64_t largest) {
    if (!cell.isNumber) return "<td>" + escaped(cell.text) + "</td>";
    std::string const kind = column.hasBar ? "number bar" : "number";
    return "<td class=\"" + kind + "\" data-value=\"" + cell.text + "\">" + groupedDigits(cell.number) +
           (column.hasBar ? barOf(cell.number, largest) : "") + "</td>";
}

std::string bodyOf(Table const& table) {
    std::vector<std::int64_t> const largest = largestOf(table);
    std::string text = "<tbody>\n";
    for (auto const& row : table.rows) {
        text += "<tr>";
        for (std::size_t i = 0; i < row.size(); ++i) text += cellText(row[i], table.columns[i], largest[i]);
        text += "</tr>\n";
    }
    return text + "</tbody>\n";
}

} // namespace

std::string htmlText(HtmlPage const& page, Table const& table) {
    std::string const title = escaped(page.title);
    std::string text = "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
                       "<meta name=\"viewport\" content=\"width=device-width\">\n<title>";
    text += title + "</title>\n<style>" + STYLE + "</style>\n</head>\n<body>\n<h1>" + title + "</h1>\n";
    for (std::string const& note : page.notes) text += "<p>" + escaped(note) + "</p>\n";
    text += "<div class=\"wide\"><table>\n" + headOf(page, table) + bodyOf(table) + "</table></div>\n";
    return text + "<script>" + SCRIPT + "</script>\n</body>\n</html>\n";
}

} // namespace zbtool
