// Any two texts, separated by the first zero, as pattern and name: the linear match gives what trying all possibilities
// gives, in both cases, narrow and wide.

#include "fuzz/target.h"

#include "basis/ground/wildcard.h"
#include "tests/support/reference_wildcard.h"

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>

#include <algorithm>
#include <string>

using namespace ZOR_Basis;

namespace {

/// Trying all possibilities takes a time that grows with the length to the power of the stars.
constexpr std::size_t LONGEST_MATCHED = 40;
constexpr std::ptrdiff_t MOST_STARS = 5;

std::basic_string<WChar> wideText(std::string const& text) {
    std::basic_string<WChar> units;
    for (char const c : text) units.push_back(static_cast<unsigned char>(c));
    return units;
}

void runWildcard(unsigned char const* data, std::size_t size) {
    std::string const all(reinterpret_cast<char const*>(data), std::min(size, 2 * LONGEST_MATCHED));
    std::string const pattern = all.c_str();
    std::string const name = pattern.size() < all.size() ? all.c_str() + pattern.size() + 1 : "";
    bool const matched = FPath::matchWildCard(pattern.c_str(), name.c_str());
    require(matched == matchesWildcard(pattern.c_str(), name.c_str()));
    require(matched == WcPath::matchWildCard(wideText(pattern).c_str(), wideText(name).c_str()));
    if (std::count(pattern.begin(), pattern.end(), '*') > MOST_STARS) return;
    require(matched == literally<ExactCase>(pattern.c_str(), name.c_str()));
    require(matchesWildcard<AnyCase>(pattern.c_str(), name.c_str()) ==
            literally<AnyCase>(pattern.c_str(), name.c_str()));
}

FuzzTarget const WILDCARD("wildcard", runWildcard);

} // namespace
