// The sibling is convert_posix.cpp. Conversions by the system's code pages.

#include "basis/text/convert_impl.h"

#include "basis/platform/windows_api_win.h"

namespace ZOR_Basis::ConvertImpl {
namespace {

UINT pageOf(Convert::Encoding encoding) {
    switch (encoding) {
    case Convert::ENC_UTF8:
        return CP_UTF8;
    case Convert::ENC_LOCAL:
        return GetACP();
    default:
        return GetOEMCP();
    }
}

UINT pageToWide(Convert::Encoding encoding) {
    switch (encoding) {
    case Convert::ENC_UTF8:
        return CP_UTF8;
    case Convert::ENC_LOCAL:
        return CP_ACP;
    default:
        return CP_OEMCP;
    }
}

UINT pageFromWide(Convert::Encoding encoding) {
    return encoding == Convert::ENC_OEM ? static_cast<UINT>(CP_OEMCP) : pageOf(encoding);
}

int asLimit(std::uint64_t capacity) { return capacity < 0x7FFFFFFF ? static_cast<int>(capacity) : 0x7FFFFFFF; }

} // namespace

bool samePage(Convert::Encoding a, Convert::Encoding b) { return pageOf(a) == pageOf(b); }

bool narrowToWide(Convert::Encoding from, char const* text, std::uint64_t size, WBStr& out) {
    UINT const page = pageToWide(from);
    int const length = static_cast<int>(size);
    int const needed = MultiByteToWideChar(page, MB_ERR_INVALID_CHARS, text, length, nullptr, 0);
    if (needed < 1) return false;
    out.extendBuf(static_cast<std::uint64_t>(needed) + 1);
    int const written =
        MultiByteToWideChar(page, MB_ERR_INVALID_CHARS, text, length, out.getBuf(), asLimit(out.sizeBuf()));
    out.setSize(static_cast<std::uint64_t>(written));
    return written > 0;
}

bool wideToNarrow(WChar const* text, std::uint64_t size, Convert::Encoding to, BufStr<255>& out) {
    UINT const page = pageFromWide(to);
    int const length = static_cast<int>(size);
    int const needed = WideCharToMultiByte(page, 0, text, length, nullptr, 0, nullptr, nullptr);
    if (needed == 0) return false;
    out.extendBuf(static_cast<std::uint64_t>(needed) + 1);
    int const written =
        WideCharToMultiByte(page, 0, text, length, out.getBuf(), asLimit(out.sizeBuf()), nullptr, nullptr);
    // kept convert-01: `resize` measures up to the first zero, so that the size is that of the text as C sees it.
    out.resize(static_cast<std::uint64_t>(written));
    return written > 0;
}

} // namespace ZOR_Basis::ConvertImpl
