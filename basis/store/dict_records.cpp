#include "basis/store/dict_records.h"

#include "basis/ground/choices.h"

#include <algorithm>
#include <cstring>

namespace ZOR_Basis {
namespace {

/// The number of bytes in one read or write.
constexpr std::uint64_t PIECE = 64 * 1024;
constexpr std::uint64_t LENGTH_SIZE = 4;

} // namespace

bool RecordReader::next() {
    at_ += length_;
    position_ += length_;
    length_ = 0;
    return readField(fields_[0]) && readField(fields_[1]);
}

bool RecordReader::readField(Field& field) {
    if (!has(length_ + LENGTH_SIZE)) return false;
    std::memcpy(&field.size, buffer_.val() + at_ + length_, LENGTH_SIZE);
    field.offset = length_ + LENGTH_SIZE;
    length_ = field.offset + field.size;
    return has(length_);
}

/// Whether so many bytes of the record are there, or can be had.
bool RecordReader::has(std::uint64_t bytes) {
    while (buffer_.size() - at_ < bytes) {
        if (!fill()) return false;
    }
    return true;
}

bool RecordReader::fill() {
    if (ended_ || !makeRoom()) return false;
    std::uint64_t const room = buffer_.sizeBuf() - buffer_.size();
    std::uint64_t const come = file_.read(buffer_.buf() + buffer_.size(), room);
    ended_ = come != room;
    if (come > room) return false;
    buffer_.setSize(buffer_.size() + come);
    arrived_ += come;
    return come != 0;
}

/// Sees to it that the buffer is not full: moves the record to the front where half of the buffer is behind it already,
/// else doubles the buffer, which then is at most four times what has come of the record.
bool RecordReader::makeRoom() {
    std::uint64_t const capacity = buffer_.sizeBuf();
    if (buffer_.size() != capacity) return true;
    if (capacity != 0 && at_ >= capacity / 2) {
        buffer_.copy(capacity - at_, buffer_.val() + at_);
        at_ = 0;
        return true;
    }
    buffer_.alloc(std::max(PIECE, 2 * capacity), KEEPING_BYTES);
    return buffer_.sizeBuf() != capacity;
}

RecordWriter::RecordWriter(IFile& file) : file_(file) { buffer_.alloc(PIECE, DISCARDING_BYTES); }

bool RecordWriter::add(Blob const& blob) {
    std::uint32_t const length = static_cast<std::uint32_t>(blob.size());
    return put(&length, sizeof length) && put(blob.val(), blob.size());
}

bool RecordWriter::finish() {
    std::uint64_t const n = buffer_.size();
    buffer_.clear();
    return n == 0 || file_.write(buffer_.val(), n) == n;
}

bool RecordWriter::put(void const* bytes, std::uint64_t n) {
    if (n > buffer_.sizeBuf() - buffer_.size() && !finish()) return false;
    if (n > buffer_.sizeBuf()) return file_.write(bytes, n) == n;
    buffer_.add(n, bytes);
    return true;
}

} // namespace ZOR_Basis
