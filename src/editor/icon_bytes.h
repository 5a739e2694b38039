// How much of the icon's bitmap resource MakeIcon copies.
#pragma once

#include <cstdint>

// The size a packed bitmap gives itself in its header (header, palette and
// pixels, each part worked out as the host's own loader does), but never
// more than the `available` bytes of the resource; 0 when the resource is
// too short to hold the header at all.
uint32_t IconBytesToCopy(const unsigned char* bitmap, uint32_t available);
