#include "examples/copy_job/timer_report.h"

#include "examples/copy_job/choices.h"

#include <zor_basis/walk.h>

#include <cstdio>

using namespace ZOR_Basis;

bool printTimerReport(FPath const& root, FPath const& copy) {
    FPath report;
    if (zbFindFile(FPath(root, "timer"), "*.timer", LOOK_FILES, report, LAST_OF_ALL, ONE_LEVEL) == 0) return false;
    File file(report, File::FILE_READ | File::FILE_BINARY);
    if (!file.isOpen()) return false;
    std::putchar('\n');
    char piece[4096];
    while (auto const got = file->read(piece, sizeof piece)) {
        // A row ends in a zero byte and a line feed, for programs that look at one row at a time.
        for (std::uint64_t i = 0; i < got; ++i) std::putchar(piece[i] != '\0' ? piece[i] : ' ');
    }
    return copy.empty() || File::Copy(copy, report, OVERWRITING, WITHOUT_PARENTS);
}
