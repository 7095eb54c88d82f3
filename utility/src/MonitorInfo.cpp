#include "utility/MonitorInfo.h"

#include <algorithm>
#include <memory>
#include <string>

#include "drawbot/Drawbot.h"
#include "tarsel/PropListUtils.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::utility {

namespace {

// How much of a window must show, and of its top edge, to count as visible.
constexpr long kMinVisibleWidth = 40;
constexpr long kMinVisibleHeight = 20;

long long Area(const MonitorInfo::Rect& inRect) {
  if (inRect.width <= 0 || inRect.height <= 0) return 0;
  return static_cast<long long>(inRect.width) * static_cast<long long>(inRect.height);
}

// Squared distance from a point to the nearest point of a rectangle.
long long DistanceSquared(const MonitorInfo::Rect& inRect, const MonitorInfo::Point& inPoint) {
  const long dx = inPoint.x < inRect.left ? inRect.left - inPoint.x
                  : inPoint.x >= inRect.Right() ? inPoint.x - (inRect.Right() - 1) : 0;
  const long dy = inPoint.y < inRect.top ? inRect.top - inPoint.y
                  : inPoint.y >= inRect.Bottom() ? inPoint.y - (inRect.Bottom() - 1) : 0;
  return static_cast<long long>(dx) * dx + static_cast<long long>(dy) * dy;
}

std::size_t NearestIndex(const std::vector<MonitorInfo::Rect>& inRects, const MonitorInfo::Point& inPoint) {
  std::size_t best = 0;
  long long bestDistance = -1;
  for (std::size_t i = 0; i < inRects.size(); ++i) {
    const long long d = DistanceSquared(inRects[i], inPoint);
    if (bestDistance < 0 || d < bestDistance) {
      bestDistance = d;
      best = i;
    }
  }
  return best;
}

MonitorInfo::Rect Nearest(const std::vector<MonitorInfo::Rect>& inRects, const MonitorInfo::Point& inPoint) {
  return inRects[NearestIndex(inRects, inPoint)];
}

// The rectangle that holds most of inRect, the earlier on equal areas, else
// the nearest to its centre.
std::size_t BestIndex(const std::vector<MonitorInfo::Rect>& inRects, const MonitorInfo::Rect& inRect) {
  if (inRects.size() == 1) return 0;
  long long bestArea = 0;
  std::size_t best = inRects.size();
  for (std::size_t i = 0; i < inRects.size(); ++i) {
    const long long area = Area(inRects[i].Intersection(inRect));
    if (area > bestArea) {
      bestArea = area;
      best = i;
    }
  }
  return best < inRects.size() ? best : NearestIndex(inRects, inRect.Center());
}

}  // namespace

const MonitorInfo::Rect& MonitorInfo::GetUnboundedRect() {
  static const Rect unbounded(-1000000000L, -1000000000L, 2000000000L, 2000000000L);
  return unbounded;
}

MonitorInfo::MonitorInfo() : mRects{GetUnboundedRect()} {}

MonitorInfo::MonitorInfo(std::vector<Rect> inRects) : mRects(std::move(inRects)) {
  if (mRects.empty()) mRects.push_back(GetUnboundedRect());
}

MonitorInfo::~MonitorInfo() = default;

bool MonitorInfo::GetMonitorRect(std::size_t inIndex, Rect& outRect) const {
  if (inIndex >= mRects.size()) return false;
  outRect = mRects[inIndex];
  return true;
}

MonitorInfo::Rect MonitorInfo::GetMonitorRectFromPoint(const Point& inPoint) const {
  for (const Rect& r : mRects)
    if (r.Contains(inPoint)) return r;
  return Nearest(mRects, inPoint);
}

MonitorInfo::Rect MonitorInfo::GetMonitorRectFromRect(const Rect& inRect) const {
  return mRects[BestIndex(mRects, inRect)];
}

MonitorInfo::Point MonitorInfo::GetMaxBottomRight() const {
  Point result(mRects.front().Right(), mRects.front().Bottom());
  for (const Rect& r : mRects) {
    result.x = std::max(result.x, r.Right());
    result.y = std::max(result.y, r.Bottom());
  }
  return result;
}

