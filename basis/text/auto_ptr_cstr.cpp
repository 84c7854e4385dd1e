#include "zor_basis/text/auto_ptr_cstr.h"

#include <cstdlib>
#include <cstring>
#include <limits>
#include <new>

namespace {

/// Never null: asks the new-handler for memory as long as there is one.
char* allocateOrThrow(std::uint64_t size, std::uint64_t extra) {
    if (size > std::numeric_limits<std::uint64_t>::max() - extra) throw std::bad_alloc();
    for (;;) {
        if (void* block = std::malloc(size + extra)) return static_cast<char*>(block);
        std::new_handler const handler = std::get_new_handler();
        if (handler == nullptr) throw std::bad_alloc();
        handler();
    }
}

} // namespace

Auto_ptr_CStr::Auto_ptr_CStr(std::uint64_t n) : buffer_(allocateOrThrow(n, 2)), length_(n) { buffer_[0] = '\0'; }

Auto_ptr_CStr::Auto_ptr_CStr(std::string text) // NOLINT(performance-unnecessary-value-param): the argument is consumed
    : buffer_(allocateOrThrow(text.size(), 1)), length_(text.size()) {
    std::memcpy(buffer_, text.c_str(), length_ + 1);
}

Auto_ptr_CStr::~Auto_ptr_CStr() { std::free(buffer_); }

void Auto_ptr_CStr::assureTerm0() noexcept {
    // kept text-14: a callee that counts the terminator fills exactly `length` bytes, so that the last one is its place
    if (length_ > 0) buffer_[length_ - 1] = '\0';
}
