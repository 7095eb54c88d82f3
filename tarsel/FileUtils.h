#pragma once
// Path helpers by text, and the folder where the toolkit and its host keep
// preference files.
#include "tarsel/FileSupport.h"
#include "tarsel/UTFString.h"

namespace tarsel::utility::FileUtils {

bool FileExists(const UTF16String& inPath);
// Removes a file (not a folder); answers whether it was removed.
bool RemoveFile(const UTF16String& inPath);
// inFolder and inName joined with one separator: "a/b" and "c" give "a/b/c",
// as do "a/b/" and "c". An absolute inName stands alone.
UTF16String BuildPathSpec(const UTF16String& inFolder, const UTF16String& inName);

// The user's configuration folder: $XDG_CONFIG_HOME when it is set to an
// absolute path, else ~/.config (with the home folder from $HOME, or from the
// password database when $HOME is unset). It may not exist yet.
filesupport::Dir GetUserConfigDir();

}  // namespace tarsel::utility::FileUtils
