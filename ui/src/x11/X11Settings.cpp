// XSETTINGS: the desktop's settings daemon, when one runs, owns the selection
// _XSETTINGS_S<screen> and keeps its settings in the property
// _XSETTINGS_SETTINGS of the owner window. The layer reads the double-click
// time and distance and the mnemonics preference from it, follows changes of
// the property, picks up a daemon that starts later (its MANAGER announcement
// on the root window), and goes back to the defaults when the daemon goes
// away. A change reaches the toolkit as a setting-change message to every top
// level, which reloads the OS preferences.
#include <cstdlib>
#include <cstring>
#include <string>

#include "tarsel/ErrorManager.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"
#include "ui/src/x11/XSettingsData.h"

namespace norvik::ui::x11 {
namespace {

constexpr unsigned kDefaultDoubleClickTime = 500;
constexpr int kDefaultDoubleClickSize = 4;

}  // namespace

void OS_NativeLayer_X11::WatchXSettings() {
  // The daemon announces itself to the root window's StructureNotify clients.
  const std::uint32_t rootMask = XCB_EVENT_MASK_STRUCTURE_NOTIFY;
  xcb_change_window_attributes(mConnection, mScreen->root, XCB_CW_EVENT_MASK, &rootMask);
  ReadXSettings(false);
}

void OS_NativeLayer_X11::ReadXSettings(bool inAnnounce) {
  const unsigned oldTime = mDoubleClickTime;
  const OS_Point oldSize = mDoubleClickSize;
  const std::map<std::string, bool> oldPreferences = mPreferences;
  xcb_get_selection_owner_reply_t* owner = xcb_get_selection_owner_reply(
      mConnection, xcb_get_selection_owner(mConnection, Atom("_XSETTINGS_S0")), nullptr);
  mXSettingsWindow = owner ? owner->owner : xcb_window_t(XCB_WINDOW_NONE);
  std::free(owner);
  mDoubleClickTime = kDefaultDoubleClickTime;
  mDoubleClickSize = OS_Point(kDefaultDoubleClickSize, kDefaultDoubleClickSize);
  mPreferences.clear();
  if (mXSettingsWindow != XCB_WINDOW_NONE) {
    const std::uint32_t mask = XCB_EVENT_MASK_PROPERTY_CHANGE | XCB_EVENT_MASK_STRUCTURE_NOTIFY;
    xcb_change_window_attributes(mConnection, mXSettingsWindow, XCB_CW_EVENT_MASK, &mask);
    const xcb_atom_t settings = Atom("_XSETTINGS_SETTINGS");
    xcb_get_property_reply_t* reply = xcb_get_property_reply(
        mConnection, xcb_get_property(mConnection, 0, mXSettingsWindow, settings, settings, 0, 16384), nullptr);
    if (reply)
      ApplyXSettings(static_cast<const std::uint8_t*>(xcb_get_property_value(reply)),
                     static_cast<std::size_t>(xcb_get_property_value_length(reply)));
    std::free(reply);
  }
  if (!inAnnounce || (oldTime == mDoubleClickTime && oldSize == mDoubleClickSize && oldPreferences == mPreferences))
    return;
  for (OS_WindowHandle window : mStacking)
    if (const X11Window* w = Find(window); w && w->ours) PostMessage(window, kOSMsgSettingChange, 0, 0);
}

void OS_NativeLayer_X11::ApplyXSettings(const std::uint8_t* inData, std::size_t inSize) {
  // Another client's bytes: malformed data is reported and leaves the defaults.
  tarsel::config::ErrorManager::Get(true)->GuardedCall([&] {
    const XSettingsData data = XSettingsData::Parse(inData, inSize);
    if (auto time = data.FindInteger("Net/DoubleClickTime"); time && *time > 0 && *time < 5000)
      mDoubleClickTime = static_cast<unsigned>(*time);
    // The distance a second click may stray; the rectangle is twice as wide.
    if (auto distance = data.FindInteger("Net/DoubleClickDistance"); distance && *distance >= 0 && *distance < 100)
      mDoubleClickSize = OS_Point(2 * *distance, 2 * *distance);
    // Mnemonics that show only while Alt is held are the opposite of always on.
    if (auto automatic = data.FindInteger("Gtk/AutoMnemonics"))
      mPreferences["windows.MnemonicsAlwaysOn"] = *automatic == 0;
  });
}

bool OS_NativeLayer_X11::GetPreference(const std::string& inName, bool& outValue) const {
  auto it = mPreferences.find(inName);
  if (it == mPreferences.end()) return false;
  outValue = it->second;
  return true;
}

bool OS_NativeLayer_X11::TranslateSettingsEvent(const xcb_generic_event_t* inEvent) {
  const std::uint8_t type = inEvent->response_type & 0x7F;
  if (type == XCB_PROPERTY_NOTIFY) {
    const auto* property = reinterpret_cast<const xcb_property_notify_event_t*>(inEvent);
    if (property->window != mXSettingsWindow || mXSettingsWindow == XCB_WINDOW_NONE) return false;
    if (property->atom == Atom("_XSETTINGS_SETTINGS")) ReadXSettings(true);
    return true;
  }
  if (type == XCB_DESTROY_NOTIFY) {
    const auto* destroyed = reinterpret_cast<const xcb_destroy_notify_event_t*>(inEvent);
    if (destroyed->window != mXSettingsWindow || mXSettingsWindow == XCB_WINDOW_NONE) return false;
    ReadXSettings(true);  // the daemon is gone, or another took over
    return true;
  }
  if (type == XCB_CLIENT_MESSAGE) {
    const auto* message = reinterpret_cast<const xcb_client_message_event_t*>(inEvent);
    if (message->window != mScreen->root || message->type != Atom("MANAGER") ||
        message->data.data32[1] != Atom("_XSETTINGS_S0"))
      return false;
    ReadXSettings(true);
    return true;
  }
  return false;
}

}  // namespace norvik::ui::x11
