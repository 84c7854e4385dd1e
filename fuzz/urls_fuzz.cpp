// Any text without zeros as a URL and as text with percent escapes.

#include "fuzz/target.h"

#include <zor_basis/files/f_path.h>
#include <zor_basis/flat.h>

#include <algorithm>
#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

// The undecoded rest is appended before each escape that follows another: the result grows with the square.
constexpr std::size_t LONGEST_URL = 300;

int digit(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

std::string decoded(std::string const& text) {
    std::string out;
    std::size_t literal = 0;
    for (std::size_t i = 0; i < text.size();) {
        bool const escape = text[i] == '%' && i + 2 < text.size() && digit(text[i + 1]) >= 0 && digit(text[i + 2]) >= 0;
        if (!escape) {
            ++i;
            continue;
        }
        // A run of no characters stands for everything up to the end.
        out += i > literal ? text.substr(literal, i - literal) : text.substr(literal);
        int const byte = digit(text[i + 1]) * 16 + digit(text[i + 2]);
        if (byte != 0) out.push_back(static_cast<char>(byte));
        literal = i += 3;
    }
    return out + text.substr(literal);
}

/// The plain function, which takes the two characters behind every "%", so that there have to be two.
void requireEscapes(std::string text) {
    std::string expected;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '%') {
            expected += text[i];
            continue;
        }
        text.resize(std::max(text.size(), i + 3), '4');
        expected += static_cast<char>(std::max(0, digit(text[i + 1])) * 16 + std::max(0, digit(text[i + 2])));
        i += 2;
    }
    std::string out(text.size() + 1, '#');
    ZB_resolveURIEscapes(text.c_str(), out.data());
    require(out.compare(0, expected.size() + 1, expected.c_str(), expected.size() + 1) == 0);
    // In place; the terminator is then part of the text or the text's own.
    ZB_resolveURIEscapes(text.data(), text.data());
    require(text.compare(0, expected.size(), expected) == 0 && text.c_str()[expected.size()] == '\0');
}

void requireParts(std::string const& url) {
    BufStr<255> scheme("-");
    BufStr<255> user("-");
    BufStr<255> password("-");
    FPath path("-");
    bool const isUrl = FPath::ParseUrl(Str(url), &scheme, &path, &user, &password);
    std::size_t const end = url.find("://");
    require(isUrl == (end != std::string::npos));
    require(FPath::ParseUrl(Str(url), nullptr, nullptr, nullptr, nullptr) == isUrl);
    if (!isUrl) {
        require(scheme == Str("-") && user == Str("-") && password == Str("-") && path == Str("-"));
        return;
    }
    require(url.substr(0, end) == scheme.c_str());
    std::size_t const at = url.rfind('@');
    bool const hasUser = at != std::string::npos && at >= end + 3;
    require(url.substr(hasUser ? at + 1 : end + 3) == path.c_str());
    if (!hasUser) {
        require(user == Str("-") && password == Str("-"));
        return;
    }
    std::size_t const colon = url.find(':', end + 3);
    bool const hasPassword = colon != std::string::npos && colon < at;
    require(url.substr(end + 3, (hasPassword ? colon : at) - end - 3) == user.c_str());
    require((hasPassword ? url.substr(colon + 1, at - colon - 1) : "-") == password.c_str());
}

void runUrls(unsigned char const* data, std::size_t size) {
    std::string text(reinterpret_cast<char const*>(data), std::min(size, LONGEST_URL));
    text.resize(std::strlen(text.c_str()));
    if (text.empty()) return;
    FPath path("dir");
    path.addDecodedUrl(Str(text));
    require("dir" + decoded(text) == path.c_str());
    requireParts(text);
    requireEscapes(text);
    FPath share("before");
    if (FPath(text).isURL() && share.ConvertFileURLtoUNC(text.c_str())) {
        require(share.size() >= 2 && std::strncmp(share.c_str(), "//", 2) == 0);
    }
}

FuzzTarget const URLS("urls", runUrls);

} // namespace
