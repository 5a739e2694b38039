#include "chains/swing_step.h"

#include "chains/run_data.h"
#include "frame/host_services.h"

namespace {

constexpr int32_t kOnSwingCode = 1;

void RemoveDestroyed(ObjectList* list) {
  if (list == nullptr) return;
  for (uint32_t j = 0; j < list->Count();) {
    if (IsBeingDestroyed(*list->At(j))) {
      list->RemoveAt(j);  // the next element moved into j: examine it next
    } else {
      ++j;
    }
  }
}

}  // namespace

void SwingStep(RunData& rd) {
  // While "On Swing" is raised the host may run this object's actions, which
  // append to the lists and can move their storage. Nothing is held across
  // the event: the count and every record are looked up afresh each round.
  for (uint32_t i = 0; i < ChainCount(rd);) {
    const ChainRecord& chain = rd.chains->At(i);
    if (IsBeingDestroyed(*chain.anchor)) {
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
  RemoveDestroyed(rd.platforms);
  RemoveDestroyed(rd.links);
}
