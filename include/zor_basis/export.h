/// \file
/// Marks what the library exports. Valid C.
///
/// `ZB_API` precedes every exported class and function. On ELF it gives default visibility. With mingw-w64 it is empty,
/// because the library's committed export list decides what is exported. With MSVC it imports, unless `ZB_BUILDING`
/// (the library itself) or `ZB_STATIC` (its objects linked into a program) is defined.
///
/// In C++ all headers require C++20.

#ifndef ZOR_BASIS_EXPORT_H
#define ZOR_BASIS_EXPORT_H

#if defined(_MSVC_LANG)
#define ZB_CXX_VERSION _MSVC_LANG
#elif defined(__cplusplus)
#define ZB_CXX_VERSION __cplusplus
#endif
#if defined(ZB_CXX_VERSION) && ZB_CXX_VERSION < 202002L
#error "zor_basis requires C++20: compile with -std=c++20 (MSVC: /std:c++20)"
#endif

#if defined(_MSC_VER)
#if defined(ZB_BUILDING)
#define ZB_API __declspec(dllexport)
#define ZB_EXTERN_TEMPLATE extern template class
#define ZB_INSTANTIATE_TEMPLATE template class __declspec(dllexport)
#elif defined(ZB_STATIC)
#define ZB_API
#define ZB_EXTERN_TEMPLATE extern template class
#define ZB_INSTANTIATE_TEMPLATE template class
#else
#define ZB_API __declspec(dllimport)
#define ZB_EXTERN_TEMPLATE extern template class __declspec(dllimport)
#define ZB_INSTANTIATE_TEMPLATE template class
#endif
#elif defined(_WIN32)
#define ZB_API
#define ZB_EXTERN_TEMPLATE extern template class
#define ZB_INSTANTIATE_TEMPLATE template class
#else
#define ZB_API __attribute__((visibility("default")))
#define ZB_EXTERN_TEMPLATE extern template class __attribute__((visibility("default")))
#define ZB_INSTANTIATE_TEMPLATE template class
#endif

/// `ZB_API` for functions so short that the indirection of an ELF call into a library matters.
#if defined(__ELF__) && !defined(__clang__)
#define ZB_API_STRAIGHT ZB_API __attribute__((noplt))
#else
#define ZB_API_STRAIGHT ZB_API
#endif

/// Around exported classes whose parts are not exported. Such a part consists of inline functions, so a program takes
/// nothing of it from the library; MSVC would warn each program of it (C4251, C4275).
#if defined(_MSC_VER)
#define ZB_INLINE_PARTS_BEGIN __pragma(warning(push)) __pragma(warning(disable : 4251 4275))
#define ZB_INLINE_PARTS_END __pragma(warning(pop))
#else
#define ZB_INLINE_PARTS_BEGIN
#define ZB_INLINE_PARTS_END
#endif

/// Declares two virtual functions of one name, in the order of their slots: MSVC numbers them from the last to the
/// first, all other compilers from the first to the last.
#if defined(_MSC_VER)
#define ZB_OVERLOADED_SLOTS(first, second)                                                                             \
    second;                                                                                                            \
    first
#else
#define ZB_OVERLOADED_SLOTS(first, second)                                                                             \
    first;                                                                                                             \
    second
#endif

/// C linkage, for functions that C can call.
#ifdef __cplusplus
#define ZB_EXTERN_C extern "C"
#else
#define ZB_EXTERN_C
#endif

#endif
