#include "import_tables.h"

#include "loaded_images.h"

namespace pe {

const ImportTable* FindImportTable(std::string_view dll) {
  static const ImportTable tables[] = {
      {"KERNEL32.dll", Kernel32Imports()},
      {"USER32.dll", User32Imports()},
      {"msvcrt.dll", MsvcrtImports()},
      {"DRAVO2.dll", Dravo2Imports()},
  };
  for (const ImportTable& table : tables) {
    if (NamesFile(dll, table.dll)) return &table;
  }
  return nullptr;
}

const ImportRow* FindImportRow(const ImportTable& table, std::string_view name, uint16_t ordinal) {
  for (const ImportRow& row : table.rows) {
    if (name.empty() ? row.name == nullptr && row.ordinal == ordinal : row.name != nullptr && name == row.name) {
      return &row;
    }
  }
  return nullptr;
}

}  // namespace pe
