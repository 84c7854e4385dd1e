#include "zor_basis/files/wc_path.h"

#include "basis/files/path_text.h"
#include "basis/files/root_folder.h"
#include "basis/memory/never_destroyed.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/text/convert.h"

#include <algorithm>
#include <atomic>
#include <mutex>

namespace ZOR_Basis {
namespace {

using Path = PathText<WidePathKind>;

/// The size of `WcPath::pathRoot`. It is written last: a thread that reads a size other than 0 may read the text.
struct RootSize : WcPath {
    static std::atomic_ref<std::uint64_t> of(WcPath& root) { return std::atomic_ref(root.*&RootSize::size_); }
};

/// Fills the public root, unless another thread has done so. Only the empty root is ever written.
void publish(WStr const& found) {
    static NeverDestroyed<std::mutex> publishing;
    std::lock_guard const lock(*publishing);
    WcPath& root = WcPath::pathRoot;
    if (!root.empty()) return;
    root.extendBuf(found.size());
    std::copy_n(found.wstr(), found.size() + 1, root.getBuf());
    RootSize::of(root).store(found.size(), std::memory_order_release);
}

/// The root in wide form; the empty text where there is none, or it cannot be converted.
WStr wideRoot() {
    if (RootSize::of(WcPath::pathRoot).load(std::memory_order_acquire) != 0) return WcPath::pathRoot;
    WcPath found;
    bool const isConverted = Convert::Utf8ToWide(RootFolder::get().text, found);
    if (!isConverted || found.empty()) return {};
    publish(found);
    return WcPath::pathRoot;
}

bool equal(WChar const* text, std::uint64_t length, WChar const* other, std::uint64_t otherLength) {
    return length == otherLength && detail::compareTextsUpTo(text, other, length) == 0;
}

/// The characters at the front that stand for the root, the slash included; 0 if none do.
std::uint64_t fakeRoot(WChar const* text, std::uint64_t length, WStr const& root) {
    constexpr std::uint64_t FIRST_WITH_SLASH = 6;
    if (length == 0 || !PathRules::isSlash(*text)) return 0;
    // kept path-08: the root itself counts as the first fake root, and nothing may follow a fake root.
    if (equal(text, length, root.wstr(), root.size())) return length < FIRST_WITH_SLASH ? length : FIRST_WITH_SLASH;
    for (std::uint64_t i = 0; i < PathRules::FAKE_ROOTS; ++i) {
        if (equal(text + 1, length - 1, PathRules::FAKE_ROOT<WChar>[i], PathRules::FAKE_ROOT_LENGTH[i])) return length;
    }
    return 0;
}

} // namespace

WcPath WcPath::pathRoot;

WcPath& WcPath::assign(WStr const& a, WStr const& b) { return Path::assign(*this, a, b); }
WcPath& WcPath::addExt(WStr const& ext, bool addDot) { return Path::addExt(*this, ext, addDot), *this; }
WcPath& WcPath::assureTermSlash() { return Path::assureTermSlash(*this), *this; }
WcPath& WcPath::remTermSlash() { return Path::remTermSlash(*this), *this; }
WcPath& WcPath::replaceBackSlashes() { return replaceBackSlashes(getBuf()), *this; }
WcPath& WcPath::replaceSlashes() { return replaceSlashes(getBuf()), *this; }
WcPath& WcPath::normalize(WChar const* source, bool url) { return Path::normalize(*this, source, url), *this; }

void WcPath::replaceBackSlashes(WChar* text) {
    if (text != nullptr) PathRules::replaceAll(text, BACK_SLASH, FORW_SLASH);
}
void WcPath::replaceSlashes(WChar* text) {
    if (text != nullptr) PathRules::replaceAll(text, FORW_SLASH, BACK_SLASH);
}

WcPath& WcPath::translateRoot() {
    WStr const root = wideRoot();
    if (std::uint64_t const fake = fakeRoot(text_, size_, root)) {
        bool const isSlash = root.empty() && RootFolder::get().isFileSystem;
        WBStr::replace(0, fake, isSlash ? WStr(ZB_W("/")) : root);
    }
    return *this;
}

WcPath& WcPath::translateRoot(WChar const* text, std::uint64_t len) {
    len = Path::lengthOf(text, len);
    if (len == 0) return clear(), *this;
    WBStr::operator=(WcPath(text, len));
    return translateRoot();
}

bool WcPath::ConvertFileURLtoUNC(WChar const* url) { return ConvertFileURLtoUNC(WStr(url)); }
bool WcPath::ConvertFileURLtoUNC(WStr const& url) { return Path::becomeUnc(*this, Path::whole(url)); }

bool WcPath::isAbsolute(WChar const* text) { return PathRules::isAbsolute(Path::orEmpty(text)); }
bool WcPath::isDos(WChar const* text) { return PathRules::isDos(Path::orEmpty(text)); }
bool WcPath::isURL(WChar const* text) { return PathRules::isURL(Path::orEmpty(text)); }
bool WcPath::isWildCard(WChar const* text) { return PathRules::isWildCard(Path::orEmpty(text)); }
bool WcPath::isFake(WChar const* text) { return fakeRoot(text, Path::lengthOf(text, 0), wideRoot()) != 0; }
bool WcPath::matchWildCard(WChar const* pattern, WChar const* name) { return Path::matchWildCard(pattern, name); }
bool WcPath::isSub(WChar const* path, WChar const* dir) { return PathRules::isSub(path, dir); }
std::uint64_t WcPath::offsetName(WChar const* text, std::uint64_t len) { return Path::offsetName(text, len); }
void WcPath::split(WChar const* text, WcPath& dir, WcPath& name, std::uint64_t len) {
    Path::split(text, dir, name, len);
}

} // namespace ZOR_Basis
