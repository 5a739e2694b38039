/* Loads a 32-bit Windows DLL (PE32, x86) into a 32-bit Linux process, as the
 * Windows loader would, and resolves its imports to the project's stand-ins:
 * KERNEL32 and msvcrt to shims over the C library, USER32 to the Win32
 * stand-in, DRAVO2 to the recording drawing stand-in. For drivers written in
 * C or C++; link libpe_loader.so.
 *
 * One thread's loader: load, call and free on the thread that loaded the
 * first image. That thread gets a Windows thread block through %fs. Windows
 * runs threads with the x87 control word PE_WINDOWS_FPU_CONTROL, Linux with
 * 0x037F (64-bit precision): the loader runs the image's start-up and
 * shut-down under Windows' word, and a driver that calls into the image sets
 * it too. */
#ifndef PE_LOADER_H
#define PE_LOADER_H

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

#define PE_LOADER_API __attribute__((visibility("default")))

/* 53-bit precision, every exception masked. */
#define PE_WINDOWS_FPU_CONTROL 0x027F

/* Maps the DLL at `path`, applies its relocations when its preferred base is
 * taken, resolves its imports, runs its TLS callbacks and its entry point
 * (DLL_PROCESS_ATTACH). Returns its module handle (its base address), or null
 * with one line saying why in `error` (cut to `error_size`, always
 * terminated when error_size > 0). */
PE_LOADER_API void* PeLoadLibrary(const char* path, char* error, size_t error_size);

/* The address of the function the module exports as `name`, or null. */
PE_LOADER_API void* PeGetProcAddress(void* module, const char* name);

/* Runs the module's TLS callbacks and entry point with DLL_PROCESS_DETACH,
 * then unmaps it. A handle that is not a loaded module is ignored. */
PE_LOADER_API void PeFreeLibrary(void* module);

#ifdef __cplusplus
}
#endif

#endif
