#include "utility/PrefManager.h"

#include <algorithm>
#include <filesystem>
#include <memory>

#include "tarsel/FileUtils.h"
#include "tarsel/PropListUtils.h"
#include "utility/MonitorInfo.h"

namespace norvik::utility {

namespace {

constexpr const char* kPositionKey = "Position";
constexpr const char* kSizeKey = "Size";

std::unique_ptr<PrefManager>& Instance() {
  static std::unique_ptr<PrefManager> instance;
  return instance;
}

bool OnSomeMonitor(const MonitorInfo& inMonitors, const MonitorInfo::Point& inPoint) {
  MonitorInfo::Rect r;
  for (std::size_t i = 0; inMonitors.GetMonitorRect(i, r); ++i)
    if (r.Contains(inPoint)) return true;
  return false;
}

}  // namespace

PrefManager* PrefManager::GetPrefManager() { return Instance().get(); }

void PrefManager::Initialize() {
  if (Instance()) return;
  Instance() = std::make_unique<PrefManager>();
  Instance()->LoadDialogPrefFile();
}

void PrefManager::Finalize() {
  std::unique_ptr<PrefManager> manager = std::move(Instance());
  if (manager) manager->SaveDialogPrefFile();
}

PrefManager::PrefManager() : mPrefs(new tarsel::proplist::PropList) {}

UTF16String PrefManager::GetDialogPrefsDirectory() const {
  const std::filesystem::path folder = tarsel::utility::FileUtils::GetUserConfigDir().GetPath() / "norvik";
  return tarsel::utility::UTF8to16(folder.string());
}

UTF16String PrefManager::GetDialogPrefsPath() const {
  return tarsel::utility::FileUtils::BuildPathSpec(GetDialogPrefsDirectory(), kDialogPrefsFileName);
}

void PrefManager::LoadDialogPrefFile() {
  tarsel::proplist::PropListP loaded(new tarsel::proplist::PropList);
  const std::string path = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(GetDialogPrefsPath()));
  try {
    if (std::filesystem::exists(path)) tarsel::proplist::utils::LoadPropList(path, *loaded);
  } catch (const std::exception&) {
    // A damaged preference file is forgotten, not fatal: windows open at
    // their default places.
    loaded->Clear();
  }
  mPrefs = loaded;
}

void PrefManager::SaveDialogPrefFile() const {
  const std::string folder = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(GetDialogPrefsDirectory()));
  std::error_code ignored;
  std::filesystem::create_directories(folder, ignored);
  const std::string path = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(GetDialogPrefsPath()));
  tarsel::proplist::utils::SavePropList(path, *mPrefs);
}

tarsel::proplist::PropListP PrefManager::WindowList(const UTF8String& inWindowID) {
  tarsel::proplist::PropListP list = mPrefs->GetSubList(inWindowID);
  return list ? list : mPrefs->NewSubList(inWindowID);
}

bool PrefManager::GetWindowPositionAndSize(const UTF8String& inWindowID, Rect& outRect) const {
  Point position, size;
  const tarsel::proplist::ConstPropListP list = mPrefs->GetSubList(inWindowID);
  if (!list || !tarsel::proplist::utils::ReadPoint32(*list, kPositionKey, position) ||
      !tarsel::proplist::utils::ReadPoint32(*list, kSizeKey, size))
    return false;
  outRect = AdjustForMonitorInfoChange(Rect(position, size.x, size.y));
  return true;
}

void PrefManager::SetWindowPositionAndSize(const UTF8String& inWindowID, const Rect& inRect) {
  SetWindowPosition(inWindowID, inRect.Origin());
  SetWindowSize(inWindowID, Point(inRect.width, inRect.height));
}

bool PrefManager::GetWindowPosition(const UTF8String& inWindowID, Point& outPosition) const {
  Point position, size(1, 1);
  const tarsel::proplist::ConstPropListP list = mPrefs->GetSubList(inWindowID);
  if (!list || !tarsel::proplist::utils::ReadPoint32(*list, kPositionKey, position)) return false;
  tarsel::proplist::utils::ReadPoint32(*list, kSizeKey, size);
  outPosition = AdjustForMonitorInfoChange(Rect(position, std::max(size.x, 1L), std::max(size.y, 1L))).Origin();
  return true;
}

void PrefManager::SetWindowPosition(const UTF8String& inWindowID, const Point& inPosition) {
  tarsel::proplist::utils::WritePoint32(*WindowList(inWindowID), kPositionKey, inPosition);
}

bool PrefManager::GetWindowSize(const UTF8String& inWindowID, Point& outSize) const {
  const tarsel::proplist::ConstPropListP list = mPrefs->GetSubList(inWindowID);
  return list && tarsel::proplist::utils::ReadPoint32(*list, kSizeKey, outSize);
}

void PrefManager::SetWindowSize(const UTF8String& inWindowID, const Point& inSize) {
  tarsel::proplist::utils::WritePoint32(*WindowList(inWindowID), kSizeKey, inSize);
}

PrefManager::Rect PrefManager::AdjustForMonitorInfoChange(const Rect& inRect) const {
  const OS_MonitorInfo monitors;
  // The top corners carry the frame that the user takes hold of.
  const Point corners[] = {inRect.Origin(), Point(inRect.Right() - 1, inRect.top)};
  bool held = monitors.IsRectVisible(inRect);
  for (const Point& corner : corners) held = held && OnSomeMonitor(monitors, corner);
  if (held) return inRect;
  Rect primary;
  monitors.GetMonitorRect(0, primary);
  Rect result = inRect;
  result.width = std::min(std::max(result.width, 1L), primary.width);
  result.height = std::min(std::max(result.height, 1L), primary.height);
  result.left = primary.left + (primary.width - result.width) / 2;
  result.top = primary.top + (primary.height - result.height) / 2;
  return result;
}

}  // namespace norvik::utility
