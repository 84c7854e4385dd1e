// Any bytes as the stored form of blobs, one behind the other. Lengths above a megabyte are made smaller beforehand, as
// reading reserves what they announce.

#include "fuzz/target.h"

#include <zor_basis/text/blob.h>

#include "tests/support/memory_file.h"

#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::uint32_t LARGEST = 1'000'000;

template <class B>
void readAll(std::string bytes) {
    MemoryFile file(bytes);
    B blob;
    for (;;) {
        std::uint64_t const at = file.position;
        std::uint64_t const left = file.content.size() - at;
        std::uint32_t length = 0;
        if (left >= sizeof length) {
            std::memcpy(&length, file.content.data() + at, sizeof length);
            length %= LARGEST;
            std::memcpy(file.content.data() + at, &length, sizeof length);
        }
        bool const whole = left >= sizeof length && left - sizeof length >= length;
        std::uint64_t const before = blob.size();
        require(blob.read(&file) == whole);
        require(blob.size() <= blob.sizeBuf());
        require(blob.size() == (left >= sizeof length ? length : before));
        if (!whole) return;
        MemoryFile copy;
        require(blob.write(&copy));
        require(copy.content == file.content.substr(at, sizeof length + length));
    }
}

void runBlob(unsigned char const* data, std::size_t size) {
    std::string const bytes(reinterpret_cast<char const*>(data), size);
    readAll<Blob>(bytes);
    readAll<SecretBlob>(bytes);
}

FuzzTarget const BLOB("blob", runBlob);

} // namespace
