// Pens and paths of the image back end.
#include <cmath>

#include "drawbot/src/cairo/CairoObjects.h"

namespace norvik::drawbot::cairo {

void OSPenInterface::SetLineJoin(LineJoin inJoin) {
  MapLineJoin(inJoin);  // refuses unknown values now rather than at drawing time
  mJoin = inJoin;
}

void OSPenInterface::SetLineCap(LineCap inCap) {
  MapLineCap(inCap);
  mCap = inCap;
}

void OSPenInterface::SetDashArray(float const* inDashes, long inCount) {
  mDashes.clear();
  for (long i = 0; inDashes && i < inCount; ++i) mDashes.push_back(inDashes[i]);
}

void OSPenInterface::GetDashArray(long inCount, float* outDashes) const {
  for (long i = 0; i < inCount && i < GetDashCount(); ++i) outDashes[i] = static_cast<float>(mDashes[i]);
}

void OSPenInterface::Apply(cairo_t* inContext) const {
  cairo_set_source_rgba(inContext, mColor.red, mColor.green, mColor.blue, mColor.alpha);
  cairo_set_line_width(inContext, mWidth);
  cairo_set_miter_limit(inContext, mMiterLimit);
  cairo_set_line_join(inContext, MapLineJoin(mJoin));
  cairo_set_line_cap(inContext, MapLineCap(mCap));
  // Dash lengths are in multiples of the pen width.
  std::vector<double> dashes(mDashes);
  for (double& d : dashes) d *= mWidth;
  cairo_set_dash(inContext, dashes.empty() ? nullptr : dashes.data(), static_cast<int>(dashes.size()), 0);
}

void OSPathInterface::Move(double inX, double inY) {
  // Starting a figure after one that came back to its own start closes it.
  if (mFigureOpen && mCurrentX == mFirstX && mCurrentY == mFirstY && !mSegments.empty() &&
      mSegments.back().op != Op::kMove)
    mSegments.push_back({Op::kClose, {}});
  mSegments.push_back({Op::kMove, {inX, inY}});
  mFirstX = mCurrentX = inX;
  mFirstY = mCurrentY = inY;
  mFigureOpen = true;
}

void OSPathInterface::Line(double inX, double inY) {
  if (!mFigureOpen) {
    Move(mCurrentX, mCurrentY);
  }
  mSegments.push_back({Op::kLine, {inX, inY}});
  mCurrentX = inX;
  mCurrentY = inY;
}

void OSPathInterface::Curve(double const (&inV)[6]) {
  if (!mFigureOpen) Move(mCurrentX, mCurrentY);
  mSegments.push_back({Op::kCurve, {inV[0], inV[1], inV[2], inV[3], inV[4], inV[5]}});
  mCurrentX = inV[4];
  mCurrentY = inV[5];
}

void OSPathInterface::Rect(double inX, double inY, double inW, double inH) {
  mSegments.push_back({Op::kRect, {inX, inY, inW, inH}});
  mFigureOpen = false;
  mFirstX = mCurrentX = inX;
  mFirstY = mCurrentY = inY;
}

bool OSPathInterface::GetSingleRect(double (&outRect)[4]) const {
  if (mSegments.size() != 1 || mSegments[0].op != Op::kRect) return false;
  for (int i = 0; i < 4; ++i) outRect[i] = mSegments[0].v[i];
  return true;
}

void OSPathInterface::MoveTo(PointT<long> const& inPoint) { Move(inPoint.x, inPoint.y); }
void OSPathInterface::MoveTo(PointT<float> const& inPoint) {
  mPixelAligned = false;
  Move(inPoint.x, inPoint.y);
}
void OSPathInterface::LineTo(PointT<long> const& inPoint) { Line(inPoint.x, inPoint.y); }
void OSPathInterface::LineTo(PointT<float> const& inPoint) {
  mPixelAligned = false;
  Line(inPoint.x, inPoint.y);
}
void OSPathInterface::BezierTo(PointT<long> const& inC1, PointT<long> const& inC2, PointT<long> const& inEnd) {
  double v[6] = {double(inC1.x), double(inC1.y), double(inC2.x), double(inC2.y), double(inEnd.x), double(inEnd.y)};
  Curve(v);
}
void OSPathInterface::BezierTo(PointT<float> const& inC1, PointT<float> const& inC2, PointT<float> const& inEnd) {
  mPixelAligned = false;
  double v[6] = {inC1.x, inC1.y, inC2.x, inC2.y, inEnd.x, inEnd.y};
  Curve(v);
}
void OSPathInterface::AddRect(RectT<long> const& inRect) {
  Rect(inRect.left, inRect.top, inRect.width, inRect.height);
}
void OSPathInterface::AddRect(RectT<float> const& inRect) {
  mPixelAligned = false;
  Rect(inRect.left, inRect.top, inRect.width, inRect.height);
}

void OSPathInterface::AddArc(PointT<float> const& inCentre, float inRadius, float inStartAngle, float inSweepAngle) {
  mPixelAligned = false;
  if (inRadius == 0) {
    Line(inCentre.x, inCentre.y);
    return;
  }
  double start = inStartAngle * M_PI / 180.0, end = (inStartAngle + inSweepAngle) * M_PI / 180.0;
  double startX = inCentre.x + inRadius * std::cos(start), startY = inCentre.y + inRadius * std::sin(start);
  if (mFigureOpen)
    Line(startX, startY);
  else
    Move(startX, startY);
  mSegments.push_back({Op::kArc, {inCentre.x, inCentre.y, inRadius, start, end}});
  mCurrentX = inCentre.x + inRadius * std::cos(end);
  mCurrentY = inCentre.y + inRadius * std::sin(end);
}

void OSPathInterface::ClosePath() {
  if (mFigureOpen) mSegments.push_back({Op::kClose, {}});
  mFigureOpen = false;
  mCurrentX = mFirstX;
  mCurrentY = mFirstY;
}

void OSPathInterface::Build(cairo_t* inContext) const {
  cairo_new_path(inContext);
  for (auto const& s : mSegments) {
    switch (s.op) {
      case Op::kMove: cairo_move_to(inContext, s.v[0], s.v[1]); break;
      case Op::kLine: cairo_line_to(inContext, s.v[0], s.v[1]); break;
      case Op::kCurve: cairo_curve_to(inContext, s.v[0], s.v[1], s.v[2], s.v[3], s.v[4], s.v[5]); break;
      case Op::kRect: cairo_rectangle(inContext, s.v[0], s.v[1], s.v[2], s.v[3]); break;
      case Op::kArc:
        if (s.v[4] >= s.v[3])
          cairo_arc(inContext, s.v[0], s.v[1], s.v[2], s.v[3], s.v[4]);
        else
          cairo_arc_negative(inContext, s.v[0], s.v[1], s.v[2], s.v[3], s.v[4]);
        break;
      case Op::kClose: cairo_close_path(inContext); break;
    }
  }
}

}  // namespace norvik::drawbot::cairo
