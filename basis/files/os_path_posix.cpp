// Converts names of the file system to wide text and back. Windows has wide names of its own.

#include "basis/files/os_path_posix.h"

#include "basis/text/utf.h"

namespace ZOR_Basis {
namespace {

constexpr std::uint32_t FIRST_STRAY = 0xDC80;
constexpr std::uint32_t LAST_STRAY = 0xDCFF;
constexpr std::uint64_t LONGEST_CHARACTER = 4;

bool isStray(std::uint32_t unit) { return unit >= FIRST_STRAY && unit <= LAST_STRAY; }

/// The bytes of the valid character at the front of a text, 0 if it does not begin with one.
std::uint64_t characterLength(char const* text, std::uint64_t left) {
    WChar units[2];
    for (std::uint64_t bytes = 1; bytes <= LONGEST_CHARACTER && bytes <= left; ++bytes) {
        if (Utf::toUtf16(text, bytes, units, 2) != Utf::INVALID) return bytes;
    }
    return 0;
}

void addWide(WBStr& out, char const* text, std::uint64_t length) {
    if (length == 0) return;
    std::uint64_t const start = out.size();
    std::uint64_t const units = Utf::utf16Length(text, length);
    out.extendBuf(start + units);
    out.setSize(start + Utf::toUtf16(text, length, out.getBuf() + start, units));
}

} // namespace

void wideName(char const* name, WBStr& out) {
    out.clear();
    std::uint64_t const length = detail::textLength(name);
    std::uint64_t valid = 0;
    std::uint64_t at = 0;
    while (at < length) {
        std::uint64_t const bytes = characterLength(name + at, length - at);
        if (bytes == 0) {
            addWide(out, name + valid, at - valid);
            out += static_cast<WChar>(0xDC00 + static_cast<unsigned char>(name[at]));
            valid = at + 1;
        }
        at += bytes != 0 ? bytes : 1;
    }
    addWide(out, name + valid, length - valid);
}

void narrowName(WChar const* name, BufStr<255>& out) {
    out.clear();
    if (name == nullptr) return;
    while (*name != 0) {
        // A stray byte's unit is a low surrogate, so one behind a high surrogate belongs to a pair.
        WChar const* run = name;
        while (*run != 0 && !isStray(*run)) run += Utf::isHighSurrogate(run[0]) && Utf::isLowSurrogate(run[1]) ? 2 : 1;
        std::uint64_t const units = static_cast<std::uint64_t>(run - name);
        std::uint64_t const start = out.size();
        std::uint64_t const bytes = Utf::utf8Length(name, units);
        out.extendBuf(start + bytes + 1);
        Utf::toUtf8(name, units, out.getBuf() + start, bytes);
        std::uint64_t const end = start + bytes;
        out.getBuf()[end] = static_cast<char>(*run != 0 ? *run - 0xDC00 : 0);
        out.resize(end + (*run != 0 ? 1 : 0));
        name = *run != 0 ? run + 1 : run;
    }
}

} // namespace ZOR_Basis
