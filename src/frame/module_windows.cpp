#if defined(_WIN32)

#include <windows.h>

#include "frame/module.h"

namespace krnumer::module {

Module Find() {
    const Module program{GetModuleHandleA(nullptr), true};
    for (const char* mark : kHostMarks)
        if (Export(program, mark) != nullptr) return program;
    return {GetModuleHandleA("krrt.dll"), true};
}

void* Export(Module module, const char* name) {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(module.handle), name));
}

void Fatal(const char* message) {
    MessageBoxA(nullptr, message, "Fatal Error", MB_TASKMODAL | MB_ICONERROR | MB_OK);
    ExitProcess(1);
}

}  // namespace krnumer::module

extern "C" BOOL APIENTRY DllMain(HMODULE module, DWORD reason, LPVOID) {
    if (reason == DLL_PROCESS_ATTACH) DisableThreadLibraryCalls(module);
    return TRUE;
}

#endif
