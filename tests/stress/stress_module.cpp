// A module that uses the library, for `stress_loader`, which loads and unloads both. Its threads are the library's:
// those of a runtime that is linked into a module cost handles and a slot for thread data with every load.

#include "tests/stress/stress_module.h"

#include <zor_basis/containers.h>
#include <zor_basis/crypto.h>
#include <zor_basis/log.h>
#include <zor_basis/memory.h>
#include <zor_basis/sync.h>
#include <zor_basis/system.h>
#include <zor_basis/text/convert.h>
#include <zor_basis/timers.h>

#include <memory>

using namespace ZOR_Basis;

namespace {

bool queues() {
    std::unique_ptr<MultiTaskQueue> const queue(MultiTaskQueue::New(MultiTaskQueue::StopOnError, 1));
    auto* const succeed = +[](void*) { return true; };
    bool const isAdded = queue->add(succeed, nullptr, false, true, false);
    queue->wait();
    return isAdded && !queue->failed();
}

bool locks() {
    Lock const lock(Lock::Mutex, true);
    SemSet const set(3);
    return set->take(7) && set->give(7);
}

bool converts() {
    BufStr<255> local;
    WBStr wide;
    return Convert::Utf8ToLocal("text", local) && Convert::LocalToWide(local, wide) && wide.size() == 4;
}

bool measures() {
    TimerMgr* manager = TimerMgr::Get("module");
    if (manager == nullptr) manager = TimerMgr::New("module", 1);
    return manager != nullptr;
}

bool encrypts() {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    std::unique_ptr<CrHash> const hash(crypt != nullptr ? crypt->createHash() : nullptr);
    return hash != nullptr && hash->hashData("secret", 6);
}

bool makesFolders() {
    VDPTempDir const folder;
    return folder.status() && !Sys::temp().empty();
}

bool allocates() {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(64, 16, 64, 8));
    void* const block = manager->alloc();
    manager->free(block);
    return block != nullptr;
}

/// A log that never had a line ends with its alert.
bool opensALog() {
    Log const log("module");
    return log.flush();
}

} // namespace

extern "C" int useLibrary(void) {
    bool const isGood =
        queues() && locks() && converts() && measures() && encrypts() && makesFolders() && allocates() && opensALog();
    return isGood ? 1 : 0;
}
