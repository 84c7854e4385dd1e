// The main job of a server module: copies a job folder, looks at both sides, finds the job's ticket, verifies the copy,
// clears up, and prints how long each of it took.
//
//     zor_basis_demo [FOLDER [REPORT]]    FOLDER: any folder; without one a sample job is made
//                                         REPORT: a file that receives the timer report
//     zor_basis_demo --sample FOLDER      makes the sample job in a new folder
//
// Read this file first, then folder_copy.cpp, which is the heart of it.

#include "examples/copy_job/choices.h"
#include "examples/copy_job/folder_copy.h"
#include "examples/copy_job/folder_verification.h"
#include "examples/copy_job/sample_job.h"
#include "examples/copy_job/scratch_root.h"
#include "examples/copy_job/timer_report.h"

#include <zor_basis/files.h>
#include <zor_basis/timers.h>
#include <zor_basis/walk.h>

#include <cstdio>
#include <cstdlib>

using namespace ZOR_Basis;

namespace {

/// What a job's steps are timed by. Timers belong to their manager, which lives as long as the process.
struct Timers {
    TimerMgr* const manager = TimerMgr::New("copy_job", 0);
    PileTimer* const copying = manager->createTimer("copy the folder", 0, FOR_ONE_THREAD);
    PileTimer* const looking = manager->createTimer("count, size, search", 0, FOR_ONE_THREAD);
    PileTimer* const verifying = manager->createTimer("verify the copy", 0, FOR_ONE_THREAD);
    PileTimer* const removing = manager->createTimer("remove the copy", 0, FOR_ONE_THREAD);

    Timers() { manager->setActive(true); }
    /// Times the rest of a scope.
    PileTimerAuto time(PileTimer* timer) const { return {timer, manager, STARTED, NOT_SUSPENDED}; }
};

int countEntries(Str const& folder) {
    FileCountVisitor counter(0);
    FileIterator::doIt(folder, LOOK_BOTH, &counter, nullptr, nullptr, DEEP, IGNORING_FAILURES, PLAIN_STORE);
    return counter.total();
}

void describe(char const* what, FPath const& folder) {
    std::printf("%-8s %s: %d entries, %lld bytes\n", what, folder.c_str(), countEntries(folder),
                static_cast<long long>(FileSizeVisitor::Get(folder, DEEP)));
}

void lookAt(FPath const& source, FPath const& copy) {
    describe("source", source);
    describe("copy", copy);
    FPath ticket;
    int const tickets = zbFindFile(copy, "*.ticket", LOOK_FILES | LOOK_ANYCASE, ticket, FIRST_ONLY, DEEP);
    std::printf("ticket   %s\n", tickets > 0 ? ticket.c_str() : "none in this folder");
}

bool complain(char const* what, FPath const& path) {
    std::fprintf(stderr, "cannot %s %s\n", what, path.c_str());
    return false;
}

int statusOf(bool good) { return good ? EXIT_SUCCESS : EXIT_FAILURE; }

bool run(FPath const& source, FPath const& copy, Timers const& timers) {
    {
        PileTimerAuto const timing = timers.time(timers.copying);
        FolderCopy folderCopy;
        if (!folderCopy.run(source, copy)) return complain("copy", folderCopy.failedAt());
    }
    {
        PileTimerAuto const timing = timers.time(timers.looking);
        lookAt(source, copy);
    }
    {
        PileTimerAuto const timing = timers.time(timers.verifying);
        FolderVerification verification(source, copy);
        if (!verification.run()) return complain("verify", verification.failedAt());
        std::printf("verified %d files, byte for byte\n", verification.files());
    }
    PileTimerAuto const timing = timers.time(timers.removing);
    return Dir::Rem(copy, WITH_CONTENTS, WITHOUT_SECOND_FLAG) || complain("remove", copy);
}

} // namespace

int main(int argc, char** argv) {
    if (argc == 3 && Str(argv[1]) == "--sample") return statusOf(makeSampleJob(argv[2]) || complain("make", argv[2]));
    if (argc >= 2 && !FStat(argv[1]).isDir()) return statusOf(complain("find the folder", argv[1]));
    ScratchRoot const scratch;
    if (!scratch.isMade()) return statusOf(complain("make", scratch.path()));
    Timers const timers;
    FPath const sample(scratch.path(), "job");
    if (argc < 2 && !makeSampleJob(sample)) return statusOf(complain("make", sample));

    bool const good = run(argc < 2 ? sample : FPath(argv[1]), FPath(scratch.path(), "copy"), timers);
    timers.manager->reset(PRINTED);
    return statusOf(printTimerReport(scratch.path(), argc < 3 ? "" : argv[2]) && good);
}
