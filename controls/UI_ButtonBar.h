#pragma once
// A row of toggle buttons of which at most one is selected. Each button is
// paired with a number, and the bar's value is the number of the selected
// button, so a host reads one double where it would otherwise listen to
// several buttons.
//
// Layout: the buttons stand side by side from the bar's left edge, all as
// wide as the widest button's recommended width and as high as the highest,
// so the segments look alike whatever their labels; a bar narrower than that
// row shares its width out equally among them instead. The bar paints the
// common frame behind them; each button paints its own face on top.
//
// Keyboard: the bar, not its buttons, is the tab stop. A click on a button
// hands focus to the bar, and the arrow keys then move the selection to the
// previous or next enabled button, without wrapping at either end.
#include <vector>

#include "controls/UI_Button.h"
#include "controls/UI_InteractiveControlView.h"

namespace norvik::controls {

class UI_ButtonBar : public UI_InteractiveControlView {
 public:
  UI_ButtonBar();
  ~UI_ButtonBar() override;

  // Each adds a toggle button paired with inValue at the end of the row and
  // answers its index. The buttons' node identifiers are the bar's, then
  // "_TextButton_" and the index, so scripts can find them by name.
  int AddTextButton(const UTF16String& inText, double inValue, const UTF16String& inToolTip = UTF16String());
  int AddImageButton(const UTF8String& inImageBaseName, double inValue,
                     const UTF16String& inToolTip = UTF16String());

  std::size_t GetButtonCount() const { return mButtons.size(); }
  // The button at inIndex, or null when there is none.
  UI_Button* GetButton(int inIndex) const;
  double GetButtonValue(int inIndex) const;
  // The selected button's index, or -1 when none is selected.
  int GetSelectedIndex() const { return mSelected; }

  // The number of the selected button. Setting it selects the first button
  // paired with that number (none when no button is) and tells nobody.
  double GetValue() const { return mValue; }
  void SetValue(double inValue);
  // Also turns every button off: an unknown bar shows no selection.
  void SetValueUnknown() override;

  // A button's change, as its listener hears it; see the rule in the source.
  void SelectionChanged(UI_ControlChangedMessage* inMessage);
  void UI_SetButtonEnabled(int inIndex, bool inEnabled);

  float GetButtonbarWidth() const;
  float GetButtonbarHeight() const;
  PointF UI_GetRecommendedSize() const override;
  // Places the buttons again, for instance after a label changed.
  void LayoutButtons();

  void UI_SizeChanged(const RectF& inLocalRect) override;
  void ChildRemoved(ui::UI_Node* inChild) override;
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

  // The rectangles of inCount segments of one size side by side from the
  // origin, as the bar places its buttons.
  static std::vector<RectF> LayoutRow(std::size_t inCount, const PointF& inSegmentSize);
  // Paints the frame common to all buttons of a bar in the parameters'
  // rectangle and state, with the shared bevel.
  static void DrawFrame(const DrawButtonParameters& inParams, drawbot::Drawbot& inDrawbot);

 private:
  struct Entry {
    UI_Button* button;
    double value;
  };

  int AddButton(const UI_ButtonP& inButton, double inValue, const UTF16String& inToolTip);
  int IndexOf(const ui::UI_Node* inNode) const;
  PointF SegmentSize() const;
  PointF FittedSegmentSize() const;
  // The enabled, visible button next to the selection in direction inStep,
  // or -1 when the row ends first.
  int NeighbourOfSelection(int inStep) const;
  void DrawBarFrame(drawbot::Drawbot& inDrawbot) const;

  std::vector<Entry> mButtons;
  int mSelected = -1;
  double mValue = 0;
};

using UI_ButtonBarP = boost::intrusive_ptr<UI_ButtonBar>;

}  // namespace norvik::controls
