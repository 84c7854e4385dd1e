// Keeps the DLL that contains this file loaded until the process ends. Its statically linked runtime takes a slot of
// thread-local storage at each load and cannot give it back, so unloading and loading again would run out of slots.

#include <windows.h>

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID) {
    if (reason == DLL_PROCESS_ATTACH) {
        HMODULE pinned = nullptr;
        GetModuleHandleExA(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_PIN,
                           reinterpret_cast<char const*>(instance), &pinned);
    }
    return TRUE;
}
