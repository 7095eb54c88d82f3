// XSETTINGS: the desktop's settings daemon, when one runs, owns the selection
// _XSETTINGS_S<screen> and keeps its settings in the property
// _XSETTINGS_SETTINGS of the owner window. The layer reads the double-click
// time from it, follows changes of the property, picks up a daemon that
// starts later (its MANAGER announcement on the root window), and goes back to
// the default when the daemon goes away.
#include <cstdlib>
#include <cstring>
#include <string>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

constexpr unsigned kDefaultDoubleClickTime = 500;

// Little-endian settings data, as every daemon on today's hardware writes.
class SettingsReader {
 public:
  SettingsReader(const std::uint8_t* inData, std::size_t inSize) : mData(inData), mSize(inSize) {}

  // The integer setting inName; false when absent or the data is malformed.
  bool FindInteger(const char* inName, std::uint32_t& outValue) const {
    if (mSize < 12 || mData[0] != 0) return false;
    const std::uint32_t count = Read32(8);
    std::size_t at = 12;
    for (std::uint32_t i = 0; i < count && at + 4 <= mSize; ++i) {
      const std::uint8_t type = mData[at];
      const std::size_t nameLength = static_cast<std::size_t>(mData[at + 2] | (mData[at + 3] << 8));
      const std::size_t valueAt = at + 4 + Padded(nameLength) + 4;  // the serial follows the name
      if (valueAt > mSize) return false;
      const std::string name(reinterpret_cast<const char*>(mData + at + 4), nameLength);
      if (type == 0) {  // integer
        if (valueAt + 4 > mSize) return false;
        if (name == inName) {
          outValue = Read32(valueAt);
          return true;
        }
        at = valueAt + 4;
      } else if (type == 1) {  // string
        if (valueAt + 4 > mSize) return false;
        at = valueAt + 4 + Padded(Read32(valueAt));
      } else if (type == 2) {  // colour
        at = valueAt + 8;
      } else {
        return false;
      }
    }
    return false;
  }

 private:
  static std::size_t Padded(std::size_t inLength) { return (inLength + 3) & ~std::size_t(3); }
  std::uint32_t Read32(std::size_t inAt) const {
    return static_cast<std::uint32_t>(mData[inAt] | (mData[inAt + 1] << 8) | (mData[inAt + 2] << 16) |
                                      (static_cast<std::uint32_t>(mData[inAt + 3]) << 24));
  }
  const std::uint8_t* mData;
  std::size_t mSize;
};

}  // namespace

void OS_NativeLayer_X11::WatchXSettings() {
  // The daemon announces itself to the root window's StructureNotify clients.
  const std::uint32_t rootMask = XCB_EVENT_MASK_STRUCTURE_NOTIFY;
  xcb_change_window_attributes(mConnection, mScreen->root, XCB_CW_EVENT_MASK, &rootMask);
  ReadXSettings();
}

void OS_NativeLayer_X11::ReadXSettings() {
  xcb_get_selection_owner_reply_t* owner = xcb_get_selection_owner_reply(
      mConnection, xcb_get_selection_owner(mConnection, Atom("_XSETTINGS_S0")), nullptr);
  mXSettingsWindow = owner ? owner->owner : xcb_window_t(XCB_WINDOW_NONE);
  std::free(owner);
  mDoubleClickTime = kDefaultDoubleClickTime;
  if (mXSettingsWindow == XCB_WINDOW_NONE) return;
  const std::uint32_t mask = XCB_EVENT_MASK_PROPERTY_CHANGE | XCB_EVENT_MASK_STRUCTURE_NOTIFY;
  xcb_change_window_attributes(mConnection, mXSettingsWindow, XCB_CW_EVENT_MASK, &mask);
  const xcb_atom_t settings = Atom("_XSETTINGS_SETTINGS");
  xcb_get_property_reply_t* reply = xcb_get_property_reply(
      mConnection, xcb_get_property(mConnection, 0, mXSettingsWindow, settings, settings, 0, 16384), nullptr);
  if (!reply) return;
  const SettingsReader reader(static_cast<const std::uint8_t*>(xcb_get_property_value(reply)),
                              static_cast<std::size_t>(xcb_get_property_value_length(reply)));
  std::uint32_t value = 0;
  if (reader.FindInteger("Net/DoubleClickTime", value) && value > 0 && value < 5000) mDoubleClickTime = value;
  std::free(reply);
}

bool OS_NativeLayer_X11::TranslateSettingsEvent(const xcb_generic_event_t* inEvent) {
  const std::uint8_t type = inEvent->response_type & 0x7F;
  if (type == XCB_PROPERTY_NOTIFY) {
    const auto* property = reinterpret_cast<const xcb_property_notify_event_t*>(inEvent);
    if (property->window != mXSettingsWindow || mXSettingsWindow == XCB_WINDOW_NONE) return false;
    if (property->atom == Atom("_XSETTINGS_SETTINGS")) ReadXSettings();
    return true;
  }
  if (type == XCB_DESTROY_NOTIFY) {
    const auto* destroyed = reinterpret_cast<const xcb_destroy_notify_event_t*>(inEvent);
    if (destroyed->window != mXSettingsWindow || mXSettingsWindow == XCB_WINDOW_NONE) return false;
    ReadXSettings();  // the daemon is gone, or another took over
    return true;
  }
  if (type == XCB_CLIENT_MESSAGE) {
    const auto* message = reinterpret_cast<const xcb_client_message_event_t*>(inEvent);
    if (message->window != mScreen->root || message->type != Atom("MANAGER") ||
        message->data.data32[1] != Atom("_XSETTINGS_S0"))
      return false;
    ReadXSettings();
    return true;
  }
  return false;
}

}  // namespace norvik::ui::x11
