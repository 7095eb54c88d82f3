#pragma once
// The row at the top of the gallery that picks the page on show: a button
// bar with a button per page. A user's choice (a click, or the arrow keys
// once the bar has the focus) calls the change function; Select sets the
// choice without calling it.
#include <functional>

#include "GalleryOptions.h"
#include "GalleryStyle.h"
#include "ui/UI_SubView.h"

namespace norvik::controls {
class UI_ButtonBar;
}

namespace norvik::gallery {

class PageSelector : public ui::UI_SubView {
 public:
  using ChangeFunction = std::function<void(GalleryPageID inPage)>;

  PageSelector();
  void Select(GalleryPageID inPage);
  GalleryPageID GetSelected() const;
  void SetChangeFunction(ChangeFunction inF) { mChange = std::move(inF); }
  // The button a user clicks to choose inPage.
  ui::UI_Node* GetChoice(GalleryPageID inPage) const;
  // The width the choices need side by side.
  float GetPreferredWidth() const;

  void UI_SizeChanged(const RectF& inLocalRect) override;

 private:
  void Arrange();
  void ChoiceMade();
  controls::UI_ButtonBar* Bar() const;
  ui::UI_NodeP mBar;
  ChangeFunction mChange;
};

}  // namespace norvik::gallery
