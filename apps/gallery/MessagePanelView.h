#pragma once
// A message box's content, composed by the layout builder as a dialog would
// be: an icon beside the message and a check box, a row of buttons below
// with a flexible gap that keeps the first button apart. The message wraps
// at the width the panel can give it, so the panel's height follows its
// width; the layout is composed again at each new width.
#include "GalleryViews.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_StaticText.h"
#include "controls/UI_TextButton.h"
#include "layout/SmartLayout.h"

namespace norvik::gallery {

class MessagePanelView : public ui::UI_SubView {
 public:
  MessagePanelView();

  // The panel's size when given at most inWidth.
  PointF GetSizeForWidth(float inWidth);
  controls::UI_StaticText* GetMessage() const { return mMessage.get(); }

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

  static constexpr float kMaxMessageWidth = 340;

 private:
  layout::SmartLayoutP Compose(float inWidth);
  ui::UI_NodeP mIcon;
  controls::UI_StaticTextP mMessage;
  boost::intrusive_ptr<controls::UI_Checkbox> mCheckbox;
  controls::UI_TextButtonP mDontSave, mCancel, mSave;
};

}  // namespace norvik::gallery
