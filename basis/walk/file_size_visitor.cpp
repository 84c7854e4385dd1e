#include "zor_basis/walk/file_size_visitor.h"

#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/walk/file_iterator.h"

namespace ZOR_Basis {

bool FileSizeVisitor::perform(FileEntry* entry) {
    total_ += Get(entry->getFullPath(), recursive_);
    return true;
}

std::int64_t FileSizeVisitor::Get(Str const& path, bool recursive) {
    FPath const whole(path);
    FStat const entry(whole);
    // Listing a link would follow it out of the tree, or around in it for ever.
    if (!entry.exist() || entry.type() == FStat::ST_LINK) return 0;
    if (entry.isFile()) return static_cast<std::int64_t>(entry.size());
    FileSizeVisitor sum(true);
    FileIterator walk(whole, recursive ? LOOK_BOTH : LOOK_FILES, nullptr, nullptr);
    return walk.doIt(&sum, false, false) ? sum.total() : 0;
}

} // namespace ZOR_Basis
