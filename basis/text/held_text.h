/// \file
/// A copy of a source that would be overwritten before it is used.

#ifndef BASIS_TEXT_HELD_TEXT_H
#define BASIS_TEXT_HELD_TEXT_H

#include "zor_basis/text/char_ops.h"

#include <cstdlib>

namespace ZOR_Basis::detail {

/// Short copies lie in the object, longer ones in a block. A copy of length 0 holds nothing.
template <class Char>
class HeldText {
public:
    HeldText(Char const* text, std::uint64_t length) : held_(length != 0) {
        if (length >= INSIDE) {
            block_ = static_cast<Char*>(length < LONGEST ? std::malloc((length + 1) * sizeof(Char)) : nullptr);
            if (block_ == nullptr) std::abort();
        }
        if (!held_) return;
        copyText(copy(), text, length);
        copy()[length] = Char();
    }
    ~HeldText() { std::free(block_); }
    HeldText(HeldText const&) = delete;
    HeldText& operator=(HeldText const&) = delete;

    /// The copy, or the source itself where nothing is held.
    Char const* orElse(Char const* source) const noexcept {
        if (!held_) return source;
        return block_ != nullptr ? block_ : inside_;
    }

private:
    static constexpr std::uint64_t INSIDE = 256;
    static constexpr std::uint64_t LONGEST = std::uint64_t{1} << 62;

    Char* copy() noexcept { return block_ != nullptr ? block_ : inside_; }

    bool held_;
    Char* block_ = nullptr;
    Char inside_[INSIDE];
};

} // namespace ZOR_Basis::detail

#endif
