#include "tools/zbtool/remove.h"

#include "tools/zbtool/byte_text.h"
#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/tally.h"
#include "tools/zbtool/terminal.h"
#include "tools/zbtool/tree_work.h"

#include <cstdio>
#include <filesystem>
#include <iostream>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace zbtool {
namespace {

/// Removes a folder entry by entry.
bool removeContents(FPath const& folder, Progress* progress) {
    bool good = true;
    bool const read = forEachEntry(folder, [&](FPath const& path, FStat const& status) {
        if (status.isDir()) {
            good &= removeContents(path, progress);
        } else if (!File::Rem(path, WITHOUT_FIRST_FLAG, WITHOUT_SECOND_FLAG)) {
            good = complain(path.c_str());
        } else if (progress != nullptr) {
            progress->add({1, status.size()});
        }
        return true;
    });
    // The complaint is about what is in it.
    if (!read || !good) return false;
    if (!Dir::Rem(folder, WITHOUT_CONTENTS, WITHOUT_SECOND_FLAG)) return complain(folder.c_str());
    if (progress != nullptr) progress->add({1, 0});
    return true;
}

/// The root of a file system, however it is written.
bool isRoot(std::string const& path) {
    std::error_code error;
    fs::path const whole = fs::canonical(path, error);
    return !error && whole == whole.root_path();
}

/// Whether a path ends in a name. The system removes no folder that is called "." or "..", but all that is in it.
bool endsInName(std::string const& path) {
    fs::path whole = path;
    while (!whole.has_filename() && whole.has_relative_path()) whole = whole.parent_path();
    return (whole.filename() != "." && whole.filename() != "..") || complain(path, "not deleted without its own name");
}

bool isConfirmed(std::string const& path, bool yes, Tally& tally) {
    if (Progress::isVisible()) tallyTree(path, true, nullptr, tally);
    if (yes) return true;
    std::fprintf(stderr, "delete %s: %llu entries, %s? [y/N] ", harmlessText(path).c_str(),
                 static_cast<unsigned long long>(tally.entries()), sizeText(tally.bytes).c_str());
    std::string answer;
    std::getline(std::cin, answer);
    return answer == "y" || answer == "Y" || answer == "yes";
}

bool removePath(std::string const& path, bool yes) {
    if (!FStat(path.c_str(), SYSTEM_ONLY).exist()) return complain(path);
    if (isRoot(path)) return complain(path, "the root of a file system is not deleted");
    Tally total;
    if (!isConfirmed(path, yes, total)) return complain(path, "not deleted");
    Progress progress("deleting");
    progress.setTotal(total.amount());
    if (!removeEntry(path, Progress::isVisible() ? &progress : nullptr)) return false;
    Progress::hide();
    std::puts(shownName("deleted " + path).c_str());
    return true;
}

} // namespace

bool removeEntry(FPath const& path, Progress* progress) {
    FStat const status(path, SYSTEM_ONLY);
    if (!status.isDir()) { return File::Rem(path, WITHOUT_FIRST_FLAG, WITHOUT_SECOND_FLAG) || complain(path.c_str()); }
    if (progress == nullptr && Dir::Rem(path, WITH_CONTENTS, WITHOUT_SECOND_FLAG)) return true;
    return removeContents(path, progress);
}

int remove(RemoveOptions const& options) {
    bool const asking = inputIsTerminal() && errorsAreTerminal();
    if (!options.yes && !asking) {
        complain("delete", "without a terminal to ask on it needs --yes");
        return MISUSED;
    }
    bool good = true;
    for (std::string const& path : options.paths) good &= endsInName(path);
    if (!good) return FAILED;
    for (std::string const& path : options.paths) good &= removePath(path, options.yes);
    return exitCodeOf(good);
}

} // namespace zbtool
