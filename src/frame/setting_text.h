// Conversion of a stored setting text to a number.
#pragma once

#include "frame/edit_data.h"

// Reads the longest prefix of a setting field that is a decimal number:
// leading white space, an optional sign, digits with an optional '.'
// fraction, and an optional exponent. 0 when there is none. The decimal point
// is always '.', whatever the locale; hexadecimal, "inf" and "nan" are not
// numbers here. A field that lacks its terminator is never read past its
// end. The result is the double nearest to the number, ties to even, the same
// on every build: an exponent too large for a double gives an infinity, one
// too small gives 0, as the C library's conversion does.
double ParseDecimalPrefix(const char (&field)[kSettingTextSize]);
