// Number text from outside (typed fields, archives): arbitrary text must read
// as a number or raise the toolkit's exception, and any double with any flags
// must format into text that reads back to the same rounded value.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"

namespace {

using namespace tarsel::utility;

void ReadArbitraryText(const std::uint8_t* inData, std::size_t inSize, unsigned short inFlags) {
  const UTF16String text = UTF8to16(std::string_view(reinterpret_cast<const char*>(inData), inSize));
  try {
    (void)StringToNumber(text, inFlags);
  } catch (const tarsel::config::Exception&) {
  }
}

// Formats the double in the first eight bytes and reads it back.
void FormatAndReadBack(const std::uint8_t* inData, std::size_t inSize, unsigned short inFlags) {
  if (inSize < 11) return;
  double value = 0;
  std::memcpy(&value, inData, sizeof(value));
  const int places = static_cast<int>(inData[8] % 12) - 2;
  const int width = inData[9] % 40;
  const unsigned short flags = static_cast<unsigned short>(inData[10] & 63) | inFlags;
  const UTF16String text = NumberToString(value, width, places, flags, 31);
  if (std::isnan(value)) return;
  double back = 0;
  try {
    back = StringToNumber(text, flags);
  } catch (const tarsel::config::Exception&) {
    std::abort();  // the toolkit's own text must read back
  }
  if (std::isinf(value)) {
    if (back != value) std::abort();
    return;
  }
  // Fixed text rounds to the places; scientific text keeps at least one
  // significant digit. Either way the relative or absolute error is bounded.
  const double unit = std::pow(10.0, -places);  // negative places round to tens, hundreds...
  if (std::fabs(back - value) > std::max(unit, std::fabs(value) * 0.5)) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  if (inSize == 0) return 0;
  static const tarsel::Locale kLocales[] = {tarsel::Locale(), tarsel::Locale("de", u',', u'.'),
                                            tarsel::Locale("fr", u',', u'\u202F')};
  tarsel::ScSetDefaultLocale locale(kLocales[(inData[0] >> 1) % 3]);
  const unsigned short flags = inData[0] & 1;  // plain or localised
  ReadArbitraryText(inData + 1, inSize - 1, flags);
  FormatAndReadBack(inData + 1, inSize - 1, flags);
  return 0;
}
