#include "tools/zbtool/tally.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/json.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/tree_work.h"

#include <atomic>
#include <cinttypes>
#include <cstdio>
#include <filesystem>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace zbtool {
namespace {

using Print = void (*)(TallyOptions const& options, std::string const& path, Tally const& tally);

void printJson(std::string const& path, Tally const& tally) {
    JsonObject object;
    object.add("path", path).add("files", tally.files).add("folders", tally.folders).add("others", tally.others);
    std::puts(object.add("bytes", tally.bytes).text().c_str());
}

void printCount(TallyOptions const& options, std::string const& path, Tally const& tally) {
    if (options.kinds) {
        std::printf("%" PRIu64 " files\t%" PRIu64 " folders\t%" PRIu64 " others\t%s\n", tally.files, tally.folders,
                    tally.others, shownName(path).c_str());
    } else {
        std::printf("%" PRIu64 "\t%s\n", tally.entries(), shownName(path).c_str());
    }
}

void printSize(TallyOptions const&, std::string const& path, Tally const& tally) {
    std::printf("%" PRIu64 "\t%s\n", tally.bytes, shownName(path).c_str());
}

int tallyAll(TallyOptions const& options, char const* what, Print print) {
    bool good = true;
    for (std::string const& path : options.paths) {
        Progress progress(what);
        Tally tally;
        good &= tallyTree(path, !options.flat, &progress, tally);
        if (isInterrupted()) endAsInterrupted();
        if (tally.entries() == 0) continue;
        Progress::hide();
        if (options.json)
            printJson(path, tally);
        else
            print(options, path, tally);
    }
    return exitCodeOf(good);
}

} // namespace

void Tally::add(FStat const& status) {
    ++(status.isFile() ? files : status.isDir() ? folders : others);
    if (status.isFile()) bytes += status.size();
}

void Tally::add(Tally const& other) {
    files += other.files;
    folders += other.folders;
    others += other.others;
    bytes += other.bytes;
}

namespace {

/// Makes a folder the current one, for a scope. The system resolves each path from the front, so that those below this
/// folder become cheaper.
class CurrentFolder {
public:
    explicit CurrentFolder(FPath const& folder) : before_(fs::current_path(error_)) {
        if (!error_) fs::current_path(folder.c_str(), error_);
        isSet_ = !error_;
    }
    ~CurrentFolder() {
        if (isSet_) fs::current_path(before_, error_);
    }
    CurrentFolder(CurrentFolder const&) = delete;
    CurrentFolder& operator=(CurrentFolder const&) = delete;

    bool isSet() const { return isSet_; }

private:
    std::error_code error_;
    fs::path before_;
    bool isSet_ = false;
};

} // namespace

bool tallyTree(FPath const& top, bool deep, Progress* progress, Tally& tally) {
    FStat const status(top, SYSTEM_ONLY);
    if (!status.exist()) return complain(top.c_str());
    tally.add(status);
    if (!status.isDir()) return true;
    CurrentFolder const current(top);
    FPath const start = current.isSet() ? FPath(".") : top;
    std::mutex adding;
    std::atomic<bool> good{true};
    auto const tell = [&](std::string const& path, std::string const& reason) {
        return complain(top.c_str() + path.substr(start.size()), reason);
    };
    auto const addFolder = [&](FPath const& folder, TreeWork::Folders& below) {
        Tally own;
        bool const read = forEachEntry(
            folder,
            [&](FPath const& path, FStat const& entry) {
                own.add(entry);
                if (deep && entry.isDir()) below.push_back(path);
                return true;
            },
            tell);
        if (!read) good = false;
        if (progress != nullptr) progress->add(own.amount());
        std::lock_guard const lock(adding);
        tally.add(own);
        return true;
    };
    return TreeWork(addFolder, TreeWork::severalWorkers()).run(start) && good;
}

int count(TallyOptions const& options) { return tallyAll(options, "counting", printCount); }

int size(TallyOptions const& options) { return tallyAll(options, "adding up", printSize); }

} // namespace zbtool
