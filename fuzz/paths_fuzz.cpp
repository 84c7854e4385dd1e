// Any two texts as paths, narrow and wide: normalising keeps to its form, splitting loses nothing, matching is what the
// rule says.

#include "fuzz/target.h"

#include "basis/ground/wildcard.h"
#include "tests/support/reference_wildcard.h"

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>

#include <algorithm>
#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::size_t LONGEST_FOR_MATCHING = 24;

std::basic_string<WChar> wide(std::string const& text) {
    std::basic_string<WChar> units;
    for (char c : text) units.push_back(static_cast<unsigned char>(c));
    return units;
}

bool same(FPath const& narrow, WcPath const& widePath) {
    if (narrow.size() != widePath.size()) return false;
    for (std::uint64_t i = 0; i < narrow.size(); ++i) {
        if (widePath.wstr()[i] != static_cast<unsigned char>(narrow.c_str()[i])) return false;
    }
    return true;
}

/// Every run of slashes is one "/", but the first may be two.
void requireNormalised(std::string const& source, FPath const& path, bool url) {
    std::string const text(path.c_str(), path.size());
    require(text.find('\\') == std::string::npos);
    std::size_t const first = text.find('/');
    std::size_t const doubled = text.find("//");
    require(doubled == std::string::npos || (doubled == first && text.compare(doubled, 3, "///") != 0));
    require(text.find("//", doubled == std::string::npos ? doubled : doubled + 2) == std::string::npos);
    if (url) require(first == doubled);
    std::string rest = source;
    std::string kept = text;
    rest.erase(std::remove_if(rest.begin(), rest.end(), isAnySlash), rest.end());
    kept.erase(std::remove_if(kept.begin(), kept.end(), isAnySlash), kept.end());
    require(rest == kept);
    FPath again;
    again.normalize(path.c_str(), url);
    require(std::strcmp(again.c_str(), path.c_str()) == 0);
}

void requireSplit(std::string const& text) {
    FPath directory("before");
    FPath name("before");
    FPath const path(text);
    path.split(directory, name);
    std::size_t const slash = text.find_last_of("/\\");
    if (slash == std::string::npos) {
        require(directory.empty() && text == name.c_str());
    } else {
        require(text.substr(slash + 1) == name.c_str());
        require((slash != 0 ? text.substr(0, slash) : text) == directory.c_str());
    }
    require(path.offsetName() == (slash == std::string::npos ? 0 : slash + 1));
}

void runPaths(unsigned char const* data, std::size_t size) {
    if (size == 0) return;
    std::string const all(reinterpret_cast<char const*>(data), size);
    std::size_t const cut = all.find('\0');
    std::string const text = all.substr(0, cut);
    std::string const other = cut != std::string::npos ? std::string(all.c_str() + cut + 1) : std::string();

    auto const wideText = wide(text);
    for (bool url : {false, true}) {
        FPath path("before");
        path.normalize(text.c_str(), url);
        requireNormalised(text, path, url);
        WcPath widePath;
        widePath.normalize(wideText.c_str(), url);
        require(same(path, widePath));
    }
    requireSplit(text);
    require(FPath::isSub(text.c_str(), text.c_str()));
    require(FPath::isSub((text + "/" + other).c_str(), text.c_str()));
    require(FPath::isAbsolute(text.c_str()) == WcPath::isAbsolute(wideText.c_str()));
    require(FPath::isURL(text.c_str()) == WcPath::isURL(wideText.c_str()));

    bool const matched = FPath::matchWildCard(text.c_str(), other.c_str());
    if (text.size() <= LONGEST_FOR_MATCHING && other.size() <= LONGEST_FOR_MATCHING) {
        require(matched == literally<ExactCase>(text.c_str(), other.c_str()));
    }
    auto const wideOther = wide(other);
    require(matched == WcPath::matchWildCard(wideText.c_str(), wideOther.c_str()));
}

FuzzTarget const PATHS("paths", runPaths);

} // namespace
