#include "utility/OS_ResourceManager.h"

#include <string>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "tarsel/ThrowError.h"
#include "ui/OS_WindowConstants.h"
#include "utility/CursorUtils.h"

namespace norvik::utility {

namespace {

std::string ToNarrow(UTF16String const& inText) { return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inText)); }

}  // namespace

OS_ResourceManager::OS_ResourceManager(tarsel::resources::ModuleHandle inModule) : mModule(inModule) {}

OS_ResourceManager::OS_ResourceManager(OS_ResourceManager const& inOther) : mModule(inOther.mModule) {
  for (auto const& [id, info] : inOther.mCursors) {
    BigCursorInfo copy = info;
    copy.loaded = false;
    copy.cursor = 0;
    mCursors.emplace(id, copy);
  }
}

OS_ResourceManager::~OS_ResourceManager() {
  for (auto const& entry : mCursors) utility::DisposeCursor(entry.second.cursor);
}

void OS_ResourceManager::GetBinary(UTF16String const& inName, UTF16String const& inType,
                                   std::vector<char>* outBuffer) const {
  std::vector<unsigned char> bytes;
  if (!tarsel::resources::GetBinaryFromModule(mModule, ToNarrow(inName), ToNarrow(inType), bytes)) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/utility/Error/ResourceUtils/UnableToAccessResourceDetailed="
                               "Unable to access resource '^1' (type ^2)",
                               0, 0, false, {}, inName, inType);
  }
  if (outBuffer) outBuffer->assign(bytes.begin(), bytes.end());
}

bool OS_ResourceManager::HasBinary(UTF16String const& inName, UTF16String const& inType) const {
  return tarsel::resources::ModuleHasBinary(mModule, ToNarrow(inName), ToNarrow(inType));
}

void OS_ResourceManager::MakeCursorFromPNG(int inID, UTF16String const& inName, short inHotX, short inHotY,
                                           ui::LoadByPolicy inPolicy) const {
  BigCursorInfo& info = mCursors[inID];
  utility::DisposeCursor(info.cursor);
  info = BigCursorInfo{false, inName, inHotX, inHotY, 0, inPolicy};
}

OS_ResourceManager::BigCursorInfo const* OS_ResourceManager::FindCursorInfo(int inID) const {
  auto found = mCursors.find(inID);
  return found == mCursors.end() ? nullptr : &found->second;
}

void OS_ResourceManager::GetResourceDataNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) const {
  GetCursorResourceNames(inID, outPNGName, outDataName);
}

void OS_ResourceManager::LoadCursor(BigCursorInfo& ioInfo) const {
  drawbot::SupplierInterface* supplier = drawbot::NewOSSupplier();
  drawbot::FileImageP image;
  if (ioInfo.policy == ui::LoadByPolicy::kByPath) {
    const std::string path = ToNarrow(ioInfo.name);
    image = drawbot::FileImageP(supplier, drawbot::kImageFileTypePNG, path.c_str(), 0);
  } else {
    std::vector<char> bytes;
    GetBinary(ioInfo.name, u"png", &bytes);
    image = drawbot::FileImageP(supplier, drawbot::kImageFileTypePNG, bytes.data(),
                                static_cast<unsigned long>(bytes.size()));
  }
  ioInfo.cursor = GetCursorFromImage(image.GetPtr(), ioInfo.hotX, ioInfo.hotY);
  ioInfo.loaded = ioInfo.cursor != 0;
}

void OS_ResourceManager::LoadAndDisplayCursor(int inID, UTF16String const& inPNGName,
                                              UTF16String const& inDataName) const {
  const std::pair<short, short> hotSpot = LoadCursorHotSpot(inDataName, *this);
  BigCursorInfo info{false, inPNGName, hotSpot.first, hotSpot.second, 0, ui::LoadByPolicy::kByResource};
  LoadCursor(info);
  mCursors[inID] = info;
  if (info.loaded) utility::DisplayCursor(info.cursor);
}

bool OS_ResourceManager::LoadAndDisplayNativeCursor(int inID) const {
  UTF16String pngName, dataName;
  GetNativeCursorResourceNames(inID, pngName, dataName);
  if (!HasBinary(pngName, u"png")) return false;
  LoadAndDisplayCursor(inID, pngName, dataName);
  return true;
}

void OS_ResourceManager::DisplayCursor(int inID) const {
  ui::OS_NativeLayer* layer = ui::GetNativeLayer();
  if (!layer) return;
  if (const int system = GetSystemCursorNumber(inID)) {
    layer->SetCursor(layer->LoadSystemCursor(system));
    return;
  }
  auto found = mCursors.find(inID);
  if (found != mCursors.end()) {
    if (!found->second.loaded) LoadCursor(found->second);
    if (found->second.loaded) layer->SetCursor(found->second.cursor);
    return;
  }
  UTF16String pngName, dataName;
  GetResourceDataNames(inID, pngName, dataName);
  if (HasBinary(pngName, u"png")) {
    LoadAndDisplayCursor(inID, pngName, dataName);
    return;
  }
  if (LoadAndDisplayNativeCursor(inID)) return;
  // No picture of the toolkit's own for this number: the platform's arrow
  // is the cursor that keeps the pointer usable.
  layer->SetCursor(layer->LoadSystemCursor(ui::kOSCursorArrow));
}

void OS_ResourceManager::DisposeCursor(int inID) const {
  auto found = mCursors.find(inID);
  if (found == mCursors.end()) return;
  utility::DisposeCursor(found->second.cursor);
  found->second.cursor = 0;
  found->second.loaded = false;
}

}  // namespace norvik::utility
