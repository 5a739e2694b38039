// What the template view is drawn from, as the author reads it: the radius
// and the object's size worked out in full, before the 32-bit and 16-bit
// fields they end up in wrap them. (Doubles: exact up to 2^53, and no
// settings make them overflow.)
#pragma once

#include <cstdint>
#include <string>

#include "frame/edit_data.h"

namespace editor_preview {

struct ChainTemplate {
  explicit ChainTemplate(const EditData& settings);

  int32_t spacing;  // the link spacing text as the editor reads it: a whole number
  int32_t angle;    // the starting angle text, likewise, in degrees
  double radius;  // (link height + spacing) x (number of links + 1)
  double width;   // platform width + 2 x radius
  double height;  // platform height + 2 x radius
  int32_t drawnRadius;  // the radius in 32 bits, as the display works it out
};

// A whole number as a message shows it.
std::string Whole(double value);

}  // namespace editor_preview
