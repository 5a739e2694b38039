// The expressions that read a chain's values and the positions of its
// objects. Every parameter is read from the host at the start of the call,
// in order, before any is looked at; the float expressions mark their result
// as a float on every call, also when they return 0.0 for a bad index.
#include "chains/run_data.h"
#include "events/chain_lookup.h"
#include "events/event_routines.h"
#include "frame/host_services.h"

namespace {

// The chain the expression's one parameter addresses, or null.
const ChainRecord* ChainParameter(RunData& rd, intptr_t token) {
  return ChainAt(rd, HostGetFirstExpressionParameter(&rd.head, token));
}

int32_t AnchorCoordinate(RunData& rd, intptr_t token, int32_t HostObjectHeader::*axis) {
  const ChainRecord* chain = ChainParameter(rd, token);
  return chain != nullptr ? chain->anchor->head.*axis : 0;
}

int32_t ChainFloat(RunData& rd, intptr_t token, float ChainRecord::*field) {
  const ChainRecord* chain = ChainParameter(rd, token);
  return FloatResult(&rd.head, chain != nullptr ? chain->*field : 0.0f);
}

// DeltaX, DeltaY and ChainAccel describe motion, so a chain that is not
// swinging reports none, whatever its record still holds.
int32_t SwingingChainFloat(RunData& rd, intptr_t token, float (*value)(const ChainRecord&)) {
  const ChainRecord* chain = ChainParameter(rd, token);
  return FloatResult(&rd.head, chain != nullptr && chain->swinging == 1 ? value(*chain) : 0.0f);
}

// A bad platform index yields the extension's own position.
int32_t PlatformCoordinate(RunData& rd, intptr_t token, int32_t HostObjectHeader::*axis) {
  const int32_t index = HostGetFirstExpressionParameter(&rd.head, token);
  if (rd.platforms == nullptr || !rd.platforms->Holds(index)) return rd.head.*axis;
  return rd.platforms->At(static_cast<uint32_t>(index))->head.*axis;
}

// Link place k (0 at the anchor end) of chain c, or 0 when either is out of
// range. In range, c * linksPerChain + k < chains * linksPerChain <= links, so
// the element exists and the product cannot overflow.
int32_t LinkCoordinate(RunData& rd, intptr_t token, int32_t HostObjectHeader::*axis) {
  const int32_t chain = HostGetFirstExpressionParameter(&rd.head, token);
  const int32_t place = HostGetNextExpressionParameter(&rd.head, token);
  if (!AddressesChain(rd, chain) || place < 0 || static_cast<uint32_t>(place) >= LinksPerChain(rd)) return 0;
  return LinkOfChain(rd, static_cast<uint32_t>(chain), static_cast<uint32_t>(place) + 1)->head.*axis;
}

}  // namespace

int32_t TVCALL ChainNum(RunData* rd, intptr_t) { return static_cast<int32_t>(ChainCount(*rd)); }

// 0 with no chains: then no link belongs to any chain.
int32_t TVCALL ChainLinks(RunData* rd, intptr_t) { return static_cast<int32_t>(LinksPerChain(*rd)); }

int32_t TVCALL AnchorX(RunData* rd, intptr_t token) { return AnchorCoordinate(*rd, token, &HostObjectHeader::x); }
int32_t TVCALL AnchorY(RunData* rd, intptr_t token) { return AnchorCoordinate(*rd, token, &HostObjectHeader::y); }

int32_t TVCALL PlatformMass(RunData* rd, intptr_t token) { return ChainFloat(*rd, token, &ChainRecord::mass); }
int32_t TVCALL ChainAngle(RunData* rd, intptr_t token) { return ChainFloat(*rd, token, &ChainRecord::angle); }
int32_t TVCALL ChainSpeed(RunData* rd, intptr_t token) { return ChainFloat(*rd, token, &ChainRecord::speed); }
int32_t TVCALL LinkSpacing(RunData* rd, intptr_t token) { return ChainFloat(*rd, token, &ChainRecord::linkSpacing); }

int32_t TVCALL PlatformX(RunData* rd, intptr_t token) { return PlatformCoordinate(*rd, token, &HostObjectHeader::x); }
int32_t TVCALL PlatformY(RunData* rd, intptr_t token) { return PlatformCoordinate(*rd, token, &HostObjectHeader::y); }

// How far the platform moved in the chain's last step: the step copies the
// old position into prevPlatformX/Y just before it computes the new one, so
// an event can add the difference to whatever stands on the platform.
int32_t TVCALL DeltaX(RunData* rd, intptr_t token) {
  return SwingingChainFloat(*rd, token, [](const ChainRecord& c) { return c.platformX - c.prevPlatformX; });
}

int32_t TVCALL DeltaY(RunData* rd, intptr_t token) {
  return SwingingChainFloat(*rd, token, [](const ChainRecord& c) { return c.platformY - c.prevPlatformY; });
}

int32_t TVCALL ChainAccel(RunData* rd, intptr_t token) {
  return SwingingChainFloat(*rd, token, [](const ChainRecord& c) { return c.acceleration; });
}

int32_t TVCALL LinkX(RunData* rd, intptr_t token) { return LinkCoordinate(*rd, token, &HostObjectHeader::x); }
int32_t TVCALL LinkY(RunData* rd, intptr_t token) { return LinkCoordinate(*rd, token, &HostObjectHeader::y); }
