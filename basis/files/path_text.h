/// \file
/// The members that narrow and wide paths share, on the string that each derives from. The kinds hold the differences.

#ifndef BASIS_FILES_PATH_TEXT_H
#define BASIS_FILES_PATH_TEXT_H

#include "basis/files/path_rules.h"
#include "basis/files/url_rules.h"
#include "basis/ground/wildcard.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/wb_str.h"

#include <string_view>

namespace ZOR_Basis {

struct NarrowPathKind {
    using Char = char;
    using String = BufStr<255>;
    using View = Str;
    static char const* textOf(Str const& view) { return view.c_str(); }
};

struct WidePathKind {
    using Char = WChar;
    using String = WBStr;
    using View = WStr;
    static WChar const* textOf(WStr const& view) { return view.wstr(); }
};

template <class Kind>
struct PathText {
    using Char = typename Kind::Char;
    using String = typename Kind::String;
    using View = typename Kind::View;
    using Text = detail::InlineText<String, Char, 255>;

    static Char const* orEmpty(Char const* text) { return PathRules::orEmpty(text); }

    static std::uint64_t lengthOf(Char const* text, std::uint64_t len) { return detail::sourceLength(text, len); }

    /// All of a view; a size of 0 is measured.
    static std::basic_string_view<Char> whole(View const& view) {
        Char const* const text = Kind::textOf(view);
        return {orEmpty(text), lengthOf(text, view.size())};
    }

    /// \param b  may be a part of the path
    template <class Path>
    static Path& assign(Path& path, View const& a, View const& b) {
        if (Text::holds(path, Kind::textOf(b))) {
            Path const kept(b);
            path = a;
            return path.add(kept);
        }
        path = a;
        return path.add(b);
    }

    static void addExt(String& path, View const& ext, bool addDot) {
        Char const* text = Kind::textOf(ext);
        if (Text::holds(path, text)) {
            String const kept(text, ext.size());
            addOtherExt(path, kept.operator Char const*(), kept.size(), addDot);
        } else {
            addOtherExt(path, text, lengthOf(text, ext.size()), addDot);
        }
    }

    static void assureTermSlash(String& path) {
        // kept path-02: the result ends in a slash, whatever there was before.
        if (path.empty() || !PathRules::isSlash(path.last())) path.add(BACK_SLASH, 1);
    }

    static void remTermSlash(String& path) {
        if (!path.empty() && PathRules::isSlash(path.last())) path.cut();
    }

    static void normalize(String& path, Char const* source, bool url) {
        source = orEmpty(source);
        if (Text::holds(path, source)) {
            String const kept(source);
            normalizeOther(path, kept.operator Char const*(), kept.size(), url);
        } else {
            normalizeOther(path, source, detail::textLength(source), url);
        }
    }

    static bool matchWildCard(Char const* pattern, Char const* name) {
        return matchesWildcard(orEmpty(pattern), orEmpty(name));
    }

    static std::uint64_t offsetName(Char const* text, std::uint64_t len) {
        return PathRules::offsetName(text, lengthOf(text, len));
    }

    static void split(Char const* text, String& directory, String& name, std::uint64_t len) {
        len = lengthOf(text, len);
        std::uint64_t const offset = PathRules::offsetName(text, len);
        assign(name, text + offset, len - offset);
        if (offset == 0) {
            directory.clear();
        } else {
            // kept path-05: nothing precedes a slash at the very front, and a length of 0 makes `copy` take the whole.
            directory.copy(text, offset - 1);
        }
    }

    static void addDecoded(String& path, std::basic_string_view<Char> text) {
        if (Text::holds(path, text.data())) {
            String const kept(text.data(), text.size());
            UrlRules::addDecoded(path, std::basic_string_view<Char>(kept));
        } else {
            UrlRules::addDecoded(path, text);
        }
    }

    static bool becomeUnc(String& path, std::basic_string_view<Char> url) {
        constexpr std::uint64_t SHORTEST = 8;
        UrlRules::Parts parts;
        if (url.size() < SHORTEST || !UrlRules::findParts(url, parts)) return false;
        if (!UrlRules::isFileScheme(url.substr(0, parts.schemeEnd))) return false;
        String decoded(TWO_SLASHES);
        UrlRules::addDecoded(decoded, url.substr(parts.path));
        path = decoded;
        return true;
    }

private:
    static constexpr Char TWO_SLASHES[] = {'/', '/', 0};
    static constexpr Char DOT[] = {'.', 0};
    static constexpr Char BACK_SLASH[] = {'\\', 0};

    /// Unlike `copy`, takes a length of 0 as it stands.
    static void assign(String& out, Char const* text, std::uint64_t length) {
        if (length == 0) {
            out.clear();
        } else {
            out.copy(text, length);
        }
    }

    static void addOtherExt(String& path, Char const* text, std::uint64_t length, bool addDot) {
        bool const hasDot = (!path.empty() && path.last() == DOT[0]) || (length != 0 && *text == DOT[0]);
        if (addDot && !hasDot) path.add(DOT, 1);
        if (length != 0) path.add(text, length);
    }

    static void normalizeOther(String& path, Char const* source, std::uint64_t length, bool url) {
        path.clear();
        path.extendBuf(length + 2);
        path.setSize(PathRules::normalize(source, url, path.getBuf()));
    }
};

} // namespace ZOR_Basis

#endif
