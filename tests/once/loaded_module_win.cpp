// The sibling is loaded_module_posix.cpp.

#include "tests/once/loaded_module.h"

#include <windows.h>

void* loadModule(char const* path) { return LoadLibraryA(path); }
void* addressIn(void* module, char const* name) {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(module), name));
}
bool unloadModule(void* module) { return FreeLibrary(static_cast<HMODULE>(module)) != 0; }
