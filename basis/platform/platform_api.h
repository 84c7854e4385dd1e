/// \file
/// Linkage of the platform layer's functions. Valid C. A module defines `XOS_BUILDING` when it is itself being built.

#ifndef BASIS_PLATFORM_PLATFORM_API_H
#define BASIS_PLATFORM_PLATFORM_API_H

#if defined(_MSC_VER) && defined(XOS_BUILDING)
#define XOS_API __declspec(dllexport)
#elif defined(_MSC_VER)
#define XOS_API __declspec(dllimport)
#elif defined(_WIN32)
#define XOS_API
#else
#define XOS_API __attribute__((visibility("default")))
#endif

#ifdef __cplusplus
#define ZB_PLATFORM_C_BEGIN extern "C" {
#define ZB_PLATFORM_C_END }
#else
#define ZB_PLATFORM_C_BEGIN
#define ZB_PLATFORM_C_END
#endif

#endif
