/// \file
/// The records of a dictionary's file, read and written in large pieces.

#ifndef BASIS_STORE_DICT_RECORDS_H
#define BASIS_STORE_DICT_RECORDS_H

#include "zor_basis/files/i_file.h"
#include "zor_basis/store/blob.h"

#include <cstdint>

namespace ZOR_Basis {

/// Bytes of the reader's buffer, valid until it goes on.
struct RecordBytes {
    char const* place = nullptr;
    std::uint32_t size = 0;
};

/// Reads one record after the other. Its buffer grows with what the file has given so far, never with what a length
/// announces.
class RecordReader {
public:
    explicit RecordReader(IFile& file) : file_(file) {}
    RecordReader(RecordReader const&) = delete;
    RecordReader& operator=(RecordReader const&) = delete;

    /// Goes to the next record.
    /// \return false where no complete one is left
    bool next();
    RecordBytes key() const { return bytes(0); }
    RecordBytes value() const { return bytes(1); }

    /// Where in the file the record begins, once `next` has failed the end of all complete ones.
    std::uint64_t position() const { return position_; }
    /// The bytes that the file has given.
    std::uint64_t arrived() const { return arrived_; }

private:
    struct Field {
        std::uint64_t offset; // from the record's begin
        std::uint32_t size;
    };

    RecordBytes bytes(int field) const { return {buffer_.val() + at_ + fields_[field].offset, fields_[field].size}; }
    bool readField(Field& field);
    bool has(std::uint64_t bytes);
    bool fill();
    bool makeRoom();

    IFile& file_;
    Blob buffer_;
    std::uint64_t at_ = 0;     // where the record begins in the buffer
    std::uint64_t length_ = 0; // what is known of it
    std::uint64_t position_ = 0;
    std::uint64_t arrived_ = 0;
    Field fields_[2] = {};
    bool ended_ = false;
};

/// Gathers records and writes them in pieces.
class RecordWriter {
public:
    explicit RecordWriter(IFile& file);
    RecordWriter(RecordWriter const&) = delete;
    RecordWriter& operator=(RecordWriter const&) = delete;

    /// Adds the stored form of a blob.
    /// \return false once something could not be written
    bool add(Blob const& blob);
    /// Writes what is still gathered.
    bool finish();

private:
    bool put(void const* bytes, std::uint64_t n);

    IFile& file_;
    Blob buffer_;
};

} // namespace ZOR_Basis

#endif
