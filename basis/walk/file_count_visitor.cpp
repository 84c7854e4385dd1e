#include "zor_basis/walk/file_count_visitor.h"

#include "basis/ground/choices.h"
#include "zor_basis/walk/file_iterator.h"

namespace ZOR_Basis {

bool FileCountVisitor::perform(FileEntry* /*entry*/) {
    ++count_;
    return true;
}

bool FileCountVisitor::stop() {
    // kept walk-08: the count has 32 bits and is what callers read, so a limit beyond it means nothing to them.
    return limit_ != 0 && count_ >= static_cast<std::int32_t>(static_cast<std::uint32_t>(limit_));
}

int FileCountVisitor::Get(Str const& path, LookForType type, std::uint64_t limit) {
    FileCountVisitor counter(limit);
    // A walk fails only where its visitor does, and counting never fails.
    FileIterator(path, type, nullptr, nullptr).doIt(&counter, ONE_LEVEL, IGNORING_FAILURES);
    return counter.total();
}

} // namespace ZOR_Basis
