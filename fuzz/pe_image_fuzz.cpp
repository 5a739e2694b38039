// Any file, however damaged, is read, laid out, relocated and searched by
// the PE loader's readers without a read or write outside the file or the
// image, and whatever they hand back lies inside the image. Nothing is run.
// The seeds are the shipping DLL without its code and the loader tests'
// probe DLL.
#include <cstdint>
#include <string>
#include <vector>

#include "fuzz_input.h"
#include "pe_image.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::span<const uint8_t> file(data, size);
  pe::Layout layout;
  std::string error;
  if (!pe::ReadLayout(file, layout, error)) {
    Check(!error.empty());
    return 0;
  }
  // Larger images are checked only as far as their headers: laying them out
  // would cost the fuzzer its speed, not find more.
  if (layout.sizeOfImage > (8u << 20)) return 0;
  std::vector<uint8_t> image(layout.sizeOfImage);
  pe::CopyImage(file, layout, image);
  const uint64_t end = image.size();
  const uint32_t base = layout.imageBase ^ 0x10000000u;  // as when its preferred base is taken
  if (!pe::Relocate(image, layout, base, error)) return 0;

  std::vector<pe::ImportedDll> dlls;
  if (pe::ReadImports(image, layout, dlls, error)) {
    for (const pe::ImportedDll& dll : dlls) {
      for (const pe::Import& function : dll.functions) Check(uint64_t{function.slotRva} + 4 <= end);
    }
  }
  Check(pe::FindExport(image, layout, "GetInfos") < end);
  pe::ThreadStorage storage;
  if (pe::ReadThreadStorage(image, layout, base, storage, error)) {
    Check(uint64_t{storage.dataRva} + storage.dataSize <= end && uint64_t{storage.indexRva} + 4 <= end);
    for (uint32_t callback : storage.callbacks) Check(callback < end);
  }
  std::vector<pe::Resource> resources;
  if (pe::ReadResources(image, layout, resources, error)) {
    for (const pe::Resource& resource : resources) Check(uint64_t{resource.dataRva} + resource.size <= end);
  }
  return 0;
}
