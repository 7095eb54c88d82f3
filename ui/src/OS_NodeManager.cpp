#include "ui/OS_NodeManager.h"

#include "drawbot/SupplierInterface.h"
#include "ui/DrawbotImageResourceCache.h"
#include "ui/ModuleResourceManager.h"
#include "ui/OS_Window.h"

namespace norvik::ui {

namespace {
// The platform supplier shared without ownership: the deleter only carries a
// counted reference, released when the last holder lets go.
std::shared_ptr<drawbot::SupplierInterface> SharePlatformSupplier() {
  drawbot::SupplierInterfaceP held(drawbot::NewOSSupplier());
  return std::shared_ptr<drawbot::SupplierInterface>(held.get(), [held](drawbot::SupplierInterface*) {});
}
}  // namespace

OS_NodeManager::OS_NodeManager() {
  SetResourceManager(NewModuleResourceManager());
  SetDrawbotImageResourceCache(std::make_unique<DrawbotImageResourceCache>());
  SetOSDrawSupplier(SharePlatformSupplier());
  // What the desktop says at start; changes come later as setting-change messages.
  GetCustomSettingsManager()->ReloadOSPreferences();
}

tarsel::geom::PointT<long> OS_NodeManager::GetGlobalMousePosition() const {
  return OS_Window::GetGlobalMousePosition();
}

}  // namespace norvik::ui
