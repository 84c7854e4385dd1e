// Any bytes as allocations and releases of small blocks: none overlaps another, each keeps what is written into it, and
// all are aligned. The first bytes are the sizes.

#include "fuzz/target.h"

#include "basis/memory/sm_bl_mem_mgr.h"

#include <algorithm>
#include <cstring>
#include <iterator>
#include <map>

using namespace ZOR_Basis;

namespace {

/// The smallest element that holds the address of the next free one.
constexpr std::uint64_t SMALLEST = sizeof(void*);
constexpr std::size_t MOST_BLOCKS = 4096;

/// The blocks in use, each with the byte that fills it.
class Blocks {
public:
    Blocks(SmBlMemMgr& manager, std::uint64_t size, std::uint64_t align)
        : manager_(manager), size_(size), align_(align) {}

    void allocate(std::uint64_t asked) {
        auto* const block = static_cast<char*>(asked % 2 == 0 ? manager_.alloc() : manager_.alloc(asked % (size_ + 1)));
        require(block != nullptr && reinterpret_cast<std::uintptr_t>(block) % align_ == 0);
        auto const above = blocks_.lower_bound(block);
        require(above == blocks_.end() || above->first >= block + size_);
        require(above == blocks_.begin() || std::prev(above)->first + size_ <= block);
        std::memset(block, ++mark_, size_);
        blocks_[block] = mark_;
    }
    void release(std::uint64_t which) {
        if (blocks_.empty()) return;
        auto const place = std::next(blocks_.begin(), static_cast<std::ptrdiff_t>(which % blocks_.size()));
        char* const block = place->first;
        require(
            std::all_of(block, block + size_, [&](char c) { return static_cast<unsigned char>(c) == place->second; }));
        manager_.free(block);
        blocks_.erase(place);
    }
    bool isFull() const { return blocks_.size() == MOST_BLOCKS; }

private:
    SmBlMemMgr& manager_;
    std::uint64_t const size_;
    std::uint64_t const align_;
    std::map<char*, unsigned char> blocks_;
    unsigned char mark_ = 0;
};

void runSmallBlocks(unsigned char const* data, std::size_t size) {
    RandomBytes bytes(data, size);
    std::uint64_t const elementSize = SMALLEST + bytes.byte();
    std::uint64_t const count = bytes.byte();
    std::uint64_t const most = bytes();
    std::uint64_t const align = bytes.byte() % 16;
    SmBlMemMgr manager(elementSize, count, most, align);
    Blocks blocks(manager, elementSize, align < 4 ? 2 : align < 8 ? 4 : 8);
    require(manager.alloc(elementSize + 8) == nullptr);
    while (!bytes.isUsedUp()) {
        std::uint64_t const act = bytes.byte();
        if (act % 8 < 5 && !blocks.isFull()) {
            for (std::uint64_t n = 1 + act / 8; n > 0; --n) blocks.allocate(n);
        } else {
            blocks.release(bytes());
        }
        require(manager.isConsistent());
    }
}

FuzzTarget const SMALL_BLOCKS("small_blocks", runSmallBlocks);

} // namespace
