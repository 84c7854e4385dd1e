/// \file
/// A shared library that a program loads and unloads: loaded_module_posix.cpp, loaded_module_win.cpp.

#ifndef TESTS_ONCE_LOADED_MODULE_H
#define TESTS_ONCE_LOADED_MODULE_H

/// \return null on failure
void* loadModule(char const* path);
void* addressIn(void* module, char const* name);
/// \return whether the system reports no failure
bool unloadModule(void* module);

#endif
