#include "host/xos_basics/control/call_text.h"

#include <algorithm>
#include <cinttypes>
#include <cstdio>

namespace host {

namespace {

constexpr std::string_view HIDDEN = "***";

bool isControl(char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; }

std::string quoted(std::string_view text) {
    std::string out{'"'};
    for (char const c : text) {
        if (isControl(c)) {
            char code[8];
            std::snprintf(code, sizeof code, "\\x%02x", static_cast<unsigned>(c));
            out += code;
        } else {
            out += c;
        }
    }
    return out += '"';
}

} // namespace

std::string numberText(char kind, std::uint64_t word) {
    if (kind == 'd') return std::to_string(static_cast<std::int64_t>(word));
    if (kind == 'u') return std::to_string(word);
    if (kind == 'p' && word == 0) return "null";
    char digits[24];
    std::snprintf(digits, sizeof digits, "0x%" PRIx64, word);
    return digits;
}

std::string traceText(char const* text) { return text == nullptr ? "null" : quoted(text); }

std::string traceUrl(char const* url) {
    if (url == nullptr) return "null";
    std::string_view const text{url};
    std::size_t const scheme = text.find("://");
    if (scheme == std::string_view::npos) return quoted(text);
    std::size_t const begin = scheme + 3;
    std::size_t const end = std::min(text.find_first_of("/?#", begin), text.size());
    // The host stands behind the last "@".
    std::size_t const at = text.substr(0, end).rfind('@');
    std::size_t const colon = text.find(':', begin);
    if (at == std::string_view::npos || at < begin || colon >= at) return quoted(text);
    std::string shown{text.substr(0, colon + 1)};
    return quoted(shown.append(HIDDEN).append(text.substr(at)));
}

std::string traceSecret(char const* text) {
    return text == nullptr || *text == '\0' ? traceText(text) : quoted(HIDDEN);
}

std::string utcText(std::chrono::sys_time<std::chrono::microseconds> time) {
    auto const day = std::chrono::floor<std::chrono::days>(time);
    std::chrono::year_month_day const date{day};
    std::chrono::hh_mm_ss const clock{time - day};
    char text[48];
    std::snprintf(text, sizeof text, "%04d-%02u-%02uT%02d:%02d:%02d.%06dZ", static_cast<int>(date.year()),
                  static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()),
                  static_cast<int>(clock.hours().count()), static_cast<int>(clock.minutes().count()),
                  static_cast<int>(clock.seconds().count()), static_cast<int>(clock.subseconds().count()));
    return text;
}

} // namespace host
