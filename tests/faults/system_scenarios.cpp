#include "tests/faults/programs.h"
#include "tests/faults/scenario.h"

#include <zor_basis/flat.h>
#include <zor_basis/log.h>
#include <zor_basis/system.h>
#include <zor_basis/timers.h>

#include <xos_host.h>

#include <memory>

using namespace ZOR_Basis;

namespace {

/// The system's root lies beside the folders of all runs, with a configuration. The platform layer keeps every root
/// that it is given, so it is given one.
void prepareRoot(Place const& place) {
    put(place / "page", "the page");
    std::filesystem::path const root = std::filesystem::path(place.path).parent_path() / "root";
    makeFolder((root / "system/config").string());
    makeFolder((root / "tmp").string());
    put((root / "system/config/vdp.cfg").string(), "VDP = on\nVPS = off\n");
    static std::string given;
    if (given.empty()) xos_HostSetRoot((given = (root / "system").string()).c_str());
}

bool makesTemporaryFolders(Place const&) {
    VDPTempDir const folder(true);
    return folder.status();
}
bool gets(Place const& place) {
    std::string const page = place / "page";
    std::string const url = "file://" + (page.front() == '/' ? page : "/" + page);
    return Url::Get((place / "got").c_str(), url.c_str(), nullptr, nullptr, true, false);
}
bool runs(Place const& place) { return ZB_runCommand("exit 0", place.path.c_str(), false); }
bool creates(Place const&) {
    unsigned long id = 0;
    int exitCode = -1;
    return Process::Create(SUCCEEDING.file, &id, SUCCEEDING.commandLine, &exitCode) && exitCode == 0;
}
bool createsAndWaits(Place const&) {
    unsigned long id = 0;
    return Process::Create(SUCCEEDING.file, &id, SUCCEEDING.commandLine, nullptr) && isAwaited(id);
}
bool knowsUsers(Place const&) {
    BufStr<15> user;
    BufStr<15> domain;
    return Sys::CurrentUser(user, false) && Sys::CurHumanUser(user) && Sys::ParseUser(Str("a\\b"), user, domain);
}
bool knowsDrives(Place const& place) {
    FPath unc;
    Sys::UnMap(Str(place.path), unc);
    return Sys::isLocalDisk(Str(place.path));
}
bool readsFlags(Place const&) { return setVDPFlagsFromCFG() == 0; }

bool logs(Place const&) {
    // A log that is destroyed is closed some time later.
    static Log const& log = *new Log("faults");
    for (int i = 0; i < 20; ++i) log.out("line %d of %s", i, "a log");
    return log.flush();
}
bool reportsTimers(Place const&) {
    // A manager and its timers exist as long as the process.
    TimerMgr* manager = TimerMgr::Get("faults");
    if (manager == nullptr) manager = TimerMgr::New("faults", 5);
    if (manager == nullptr) return false;
    PileTimer* timer = manager->getTimer(1);
    if (timer == nullptr) timer = manager->createTimer("a timer", 1, true);
    if (timer == nullptr) return false;
    manager->setActive(true);
    manager->start(1);
    manager->stop(1);
    manager->resetTimers(true);
    return manager->getTimer(1) == timer;
}
bool parses(Place const&) {
    std::string const text = "first line\nsecond line\n";
    ZB_Parse parse(text.c_str(), static_cast<int>(text.size()));
    char line[20];
    int length = 0;
    FPath name;
    return parse.getLine(19, line, &length) && parse.checkLine("second line");
}

} // namespace

Scenarios systemScenarios() {
    return {
        {"VDPTempDir", prepareRoot, makesTemporaryFolders, Scenario::NAMES, Scenario::LASTING_FAULTS},
        {"Url::Get", prepareRoot, gets},
        {"ZB_runCommand", prepareRoot, runs},
        {"Process::Create", prepareRoot, creates},
        {"Process::Wait", prepareRoot, createsAndWaits},
        // Of glibc the name service.
        {"Sys::CurrentUser", prepareRoot, knowsUsers, Scenario::WHOLE_FILES, Scenario::ALLOCATION_FAULTS},
        {"Sys::isLocalDisk, UnMap", prepareRoot, knowsDrives},
        {"setVDPFlagsFromCFG", prepareRoot, readsFlags},
        {"Log", prepareRoot, logs, Scenario::NAMES},
        {"TimerMgr", prepareRoot, reportsTimers, Scenario::NAMES},
        {"ZB_Parse", prepareNothing, parses},
    };
}
