#include "zor_basis/system/vdp_temp_dir.h"

#include "basis/files/platform_flags.h"
#include "basis/files/whole_entry.h"
#include "basis/ground/choices.h"
#include "basis/memory/never_destroyed.h"
#include "basis/platform/xos_basics.h"
#include "basis/sync/held_semaphore.h"
#include "basis/system/decimal_text.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/system/sys.h"

#include <mutex>

namespace ZOR_Basis {
namespace {

constexpr int NAMED_MUTEX = 264;
constexpr char SHARED_FOLDER[] = "vdp_tmp";
constexpr int CLEARS_THE_FOLDER = 1;

/// The mutex by which all processes of a user take turns.
xos_Sem mutexOfAllProcesses() {
    static constinit std::uint32_t word = 0;
    return xos_SemNamedMutexCreate(NAMED_MUTEX, 0, 0, &word);
}

/// Guards the parts of the names while `Init` changes them. Never held during a call of the platform layer.
NeverDestroyed<std::mutex> parts;

NeverDestroyed<FPath> commonFolder;
NeverDestroyed<BufStr<15>> lastNumber("0");
NeverDestroyed<BufStr<15>> suffix(".r");

/// Whether the path is a directory now.
bool becomesDirectory(FPath const& path) {
    FStat const entry(path.c_str());
    // kept temp-02: what an earlier run left is used as it is; instance 1 begins with an empty common folder.
    if (entry.isDir()) return true;
    return !entry.isFile() && Dir::NewFor(path) && xos_DirCreateEx(path, 0) == 0;
}

} // namespace

static_assert(sizeof(xos_Sem) == sizeof(std::uint64_t));

FPath& VDPTempDir::_GlbTmp = *commonFolder;
BufStr<15>& VDPTempDir::_CurName = *lastNumber;
BufStr<15>& VDPTempDir::_ExtRip = *suffix;
constinit std::atomic<std::uint64_t> VDPTempDir::_Sem{0};
constinit std::atomic<std::int32_t> VDPTempDir::_Level{0};

void VDPTempDir::Init(int n) {
    if (_Sem != 0 && (n == 0 || _Level > 0)) return;
    // `_Sem` is not taken here: a `Create` that keeps failing holds it and would block the user's other processes.
    HeldSemaphore const all(mutexOfAllProcesses());
    // kept temp-01: folders that jobs have already stay beneath the root.
    if (_Level > 0 || (n == 0 && _GlbTmp.some())) return;
    choose(n);
    if (_Sem == 0) _Sem = xos_SemMCreate();
    if (n > 0) _Level = n;
}

/// Sets the common folder and the suffix.
void VDPTempDir::choose(int n) {
    FPath folder = Sys::temp();
    if (n > 0) folder.add(SHARED_FOLDER);
    if (n == CLEARS_THE_FOLDER) {
        removeTree(folder);
        Dir::New(folder, WITH_PARENTS);
    }
    std::lock_guard const held(*parts);
    _GlbTmp = folder;
    if (n > 0) _ExtRip << n;
}

/// Does what `Init` would have done.
void VDPTempDir::prepare() {
    HeldSemaphore const all(mutexOfAllProcesses());
    if (_Level <= 0 && _GlbTmp.empty()) choose(0);
    if (_Sem == 0) _Sem = xos_SemMCreate();
}

/// \pre `_Sem` is held
void VDPTempDir::nextPath(FPath& path) {
    incrementDecimal(_CurName);
    std::lock_guard const held(*parts);
    path.assign(_GlbTmp, _CurName).addExt(_ExtRip, WITHOUT_DOT);
}

void VDPTempDir::Create(FPath& path) {
    if (_Sem == 0) prepare();
    HeldSemaphore const naming(_Sem);
    // kept temp-03: a job cannot continue without its folder, and a root that is full or missing becomes usable again.
    do { nextPath(path); } while (!becomesDirectory(path));
}

FPath const& VDPTempDir::Root() { return _GlbTmp; }

VDPTempDir::~VDPTempDir() {
    // kept temp-04: the second of two copies finds nothing left to remove.
    if (deletes_ && FStat::isDir(path_)) xos_DirRemove(path_, REMOVE_ALWAYS | RECURSIVE);
}

bool VDPTempDir::status() const { return FStat::exist(path_); }

} // namespace ZOR_Basis
