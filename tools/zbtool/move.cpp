#include "tools/zbtool/move.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/remove.h"
#include "tools/zbtool/staging.h"

#include "basis/platform/xos_basics.h"

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <span>
#include <system_error>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace zbtool {
namespace {

/// Renames the entry. `File::Move` and `Dir::Move` copy where that fails and then remove the source even if the copy
/// failed, so they are no choice for a tool.
bool renameEntry(FPath const& source, FPath const& target, bool overwrite) {
    bool const isFolder = FStat(source, SYSTEM_ONLY).isDir();
    return (isFolder ? xos_DirMove(target, source, overwrite ? 1 : 0) : xos_FileMove(target, source, overwrite)) == 0;
}

bool complainOfMove(FPath const& source, FPath const& target, std::string const& reason) {
    return complain("cannot move '" + std::string(source.c_str()) + "' to '" + target.c_str() + "'", reason);
}

/// Whether a folder contains something, or cannot be looked into.
bool isFilledFolder(FPath const& path) {
    std::error_code error;
    return FStat(path, SYSTEM_ONLY).isDir() && !fs::is_empty(path.c_str(), error);
}

bool moveEntry(FPath const& source, FPath const& target, bool overwrite, Progress& progress) {
    // A rename would first remove the folder that is there, a copy would fill it up.
    if (overwrite && isFilledFolder(target))
        return complainOfMove(source, target, std::generic_category().message(ENOTEMPTY));
    if (renameEntry(source, target, overwrite)) {
        progress.add({1, 0});
        return true;
    }
    if (!lastFailureNeedsCopy()) return complainOfMove(source, target, lastReason());
    if (!overwrite && FStat(target, SYSTEM_ONLY).exist()) return complain(target.c_str(), "exists already");
    return copyEntry(source, target, overwrite, progress) && !isInterrupted() && removeEntry(source, nullptr);
}

} // namespace

int move(CopyOptions const& options) {
    std::span const sources(options.paths.begin(), options.paths.end() - 1);
    if (!haveDistinctNames(sources)) return MISUSED;
    watchForInterruption(clearStaging);
    Progress progress("moving");
    for (std::string const& source : sources) {
        FPath const destination = destinationOf(source, options.paths.back(), sources.size() == 1);
        bool const good = !destination.empty() && moveEntry(source, destination, options.overwrite, progress);
        if (isInterrupted()) endAsInterrupted();
        if (!good) return FAILED;
        Progress::hide();
        std::puts(shownName("moved " + source + " to " + destination.c_str()).c_str());
    }
    return DONE;
}

} // namespace zbtool
