// Used by tree_posix.cpp; its counterpart for Windows works with paths.

#include "host/xos_basics/directories/remove_tree_posix.h"

#include "host/xos_basics/directories/directory_chain_posix.h"
#include "host/xos_basics/directories/dirents_posix.h"
#include "host/xos_basics/directories/name_queue.h"
#include "host/xos_basics/result.h"

#include <memory>
#include <unistd.h>
#include <vector>

namespace host {

namespace {

class TreeRemoval {
public:
    bool run(Descriptor at, char const* name);

private:
    /// One directory of the chain, with those of its directories that are still there.
    struct Level {
        NameQueue directories;
        unsigned passes;
        unsigned failuresBefore;
    };

    void enter(char const* name);
    /// Removes what no descent is needed for, and notes the directories.
    void sweep();
    /// Removes the directory that has just been swept, from the one above.
    /// \return false: that one cannot be found
    bool leave();
    bool removeUnentered(char const* name);
    void fail();

    /// A directory that fills up again is emptied so often.
    static constexpr unsigned MOST_PASSES = 64;

    DirectoryChain chain_;
    std::vector<Level> levels_;
    Dirents dirents_;
    unsigned failures_ = 0;
    int firstError_ = 0;
};

bool TreeRemoval::run(Descriptor at, char const* name) {
    chain_.push(std::move(at));
    levels_.push_back({{}, 0, 0});
    levels_.back().directories.add(name);
    for (;;) {
        NameQueue const& waiting = levels_.back().directories;
        if (!waiting.empty()) {
            enter(waiting.first());
        } else if (levels_.size() == 1) {
            return failures_ == 0 || failWith(firstError_);
        } else if (!leave()) {
            return false;
        }
    }
}

void TreeRemoval::fail() {
    if (failures_++ == 0) firstError_ = errno;
}

void TreeRemoval::enter(char const* name) {
    Descriptor directory{::openat(chain_.lowest(), name, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC)};
    if (!directory || !chain_.push(std::move(directory))) {
        if (!removeUnentered(name)) fail();
        levels_.back().directories.dropFirst();
        return;
    }
    levels_.push_back({{}, 0, failures_});
    sweep();
}

void TreeRemoval::sweep() {
    int const directory = chain_.lowest();
    while (dirents_.next(directory)) {
        if (!S_ISDIR(dirents_.toldType())) {
            if (::unlinkat(directory, dirents_.name(), 0) == 0 || errno == ENOENT) continue;
            if (errno != EISDIR) {
                fail();
                continue;
            }
        }
        levels_.back().directories.add(dirents_.name());
    }
    if (dirents_.failed()) fail();
}

bool TreeRemoval::leave() {
    if (!chain_.findAbove()) return false;
    chain_.pop();
    bool const clean = levels_.back().failuresBefore == failures_;
    levels_.pop_back();
    Level& above = levels_.back();
    bool const gone = ::unlinkat(chain_.lowest(), above.directories.first(), AT_REMOVEDIR) == 0 || errno == ENOENT;
    if (!gone) {
        // Filled again, or replaced by another entry: examine it again.
        bool const changed = errno == ENOTEMPTY || errno == EEXIST || errno == ENOTDIR;
        if (clean && changed && ++above.passes < MOST_PASSES) return true;
        fail();
    }
    above.directories.dropFirst();
    above.passes = 0;
    return true;
}

bool TreeRemoval::removeUnentered(char const* name) {
    int const error = errno;
    bool const noDirectory = error == ENOTDIR || error == ELOOP;
    if (error == ENOENT || ::unlinkat(chain_.lowest(), name, noDirectory ? 0 : AT_REMOVEDIR) == 0) return true;
    if (errno == ENOENT) return true;
    return noDirectory ? false : failWith(error);
}

} // namespace

bool removeTree(int at, char const* name) {
    Descriptor directory{::fcntl(at, F_DUPFD_CLOEXEC, 0)};
    return directory && unlessMemoryLacks(false, [&] {
               return std::make_unique_for_overwrite<TreeRemoval>()->run(std::move(directory), name);
           });
}

} // namespace host
