#include "ButtonGridView.h"

#include <algorithm>
#include <cmath>

#include "GalleryViews.h"
#include "controls/UI_RadioGroup.h"

namespace norvik::gallery {

ButtonGridView::ButtonGridView() {
  UI_SetNodeID("button-grid");
  mRadioGroup.reset(new controls::UI_RadioGroup());
  mRadioGroup->UI_SetNodeID("sample-radio-group");
  mSamples.resize(kButtonKindCount);
  for (int k = 0; k < kButtonKindCount; ++k) {
    mSamples[k].resize(kShownStateCount);
    for (int s = 0; s < kShownStateCount; ++s) {
      if (!KindShowsState(KindAt(k), StateAt(s))) continue;
      mSamples[k][s] = MakeStateSample(KindAt(k), StateAt(s));
      AddGalleryChild(KindAt(k) == ButtonKind::kRadio ? mRadioGroup.get() : this, mSamples[k][s]);
    }
  }
  AddGalleryChild(this, mRadioGroup);
}

ui::UI_Node* ButtonGridView::GetSample(ButtonKind inKind, ShownState inState) const {
  return mSamples[static_cast<int>(inKind)][static_cast<int>(inState)].get();
}

int ButtonGridView::GetSampleCount() const {
  int count = 0;
  for (const auto& row : mSamples)
    for (const auto& sample : row) count += sample ? 1 : 0;
  return count;
}

float ButtonGridView::RowHeight() const {
  const RectF r = UI_GetLocalRectF(false);
  return std::floor(std::clamp((r.height - kHeadingHeight) / kButtonKindCount, kMinRowHeight, kMaxRowHeight));
}

float ButtonGridView::LabelWidth() const {
  return std::floor(std::clamp(UI_GetLocalRectF(false).width * 0.17f, kMinLabelWidth, kMaxLabelWidth));
}

float ButtonGridView::ColumnWidth() const {
  const RectF r = UI_GetLocalRectF(false);
  return std::floor(std::max(0.0f, (r.width - LabelWidth()) / kShownStateCount));
}

RectF ButtonGridView::GetCellRect(ButtonKind inKind, ShownState inState) const {
  const float rowH = RowHeight(), colW = ColumnWidth();
  return RectF(LabelWidth() + colW * static_cast<float>(inState), kHeadingHeight + rowH * static_cast<float>(inKind),
               colW, rowH);
}

void ButtonGridView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void ButtonGridView::Arrange() {
  const RectF radioRow = GetCellRect(ButtonKind::kRadio, ShownState::kNormal);
  const float labelW = LabelWidth();
  mRadioGroup->UI_SetLocalRectF(RectF(labelW, radioRow.top, ColumnWidth() * kShownStateCount, radioRow.height));
  for (int k = 0; k < kButtonKindCount; ++k) {
    const PointF size = ButtonSize(KindAt(k));
    for (int s = 0; s < kShownStateCount; ++s) {
      if (!mSamples[k][s]) continue;
      RectF cell = GetCellRect(KindAt(k), StateAt(s));
      if (KindAt(k) == ButtonKind::kRadio) cell.left -= labelW, cell.top = 0;
      const float w = std::min(size.x, std::max(0.0f, cell.width - 10));
      const float h = std::min(size.y, cell.height);
      mSamples[k][s]->UI_SetLocalRectF(
          RectF(std::floor(cell.left + (cell.width - w) / 2), std::floor(cell.top + (cell.height - h) / 2), w, h));
    }
  }
}

void ButtonGridView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const float rowH = RowHeight(), colW = ColumnWidth(), labelW = LabelWidth();
  // Every other row on a faint stripe, so that a row reads across.
  for (int k = 0; k < kButtonKindCount; k += 2)
    FillRect(inDrawbot, RectF(0, kHeadingHeight + rowH * static_cast<float>(k), r.width, rowH),
             Mix(c.panel, c.text, 0.035f));
  for (int s = 0; s < kShownStateCount; ++s)
    DrawLabel(inDrawbot, ShownStateName(StateAt(s)),
              RectF(labelW + colW * static_cast<float>(s) + 2, 0, colW - 4, kHeadingHeight), c.dimText,
              drawbot::kTextAlignCenter, 0, true);
  FillRect(inDrawbot, RectF(0, kHeadingHeight - 1, r.width, 1), Mix(c.panel, c.border, 0.6f));
  for (int k = 0; k < kButtonKindCount; ++k)
    DrawLabel(inDrawbot, ButtonKindName(KindAt(k)),
              RectF(6, kHeadingHeight + rowH * static_cast<float>(k), labelW - 10, rowH), c.text);
  UI_SubView::UI_Draw(inDrawbot);
}

}  // namespace norvik::gallery
