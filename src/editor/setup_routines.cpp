// The editor routines that open the setup dialog: on a new object, and from
// the object's popup menu.
#include "editor/setup_dialog.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/host_services.h"

namespace {

// The host's own popup-menu command for the object's setup.
constexpr int32_t kSetupCommand = 2020;
// What SelectPopup tells the host after OK.
constexpr int32_t kSettingsChanged = 4;

}  // namespace

TAVRIN_EXPORT int32_t TVCALL CreateObject(EditorHost* host, void*, EditData* edit) {
  if (!HostIsCompatible(host)) return -1;
  WriteEditDataDefaults(*edit);
  return static_cast<int32_t>(RunSetupDialog(host, edit));
}

TAVRIN_EXPORT int32_t TVCALL SelectPopup(EditorHost* host, int32_t command, void*, void*, EditData* edit, void*,
                                         void*) {
  if (!HostIsCompatible(host) || command != kSetupCommand) return 0;
  return RunSetupDialog(host, edit) == 0 ? kSettingsChanged : 0;
}
