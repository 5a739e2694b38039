#include "swing_limit.h"

#include <cmath>

#include "chains/float_math.h"

LimitChains LimitChainsOf(const RunData& rd) {
  LimitChains limit;
  limit.gravity = rd.gravity;
  limit.linksPerChain = LinksPerChain(rd);
  for (uint32_t i = 0; i < rd.chains->Count(); ++i) {
    limit.chains.push_back(rd.chains->At(i));
    limit.platforms.push_back(rd.platforms->At(i));
  }
  for (uint32_t i = 0; i < rd.chains->Count() * limit.linksPerChain; ++i) limit.links.push_back(rd.links->At(i));
  return limit;
}

void LimitFrame(LimitChains& limit) {
  const uint32_t n = limit.linksPerChain;
  const double h0 = limit.links[0]->head.height;
  for (std::size_t i = 0; i < limit.chains.size(); ++i) {
    ChainRecord& r = limit.chains[i];
    const double speed = static_cast<double>(r.speed) + r.acceleration;
    r.speed = static_cast<float>(speed);
    const double angle = speed + r.angle;
    r.angle = static_cast<float>(angle);
    const int32_t length = static_cast<int32_t>((h0 + r.linkSpacing) * (static_cast<double>(n) + 1.0));
    r.acceleration = static_cast<float>(std::sin(angle * kDegree) * (-(static_cast<double>(limit.gravity) * r.mass) / length));

    r.prevPlatformX = r.platformX;
    r.prevPlatformY = r.platformY;
    const double theta = (static_cast<double>(r.angle) + 90.0) * kDegree;
    const double cosTheta = std::cos(theta);
    const double sinTheta = std::sin(theta);
    const double anchorX = r.anchor->head.x;
    const double anchorY = r.anchor->head.y;
    r.platformX = static_cast<float>(cosTheta * length + anchorX);
    r.platformY = static_cast<float>(sinTheta * length + anchorY);

    const double spacing = r.linkSpacing;
    HostObject* const* links = &limit.links[i * n];
    for (uint32_t k = 1; k <= n; ++k) {
      HostObject& link = *links[k - 1];
      const double distance = (static_cast<double>(link.head.height) + spacing) * static_cast<double>(static_cast<float>(k));
      link.head.x = static_cast<int32_t>(cosTheta * distance + anchorX);
      link.head.y = static_cast<int32_t>(sinTheta * distance + anchorY);
      link.changed = 1;
    }
    HostObject& platform = *limit.platforms[i];
    platform.head.x = static_cast<int32_t>(r.platformX);
    platform.head.y = static_cast<int32_t>(r.platformY);
    platform.changed = 1;
  }
}
