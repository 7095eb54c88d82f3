// XSETTINGS data comes from whichever client owns the settings selection: the
// reader may refuse it only with the toolkit's exception, and what it does
// read must hold no more settings than the bytes could carry.
#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "tarsel/ThrowError.h"
#include "ui/src/x11/XSettingsData.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  using norvik::ui::x11::XSettingsData;
  try {
    const XSettingsData data = XSettingsData::Parse(inData, inSize);
    if (data.GetCount() > inSize / 12) {
      std::fprintf(stderr, "more settings than the data can hold\n");
      std::abort();
    }
    (void)data.FindInteger("Net/DoubleClickTime");
    (void)data.FindString("Net/ThemeName");
  } catch (const tarsel::config::Exception&) {
  }
  return 0;
}
