#pragma once
// DrawParameters and its derivatives are snapshots of a control's look. A
// control's UI_Draw fills one on the stack from its live state and hands it to
// a static Draw routine that reads nothing else, so the same routine paints a
// control's look where no control exists (list cells, tool bars). Built with
// a null control, a record takes the defaults.
#include <cstdint>

#include "controls/UI_ColorChangeSupport.h"
#include "drawbot/DrawbotTypes.h"
#include "tarsel/Flags.h"
#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"
#include "ui/Theme.h"

namespace norvik::drawbot {
class Drawbot;
class ImageInterface;
}

namespace norvik::controls {

class UI_ControlView;

class DrawParameters {
 public:
  using StateFlags = tarsel::utility::Flags<unsigned long>;
  using RectF = tarsel::geom::RectT<float>;

  DrawParameters();
  explicit DrawParameters(const UI_ControlView* inControl);
  DrawParameters(const DrawParameters&) = default;
  DrawParameters& operator=(const DrawParameters&) = default;
  virtual ~DrawParameters() = default;

  void SetDefaults();

  StateFlags GetControlState() const { return mControlState; }
  void SetControlState(StateFlags inState) { mControlState = inState; }
  const RectF& GetRectF() const { return mRect; }
  void SetRectF(const RectF& inRect) { mRect = inRect; }
  const ColorChangeMap* GetColorChangeMap() const { return mColorChangeMap; }
  void SetColorChangeMap(const ColorChangeMap* inMap) { mColorChangeMap = inMap; }
  const ui::ThemeP& GetTheme() const { return mTheme; }
  void SetTheme(const ui::ThemeP& inTheme) { mTheme = inTheme; }
  bool GetAllowMnemonics() const { return mAllowMnemonics; }
  void SetAllowMnemonics(bool inAllow) { mAllowMnemonics = inAllow; }
  bool GetDisplayMnemonics() const { return mDisplayMnemonics; }
  void SetDisplayMnemonics(bool inDisplay) { mDisplayMnemonics = inDisplay; }
  std::int64_t GetMnemonicLocation() const { return mMnemonicLocation; }
  void SetMnemonicLocation(std::int64_t inLocation) { mMnemonicLocation = inLocation; }
  bool GetValueUnknown() const { return mValueUnknown; }
  void SetValueUnknown(bool inUnknown) { mValueUnknown = inUnknown; }

  // The theme colour inIndex after the colour change map.
  drawbot::ColorRGBA Color(std::uint64_t inIndex) const;

 private:
  StateFlags mControlState;
  RectF mRect;
  const ColorChangeMap* mColorChangeMap = nullptr;
  ui::ThemeP mTheme;
  bool mAllowMnemonics = false;
  bool mDisplayMnemonics = false;
  std::int64_t mMnemonicLocation = 0;
  bool mValueUnknown = false;
};

// The text half of records of controls that carry a label.
class DrawTextControlBaseParameters {
 public:
  DrawTextControlBaseParameters();
  virtual ~DrawTextControlBaseParameters() = default;

  const UTF16String& GetFontName() const { return mFontName; }
  void SetFontName(const UTF16String& inName) { mFontName = inName; }
  const UTF16String& GetFontStyleName() const { return mFontStyleName; }
  void SetFontStyleName(const UTF16String& inName) { mFontStyleName = inName; }
  float GetFontSize() const { return mFontSize; }
  void SetFontSize(float inSize) { mFontSize = inSize; }
  drawbot::TextAlignment GetTextAlignment() const { return mAlignment; }
  void SetTextAlignment(drawbot::TextAlignment inAlignment) { mAlignment = inAlignment; }
  drawbot::TextTruncation GetTextTruncation() const { return mTruncation; }
  void SetTextTruncation(drawbot::TextTruncation inTruncation) { mTruncation = inTruncation; }
  const UTF16String& GetText() const { return mText; }
  void SetText(const UTF16String& inText) { mText = inText; }
  // Space kept free before the label, inside the face's rectangle.
  float GetTextIndent() const { return mTextIndent; }
  void SetTextIndent(float inIndent) { mTextIndent = inIndent; }

 private:
  UTF16String mFontName;
  UTF16String mFontStyleName;
  float mFontSize;
  drawbot::TextAlignment mAlignment = drawbot::kTextAlignCenter;
  drawbot::TextTruncation mTruncation = drawbot::kTextTruncationEndWithEllipsis;
  UTF16String mText;
  float mTextIndent = 0;
};

// What stands on a button's bevel. Faces live on the stack of the Draw
// routine that sets them; the parameters only point at them.
class DrawButtonFace {
 public:
  virtual ~DrawButtonFace() = default;
  virtual void operator()(tarsel::utility::Flags<unsigned long> inState, const tarsel::geom::RectT<float>& inRect,
                          const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot,
                          const ui::Theme& inTheme, const ColorChangeMap* inMap) const = 0;
};

class DrawButtonParameters : public DrawParameters {
 public:
  using PointF = tarsel::geom::PointT<float>;

  DrawButtonParameters() = default;
  explicit DrawButtonParameters(const UI_ControlView* inControl);

