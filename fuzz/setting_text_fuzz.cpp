// Any ten bytes of a stored setting convert without reading past the field,
// and agree to the bit with the C library wherever the text is plain decimal.
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "frame/setting_text.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  // Exactly the field's bytes on the heap, so a read past them is caught.
  constexpr size_t kField = kSettingTextSize;
  char* field = static_cast<char*>(std::malloc(kField));
  std::memset(field, 0, kField);
  std::memcpy(field, data, size < kField ? size : kField);
  const double value = ParseDecimalPrefix(*reinterpret_cast<const char(*)[kField]>(field));

  // Where every byte is a digit, '.', sign, 'e' or a space, strtod in the
  // "C" locale reads the same number.
  bool plain = true;
  for (size_t i = 0; i < kField && field[i] != '\0'; ++i) {
    plain = plain && std::strchr("0123456789.+-eE ", field[i]) != nullptr;
  }
  if (plain) {
    char terminated[kField + 1] = {};
    std::memcpy(terminated, field, kField);
    const double expected = std::strtod(terminated, nullptr);
    if (std::memcmp(&value, &expected, sizeof value) != 0) std::abort();  // to the bit, the sign of 0 too
  }
  std::free(field);
  return 0;
}
