// The sibling is convert_win.cpp. Conversions by our own UTF-8 and by the locale's character set.

#include "basis/text/convert_impl.h"

#include "basis/text/charset_posix.h"
#include "basis/text/utf.h"

namespace ZOR_Basis::ConvertImpl {
namespace {

bool isUtf8(Convert::Encoding encoding) { return encoding == Convert::ENC_UTF8 || Charset::isUtf8(Charset::local()); }

/// A result of so many bytes or units needs one more in the output's capacity.
template <class Out>
std::uint64_t roomIn(Out const& out) {
    return out.sizeBuf() - 1;
}

/// \return the units, or INVALID: then the output keeps its capacity
std::uint64_t utf8ToGrownWide(char const* text, std::uint64_t size, WBStr& out) {
    std::uint64_t const units = Utf::utf16Length(text, size);
    if (units == Utf::INVALID) return units;
    out.extendBuf(units + 1);
    Utf::validToUtf16(text, size, out.getBuf(), out.sizeBuf());
    return units;
}

bool utf8ToWide(char const* text, std::uint64_t size, WBStr& out) {
    constexpr std::uint64_t MOST_BYTES_OF_A_UNIT = 3;
    // Most results fit into what is there, and nothing is counted.
    bool const mayFit = size / MOST_BYTES_OF_A_UNIT <= roomIn(out);
    std::uint64_t units = mayFit ? Utf::toUtf16(text, size, out.getBuf(), roomIn(out)) : Utf::NO_ROOM;
    if (units == Utf::NO_ROOM) units = utf8ToGrownWide(text, size, out);
    out.setSize(units != Utf::INVALID ? units : 0);
    return units != Utf::INVALID;
}

/// Converts the rest of a text in more room.
Utf::Utf8Result convertRest(WChar const* text, std::uint64_t size, Utf::Utf8Result front, BufStr<255>& out) {
    if (front.hasZero) front = {}; // growing keeps a text only up to a zero
    WChar const* const rest = text + front.units;
    out.setSize(front.bytes);
    out.extendBuf(front.bytes + Utf::utf8Length(rest, size - front.units) + 1);
    Utf::Utf8Result const back =
        Utf::toUtf8(rest, size - front.units, out.getBuf() + front.bytes, out.sizeBuf() - front.bytes);
    return {size, front.bytes + back.bytes, back.hasZero};
}

bool wideToUtf8(WChar const* text, std::uint64_t size, BufStr<255>& out) {
    Utf::Utf8Result done{};
    if (size <= roomIn(out)) done = Utf::toUtf8(text, size, out.getBuf(), roomIn(out));
    if (done.units != size) done = convertRest(text, size, done, out);
    if (done.hasZero) {
        // kept convert-01: `resize` measures up to the first zero, so that the size is that of the text as C sees it.
        out.resize(done.bytes);
    } else {
        out.getBuf()[out.sizeBuf()] = '\0';
        out.setSize(done.bytes);
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
