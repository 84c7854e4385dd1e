/// \file
/// `Blob`: bytes on the heap, in a block of exactly the size that was needed. `SecretBlob`: one for key material, whose
/// blocks are filled with zeros before they are released.
///
/// A blob holds bytes and no text: nothing terminates them. Its block never shrinks and grows exactly, without doubling or
/// rounding, so whoever adds many small pieces calls `alloc` first. Sources may lie in the blob's own block.
///
/// **Stored form**, as files and dictionaries keep it: four bytes, the number of data bytes with the lowest byte first, and
/// then the data.
///
/// \thread  one thread at a time
/// \error  where memory cannot be had a blob stays as it is; `sizeBuf()` then tells

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
    /// Empty, without a block.
    Blob() = default;
    /// `copy` at once.
    Blob(std::uint64_t n, char const* bytes) { copy(n, bytes); }
    Blob(Blob const& other) { copy(other.size_, other.buffer_); }
    /// The other's bytes, by `copy`; nothing for itself.
    Blob& operator=(Blob const& other);
    /// Releases the block as it is.
    virtual ~Blob();

    /// Replaces the bytes. The block stays where it has room for them.
    /// \pre there are n bytes
    /// \cost one allocation at most, of exactly n bytes
    void copy(std::uint64_t n, char const* bytes);
    /// Appends bytes; nothing for none and for null.
    /// \cost one allocation at most, of exactly the new size
    void add(std::uint64_t n, void const* bytes);
    /// Makes room for n bytes, if there is less.
    /// \param keep  a new block takes the bytes over; without, it leaves the blob empty
    /// \kept blob-01: where there is room already nothing changes, not even the size, whatever `keep` says
    void alloc(std::uint64_t n, bool keep);

    /// Sets the size after the block has been filled directly. \pre n is at most `sizeBuf()`: nothing is checked
    void setSize(std::uint64_t n) { size_ = n; }
    /// Sets the size to 0; the block stays, and so do the bytes in it.
    void clear() { size_ = 0; }

    /// The block; null without one.
    char* buf() { return buffer_; }
    char const* val() const { return buffer_; }
    /// Bytes in use, and bytes of the block.
    std::uint64_t size() const { return size_; }
    std::uint64_t sizeBuf() const { return capacity_; }

    bool operator==(Blob const& other) const;
    bool operator!=(Blob const& other) const { return !(*this == other); }
    /// Orders by bytes as unsigned numbers; of two that agree as far as they go the shorter is less.
    bool operator<(Blob const& other) const;

    /// Replaces the bytes by a stored form that is read from a file.
    /// \kept blob-02: after a short read of the data the size is what the stored form announced
    /// \error false and nothing changed, where the four bytes of the length are not there, or where there is no memory for
    ///     as much as they say
    /// \return whether length and data were read in full
    /// \cost one read for each of the two
    bool read(IFile* file);
    /// Writes the stored form. \return whether both length and data were written in full
    /// \kept blob-03: of a size above 4,294,967,295 the length has the low 32 bits, while all bytes follow: nothing can
    ///     read that again
    /// \cost one write for each of the two
    bool write(IFile* file) const;

private:
    char* makeBlock(std::uint64_t n, std::uint64_t kept) const;
    void replaceBlock(char* block, std::uint64_t n);

    char* buffer_ = nullptr;
    std::uint64_t size_ = 0;
    std::uint64_t capacity_ = 0;
};

/// A blob for key material. Every block is filled with zeros, to its whole capacity, before it is released: when another
/// one replaces it, and at the end. `clear` and `copy` into the same block release nothing and so wipe nothing. A `Blob`
/// that is made from it does not wipe its copy.
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

/// Over all bytes in use.
template <>
struct std::hash<ZOR_Basis::Blob> {
    std::size_t operator()(ZOR_Basis::Blob const& blob) const noexcept {
        return std::hash<std::string_view>()({blob.val(), blob.size()});
    }
};

#endif
