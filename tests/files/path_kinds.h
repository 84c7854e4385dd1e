/// \file
/// Narrow and wide paths for typed suites. Where the two differ, a table has a column for each.

#ifndef TESTS_FILES_PATH_KINDS_H
#define TESTS_FILES_PATH_KINDS_H

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>

#include <gtest/gtest.h>

#include <string>

struct NarrowPath {
    using Path = ZOR_Basis::FPath;
    using View = ZOR_Basis::Str;
    using Char = char;
    using Text = std::string;
    static constexpr bool IS_WIDE = false;
    static Char const* text(Path const& path) { return path.c_str(); }
};

struct WidePath {
    using Path = ZOR_Basis::WcPath;
    using View = ZOR_Basis::WStr;
    using Char = ZOR_Basis::WChar;
    using Text = std::basic_string<ZOR_Basis::WChar>;
    static constexpr bool IS_WIDE = true;
    static Char const* text(Path const& path) { return path.wstr(); }
};

template <class Kind>
class PathOfKind : public testing::Test {
public:
    /// The tables are ASCII.
    static typename Kind::Text t(std::string const& text) { return {text.begin(), text.end()}; }
    static typename Kind::Path p(std::string const& text) {
        auto const own = t(text);
        return typename Kind::View(own);
    }
    static std::string plain(typename Kind::Path const& path) {
        std::string text;
        for (std::uint64_t i = 0; i < path.size(); ++i) text.push_back(static_cast<char>(Kind::text(path)[i]));
        EXPECT_EQ(Kind::text(path)[path.size()], 0) << "terminated";
        return text;
    }
};

using PathKinds = testing::Types<NarrowPath, WidePath>;

#endif
