#pragma once
// Doubles for focus and timer tests: a window stand-in at the root of a tree,
// views that want focus (or not), containers that keep Tab inside, and a
// native focus platform whose windows are described by a table.
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "ui/OS_FocusPlatform.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_NodeTimerManager.h"
#include "ui/UI_SubView.h"

namespace norvik::ui::test {

// One focus notification as seen by a FocusLog.
struct FocusEvent {
  std::string node;
  FocusChangeReason reason;
  bool hasFocus;
  bool operator==(const FocusEvent& o) const {
    return node == o.node && reason == o.reason && hasFocus == o.hasFocus;
  }
};

using FocusLog = std::vector<FocusEvent>;

// Tells a FocusLog of every UI_FocusChanged it receives.
template <class Base>
class FocusLogging : public Base {
 public:
  void SetFocusLog(FocusLog* inLog) { mLog = inLog; }
  void UI_FocusChanged(FocusChangeReason inReason) override {
    if (mLog) mLog->push_back({this->UI_GetNodeID().c_str(), inReason, this->mHasKeyboardFocus});
    Base::UI_FocusChanged(inReason);
  }

 private:
  FocusLog* mLog = nullptr;
};

// The root of a test tree, standing where a native window stands: it ends
// the visibility walk, owns the timer manager, and counts native focus calls.
class TestWindowNode : public FocusLogging<UI_SubView> {
 public:
  TestWindowNode() : mTimers(this, [this](UI_Node* n, long id, float s) { return MakeRecord(n, id, s); }) {
    UI_SetNodeID("window");
    UI_SetLocalRectF(RectF(0, 0, 800, 600));
    UI_Show(true);
  }
  // The children's timers end while the timer manager is still there, as in a
  // native window. (Detaching the children here would hand them focus back to
  // this dying node.)
  ~TestWindowNode() override {
    for (auto it = ChildBegin(); it != ChildEnd(); ++it) {
      if ((*it)->UI_IsSubView()) static_cast<UI_SubView*>(it->get())->UI_RemoveSubViewTimers();
    }
  }

  bool UI_AreAllParentsVisible() const override { return UI_IsShown(); }
  UI_NodeTimerManager* UI_GetTimerManager(bool) override { return &mTimers; }
  const UI_NodeTimerManager* UI_GetTimerManager(bool) const override { return &mTimers; }
  void UI_SetKeyboardFocusWithOS() override { ++mOSSetFocusCalls; }
  bool UI_WantsKeyboardFocus() const override { return mWantsFocus; }
  void UI_UpdateNow(unsigned long) override { ++mUpdateNowCalls; }

  UI_NodeTimerManager& Timers() { return mTimers; }
  // Every record the factory made, in order, with its interval.
  const std::vector<std::pair<long, float>>& CreatedTimers() const { return mCreated; }

  int mOSSetFocusCalls = 0;
  int mUpdateNowCalls = 0;
  bool mWantsFocus = true;

 private:
  UI_NodeTimerDataP MakeRecord(UI_Node* inNode, long inID, float inSeconds) {
    mCreated.emplace_back(inID, inSeconds);
    return UI_NodeTimerManager::MakePlainTimerData(inNode, inID, inSeconds);
  }

  std::vector<std::pair<long, float>> mCreated;
  UI_NodeTimerManager mTimers;
};

// A view that takes focus by every route unless told otherwise.
class FocusableView : public FocusLogging<UI_SubView> {
 public:
  bool UI_WantsKeyboardFocus() const override { return mWantsFocus; }
  bool UI_WantsKeyboardFocusFromAdvance() const override { return mWantsFocusFromAdvance; }
  bool AllowFocusToAdvanceFromChildren() const override { return mAllowAdvanceFromChildren; }
  void UI_PrepareForKeyboardFocusFromAdvance(UI_Node* inNode) override {
    ++mPrepareCalls;
    if (mOnPrepare) mOnPrepare();
    FocusLogging<UI_SubView>::UI_PrepareForKeyboardFocusFromAdvance(inNode);
  }

  bool mWantsFocus = true;
  bool mWantsFocusFromAdvance = true;
  bool mAllowAdvanceFromChildren = true;
  int mPrepareCalls = 0;
  std::function<void()> mOnPrepare;  // runs when focus advance offers this view focus
};

using FocusableViewP = boost::intrusive_ptr<FocusableView>;

// Makes a shown view of type T with id inID and appends it to inParent.
template <class T = FocusableView>
boost::intrusive_ptr<T> AddView(UI_Node& inParent, const std::string& inID, FocusLog* inLog = nullptr) {
  boost::intrusive_ptr<T> view(new T);
  view->UI_SetNodeID(inID.c_str());
  view->UI_SetLocalRectF(UI_Node::RectF(0, 0, 20, 20));
  view->UI_Show(true);
  view->SetFocusLog(inLog);
  inParent.ChildPushBack(view);
  return view;
}

// A panel that never takes focus itself.
inline FocusableViewP AddPanel(UI_Node& inParent, const std::string& inID, FocusLog* inLog = nullptr) {
  FocusableViewP panel = AddView(inParent, inID, inLog);
  panel->mWantsFocus = false;
  panel->mWantsFocusFromAdvance = false;
  return panel;
}

// The id of the focus leaf, or "" when there is none.
inline std::string FocusLeafID() {
  const UI_NodeManager* manager = UI_NodeManager::GetConst();
  const UI_Node* leaf = manager ? manager->GetKeyboardFocusLeafNode() : nullptr;
  return leaf ? std::string(leaf->UI_GetNodeID().c_str()) : std::string();
}

// A native window system described by a table of windows.
class TableFocusPlatform : public OS_FocusPlatform {
 public:
  struct Window {
    UI_Node* ours = nullptr;  // the node behind the handle when it is one of ours
    bool child = false;
    OS_WindowHandle parent = 0;
  };

  UI_Node* GetOurWindowNode(OS_WindowHandle inHandle) const override {
    const auto it = mWindows.find(inHandle);
    return it == mWindows.end() ? nullptr : it->second.ours;
  }
  bool IsChildWindow(OS_WindowHandle inHandle) const override {
    const auto it = mWindows.find(inHandle);
    return it != mWindows.end() && it->second.child;
  }
  OS_WindowHandle GetParentWindow(OS_WindowHandle inHandle) const override {
    const auto it = mWindows.find(inHandle);
    return it == mWindows.end() ? 0 : it->second.parent;
  }
  void RemovePendingKeyMessages() override { ++mKeyRemovals; }

  std::map<OS_WindowHandle, Window> mWindows;
  int mKeyRemovals = 0;
};

}  // namespace norvik::ui::test
