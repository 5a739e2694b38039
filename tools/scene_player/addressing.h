// What an action or expression of a scene addresses that does not exist at
// the moment it runs: a chain (or platform, or link place) beyond those the
// library holds, or a negative one. The library then does nothing, or
// answers a neutral value, without a word; the player says so.
#pragma once

#include <cstdint>
#include <string>

#include "chains/run_data.h"

namespace scene_player {

// An empty text when action `code` with first parameter `first` addresses
// something that exists (or nothing at all); otherwise what it misses and
// what the library does instead.
std::string MissedByAction(const RunData& rd, int code, int32_t first);

// The same for expression `code` with its parameters.
std::string MissedByExpression(const RunData& rd, int code, const int32_t (&params)[2]);

}  // namespace scene_player
