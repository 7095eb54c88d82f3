#pragma once
// A toggle whose triangle turns a quarter between closed (pointing right)
// and open (pointing down). The turn is animated over the twirl duration;
// listeners hear of the change only once the turn has ended, so a view that
// opens a section does so after the triangle has come to rest.
#include "controls/UI_PictureTextButton.h"

namespace norvik::controls {

// The face of a disclosure triangle: the triangle at rest, closed or open
// by the button's value, or part way through its twirl. While the button is
// held it points where a release would leave it, following the press look.
class DrawTrianglePicture : public DrawButtonFace {
 public:
  // inTime is the seconds into the twirl, or -1 when none runs.
  DrawTrianglePicture(const DrawParameters& inParams, double inTime, double inDuration, bool inValue,
                      bool inCaptured, float inScale);
  // 0 degrees points right (closed), 90 down (open).
  float GetAngle(DrawParameters::StateFlags inState) const;
  void operator()(DrawParameters::StateFlags inState, const tarsel::geom::RectT<float>& inRect,
                  const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot, const ui::Theme& inTheme,
                  const ColorChangeMap* inMap) const override;

 private:
  const DrawParameters& mParams;
  double mTime;
  double mDuration;
  bool mValue;
  bool mCaptured;
  float mScale;
};

class UI_DisclosureTriangleButton : public UI_PictureTextButton {
 public:
  explicit UI_DisclosureTriangleButton(const UTF16String& inText = UTF16String());
  ~UI_DisclosureTriangleButton() override;

  void SetTwirlDuration(double inSeconds) { mTwirlDuration = inSeconds; }
  double GetTwirlDuration() const { return mTwirlDuration; }
  // Seconds into the running twirl, or -1 when none runs.
  double GetAnimationTime() const;

  void SendButtonChangedMessage(ModKeys inModKeys) override;
  bool UI_DoTimerNotify(long inTimerID) override;

  // Draws the triangle at inAngle degrees (0 right, 90 down) centred in inRect.
  static void DrawTriangle(const DrawParameters& inParams, const RectF& inRect, float inAngle,
                           drawbot::Drawbot& inDrawbot);

 protected:
  void DrawPicture(const DrawParameters& inParams, const RectF& inRect, drawbot::Drawbot& inDrawbot) override;

 private:
  ModKeys mStoredModKeys;
  double mAnimationStart = -1;
  long mTimerID = 0;
  double mTwirlDuration = 0.075;
};

}  // namespace norvik::controls
