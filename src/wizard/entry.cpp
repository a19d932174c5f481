// Library entry point. On Windows it only turns off thread notifications;
// elsewhere there is nothing to do.
#if defined(_WIN32)
#include <windows.h>
BOOL APIENTRY DllMain(HMODULE module, DWORD reason, LPVOID) {
    if (reason == DLL_PROCESS_ATTACH)
        DisableThreadLibraryCalls(module);
    return TRUE;
}
#endif
