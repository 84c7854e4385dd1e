/// \file
/// `MemMgr`: an allocation policy that is chosen at run time. `MemMgrPtr`: owns one.
///
/// | made by | `alloc(size)` | `alloc()` | `free(p, size)` | `free(p)` |
/// |---|---|---|---|---|
/// | `makeStd` | the runtime's heap | null | the runtime's heap | the runtime's heap |
/// | `makeSmlBlk` | an element; null if `size` exceeds it | an element | returns it | returns it |
/// | `makeStack` | always the end of the current block | null | the runtime's heap | does nothing |
///
/// Sizes are in bytes. If memory is short, `alloc` returns null. Freeing null does nothing.
///
///     MemMgrPtr nodes(MemMgr::makeSmlBlk(sizeof(Node), 100, 10000, alignof(Node)));
///     if (void* place = nodes->alloc()) use(new (place) Node);
///
/// \thread the standard manager: like the runtime's heap; the others: one thread at a time

#ifndef ZOR_BASIS_MEMORY_MEM_MGR_H
#define ZOR_BASIS_MEMORY_MEM_MGR_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

#include <cstddef>
#include <cstdint>

namespace ZOR_Basis {

/// The interface and the standard manager.
class ZB_API MemMgr {
public:
    MemMgr(MemMgr const&) = delete;
    MemMgr& operator=(MemMgr const&) = delete;

    /// Without a size: allocates one element of the manager's fixed size, if it has one.
    ZB_OVERLOADED_SLOTS(virtual void* alloc(std::uint64_t size), virtual void* alloc());
    ZB_OVERLOADED_SLOTS(virtual void free(void* p, std::uint64_t size), virtual void free(void* p));
    /// Releases all memory that the manager has allocated, freed by the user or not.
    virtual ~MemMgr();

    /// Returns the standard manager, one for the whole process. It must not be deleted or passed to a `MemMgrPtr`.
    static MemMgr* makeStd();

    /// Makes a manager of elements of one size, carved from chunks without a header for each element.
    ///
    /// The element freed last is allocated again first. Chunks are carved from their end downwards. This function
    /// allocates the first one, with room for the larger of `count` and 16 elements, at most 1 MiB; each further chunk
    /// has twice the size, up to room for `maxCount` elements, at most 4 MiB. No memory returns to the heap before the
    /// manager is deleted.
    /// \param elemSize  is rounded up to the alignment
    /// \param count  is the number of elements expected at first
    /// \param maxCount  is the largest number of elements expected; it has an effect only from four times the first
    ///     number on, otherwise chunks stop growing at four times the first
    /// \param align  selects the alignment: 2 if less than 4, 4 if less than 8, otherwise 8
    /// \kept memory-01: elements smaller than a pointer are not widened, so freeing one writes into its neighbour; such
    ///     elements must only be allocated
    /// \error `alloc` returns null for elements that do not fit the largest chunk
    /// \pre an element that is freed came from this manager and is freed once
    /// \return owned by the caller; null if memory is short
    static MemMgr* makeSmlBlk(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align);

    /// Makes a manager that returns the end of a block.
    /// \kept memory-02: the manager never advances: every `alloc(size)` returns the same address, one past the block,
    ///     whatever the size
    /// \param blockSize  is the size of the buffer, or, without one, of the block that the first `alloc(size)` takes
    ///     from the heap
    /// \param buffer  is borrowed until the manager is deleted; may be null
    /// \return owned by the caller; null if memory is short
    static MemMgr* makeStack(std::uint64_t blockSize, void* buffer);

protected:
    constexpr MemMgr() = default;

    /// The one standard manager.
    static MemMgr _Only;
};

/// Owns a manager for the duration of a scope. It lives on the stack or in another object, never on the heap by itself.
class ZB_API MemMgrPtr : public detail::NotDeletable<MemMgrPtr> {
public:
    /// \param manager  is adopted; may be null, must not be the standard manager
    MemMgrPtr(MemMgr* manager = nullptr) : manager_(manager) {}
    MemMgrPtr(MemMgrPtr const&) = delete;
    MemMgrPtr& operator=(MemMgrPtr const&) = delete;
    ~MemMgrPtr() { delete manager_; }

    /// The manager, which may be null.
    operator MemMgr*() const { return manager_; }
    MemMgr* operator->() const { return manager_; }

private:
    static void* operator new(std::size_t) noexcept { return nullptr; }
    static void operator delete(void*) noexcept {}

    MemMgr* manager_;
};

} // namespace ZOR_Basis

#endif
