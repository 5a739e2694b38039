// The run-time object: the host's object header followed by the extension's
// own fields, the three lists and the settings read from the stored record.
#pragma once

#include <cstddef>
#include <cstdint>

#include "chains/identifier_index.h"
#include "chains/ordered_list.h"
#include "frame/host_object.h"

// One chain. The chain's links and platform are not named here: they are
// found by position in the links and platforms lists.
struct ChainRecord {
  HostObject* anchor;
  float mass;
  float angle;  // degrees; 0 hangs straight down, positive swings towards smaller x
  float speed;  // degrees per frame
  float linkSpacing;
  float prevPlatformX;
  float prevPlatformY;
  float platformX;
  float platformY;
  float acceleration;  // degrees per frame per frame, added to speed at the next step
  uint8_t swinging;    // 1 while the swing step moves the chain every frame
};

class ObjectList : public OrderedList<HostObject*> {
 public:
  // The position of the first object whose identifier is `id`.
  std::optional<uint32_t> Find(int32_t id) {
    return index_.Find(id, Count(), Removals(), [this](uint32_t i) { return ObjectIdentifier(At(i)->head); });
  }

 private:
  IdentifierIndex index_;
};

class ChainList : public OrderedList<ChainRecord> {
 public:
  // The index of the first chain whose anchor's identifier is `id`.
  std::optional<uint32_t> FindAnchor(int32_t id) {
    return index_.Find(id, Count(), Removals(), [this](uint32_t i) { return ObjectIdentifier(At(i).anchor->head); });
  }

 private:
  IdentifierIndex index_;
};

struct RunData {
  HostObjectHeader head;  // the extension's own host object
  ObjectList* platforms;
  ObjectList* links;
  ChainList* chains;
  float startAngle;
  float defaultMass;
  float gravity;
  float defaultLinkSpacing;
  int32_t currentChain;  // chain for which the swing step last raised "On Swing"
};

#if TAVRIN_I686
static_assert(offsetof(RunData, platforms) == 184);
static_assert(offsetof(RunData, links) == 188);
static_assert(offsetof(RunData, chains) == 192);
static_assert(offsetof(RunData, startAngle) == 196);
static_assert(offsetof(RunData, defaultMass) == 200);
static_assert(offsetof(RunData, gravity) == 204);
static_assert(offsetof(RunData, defaultLinkSpacing) == 208);
static_assert(offsetof(RunData, currentChain) == 212);
static_assert(sizeof(RunData) == 216);
#elif UINTPTR_MAX == UINT64_MAX
static_assert(offsetof(RunData, platforms) == 184);
static_assert(offsetof(RunData, links) == 192);
static_assert(offsetof(RunData, chains) == 200);
static_assert(offsetof(RunData, startAngle) == 208);
static_assert(offsetof(RunData, defaultMass) == 212);
static_assert(offsetof(RunData, gravity) == 216);
static_assert(offsetof(RunData, defaultLinkSpacing) == 220);
static_assert(offsetof(RunData, currentChain) == 224);
static_assert(sizeof(RunData) == 232);
#endif

// The number of chains, 0 while the run-time object has no chain list.
inline uint32_t ChainCount(const RunData& rd) { return rd.chains ? rd.chains->Count() : 0; }
inline uint32_t LinkCount(const RunData& rd) { return rd.links ? rd.links->Count() : 0; }
inline uint32_t PlatformCount(const RunData& rd) { return rd.platforms ? rd.platforms->Count() : 0; }

// True when `index`, taken as signed, addresses one of the chains.
inline bool AddressesChain(const RunData& rd, int32_t index) { return rd.chains && rd.chains->Holds(index); }

// Links per chain: links divided by chains, rounded down; 0 with no chain
// (then no link belongs to any chain). Computed afresh at every use, so
// adding or removing any object regroups the links of every chain.
inline uint32_t LinksPerChain(const RunData& rd) {
  const uint32_t chains = ChainCount(rd);
  return chains == 0 ? 0 : LinkCount(rd) / chains;
}

// Link k (1 at the anchor end to LinksPerChain) of chain i: element
// LinksPerChain * i + k - 1 of the links list. The caller keeps i below the
// chain count and k within 1..LinksPerChain, so the element exists.
inline HostObject* LinkOfChain(const RunData& rd, uint32_t chain, uint32_t k) {
  return rd.links->At(LinksPerChain(rd) * chain + k - 1);
}

// Platform of chain i: element i of the platforms list, or null when that
// list is shorter.
inline HostObject* PlatformOfChain(const RunData& rd, uint32_t chain) {
  return chain < PlatformCount(rd) ? rd.platforms->At(chain) : nullptr;
}

// Appends a new chain anchored at `anchor`, with the object's defaults and at
// rest. False when memory ran out (nothing was added).
bool AddChain(RunData& rd, HostObject* anchor);
