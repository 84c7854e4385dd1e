#include "host/xos_url/url_text.h"

#include <algorithm>
#include <charconv>

namespace host {

namespace {

char lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

bool startsWith(std::string_view text, std::string_view start) {
    return text.size() >= start.size() && std::equal(start.begin(), start.end(), text.begin(),
                                                     [](char wanted, char given) { return lower(given) == wanted; });
}

bool needsEscape(unsigned char byte) { return byte <= 0x20 || byte >= 0x7F; }

std::optional<std::string> unescaped(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        unsigned char byte = static_cast<unsigned char>(text[i]);
        if (byte == '%') {
            std::string_view const digits = text.substr(i + 1, 2);
            auto const parsed = std::from_chars(digits.data(), digits.data() + digits.size(), byte, 16);
            if (digits.size() != 2 || parsed.ptr != digits.data() + 2) return std::nullopt;
            i += 2;
        }
        if (byte == 0) return std::nullopt;
        result += static_cast<char>(byte);
    }
    return result;
}

constexpr std::string_view FILE_SCHEME = "file:";

} // namespace

Scheme schemeOf(std::string_view url) {
    if (startsWith(url, "http://")) return Scheme::HTTP;
    if (startsWith(url, "https://")) return Scheme::HTTPS;
    return startsWith(url, FILE_SCHEME) ? Scheme::FILE : Scheme::OTHER;
}

std::string escapedUrl(std::string_view url) {
    constexpr char DIGITS[] = "0123456789ABCDEF";
    std::string result;
    for (char const c : url) {
        auto const byte = static_cast<unsigned char>(c);
        if (needsEscape(byte)) {
            result += {'%', DIGITS[byte >> 4], DIGITS[byte & 15]};
        } else {
            result += c;
        }
    }
    return result;
}

std::optional<FileUrl> parseFileUrl(std::string_view url) {
    if (!startsWith(url, FILE_SCHEME)) return std::nullopt;
    url.remove_prefix(FILE_SCHEME.size());
    url = url.substr(0, url.find_first_of("?#"));
    std::string host;
    if (url.substr(0, 2) == "//") {
        url.remove_prefix(2);
        host = url.substr(0, url.find('/'));
        url.remove_prefix(host.size());
    }
    if (url.empty() || url.front() != '/') return std::nullopt;
    std::optional<std::string> path = unescaped(url);
    if (!path.has_value()) return std::nullopt;
    return FileUrl{startsWith(host, "localhost") && host.size() == 9 ? std::string{} : host, std::move(*path)};
}

} // namespace host
