#include "dialog_template.h"

#include "module_resources.h"

namespace standin {

namespace {

constexpr DWORD kSetFont = 0x40;  // DS_SETFONT: a point size and a typeface follow the caption

// Reads the template front to back, never past its end.
class Reader {
 public:
  Reader(const unsigned char* bytes, std::size_t size) : bytes_(bytes), size_(size) {}

  bool Word(WORD& value) {
    if (offset_ + 2 > size_) return false;
    value = ReadWord(bytes_ + offset_);
    offset_ += 2;
    return true;
  }
  bool Dword(DWORD& value) {
    WORD low = 0, high = 0;
    if (!Word(low) || !Word(high)) return false;
    value = DWORD{low} | (DWORD{high} << 16);
    return true;
  }
  bool Short(short& value) {
    WORD word = 0;
    if (!Word(word)) return false;
    value = static_cast<short>(word);
    return true;
  }
  // A zero-terminated UTF-16 text.
  bool Text(std::string& text) {
    for (WORD c = 0; Word(c);) {
      if (c == 0) return true;
      text.push_back(NarrowChar(c));
    }
    return false;
  }
  // 0: none; 0xFFFF and a word: an ordinal; anything else starts a text.
  bool Name(TemplateName& name) {
    if (offset_ + 2 > size_) return false;
    const WORD first = ReadWord(bytes_ + offset_);
    if (first == 0xFFFF) {
      offset_ += 2;
      name.isOrdinal = true;
      return Word(name.ordinal);
    }
    return Text(name.text);
  }
  bool Skip(std::size_t count) {
    if (count > size_ - offset_) return false;
    offset_ += count;
    return true;
  }
  void AlignToDword() { offset_ = (offset_ + 3) & ~std::size_t{3}; }

 private:
  const unsigned char* bytes_;
  std::size_t size_;
  std::size_t offset_ = 0;
};

bool ReadItem(Reader& in, DialogItemTemplate& item) {
  WORD extraBytes = 0;
  in.AlignToDword();
  return in.Dword(item.style) && in.Dword(item.exStyle) && in.Short(item.x) && in.Short(item.y) &&
         in.Short(item.cx) && in.Short(item.cy) && in.Word(item.id) && in.Name(item.windowClass) &&
         in.Name(item.title) && in.Word(extraBytes) && in.Skip(extraBytes);
}

}  // namespace

bool ReadDialogTemplate(const unsigned char* bytes, std::size_t size, DialogTemplate& dialog) {
  if (size >= 4 && ReadWord(bytes) == 1 && ReadWord(bytes + 2) == 0xFFFF) return false;  // extended form
  Reader in(bytes, size);
  WORD count = 0;
  if (!in.Dword(dialog.style) || !in.Dword(dialog.exStyle) || !in.Word(count) || !in.Short(dialog.x) ||
      !in.Short(dialog.y) || !in.Short(dialog.cx) || !in.Short(dialog.cy) || !in.Name(dialog.menu) ||
      !in.Name(dialog.windowClass) || !in.Text(dialog.caption)) {
    return false;
  }
  if ((dialog.style & kSetFont) != 0 && (!in.Word(dialog.pointSize) || !in.Text(dialog.font))) return false;
  dialog.items.resize(count);
  for (DialogItemTemplate& item : dialog.items) {
    if (!ReadItem(in, item)) return false;
  }
  return true;
}

}  // namespace standin
