// The library's module instance handle, kept from the entry point and used
// for every load of the library's own resources.
#pragma once

#include <windows.h>

HINSTANCE TavrinModule();
void SetTavrinModule(HINSTANCE module);
