// A dialog template as the resource compiler stores it (DLGTEMPLATE and
// its items), read into plain values.
#pragma once

#include <windows.h>

#include <cstddef>
#include <string>
#include <vector>

namespace standin {

// A class, menu or text field: an ordinal, or a text (empty for none).
struct TemplateName {
  bool isOrdinal = false;
  WORD ordinal = 0;
  std::string text;
};

struct DialogItemTemplate {
  DWORD style = 0;
  DWORD exStyle = 0;
  short x = 0, y = 0, cx = 0, cy = 0;
  WORD id = 0;
  TemplateName windowClass;
  TemplateName title;
};

struct DialogTemplate {
  DWORD style = 0;
  DWORD exStyle = 0;
  short x = 0, y = 0, cx = 0, cy = 0;
  TemplateName menu;
  TemplateName windowClass;
  std::string caption;
  WORD pointSize = 0;  // with DS_SETFONT only
  std::string font;
  std::vector<DialogItemTemplate> items;
};

// Reads the classic template form. False when the bytes end early or hold
// the extended form (DLGTEMPLATEEX), which no resource here uses.
bool ReadDialogTemplate(const unsigned char* bytes, std::size_t size, DialogTemplate& dialog);

}  // namespace standin
