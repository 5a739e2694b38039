// Conversion of a stored setting text to a number.
#pragma once

#include <cstddef>

// Reads the longest prefix of `text` that is a decimal number: leading white
// space, an optional sign, digits with an optional '.' fraction, and an
// optional exponent. 0 when there is none. The decimal point is always '.',
// whatever the locale; hexadecimal, "inf" and "nan" are not numbers here.
// At most `size` bytes are read, so a field that lacks its terminator is
// never read past its end. An exponent too large for a double gives an
// infinity, one too small gives 0, as the C library's conversion does.
double ParseDecimalPrefix(const char* text, std::size_t size);
