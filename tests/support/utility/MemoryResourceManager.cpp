#include "support/utility/MemoryResourceManager.h"

#include <algorithm>
#include <cctype>

#include "tarsel/ThrowError.h"
#include "utility/CursorUtils.h"

namespace norvik::utility::testing {

namespace {

std::string Upper(std::string inText) {
  std::transform(inText.begin(), inText.end(), inText.begin(),
                 [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
  return inText;
}

std::string Upper(UTF16String const& inText) {
  return Upper(tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inText)));
}

}  // namespace

void MemoryResourceManager::Put(std::string const& inName, std::string const& inType, std::string const& inBytes) {
  mItems[{Upper(inName), Upper(inType)}] = inBytes;
}

std::string const* MemoryResourceManager::Find(UTF16String const& inName, UTF16String const& inType) const {
  auto found = mItems.find({Upper(inName), Upper(inType)});
  return found == mItems.end() ? nullptr : &found->second;
}

void MemoryResourceManager::GetBinary(UTF16String const& inName, UTF16String const& inType,
                                      std::vector<char>* outBuffer) const {
  std::string const* bytes = Find(inName, inType);
  if (!bytes) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/utility/Error/ResourceUtils/UnableToAccessResourceDetailed="
                               "Unable to access resource '^1' (type ^2)",
                               0, 0, false, {}, inName, inType);
  }
  ++mReads;
  outBuffer->assign(bytes->begin(), bytes->end());
}

bool MemoryResourceManager::HasBinary(UTF16String const& inName, UTF16String const& inType) const {
  return Find(inName, inType) != nullptr;
}

void MemoryResourceManager::GetResourceDataNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) const {
  GetCursorResourceNames(inID, outPNGName, outDataName);
}

}  // namespace norvik::utility::testing
