#pragma once
// The opaque drawing resources. A supplier makes them, and they are valid only
// with surfaces of the supplier that made them.
#include "drawbot/DrawbotTypes.h"
#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/RefCountedObject.h"

namespace norvik::drawbot {

class PenInterface : public tarsel::utility::RefCountedObject {
 public:
  virtual void SetWidth(float inWidth) = 0;
  virtual float GetWidth() const = 0;
  virtual void SetMiterLimit(float inLimit) = 0;
  virtual float GetMiterLimit() const = 0;
  virtual void SetLineJoin(LineJoin inJoin) = 0;
  virtual LineJoin GetLineJoin() const = 0;
  // Sets the start and the end cap together.
  virtual void SetLineCap(LineCap inCap) = 0;
  virtual LineCap GetLineCap() const = 0;
  virtual void SetDashArray(float const* inDashes, long inCount) = 0;
  // Copies at most inCount dash lengths into outDashes.
  virtual void GetDashArray(long inCount, float* outDashes) const = 0;
  virtual long GetDashCount() const = 0;
};

class BrushInterface : public tarsel::utility::RefCountedObject {};
class ShaderInterface : public tarsel::utility::RefCountedObject {};
class LinearShaderInterface : public ShaderInterface {};
class RadialShaderInterface : public ShaderInterface {};

// A path keeps track of whether it was built only from whole-pixel points: the
// integer forms keep that mark, any float form clears it, and a back end uses
// it to decide whether the shape needs the half-pixel shift.
class PathInterface : public tarsel::utility::RefCountedObject {
 public:
  virtual void MoveTo(tarsel::geom::PointT<long> const& inPoint) = 0;
  virtual void MoveTo(tarsel::geom::PointT<float> const& inPoint) = 0;
  virtual void LineTo(tarsel::geom::PointT<long> const& inPoint) = 0;
  virtual void LineTo(tarsel::geom::PointT<float> const& inPoint) = 0;
  virtual void BezierTo(tarsel::geom::PointT<long> const& inControl1, tarsel::geom::PointT<long> const& inControl2,
                        tarsel::geom::PointT<long> const& inEnd) = 0;
  virtual void BezierTo(tarsel::geom::PointT<float> const& inControl1,
                        tarsel::geom::PointT<float> const& inControl2, tarsel::geom::PointT<float> const& inEnd) = 0;
  virtual void AddRect(tarsel::geom::RectT<long> const& inRect) = 0;
  virtual void AddRect(tarsel::geom::RectT<float> const& inRect) = 0;
  // Angles in degrees, clockwise in a y-down space. A line joins the current
  // point to the start of the arc; a radius of 0 is a LineTo the centre.
  virtual void AddArc(tarsel::geom::PointT<float> const& inCentre, float inRadius, float inStartAngle,
                      float inSweepAngle) = 0;
  virtual void ClosePath() = 0;
};

class FontInterface : public tarsel::utility::RefCountedObject {
 public:
  virtual float GetAscent() const = 0;
  virtual float GetDescent() const = 0;
  // The size in pixels.
  virtual float GetSize() const = 0;
  // inLength -1 measures up to the terminator.
  virtual float MeasureStringWidth(unsigned short const* inText, long inLength) const = 0;
  virtual float MeasureMultiLineStringHeight(unsigned short const* inText, float inWidth, long inLength) const = 0;
};

class ImageInterface : public tarsel::utility::RefCountedObject {
 public:
  virtual unsigned long GetWidth() const = 0;
  virtual unsigned long GetHeight() const = 0;
};

}  // namespace norvik::drawbot
