#include "tools/zbtool/copy.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/entry_names.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/staging.h"
#include "tools/zbtool/tally.h"
#include "tools/zbtool/tree_work.h"

#include <atomic>
#include <cstdio>
#include <filesystem>
#include <map>
#include <span>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace zbtool {
namespace {

// What one step copies lets an interruption wait, so it is not much.
constexpr std::uint64_t MOST_BYTES = 16 << 20;
constexpr std::uint64_t MOST_ENTRIES = 2'000;

/// The first failure ends the work. What other threads meet meanwhile only follows from it.
bool complainOnce(std::string const& subject, std::string const& reason) {
    static std::atomic<bool> isTold{false};
    return !isTold.exchange(true) && complain(subject, reason);
}

bool complainOfCopy(FPath const& source, FPath const& target, std::string const& reason) {
    return complainOnce("cannot copy '" + std::string(source.c_str()) + "' to '" + target.c_str() + "'", reason);
}

std::uint64_t bytesOf(FStat const& status) { return status.isFile() ? status.size() : 0; }

/// A file, a link or the like.
bool copySingle(FPath const& source, FStat const& status, FPath const& target, bool overwrite) {
    std::string reason;
    bool good = true;
    if (status.isFile() && status.size() > MOST_BYTES) {
        good = copyStaged(target, source, overwrite, reason);
    } else {
        good = status.isFile() ? File::Copy(target, source, overwrite, WITHOUT_PARENTS)
                               : Dir::Copy(target, source, WITHOUT_CONTENTS, overwrite, WITHOUT_SECOND_FLAG);
        if (!good) reason = lastReason();
    }
    return good || complainOfCopy(source, target, reason);
}

class TreeCopy {
public:
    TreeCopy(FPath const& source, FPath const& target, bool overwrite, Progress& progress)
        : source_(source), target_(target), overwrite_(overwrite), progress_(progress) {}

    bool run() {
        bool const good = TreeWork([this](auto& folder, auto& below) { return copyFolder(folder, below); },
                                   TreeWork::severalWorkers())
                              .run(source_);
        return restorePermissions() && good;
    }

private:
    struct Entry {
        FPath path;
        FStat status;
    };
    struct Content {
        std::vector<Entry> entries; ///< all but the folders
        Tally tally;
    };

    FPath targetOf(FPath const& path) const {
        return FPath(target_.c_str() + std::string(path.c_str() + source_.size()));
    }

    bool copyFolder(FPath const& folder, TreeWork::Folders& below) {
        Content content;
        bool const read = forEachEntry(
            folder,
            [&](FPath const& path, FStat const& status) {
                content.tally.add(status);
                if (status.isDir())
                    below.push_back(path);
                else
                    content.entries.push_back({path, status});
                return true;
            },
            complainOnce);
        return read && (copyInOneStep(folder, content) || copyEntries(folder, content)) &&
               (below.empty() || makeWritable(folder));
    }

    /// The library copies a whole folder faster than its files one by one, but does not tell which one failed.
    bool copyInOneStep(FPath const& folder, Content const& content) {
        FPath const target = targetOf(folder);
        if (content.tally.bytes > MOST_BYTES || content.tally.entries() > MOST_ENTRIES) return false;
        if (FStat(target, SYSTEM_ONLY).exist()) return false;
        if (!Dir::Copy(target, folder, WITHOUT_CONTENTS, SPARING, WITHOUT_SECOND_FLAG)) return false;
        progress_.add({content.entries.size() + 1, content.tally.bytes});
        return true;
    }

    bool copyEntries(FPath const& folder, Content const& content) {
        FPath const target = targetOf(folder);
        bool const isNew = !FStat(target, SYSTEM_ONLY).exist();
        if (!Dir::New(target, WITHOUT_PARENTS)) return complainOfCopy(folder, target, lastReason());
        if (isNew) keepPermissions(folder);
        progress_.add({1, 0});
        for (Entry const& entry : content.entries) {
            if (isInterrupted()) return false;
            if (!copySingle(entry.path, entry.status, targetOf(entry.path), overwrite_)) return false;
            progress_.add({1, bytesOf(entry.status)});
        }
        return true;
    }

