#pragma once
// Test doubles of the input seams: a platform whose modifier state a test
// sets, whose native queue it fills and which counts default cursors, and a keyboard layout built from a
// table. Each installs itself for its lifetime and uninstalls on destruction.
#include <map>
#include <utility>
#include <vector>

#include "ui/InputPlatform.h"
#include "ui/KeyboardLayout.h"

namespace norvik::ui::test {

class FakeInputPlatform : public InputPlatformInterface {
 public:
  FakeInputPlatform();
  ~FakeInputPlatform() override;
  FakeInputPlatform(const FakeInputPlatform&) = delete;
  FakeInputPlatform& operator=(const FakeInputPlatform&) = delete;

  ModifierKeys GetRecentEventModKeys() const override { return mRecentModKeys; }
  ModifierKeys GetCurrentModKeys() const override { return mCurrentModKeys; }
  bool RemovePendingMessage(OS_WindowHandle inWindow, unsigned inMessage) override;
  void SetDefaultCursor() override { ++mDefaultCursorCount; }

  void PostMessage(OS_WindowHandle inWindow, unsigned inMessage) { mQueue.emplace_back(inWindow, inMessage); }
  const std::vector<std::pair<OS_WindowHandle, unsigned>>& GetQueue() const { return mQueue; }

  ModifierKeys mRecentModKeys;
  ModifierKeys mCurrentModKeys;
  int mDefaultCursorCount = 0;

 private:
  std::vector<std::pair<OS_WindowHandle, unsigned>> mQueue;
};

class FakeKeyboardLayout : public KeyboardLayoutInterface {
 public:
  FakeKeyboardLayout(unsigned inLayout, unsigned inCodePage);
  ~FakeKeyboardLayout() override;
  FakeKeyboardLayout(const FakeKeyboardLayout&) = delete;
  FakeKeyboardLayout& operator=(const FakeKeyboardLayout&) = delete;

  // inKey types inCharacter (unshifted) in this layout.
  void AddKey(short inKey, unsigned short inCharacter);

  unsigned GetActiveLayout() const override { return mLayout; }
  unsigned GetCodePage(unsigned inLayout) const override;
  unsigned short KeyToCharacter(unsigned inLayout, short inKey) const override;
  short CharacterToKey(unsigned inLayout, unsigned short inCharacter) const override;

  // Which layouts were asked about, in order.
  mutable std::vector<unsigned> mLayoutsAsked;

 private:
  unsigned mLayout;
  unsigned mCodePage;
  std::map<short, unsigned short> mKeys;
  USKeyboardLayout mUS;
};

}  // namespace norvik::ui::test
