/// \file
/// `WcPath`: a path as wide text, the counterpart of `FPath` in 16-bit code units, for names that the local encoding
/// lacks.
///
/// The members behave like those of `FPath` unless a `\kept` line says otherwise. `ParseUrl`, `addDecodedUrl` and the
/// translating constructors have no wide form.
///
/// \thread one thread at a time for each object. `pathRoot` is filled once, whichever thread asks first; an application
///     may set or clear it only while no other thread uses wide paths

#ifndef ZOR_BASIS_FILES_WC_PATH_H
#define ZOR_BASIS_FILES_WC_PATH_H

#include "zor_basis/export.h"
#include "zor_basis/files/path_join.h"
#include "zor_basis/text/wb_str.h"
#include "zor_basis/text/wstr.h"

#include <concepts>
#include <cstdint>
#include <functional>

namespace ZOR_Basis {

#if defined(__GNUC__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor" // as for a WBStr
#endif

class ZB_API WcPath : public WBStr {
public:
    /// As in `FPath`: the two kinds of slash, the Windows separator and the other one.
    static constexpr WChar BACK_SLASH = ZB_W('\\');
    static constexpr WChar FORW_SLASH = ZB_W('/');
    static constexpr WChar slashGood = BACK_SLASH;
    static constexpr WChar slashBad = FORW_SLASH;

    /// The root folder in wide form. The first test for a fake root fills it from `Sys::root()`, which is UTF-8; while
    /// that is empty or cannot be converted, this stays empty and the next test tries again. An application may assign
    /// another root, which then holds for all wide paths; if it clears the root, the next test fills it again.
    static WcPath pathRoot;

    WcPath() = default;
    WcPath(WcPath const& other) = default;
    /// Copy a text, or join two by `add`; nothing is normalised or translated.
    WcPath(WStr const& text) : WBStr(text) {}
    WcPath(WChar const* text, std::uint64_t len = 0) : WBStr(text, len) {}
    template <detail::Index I>
    WcPath(WChar const* text, I len) : WcPath(text, static_cast<std::uint64_t>(len)) {}
    WcPath(WStr const& a, WStr const& b) : WBStr(a) { add(b); }
    WcPath(WStr const& a, WChar const* b) : WBStr(a) { add(b); }
    WcPath(WChar const* a, WChar const* b) : WBStr(a) { add(b); }
    WcPath(WChar const* a, WStr const& b) : WBStr(a) { add(b); }

    WcPath& operator=(WcPath const& other) = default;
    /// Assigns a copy, as to any `WBStr`.
    WcPath& operator=(WStr const& text) { return WBStr::operator=(text), *this; }
    WcPath& operator=(WChar const* text) { return WBStr::operator=(text), *this; }

    /// Assigns two texts joined by `add`.
    WcPath& assign(WStr const& a, WStr const& b);
    WcPath& assign(WStr const& a, WChar const* b) { return assign(a, WStr(b)); }

    /// Appends a component, with "/" before it unless the path is empty or ends in a slash.
    /// \kept path-07: unlike in `FPath`, either kind of slash counts as a separator: "dir\" and "x" give "dir\x"
    WcPath& add(WChar const* text, std::uint64_t len = 0) {
        // kept path-07: wide paths come from the system, which ends folders in a backslash
        detail::joinPath<WBStr>(*this, text, len, size_ != 0 && !isSlash(text_[size_ - 1]));
        return *this;
    }
    WcPath& add(WStr const& text) { return add(text.wstr(), text.size()); }
    /// Appends a component of one code unit; 0 appends nothing.
    template <std::same_as<WChar> C>
    WcPath& add(C c) {
        return add(&c, 1);
    }
    WcPath& operator+=(WChar const* text) { return add(text); }
    WcPath& operator+=(WStr const& text) { return add(text); }
    template <std::same_as<WChar> C>
    WcPath& operator+=(C c) {
        return add(c);
    }

    /// As in `FPath`, in code units.
    WcPath& addExt(WStr const& ext, bool addDot);
    WcPath& assureTermSlash();
    WcPath& remTermSlash();
    WcPath& replaceBackSlashes();
    static void replaceBackSlashes(WChar* text);
    WcPath& replaceSlashes();
    static void replaceSlashes(WChar* text);
    WcPath& normalize(WChar const* source, bool url);

    /// Replaces a path that is a fake root by `pathRoot`.
    /// \kept path-08: unlike in `FPath`, the whole path is compared: "/scsi0" becomes the root, "/scsi0/tmp" does not
    ///     change. A path that equals `pathRoot` counts as fake, so its first six characters, or all if it has fewer,
    ///     are replaced by the root
    WcPath& translateRoot();
    WcPath& translateRoot(WStr const& text) { return translateRoot(text.wstr(), text.size()); }
    WcPath& translateRoot(WChar const* text, std::uint64_t len = 0);

    /// Assigns the network path of a "file" URL, with its percent escapes decoded like `FPath::addDecodedUrl`; each
    /// escape gives one code unit.
    bool ConvertFileURLtoUNC(WChar const* url);
    bool ConvertFileURLtoUNC(WStr const& url);

    /// As in `FPath`: questions about a character, the path or a text.
    static bool isSlash(WChar c) { return c == BACK_SLASH || c == FORW_SLASH; }
    template <detail::Index I>
    requires(!std::same_as<I, WChar>) bool isSlash(I index) const {
        auto const i = static_cast<std::uint64_t>(index);
        return i < size_ && isSlash(text_[i]);
    }
    bool isAbsolute() const { return isAbsolute(text_); }
    static bool isAbsolute(WChar const* text);
    bool isDos() const { return isDos(text_); }
    static bool isDos(WChar const* text);
    bool isURL() const { return isURL(text_); }
    static bool isURL(WChar const* text);
    /// Tells whether the whole path is a slash and a fake root, or equals `pathRoot` and begins with a slash.
    bool isFake() const { return isFake(text_); }
    static bool isFake(WChar const* text);
    /// As in `FPath`.
    bool isWildCard() const { return isWildCard(text_); }
    static bool isWildCard(WChar const* text);
    bool matchWildCard(WChar const* pattern) const { return matchWildCard(pattern, text_); }
    static bool matchWildCard(WChar const* pattern, WChar const* name);
    bool isSub(WChar const* other) const { return isSub(other, text_); }
    static bool isSub(WChar const* path, WChar const* dir);
    std::uint64_t offsetName() const { return offsetName(text_, size_); }
    static std::uint64_t offsetName(WChar const* text, std::uint64_t len = 0);
    void split(WcPath& dir, WcPath& name) const { split(text_, dir, name, size_); }
    static void split(WChar const* text, WcPath& dir, WcPath& name, std::uint64_t len = 0);
};

#if defined(__GNUC__)
#pragma GCC diagnostic pop
#endif

static_assert(sizeof(WcPath) == sizeof(WBStr));

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::WcPath> : std::hash<ZOR_Basis::WBStr> {};

#endif
