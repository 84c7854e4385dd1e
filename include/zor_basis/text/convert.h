/// \file
/// Conversions between the three narrow encodings and wide text.
///
/// Declares `Convert`, a class of static functions. Narrow results go into a `BufStr<255>`, wide ones into a `WBStr`;
/// both grow as needed, so no result is ever truncated.
///
///     WBStr wide;
///     if (!Convert::Utf8ToWide("caf\xC3\xA9", wide)) report("not UTF-8");
///
/// **Encodings.** On Windows the local encoding is the system's ANSI code page and the OEM encoding that of the
/// console; 65001 is UTF-8. On Linux both are the character set of the environment's locale (`LC_ALL`, `LC_CTYPE`,
/// `LANG`, in this order), read at the first conversion; later calls of `setlocale` have no effect.
///
/// **Sources.** Each function takes a view, or a pointer with a length. A length of 0, also that of a view, means "up
/// to the terminator"; with any other length a zero is an ordinary character. A null pointer is an empty source. A
/// source of more than 2,147,483,647 bytes or units cannot be converted.
///
/// **What cannot be converted.** A narrow source must be valid in its encoding: an overlong form, a surrogate or a
/// value above U+10FFFF is not valid UTF-8. A wide source always converts: an unpaired surrogate becomes U+FFFD, and a
/// character that the target encoding lacks becomes its default character, usually "?" (Windows may choose a similar
/// letter).
///
/// \pre the output is neither the source nor a part of it
/// \thread thread-safe, as long as no two threads share an output
/// \cost a block is allocated only if the result does not fit the output's capacity, and then has exactly the required
///     size

#ifndef ZOR_BASIS_TEXT_CONVERT_H
#define ZOR_BASIS_TEXT_CONVERT_H

#include "zor_basis/export.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/str.h"
#include "zor_basis/text/wb_str.h"
#include "zor_basis/text/wstr.h"
#include "zor_basis/wide_char.h"

#include <cstdint>

namespace ZOR_Basis {

/// The conversions; there are no objects of this class.
class ZB_API Convert {
public:
    /// A narrow encoding. Other values are refused, or copied through by `EncodeMB` and `ToLocal`.
    enum Encoding : std::uint32_t {
        ENC_UTF8 = 0,
        ENC_LOCAL = 1, ///< the system's ANSI code page, or the locale's character set
        ENC_OEM = 2,   ///< the console's code page, or the locale's character set
    };

    /// Replaces `out` by the wide form of a UTF-8 text.
    /// \return false, with an empty `out`, if the text is invalid; true for an empty one
    static bool Utf8ToWide(Str const& text, WBStr& out);
    static bool Utf8ToWide(char const* text, WBStr& out, std::uint64_t len = 0);

    /// Replaces `out` by the wide form of a text in the local encoding.
    /// \return false, with an empty `out`, if the text is invalid; true for an empty one
    static bool LocalToWide(Str const& text, WBStr& out);
    static bool LocalToWide(char const* text, WBStr& out, std::uint64_t len = 0);

    /// Replaces `out` by the wide form of a text in the encoding `from`.
    /// \return false, with an empty `out`, if the text is invalid or there is no such encoding; true for an empty text
    static bool ToWide(Encoding from, Str const& text, WBStr& out);
    static bool ToWide(Encoding from, char const* text, WBStr& out, std::uint64_t len = 0);

    /// Replaces `out` by the UTF-8 form of a wide text.
    /// \kept convert-01: a zero inside a given length ends the result, because the result is measured afterwards
    /// \return false, with an empty `out`, if the system fails; true for an empty text
    static bool WideToUtf8(WStr const& text, BufStr<255>& out);
    static bool WideToUtf8(WChar const* text, BufStr<255>& out, std::uint64_t len = 0);

    /// Replaces `out` by the form of a wide text in the local encoding. A zero inside ends the result.
    /// \return false, with an empty `out`, if the system fails; true for an empty text
    static bool WideToLocal(WStr const& text, BufStr<255>& out);
    static bool WideToLocal(WChar const* text, BufStr<255>& out, std::uint64_t len = 0);

    /// Replaces `out` by the form of a wide text in the encoding `to`. A zero inside ends the result.
    /// \return false, with an empty `out`, if the system fails or there is no such encoding; true for an empty text
    static bool FromWide(WStr const& text, Encoding to, BufStr<255>& out);
    static bool FromWide(WChar const* text, Encoding to, BufStr<255>& out, std::uint64_t len = 0);

    /// Replaces `out` by the form of a narrow text in another narrow encoding. Never fails.
    /// \kept convert-02: text that cannot be converted, and text from or to an encoding that does not exist, is copied
    ///     unchanged, and the result is true
    /// \cost if both encodings are the same code page, the text is copied without a call of the system
    /// \return true
    static bool EncodeMB(Encoding from, Str const& text, Encoding to, BufStr<255>& out);
    static bool EncodeMB(Encoding from, char const* text, Encoding to, BufStr<255>& out, std::uint64_t len = 0);

    /// Calls `EncodeMB` with the local encoding as target.
    /// \return true
    static bool ToLocal(Encoding from, Str const& text, BufStr<255>& out);
    static bool ToLocal(Encoding from, char const* text, BufStr<255>& out, std::uint64_t len = 0);

    /// Replaces `out` by the UTF-8 form of a text in the local encoding.
    /// \return false, with an empty `out`, whichever step fails; true for an empty text
    static bool LocalToUtf8(Str const& text, BufStr<255>& out);
    static bool LocalToUtf8(char const* text, BufStr<255>& out, std::uint64_t len = 0);

    /// Replaces `out` by the local form of a UTF-8 text.
    /// \return false, with an empty `out`, whichever step fails; true for an empty text
    static bool Utf8ToLocal(Str const& text, BufStr<255>& out);
    static bool Utf8ToLocal(char const* text, BufStr<255>& out, std::uint64_t len = 0);
};

} // namespace ZOR_Basis

#endif
