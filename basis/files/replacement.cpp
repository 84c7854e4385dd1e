#include "basis/files/replacement.h"

#include "basis/files/last_error.h"
#include "basis/files/platform_flags.h"
#include "basis/files/replacement_impl.h"
#include "basis/files/system_calls.h"
#include "basis/files/whole_entry.h"
#include "basis/ground/choices.h"

#include <atomic>

namespace ZOR_Basis {
namespace {

constexpr int MOST_ATTEMPTS = 100;

/// A name in the folder of the target: very probably a new one, and short even if the target's is long.
void nameBeside(FPath const& target, FPath& temporary) {
    static std::atomic<std::uint64_t> counter{0};
    temporary = target;
    cutToFolder(temporary);
    BufStr<255>& text = temporary;
    text << ".zb-" << processNumber() << "-" << systemCalls.tick() << "-" << ++counter << ".tmp";
}

} // namespace

Replacement::~Replacement() {
    if (temporary_.empty()) return;
    KeepLastError const kept;
    file_.reset();
    removeFile(temporary_);
}

bool Replacement::open(char const* path, int mode) {
    if (!followLinks(path, target_) || !makeTemporary()) return false;
    file_.emplace(temporary_.c_str(), mode);
    return file_->isOpen();
}

bool Replacement::makeTemporary() {
    FPath name;
    for (int attempt = 0; attempt < MOST_ATTEMPTS; ++attempt) {
        nameBeside(target_, name);
        Made const made = makeBeside(name, target_);
        if (made == Made::NAME_TAKEN) continue;
        if (made == Made::YES) temporary_ = name;
        return made == Made::YES;
    }
    return false;
}

bool Replacement::putInPlace() {
    if (!file_->flush() || !file_->close()) return false;
    if (xos_FileMove(target_, temporary_, overwriteIf(OVERWRITING)) != 0) return false;
    temporary_.clear();
    return true;
}

} // namespace ZOR_Basis
