/// \file
/// The text of a configuration group: lines `key = value`, `#` comments.

#ifndef HOST_XOS_BASICS_CONFIGURATION_GROUP_TEXT_H
#define HOST_XOS_BASICS_CONFIGURATION_GROUP_TEXT_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host {

struct GroupEntry {
    std::string key;
    std::string value;
    int line;
};

struct GroupText {
    /// In the order of the lines.
    std::vector<GroupEntry> entries;
    /// Lines that are neither empty, nor a comment, nor a key with a value.
    std::vector<int> malformedLines;
};

/// A comment begins with a `#` at the line's start or behind white space. White space around keys and values does not
/// count, nor do a carriage return at the line's end and a byte-order mark at the text's start.
GroupText parseGroup(std::string_view text);

/// `true`, `yes`, `on`, `1` and `false`, `no`, `off`, `0`, in any case.
/// \return nothing for any other text
std::optional<bool> switchValue(std::string_view value);

} // namespace host

#endif
