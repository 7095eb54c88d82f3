// Feeds arbitrary text to the arithmetic evaluator of number fields. The first
// byte picks the flags (localised or plain, unit names skipped or not); the
// rest is UTF-8 text, broken sequences included. Only the toolkit's own
// exception may come out, and a finite answer must survive formatting and
// reading back.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  if (inSize == 0) return 0;
  const unsigned short flags = inData[0] & 3;
  const UTF16String text =
      tarsel::utility::UTF8to16(std::string_view(reinterpret_cast<const char*>(inData + 1), inSize - 1));
  double value = 0;
  try {
    value = tarsel::utility::Calculate(text, flags);
  } catch (const tarsel::config::Exception&) {
    return 0;
  }
  if (std::isinf(value)) std::abort();  // overflow must raise, never answer infinity
  if (std::isnan(value)) return 0;
  const UTF16String written =
      tarsel::utility::NumberToString(value, 0, 6, tarsel::utility::kNumberFormatNoLocalization, 31);
  try {
    (void)tarsel::utility::StringToNumber(written, tarsel::utility::kNumberFormatNoLocalization);
  } catch (const tarsel::config::Exception&) {
    std::abort();  // the toolkit's own number text must read back
  }
  return 0;
}
