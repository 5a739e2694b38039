// What the Win32 stand-in offers beyond the Win32 calls: the module handle
// under which the library's resources are found, hooks through which tests
// make allocations fail and count what is still alive, and the author who
// works the dialogs. The library's
// own code never includes this header.
#pragma once

#include <windows.h>

#include <cstddef>
#include <functional>

// The library's module instance handle (the one DllMain received).
HINSTANCE StandinLibraryModule();

// After `successes` more calls succeed, the next `failures` calls of
// LocalAlloc (or CreatePopupMenu) fail as they do when memory runs out.
void StandinFailLocalAlloc(int successes, int failures = 1);
void StandinFailCreatePopupMenu(int successes, int failures = 1);

// Menus and local memory blocks created and not yet destroyed or freed.
std::size_t StandinLiveMenuCount();
std::size_t StandinLiveLocalBlockCount();

// The author at the screen: called once each modal dialog is up
// (initialised, focused and shown), to type and press through the Win32
// calls as a person would. A dialog it leaves open would wait forever under
// USER32; the stand-in reports it and stops the program. An empty function
// removes the author. The author it replaces.
std::function<void(HWND dialog)> StandinSetDialogAuthor(std::function<void(HWND dialog)> author);
