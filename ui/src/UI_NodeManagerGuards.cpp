// The scoped guards of UI_NodeManager. The movable ones hand their duty over
// to the new object: the moved-from guard ends nothing.
#include <utility>

#include "ui/UI_NodeManager.h"

namespace norvik::ui {

UI_NodeManager::SuspendOSFocusUpdates::SuspendOSFocusUpdates(UI_NodeManager* inManager) : mManager(inManager) {
  if (mManager) ++mManager->mSuspendOSFocus;
}
UI_NodeManager::SuspendOSFocusUpdates::SuspendOSFocusUpdates(SuspendOSFocusUpdates&& ioOther) noexcept
    : mManager(std::exchange(ioOther.mManager, nullptr)) {}
UI_NodeManager::SuspendOSFocusUpdates& UI_NodeManager::SuspendOSFocusUpdates::operator=(
    SuspendOSFocusUpdates&& ioOther) noexcept {
  if (this != &ioOther) {
    if (mManager) --mManager->mSuspendOSFocus;
    mManager = std::exchange(ioOther.mManager, nullptr);
  }
  return *this;
}
UI_NodeManager::SuspendOSFocusUpdates::~SuspendOSFocusUpdates() {
  if (mManager) --mManager->mSuspendOSFocus;
}

UI_NodeManager::SuspendMouseOverUpdates::SuspendMouseOverUpdates(UI_NodeManager* inManager)
    : mManager(inManager) {
  if (mManager) ++mManager->mSuspendMouseOver;
}
UI_NodeManager::SuspendMouseOverUpdates::SuspendMouseOverUpdates(SuspendMouseOverUpdates&& ioOther) noexcept
    : mManager(std::exchange(ioOther.mManager, nullptr)) {}
UI_NodeManager::SuspendMouseOverUpdates& UI_NodeManager::SuspendMouseOverUpdates::operator=(
    SuspendMouseOverUpdates&& ioOther) noexcept {
  if (this != &ioOther) {
    if (mManager) --mManager->mSuspendMouseOver;
    mManager = std::exchange(ioOther.mManager, nullptr);
  }
  return *this;
}
UI_NodeManager::SuspendMouseOverUpdates::~SuspendMouseOverUpdates() {
  if (mManager) --mManager->mSuspendMouseOver;
}

UI_NodeManager::SuspendOSMouseActivates::SuspendOSMouseActivates(UI_NodeManager* inManager,
                                                                 PlatformWindow inWindow)
    : mManager(inManager) {
  if (mManager) mManager->mOSMouseActivateSuspends.push_back(inWindow);
}
UI_NodeManager::SuspendOSMouseActivates::SuspendOSMouseActivates(SuspendOSMouseActivates&& ioOther) noexcept
    : mManager(std::exchange(ioOther.mManager, nullptr)) {}
UI_NodeManager::SuspendOSMouseActivates& UI_NodeManager::SuspendOSMouseActivates::operator=(
    SuspendOSMouseActivates&& ioOther) noexcept {
  if (this != &ioOther) {
    if (mManager && !mManager->mOSMouseActivateSuspends.empty()) mManager->mOSMouseActivateSuspends.pop_back();
    mManager = std::exchange(ioOther.mManager, nullptr);
  }
  return *this;
}
UI_NodeManager::SuspendOSMouseActivates::~SuspendOSMouseActivates() {
  if (mManager && !mManager->mOSMouseActivateSuspends.empty()) mManager->mOSMouseActivateSuspends.pop_back();
}

UI_NodeManager::SetModalWindow::SetModalWindow(UI_NodeManager* inManager, UI_Node* inWindow)
    : mManager(inManager), mWindow(inWindow) {
  if (mManager) mManager->PushModalWindow(mWindow);
}
UI_NodeManager::SetModalWindow::SetModalWindow(SetModalWindow&& ioOther) noexcept
    : mManager(std::exchange(ioOther.mManager, nullptr)), mWindow(ioOther.mWindow) {}
UI_NodeManager::SetModalWindow& UI_NodeManager::SetModalWindow::operator=(SetModalWindow&& ioOther) noexcept {
  if (this != &ioOther) {
    if (mManager) mManager->PopModalWindow(mWindow);
    mManager = std::exchange(ioOther.mManager, nullptr);
    mWindow = ioOther.mWindow;
  }
  return *this;
}
UI_NodeManager::SetModalWindow::~SetModalWindow() {
  if (mManager) mManager->PopModalWindow(mWindow);
}

UI_NodeManager::NotifyUserResizing::NotifyUserResizing(UI_NodeManager* inManager, UI_Node* inWindow)
    : mManager(inManager), mWindow(inWindow) {
  if (mManager) mManager->BeginUserResizing(mWindow, false);
}
UI_NodeManager::NotifyUserResizing::~NotifyUserResizing() {
  if (mManager) mManager->EndUserResizing(mWindow, false);
}

UI_NodeManager::AddAndRemoveMouseEventFilterNode::AddAndRemoveMouseEventFilterNode(UI_NodeManager* inManager,
                                                                                   UI_Node* inNode)
    : mManager(inManager), mNode(inNode) {
  if (mManager) mManager->AddMouseEventFilterNode(mNode);
}
UI_NodeManager::AddAndRemoveMouseEventFilterNode::~AddAndRemoveMouseEventFilterNode() {
  if (mManager) mManager->RemoveMouseEventFilterNode(mNode);
}

UI_NodeManager::AddAndRemoveKeyboardEventFilterNode::AddAndRemoveKeyboardEventFilterNode(
    UI_NodeManager* inManager, UI_Node* inNode)
    : mManager(inManager), mNode(inNode) {
  if (mManager) mManager->AddKeyboardEventFilterNode(mNode);
}
UI_NodeManager::AddAndRemoveKeyboardEventFilterNode::~AddAndRemoveKeyboardEventFilterNode() {
  if (mManager) mManager->RemoveKeyboardEventFilterNode(mNode);
}

}  // namespace norvik::ui