    /// The copy of a folder that cannot be written to must be writable until it is full.
    bool makeWritable(FPath const& folder) {
        std::error_code error;
        fs::perms const wanted = fs::status(folder.c_str(), error).permissions();
        if ((wanted & fs::perms::owner_all) == fs::perms::owner_all) return true;
        fs::permissions(targetOf(folder).c_str(), fs::perms::owner_all, fs::perm_options::add, error);
        keepPermissions(folder);
        return true;
    }

    void keepPermissions(FPath const& folder) {
        std::lock_guard const lock(mutex_);
        unfinished_.push_back(folder);
    }

    bool restorePermissions() {
        std::error_code error;
        for (auto folder = unfinished_.rbegin(); folder != unfinished_.rend(); ++folder) {
            fs::permissions(targetOf(*folder).c_str(), fs::status(folder->c_str(), error).permissions(), error);
        }
        return true;
    }

    FPath const source_;
    FPath const target_;
    bool const overwrite_;
    Progress& progress_;
    std::mutex mutex_;
    std::vector<FPath> unfinished_; ///< the folders whose copies still have permissions of their own
};

/// Whether a path is a folder or lies in it, by what links lead to.
bool isInside(FPath const& path, FPath const& folder) {
    std::error_code error;
    fs::path const inner = fs::weakly_canonical(path.c_str(), error);
    fs::path const outer = fs::weakly_canonical(folder.c_str(), error);
    auto const [rest, ignored] = std::mismatch(outer.begin(), outer.end(), inner.begin(), inner.end());
    return rest == outer.end();
}

/// The name at the end of a path, also of "..".
std::string nameOf(std::string const& path) {
    FPath const text(path);
    std::string const name = text.c_str() + text.offsetName();
    std::error_code error;
    return name == "." || name == ".." ? fs::canonical(path, error).filename().generic_string() : name;
}

} // namespace

bool haveDistinctNames(std::span<std::string const> sources) {
    std::map<std::string, std::string> sourceOfName;
    for (std::string const& source : sources) {
        auto const [other, isNew] = sourceOfName.try_emplace(comparedName(nameOf(source)), source);
        if (!isNew) return complain(other->second + ", " + source, "two sources of one name");
    }
    return true;
}

FPath destinationOf(std::string const& source, std::string const& target, bool isOnly) {
    FStat const status(source.c_str(), SYSTEM_ONLY);
    std::error_code error;
    bool const isFolder = fs::is_directory(target, error);
    bool good = status.exist() || complain(source);
    good = good && (isFolder || isOnly || complain(target, "not a folder, as several sources require"));
    FPath destination(target);
    if (isFolder) destination.add(nameOf(source));
    if (good && status.isDir() && isInside(destination, source))
        good = complainOfCopy(source, destination, "the destination lies in the source");
    return good ? destination : FPath();
}

bool copyEntry(FPath const& source, FPath const& target, bool overwrite, Progress& progress) {
    FStat const status(source, SYSTEM_ONLY);
    if (!status.isDir()) {
        progress.add({1, bytesOf(status)});
        return copySingle(source, status, target, overwrite);
    }
    // Where nobody watches, the library copies the whole tree, which is fastest. It does not tell what failed.
    std::string ignored;
    bool const inOneStep = !Progress::isVisible() && !FStat(target, SYSTEM_ONLY).exist();
    if (inOneStep && copyStaged(target, source, overwrite, ignored)) return true;
    return TreeCopy(source, target, overwrite, progress).run();
}

int copy(CopyOptions const& options) {
    std::span const sources(options.paths.begin(), options.paths.end() - 1);
    if (!haveDistinctNames(sources)) return MISUSED;
    watchForInterruption(clearStaging);
    Progress progress("copying");
    Tally total;
    for (std::string const& source : sources) {
        if (Progress::isVisible() && !tallyTree(source, true, nullptr, total)) return FAILED;
    }
    progress.setTotal(total.amount());
    for (std::string const& source : sources) {
        FPath const destination = destinationOf(source, options.paths.back(), sources.size() == 1);
        bool const good = !destination.empty() && copyEntry(source, destination, options.overwrite, progress);
        if (isInterrupted()) endAsInterrupted();
        if (!good) return FAILED;
        Progress::hide();
        std::puts(shownName("copied " + source + " to " + destination.c_str()).c_str());
    }
    if (Progress::isVisible()) std::puts(progressText("done:", progress.done(), {}, progress.seconds()).c_str());
    return DONE;
}

} // namespace zbtool