bool MonitorInfo::IsRectVisible(const Rect& inRect) const {
  if (inRect.width <= 0 || inRect.height <= 0) return false;
  const long needWidth = std::min(inRect.width, kMinVisibleWidth);
  const long needHeight = std::min(inRect.height, kMinVisibleHeight);
  for (const Rect& r : mRects) {
    const Rect shown = r.Intersection(inRect);
    const bool topOnMonitor = inRect.top >= r.top && inRect.top < r.Bottom();
    if (topOnMonitor && shown.width >= needWidth && shown.height >= needHeight) return true;
  }
  return false;
}

MonitorInfo::Rect MonitorInfo::EnsureRectIsVisible(const Rect& inRect) const {
  if (IsRectVisible(inRect)) return inRect;
  const Rect monitor = GetMonitorRectFromRect(inRect);
  Rect result = inRect;
  result.width = std::min(std::max(result.width, 1L), monitor.width);
  result.height = std::min(std::max(result.height, 1L), monitor.height);
  result.left = std::clamp(result.left, monitor.left, monitor.Right() - result.width);
  result.top = std::clamp(result.top, monitor.top, monitor.Bottom() - result.height);
  return result;
}

void MonitorInfo::SaveToPropList(tarsel::proplist::PropList& outList) const {
  outList.SetValue("MonitorCount", static_cast<std::int32_t>(mRects.size()));
  for (std::size_t i = 0; i < mRects.size(); ++i)
    tarsel::proplist::utils::WriteRect32(outList, "Monitor" + std::to_string(i), mRects[i]);
}

// ---- OS_MonitorInfo ----

OS_MonitorInfo::OS_MonitorInfo() { Update(); }

bool OS_MonitorInfo::MonitorEnumProc(const Rect& inWorkArea, const Rect& inBounds, OS_MonitorInfo* inSelf) {
  if (inWorkArea.width > 0 && inWorkArea.height > 0) {
    inSelf->mRects.push_back(inWorkArea);
    inSelf->mBounds.push_back(inBounds.width > 0 && inBounds.height > 0 ? inBounds : inWorkArea);
  }
  return true;
}

void OS_MonitorInfo::Update() {
  mRects.clear();
  mBounds.clear();
  if (const ui::OS_NativeLayer* layer = ui::GetNativeLayer()) {
    for (const ui::OS_Monitor& monitor : layer->GetMonitors())
      if (!MonitorEnumProc(monitor.workArea, monitor.bounds, this)) break;
  }
  if (mRects.empty()) {
    mRects.push_back(GetUnboundedRect());
    mBounds.push_back(GetUnboundedRect());
  }
}

std::size_t OS_MonitorInfo::GetMonitorIDFromRect(const Rect& inRect) const { return BestIndex(mBounds, inRect); }

namespace {

// The drawing layer's view of the monitors: read afresh for every split, so
// that a monitor plugged in or a changed work area counts at the next paint.
// A monitor's identity is the address of its slot, distinct for each index.
class NativeMonitorSource : public drawbot::MonitorSource {
 public:
  long GetMonitorCount() const override {
    if (!mInfo)
      mInfo = std::make_unique<OS_MonitorInfo>();
    else
      mInfo->Update();
    mSlots.resize(mInfo->GetMonitorCount());
    return static_cast<long>(mInfo->GetMonitorCount());
  }
  bool GetMonitorRect(long inIndex, tarsel::geom::RectT<long>* outRect) const override {
    return mInfo && inIndex >= 0 && mInfo->GetMonitorRect(static_cast<std::size_t>(inIndex), *outRect);
  }
  void const* GetMonitorIDFromRect(tarsel::geom::RectT<long> const& inRect) const override {
    if (!mInfo || mSlots.empty()) return nullptr;
    const std::size_t index = mInfo->GetMonitorIDFromRect(inRect);
    return index < mSlots.size() ? &mSlots[index] : nullptr;
  }

 private:
  mutable std::unique_ptr<OS_MonitorInfo> mInfo;
  mutable std::vector<char> mSlots;
};

NativeMonitorSource sNativeMonitors;
[[maybe_unused]] const bool sInstalled = (drawbot::SetMonitorSource(&sNativeMonitors), true);

}  // namespace

}  // namespace norvik::utility
