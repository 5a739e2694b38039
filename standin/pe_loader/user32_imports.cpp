// USER32: the Win32 stand-in's calls, which read the loaded image's own
// resources through its module handle.
#include <windows.h>

#include "import_tables.h"

namespace pe {

std::span<const ImportRow> User32Imports() {
  static const ImportRow rows[] = {
      Stdcall<16>("AppendMenuA", &AppendMenuA),
      Stdcall<12>("CheckDlgButton", &CheckDlgButton),
      Stdcall<0>("CreatePopupMenu", &CreatePopupMenu),
      Stdcall<4>("DestroyMenu", &DestroyMenu),
      Stdcall<20>("DialogBoxParamA", &DialogBoxParamA),
      Stdcall<8>("EndDialog", &EndDialog),
      Stdcall<16>("GetDlgItemInt", &GetDlgItemInt),
      Stdcall<16>("GetDlgItemTextA", &GetDlgItemTextA),
      Stdcall<4>("GetMenuItemCount", &GetMenuItemCount),
      Stdcall<8>("GetMenuItemID", &GetMenuItemID),
      Stdcall<12>("GetMenuState", &GetMenuState),
      Stdcall<20>("GetMenuStringA", &GetMenuStringA),
      Stdcall<8>("GetSubMenu", &GetSubMenu),
      Stdcall<8>("GetWindowLongA", &GetWindowLongA),
      Stdcall<8>("IsDlgButtonChecked", &IsDlgButtonChecked),
      Stdcall<4>("IsWindow", &IsWindow),
      Stdcall<8>("LoadMenuA", &LoadMenuA),
      Stdcall<16>("LoadStringA", &LoadStringA),
      Stdcall<16>("MessageBoxA", &MessageBoxA),
      Stdcall<16>("SetDlgItemInt", &SetDlgItemInt),
      Stdcall<12>("SetDlgItemTextA", &SetDlgItemTextA),
      Stdcall<12>("SetWindowLongA", &SetWindowLongA),
  };
  return rows;
}

}  // namespace pe
