/// \file
/// A timer report while it is written.

#ifndef BASIS_TIMERS_REPORT_FILE_H
#define BASIS_TIMERS_REPORT_FILE_H

#include "zor_basis/files/f_path.h"
#include "zor_basis/files/file.h"
#include "zor_basis/text/buf_str.h"

#include <cstdint>

namespace ZOR_Basis {

class PileTimer;

/// \error a file that cannot be opened raises an assertion and swallows what is written
class ReportFile {
public:
    /// Makes the folder where it is missing, opens the file of this second and writes the head.
    ReportFile(FPath const& folder, Str const& manager, std::int32_t rip);
    /// Writes the row of a timer.
    void write(PileTimer const& timer);

private:
    void writeHead(std::int32_t seconds);
    void writeLine();

    BufStr<255> line_;
    File file_;
};

/// Seconds since 1970 UTC. Replaced by tests only, while nothing else runs.
extern std::int64_t (*reportTime)();

} // namespace ZOR_Basis

#endif
