#pragma once
// Settings shared by every application of the toolkit's family, such as
// "GB18030 UI Support". They live in one text file under the user's
// configuration folder, "Halvorn/Common/Settings.conf", one "name=value" a
// line; blank lines and lines starting with '#' are ignored. Names may hold
// spaces; the value is everything after the first '='.
#include "tarsel/UTFString.h"

namespace norvik::ui {

UTF16String GetCommonSettingsPath();

// False, leaving outValue alone, when the file or the name is missing.
bool ReadCommonSetting(const UTF16String& inName, UTF16String& outValue);

}  // namespace norvik::ui
