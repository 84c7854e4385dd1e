/// \file
/// Transfers of any length through calls of the runtime that limit the length of one transfer.

#ifndef BASIS_FILES_PIECES_H
#define BASIS_FILES_PIECES_H

#include <cstdint>

namespace ZOR_Basis {

inline constexpr std::uint64_t TRANSFER_FAILED = ~std::uint64_t{0};
/// The runtime transfers this many bytes in one call on every system.
inline constexpr std::uint64_t LARGEST_PIECE = 0x40000000;

/// Calls `transfer(place, bytes)` until everything is transferred or a call transfers less. It returns the bytes done,
/// or a negative number for a failure.
/// \return the bytes transferred, all ones where the very first call failed
template <class Byte, class Transfer>
std::uint64_t inPieces(Byte* buffer, std::uint64_t n, Transfer transfer) {
    std::uint64_t done = 0;
    do {
        std::uint64_t const piece = n - done < LARGEST_PIECE ? n - done : LARGEST_PIECE;
        std::int64_t const moved = transfer(buffer + done, static_cast<unsigned>(piece));
        if (moved < 0) return done != 0 ? done : TRANSFER_FAILED;
        done += static_cast<std::uint64_t>(moved);
        if (static_cast<std::uint64_t>(moved) != piece) break;
    } while (done < n);
    return done;
}

} // namespace ZOR_Basis

#endif
