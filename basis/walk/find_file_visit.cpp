#include "zor_basis/walk/find_file_visit.h"

#include "basis/ground/choices.h"
#include "zor_basis/walk/file_iterator.h"

#include <cstring>

namespace ZOR_Basis {

void FindFileVisit::searchName(Str const& name) {
    key_ = name;
    key_.toLower();
    byName_ = true;
}

void FindFileVisit::searchExt(Str const& ext) {
    // kept walk-09: extensions are given without their dot; one that has it finds names with two dots.
    key_ = ".";
    key_.add(ext);
    key_.toLower();
    byName_ = false;
}

void FindFileVisit::clear() {
    path_.clear();
    key_.clear();
    count_ = 0;
}

bool FindFileVisit::matches(FileEntry const& entry) const {
    if (key_.empty()) return true;
    BufStr<255> name(entry.getName());
    std::uint64_t const size = name.size();
    if (size < key_.size() || (byName_ && size != key_.size())) return false;
    name.toLower();
    return std::memcmp(name.c_str() + (size - key_.size()), key_.c_str(), key_.size()) == 0;
}

bool FindFileVisit::perform(FileEntry* entry) {
    if (!matches(*entry)) return true;
    if (keepLast_ || count_ == 0) path_.assign(entry->getDir(), entry->getName());
    ++count_;
    return true;
}

bool FindFileVisit::stop() { return maxCount_ >= 1 && count_ >= maxCount_; }

} // namespace ZOR_Basis

int zbFindFile(ZOR_Basis::Str const& dir, char const* wildcard, ZOR_Basis::LookForType type, ZOR_Basis::FPath& found,
               bool firstOnly, bool deep) {
    ZOR_Basis::FileIterator walk(dir, type, wildcard, nullptr);
    ZOR_Basis::FindFileVisit search(!firstOnly, firstOnly ? 1 : 0);
    walk.doIt(&search, deep, ZOR_Basis::IGNORING_FAILURES);
    found = search.getPath();
    return search.getNum();
}
