// The thread block a Windows thread has at %fs:0, given to the calling
// thread so that a Windows image's start-up code finds what it reads there.
// One thread only: the loader and its images run on the thread that loaded
// them.
#pragma once

#include <cstdint>
#include <string>

namespace pe {

// Gives the calling thread its thread block, once. False, with the reason,
// when the system will not make the segment that %fs selects.
bool EnsureThreadBlock(std::string& error);

// The slot of the thread block's TLS array that holds the data of the image
// with TLS index `index`; the loader puts each image's copy of its TLS
// template there. Null for an index beyond the array.
void** ThreadStorageSlot(uint32_t index);

}  // namespace pe
