// JSON text from outside: parsing may refuse text only with the toolkit's
// exception, and every parsed value must write out and parse back to the
// same text.
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "tarsel/JSONSerialization.h"
#include "tarsel/ThrowError.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  using namespace tarsel::serialization;
  const std::string_view text(reinterpret_cast<const char*>(inData), inSize);
  boost::any value;
  try {
    value = JSONParse(text);
  } catch (const tarsel::config::Exception&) {
    return 0;
  }
  const UTF8String first = GetJSONString(value);
  const UTF8String second = GetJSONString(JSONParse(first));
  if (first != second) {
    std::fprintf(stderr, "written JSON does not parse back the same:\n%s\n---\n%s\n", first.c_str(), second.c_str());
    std::abort();
  }
  (void)ObjectHasProperty(value, "mToolBarItemsInfo");
  (void)GetVariantInObject(value, "mToolBarItemsInfo");
  return 0;
}
