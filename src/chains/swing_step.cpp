#include "chains/swing_step.h"

#include "chains/run_data.h"
#include "frame/host_services.h"

namespace {

constexpr int32_t kOnSwingCode = 1;

// Lambdas rather than functions, so that the walks inline the test.
constexpr auto Destroyed = [](const HostObject* object) { return IsBeingDestroyed(*object); };
constexpr auto AnchorDestroyed = [](const ChainRecord& chain) { return IsBeingDestroyed(*chain.anchor); };

}  // namespace

void SwingStep(RunData& rd) {
  // While "On Swing" is raised the host may run this object's actions, which
  // append to the lists and can move their storage. Nothing is held across
  // the event: the count and every record are looked up afresh each round.
  for (uint32_t i = 0; i < ChainCount(rd);) {
    const ChainRecord& chain = rd.chains->At(i);
    if (AnchorDestroyed(chain)) {
      rd.chains->RemoveAt(i);  // the record that moved into i is tested next
      continue;
    }
    if (chain.swinging == 1) {
      AdvanceChain(rd, i, false);
      rd.currentChain = static_cast<int32_t>(i);
      HostGenerateEvent(&rd.head, kOnSwingCode, 0);
    }
    ++i;
  }
  if (rd.platforms != nullptr) rd.platforms->RemoveIf(Destroyed);
  if (rd.links != nullptr) rd.links->RemoveIf(Destroyed);
  // An "On Swing" rule may have destroyed the anchor of a chain that the pass
  // had already stepped. The host frees every object flagged in this frame
  // as soon as this call returns, so that chain cannot wait for the next
  // pass: it leaves now, having kept this frame's step and event.
  if (rd.chains != nullptr) rd.chains->RemoveIf(AnchorDestroyed);
}
