#pragma once
// A user at a real X server: a second connection that moves the pointer,
// presses buttons and types through XTEST, and that can change the server's
// keyboard mapping the way a layout switch does.
#include <xcb/xcb.h>

#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <vector>

namespace norvik::ui {
class OS_NativeLayer;
}

namespace norvik::test {

// Runs the layer's pending events until inCondition holds or inMilliseconds
// pass; answers the condition. What a user did reaches the toolkit only
// through the layer's loop, so every test waits this way.
bool PumpUntil(ui::OS_NativeLayer& inLayer, const std::function<bool()>& inCondition, int inMilliseconds);

// One pixel of a drawable as the server holds it, 0xRRGGBB; all ones when
// the server refuses (an unmapped window, a point outside it).
std::uint32_t ReadServerPixel(xcb_connection_t* inConnection, xcb_drawable_t inDrawable, int inX, int inY);

class XTestUser {
 public:
  explicit XTestUser(const std::string& inDisplay);
  ~XTestUser();
  XTestUser(const XTestUser&) = delete;
  XTestUser& operator=(const XTestUser&) = delete;

  bool IsConnected() const { return mConnection && !xcb_connection_has_error(mConnection); }
  xcb_connection_t* GetConnection() const { return mConnection; }
  xcb_window_t GetRoot() const;

  void MovePointer(int inX, int inY);
  void Button(int inButton, bool inPress);
  void Click(int inX, int inY, int inButton = 1);
  // The key whose unshifted symbol is inKeysym; false when no key has it.
  bool Key(std::uint32_t inKeysym, bool inPress);
  bool Tap(std::uint32_t inKeysym);
  void KeyCode(xcb_keycode_t inKeycode, bool inPress);
  // The keycode whose unshifted symbol is inKeysym, 0 when none.
  xcb_keycode_t KeycodeOf(std::uint32_t inKeysym);

  // Gives inKeycode the symbols inLower and inUpper (its first two levels).
  // The old mapping of every key changed here comes back in the destructor.
  void MapKey(xcb_keycode_t inKeycode, std::uint32_t inLower, std::uint32_t inUpper);
  void RestoreKeys();
  // Waits (a second at most) until the server has no key down.
  void WaitForKeysUp();

 private:
  std::vector<std::uint32_t> ReadKey(xcb_keycode_t inKeycode, int& outPerKey);
  void WriteKey(xcb_keycode_t inKeycode, const std::vector<std::uint32_t>& inSyms, int inPerKey);

  xcb_connection_t* mConnection = nullptr;
  std::map<xcb_keycode_t, std::pair<std::vector<std::uint32_t>, int>> mSavedKeys;
};

}  // namespace norvik::test
