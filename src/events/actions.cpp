// The sixteen actions. Every one returns 0: the host learns nothing from the
// result, and an index that addresses no chain makes an action do nothing.
#include "chains/run_data.h"
#include "chains/swing_step.h"
#include "events/chain_lookup.h"
#include "events/event_routines.h"
#include "frame/host_services.h"

namespace {

// An object parameter arrives as the address of the object's host record.
// The host always hands one over; a null would only crash the next step, so
// it is ignored.
HostObject* ObjectParameter(intptr_t argument) { return reinterpret_cast<HostObject*>(argument); }

void AppendObject(ObjectList* list, intptr_t argument) {
  HostObject* object = ObjectParameter(argument);
  // An append that finds no memory leaves the list as it was.
  if (list != nullptr && object != nullptr) list->Append(object);
}

// The float setters take their value from the host's float service, not from
// the integer argument, and ask for it on every run, whatever the index.
void SetChainFloat(RunData& rd, intptr_t index, float ChainRecord::*field) {
  const float value = HostGetFloatParameter(&rd.head);
  if (ChainRecord* chain = ChainAt(rd, IntegerParameter(index))) chain->*field = value;
}

void SetAllSwinging(RunData& rd, uint8_t swinging) {
  for (uint32_t i = 0; i < ChainCount(rd); ++i) rd.chains->At(i).swinging = swinging;
}

void SetChainSwinging(RunData& rd, intptr_t index, uint8_t swinging) {
  if (ChainRecord* chain = ChainAt(rd, IntegerParameter(index))) chain->swinging = swinging;
}

// The anchor moves at once and is redrawn; its links and platform follow at
// the chain's next step.
void MoveAnchor(RunData& rd, intptr_t index, intptr_t position, int32_t HostObjectHeader::*axis) {
  if (ChainRecord* chain = ChainAt(rd, IntegerParameter(index))) {
    chain->anchor->head.*axis = IntegerParameter(position);
    chain->anchor->changed = 1;
  }
}

}  // namespace

int16_t TVCALL AddAnchor(RunData* rd, intptr_t object, intptr_t) {
  // The same object may anchor several chains, or be a link or platform too.
  if (HostObject* anchor = ObjectParameter(object)) AddChain(*rd, anchor);
  return 0;
}

int16_t TVCALL AddLink(RunData* rd, intptr_t object, intptr_t) {
  AppendObject(rd->links, object);
  return 0;
}

int16_t TVCALL AddPlatform(RunData* rd, intptr_t object, intptr_t) {
  AppendObject(rd->platforms, object);
  return 0;
}

int16_t TVCALL SetAnchorX(RunData* rd, intptr_t index, intptr_t x) {
  MoveAnchor(*rd, index, x, &HostObjectHeader::x);
  return 0;
}

int16_t TVCALL SetAnchorY(RunData* rd, intptr_t index, intptr_t y) {
  MoveAnchor(*rd, index, y, &HostObjectHeader::y);
  return 0;
}

int16_t TVCALL SetMass(RunData* rd, intptr_t index, intptr_t) {
  SetChainFloat(*rd, index, &ChainRecord::mass);
  return 0;
}

int16_t TVCALL SetAngle(RunData* rd, intptr_t index, intptr_t) {
  SetChainFloat(*rd, index, &ChainRecord::angle);
  return 0;
}

// Not offered in the action menu, but an event that holds it does what its
// text says.
int16_t TVCALL SetSpeed(RunData* rd, intptr_t index, intptr_t) {
  SetChainFloat(*rd, index, &ChainRecord::speed);
  return 0;
}

int16_t TVCALL SetLinkSpacing(RunData* rd, intptr_t index, intptr_t) {
  SetChainFloat(*rd, index, &ChainRecord::linkSpacing);
  return 0;
}

int16_t TVCALL StartAll(RunData* rd, intptr_t, intptr_t) {
  SetAllSwinging(*rd, 1);
  return 0;
}

int16_t TVCALL StartChain(RunData* rd, intptr_t index, intptr_t) {
  SetChainSwinging(*rd, index, 1);
  return 0;
}

int16_t TVCALL StopAll(RunData* rd, intptr_t, intptr_t) {
  SetAllSwinging(*rd, 0);
  return 0;
}

int16_t TVCALL StopChain(RunData* rd, intptr_t index, intptr_t) {
  SetChainSwinging(*rd, index, 0);
  return 0;
}

int16_t TVCALL UpdateAll(RunData* rd, intptr_t, intptr_t) {
  UpdateAllChains(*rd);
  return 0;
}

int16_t TVCALL UpdateChain(RunData* rd, intptr_t index, intptr_t) {
  UpdateChainAt(*rd, IntegerParameter(index));
  return 0;
}

// Used once: the chain's next step adds it to the speed and then replaces it
// with the acceleration computed from the new angle.
int16_t TVCALL SetAcceleration(RunData* rd, intptr_t index, intptr_t) {
  SetChainFloat(*rd, index, &ChainRecord::acceleration);
  return 0;
}
