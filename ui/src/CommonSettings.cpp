#include "ui/CommonSettings.h"

#include <fstream>
#include <string>

#include "tarsel/FileUtils.h"

namespace norvik::ui {

namespace {

std::filesystem::path CommonSettingsFile() {
  return tarsel::utility::FileUtils::GetUserConfigDir().GetPath() / "Halvorn" / "Common" / "Settings.conf";
}

}  // namespace

UTF16String GetCommonSettingsPath() {
  return tarsel::utility::UTF8to16(CommonSettingsFile().string());
}

bool ReadCommonSetting(const UTF16String& inName, UTF16String& outValue) {
  std::ifstream in(CommonSettingsFile());
  if (!in) return false;
  const std::string wanted = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inName));
  std::string line;
  while (std::getline(in, line)) {
    if (!line.empty() && line.back() == '\r') line.pop_back();
    if (line.empty() || line[0] == '#') continue;
    const std::size_t eq = line.find('=');
    if (eq == std::string::npos || line.compare(0, eq, wanted) != 0 || eq != wanted.size()) continue;
    outValue = tarsel::utility::UTF8to16(std::string_view(line).substr(eq + 1));
    return true;
  }
  return false;
}

}  // namespace norvik::ui
