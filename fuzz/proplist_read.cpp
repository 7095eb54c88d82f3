// Property-list documents from outside: reading may refuse a document only
// with the toolkit's exception, and whatever it accepts must write out and
// read back to the same document text.
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "tarsel/PropListUtils.h"
#include "tarsel/ThrowError.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  using namespace tarsel::proplist;
  const std::string_view text(reinterpret_cast<const char*>(inData), inSize);
  PropList list;
  try {
    utils::ReadPropList(text, list);
  } catch (const tarsel::config::Exception&) {
    return 0;
  }
  // Floats are written with six digits, so lists may differ after one trip;
  // from then on the text must be stable.
  const UTF8String first = utils::WritePropList(list);
  PropList again;
  utils::ReadPropList(first, again);
  const UTF8String second = utils::WritePropList(again);
  if (first != second) {
    std::fprintf(stderr, "written document does not read back the same:\n%s\n---\n%s\n", first.c_str(),
                 second.c_str());
    std::abort();
  }
  return 0;
}
