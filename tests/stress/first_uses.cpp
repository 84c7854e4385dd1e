// What the library makes at its first use is used first by eight threads at once, in a fresh process each time.

#include "tests/stress/campaign.h"
#include "tests/stress/places.h"

#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"

#include <zor_basis/containers.h>
#include <zor_basis/crypto.h>
#include <zor_basis/files.h>
#include <zor_basis/flat.h>
#include <zor_basis/log.h>
#include <zor_basis/memory.h>
#include <zor_basis/sync.h>
#include <zor_basis/system.h>
#include <zor_basis/text/convert.h>
#include <zor_basis/timers.h>

#include <algorithm>
#include <atomic>
#include <memory>
#include <thread>

using namespace ZOR_Basis;

namespace stress {
namespace {

constexpr unsigned THREADS = 8;

std::string address(void const* place) { return std::to_string(reinterpret_cast<std::uintptr_t>(place)); }

std::string root(unsigned) { return address(&Sys::root()) + Sys::root().c_str(); }
std::string temp(unsigned) { return Sys::temp().c_str(); }
std::string wideRoot(unsigned) {
    WcPath path;
    path.translateRoot(ZB_W("/scsi0"));
    BufStr<255> narrow;
    return Convert::WideToUtf8(path, narrow) && narrow == Sys::root() ? narrow.c_str() : "";
}
std::string registry(unsigned) { return TimerMgr::Mgr() != nullptr ? address(TimerMgr::Mgr()) : ""; }
std::string manager(unsigned thread) {
    std::string const name = "of " + std::to_string(thread);
    return TimerMgr::New(name.c_str(), 1) == TimerMgr::Get(name.c_str()) ? "made" : "";
}
std::string folder(unsigned) {
    VDPTempDir const made(false);
    return made.status() ? made.path().c_str() : "";
}
std::string flags(unsigned) { return isQDBON() == 1 && isVPSON() == 0 && isVDPON() == 1 ? "on, off, any" : ""; }
std::string log(unsigned thread) {
    std::string const name = "of" + std::to_string(thread);
    Log const made(name.c_str());
    made.out("%d %.2f", 7, 0.5);
    FPath file(Sys::temp(), "zb_log");
    file.add(name.c_str()).add("0.log");
    bool const isWritten = made.flush();
    std::string const text = textOf(file.c_str());
    return isWritten ? text.substr(0, text.find_first_of("\r\n")) : "";
}
std::string conversion(unsigned) {
    WBStr wide;
    BufStr<255> local;
    BufStr<255> oem;
    bool const isDone = Convert::Utf8ToWide("a\xC3\xA4", wide) && Convert::WideToLocal(wide, local) &&
                        Convert::EncodeMB(Convert::ENC_UTF8, "abc", Convert::ENC_OEM, oem) && oem == Str("abc");
    return isDone ? local.c_str() : "";
}
std::string hashing(unsigned) { return std::to_string(Str("a text of more than sixteen bytes").hash()); }
std::string comparing(unsigned) {
    return Str("a text of more than sixteen bytes") < Str("a text of more than sixteen bytez") ? "less" : "";
}
std::string crypto(unsigned) {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    std::unique_ptr<CrHash> const hash(crypt != nullptr ? crypt->createHash() : nullptr);
    Blob key;
    if (hash == nullptr || !hash->hashData("secret", 6) || !hash->exportKey(key)) return "";
    return {key.val(), static_cast<std::size_t>(key.size())};
}
std::string lock(unsigned) {
    Lock both(Lock::Mutex, true);
    both.unlock();
    Lock binary(Lock::Binary, false);
    binary.lock();
    binary.unlock();
    return "locked";
}
std::string namedMutex(unsigned) {
    static std::uint32_t word = 0;
    xos_Sem const mutex = xos_SemNamedMutexCreate(77'002, 0, 0, &word);
    return xos_SemTake(mutex) == 0 && xos_SemGive(mutex) == 0 ? address(&word) : "";
}
std::string queue(unsigned) {
    std::unique_ptr<MultiTaskQueue> const made(MultiTaskQueue::New(MultiTaskQueue::StopOnError, 2));
    bool const isAdded = made->add([](void*) { return true; }, nullptr, false, true, false);
    made->wait();
    return isAdded && !made->failed() && made->first()->result() ? "done" : "";
}
std::string memory(unsigned) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(16, 4, 64, 8));
    void* const block = manager->alloc();
    manager->free(block);
    return block != nullptr ? "allocated" : "";
}
std::string user(unsigned) {
    BufStr<15> name;
    return Sys::CurrentUser(name, false) ? name.c_str() : "";
}
std::string drive(unsigned) { return Sys::isLocalDisk(Sys::temp()) ? "local" : "elsewhere"; }
std::string clock(unsigned) {
    BaseTimer timer;
    timer.start(false);
    timer.stop(nullptr);
    return timer.total() >= 0 ? "measured" : "";
}
std::string alert(unsigned) {
    std::atomic<int> calls{0};
    auto* const call = +[](HQ_Basis::AlertTimer::Alert const& due) -> std::uint32_t {
        ++*static_cast<std::atomic<int>*>(due.context);
        return 1;
    };
    std::uint32_t const id = HQ_Basis::AlertTimer::New(1, call, &calls);
    for (int i = 0; i < 10'000 && calls == 0; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    HQ_Basis::AlertTimer::Delete(id);
    return calls != 0 ? "called" : "";
}

struct FirstUse {
    char const* name;
    /// \return what it found; empty: a failure
    std::string (*use)(unsigned thread);
    /// Each thread finds the same, or each something else.
    bool isShared = true;
};

constexpr FirstUse USES[] = {
    {"root", root},
    {"temp", temp},
    {"wide root", wideRoot},
    {"registry", registry},
    {"manager", manager},
    {"folder", folder, false},
    {"flags", flags},
    {"log", log},
    {"conversion", conversion},
    {"hashing", hashing},
    {"comparing", comparing},
    {"crypto", crypto},
    {"lock", lock},
    {"mutex", namedMutex},
    {"queue", queue},
    {"memory", memory},
    {"user", user},
    {"drive", drive},
    {"clock", clock},
    {"alert", alert},
};

/// first NUMBER: one of the uses, in threads that begin together.
int first(std::vector<std::string> const& arguments) {
    FirstUse const& wanted = USES[std::stoul(arguments.at(0))];
    std::vector<std::string> found(THREADS);
    std::vector<std::thread> threads;
    std::atomic<unsigned> missing{THREADS};
    for (unsigned i = 0; i < THREADS; ++i) {
        threads.emplace_back([&, i] {
            --missing;
            while (missing != 0) std::this_thread::yield();
            found[i] = wanted.use(i);
        });
    }
    for (std::thread& thread : threads) thread.join();
    std::set<std::string> const different(found.begin(), found.end());
    if (different.count("") != 0) return 3;
    return different.size() == (wanted.isShared ? 1 : THREADS) ? 0 : 4;
}

void raceOne(std::size_t number, Findings& findings) {
    Scratch const scratch(stressFolder());
    makeFolder(scratch / "config");
    makeFolder(scratch / "tmp");
    put(scratch / "config/vdp.cfg", "qdb = on\nvps = off\n");
    Child child{programBeside("stress"), {"--as", "first", std::to_string(number)}, {{"XOS_ROOT", scratch.path()}}};
    int const code = child.isStarted() ? child.wait() : -2;
    findings.expect(code == 0, std::string(USES[number].name) + " ends with " + std::to_string(code));
}

} // namespace

void raceFirstUses(std::uint64_t processes, Findings& findings) {
    for (std::uint64_t i = 0; i < processes; ++i) {
        for (std::size_t number = 0; number < std::size(USES); ++number) raceOne(number, findings);
    }
    findings.note(std::to_string(std::size(USES)) + " first uses, " + std::to_string(THREADS) + " threads");
}

Roles firstUseRoles() { return {{"first", first}}; }

} // namespace stress
