/// \file
/// `MemMgr`: allocation policies that are chosen at run time; `MemMgrPtr`: the owner of one.
///
/// | made by | `alloc(size)` | `alloc()` | `free(p, size)` | `free(p)` |
/// |---|---|---|---|---|
/// | `makeStd` | the runtime's heap | null | the runtime's heap | the runtime's heap |
/// | `makeSmlBlk` | an element, null for more than its size | an element | gives it back | gives it back |
/// | `makeStack` | always the end of the current block | null | the runtime's heap | nothing |
///
/// Sizes are in bytes. Null is what comes back where memory runs short, and freeing null does nothing.
///
/// \thread  the standard manager as the runtime's heap; the others one thread at a time

#ifndef ZOR_BASIS_MEMORY_MEM_MGR_H
#define ZOR_BASIS_MEMORY_MEM_MGR_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

#include <cstddef>
#include <cstdint>

namespace ZOR_Basis {

/// The interface, and the standard manager.
class ZB_API MemMgr {
public:
    MemMgr(MemMgr const&) = delete;
    MemMgr& operator=(MemMgr const&) = delete;

    virtual void* alloc(std::uint64_t size);
    /// One element of the manager's fixed size, where it has one.
    virtual void* alloc();
    virtual void free(void* p, std::uint64_t size);
    virtual void free(void* p);
    /// Releases everything that a manager has taken, given back or not.
    virtual ~MemMgr();

    /// The standard manager, one for the whole process. Never deleted, never given to a `MemMgrPtr`.
    static MemMgr* makeStd();

    /// A manager of elements of one size, carved from chunks of memory without any header.
    ///
    /// The last element freed is the first to be allocated again. Chunks are carved from their end downwards; the first is
    /// made at once and has room for the larger of `count` and 16 elements, at most 1 MiB; each next one has twice the
    /// size, up to room for `maxCount`, at most 4 MiB. Nothing goes back to the heap before the manager is deleted.
    /// \param elemSize  rounded up to the alignment
    /// \param count     elements expected at first
    /// \param maxCount  elements expected at most; counts only from four times the first number on, else chunks stop
    ///                  growing at four times the first
    /// \param align     2 for less than 4, 4 for less than 8, else 8
    /// \kept memory-01: elements smaller than a pointer are not widened, so that freeing one writes into its neighbour;
    ///     such elements are only allocated
    /// \error elements that do not fit the largest chunk are refused: `alloc` gives null
    /// \pre what is freed came from this manager and is freed once
    /// \return owned by the caller; null when memory runs out
    static MemMgr* makeSmlBlk(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align);

    /// A manager that hands out the end of a block.
    /// \kept memory-02: it never advances: every `alloc(size)` gives the same address, one past the block, whatever the size
    /// \param blockSize  of the buffer, or of the block that the first `alloc(size)` takes from the heap without one
    /// \param buffer  borrowed until the manager is deleted; may be null
    /// \return owned by the caller; null when memory runs out
    static MemMgr* makeStack(std::uint64_t blockSize, void* buffer);

protected:
    constexpr MemMgr() = default;

    static MemMgr _Only;
};

/// Owns a manager for the length of a scope. Lives on the stack or in another object, never on the heap by itself.
class ZB_API MemMgrPtr : public detail::NotDeletable<MemMgrPtr> {
public:
    /// \param manager  adopted; may be null, is never the standard manager
    MemMgrPtr(MemMgr* manager = nullptr) : manager_(manager) {}
    MemMgrPtr(MemMgrPtr const&) = delete;
    MemMgrPtr& operator=(MemMgrPtr const&) = delete;
    ~MemMgrPtr() { delete manager_; }

    operator MemMgr*() const { return manager_; }
    MemMgr* operator->() const { return manager_; }

private:
    static void* operator new(std::size_t) noexcept { return nullptr; }
    static void operator delete(void*) noexcept {}

    MemMgr* manager_;
};

} // namespace ZOR_Basis

#endif
