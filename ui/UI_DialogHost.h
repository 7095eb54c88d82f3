#pragma once
// The mark of a node that hosts a dialog's content: the view container of a
// dialog window, or the same container embedded in another view. Controls ask
// for it rather than for a dialog class, so that a focused button inside any
// dialog can draw as that dialog's default button.
namespace norvik::ui {

class UI_Node;

class UI_DialogHost {
 public:
  virtual ~UI_DialogHost() = default;

  // The nearest ancestor of inNode that hosts a dialog, or null.
  static const UI_DialogHost* FindFor(const UI_Node* inNode);
};

}  // namespace norvik::ui
