#include "zor_basis/files/f_path.h"

#include "basis/files/path_text.h"
#include "basis/files/root_folder.h"
#include "basis/files/url_rules.h"

#include <cstring>
#include <string_view>

namespace ZOR_Basis {
namespace {

using Path = PathText<NarrowPathKind>;

/// Tells whether a path already lies under the root and needs no translation. Every path begins with an unknown root's
/// empty text: nothing can be translated to it. All absolute paths lie under "/", which says nothing about fake roots.
bool isUnder(RootFolder::Root const& root, char const* text, std::uint64_t length) {
    std::uint64_t const size = root.text.size();
    return !root.isFileSystem && length >= size && std::memcmp(text, root.text.c_str(), size) == 0;
}

/// The length of the fake root at the front, the slash before it not counted; 0 without one.
std::uint64_t fakeRoot(char const* text, std::uint64_t length, RootFolder::Root const& root) {
    if (length == 0 || !PathRules::isSlash(*text) || isUnder(root, text, length)) return 0;
    for (std::uint64_t i = 0; i < PathRules::FAKE_ROOTS; ++i) {
        std::uint64_t const end = 1 + PathRules::FAKE_ROOT_LENGTH[i];
        if (length < end || std::memcmp(text + 1, PathRules::FAKE_ROOT<char>[i], end - 1) != 0) continue;
        if (length == end || text[end] == '\0' || PathRules::isSlash(text[end])) return end - 1;
    }
    return 0;
}

/// The text that replaces the root in front of the rest of a path.
Str rootBefore(RootFolder::Root const& root, char const* rest) {
    bool const alone = root.isFileSystem && *rest == '\0';
    return alone ? Str("/") : Str(root.text);
}

/// Unlike `copy`, takes a length of 0 as it stands.
void assignPart(BufStr<255>* out, std::string_view url, std::uint64_t from, std::uint64_t to) {
    if (out == nullptr) return;
    if (from == to) {
        out->clear();
    } else {
        out->copy(url.data() + from, to - from);
    }
}

} // namespace

FPath::FPath(char const* text, TranslPath) { translateRoot(text); }
FPath::FPath(Str const& text, TranslPath) { translateRoot(text); }

FPath& FPath::assign(Str const& a, Str const& b) { return Path::assign(*this, a, b); }
FPath& FPath::addExt(Str const& ext, bool addDot) { return Path::addExt(*this, ext, addDot), *this; }
FPath& FPath::assureTermSlash() { return Path::assureTermSlash(*this), *this; }
FPath& FPath::remTermSlash() { return Path::remTermSlash(*this), *this; }
FPath& FPath::replaceBackSlashes() { return replaceBackSlashes(getBuf()), *this; }
FPath& FPath::replaceSlashes() { return replaceSlashes(getBuf()), *this; }
FPath& FPath::normalize(char const* source, bool url) { return Path::normalize(*this, source, url), *this; }

void FPath::replaceBackSlashes(char* text) {
    if (text != nullptr) PathRules::replaceAll(text, BACK_SLASH, FORW_SLASH);
}
void FPath::replaceSlashes(char* text) {
    if (text != nullptr) PathRules::replaceAll(text, FORW_SLASH, BACK_SLASH);
}

FPath& FPath::translateRoot() {
    RootFolder::Root const& root = RootFolder::get();
    if (std::uint64_t const fake = fakeRoot(text_, size_, root)) {
        Str const folder = rootBefore(root, text_ + 1 + fake);
        BufStr::replace(0, 1 + fake, folder.c_str(), folder.size());
    }
    return *this;
}

FPath& FPath::translateRoot(char const* text, std::uint64_t len) {
    len = Path::lengthOf(text, len);
    if (len == 0) return clear(), *this;
    BufStr::operator=(FPath(text, len));
    return translateRoot();
}

FPath& FPath::addDecodedUrl(Str const& text) { return Path::addDecoded(*this, Path::whole(text)), *this; }

bool FPath::ConvertFileURLtoUNC(char const* url) { return ConvertFileURLtoUNC(Str(url)); }
bool FPath::ConvertFileURLtoUNC(Str const& url) { return Path::becomeUnc(*this, Path::whole(url)); }

bool FPath::isAbsolute(char const* text) { return PathRules::isAbsolute(Path::orEmpty(text)); }
bool FPath::isDos(char const* text) { return PathRules::isDos(Path::orEmpty(text)); }
bool FPath::isURL(char const* text) { return PathRules::isURL(Path::orEmpty(text)); }
bool FPath::isWildCard(char const* text) { return PathRules::isWildCard(Path::orEmpty(text)); }
bool FPath::isFake(char const* text) { return fakeRoot(text, Path::lengthOf(text, 0), RootFolder::get()) != 0; }
bool FPath::matchWildCard(char const* pattern, char const* name) { return Path::matchWildCard(pattern, name); }
bool FPath::isSub(char const* path, char const* dir) { return PathRules::isSub(path, dir); }
std::uint64_t FPath::offsetName(char const* text, std::uint64_t len) { return Path::offsetName(text, len); }
void FPath::split(char const* text, FPath& dir, FPath& name, std::uint64_t len) { Path::split(text, dir, name, len); }

bool FPath::ParseUrl(Str const& url, BufStr<255>* scheme, FPath* path, BufStr<255>* user, BufStr<255>* password) {
    std::string_view const view = Path::whole(url);
    UrlRules::Parts parts;
    if (!UrlRules::findParts(view, parts)) return false;
    assignPart(scheme, view, 0, parts.schemeEnd);
    if (parts.hasUser) assignPart(user, view, parts.user, parts.userEnd);
    if (parts.hasPassword) assignPart(password, view, parts.userEnd + 1, parts.passwordEnd);
    assignPart(path, view, parts.path, view.size());
    return true;
}

} // namespace ZOR_Basis
