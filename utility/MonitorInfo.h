#pragma once
// Where the screens are. MonitorInfo holds the work rectangles of the
// monitors, primary first, and answers the placement questions of popups and
// saved windows; OS_MonitorInfo fills it from the native layer.
#include <cstddef>
#include <vector>

#include <boost/core/noncopyable.hpp>

#include "tarsel/PointT.h"
#include "tarsel/PropList.h"
#include "tarsel/RectT.h"

namespace norvik::utility {

class MonitorInfo : private boost::noncopyable {
 public:
  using Rect = tarsel::geom::RectT<long>;
  using Point = tarsel::geom::PointT<long>;

  // Without a platform, one monitor covers the whole coordinate space.
  static const Rect& GetUnboundedRect();

  MonitorInfo();
  explicit MonitorInfo(std::vector<Rect> inRects);
  virtual ~MonitorInfo();

  // Reads the monitors again; the base keeps what it holds.
  virtual void Update() {}

  std::size_t GetMonitorCount() const { return mRects.size(); }
  bool GetMonitorRect(std::size_t inIndex, Rect& outRect) const;
  // The monitor holding the point, else the nearest one.
  Rect GetMonitorRectFromPoint(const Point& inPoint) const;
  // The monitor that the rectangle overlaps most (the earlier one on a tie),
  // else the nearest one.
  Rect GetMonitorRectFromRect(const Rect& inRect) const;
  // The right and bottom edges furthest out over all monitors.
  Point GetMaxBottomRight() const;
  // Visible: the top edge (where a frame is taken hold of) lies on some
  // monitor over a usable length, and a usable part of the rectangle shows.
  bool IsRectVisible(const Rect& inRect) const;
  // The rectangle itself when visible; else moved (and shrunk if it must be)
  // onto the monitor it belongs to most.
  Rect EnsureRectIsVisible(const Rect& inRect) const;
  // "MonitorCount" and one "Monitor<i>" rectangle each.
  void SaveToPropList(tarsel::proplist::PropList& outList) const;
  bool Equals(const MonitorInfo& inOther) const { return mRects == inOther.mRects; }

 protected:
  std::vector<Rect> mRects;
};

// Colour-managed drawing splits its rectangles at the borders of these
// monitors: the library installs a reader of the native layer's monitors as
// the drawing layer's monitor source when it is loaded.
class OS_MonitorInfo : public MonitorInfo {
 public:
  // Reads the monitors at once.
  OS_MonitorInfo();

  void Update() override;
  // The index of the platform's monitor for a rectangle: the one whose whole
  // screen holds most of it (the earlier on a tie), else the nearest. Work
  // areas may coincide where screens do not, so they cannot tell monitors
  // apart.
  std::size_t GetMonitorIDFromRect(const Rect& inRect) const;

 private:
  // Called once a monitor during Update; adds its work area and its screen.
  static bool MonitorEnumProc(const Rect& inWorkArea, const Rect& inBounds, OS_MonitorInfo* inSelf);

  std::vector<Rect> mBounds;  // the whole screen of each entry of mRects
};

}  // namespace norvik::utility
