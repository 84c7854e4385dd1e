/// \file
/// `WcPath`: a wide path, the twin of `FPath` in 16-bit code units, for names beyond the local encoding.
///
/// The members do what those of `FPath` do, except where a `\kept` line says otherwise; there are no wide forms of
/// `ParseUrl`, `addDecodedUrl` and the translating constructors.
///
/// \thread  one thread at a time for each object. `pathRoot` is filled once, whichever thread asks first; an application sets
///     or clears it while no other thread uses wide paths

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
    static constexpr WChar BACK_SLASH = ZB_W('\\');
    static constexpr WChar FORW_SLASH = ZB_W('/');
    static constexpr WChar slashGood = BACK_SLASH;
    static constexpr WChar slashBad = FORW_SLASH;

    /// The root folder in wide form. Filled at the first test for a fake root from `Sys::root()`, which is UTF-8; while
    /// that cannot be converted, or is empty, this stays empty and the next test tries again. What an application puts here
    /// is the root of all wide paths from then on; once it is cleared the next test fills it again.
    static WcPath pathRoot;

    WcPath() = default;
    WcPath(WcPath const& other) = default;
    WcPath(WStr const& text) : WBStr(text) {}
    WcPath(WChar const* text, std::uint64_t len = 0) : WBStr(text, len) {}
    template <detail::Index I>
    WcPath(WChar const* text, I len) : WcPath(text, static_cast<std::uint64_t>(len)) {}
    WcPath(WStr const& a, WStr const& b) : WBStr(a) { add(b); }
    WcPath(WStr const& a, WChar const* b) : WBStr(a) { add(b); }
    WcPath(WChar const* a, WChar const* b) : WBStr(a) { add(b); }
    WcPath(WChar const* a, WStr const& b) : WBStr(a) { add(b); }

    WcPath& operator=(WcPath const& other) = default;
    WcPath& operator=(WStr const& text) { return WBStr::operator=(text), *this; }
    WcPath& operator=(WChar const* text) { return WBStr::operator=(text), *this; }

    WcPath& assign(WStr const& a, WStr const& b);
    WcPath& assign(WStr const& a, WChar const* b) { return assign(a, WStr(b)); }

    /// Appends a component, with "/" before it where the path is not empty and does not end in a slash.
    /// \kept path-07: unlike `FPath`, either kind counts as an end: "dir\" and "x" give "dir\x"
    WcPath& add(WChar const* text, std::uint64_t len = 0) {
        // kept path-07: wide paths come from the system, which ends folders in a backslash
        detail::joinPath<WBStr>(*this, text, len, size_ != 0 && !isSlash(text_[size_ - 1]));
        return *this;
    }
    WcPath& add(WStr const& text) { return add(text.wstr(), text.size()); }
    /// Appends a component of one unit; 0 is none.
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

    WcPath& addExt(WStr const& ext, bool addDot);
    WcPath& assureTermSlash();
    WcPath& remTermSlash();
    WcPath& replaceBackSlashes();
    static void replaceBackSlashes(WChar* text);
    WcPath& replaceSlashes();
    static void replaceSlashes(WChar* text);
    WcPath& normalize(WChar const* source, bool url);

    /// Puts `pathRoot` in place of a path that is a fake root.
    /// \kept path-08: unlike for `FPath`, the whole path is compared: "/scsi0" becomes the root while "/scsi0/tmp" stays;
    ///       and a path that equals `pathRoot` counts as fake, so that its first six characters, or all that it has, make
    ///       place for the root
    WcPath& translateRoot();
    WcPath& translateRoot(WStr const& text) { return translateRoot(text.wstr(), text.size()); }
    WcPath& translateRoot(WChar const* text, std::uint64_t len = 0);

    /// Becomes the network path of a "file" URL, with its percent escapes decoded as `FPath::addDecodedUrl` does; each
    /// escape gives one code unit.
    bool ConvertFileURLtoUNC(WChar const* url);
    bool ConvertFileURLtoUNC(WStr const& url);

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
    /// Is, as a whole, a slash and a fake root, or equals `pathRoot` and begins with a slash.
    bool isFake() const { return isFake(text_); }
    static bool isFake(WChar const* text);
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
