// The sibling is loaded_module_win.cpp.

#include "tests/once/loaded_module.h"

#include <dlfcn.h>

void* loadModule(char const* path) { return dlopen(path, RTLD_NOW | RTLD_LOCAL); }
void* addressIn(void* module, char const* name) { return dlsym(module, name); }
bool unloadModule(void* module) { return dlclose(module) == 0; }
