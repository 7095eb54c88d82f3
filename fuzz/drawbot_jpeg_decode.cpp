// JPEG bytes from outside (resources, files): the decoder may refuse them only
// with the toolkit's exception, and an image it does give has a size.
#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "tarsel/ThrowError.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  using namespace norvik::drawbot;
  static SupplierInterface* supplier = NewOSSupplier();
  // A size of 0 would make the bytes a file name.
  if (inSize == 0) return 0;
  try {
    FileImageP image(supplier, kImageFileTypeJPG, inData, static_cast<unsigned long>(inSize));
    if (image.Get()->GetWidth() == 0 || image.Get()->GetHeight() == 0) {
      std::fprintf(stderr, "a decoded image without size\n");
      std::abort();
    }
  } catch (const tarsel::config::Exception&) {
  }
  return 0;
}