  bool GetDrawContainer() const { return mDrawContainer; }
  void SetDrawContainer(bool inDraw) { mDrawContainer = inDraw; }
  bool GetDrawOutline() const { return mDrawOutline; }
  void SetDrawOutline(bool inDraw) { mDrawOutline = inDraw; }
  bool GetDefaultAppearance() const { return mDefaultAppearance; }
  void SetDefaultAppearance(bool inDefault) { mDefaultAppearance = inDefault; }
  bool GetRotatedGradient() const { return mRotatedGradient; }
  void SetRotatedGradient(bool inRotated) { mRotatedGradient = inRotated; }
  bool GetSemiRounded() const { return mSemiRounded; }
  void SetSemiRounded(bool inSemi) { mSemiRounded = inSemi; }
  bool GetSelectedAppearance() const { return mSelectedAppearance; }
  void SetSelectedAppearance(bool inSelected) { mSelectedAppearance = inSelected; }
  float GetStrokeSize() const { return mStrokeSize; }
  void SetStrokeSize(float inSize) { mStrokeSize = inSize; }
  float GetCornerRadius() const { return mCornerRadius; }
  void SetCornerRadius(float inRadius) { mCornerRadius = inRadius; }
  const PointF& GetOffset() const { return mOffset; }
  void SetOffset(const PointF& inOffset) { mOffset = inOffset; }
  const DrawButtonFace* GetDrawButtonFace() const { return mFace; }
  void SetDrawButtonFace(const DrawButtonFace* inFace) { mFace = inFace; }
  bool GetInsetUndrawnSpace() const { return mInsetUndrawnSpace; }
  void SetInsetUndrawnSpace(bool inInset) { mInsetUndrawnSpace = inInset; }
  bool ShouldDrawInnerBevelOutline() const { return mInnerBevelOutline; }
  void SetDrawInnerBevelOutline(bool inDraw) { mInnerBevelOutline = inDraw; }
  bool ShouldDrawOuterBevelOutline() const { return mOuterBevelOutline; }
  void SetDrawOuterBevelOutline(bool inDraw) { mOuterBevelOutline = inDraw; }
  bool ShouldDrawInnerGradient() const { return mInnerGradient; }
  void SetDrawInnerGradient(bool inDraw) { mInnerGradient = inDraw; }

 private:
  bool mDrawContainer = true;
  bool mDrawOutline = true;
  bool mDefaultAppearance = false;
  bool mRotatedGradient = false;
  bool mSemiRounded = false;
  bool mSelectedAppearance = false;
  float mStrokeSize = 1;
  float mCornerRadius = 0;
  PointF mOffset;
  const DrawButtonFace* mFace = nullptr;
  bool mInsetUndrawnSpace = true;
  bool mInnerBevelOutline = true;
  bool mOuterBevelOutline = true;
  bool mInnerGradient = true;
};

class DrawTextButtonParameters : public DrawButtonParameters, public DrawTextControlBaseParameters {
 public:
  DrawTextButtonParameters() = default;
  explicit DrawTextButtonParameters(const UI_ControlView* inControl);
};

class DrawPictureTextButtonParameters : public DrawTextButtonParameters {
 public:
  using DrawTextButtonParameters::DrawTextButtonParameters;
};

// A picture button's look: the image on the bevel, with its scale and alpha.
// The image is not owned; it lives in the image cache or with the supplier.
class DrawPictureButtonParameters : public DrawButtonParameters {
 public:
  DrawPictureButtonParameters() = default;
  explicit DrawPictureButtonParameters(const UI_ControlView* inControl);
  const drawbot::ImageInterface* GetImage() const { return mImage; }
  void SetImage(const drawbot::ImageInterface* inImage) { mImage = inImage; }
  float GetScale() const { return mScale; }
  void SetScale(float inScale) { mScale = inScale; }
  float GetAlpha() const { return mAlpha; }
  void SetAlpha(float inAlpha) { mAlpha = inAlpha; }
  // Space kept free between the face's rectangle and the image.
  float GetImageBorder() const { return mImageBorder; }
  void SetImageBorder(float inBorder) { mImageBorder = inBorder; }

 private:
  const drawbot::ImageInterface* mImage = nullptr;
  float mScale = 1;
  float mAlpha = 1;
  float mImageBorder = 0;
};

class DrawCheckBoxParams : public DrawButtonParameters, public DrawTextControlBaseParameters {
 public:
  DrawCheckBoxParams() = default;
  explicit DrawCheckBoxParams(const UI_ControlView* inControl);
  // 0 off, 1 on, 2 mixed.
  int GetValue() const { return mValue; }
  void SetValue(int inValue) { mValue = inValue; }
  float GetCheckSize() const { return mCheckSize; }
  void SetCheckSize(float inSize) { mCheckSize = inSize; }

 private:
  int mValue = 0;
  float mCheckSize = 14;
};

class DrawRadioButtonParams : public DrawButtonParameters, public DrawTextControlBaseParameters {
 public:
  DrawRadioButtonParams() = default;
  explicit DrawRadioButtonParams(const UI_ControlView* inControl);
  bool GetOn() const { return mOn; }
  void SetOn(bool inOn) { mOn = inOn; }
  float GetButtonSize() const { return mButtonSize; }
  void SetButtonSize(float inSize) { mButtonSize = inSize; }

 private:
  bool mOn = false;
  float mButtonSize = 14;
};

}  // namespace norvik::controls
