/// \file
/// Texts to convert: random ones from a fixed seed, and real ones that Debian ships.
///
/// A row goes through a pool of different texts of one kind and size. One text that is repeated would let the processor
/// predict every branch, which it cannot do in use.

#ifndef BENCH_TEXT_CONVERT_TEXTS_H
#define BENCH_TEXT_CONVERT_TEXTS_H

#include <cstddef>
#include <string>
#include <vector>

namespace bench {

struct Text {
    std::string narrow;
    std::u16string wide;
};

struct Pool {
    /// Kind and size, such as "latin-300B".
    std::string name;
    std::vector<Text> texts;
};

/// All kinds at 30 bytes, 300 bytes and 64 KiB of UTF-8. A real text that is not installed is left out, with a message.
std::vector<Pool> makePools();

} // namespace bench

#endif
