#include "zor_basis/store/blob.h"

#include "basis/ground/choices.h"
#include "basis/text/wipe.h"
#include "zor_basis/files/i_file.h"

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <cstring>

namespace ZOR_Basis {
namespace {

static_assert(std::endian::native == std::endian::little, "the stored length has its lowest byte first");

// The standard's functions take no null, not even for no bytes.
void copyBytes(char* to, void const* from, std::uint64_t n) {
    if (n != 0) std::memmove(to, from, n);
}

int compareBytes(char const* a, char const* b, std::uint64_t n) { return n != 0 ? std::memcmp(a, b, n) : 0; }

} // namespace

void Blob::freeBuf() {
    if (buffer_ == nullptr) return;
    std::free(buffer_);
    buffer_ = nullptr;
}

Blob& Blob::operator=(Blob const& other) {
    if (this != &other) copy(other.size_, other.buffer_);
    return *this;
}

Blob::~Blob() { Blob::freeBuf(); }

/// A block of n bytes that begins with so many of the present ones.
char* Blob::makeBlock(std::uint64_t n, std::uint64_t kept) const {
    char* const block = static_cast<char*>(std::malloc(n));
    if (block != nullptr) copyBytes(block, buffer_, kept);
    return block;
}

void Blob::replaceBlock(char* block, std::uint64_t n) {
    if (buffer_ != nullptr) freeBuf();
    buffer_ = block;
    capacity_ = n;
}

void Blob::copy(std::uint64_t n, char const* bytes) {
    if (capacity_ >= n) {
        copyBytes(buffer_, bytes, n);
    } else {
        char* const block = makeBlock(n, 0);
        if (block == nullptr) return;
        // The source may lie in the old block.
        copyBytes(block, bytes, n);
        size_ = 0;
        replaceBlock(block, n);
    }
    size_ = n;
}

void Blob::add(std::uint64_t n, void const* bytes) {
    if (n == 0 || bytes == nullptr) return;
    std::uint64_t const size = size_ + n;
    if (size < n) return;
    if (capacity_ >= size) {
        copyBytes(buffer_ + size_, bytes, n);
    } else {
        char* const block = makeBlock(size, size_);
        if (block == nullptr) return;
        copyBytes(block + size_, bytes, n);
        replaceBlock(block, size);
    }
    size_ = size;
}

void Blob::alloc(std::uint64_t n, bool keep) {
    // kept blob-01: a caller that needs an empty blob clears it.
    if (capacity_ >= n) return;
    char* const block = makeBlock(n, keep ? size_ : 0);
    if (block == nullptr) return;
    if (!keep) size_ = 0;
    replaceBlock(block, n);
}

bool Blob::operator==(Blob const& other) const {
    return size_ == other.size_ && compareBytes(buffer_, other.buffer_, size_) == 0;
}

bool Blob::operator<(Blob const& other) const {
    int const order = compareBytes(buffer_, other.buffer_, std::min(size_, other.size_));
    return order != 0 ? order < 0 : size_ < other.size_;
}

bool Blob::read(IFile* file) {
    std::uint32_t length = 0;
    if (file == nullptr || file->read(&length, sizeof length) != sizeof length) return false;
    alloc(length, DISCARDING_BYTES);
    if (capacity_ < length) return false;
    // kept blob-02: the bytes behind those that came are what was in the block.
    size_ = length;
    return length == 0 || file->read(buffer_, length) == length;
}

bool Blob::write(IFile* file) const {
    // kept blob-03: the stored length has no more room.
    std::uint32_t const length = static_cast<std::uint32_t>(size_);
    if (file == nullptr || file->write(&length, sizeof length) != sizeof length) return false;
    return size_ == 0 || file->write(buffer_, size_) == size_;
}

void SecretBlob::freeBuf() {
    wipe(buf(), sizeBuf());
    Blob::freeBuf();
}

SecretBlob::~SecretBlob() { SecretBlob::freeBuf(); }

} // namespace ZOR_Basis
