#include "zor_basis/text/convert.h"

#include "basis/text/convert_impl.h"

#include <string>

namespace ZOR_Basis {
namespace {

// The system counts the characters of a source in 32 bits.
constexpr std::uint64_t LONGEST_SOURCE = 0x7FFFFFFF;

bool isKnown(Convert::Encoding encoding) { return encoding <= Convert::ENC_OEM; }

template <class Char>
std::uint64_t measured(Char const* text, std::uint64_t len) {
    if (text == nullptr) return 0;
    return len != 0 ? len : std::char_traits<Char>::length(text);
}

/// The steps that all direct conversions share. `step(len)` converts a source that is not empty.
template <class Char, class Out, class Step>
bool convert(Char const* text, std::uint64_t len, Out& out, Step step) {
    out.clear();
    len = measured(text, len);
    if (len == 0) return true;
    return len <= LONGEST_SOURCE && step(len);
}

bool toWide(Convert::Encoding from, char const* text, WBStr& out, std::uint64_t len) {
    return convert(text, len, out,
                   [&](std::uint64_t size) { return ConvertImpl::narrowToWide(from, text, size, out); });
}

bool fromWide(WChar const* text, Convert::Encoding to, BufStr<255>& out, std::uint64_t len) {
    return convert(text, len, out, [&](std::uint64_t size) { return ConvertImpl::wideToNarrow(text, size, to, out); });
}

/// Converts narrow text to narrow text through wide text. Leaves `out` empty if either step fails.
bool reencode(Convert::Encoding from, char const* text, Convert::Encoding to, BufStr<255>& out, std::uint64_t len) {
    WBStr wide;
    out.clear();
    return toWide(from, text, wide, len) && fromWide(wide.wstr(), to, out, wide.size());
}

} // namespace

bool Convert::Utf8ToWide(Str const& text, WBStr& out) { return Utf8ToWide(text.c_str(), out, text.size()); }
bool Convert::Utf8ToWide(char const* text, WBStr& out, std::uint64_t len) { return toWide(ENC_UTF8, text, out, len); }

bool Convert::LocalToWide(Str const& text, WBStr& out) { return LocalToWide(text.c_str(), out, text.size()); }
bool Convert::LocalToWide(char const* text, WBStr& out, std::uint64_t len) { return toWide(ENC_LOCAL, text, out, len); }

bool Convert::ToWide(Encoding from, Str const& text, WBStr& out) {
    return ToWide(from, text.c_str(), out, text.size());
}
bool Convert::ToWide(Encoding from, char const* text, WBStr& out, std::uint64_t len) {
    if (isKnown(from)) return toWide(from, text, out, len);
    out.clear();
    return false;
}

bool Convert::WideToUtf8(WStr const& text, BufStr<255>& out) { return WideToUtf8(text.wstr(), out, text.size()); }
bool Convert::WideToUtf8(WChar const* text, BufStr<255>& out, std::uint64_t len) {
    return fromWide(text, ENC_UTF8, out, len);
}

bool Convert::WideToLocal(WStr const& text, BufStr<255>& out) { return WideToLocal(text.wstr(), out, text.size()); }
bool Convert::WideToLocal(WChar const* text, BufStr<255>& out, std::uint64_t len) {
    return fromWide(text, ENC_LOCAL, out, len);
}

bool Convert::FromWide(WStr const& text, Encoding to, BufStr<255>& out) {
    return FromWide(text.wstr(), to, out, text.size());
}
bool Convert::FromWide(WChar const* text, Encoding to, BufStr<255>& out, std::uint64_t len) {
    if (isKnown(to)) return fromWide(text, to, out, len);
    out.clear();
    return false;
}

bool Convert::EncodeMB(Encoding from, Str const& text, Encoding to, BufStr<255>& out) {
    return EncodeMB(from, text.c_str(), to, out, text.size());
}
bool Convert::EncodeMB(Encoding from, char const* text, Encoding to, BufStr<255>& out, std::uint64_t len) {
    bool const mustConvert = from != to && isKnown(from) && isKnown(to) && !ConvertImpl::samePage(from, to);
    if (mustConvert && reencode(from, text, to, out, len)) return true;
    // kept convert-02: callers hand names through here and rely on getting some text, if need be the one they gave.
    out.copy(text, len);
    return true;
}

bool Convert::ToLocal(Encoding from, Str const& text, BufStr<255>& out) { return EncodeMB(from, text, ENC_LOCAL, out); }
bool Convert::ToLocal(Encoding from, char const* text, BufStr<255>& out, std::uint64_t len) {
    return EncodeMB(from, text, ENC_LOCAL, out, len);
}

bool Convert::LocalToUtf8(Str const& text, BufStr<255>& out) { return LocalToUtf8(text.c_str(), out, text.size()); }
bool Convert::LocalToUtf8(char const* text, BufStr<255>& out, std::uint64_t len) {
    return reencode(ENC_LOCAL, text, ENC_UTF8, out, len);
}

bool Convert::Utf8ToLocal(Str const& text, BufStr<255>& out) { return Utf8ToLocal(text.c_str(), out, text.size()); }
bool Convert::Utf8ToLocal(char const* text, BufStr<255>& out, std::uint64_t len) {
    return reencode(ENC_UTF8, text, ENC_LOCAL, out, len);
}

} // namespace ZOR_Basis
