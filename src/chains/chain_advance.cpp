// The pendulum arithmetic shared by the swing step and the chain update.
// Every intermediate is a double, record fields are rounded to float when
// stored, and every integer comes from truncation toward zero.
#include <algorithm>
#include <cmath>

#include "chains/float_math.h"
#include "chains/run_data.h"
#include "chains/swing_step.h"

namespace {

constexpr double kPlacementOffset = 90.0;       // angle 0 hangs straight down
constexpr uint32_t kExactFloatIntegers = 1u << 24;  // every integer up to here is a float
constexpr double kDirectionStep = 0.08888888888888889;  // 32 directions per 360 degrees

// Both coordinates are tested once on the common path: calling TruncateToInt
// twice costs two more instructions per link (measured with callgrind).
void PlaceObject(HostObject& object, double x, double y) {
  if (int32_t ix, iy; TruncatesToInt(x, ix) && TruncatesToInt(y, iy)) [[likely]] {
    object.head.x = ix;
    object.head.y = iy;
  } else {
    object.head.x = TruncateToInt(x, object.head.x);
    object.head.y = TruncateToInt(y, object.head.y);
  }
  object.changed = 1;
}

}  // namespace

int32_t ChainDirection(float angle, int32_t unchanged) {
  if (!std::isfinite(angle)) return unchanged;
  const int32_t a = TruncateToInt(static_cast<double>(angle) * -1.0 + 90.0, 0);
  const int32_t s = TruncateToInt(a * kDirectionStep, 0);
  const int32_t d = s % 32;
  return d < 0 ? d + 32 : d;
}

void AdvanceChain(RunData& rd, uint32_t chain, bool turn) {
  const uint32_t n = LinksPerChain(rd);
  // No event is raised here, so the record and the objects stay where they
  // are for the whole call.
  ChainRecord& r = rd.chains->At(chain);
  const HostObject* const anchor = r.anchor;

  const double speed = static_cast<double>(r.speed) + r.acceleration;
  r.speed = RoundToFloat(speed);
  const double angle = speed + r.angle;
  r.angle = RoundToFloat(angle);

  // The chain's length always comes from the first object of the whole links
  // list. With no link at all there is nothing to measure: h0 is 0.
  const int32_t h0 = LinkCount(rd) > 0 ? rd.links->At(0)->head.height : 0;
  const int32_t length =
      TruncateToInt((static_cast<double>(h0) + r.linkSpacing) * (static_cast<double>(n) + 1.0), 0);

  // A pendulum of no length has no torque; dividing by it would not be finite.
  if (length == 0) {
    r.acceleration = 0.0f;
  } else {
    const double pull = -(static_cast<double>(rd.gravity) * r.mass) / length;
    r.acceleration = RoundToFloat(std::sin(angle * kDegree) * pull);
  }

  r.prevPlatformX = r.platformX;
  r.prevPlatformY = r.platformY;
  const double theta = (static_cast<double>(r.angle) + kPlacementOffset) * kDegree;
  const double cosTheta = std::cos(theta);
  const double sinTheta = std::sin(theta);
  r.platformX = RoundToFloat(cosTheta * length + anchor->head.x);
  r.platformY = RoundToFloat(sinTheta * length + anchor->head.y);

  // Each link stands at its own height (plus spacing) times its place, so
  // links of differing heights need not end where the platform hangs. What
  // is the chain's is read once; the anchor's position is read again only
  // after placing a link that is the anchor itself, which moves it for the
  // links after it.
  const double spacing = r.linkSpacing;
  double anchorX = anchor->head.x;
  double anchorY = anchor->head.y;
  HostObject* const* const links = n > 0 ? &rd.links->At(n * chain) : nullptr;  // link k is links[k - 1]
  const auto placeLink = [&](uint32_t k, double place) {
    HostObject& link = *links[k - 1];
    const double distance = (static_cast<double>(link.head.height) + spacing) * place;
    PlaceObject(link, cosTheta * distance + anchorX, sinTheta * distance + anchorY);
    if (&link == anchor) {
      anchorX = link.head.x;
      anchorY = link.head.y;
    }
  };
  // A link's place is k as a float. Up to 2^24 that is k exactly, which a
  // running sum gives more cheaply than a conversion for every link.
  const uint32_t exactPlaces = std::min(n, kExactFloatIntegers);
  double place = 0.0;
  for (uint32_t k = 1; k <= exactPlaces; ++k) placeLink(k, place += 1.0);
  for (uint32_t k = exactPlaces + 1; k <= n; ++k) placeLink(k, static_cast<float>(k));

  // A direction from an angle that is not finite leaves every object's own.
  const bool turns = turn && std::isfinite(r.angle);
  const int32_t direction = turns ? ChainDirection(r.angle, 0) : 0;
  for (uint32_t k = 1; turns && k <= n; ++k) links[k - 1]->direction = direction;

  if (HostObject* platform = PlatformOfChain(rd, chain)) {
    PlaceObject(*platform, r.platformX, r.platformY);
    if (turns) platform->direction = direction;
  }
}
