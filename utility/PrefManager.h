#pragma once
// Window rectangles kept across runs. The preferences live in one property
// list per user, "NRKDialogPrefs.xml" in the toolkit's folder under the user's
// configuration folder; each window has a sub-list under its identifier with
// its position and size. A rectangle read back is checked against the
// monitors of now: one saved on a screen that is gone reopens on the primary.
#include <memory>

#include "tarsel/PointT.h"
#include "tarsel/PropList.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"

namespace norvik::utility {

class PrefManager {
 public:
  using Rect = tarsel::geom::RectT<long>;
  using Point = tarsel::geom::PointT<long>;

  static constexpr const char16_t* kDialogPrefsFileName = u"NRKDialogPrefs.xml";

  // The one manager: null before Initialize and after Finalize.
  static PrefManager* GetPrefManager();
  // Makes the manager and loads the file; a second call does nothing.
  static void Initialize();
  // Saves the file and ends the manager.
  static void Finalize();

  PrefManager();

  // "<user configuration folder>/norvik".
  UTF16String GetDialogPrefsDirectory() const;
  UTF16String GetDialogPrefsPath() const;
  // A missing or unreadable file leaves empty preferences.
  void LoadDialogPrefFile();
  // Creates the folder when needed; raises the toolkit's exception when the
  // file cannot be written.
  void SaveDialogPrefFile() const;

  // Each Get answers false, leaving the output alone, when nothing is stored.
  // Rectangles and positions come back corrected for the monitors of now.
  bool GetWindowPositionAndSize(const UTF8String& inWindowID, Rect& outRect) const;
  void SetWindowPositionAndSize(const UTF8String& inWindowID, const Rect& inRect);
  bool GetWindowPosition(const UTF8String& inWindowID, Point& outPosition) const;
  void SetWindowPosition(const UTF8String& inWindowID, const Point& inPosition);
  bool GetWindowSize(const UTF8String& inWindowID, Point& outSize) const;
  void SetWindowSize(const UTF8String& inWindowID, const Point& inSize);

  // The rectangle itself when its top corners still lie on a monitor and it
  // shows usably; otherwise placed on the primary monitor.
  Rect AdjustForMonitorInfoChange(const Rect& inRect) const;

  tarsel::proplist::PropList& GetPrefs() { return *mPrefs; }

 private:
  tarsel::proplist::PropListP WindowList(const UTF8String& inWindowID);

  tarsel::proplist::PropListP mPrefs;
};

}  // namespace norvik::utility
