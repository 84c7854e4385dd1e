#include "zor_basis/walk/file_size_visitor.h"

#include "basis/ground/choices.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/walk/file_iterator.h"

namespace ZOR_Basis {
namespace {

/// Sums one directory. Of files it takes the size that the walk has just asked for.
class DirectorySum : public FileVisitor {
public:
    bool perform(FileEntry* entry) override {
        total_ += entry->isFile() ? static_cast<std::int64_t>(entry->getSize())
                                  : FileSizeVisitor::Get(entry->getFullPath(), DEEP);
        return true;
    }
    std::int64_t total() const { return total_; }

private:
    std::int64_t total_ = 0;
};

} // namespace

bool FileSizeVisitor::perform(FileEntry* entry) {
    total_ += Get(entry->getFullPath(), recursive_);
    return true;
}

std::int64_t FileSizeVisitor::Get(Str const& path, bool recursive) {
    FPath const whole(path);
    FStat const entry(whole);
    // Listing a link would follow it out of the tree, or around in it forever.
    if (!entry.exist() || entry.type() == FStat::ST_LINK) return 0;
    if (entry.isFile()) return static_cast<std::int64_t>(entry.size());
    DirectorySum sum;
    FileIterator walk(whole, recursive ? LOOK_BOTH : LOOK_FILES, nullptr, nullptr);
    return walk.doIt(&sum, ONE_LEVEL, IGNORING_FAILURES) ? sum.total() : 0;
}

} // namespace ZOR_Basis
