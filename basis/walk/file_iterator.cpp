#include "zor_basis/walk/file_iterator.h"

#include "basis/files/last_error.h"
#include "basis/files/platform_flags.h"
#include "basis/ground/choices.h"
#include "basis/platform/xos_basics.h"
#include "zor_basis/files/f_stat.h"

namespace ZOR_Basis {
namespace {

/// The kinds of entries that a listing of the platform layer can select.
enum Kind : int { EVERYTHING = 0, DIRECTORIES = 1, FILES = 2 };

// kept walk-01: callers that count and copy use LOOK_ALL for folders; callers that list use it for everything.
constexpr Kind WALKED[] = {DIRECTORIES, FILES, DIRECTORIES, EVERYTHING};
constexpr Kind LISTED[] = {EVERYTHING, FILES, DIRECTORIES, EVERYTHING};

Kind kindOf(Kind const (&table)[4], LookForType type) { return table[type & LOOK_BOTH]; }

bool isPassedOver(char const* name) {
    // kept walk-03: the folder that another system leaves beside the files of a job does not belong to it.
    return xos_StrCmp(name, "__MACOS") == 0;
}

FileEntry entryOf(FPath const& dir, char const* name, bool platformFallback) {
    FStat const status(FPath(dir, name), platformFallback);
    // kept walk-02: visitors distinguish two kinds, and every other kind is removed and copied like a tree.
    if (status.isFile()) return {FStat::ST_FILE, dir, name, status.size(), status.modified()};
    return {FStat::ST_DIR, dir, name, 0, status.modified()};
}

/// The result of one pass: that of the last entry, with the reason if it failed.
class LastResult {
public:
    LastResult& operator=(bool result) {
        result_ = result;
        if (!result) why_ = LastError();
        return *this;
    }
    operator bool() const { return result_; }
    /// The result of the pass after the listing has ended, which sets last errors of its own.
    bool told() const {
        if (!result_) why_.restore();
        return result_;
    }

private:
    bool result_ = true;
    LastError why_;
};

} // namespace

FileIterator::FileIterator(char const* path, LookForType type, char const* wildcard, FileCondition* condition)
    : path_(path), type_(type), wildcard_(wildcard), condition_(condition) {}

FileIterator::FileIterator(Str const& path, LookForType type, char const* wildcard, FileCondition* condition)
    : path_(path), type_(type), wildcard_(wildcard), condition_(condition) {}

FileIterator::FileIterator(LookForType type) : type_(type) {}

FileIterator::FileIterator(FileIterator const& other)
    : path_(other.path_),
      type_(other.type_),
      wildcard_(other.wildcard_),
      condition_(other.condition_),
      crypted_(other.crypted_) {}

FileIterator& FileIterator::operator=(FileIterator const& other) {
    if (this == &other) return *this;
    finish();
    path_ = other.path_;
    type_ = other.type_;
    wildcard_ = other.wildcard_;
    condition_ = other.condition_;
    crypted_ = other.crypted_;
    return *this;
}

FileIterator::~FileIterator() { finish(); }

bool FileIterator::open(bool useWildcard, bool anyCase) {
    finish();
    bool const restricted = useWildcard && !wildcard_.empty();
    handle_ = xos_DirOpenEx(path_, restricted ? wildcard_.c_str() : nullptr, flagIf(crypted_, ENCRYPTED_STORE));
    if (handle_ == 0) return false;
    if (anyCase && (type_ & LOOK_ANYCASE) != 0) xos_DirForceCaseAny(handle_, 1);
    return true;
}

char const* FileIterator::nextName(int kind) {
    return handle_ != 0 ? xos_DirNextEx(handle_, kind, 0, NAMES_AS_STORED) : nullptr;
}

bool FileIterator::doIt(FileVisitor* visitor, bool deep, bool stopOnFalse) {
    bool const result = shallowIteration(visitor, stopOnFalse);
    if (stopOnFalse && !result) return false;
    if (visitor->stop() || !deep) return result;
    return deepIteration(visitor, stopOnFalse);
}

bool FileIterator::doIt(Str const& path, LookForType type, FileVisitor* visitor, char const* wildcard,
                        FileCondition* condition, bool deep, bool stopOnFalse, bool crypted) {
    FileIterator walk(path, type, wildcard, condition);
    walk.setCrypted(crypted);
    return walk.doIt(visitor, deep, stopOnFalse);
}

bool FileIterator::shallowIteration(FileVisitor* visitor, bool stopOnFalse) {
    // kept walk-06: folders come and go during a walk, and a folder that is gone contains nothing.
    if (!open(WITH_WILDCARD, IN_ANY_CASE)) return true;
    bool const result = shallowRide(visitor, stopOnFalse);
    finish();
    return result;
}

bool FileIterator::deepIteration(FileVisitor* visitor, bool stopOnFalse) {
    // kept walk-04: a wildcard selects files, and these lie in folders of any name.
    if (!open(WITHOUT_WILDCARD, IN_EXACT_CASE)) return true;
    bool const result = deepRide(visitor, stopOnFalse);
    finish();
    return result;
}

bool FileIterator::shallowRide(FileVisitor* visitor, bool stopOnFalse) {
    LastResult result;
    while ((result || !stopOnFalse) && !visitor->stop()) {
        char const* const name = nextName(kindOf(WALKED, type_));
        if (name == nullptr) break;
        if (isPassedOver(name)) continue;
        FileEntry entry = entryOf(path_, name, !crypted_);
        if (condition_ != nullptr && !condition_->acceptEntry(&entry)) continue;
        // kept walk-05: a caller that needs every failure stops at the first one or counts them in its visitor.
        result = visitor->perform(&entry);
    }
    return result.told();
}

bool FileIterator::deepRide(FileVisitor* visitor, bool stopOnFalse) {
    LastResult result;
    while ((result || !stopOnFalse) && !visitor->stop()) {
        char const* const name = nextName(DIRECTORIES);
        if (name == nullptr) break;
        if (isPassedOver(name)) continue;
        FileIterator child(*this);
        child.path_.add(name);
        result = child.doIt(visitor, DEEP, stopOnFalse);
    }
    return result.told();
}

bool FileIterator::start(bool useWildcard) { return open(useWildcard, useWildcard); }

char const* FileIterator::next() {
    if (handle_ == 0 && !start(WITH_WILDCARD)) return nullptr;
    while (char const* const name = nextName(kindOf(LISTED, type_))) {
        if (condition_ == nullptr || condition_->acceptName(this, name)) return name;
    }
    finish();
    return nullptr;
}

void FileIterator::finish() {
    if (handle_ == 0) return;
    KeepLastError const keep;
    xos_DirClose(handle_);
    handle_ = 0;
}

} // namespace ZOR_Basis
