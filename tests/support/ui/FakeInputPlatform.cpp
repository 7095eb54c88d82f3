#include "support/ui/FakeInputPlatform.h"

#include <algorithm>

namespace norvik::ui::test {

FakeInputPlatform::FakeInputPlatform() { SetInputPlatform(this); }

FakeInputPlatform::~FakeInputPlatform() { SetInputPlatform(nullptr); }

bool FakeInputPlatform::RemovePendingMessage(OS_WindowHandle inWindow, unsigned inMessage) {
  auto it = std::find(mQueue.begin(), mQueue.end(), std::make_pair(inWindow, inMessage));
  if (it == mQueue.end()) return false;
  mQueue.erase(it);
  return true;
}

FakeKeyboardLayout::FakeKeyboardLayout(unsigned inLayout, unsigned inCodePage)
    : mLayout(inLayout), mCodePage(inCodePage) {
  SetKeyboardLayout(this);
}

FakeKeyboardLayout::~FakeKeyboardLayout() { SetKeyboardLayout(nullptr); }

void FakeKeyboardLayout::AddKey(short inKey, unsigned short inCharacter) { mKeys[inKey] = inCharacter; }

unsigned FakeKeyboardLayout::GetCodePage(unsigned inLayout) const {
  return inLayout == mLayout ? mCodePage : mUS.GetCodePage(inLayout);
}

// Layouts other than this one answer as US English, like a system that also
// has the US layout installed.
unsigned short FakeKeyboardLayout::KeyToCharacter(unsigned inLayout, short inKey) const {
  mLayoutsAsked.push_back(inLayout);
  if (inLayout != mLayout) return mUS.KeyToCharacter(inLayout, inKey);
  auto it = mKeys.find(inKey);
  return it != mKeys.end() ? it->second : 0;
}

short FakeKeyboardLayout::CharacterToKey(unsigned inLayout, unsigned short inCharacter) const {
  mLayoutsAsked.push_back(inLayout);
  if (inLayout != mLayout) return mUS.CharacterToKey(inLayout, inCharacter);
  for (const auto& [key, c] : mKeys) {
    if (c == inCharacter) return key;
  }
  return 0;
}

}  // namespace norvik::ui::test
