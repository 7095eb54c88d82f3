#pragma once
// The reader of named resources carried in a library file: the toolkit's PNG
// images and its XML documents (dialog layouts, cursor data). Names and types
// compare without regard to case, so code may ask for "RV4_Close_Normal" of
// type "png" what the table holds as "RV4_CLOSE_NORMAL" of type "PNG".
//
// The same object loads and shows the toolkit's cursors: it knows which
// cursor numbers are the platform's own and which are drawn by the toolkit.
#include <vector>

#include "tarsel/UTFString.h"

namespace norvik::ui {

// Where a registered cursor's picture comes from.
enum class LoadByPolicy { kByResource, kByPath };

class ResourceManager {
 public:
  virtual ~ResourceManager() = default;

  // Replaces the content of outBuffer with the bytes of the resource; raises
  // "Unable to access resource '<name>' (type <type>)" when there is none.
  virtual void GetBinary(UTF16String const& inName, UTF16String const& inType, std::vector<char>* outBuffer) const = 0;
  virtual bool HasBinary(UTF16String const& inName, UTF16String const& inType) const = 0;

  // Registers a cursor picture under inID, with its hot spot: a PNG resource
  // name or a file path as inPolicy says. The cursor is made when it is first
  // displayed.
  virtual void MakeCursorFromPNG(int inID, UTF16String const& inName, short inHotX, short inHotY,
                                 LoadByPolicy inPolicy) const = 0;
  // Makes inID the cursor in force.
  virtual void DisplayCursor(int inID) const = 0;
  // Releases the native cursor made for inID (it is made again when next
  // displayed); the registration stays.
  virtual void DisposeCursor(int inID) const = 0;
  // The PNG and the XML resource names of the toolkit-drawn cursor inID.
  virtual void GetResourceDataNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) const = 0;
};

}  // namespace norvik::ui
