// How the event routines read their arguments and find the chain an index
// addresses.
#pragma once

#include <cstdint>

#include "chains/run_data.h"

// An integer parameter (chain index, link place, position, identifier) is the
// low 32 bits of its argument, taken as signed; on 64-bit targets the argument
// is pointer-wide because object parameters arrive in the same slot.
inline int32_t IntegerParameter(intptr_t argument) { return static_cast<int32_t>(argument); }

// The chain `index` addresses, or null when it is negative or not below the
// number of chains.
inline ChainRecord* ChainAt(RunData& rd, int32_t index) {
  return AddressesChain(rd, index) ? &rd.chains->At(static_cast<uint32_t>(index)) : nullptr;
}
