// The sibling is convert_win.cpp. Conversions by our own UTF-8 and by the locale's character set.

#include "basis/text/convert_impl.h"

#include "basis/text/charset_posix.h"
#include "basis/text/utf.h"

#include <cstring>

namespace ZOR_Basis::ConvertImpl {
namespace {

bool isUtf8(Convert::Encoding encoding) { return encoding == Convert::ENC_UTF8 || Charset::isUtf8(Charset::local()); }

/// Grows the output for a text that may still turn out to be invalid; the output keeps its capacity then.
std::uint64_t utf8ToGrownWide(char const* text, std::uint64_t size, WBStr& out) {
    WBStr whole;
    whole.extendBuf(Utf::utf16Length(text, size) + 1);
    std::uint64_t const written = Utf::toUtf16(text, size, whole.getBuf(), whole.sizeBuf());
    if (written == Utf::INVALID) return written;
    out.extendBuf(written + 1);
    std::memcpy(out.getBuf(), whole.wstr(), written * sizeof(WChar));
    return written;
}

bool utf8ToWide(char const* text, std::uint64_t size, WBStr& out) {
    // Most results fit into what is there, and nothing is counted; one unit of the capacity stays free.
    std::uint64_t written = Utf::toUtf16(text, size, out.getBuf(), out.sizeBuf() - 1);
    if (written == Utf::NO_ROOM) written = utf8ToGrownWide(text, size, out);
    out.setSize(written != Utf::INVALID ? written : 0);
    return written != Utf::INVALID;
}

bool wideToUtf8(WChar const* text, std::uint64_t size, BufStr<255>& out) {
    Utf::Utf8Text written = Utf::toUtf8(text, size, out.getBuf(), out.sizeBuf() - 1);
    if (written.size == Utf::NO_ROOM) {
        out.extendBuf(Utf::utf8Length(text, size) + 1);
        written = Utf::toUtf8(text, size, out.getBuf(), out.sizeBuf());
    }
    if (written.hasZero) {
        // kept convert-01: `resize` measures up to the first zero, so that the size is that of the text as C sees it.
        out.resize(written.size);
    } else {
        out.getBuf()[out.sizeBuf()] = '\0';
        out.setSize(written.size);
    }
    return true;
}

} // namespace

bool samePage(Convert::Encoding a, Convert::Encoding b) { return isUtf8(a) == isUtf8(b); }

bool narrowToWide(Convert::Encoding from, char const* text, std::uint64_t size, WBStr& out) {
    return isUtf8(from) ? utf8ToWide(text, size, out) : Charset::toWide(Charset::local(), text, size, out);
}

bool wideToNarrow(WChar const* text, std::uint64_t size, Convert::Encoding to, BufStr<255>& out) {
    return isUtf8(to) ? wideToUtf8(text, size, out) : Charset::fromWide(Charset::local(), text, size, out);
}

} // namespace ZOR_Basis::ConvertImpl
