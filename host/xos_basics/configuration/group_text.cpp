#include "host/xos_basics/configuration/group_text.h"

#include <algorithm>
#include <array>

namespace host {

namespace {

constexpr std::string_view BLANKS = " \t\r\v\f";

std::string_view trimmed(std::string_view text) {
    std::size_t const first = text.find_first_not_of(BLANKS);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(BLANKS) - first + 1);
}

std::string_view withoutComment(std::string_view line) {
    for (std::size_t i = line.find('#'); i != std::string_view::npos; i = line.find('#', i + 1)) {
        if (i == 0 || BLANKS.find(line[i - 1]) != std::string_view::npos) return line.substr(0, i);
    }
    return line;
}

void parseLine(std::string_view line, int number, GroupText& group) {
    std::string_view const text = trimmed(withoutComment(line));
    if (text.empty()) return;
    std::size_t const equals = text.find('=');
    std::string_view const key = trimmed(text.substr(0, equals));
    if (equals == std::string_view::npos || key.empty()) {
        group.malformedLines.push_back(number);
        return;
    }
    group.entries.push_back({std::string(key), std::string(trimmed(text.substr(equals + 1))), number});
}

char lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

bool isWord(std::string_view value, std::string_view word) {
    return std::equal(value.begin(), value.end(), word.begin(), word.end(),
                      [](char a, char b) { return lower(a) == b; });
}

} // namespace

GroupText parseGroup(std::string_view text) {
    constexpr std::string_view BYTE_ORDER_MARK = "\xEF\xBB\xBF";
    if (text.substr(0, BYTE_ORDER_MARK.size()) == BYTE_ORDER_MARK) text.remove_prefix(BYTE_ORDER_MARK.size());
    GroupText group;
    for (int number = 1; !text.empty(); ++number) {
        std::size_t const end = text.find('\n');
        parseLine(text.substr(0, end), number, group);
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return group;
}

std::optional<bool> switchValue(std::string_view value) {
    constexpr std::array<std::string_view, 4> ON{"true", "yes", "on", "1"};
    constexpr std::array<std::string_view, 4> OFF{"false", "no", "off", "0"};
    auto const isValue = [value](std::string_view word) { return isWord(value, word); };
    if (std::any_of(ON.begin(), ON.end(), isValue)) return true;
    if (std::any_of(OFF.begin(), OFF.end(), isValue)) return false;
    return std::nullopt;
}

} // namespace host
