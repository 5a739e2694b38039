#include "chains/run_data.h"

bool AddChain(RunData& rd, HostObject* anchor) {
  if (rd.chains == nullptr) return false;
  ChainRecord chain{};
  chain.anchor = anchor;
  chain.mass = rd.defaultMass;
  chain.angle = rd.startAngle;
  chain.linkSpacing = rd.defaultLinkSpacing;
  return rd.chains->Append(chain);
}
