#pragma once
// The toolkit's cursors. A toolkit-drawn cursor is a PNG resource
// "CursorID-<n>" with a data document "CursorDataID-<n>" that gives its hot
// spot; the numbers below 7 are the platform's own cursors. The native
// cursor is made through whatever native layer is installed, and nothing
// happens when none is.
#include <utility>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/ResourceInterfaces.h"
#include "tarsel/UTFString.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::ui {
class ResourceManager;
}

namespace norvik::utility {

// Cursor numbers the platform draws itself.
enum CursorID : int {
  kCursorArrow = 0,
  kCursorDefault = 1,
  kCursorWait = 2,
  kCursorCross = 3,
  kCursorNotAllowed = 4,
  kCursorArrowAlternate = 5,
  kCursorArrowOther = 6,
  kFirstToolkitCursor = 7
};

// The PNG and the XML resource names of cursor inID: "CursorID-<n>" and
// "CursorDataID-<n>".
void GetCursorResourceNames(int inID, UTF16String& outPNGName, UTF16String& outDataName);

// The system cursor number (such as the arrow, 32512) that stands for inID,
// or 0 when inID is not one of the platform's cursors.
int GetSystemCursorNumber(int inID);

// The hot spot from the cursor data document inDataName (type "xml"), or
// (0, 0) when there is no such document. Raises "Not a valid cursor data
// definition." when the document has no "NRK_CursorData" version, and
// "Unable to load cursor data file. Incompatible version." for a version
// other than "1.0"; malformed XML raises the property-list reader's error.
std::pair<short, short> LoadCursorHotSpot(UTF16String const& inDataName, ui::ResourceManager const& inResources);

// A native cursor with the picture of inImage (an image of the platform
// supplier) and the hot spot (inHotX, inHotY); 0 without a native layer or
// an image.
ui::OS_CursorHandle GetCursorFromImage(boost::intrusive_ptr<drawbot::ImageInterface> inImage, short inHotX,
                                       short inHotY);
// Makes such a cursor and puts it in force; answers its handle, which the
// caller releases with DisposeCursor once another cursor is in force.
ui::OS_CursorHandle DisplayCursorFromImage(boost::intrusive_ptr<drawbot::ImageInterface> inImage, short inHotX,
                                           short inHotY);
// Puts a native cursor in force.
void DisplayCursor(ui::OS_CursorHandle inCursor);
void DisposeCursor(ui::OS_CursorHandle inCursor);

}  // namespace norvik::utility
