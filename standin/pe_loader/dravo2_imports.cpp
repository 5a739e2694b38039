// DRAVO2, by ordinal: the recording drawing stand-in. The two plain services
// are __stdcall; the surface class's operations are __thiscall, the object
// in ECX and the callee removing the rest.
#include "dravo2_standin.h"
#include "import_tables.h"

namespace pe {

std::span<const ImportRow> Dravo2Imports() {
  static const ImportRow rows[] = {
      Stdcall<8>(34, &HostGetEditorSurface),
      Stdcall<8>(50, &HostUpdateEditorRect),
      Thiscall<0>(264, &HostSurfaceConstruct),
      Thiscall<0>(286, &HostSurfaceDestruct),
      Thiscall<28>(344, &HostSurfaceBlit),
      Thiscall<12>(372, &HostSurfaceCreate),
      Thiscall<52>(411, &HostSurfaceDrawText),
      Thiscall<12>(616, &HostSurfaceLoadBitmap),
      Thiscall<32>(679, &HostSurfaceRectangle),
  };
  return rows;
}

}  // namespace pe
