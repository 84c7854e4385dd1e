#include "zor_basis/system/sys.h"

#include "basis/files/root_folder.h"
#include "basis/system/beneath_root.h"

namespace ZOR_Basis {
namespace {

constexpr char TEMP[] = "tmp";

} // namespace

FPath const& Sys::root() {
    RootFolder::Root const& found = RootFolder::get();
    // Never destroyed: other modules ask to the very end.
    static FPath const* const none = new FPath;
    if (found.text.empty()) return *none;
    static FPath const* const kept = new FPath(found.text);
    return *kept;
}

bool Sys::root(FPath& out) {
    out = root();
    return !out.empty();
}

FPath const& Sys::temp() {
    RootFolder::Root const& root = RootFolder::get();
    if (root.text.empty()) {
        thread_local FPath passing;
        return passing = beneathRoot(root, TEMP);
    }
    static FPath const* const kept = new FPath(beneathRoot(root, TEMP));
    return *kept;
}

} // namespace ZOR_Basis
