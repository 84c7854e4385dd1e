#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/semaphores/named_mutex.h"
#include "host/xos_basics/semaphores/semaphore.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <atomic>
#include <mutex>
#include <vector>

namespace host {

namespace {

struct Entry {
    int id;
    xos_Sem handle;
};

constinit QuickMutex mutex;

/// The mutexes of this process; a caller's word holds an index and one.
std::vector<Entry>& entries() {
    static auto& all = *new std::vector<Entry>;
    return all;
}

std::uint32_t indexById(int id) {
    std::uint32_t index = 0;
    while (index < entries().size() && entries()[index].id != id) { ++index; }
    return index;
}

bool addEntry(int id) {
    NamedMutex* const named = openNamed(id);
    if (named == nullptr) return false;
    Semaphore* const semaphore = makeSemaphore(SemaphoreKind::NAMED, 0);
    if (semaphore == nullptr) return false;
    semaphore->named = named;
    entries().push_back({id, semaphore->handle.load()});
    return true;
}

xos_Sem handleById(int id, std::uint32_t* word) {
    std::lock_guard const lock{mutex};
    // The word is another thread's as well; a foreign number in it, or another mutex's, is not followed.
    std::uint32_t index = word == nullptr ? 0 : std::atomic_ref{*word}.load() - 1;
    if (index >= entries().size() || entries()[index].id != id) {
        index = indexById(id);
        if (index == entries().size() && !addEntry(id)) return 0;
        if (word != nullptr) { std::atomic_ref{*word}.store(index + 1); }
    }
    return entries()[index].handle;
}

} // namespace

} // namespace host

extern "C" xos_Sem xos_SemNamedMutexCreate(int id, int flags, int reserved, uint32_t* word) {
    auto const create = [=] { return host::handleById(id, word); };
    return host::call<xos_Sem>(host::Function::xos_SemNamedMutexCreate, 0, create, id, flags, reserved, word);
}
