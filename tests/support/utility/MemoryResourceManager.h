#pragma once
// A resource reader over documents the test puts in memory, for feeding the
// cursor and image code input the library does not carry. Cursor operations
// are counted, not performed.
#include <map>
#include <string>
#include <utility>

#include "ui/ResourceManager.h"

namespace norvik::utility::testing {

class MemoryResourceManager : public ui::ResourceManager {
 public:
  // Names and types are stored as given and matched without regard to case.
  void Put(std::string const& inName, std::string const& inType, std::string const& inBytes);

  void GetBinary(UTF16String const& inName, UTF16String const& inType, std::vector<char>* outBuffer) const override;
  bool HasBinary(UTF16String const& inName, UTF16String const& inType) const override;
  void MakeCursorFromPNG(int, UTF16String const&, short, short, ui::LoadByPolicy) const override {}
  void DisplayCursor(int inID) const override { mDisplayed.push_back(inID); }
  void DisposeCursor(int) const override {}
  void GetResourceDataNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) const override;

  int GetReadCount() const { return mReads; }
  std::vector<int> const& GetDisplayed() const { return mDisplayed; }

 private:
  std::string const* Find(UTF16String const& inName, UTF16String const& inType) const;

  std::map<std::pair<std::string, std::string>, std::string> mItems;
  mutable int mReads = 0;
  mutable std::vector<int> mDisplayed;
};

}  // namespace norvik::utility::testing
