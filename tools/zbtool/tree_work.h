/// \file
/// Goes through the folders of a tree, several of them at the same time.

#ifndef TOOLS_ZBTOOL_TREE_WORK_H
#define TOOLS_ZBTOOL_TREE_WORK_H

#include "tools/zbtool/complaint.h"
#include "tools/zbtool/entry_names.h"

#include <zor_basis/files.h>
#include <zor_basis/walk.h>

#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace zbtool {

/// Calls `bool each(FPath const& path, FStat const& status)` for every entry of a folder, until it returns false.
/// Unlike a walk of the library this passes over no name and tells a folder that cannot be read from an empty one.
/// \param tell  is called with the path and the reason, if the folder cannot be read, and for each entry that the
///     library cannot reach by its name
/// \return false if there was such a failure
template <class Each, class Tell>
bool forEachEntry(ZOR_Basis::FPath const& folder, Each each, Tell tell) {
    ZOR_Basis::FileIterator listing(folder, ZOR_Basis::LOOK_ALL, nullptr, nullptr);
    if (!listing.start(false)) return tell(folder.c_str(), lastReason());
    bool good = true;
    while (char const* const name = listing.next()) {
        ZOR_Basis::FPath const path(folder, name);
        std::string_view const why = whyUnreachable(name);
        if (!why.empty())
            good = tell(path.c_str(), std::string(why));
        else if (!each(path, ZOR_Basis::FStat(path, false)))
            break;
    }
    return good;
}

/// The same with complaints.
template <class Each>
bool forEachEntry(ZOR_Basis::FPath const& folder, Each each) {
    auto const tell = [](std::string const& path, std::string const& reason) { return complain(path, reason); };
    return forEachEntry(folder, each, tell);
}

class TreeWork {
public:
    using Folders = std::vector<ZOR_Basis::FPath>;
    /// Does the work of one folder.
    /// \param below  receives the folders to handle next
    /// \return false to end the whole work
    /// \thread runs on several threads at the same time, never twice for one folder
    using Handle = std::function<bool(ZOR_Basis::FPath const& folder, Folders& below)>;

    /// \param workers  limits the threads; with one the folders come in the order of a walk
    TreeWork(Handle handle, unsigned workers) : handle_(std::move(handle)), most_(workers) {}
    /// \return false if the work was ended, by a handler or by an interruption
    bool run(ZOR_Basis::FPath const& top);

    /// As many threads as help: beyond a few they only wait for each other's folders.
    static unsigned severalWorkers();

private:
    void work();
    void add(Folders& folders);

    Handle const handle_;
    unsigned const most_;
    std::mutex mutex_;
    std::condition_variable changed_;
    Folders waiting_;
    std::vector<std::thread> threads_;
    unsigned busy_ = 0;
    bool ended_ = false;
};

} // namespace zbtool

#endif
