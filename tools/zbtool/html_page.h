/// \file
/// A table as a page that needs nothing but itself: no network, no second file, and scripts only to sort it anew.

#ifndef TOOLS_ZBTOOL_HTML_PAGE_H
#define TOOLS_ZBTOOL_HTML_PAGE_H

#include "tools/zbtool/table.h"

#include <string>
#include <vector>

namespace zbtool {

struct HtmlPage {
    std::string title;
    /// Lines between the title and the table.
    std::vector<std::string> notes;
    /// The column by which the rows are sorted, and whether from the smallest or first.
    std::string sortedBy;
    bool isAscending = false;
};

/// The whole page. It follows the reader's choice of dark or light.
std::string htmlText(HtmlPage const& page, Table const& table);

} // namespace zbtool

#endif
