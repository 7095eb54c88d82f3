#pragma once
// Doubles for node-tree tests: a view that records what the tree tells it,
// and a fixture that owns the process-wide manager.
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "ui/OS_NodeManager.h"
#include "ui/UI_SubView.h"
#include "ui/UI_ToolTipManager.h"

namespace norvik::ui::test {

// A view that records invalidations, node changes and disable changes, and
// can be told to want keyboard focus.
class RecordingView : public UI_SubView {
 public:
  struct Invalidation {
    bool whole;
    RectL rect;
    unsigned long flags;
  };

  explicit RecordingView(const char* inName = "view") { UI_SetNodeID(inName); }

  void UI_Invalidate(const RectL* inRect, unsigned long inFlags) override {
    invalidations.push_back({inRect == nullptr, inRect ? *inRect : RectL(), inFlags});
    UI_SubView::UI_Invalidate(inRect, inFlags);
  }
  void UI_NodeChanged(NodeChange inChange) override {
    nodeChanges.push_back(inChange);
    if (onNodeChanged) onNodeChanged(inChange);
  }
  void UI_DisabledStateChanged() override {
    ++disabledChanges;
    UI_SubView::UI_DisabledStateChanged();
  }
  bool UI_WantsKeyboardFocus() const override { return wantsFocus; }
  bool UI_DisplaysToolTipForChild(const UI_Node*) const override { return displaysTipsForChildren; }

  std::vector<Invalidation> invalidations;
  std::vector<NodeChange> nodeChanges;
  int disabledChanges = 0;
  bool wantsFocus = false;
  bool displaysTipsForChildren = false;
  std::function<void(NodeChange)> onNodeChanged;
};

using RecordingViewP = boost::intrusive_ptr<RecordingView>;

// A shown view with a rectangle, optionally added to a parent.
inline RecordingViewP MakeView(float inX, float inY, float inW, float inH, UI_Node* inParent = nullptr,
                               const char* inName = "view") {
  RecordingViewP v(new RecordingView(inName));
  v->UI_SetLocalRectF(tarsel::geom::RectT<float>(inX, inY, inW, inH));
  v->UI_Show(true);
  if (inParent) inParent->ChildPushBack(v);
  return v;
}

// A tool tip manager that records each tip it was asked to show ("show",
// with the node in refreshed) and each dispose.
class RecordingToolTips : public UI_ToolTipManager {
 public:
  UI_Node* GetToolTipNode() const override { return shown; }
  void RefreshToolTip(UI_Node* inNode) override {
    shown = inNode;
    refreshed.push_back(inNode);
    calls.push_back("show");
  }
  void DisposeToolTip() override {
    shown = nullptr;
    calls.push_back("dispose");
  }
  // Installs a new one in inManager, which owns it.
  static RecordingToolTips* InstallIn(UI_NodeManager& inManager) {
    auto tips = std::make_unique<RecordingToolTips>();
    RecordingToolTips* raw = tips.get();
    inManager.SetToolTipManager(std::move(tips));
    return raw;
  }
  UI_Node* shown = nullptr;
  std::vector<UI_Node*> refreshed;
  std::vector<std::string> calls;
};

// Owns the manager for the length of one test.
class ManagerTest : public ::testing::Test {
 protected:
  OS_NodeManager manager;
};

}  // namespace norvik::ui::test
