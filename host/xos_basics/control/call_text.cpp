#include "host/xos_basics/control/call_text.h"

#include "host/xos_basics/control/call_record.h"

#include <cinttypes>
#include <cstdio>

namespace host {

namespace {

constexpr std::size_t NUMBER_SIZE = 24;

std::string textOf(std::uint64_t word, CallSnapshot const& call) {
    if (word == NULL_TEXT) return "null";
    return '"' + std::string(reinterpret_cast<char const*>(call.texts.data() + word)) + '"';
}

std::string decimal(std::int64_t value) {
    char digits[NUMBER_SIZE];
    std::snprintf(digits, sizeof digits, "%" PRId64, value);
    return digits;
}

std::string unsignedDecimal(std::uint64_t value) {
    char digits[NUMBER_SIZE];
    std::snprintf(digits, sizeof digits, "%" PRIu64, value);
    return digits;
}

std::string hexadecimal(std::uint64_t value) {
    char digits[NUMBER_SIZE];
    std::snprintf(digits, sizeof digits, "0x%" PRIx64, value);
    return digits;
}

std::string argumentText(char kind, std::uint64_t word, CallSnapshot const& call) {
    switch (kind) {
    case 't':
        return textOf(word, call);
    case 'd':
        return decimal(static_cast<std::int64_t>(word));
    case 'u':
        return unsignedDecimal(word);
    case 'p':
        return word == 0 ? "null" : hexadecimal(word);
    default:
        return hexadecimal(word);
    }
}

} // namespace

std::string callText(char const* kinds, CallSnapshot const& call) {
    std::string text;
    for (std::size_t i = 0; kinds[i] != '\0'; ++i) {
        if (i != 0) text += ", ";
        text += argumentText(kinds[i], call.words[i], call);
    }
    return text;
}

} // namespace host
