#include "basis/timers/report_file.h"

#include "basis/ground/choices.h"
#include "basis/timers/complaint.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/timers/pile_timer.h"

#include <ctime>
#include <string>

namespace ZOR_Basis {
namespace {

// kept timers-08: a report is appended to an earlier one of the same second.
constexpr int MODE = File::FILE_WRITE | File::FILE_APPEND | File::FILE_SEQUENTIAL | File::FILE_PLATFORM_EXTRA;
static_assert(MODE == 0x226);

constexpr int MICROSECONDS = 1'000'000;

struct Title {
    char const* text;
    std::uint64_t width;
};

constexpr Title TITLES[] = {
    {"Function", 40},      {"Count", 10},   {"Total", 15},         {"Average", 15},     {"Maximum", 15},
    {"Maximum count", 15}, {"Minimum", 15}, {"Suspend total", 15}, {"Suspend Max", 15}, {"Notes", 24},
};

void complainOf(FPath const& path) {
    BufStr<255> message("TimerMgr::reset() - cannot open the report ");
    complain(__LINE__, message.add(path));
}

std::int64_t secondsNow() { return std::time(nullptr); }

} // namespace

std::int64_t (*reportTime)() = secondsNow;

ReportFile::ReportFile(FPath const& folder, Str const& manager, std::int32_t rip) {
    auto const seconds = static_cast<std::int32_t>(reportTime());
    line_ << seconds << "_" << manager << "_" << rip << ".timer";
    FPath path(folder);
    path.add(line_);
    // The folder was made with the registry. A server that cleans up its root may have removed it since.
    Dir::New(folder.c_str(), WITHOUT_PARENTS);
    if (!file_.open(path.c_str(), MODE, WITHOUT_CREATE_FLAG)) complainOf(path);
    writeHead(seconds);
}

void ReportFile::writeHead(std::int32_t seconds) {
    line_.clear();
    line_ << "Log timestamp (sec): " << seconds << "\nTimers (mksec):\n";
    for (Title const& title : TITLES) {
        std::uint64_t const end = line_.size() + title.width;
        line_ << title.text;
        while (line_.size() < end) line_.add(' ');
    }
    writeLine();
}

void ReportFile::write(PileTimer const& timer) {
    timer.print(line_, MICROSECONDS);
    writeLine();
}

void ReportFile::writeLine() {
    line_.add('\n');
    if (file_.ptr() != nullptr) file_->write(line_.c_str(), line_.size());
}

} // namespace ZOR_Basis
