/// \file
/// `Auto_ptr_CStr`: owns a character array, for calls that fill a zero-terminated buffer.
///
///     Auto_ptr_CStr name(255);
///     readName(name, name.length());
///     name.assureTerm0();

#ifndef ZOR_BASIS_TEXT_AUTO_PTR_CSTR_H
#define ZOR_BASIS_TEXT_AUTO_PTR_CSTR_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

#include <cstdint>
#include <string>

/// Not copyable. The buffer comes from the runtime's `malloc`, which is retried through the new-handler of the
/// library's own runtime, and is released by `free`.
class ZB_API Auto_ptr_CStr : public ZOR_Basis::detail::NotDeletable<Auto_ptr_CStr> {
public:
    /// Allocates a buffer of n + 2 bytes that begins with a terminator; its length is n.
    /// \error throws `std::bad_alloc` where memory is short and no new-handler helps
    Auto_ptr_CStr(std::uint64_t n);
    /// Allocates a buffer that contains the text and a terminator; its length is the text's size.
    /// \error throws `std::bad_alloc` where memory is short and no new-handler helps
    Auto_ptr_CStr(std::string text);
    ~Auto_ptr_CStr();

    /// The buffer.
    char* c_str() noexcept { return buffer_; }
    char const* c_str() const noexcept { return buffer_; }
    operator char*() noexcept { return buffer_; }
    /// The number of bytes, without the terminator.
    std::uint64_t length() const noexcept { return length_; }

    /// Terminates a buffer that a callee may have filled completely.
    /// \kept text-14: the terminator replaces the last counted byte, so "abc" becomes "ab"; with a length of 0 nothing
    ///     happens
    void assureTerm0() noexcept;

private:
    Auto_ptr_CStr(Auto_ptr_CStr const&) = delete;
    Auto_ptr_CStr& operator=(Auto_ptr_CStr const&) = delete;

    char* buffer_;
    std::uint64_t length_;
};

static_assert(sizeof(Auto_ptr_CStr) == 16);

#endif
