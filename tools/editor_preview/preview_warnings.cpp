#include "preview_warnings.h"

#include <cstdint>

#include "chain_template.h"

namespace editor_preview {

std::vector<std::string> PreviewWarnings(const EditData& before, const EditData& after) {
  std::vector<std::string> warnings;
  if (before.viewTemplate > 1) {
    warnings.push_back("view-template is " + std::to_string(before.viewTemplate) +
                       ": the frame editor draws nothing for it and keeps the stored size; the setup dialog only "
                       "stores 0 or 1");
  }
  if (before.viewTemplate != 1) return warnings;

  const struct {
    const char* name;
    int32_t value;
  } sizes[] = {{"number of links", before.linkCount},       {"link height", before.linkHeight},
               {"anchor width", before.anchorWidth},         {"anchor height", before.anchorHeight},
               {"platform width", before.platformWidth},     {"platform height", before.platformHeight}};
  for (const auto& [name, value] : sizes) {
    if (value < 0) {
      warnings.push_back(std::string("the ") + name + " is " + std::to_string(value) +
                         ", less than 0: the preview is drawn from it all the same, inside out or on the other side "
                         "of the anchor");
    }
  }

  const ChainTemplate chain(before);
  if (chain.width != after.objectWidth || chain.height != after.objectHeight) {
    warnings.push_back("the object would be " + Whole(chain.width) + " x " + Whole(chain.height) +
                       " pixels, beyond what its stored 16-bit size holds (-32768 to 32767): the editor takes it as " +
                       std::to_string(after.objectWidth) + " x " + std::to_string(after.objectHeight));
  } else if (after.objectWidth <= 1 || after.objectHeight <= 1) {
    warnings.push_back("the object comes out " + std::to_string(after.objectWidth) + " x " +
                       std::to_string(after.objectHeight) + " pixels: too small for an author to select in the editor");
  }
  return warnings;
}

}  // namespace editor_preview
