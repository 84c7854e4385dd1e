/// \file
/// The functions of `unload_module`.

#ifndef TESTS_ONCE_UNLOAD_MODULE_H
#define TESTS_ONCE_UNLOAD_MODULE_H

#if defined(_WIN32)
#define MODULE_API __declspec(dllexport)
#else
#define MODULE_API __attribute__((visibility("default")))
#endif

/// Makes a log with one line. \param isKept  0: closes it
extern "C" MODULE_API void logOneLine(int isKept);

using LogOneLine = void (*)(int isKept);

#endif
