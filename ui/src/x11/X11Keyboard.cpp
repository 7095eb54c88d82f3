// The keyboard through xkbcommon-x11: the keymap of the core keyboard, key
// events turned into key and character messages (with compose sequences and
// dead keys), the held and toggled state of keys, and the layout answers.
// xcb/xkb.h names a field "explicit", a C++ keyword.
#define explicit explicit_
#include <xcb/xkb.h>
#undef explicit
#include <xkbcommon/xkbcommon-keysyms.h>
#include <xkbcommon/xkbcommon-x11.h>

#include <clocale>
#include <cstdlib>
#include <cstring>
#include <string>

#include "ui/src/x11/OS_NativeLayer_X11.h"
#include "ui/src/x11/X11Keyboard.h"

namespace norvik::ui::x11 {
namespace {

constexpr std::uint8_t kHeld = 0x80;
constexpr std::uint8_t kToggled = 0x01;

struct KeysymEntry {
  xkb_keysym_t keysym;
  int code;
  bool extended;
};

const KeysymEntry kKeysyms[] = {
    {XKB_KEY_BackSpace, 8, false}, {XKB_KEY_Tab, 9, false}, {XKB_KEY_ISO_Left_Tab, 9, false},
    {XKB_KEY_Return, 13, false}, {XKB_KEY_KP_Enter, 13, true}, {XKB_KEY_Shift_L, 16, false},
    {XKB_KEY_Shift_R, 16, false}, {XKB_KEY_Control_L, 17, false}, {XKB_KEY_Control_R, 17, true},
    {XKB_KEY_Alt_L, 18, false}, {XKB_KEY_Alt_R, 18, true}, {XKB_KEY_ISO_Level3_Shift, 18, true},
    {XKB_KEY_Meta_L, 18, false}, {XKB_KEY_Pause, 19, false}, {XKB_KEY_Caps_Lock, 20, false},
    {XKB_KEY_Escape, 27, false}, {XKB_KEY_space, 32, false}, {XKB_KEY_Prior, 33, true},
    {XKB_KEY_Next, 34, true}, {XKB_KEY_End, 35, true}, {XKB_KEY_Home, 36, true}, {XKB_KEY_Left, 37, true},
    {XKB_KEY_Up, 38, true}, {XKB_KEY_Right, 39, true}, {XKB_KEY_Down, 40, true}, {XKB_KEY_Print, 44, true},
    {XKB_KEY_Insert, 45, true}, {XKB_KEY_Delete, 46, true}, {XKB_KEY_Help, 47, false},
    {XKB_KEY_Super_L, 91, true}, {XKB_KEY_Super_R, 92, true}, {XKB_KEY_Menu, 93, true},
    {XKB_KEY_KP_Prior, 33, false}, {XKB_KEY_KP_Next, 34, false}, {XKB_KEY_KP_End, 35, false},
    {XKB_KEY_KP_Home, 36, false}, {XKB_KEY_KP_Left, 37, false}, {XKB_KEY_KP_Up, 38, false},
    {XKB_KEY_KP_Right, 39, false}, {XKB_KEY_KP_Down, 40, false}, {XKB_KEY_KP_Insert, 45, false},
    {XKB_KEY_KP_Delete, 46, false}, {XKB_KEY_KP_Begin, 12, false}, {XKB_KEY_KP_Multiply, 106, false},
    {XKB_KEY_KP_Add, 107, false}, {XKB_KEY_KP_Subtract, 109, false}, {XKB_KEY_KP_Decimal, 110, false},
    {XKB_KEY_KP_Separator, 110, false}, {XKB_KEY_KP_Divide, 111, true}, {XKB_KEY_Num_Lock, 144, true},
    {XKB_KEY_Scroll_Lock, 145, false}, {XKB_KEY_semicolon, 186, false}, {XKB_KEY_colon, 186, false},
    {XKB_KEY_equal, 187, false}, {XKB_KEY_plus, 187, false}, {XKB_KEY_comma, 188, false},
    {XKB_KEY_less, 188, false}, {XKB_KEY_minus, 189, false}, {XKB_KEY_underscore, 189, false},
    {XKB_KEY_period, 190, false}, {XKB_KEY_greater, 190, false}, {XKB_KEY_slash, 191, false},
    {XKB_KEY_question, 191, false}, {XKB_KEY_grave, 192, false}, {XKB_KEY_asciitilde, 192, false},
    {XKB_KEY_bracketleft, 219, false}, {XKB_KEY_braceleft, 219, false}, {XKB_KEY_backslash, 220, false},
    {XKB_KEY_bar, 220, false}, {XKB_KEY_bracketright, 221, false}, {XKB_KEY_braceright, 221, false},
    {XKB_KEY_apostrophe, 222, false}, {XKB_KEY_quotedbl, 222, false},
};

// Language identifiers of common layouts, by the layout's xkb name.
struct LayoutLanguage {
  const char* prefix;
  unsigned language;
  unsigned codePage;
};
const LayoutLanguage kLayouts[] = {
    {"English (UK)", 2057, 1252}, {"English", 1033, 1252}, {"German", 1031, 1252}, {"French", 1036, 1252},
    {"Spanish", 1034, 1252},      {"Italian", 1040, 1252}, {"Portuguese", 2070, 1252}, {"Dutch", 1043, 1252},
    {"Swedish", 1053, 1252},      {"Norwegian", 1044, 1252}, {"Danish", 1030, 1252}, {"Finnish", 1035, 1252},
    {"Polish", 1045, 1250},       {"Czech", 1029, 1250},   {"Hungarian", 1038, 1250}, {"Russian", 1049, 1251},
    {"Ukrainian", 1058, 1251},    {"Greek", 1032, 1253},   {"Turkish", 1055, 1254}, {"Hebrew", 1037, 1255},
    {"Arabic", 1025, 1256},       {"Japanese", 1041, 932}, {"Korean", 1042, 949},  {"Chinese", 2052, 936},
};

// Character messages carry UTF-16 units: a character beyond the first plane
// becomes its surrogate pair.
void AppendUtf16(std::u16string& ioText, char32_t inCharacter) {
  if (inCharacter < 0x10000) {
    ioText.push_back(static_cast<char16_t>(inCharacter));
  } else if (inCharacter <= 0x10FFFF) {
    inCharacter -= 0x10000;
    ioText.push_back(static_cast<char16_t>(0xD800 + (inCharacter >> 10)));
    ioText.push_back(static_cast<char16_t>(0xDC00 + (inCharacter & 0x3FF)));
  }
}

}  // namespace

VirtualKey KeysymToVirtualKey(xkb_keysym_t inKeysym) {
  if (inKeysym >= XKB_KEY_a && inKeysym <= XKB_KEY_z) return {static_cast<int>('A' + (inKeysym - XKB_KEY_a)), false};
  if (inKeysym >= XKB_KEY_A && inKeysym <= XKB_KEY_Z) return {static_cast<int>(inKeysym), false};
  if (inKeysym >= XKB_KEY_0 && inKeysym <= XKB_KEY_9) return {static_cast<int>(inKeysym), false};
  if (inKeysym >= XKB_KEY_KP_0 && inKeysym <= XKB_KEY_KP_9) return {static_cast<int>(96 + (inKeysym - XKB_KEY_KP_0)), false};
  if (inKeysym >= XKB_KEY_F1 && inKeysym <= XKB_KEY_F24) return {static_cast<int>(112 + (inKeysym - XKB_KEY_F1)), false};
  for (const KeysymEntry& e : kKeysyms)
    if (e.keysym == inKeysym) return {e.code, e.extended};
  return {};
}

void OS_NativeLayer_X11::SetUpKeyboard() {
  mXkbContext = xkb_context_new(XKB_CONTEXT_NO_FLAGS);
  std::uint8_t firstEvent = 0;
  if (!mXkbContext ||
      !xkb_x11_setup_xkb_extension(mConnection, XKB_X11_MIN_MAJOR_XKB_VERSION, XKB_X11_MIN_MINOR_XKB_VERSION,
                                   XKB_X11_SETUP_XKB_EXTENSION_NO_FLAGS, nullptr, nullptr, &firstEvent, nullptr))
    return;
  mXkbEventBase = firstEvent;
  mKeyboardDevice = xkb_x11_get_core_keyboard_device_id(mConnection);
  // Autorepeat as repeated presses without releases, so a held key is seen as held.
  xcb_xkb_per_client_flags(mConnection, XCB_XKB_ID_USE_CORE_KBD, XCB_XKB_PER_CLIENT_FLAG_DETECTABLE_AUTO_REPEAT,
                           XCB_XKB_PER_CLIENT_FLAG_DETECTABLE_AUTO_REPEAT, 0, 0, 0);
  // State changes too: the desktop switches layouts by locking another group,
  // and the active layout must be known before the next key arrives.
  const std::uint16_t events =
      XCB_XKB_EVENT_TYPE_NEW_KEYBOARD_NOTIFY | XCB_XKB_EVENT_TYPE_MAP_NOTIFY | XCB_XKB_EVENT_TYPE_STATE_NOTIFY;
  xcb_xkb_select_events(mConnection, static_cast<xcb_xkb_device_spec_t>(mKeyboardDevice), events, 0, events, 0xFF,
                        0xFF, nullptr);
  LoadKeymap();
  const char* locale = std::getenv("LC_ALL");
  if (!locale || !*locale) locale = std::getenv("LC_CTYPE");
  if (!locale || !*locale) locale = std::getenv("LANG");
  if (!locale || !*locale) locale = "C";
  mComposeTable = xkb_compose_table_new_from_locale(mXkbContext, locale, XKB_COMPOSE_COMPILE_NO_FLAGS);
  if (!mComposeTable) mComposeTable = xkb_compose_table_new_from_locale(mXkbContext, "en_US.UTF-8", XKB_COMPOSE_COMPILE_NO_FLAGS);
  if (mComposeTable) mComposeState = xkb_compose_state_new(mComposeTable, XKB_COMPOSE_STATE_NO_FLAGS);
  mLayout = std::make_unique<X11KeyboardLayout>(*this);
}

void OS_NativeLayer_X11::LoadKeymap() {
  if (!mXkbContext || mKeyboardDevice < 0) return;
  xkb_keymap* keymap = xkb_x11_keymap_new_from_device(mXkbContext, mConnection, mKeyboardDevice,
                                                      XKB_KEYMAP_COMPILE_NO_FLAGS);
  if (!keymap) return;
  xkb_state* state = xkb_x11_state_new_from_device(keymap, mConnection, mKeyboardDevice);
  if (!state) {
    xkb_keymap_unref(keymap);
    return;
  }
  if (mXkbState) xkb_state_unref(mXkbState);
  if (mKeymap) xkb_keymap_unref(mKeymap);
  mKeymap = keymap;
  mXkbState = state;
}

const KeyboardLayoutInterface* OS_NativeLayer_X11::GetKeyboardLayout() const { return mLayout.get(); }

void OS_NativeLayer_X11::TranslateXkbEvent(const xcb_generic_event_t* inEvent) {
  // The second byte of every XKB event tells which one it is.
  const std::uint8_t xkbType = inEvent->pad0;
  if (xkbType != XCB_XKB_STATE_NOTIFY) {
    LoadKeymap();
    return;
  }
  const auto* state = reinterpret_cast<const xcb_xkb_state_notify_event_t*>(inEvent);
  if (mXkbState && state->deviceID == mKeyboardDevice)
    xkb_state_update_mask(mXkbState, state->baseMods, state->latchedMods, state->lockedMods,
                          static_cast<xkb_layout_index_t>(state->baseGroup),
                          static_cast<xkb_layout_index_t>(state->latchedGroup),
                          static_cast<xkb_layout_index_t>(state->lockedGroup));
}

// Key messages carry the X keycode less 8 as their scan code (the kernel's key
// number, which matches the hardware set-1 code on the main block). The key's
// virtual key is that of its first-level symbol in the layout now in force, so
// that a character typed with Ctrl reports the letter the layout puts there.
int OS_NativeLayer_X11::ScanCodeToVirtualKey(unsigned inScanCode) const {
  if (!mKeymap) return OS_NativeLayer::ScanCodeToVirtualKey(inScanCode);
  if (inScanCode > 0xFFFF) return 0;
  const xkb_keycode_t keycode = static_cast<xkb_keycode_t>(inScanCode) + 8;
  if (keycode < xkb_keymap_min_keycode(mKeymap) || keycode > xkb_keymap_max_keycode(mKeymap)) return 0;
  const xkb_layout_index_t layout = ActiveLayoutIndex();
  const xkb_keysym_t* syms = nullptr;
  if (xkb_keymap_key_get_syms_by_level(mKeymap, keycode, layout, 0, &syms) < 1) return 0;
  const int code = KeysymToVirtualKey(syms[0]).code;
  return code != 0 ? code : OS_NativeLayer::ScanCodeToVirtualKey(inScanCode);
}

short OS_NativeLayer_X11::GetKeyState(int inVirtualKey) const {
  if (inVirtualKey < 0 || inVirtualKey > 255) return 0;
  const std::uint8_t s = mMessageKeyStates[static_cast<std::size_t>(inVirtualKey)];
  return static_cast<short>(((s & kHeld) ? 0x8000 : 0) | ((s & kToggled) ? 1 : 0));
}

short OS_NativeLayer_X11::GetAsyncKeyState(int inVirtualKey) const {
  if (inVirtualKey < 0 || inVirtualKey > 255) return 0;
  const std::uint8_t s = mKeyStates[static_cast<std::size_t>(inVirtualKey)];
  return static_cast<short>(((s & kHeld) ? 0x8000 : 0) | ((s & kToggled) ? 1 : 0));
}

void OS_NativeLayer_X11::QueueCharacters(OS_WindowHandle inTarget, const std::u32string& inText, bool inSystem,
                                         std::intptr_t inLParam) {
  std::u16string units;
  for (char32_t c : inText) AppendUtf16(units, c);
  for (char16_t unit : units) Queue(inTarget, inSystem ? kOSMsgSysChar : kOSMsgChar, unit, inLParam, true);
}

void OS_NativeLayer_X11::TranslateKey(const xcb_key_press_event_t* inEvent, bool inPress) {
  if (!mXkbState || !mKeymap) return;
  const xkb_keycode_t keycode = inEvent->detail;
  const std::uint16_t mods = inEvent->state;
  // The state of this event: modifiers and group as X reports them with it.
  const xkb_layout_index_t group = (mods >> 13) & 3;
  xkb_state_update_mask(mXkbState, mods & 0xFF, 0, 0, 0, 0, group);
  const xkb_keysym_t effective = xkb_state_key_get_one_sym(mXkbState, keycode);
  const xkb_keysym_t* plain = nullptr;
  const int plainCount = xkb_keymap_key_get_syms_by_level(mKeymap, keycode, group, 0, &plain);
  const bool keypad = effective >= XKB_KEY_KP_Space && effective <= XKB_KEY_KP_9;
  VirtualKey vk = KeysymToVirtualKey(keypad || plainCount < 1 ? effective : plain[0]);
  if (vk.code == 0) vk = KeysymToVirtualKey(effective);
  // Dead keys and letters beyond ASCII (é on a French keyboard) have no key of
  // their own: they take the key at the same place on a US keyboard.
  if (vk.code == 0) vk.code = OS_NativeLayer::ScanCodeToVirtualKey(keycode - 8);

  const bool alt = (mods & XCB_MOD_MASK_1) != 0;
  const bool ctrl = (mods & XCB_MOD_MASK_CONTROL) != 0;
  const std::size_t index = static_cast<std::size_t>(vk.code);
  const bool wasHeld = vk.code != 0 && (mKeyStates[index] & kHeld);
  if (vk.code != 0) {
    mKeyStates[index] = static_cast<std::uint8_t>(inPress ? (mKeyStates[index] | kHeld) : (mKeyStates[index] & ~kHeld));
    int side = 0;
    if (effective == XKB_KEY_Shift_L) side = 160;
    if (effective == XKB_KEY_Shift_R) side = 161;
    if (effective == XKB_KEY_Control_L) side = 162;
    if (effective == XKB_KEY_Control_R) side = 163;
    if (effective == XKB_KEY_Alt_L || effective == XKB_KEY_Meta_L) side = 164;
    if (effective == XKB_KEY_Alt_R || effective == XKB_KEY_ISO_Level3_Shift) side = 165;
    if (side) mKeyStates[static_cast<std::size_t>(side)] = inPress ? kHeld : 0;
  }
  // Toggles as the server reports them (after this key, for the lock keys themselves).
  auto setToggle = [&](int key, bool on) {
    std::uint8_t& s = mKeyStates[static_cast<std::size_t>(key)];
    s = static_cast<std::uint8_t>(on ? (s | kToggled) : (s & ~kToggled));
  };
  const bool capsOn = (mods & XCB_MOD_MASK_LOCK) != 0;
  const bool numOn = (mods & XCB_MOD_MASK_2) != 0;
  setToggle(20, (vk.code == 20 && inPress) ? !capsOn : capsOn);
  setToggle(144, (vk.code == 144 && inPress) ? !numOn : numOn);
  if (vk.code == 0) return;

  const OS_WindowHandle target = mFocus ? mFocus : (mActive ? mActive : TopLevelOf(inEvent->event));
  if (!Find(target)) return;
  const bool system = alt && !ctrl;
  std::intptr_t lParam = 1 | (static_cast<std::intptr_t>((keycode - 8) & 0xFF) << 16);
  if (vk.extended) lParam |= std::intptr_t(1) << 24;
  if (alt) lParam |= std::intptr_t(1) << 29;
  if (inPress ? wasHeld : true) lParam |= std::intptr_t(1) << 30;
  if (!inPress) lParam |= std::intptr_t(1) << 31;
  const unsigned message = inPress ? (system ? kOSMsgSysKeyDown : kOSMsgKeyDown) : (system ? kOSMsgSysKeyUp : kOSMsgKeyUp);
  Queue(target, message, static_cast<std::uintptr_t>(vk.code), lParam, true);
  if (!inPress || effective == XKB_KEY_Delete || effective == XKB_KEY_KP_Delete) return;

  // Characters: a compose sequence in progress swallows the key; a finished one
  // gives its text; otherwise the key's own character.
  std::u32string text;
  if (mComposeState && xkb_compose_state_feed(mComposeState, effective) == XKB_COMPOSE_FEED_ACCEPTED) {
    switch (xkb_compose_state_get_status(mComposeState)) {
      case XKB_COMPOSE_COMPOSING:
        return;
      case XKB_COMPOSE_COMPOSED: {
        char utf8[64];
        xkb_compose_state_get_utf8(mComposeState, utf8, sizeof(utf8));
        xkb_compose_state_reset(mComposeState);
        UTF16String composed = tarsel::utility::UTF8to16(utf8);
        std::u16string units(composed.begin(), composed.end());
        for (char16_t unit : units) Queue(target, system ? kOSMsgSysChar : kOSMsgChar, unit, lParam, true);
        return;
      }
      case XKB_COMPOSE_CANCELLED:
        xkb_compose_state_reset(mComposeState);
        return;
      case XKB_COMPOSE_NOTHING:
        break;
    }
  }
  const std::uint32_t character = xkb_state_key_get_utf32(mXkbState, keycode);
  if (character != 0) {
    text.push_back(static_cast<char32_t>(character));
    QueueCharacters(target, text, system, lParam);
  }
}

xkb_layout_index_t OS_NativeLayer_X11::ActiveLayoutIndex() const {
  return mXkbState ? xkb_state_serialize_layout(mXkbState, XKB_STATE_LAYOUT_EFFECTIVE) : 0;
}

// ---- layout answers: those of the layout in force ----

unsigned X11KeyboardLayout::GetActiveLayout() const {
  if (!mLayer.mKeymap) return kKeyboardLayoutUSEnglish;
  const char* name = xkb_keymap_layout_get_name(mLayer.mKeymap, mLayer.ActiveLayoutIndex());
  if (!name) return kKeyboardLayoutUSEnglish;
  for (const LayoutLanguage& l : kLayouts)
    if (std::strncmp(name, l.prefix, std::strlen(l.prefix)) == 0) return l.language;
  return kKeyboardLayoutUSEnglish;
}

unsigned X11KeyboardLayout::GetCodePage(unsigned inLayout) const {
  for (const LayoutLanguage& l : kLayouts)
    if (l.language == inLayout) return l.codePage;
  return kCodePageWesternEuropean;
}

unsigned short X11KeyboardLayout::KeyToCharacter(unsigned, short inKey) const {
  xkb_keymap* keymap = mLayer.mKeymap;
  if (!keymap || inKey <= 0) return 0;
  const xkb_layout_index_t layout = mLayer.ActiveLayoutIndex();
  for (xkb_keycode_t k = xkb_keymap_min_keycode(keymap); k <= xkb_keymap_max_keycode(keymap); ++k) {
    const xkb_keysym_t* syms = nullptr;
    if (xkb_keymap_key_get_syms_by_level(keymap, k, layout, 0, &syms) < 1) continue;
    if (KeysymToVirtualKey(syms[0]).code != inKey) continue;
    const std::uint32_t c = xkb_keysym_to_utf32(syms[0]);
    if (c == 0 || c > 0xFFFF) return 0;
    // Letters answer in capitals, as the key is labelled.
    return static_cast<unsigned short>(c >= 'a' && c <= 'z' ? c - 'a' + 'A' : c);
  }
  return 0;
}

short X11KeyboardLayout::CharacterToKey(unsigned, unsigned short inCharacter) const {
  xkb_keymap* keymap = mLayer.mKeymap;
  if (!keymap || inCharacter == 0) return 0;
  const xkb_layout_index_t layout = mLayer.ActiveLayoutIndex();
  for (xkb_keycode_t k = xkb_keymap_min_keycode(keymap); k <= xkb_keymap_max_keycode(keymap); ++k) {
    for (xkb_level_index_t level = 0; level < 2; ++level) {
      const xkb_keysym_t* syms = nullptr;
      if (xkb_keymap_key_get_syms_by_level(keymap, k, layout, level, &syms) < 1) continue;
      const std::uint32_t c = xkb_keysym_to_utf32(syms[0]);
      if (c == inCharacter || (c >= 'a' && c <= 'z' && c - 'a' + 'A' == inCharacter)) {
        const xkb_keysym_t* base = nullptr;
        if (xkb_keymap_key_get_syms_by_level(keymap, k, layout, 0, &base) < 1) continue;
        const int code = KeysymToVirtualKey(base[0]).code;
        if (code != 0) return static_cast<short>(code);
      }
    }
  }
  return 0;
}

}  // namespace norvik::ui::x11
