#include "zor_basis/flat.h"

#include "basis/files/path_rules.h"
#include "zor_basis/text/str.h"

#include <cstring>

namespace PathRules = ZOR_Basis::PathRules;

namespace {

int escapeDigit(char c) {
    int const value = ZOR_Basis::Str::hexToDigit(c);
    return value < 0 ? 0 : value;
}

} // namespace

char const* ZB_baseNamePosition(char const* text) {
    if (text == nullptr) return nullptr;
    std::uint64_t const name = PathRules::offsetName(text, std::strlen(text));
    return name != 0 ? text + name : nullptr;
}

void ZB_replaceBackSlashes(char* text) {
    if (text != nullptr) PathRules::replaceAll(text, '\\', '/');
}

void ZB_replaceBackSlashes2(char const* source, char* target) {
    for (; *source != '\0'; ++source) *target++ = *source == '\\' ? '/' : *source;
    *target = '\0';
}

int ZB_resolveURIEscapes(char const* in, char* out) {
    for (; *in != '\0'; ++in) {
        char byte = *in;
        if (byte == '%') {
            byte = static_cast<char>(16 * escapeDigit(in[1]) + escapeDigit(in[2]));
            in += 2;
        }
        *out++ = byte;
    }
    *out = '\0';
    return 0;
}
