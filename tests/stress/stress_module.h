/// \file
/// The function of `stress_module`.

#ifndef TESTS_STRESS_STRESS_MODULE_H
#define TESTS_STRESS_STRESS_MODULE_H

#if defined(_WIN32)
#define MODULE_API __declspec(dllexport)
#else
#define MODULE_API __attribute__((visibility("default")))
#endif

/// Uses what has state of its own in the library. \return 1 if all of it worked
extern "C" MODULE_API int useLibrary(void);

using UseLibrary = int (*)(void);

#endif
