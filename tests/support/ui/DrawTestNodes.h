#pragma once
// Doubles for draw traversal tests: a view that paints its rectangle in a
// theme colour and logs each drawing, and helpers to paint a tree onto a
// recording surface.
#include <functional>
#include <string>
#include <vector>

#include "drawbot/Drawbot.h"
#include "support/drawbot/RecordingSupplier.h"
#include "ui/UI_SubView.h"

namespace norvik::ui::test {

class PaintingView : public UI_SubView {
 public:
  PaintingView(std::string inName, std::uint64_t inColorID, std::vector<std::string>* ioLog)
      : name(std::move(inName)), colorID(inColorID), log(ioLog) {}

  void UI_Draw(drawbot::Drawbot* inDrawbot) override {
    ++draws;
    if (log) log->push_back(name);
    if (onDraw) onDraw(inDrawbot);
    inDrawbot->GetSurface()->PaintRect(GetThemeColor(colorID), paintRect ? *paintRect : UI_GetLocalRectF(false));
    UI_SubView::UI_Draw(inDrawbot);
  }
  bool UI_ReceivesEventsFromOS() const override { return nativeWindow; }
  void UI_GetOSControlClipRects(OSControlClipRects& ioRects) const override {
    if (hostedControl) ioRects.push_back({this, *hostedControl});
    UI_SubView::UI_GetOSControlClipRects(ioRects);
  }

  std::string name;
  std::uint64_t colorID;
  std::vector<std::string>* log;
  int draws = 0;
  bool nativeWindow = false;
  const RectF* paintRect = nullptr;          // paints this instead of its own rectangle
  const RectF* hostedControl = nullptr;      // a native control, local to this view
  std::function<void(drawbot::Drawbot*)> onDraw;
};

using PaintingViewP = boost::intrusive_ptr<PaintingView>;

inline PaintingViewP AddPaintingView(const char* inName, float inX, float inY, float inW, float inH,
                                     std::uint64_t inColorID, std::vector<std::string>* ioLog,
                                     UI_Node* inParent = nullptr) {
  PaintingViewP v(new PaintingView(inName, inColorID, ioLog));
  v->UI_SetLocalRectF(tarsel::geom::RectT<float>(inX, inY, inW, inH));
  v->UI_Show(true);
  if (inParent) inParent->ChildPushBack(v);
  return v;
}

// A recording surface of a given size and the drawbot over it.
struct RecordingTarget {
  explicit RecordingTarget(long inWidth = 200, long inHeight = 200)
      : surface(static_cast<drawbot::testing::RecordingSurface*>(
            supplier.NewOffscreenSurface(static_cast<unsigned long>(inWidth), static_cast<unsigned long>(inHeight),
                                         false))),
        drawbot(&supplier, surface.get()) {}

  // The operations recorded since the last call, then forgets them.
  std::vector<drawbot::testing::DrawCall> Take() {
    std::vector<drawbot::testing::DrawCall> calls = supplier.GetCalls();
    supplier.ClearCalls();
    return calls;
  }
  static int Count(const std::vector<drawbot::testing::DrawCall>& inCalls, const std::string& inOp) {
    int n = 0;
    for (const auto& c : inCalls) n += c.op == inOp ? 1 : 0;
    return n;
  }

  drawbot::testing::RecordingSupplier supplier;
  boost::intrusive_ptr<drawbot::testing::RecordingSurface> surface;
  drawbot::Drawbot drawbot;
};

}  // namespace norvik::ui::test
