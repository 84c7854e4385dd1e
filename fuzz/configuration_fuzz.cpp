// Any bytes as the file of a configuration group: its entries are those that a second reading finds, which looks at one
// line at a time, character by character.

#include "fuzz/target.h"

#include "host/xos_basics/configuration/group_text.h"

#include <cctype>
#include <sstream>
#include <string>

using namespace host;

namespace {

bool isWhiteSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r' && c != '\n'); }

std::string stripped(std::string text) {
    while (!text.empty() && isWhiteSpace(text.back())) text.pop_back();
    while (!text.empty() && isWhiteSpace(text.front())) text.erase(0, 1);
    return text;
}

std::string beforeComment(std::string const& line) {
    std::string text;
    for (char const c : line) {
        if (c == '#' && (text.empty() || isWhiteSpace(text.back()))) break;
        text += c;
    }
    return text;
}

/// \return the remaining entries and lines of `found` begin with this one's
void requireLine(std::string const& line, int number, GroupText const& found, std::size_t& entry, std::size_t& bad) {
    std::string const text = stripped(beforeComment(line));
    if (text.empty()) return;
    std::string const key = stripped(text.substr(0, text.find('=')));
    if (text.find('=') == std::string::npos || key.empty()) {
        require(bad < found.malformedLines.size() && found.malformedLines[bad++] == number);
        return;
    }
    require(entry < found.entries.size());
    GroupEntry const& read = found.entries[entry++];
    require(read.key == key && read.line == number);
    require(read.value == stripped(text.substr(text.find('=') + 1)));
    std::string lower;
    for (char const c : read.value) lower += c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
    bool const isOn = lower == "true" || lower == "yes" || lower == "on" || lower == "1";
    bool const isOff = lower == "false" || lower == "no" || lower == "off" || lower == "0";
    require(switchValue(read.value).has_value() == (isOn || isOff) && switchValue(read.value).value_or(false) == isOn);
}

void runConfiguration(unsigned char const* data, std::size_t size) {
    std::string text(reinterpret_cast<char const*>(data), size);
    GroupText const found = parseGroup(text);
    if (text.compare(0, 3, "\xEF\xBB\xBF") == 0) text.erase(0, 3);
    std::istringstream lines(text);
    std::string line;
    std::size_t entry = 0;
    std::size_t bad = 0;
    for (int number = 1; std::getline(lines, line); ++number) requireLine(line, number, found, entry, bad);
    require(entry == found.entries.size() && bad == found.malformedLines.size());
}

FuzzTarget const CONFIGURATION("configuration", runConfiguration);

} // namespace
