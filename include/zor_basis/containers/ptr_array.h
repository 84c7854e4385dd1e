/// \file
/// `PtrArray<T>`: a growable array of pointers that does not own the objects they point to.
///
/// An iteration from `begin()` to `end()` visits every slot below the size, including skipped slots, which are null.
///
///     PtrArray<Page> pages;
///     pages.insertBack(&cover);
///     for (Page* page : pages)
///         if (page != nullptr) page->render();
///
/// \thread one thread at a time
/// \error the program is aborted if memory is short

#ifndef ZOR_BASIS_CONTAINERS_PTR_ARRAY_H
#define ZOR_BASIS_CONTAINERS_PTR_ARRAY_H

#include "zor_basis/text/char_ops.h"

#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace ZOR_Basis {

template <class T>
class PtrArray {
public:
    /// Constructs an empty array with room for n pointers; 0 counts as 1.
    PtrArray(std::uint64_t n = 8) { extend(n != 0 ? n : 1); }
    PtrArray(PtrArray const& other) : PtrArray(other.capacity_) { *this = other; }
    /// Copies the other's pointers into its own block, of at least the other's capacity.
    PtrArray& operator=(PtrArray const& other) {
        if (this == &other) return *this;
        if (capacity_ < other.capacity_) {
            std::free(slots_);
            slots_ = makeSlots(capacity_ = other.capacity_);
            count_ = capacity_;
        }
        if (other.count_ != 0) std::memcpy(slots_, other.slots_, other.count_ * sizeof(T*));
        if (other.count_ < count_) std::memset(slots_ + other.count_, 0, (count_ - other.count_) * sizeof(T*));
        count_ = other.count_;
        return *this;
    }
    /// Releases the block, not the objects.
    ~PtrArray() { std::free(slots_); }

    /// Appends a pointer.
    /// \return its index
    std::uint64_t insertBack(T* pointer) {
        if (count_ == capacity_) extend(2 * capacity_);
        slots_[count_] = pointer;
        return count_++;
    }

    /// Stores a pointer at an index; skipped slots become null.
    void set(T* pointer, std::uint64_t index) {
        if (index >= capacity_) extend(index + 1);
        slots_[index] = pointer;
        if (index >= count_) count_ = index + 1;
    }

    /// The pointer at an index; null at the size and beyond.
    template <detail::Index I>
    T* operator[](I index) const {
        auto const i = static_cast<std::uint64_t>(index);
        return i < count_ ? slots_[i] : nullptr;
    }

    /// One more than the highest index in use.
    std::uint64_t size() const { return count_; }

    /// The slots below the size; they move when the array grows.
    T** begin() { return slots_; }
    T** end() { return slots_ + count_; }
    T* const* begin() const { return slots_; }
    T* const* end() const { return slots_ + count_; }

protected:
    /// Makes room for n pointers; a new block has at least twice the previous capacity.
    void extend(std::uint64_t n) {
        if (n <= capacity_) return;
        std::uint64_t const capacity = n > 2 * capacity_ ? n : 2 * capacity_;
        T** const slots = makeSlots(capacity);
        if (count_ != 0) std::memcpy(slots, slots_, count_ * sizeof(T*));
        if (capacity <= FEW) std::memset(slots + count_, 0, (capacity - count_) * sizeof(T*));
        std::free(slots_);
        slots_ = slots;
        capacity_ = capacity;
    }

    /// The slots, how many there are, and how many are in use.
    std::uint64_t capacity_ = 0;
    std::uint64_t count_ = 0;
    T** slots_ = nullptr;

private:
    /// Up to this number, clearing a block costs less than getting a cleared block from the runtime.
    static constexpr std::uint64_t FEW = 128;

    /// Returns null slots, or, if they are few, slots that the caller must clear.
    static T** makeSlots(std::uint64_t n) {
        void* const slots = n <= FEW ? std::malloc(n * sizeof(T*)) : std::calloc(n, sizeof(T*));
        if (slots == nullptr) std::abort();
        return static_cast<T**>(slots);
    }
};

} // namespace ZOR_Basis

#endif
