#include "libmain/libmain.h"

#include <new>

#include "fix/kxfixvalidator.h"

#if defined(_WIN32)
#include <windows.h>

BOOL WINAPI DllMain(HINSTANCE module, DWORD reason, LPVOID /*reserved*/) {
    if (reason == DLL_PROCESS_ATTACH) DisableThreadLibraryCalls(module);
    return TRUE;
}
#endif

KXValidator* KX_STDCALL NewValidator() {
    // Nothing may leave a C entry point: a failing constructor also answers null.
    try {
        return new (std::nothrow) KXFIXValidator;
    } catch (...) {
        return nullptr;
    }
}

void KX_STDCALL DeleteValidator(KXValidator* validator) {
    delete validator;
}
