#include "basis/files/root_folder.h"

#include "basis/files/path_rules.h"
#include "basis/files/root_folder_impl.h"
#include "basis/memory/never_destroyed.h"
#include "basis/platform/xos_basics.h"

#include <atomic>
#include <cstring>
#include <mutex>

namespace ZOR_Basis::RootFolder {
namespace {

constexpr std::uint64_t FIRST_ROOM = 512;
constexpr char SYSTEM[] = "system";

std::atomic<Root const*> kept{nullptr};
std::uint64_t room = FIRST_ROOM; // used by the asking thread only

/// The root before it is known. It is not a static object because it must outlive every caller.
Root const& unknown(bool isFileSystem) {
    static Root const* const roots = new Root[2]{{{}, false}, {{}, true}};
    return roots[isFileSystem ? 1 : 0];
}

Root fromCurrentFolder() {
    BufStr<255> folder;
    folder.extendBuf(room);
    if (currentFolder(folder.getBuf(), room)) return fromFolder(folder.c_str());
    // kept root-01: a folder that needs more room is found by the next call, not by this one.
    room *= 2;
    return {};
}

Root find() {
    char const* const configured = xos_FileSystemRoot();
    return !detail::isNothing(configured) ? fromFolder(configured) : fromCurrentFolder();
}

} // namespace

Root fromFolder(char const* folder) {
    Root root{folder, false};
    BufStr<255>& text = root.text;
    if (!text.empty() && PathRules::isSlash(text.last())) text.cut();
    std::uint64_t const name = PathRules::offsetName(text.c_str(), text.size());
    if (std::strcmp(text.c_str() + name, SYSTEM) == 0) text.cut(name != 0 ? name - 1 : 0);
    PathRules::replaceAll(text.getBuf(), '\\', '/');
    root.isFileSystem = HAS_ONE_FILE_SYSTEM && text.empty() && PathRules::isSlash(*folder);
    return root;
}

Root const& get() {
    if (Root const* const known = kept.load(std::memory_order_acquire)) return *known;
    // One thread asks; the others wait for its answer.
    static NeverDestroyed<std::mutex> asking;
    std::lock_guard const one(*asking);
    if (Root const* const known = kept.load(std::memory_order_relaxed)) return *known;
    Root const found = find();
    if (found.text.empty()) return unknown(found.isFileSystem);
    Root const* const known = new Root(found);
    kept.store(known, std::memory_order_release);
    return *known;
}

} // namespace ZOR_Basis::RootFolder
