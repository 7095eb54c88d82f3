#include "x11/XTestUser.h"

#include <xcb/xtest.h>

#include <unistd.h>

#include <chrono>
#include <cstdlib>

#include "ui/OS_NativeLayer.h"

namespace norvik::test {

bool PumpUntil(ui::OS_NativeLayer& inLayer, const std::function<bool()>& inCondition, int inMilliseconds) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(inMilliseconds);
  while (std::chrono::steady_clock::now() < end) {
    inLayer.ProcessPendingEvents();
    if (inCondition()) return true;
    usleep(1000);
  }
  inLayer.ProcessPendingEvents();
  return inCondition();
}

std::uint32_t ReadServerPixel(xcb_connection_t* inConnection, xcb_drawable_t inDrawable, int inX, int inY) {
  xcb_get_image_reply_t* image = xcb_get_image_reply(
      inConnection,
      xcb_get_image(inConnection, XCB_IMAGE_FORMAT_Z_PIXMAP, inDrawable, static_cast<int16_t>(inX),
                    static_cast<int16_t>(inY), 1, 1, ~0u),
      nullptr);
  if (!image) return 0xFFFFFFFF;
  const std::uint8_t* data = xcb_get_image_data(image);
  const std::uint32_t pixel = (std::uint32_t(data[2]) << 16) | (std::uint32_t(data[1]) << 8) | data[0];
  std::free(image);
  return pixel;
}

XTestUser::XTestUser(const std::string& inDisplay) : mConnection(xcb_connect(inDisplay.c_str(), nullptr)) {}

XTestUser::~XTestUser() {
  if (!mConnection) return;
  if (IsConnected()) {
    WaitForKeysUp();
    RestoreKeys();
  }
  xcb_disconnect(mConnection);
}

// The server runs faked input through its input queue, after the request
// that asked for it: a release sent last may still be on its way when a test
// ends, and would leave the key down for the next one.
void XTestUser::WaitForKeysUp() {
  for (int attempt = 0; attempt < 500; ++attempt) {
    xcb_query_keymap_reply_t* keymap = xcb_query_keymap_reply(mConnection, xcb_query_keymap(mConnection), nullptr);
    bool anyDown = false;
    if (keymap)
      for (std::uint8_t bits : keymap->keys) anyDown = anyDown || bits != 0;
    std::free(keymap);
    if (!anyDown) return;
    usleep(1000);
  }
}

xcb_window_t XTestUser::GetRoot() const { return xcb_setup_roots_iterator(xcb_get_setup(mConnection)).data->root; }

void XTestUser::MovePointer(int inX, int inY) {
  xcb_test_fake_input(mConnection, XCB_MOTION_NOTIFY, 0, XCB_CURRENT_TIME, GetRoot(), static_cast<int16_t>(inX),
                      static_cast<int16_t>(inY), 0);
  xcb_flush(mConnection);
}

void XTestUser::Button(int inButton, bool inPress) {
  xcb_test_fake_input(mConnection, inPress ? XCB_BUTTON_PRESS : XCB_BUTTON_RELEASE, static_cast<uint8_t>(inButton),
                      XCB_CURRENT_TIME, XCB_NONE, 0, 0, 0);
  xcb_flush(mConnection);
}

void XTestUser::Click(int inX, int inY, int inButton) {
  MovePointer(inX, inY);
  Button(inButton, true);
  Button(inButton, false);
}

xcb_keycode_t XTestUser::KeycodeOf(std::uint32_t inKeysym) {
  const xcb_setup_t* setup = xcb_get_setup(mConnection);
  const int count = setup->max_keycode - setup->min_keycode + 1;
  xcb_get_keyboard_mapping_reply_t* map = xcb_get_keyboard_mapping_reply(
      mConnection, xcb_get_keyboard_mapping(mConnection, setup->min_keycode, static_cast<uint8_t>(count)), nullptr);
  if (!map) return 0;
  const xcb_keysym_t* syms = xcb_get_keyboard_mapping_keysyms(map);
  xcb_keycode_t found = 0;
  for (int i = 0; i < count && !found; ++i)
    if (syms[i * map->keysyms_per_keycode] == inKeysym) found = static_cast<xcb_keycode_t>(setup->min_keycode + i);
  std::free(map);
  return found;
}

bool XTestUser::Key(std::uint32_t inKeysym, bool inPress) {
  const xcb_keycode_t keycode = KeycodeOf(inKeysym);
  if (keycode == 0) return false;
  KeyCode(keycode, inPress);
  return true;
}

void XTestUser::KeyCode(xcb_keycode_t inKeycode, bool inPress) {
  xcb_test_fake_input(mConnection, inPress ? XCB_KEY_PRESS : XCB_KEY_RELEASE, inKeycode, XCB_CURRENT_TIME, XCB_NONE,
                      0, 0, 0);
  xcb_flush(mConnection);
}

bool XTestUser::Tap(std::uint32_t inKeysym) { return Key(inKeysym, true) && Key(inKeysym, false); }

std::vector<std::uint32_t> XTestUser::ReadKey(xcb_keycode_t inKeycode, int& outPerKey) {
  xcb_get_keyboard_mapping_reply_t* map = xcb_get_keyboard_mapping_reply(
      mConnection, xcb_get_keyboard_mapping(mConnection, inKeycode, 1), nullptr);
  std::vector<std::uint32_t> syms;
  outPerKey = 0;
  if (!map) return syms;
  outPerKey = map->keysyms_per_keycode;
  const xcb_keysym_t* data = xcb_get_keyboard_mapping_keysyms(map);
  syms.assign(data, data + map->keysyms_per_keycode);
  std::free(map);
  return syms;
}

void XTestUser::WriteKey(xcb_keycode_t inKeycode, const std::vector<std::uint32_t>& inSyms, int inPerKey) {
  xcb_change_keyboard_mapping(mConnection, 1, inKeycode, static_cast<uint8_t>(inPerKey), inSyms.data());
  // A round trip, so the server has the new mapping before the next key.
  std::free(xcb_get_input_focus_reply(mConnection, xcb_get_input_focus(mConnection), nullptr));
}

void XTestUser::MapKey(xcb_keycode_t inKeycode, std::uint32_t inLower, std::uint32_t inUpper) {
  int perKey = 0;
  std::vector<std::uint32_t> old = ReadKey(inKeycode, perKey);
  if (perKey < 2) return;
  if (!mSavedKeys.count(inKeycode)) mSavedKeys[inKeycode] = {old, perKey};
  std::vector<std::uint32_t> syms(static_cast<std::size_t>(perKey), XCB_NO_SYMBOL);
  syms[0] = inLower;
  syms[1] = inUpper;
  WriteKey(inKeycode, syms, perKey);
}

void XTestUser::RestoreKeys() {
  for (const auto& [keycode, saved] : mSavedKeys) WriteKey(keycode, saved.first, saved.second);
  mSavedKeys.clear();
}

}  // namespace norvik::test
