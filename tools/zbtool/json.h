/// \file
/// Writes JSON, and reads what `dict import` accepts: one object of texts.

#ifndef TOOLS_ZBTOOL_JSON_H
#define TOOLS_ZBTOOL_JSON_H

#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace zbtool {

/// A text in double quotes. A byte that is no part of valid UTF-8 becomes U+FFFD.
std::string jsonText(std::string_view text);

/// An object while it is written, in one line.
class JsonObject {
public:
    JsonObject& add(char const* name, std::string_view text) { return addRaw(name, jsonText(text)); }
    JsonObject& add(char const* name, char const* text) { return add(name, std::string_view(text)); }
    JsonObject& add(char const* name, bool value) { return addRaw(name, value ? "true" : "false"); }
    JsonObject& add(char const* name, std::uint64_t number) { return addRaw(name, std::to_string(number)); }
    JsonObject& add(char const* name, std::int64_t number) { return addRaw(name, std::to_string(number)); }
    /// \param value  is JSON already
    JsonObject& addRaw(std::string_view name, std::string_view value);
    std::string text() const { return "{" + members_ + "}"; }

private:
    std::string members_;
};

using JsonMembers = std::vector<std::pair<std::string, std::string>>;

/// Reads an object whose values are all texts.
/// \return false, with a reason, for any other text
bool readJsonTexts(std::string_view text, JsonMembers& members, std::string& reason);

} // namespace zbtool

#endif
