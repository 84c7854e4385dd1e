#include "tools/zbtool/log_files.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/staging.h"
#include "tools/zbtool/utf8.h"

#include <zor_basis/files.h>
#include <zor_basis/walk.h>

#include <xos_host.h>

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cstdio>
#include <set>
#include <thread>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

constexpr std::chrono::milliseconds BETWEEN_LOOKS(250);

FPath folderOf(std::string const& name) { return FPath("/scsi0/tmp/zb_log", TranslPath()).add(Str(name)); }

/// The session of a file such as "12.log"; -1 for any other name.
int sessionOf(std::string_view name) {
    int session = -1;
    auto const [end, error] = std::from_chars(name.data(), name.data() + name.size(), session);
    return error == std::errc() && std::string_view(end, name.data() + name.size()) == ".log" ? session : -1;
}

std::set<int> sessionsIn(FPath const& folder, int wanted) {
    std::set<int> sessions;
    FileIterator listing(folder, LOOK_FILES, "*.log", nullptr);
    while (char const* const name = listing.next()) {
        int const session = sessionOf(name);
        if (session >= 0 && (wanted < 0 || session == wanted)) sessions.insert(session);
    }
    return sessions;
}

FPath fileOf(FPath const& folder, int session) { return FPath(folder, (std::to_string(session) + ".log").c_str()); }

/// Prints what a file has from a position on, and moves the position there.
bool printFrom(FPath const& path, std::uint64_t& position) {
    File file(path, File::FILE_READ | File::FILE_BINARY);
    if (!file) return complain(path.c_str());
    constexpr int PIECE = 64 * 1024;
    char bytes[PIECE];
    // A seek takes an `int`; a log that is longer is read over.
    for (std::uint64_t left = position; left > 0;) {
        std::uint64_t const got = file->read(bytes, std::min<std::uint64_t>(left, PIECE));
        if (got == 0) return true;
        left -= got;
    }
    std::string text;
    while (std::uint64_t const got = file->read(bytes, PIECE)) {
        text.append(bytes, got);
        position += got;
        // The rest of a character at the end may come with the next piece.
        std::size_t const whole = got == PIECE ? text.size() - unfinishedLength(text) : text.size();
        std::string const shown = shownLines(text.substr(0, whole));
        std::fwrite(shown.data(), 1, shown.size(), stdout);
        text.erase(0, whole);
    }
    std::fwrite(text.data(), 1, text.size(), stdout);
    return std::fflush(stdout) == 0;
}

/// Prints the last session as it grows, and each one that follows it.
int follow(FPath const& folder, int wanted, int session, std::uint64_t position) {
    while (!isInterrupted()) {
        std::this_thread::sleep_for(BETWEEN_LOOKS);
        std::set<int> const sessions = sessionsIn(folder, wanted);
        for (auto next = sessions.lower_bound(session); next != sessions.end(); ++next) {
            if (*next != session) position = 0;
            session = *next;
            // A file that has shrunk was begun anew.
            std::uint64_t const size = FStat::size(fileOf(folder, session));
            if (size < position) position = 0;
            if (size > position && !printFrom(fileOf(folder, session), position)) return FAILED;
        }
    }
    endAsInterrupted();
}

} // namespace

int printLog(LogOptions const& options) {
    if (!options.root.empty()) xos_HostSetRoot(options.root.c_str());
    FPath const folder = folderOf(options.name);
    if (!FStat(folder, SYSTEM_ONLY).exist()) return exitCodeOf(complain(folder.c_str()));
    std::set<int> const sessions = sessionsIn(folder, options.session);
    if (sessions.empty() && !options.follow) {
        std::string const which = options.session < 0 ? "session" : "session " + std::to_string(options.session);
        return exitCodeOf(complain(folder.c_str(), "contains no " + which));
    }
    if (options.follow) watchForInterruption(clearStaging);
    std::uint64_t position = 0;
    for (int session : sessions) {
        position = 0;
        if (!printFrom(fileOf(folder, session), position)) return FAILED;
    }
    int const last = sessions.empty() ? 0 : *sessions.rbegin();
    return options.follow ? follow(folder, options.session, last, position) : DONE;
}

} // namespace zbtool
