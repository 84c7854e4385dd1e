/// \file
/// Prevents a text from being used as any other pointer. Not meant for users.
///
/// The text types convert implicitly to a pointer to their text. The language would then accept them wherever any
/// pointer is allowed: in `delete`, and in comparisons with pointers to other types, which compare addresses.

#ifndef ZOR_BASIS_TEXT_POINTER_GUARD_H
#define ZOR_BASIS_TEXT_POINTER_GUARD_H

#include "zor_basis/export.h"

#include <compare>
#include <type_traits>

namespace ZOR_Basis::detail {

template <class>
inline constexpr bool NEVER = false;

/// An empty base of a class that converts to a pointer and must not be deleted through it. `delete` requires exactly
/// one conversion to a pointer and finds two; no call can use the second one, so it affects nothing else.
template <class Derived>
class NotDeletable {
public:
    operator NotDeletable*() const requires NEVER<Derived>;
};

/// A pointer that cannot point to text of these characters.
template <class Pointer, class Char>
concept PointerToOther = std::is_pointer_v<Pointer> && !std::is_convertible_v<Pointer, Char const*>;

/// The empty base of the views. Each comparison deleted here would otherwise compile as a comparison of addresses.
template <class Char>
class PointerGuard : public NotDeletable<PointerGuard<Char>> {
    template <PointerToOther<Char> Pointer>
    friend bool operator==(PointerGuard const&, Pointer) = delete;
    template <PointerToOther<Char> Pointer>
    friend std::weak_ordering operator<=>(PointerGuard const&, Pointer) = delete;
};

} // namespace ZOR_Basis::detail

#endif
