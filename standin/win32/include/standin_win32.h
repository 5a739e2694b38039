// What the Win32 stand-in offers beyond the Win32 calls: the modules whose
// resources the resource calls read, hooks through which tests make
// allocations fail and count what is still alive, and the author who works
// the dialogs. The library's own code never includes this header.
#pragma once

#include <windows.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace standin {

// A resource type or name: an integer id, or a text kept in upper case as
// the resource compiler stores it.
struct ResourceKey {
  uint16_t id = 0;
  std::u16string text;  // empty for an id
};

struct ResourceEntry {
  ResourceKey type;
  ResourceKey name;
  uint16_t language = 0;
  const unsigned char* data = nullptr;
  uint32_t size = 0;
};

}  // namespace standin

// Makes `resources` what FindResourceA, LoadStringA, LoadMenuA and
// DialogBoxParamA find under `module`, replacing any it had. Their data must
// stay in place until the module is removed. False when memory runs out.
bool StandinAddModule(HMODULE module, std::vector<standin::ResourceEntry> resources);
// The module's resources are gone, and so are its HRSRC handles.
void StandinRemoveModule(HMODULE module);

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
