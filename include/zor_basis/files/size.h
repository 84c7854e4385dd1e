/// \file
/// `Size`: an unsigned 64-bit count as a value type that can be a key of ordered and hashed containers.

#ifndef ZOR_BASIS_FILES_SIZE_H
#define ZOR_BASIS_FILES_SIZE_H

#include "zor_basis/export.h"

#include <concepts>
#include <cstdint>
#include <functional>
#include <type_traits>

namespace ZOR_Basis {

class Size {
public:
    Size() = default;
    /// A number of bytes.
    Size(std::uint64_t value) : value_(value) {}
    /// The absolute value of an `int`.
    /// \kept stat-01: the absolute value is computed in 32 bits and then sign-extended, so the most negative `int`
    ///     becomes 0xFFFFFFFF80000000
    Size(int value) : value_(absolute(value)) {}
    /// Any other integer by its value.
    template <std::integral I>
    Size(I value) : value_(static_cast<std::uint64_t>(value)) {}

    /// The number, which also is its hash.
    std::uint64_t get() const { return value_; }
    std::uint64_t val() const { return value_; }
    std::uint64_t hash() const { return value_; }
    /// Sets the number.
    void set(std::uint64_t value) { value_ = value; }

    /// Compare the numbers.
    bool operator==(Size const& other) const { return value_ == other.value_; }
    bool operator!=(Size const& other) const { return value_ != other.value_; }
    bool operator<(Size const& other) const { return value_ < other.value_; }

private:
    // kept stat-01: negating in unsigned arithmetic leaves the one `int` without a counterpart as it is.
    static std::uint64_t absolute(int value) {
        std::uint32_t const bits = static_cast<std::uint32_t>(value);
        return static_cast<std::uint64_t>(static_cast<std::int32_t>(value < 0 ? 0u - bits : bits));
    }

    std::uint64_t value_ = 0;
};

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::Size> {
    std::size_t operator()(ZOR_Basis::Size const& size) const noexcept { return size.hash(); }
};

#endif
