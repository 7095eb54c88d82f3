#include "tarsel/FileUtils.h"

#include <cstdlib>
#include <system_error>

#include <pwd.h>
#include <unistd.h>

namespace tarsel::utility::FileUtils {

namespace fs = std::filesystem;

bool FileExists(const UTF16String& inPath) { return filesupport::File(inPath).Exists(); }

bool RemoveFile(const UTF16String& inPath) {
  const filesupport::File file(inPath);
  std::error_code error;
  if (fs::is_directory(file.GetPath(), error)) return false;
  return fs::remove(file.GetPath(), error) && !error;
}

UTF16String BuildPathSpec(const UTF16String& inFolder, const UTF16String& inName) {
  if (inFolder.empty() || (!inName.empty() && inName.front() == u'/')) return inName;
  if (inName.empty()) return inFolder;
  UTF16String path = inFolder;
  if (path.back() != u'/') path.push_back(u'/');
  return path + inName;
}

filesupport::Dir GetUserConfigDir() {
  const char* xdg = std::getenv("XDG_CONFIG_HOME");
  if (xdg && xdg[0] == '/') return filesupport::Dir(fs::path(xdg));
  const char* home = std::getenv("HOME");
  std::string homePath = home && home[0] ? home : "";
  if (homePath.empty()) {
    if (const passwd* entry = ::getpwuid(::getuid()); entry && entry->pw_dir) homePath = entry->pw_dir;
  }
  if (homePath.empty()) homePath = "/tmp";
  return filesupport::Dir(fs::path(homePath) / ".config");
}

}  // namespace tarsel::utility::FileUtils
