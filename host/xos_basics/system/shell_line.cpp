#include "host/xos_basics/system/shell_line.h"

namespace host {

namespace {

std::string_view trimmed(std::string_view text) {
    std::size_t const first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

std::string_view unquoted(std::string_view text) {
    bool const isQuoted = text.size() >= 2 && text.front() == '"' && text.back() == '"';
    return isQuoted ? text.substr(1, text.size() - 2) : text;
}

} // namespace

ShellLine splitShellLine(std::string_view line) {
    constexpr std::string_view CHANGE = "cd ";
    constexpr std::string_view THEN = "& ";
    // "cd & x" has nothing between the two.
    std::size_t const end = line.find(THEN, CHANGE.size());
    if (line.substr(0, CHANGE.size()) != CHANGE || end == std::string_view::npos) return {{}, std::string(line)};
    return {std::string(unquoted(trimmed(line.substr(CHANGE.size(), end - CHANGE.size())))),
            std::string(line.substr(end + THEN.size()))};
}

} // namespace host
