/// \file
/// `Blob`: bytes in a heap block of exactly the required size. `SecretBlob`: a blob for key material, whose blocks are
/// filled with zeros before they are released.
///
/// A blob contains bytes, not text: there is no terminator. Its block never shrinks and grows exactly, without doubling
/// or rounding, so a caller that adds many small pieces should call `alloc` first. Sources may lie in the blob's own
/// block.
///
/// **Stored form**, which files and dictionaries contain: four bytes, the number of data bytes with the lowest byte
/// first, and then the data.
///
///     Blob page;
///     page.alloc(size, false);
///     page.setSize(fill(page.buf(), page.sizeBuf()));
///
/// \thread one thread at a time
/// \error if memory is short the blob does not change; check `sizeBuf()`

#ifndef ZOR_BASIS_STORE_BLOB_H
#define ZOR_BASIS_STORE_BLOB_H

#include "zor_basis/export.h"

#include <cstdint>
#include <functional>
#include <string_view>

namespace ZOR_Basis {

class IFile;

class ZB_API Blob {
protected:
    /// Releases the block, if there is one.
    virtual void freeBuf();

public:
    /// Constructs an empty blob without a block.
    Blob() = default;
    /// Constructs a blob and calls `copy`.
    /// \kept blob-04: the size comes before the bytes, here and in all functions
    Blob(std::uint64_t n, char const* bytes) { copy(n, bytes); } // kept blob-04
    Blob(Blob const& other) { copy(other.size_, other.buffer_); }
    /// Copies the other's bytes by `copy`. Self-assignment does nothing.
    Blob& operator=(Blob const& other);
    /// Releases the block without clearing it.
    virtual ~Blob();

    /// Replaces the bytes. Keeps the block if it has room for them.
    /// \pre `bytes` points to n bytes
    /// \cost one allocation at most, of exactly n bytes
    void copy(std::uint64_t n, char const* bytes);
    /// Appends bytes; does nothing if n is 0 or `bytes` is null.
    /// \cost one allocation at most, of exactly the new size
    void add(std::uint64_t n, void const* bytes);
    /// Makes room for n bytes, if there is less room.
    /// \param keep  copies the bytes into a new block; false: a new block leaves the blob empty
    /// \kept blob-01: if there is enough room nothing changes, not even the size, whatever `keep` says
    void alloc(std::uint64_t n, bool keep);

    /// Sets the size after the block has been filled directly.
    /// \pre n is at most `sizeBuf()`, which is not checked
    void setSize(std::uint64_t n) { size_ = n; }
    /// Sets the size to 0; keeps the block and the bytes in it.
    void clear() { size_ = 0; }

    /// The block; null if there is none.
    char* buf() { return buffer_; }
    char const* val() const { return buffer_; }
    /// The number of bytes in use, and the number of bytes in the block.
    std::uint64_t size() const { return size_; }
    std::uint64_t sizeBuf() const { return capacity_; }

    /// Compares sizes and bytes.
    bool operator==(Blob const& other) const;
    bool operator!=(Blob const& other) const { return !(*this == other); }
    /// Orders by unsigned bytes; a blob is less than a longer one that begins with it.
    bool operator<(Blob const& other) const;

    /// Replaces the bytes by a stored form, which is read from a file.
    /// \kept blob-02: after a short read of the data the size is the number that the stored form announced
    /// \error false, with nothing changed, if the four bytes of the length cannot be read, or if memory for that length
    ///     is short
    /// \return whether length and data were read in full
    /// \cost one read each for length and data
    bool read(IFile* file);
    /// Writes the stored form.
    /// \return whether both length and data were written in full
    /// \kept blob-03: if the size is above 4,294,967,295, the length has its low 32 bits, but all bytes follow: the
    ///     result cannot be read again
    /// \cost one write each for length and data
    bool write(IFile* file) const;

private:
    char* makeBlock(std::uint64_t n, std::uint64_t kept) const;
    void replaceBlock(char* block, std::uint64_t n);

    char* buffer_ = nullptr;
    std::uint64_t size_ = 0;
    std::uint64_t capacity_ = 0;
};

/// A blob for key material. Every block is filled with zeros, over its whole capacity, before it is released: when
/// another block replaces it, and in the destructor. `clear`, and `copy` into the same block, release nothing and so
/// wipe nothing. A `Blob` that is constructed from it does not wipe its copy.
class ZB_API SecretBlob : public Blob {
protected:
    void freeBuf() override;

public:
    SecretBlob() = default;
    SecretBlob(SecretBlob const& other) = default;
    SecretBlob& operator=(SecretBlob const& other) = default;
    ~SecretBlob() override;
};

static_assert(sizeof(Blob) == 32 && sizeof(SecretBlob) == sizeof(Blob));

} // namespace ZOR_Basis

/// Hashes all bytes in use.
template <>
struct std::hash<ZOR_Basis::Blob> {
    std::size_t operator()(ZOR_Basis::Blob const& blob) const noexcept {
        return std::hash<std::string_view>()({blob.val(), blob.size()});
    }
};

#endif
