#include "tools/zbtool/move.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/remove.h"
#include "tools/zbtool/staging.h"

#include "basis/platform/xos_basics.h"

#include <cstdio>
#include <span>
#include <system_error>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

/// Renames the entry. `File::Move` and `Dir::Move` copy where that fails and then remove the source even if the copy
/// failed, so they are no choice for a tool.
bool renameEntry(FPath const& source, FPath const& target, bool overwrite) {
    bool const isFolder = FStat(source, SYSTEM_ONLY).isDir();
    return (isFolder ? xos_DirMove(target, source, overwrite ? 1 : 0) : xos_FileMove(target, source, overwrite)) == 0;
}

bool moveEntry(FPath const& source, FPath const& target, bool overwrite, Progress& progress) {
    if (renameEntry(source, target, overwrite)) {
        progress.add({1, 0});
        return true;
    }
    if (!lastFailureNeedsCopy()) {
        return complain("cannot move '" + std::string(source.c_str()) + "' to '" + target.c_str() + "'");
    }
    if (!overwrite && FStat(target, SYSTEM_ONLY).exist()) return complain(target.c_str(), "exists already");
    return copyEntry(source, target, overwrite, progress) && !isInterrupted() && removeEntry(source, nullptr);
}

} // namespace

int move(CopyOptions const& options) {
    watchForInterruption(clearStaging);
    Progress progress("moving");
    std::span const sources(options.paths.begin(), options.paths.end() - 1);
    for (std::string const& source : sources) {
        FPath const destination = destinationOf(source, options.paths.back(), sources.size() == 1);
        bool const good = !destination.empty() && moveEntry(source, destination, options.overwrite, progress);
        if (isInterrupted()) endAsInterrupted();
        if (!good) return FAILED;
        Progress::hide();
        std::printf("moved %s to %s\n", source.c_str(), destination.c_str());
    }
    return DONE;
}

} // namespace zbtool
