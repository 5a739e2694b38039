// The per-frame pendulum step and the explicit chain update.
#pragma once

#include <cstdint>

struct RunData;

// One frame: removes chains whose anchor is being destroyed, steps every
// swinging chain and raises "On Swing" for it, then removes destroyed
// platforms and links.
void SwingStep(RunData& rd);

// Advances chain `chain` (which must exist) by one pendulum step and places
// its links and platform. With `turn`, the placed objects are also turned to
// face along the chain. Raises no event and removes nothing.
void AdvanceChain(RunData& rd, uint32_t chain, bool turn);

// The update actions: every chain, or the chain `index` addresses (nothing
// when it addresses none). Both also turn the placed objects.
void UpdateAllChains(RunData& rd);
void UpdateChainAt(RunData& rd, int32_t index);

// The direction (0 to 31) that a chain at `angle` degrees gives its links and
// platform; `unchanged` when the angle is not finite.
int32_t ChainDirection(float angle, int32_t unchanged);
