#pragma once
// The toolkit's controls on the page: push buttons, check boxes and a radio
// group, each a real control taking clicks, keys and focus.
#include <vector>

#include "GalleryStyle.h"
#include "ui/UI_SubView.h"

namespace norvik::controls {
class UI_TextButton;
class UI_Checkbox;
class UI_RadioGroup;
}  // namespace norvik::controls

namespace norvik::gallery {

class ControlsView : public ui::UI_SubView {
 public:
  ControlsView();
  void UI_SizeChanged(const RectF& inLocalRect) override;

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  controls::UI_Checkbox* GetSnapCheckbox() const;
  controls::UI_TextButton* GetRenderButton() const;
  // The line under the controls: the last button pressed, or a hint.
  const UTF16String& GetStatus() const { return mStatus; }
  controls::UI_RadioGroup* GetTimeDisplayGroup() const;

 private:
  void Arrange();
  ui::UI_NodeP mRender, mExport, mSnap, mWaveforms, mGroup;
  std::vector<ui::UI_NodeP> mRadios;
  UTF16String mStatus;
};

}  // namespace norvik::gallery
