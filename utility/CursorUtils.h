#pragma once
// The toolkit's cursors. A toolkit-drawn cursor is a PNG resource
// "CursorID-<n>" with a data document "CursorDataID-<n>" that gives its hot
// spot; the numbers below 7 are the platform's own cursors. The native
// cursor is made through whatever native layer is installed, and nothing
// happens when none is.
#include <utility>
#include <vector>

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

// The cursors the library carries as artwork of its own, by number: a
// picture "NativeCursor-<n>" with its hot spot in "NativeCursorData-<n>".
enum NativeCursorID : int {
  kCursorTextInsert = 1,        // an I-beam, where typing goes into a field
  kCursorOpenHand = 10,         // the view can be grabbed
  kCursorZoomIn = 11,
  kCursorZoomOut = 12,
  kCursorClosedHand = 13,       // panning the view
  kCursorResizeColumns = 14,    // a vertical divider moves left and right
  kCursorScrub = 15,            // dragging left and right changes a number
  kCursorWheel = 16,            // the wheel changes the value
  kCursorResizeRows = 17,       // a horizontal divider moves up and down
  kCursorHotText = 18,          // a pointing hand over hot text
  kCursorColorPicker = 19,      // a ring around the sampled point
  kCursorEyedropper = 20,
  kCursorPencil = 21,
  kCursorMove = 22,             // drags the object under the arrow
  kCursorTrimStart = 23,        // the in point of a clip moves
  kCursorTrimEnd = 24,          // the out point of a clip moves
  kCursorRazor = 25             // cuts at the vertical line
};

// Every number that has such artwork, in ascending order.
const std::vector<int>& GetNativeCursorNumbers();

// The PNG and the XML resource names of cursor inID: "CursorID-<n>" and
// "CursorDataID-<n>".
void GetCursorResourceNames(int inID, UTF16String& outPNGName, UTF16String& outDataName);
// The PNG and XML names of the library's own artwork for cursor inID:
// "NativeCursor-<n>" and "NativeCursorData-<n>".
void GetNativeCursorResourceNames(int inID, UTF16String& outPNGName, UTF16String& outDataName);

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
