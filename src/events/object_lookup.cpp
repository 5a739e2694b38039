// The expressions that find the chain, and the place in it, of a host object
// given by its identifier. Nothing but positions in the lists ties an object
// to a chain, so both take the first match in list order, which each list
// keeps an index of.
#include <optional>

#include "chains/run_data.h"
#include "events/event_routines.h"
#include "frame/host_services.h"

namespace {

constexpr int32_t kNotFound = -1;

std::optional<uint32_t> FindObject(ObjectList* list, int32_t id) {
  return list != nullptr ? list->Find(id) : std::nullopt;
}

}  // namespace

// Platforms first, then links, then anchors: an object in several lists is
// reported by the first that holds it. A platform's position is its chain
// even when no chain has that index yet; a link past the last chain's links
// yields the index one past the last chain. With no links per chain (fewer
// links than chains) no link belongs to a chain, and the search goes on to
// the anchors rather than divide by zero.
int32_t TVCALL ChainIndex(RunData* rd, intptr_t token) {
  const int32_t id = HostGetFirstExpressionParameter(&rd->head, token);
  if (const auto platform = FindObject(rd->platforms, id)) return static_cast<int32_t>(*platform);
  if (const uint32_t perChain = LinksPerChain(*rd); perChain > 0) {
    if (const auto link = FindObject(rd->links, id)) return static_cast<int32_t>(*link / perChain);
  }
  if (rd->chains != nullptr) {
    if (const auto anchor = rd->chains->FindAnchor(id)) return static_cast<int32_t>(*anchor);
  }
  return kNotFound;
}

// The link's place within its chain, 0 at the anchor end. With no links per
// chain the link has no place in any chain.
int32_t TVCALL LinkIndex(RunData* rd, intptr_t token) {
  const int32_t id = HostGetFirstExpressionParameter(&rd->head, token);
  const uint32_t perChain = LinksPerChain(*rd);
  const auto link = FindObject(rd->links, id);
  if (!link || perChain == 0) return kNotFound;
  return static_cast<int32_t>(*link % perChain);
}
