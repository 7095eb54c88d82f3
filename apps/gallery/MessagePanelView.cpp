#include "MessagePanelView.h"

#include <algorithm>
#include <cmath>

#include "layout/SmartLayoutBuilder.h"
#include "layout/UI_TextLayout.h"

namespace norvik::gallery {

namespace {

constexpr float kMargin = 16;
constexpr float kIconSize = 32;
constexpr float kIconGap = 12;
constexpr float kButtonGap = 8;
const layout::PointF kButtonMinimum(72, 22);

// The warning sign beside the message: a round badge with an exclamation.
class MessageIconView : public ui::UI_SubView {
 public:
  MessageIconView() { UI_SetNodeID("message-icon"); }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override {
    const GalleryColors c = CurrentColors();
    const RectF r = UI_GetLocalRectF(false);
    FillRoundRect(inDrawbot, r, r.width / 2, c.accent);
    FillRect(inDrawbot, RectF(r.width / 2 - 2, r.height * 0.22f, 4, r.height * 0.38f), c.panel);
    FillRect(inDrawbot, RectF(r.width / 2 - 2, r.height * 0.68f, 4, 4), c.panel);
  }
};

}  // namespace

MessagePanelView::MessagePanelView() {
  UI_SetNodeID("message-panel");
  mIcon.reset(new MessageIconView());
  mMessage.reset(new controls::UI_StaticText(
      Text("$$$/norvik/gallery/Layout/Message=Do you want to save the changes you made to \"Interview take 3\"? "
           "Your changes will be lost if you close the project without saving them.")));
  mMessage->UI_SetNodeID("message-text");
  mCheckbox.reset(new controls::UI_Checkbox(Text("$$$/norvik/gallery/Layout/DontAsk=Do not ask again")));
  mDontSave.reset(new controls::UI_TextButton(Text("$$$/norvik/gallery/Layout/DontSave=Don't Save")));
  mCancel.reset(new controls::UI_TextButton(Text("$$$/norvik/gallery/Layout/Cancel=Cancel")));
  mSave.reset(new controls::UI_TextButton(Text("$$$/norvik/gallery/Layout/Save=Save")));
  for (const ui::UI_NodeP& node :
       {mIcon, ui::UI_NodeP(mMessage), ui::UI_NodeP(mCheckbox), ui::UI_NodeP(mDontSave), ui::UI_NodeP(mCancel),
        ui::UI_NodeP(mSave)})
    AddGalleryChild(this, node);
}

layout::SmartLayoutP MessagePanelView::Compose(float inWidth) {
  using Builder = layout::SmartLayoutBuilder;
  const float messageWidth =
      std::clamp(inWidth - 2 * kMargin - kIconSize - kIconGap, 120.0f, kMaxMessageWidth);
  Builder text(new layout::UI_TextLayout(mMessage, messageWidth));
  text.AddSpacer_Bottom(10);
  text.AddLayout_Bottom(new layout::UI_CheckboxLayout(mCheckbox), false, Builder::kSpacingNearEdge);
  text.AddSpacer_Left(kIconGap);
  text.AddUINode_Left(mIcon, layout::PointF(kIconSize, kIconSize), false, Builder::kSpacingNearEdge);

  // From the left: the first button, a gap that takes all the spare width,
  // then the other two at the right edge.
  Builder buttons(new layout::UI_TextButtonLayout(mDontSave, kButtonMinimum));
  buttons.AddSpacer_Right(kButtonGap * 3, true);
  buttons.AddLayout_Right(new layout::UI_TextButtonLayout(mCancel, kButtonMinimum));
  buttons.AddSpacer_Right(kButtonGap);
  buttons.AddLayout_Right(new layout::UI_TextButtonLayout(mSave, kButtonMinimum));

  Builder panel(text.GetLayout());
  panel.AddSpacer_Bottom(18);
  panel.AddLayout_Bottom(buttons.GetLayout());
  panel.AddSpacer_AllSides(kMargin);
  return panel.GetLayout();
}

ui::UI_Node::PointF MessagePanelView::GetSizeForWidth(float inWidth) {
  return Compose(inWidth)->GetInitialSize();
}

void MessagePanelView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  const RectF r = UI_GetLocalRectF(false);
  Compose(r.width)->SetLocation(RectF(0, 0, r.width, r.height));
}

void MessagePanelView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  FillRoundRect(inDrawbot, r, 6, Mix(c.panel, c.background, 0.35f));
  StrokeRoundRect(inDrawbot, r.Insetted(0.5f, 0.5f), 6, c.border, 1);
  UI_SubView::UI_Draw(inDrawbot);
}

}  // namespace norvik::gallery
