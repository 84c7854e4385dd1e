// A module that links the installed library and uses every subsystem once, through the entry headers alone.

#include <zor_basis/containers.h>
#include <zor_basis/crypto.h>
#include <zor_basis/files.h>
#include <zor_basis/log.h>
#include <zor_basis/memory.h>
#include <zor_basis/sync.h>
#include <zor_basis/system.h>
#include <zor_basis/text.h>
#include <zor_basis/timers.h>
#include <zor_basis/walk.h>

#include <cstdio>
#include <memory>

using namespace ZOR_Basis;

namespace {

bool writeFile(FPath const& path, Str const& text) {
    File file(path, File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY);
    return file.isOpen() && file->write(text.c_str(), text.size()) == text.size();
}

/// A job folder is copied by a walk, timed, and counted.
bool copiesFolder(FPath const& place) {
    TimerMgr* const manager = TimerMgr::New("module", 0);
    manager->setActive(true);
    PileTimerAuto const timing(manager->createTimer("copy", 0, false), manager, true, false);
    FPath const source(place, "source");
    FPath const target(place, "target");
    bool const made = Dir::New(source, true) && Dir::New(target, true) &&
                      writeFile(FPath(source, "job.ticket"), "copies: 2\n") && writeFile(FPath(source, "page"), "text");
    FileCopyVisitor copier(target, true, true);
    FPath ticket;
    return made && FileIterator::doIt(source, LOOK_BOTH, &copier, nullptr, nullptr, false, true, false) &&
           FileCountVisitor::Get(target, LOOK_BOTH, 0) == 2 && FileSizeVisitor::Get(target, true) == 14 &&
           zbFindFile(target, "*.ticket", LOOK_FILES, ticket, true, false) == 1;
}

bool keepsRecords(FPath const& place) {
    FPath const path(place, "records");
    Dict<Blob, Blob> records(path);
    records.set(Blob(5, "media"), Blob(2, "A4"));
    Dict<Blob, Blob> loaded(path);
    Blob value;
    return records.write() && loaded.read() && loaded.get(Blob(5, "media"), value) && value == Blob(2, "A4");
}

bool runsJobs() {
    SemSet keys;
    std::unique_ptr<MultiTaskQueue> const queue(MultiTaskQueue::New(MultiTaskQueue::StopOnError, 2));
    for (int i = 0; i < 8; ++i)
        queue->add(
            [](void* set) {
                SemSet& locks = *static_cast<SemSet*>(set);
                return locks->take(7) && locks->give(7);
            },
            &keys, false, true, false);
    queue->wait();
    return !queue->failed();
}

bool keepsSecrets() {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    CrHashPtr hash(crypt.get());
    hash->hashData("secret", 6);
    std::unique_ptr<CrKey> const key(crypt->deriveKey(hash));
    Blob encrypted;
    Blob decrypted;
    Blob const plain(6, "ticket");
    return key->encrypt(plain, encrypted) && key->decrypt(encrypted, decrypted) && decrypted == plain;
}

bool allocates() {
    MemMgrPtr const blocks(MemMgr::makeSmlBlk(24, 100, 0, 8));
    void* const block = blocks->alloc();
    blocks->free(block);
    return block != nullptr && blocks->alloc() == block;
}

} // namespace

int main() {
    VDPTempDir const folder(true);
    Log const log("module");
    log.out("works in %s", folder.path().c_str());
    bool const good = folder.status() && copiesFolder(folder.path()) && keepsRecords(folder.path()) && runsJobs() &&
                      keepsSecrets() && allocates();
    std::puts(good ? "consumer_module: good" : "consumer_module: bad");
    return good ? 0 : 1;
}
