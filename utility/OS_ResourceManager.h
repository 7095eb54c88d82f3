#pragma once
// The resource reader over a module's own resource table (the resources that
// the build compiles into the library), and the toolkit's cursors.
//
// Cursors are registered by number and made on first display: a picture
// registered with MakeCursorFromPNG, else the toolkit-drawn "CursorID-<n>"
// resource with the hot spot of its "CursorDataID-<n>" document, else the
// library's own artwork for the number ("NativeCursor-<n>", see
// NativeCursorID). Numbers 0 to 6 (but 1) are the platform's own cursors.
#include <map>

#include "tarsel/ModuleResources.h"
#include "ui/OS_NativeLayer.h"
#include "ui/ResourceManager.h"

namespace norvik::utility {

class OS_ResourceManager : public ui::ResourceManager {
 public:
  struct BigCursorInfo {
    bool loaded = false;
    UTF16String name;  // PNG resource name or file path
    short hotX = 0;
    short hotY = 0;
    ui::OS_CursorHandle cursor = 0;  // the native cursor once loaded
    ui::LoadByPolicy policy = ui::LoadByPolicy::kByResource;
  };

  explicit OS_ResourceManager(tarsel::resources::ModuleHandle inModule = tarsel::resources::kThisModule);
  // The copy shares the registrations but makes its own native cursors.
  OS_ResourceManager(OS_ResourceManager const& inOther);
  OS_ResourceManager& operator=(OS_ResourceManager const&) = delete;
  // Releases the native cursors this manager made.
  ~OS_ResourceManager() override;

  void GetBinary(UTF16String const& inName, UTF16String const& inType, std::vector<char>* outBuffer) const override;
  bool HasBinary(UTF16String const& inName, UTF16String const& inType) const override;
  void MakeCursorFromPNG(int inID, UTF16String const& inName, short inHotX, short inHotY,
                         ui::LoadByPolicy inPolicy) const override;
  void DisplayCursor(int inID) const override;
  void DisposeCursor(int inID) const override;
  void GetResourceDataNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) const override;

  tarsel::resources::ModuleHandle GetModule() const { return mModule; }
  // The registration of inID, or null.
  BigCursorInfo const* FindCursorInfo(int inID) const;

 private:
  // Makes the native cursor of a registered entry.
  void LoadCursor(BigCursorInfo& ioInfo) const;
  // Reads the hot spot of a toolkit-drawn cursor, registers and shows it.
  void LoadAndDisplayCursor(int inID, UTF16String const& inPNGName, UTF16String const& inDataName) const;
  // The same for the library's own numbered artwork; false when it has none
  // for inID.
  bool LoadAndDisplayNativeCursor(int inID) const;

  tarsel::resources::ModuleHandle mModule;
  // A cache of native cursors, filled by the const display operations.
  mutable std::map<int, BigCursorInfo> mCursors;
};

}  // namespace norvik::utility
