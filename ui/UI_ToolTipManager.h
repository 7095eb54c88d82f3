#pragma once
// The seam through which the node tree talks to the tool tip display. The
// manager holds one when the platform provides it; without one no tip shows.
namespace norvik::ui {

class UI_Node;

class UI_ToolTipManager {
 public:
  virtual ~UI_ToolTipManager() = default;

  // The node whose tip is on screen, or null.
  virtual UI_Node* GetToolTipNode() const = 0;
  // Shows inNode's current text again; disposes the tip when it cannot be shown.
  virtual void RefreshToolTip(UI_Node* inNode) = 0;
  virtual void DisposeToolTip() = 0;
  // Seconds a node's own tip waits after the mouse arrives on it.
  virtual float GetDisplayDelay() const { return 0.75f; }
};

}  // namespace norvik::ui
