#include "frame/host_services.h"

#include <bit>

float HostGetFloatParameter(HostObjectHeader* own) {
  const int32_t bits = reinterpret_cast<HostGetFloatParameterFn>(
      own->context->slot[kSlotGetFloatParameter])(own, 1, 0);
  return std::bit_cast<float>(bits);
}

int32_t FloatResult(HostObjectHeader* own, float value) {
  own->flags |= kFlagFloatResult;
  return std::bit_cast<int32_t>(value);
}

bool HostIsCompatible(const EditorHost* host) {
  if (host == nullptr || host->slot[kEditorSlotGetVersion] == nullptr) return false;
  const auto version = reinterpret_cast<HostGetVersionFn>(host->slot[kEditorSlotGetVersion]);
  if ((version() & 0xFFFu) < 218) return false;
  if ((version() & 0xFFFF0000u) < 0x02000000u) return false;
  if ((version() & 0x8000u) != 0) return false;
  return true;
}
