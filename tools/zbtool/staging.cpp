#include "tools/zbtool/staging.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/interruption.h"

#include <filesystem>
#include <mutex>
#include <random>
#include <set>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

std::mutex mutex;
std::set<std::string> openFolders;

/// A folder for one file.
class StagingFolder {
public:
    explicit StagingFolder(FPath const& target) {
        std::string const name = ".zbtool-" + std::to_string(std::random_device()());
        path_ = (std::filesystem::path(target.c_str()).parent_path() / name).generic_string();
        std::lock_guard const lock(mutex);
        made_ = Dir::New(path_, WITHOUT_PARENTS);
        if (made_) openFolders.insert(path_.c_str());
    }
    ~StagingFolder() {
        std::lock_guard const lock(mutex);
        if (made_) Dir::Rem(path_, WITH_CONTENTS, WITHOUT_SECOND_FLAG);
        openFolders.erase(path_.c_str());
    }
    StagingFolder(StagingFolder const&) = delete;
    StagingFolder& operator=(StagingFolder const&) = delete;

    bool isMade() const { return made_; }
    FPath const& path() const { return path_; }

private:
    FPath path_;
    bool made_;
};

bool fillAndMove(FPath const& target, Fill const& fill, bool overwrite, std::string& reason) {
    StagingFolder const staging(target);
    FPath const staged(staging.path(), "copy");
    // A move that is refused removes its source, which is only the staged copy.
    bool const good = staging.isMade() && fill(staged) && File::Move(target, staged, overwrite, WITHOUT_PARENTS);
    if (!good) reason = lastReason();
    return good;
}

} // namespace

bool writeStaged(FPath const& target, Fill const& fill, bool overwrite, std::string& reason) {
    watchForInterruption(clearStaging);
    bool const good = fillAndMove(target, fill, overwrite, reason);
    if (isInterrupted()) endAsInterrupted();
    return good;
}

bool copyStaged(FPath const& target, FPath const& source, bool overwrite, std::string& reason) {
    if (!FStat(source, SYSTEM_ONLY).isDir()) {
        auto const fill = [&](FPath const& staged) { return File::Copy(staged, source, SPARING, WITHOUT_PARENTS); };
        return fillAndMove(target, fill, overwrite, reason);
    }
    StagingFolder const staging(target);
    FPath const staged(staging.path(), "copy");
    bool const good = staging.isMade() && Dir::Copy(staged, source, WITH_CONTENTS, SPARING, WITHOUT_SECOND_FLAG) &&
                      Dir::Move(target, staged, SPARING, WITHOUT_SECOND_FLAG);
    if (!good) reason = lastReason();
    return good;
}

void clearStaging() {
    mutex.lock(); // and never unlocked, as the program ends next
    for (std::string const& folder : openFolders) Dir::Rem(folder.c_str(), WITH_CONTENTS, WITHOUT_SECOND_FLAG);
}

} // namespace zbtool
