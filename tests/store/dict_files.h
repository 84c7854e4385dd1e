/// \file
/// Dictionaries and the bytes of their files, for the tests of both.

#ifndef TESTS_STORE_DICT_FILES_H
#define TESTS_STORE_DICT_FILES_H

#include <zor_basis/store/dict.h>

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

using BlobDict = ZOR_Basis::Dict<ZOR_Basis::Blob, ZOR_Basis::Blob>;
using BlobEntry = ZOR_Basis::DictEntry<ZOR_Basis::Blob, ZOR_Basis::Blob>;
using Pair = std::pair<std::string, std::string>;
using Pairs = std::vector<Pair>;

inline ZOR_Basis::Blob blob(std::string const& bytes) { return {bytes.size(), bytes.data()}; }
inline std::string text(ZOR_Basis::Blob const& bytes) {
    return bytes.size() != 0 ? std::string(bytes.val(), bytes.size()) : "";
}

inline std::string length(std::uint32_t n) { return std::string(reinterpret_cast<char const*>(&n), 4); }
inline std::string field(std::string const& bytes) { return length(static_cast<std::uint32_t>(bytes.size())) + bytes; }
inline std::string fileOf(Pairs const& pairs) {
    std::string bytes;
    for (Pair const& pair : pairs) bytes += field(pair.first) + field(pair.second);
    return bytes;
}

/// Has a dictionary hold the pairs in their order.
inline void fill(BlobDict& dict, Pairs const& pairs) {
    dict.clean();
    for (auto pair = pairs.rbegin(); pair != pairs.rend(); ++pair) dict.set(blob(pair->first), blob(pair->second));
}

#endif
