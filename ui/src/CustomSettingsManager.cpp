#include "ui/CustomSettingsManager.h"

namespace norvik::ui {

CustomSettingsManager::CustomSettingsManager() { CustomSettingsManager::Reload(); }

CustomSettingsManager::~CustomSettingsManager() = default;

void CustomSettingsManager::Reload() {
  mTable.clear();
  mTable["norvik.controls.UI_Button.LoseFocusOnESC"] = true;
  mTable["norvik.controls.UI_TextEdit.LoseFocusOnPreMouse"] = true;
  mTable["norvik.controls.UI_HotTextNumber.ShowBlankEditFieldsForHotNumbersWithunknownState"] = false;
  mTable["norvik.controls.UI_SliderGap"] = false;
  mTable["norvik.controls.UI_SliderCenterTick_Height"] = 12L;
  mTable["norvik.controls.UI_SliderCenterTick_Gap"] = 0L;
  mTable["norvik.controls.UI_SliderCenterTick_Color"] = false;
  // "norvik.controls.UI_Popup.KeyboardSearchableWhenNotEditable",
  // "norvik.ui.windows.ShowCloseBoxOnModalDialogs",
  // "norvik.ui.windows.ShowMaximizeBoxOnModalDialogs" and
  // "norvik.utils.FontDependentBaselines" have no toolkit default: their
  // readers pass their own fallback.
}

std::optional<CustomSettingsManager::Value> CustomSettingsManager::Find(std::string_view inKey) const {
  auto it = mTable.find(inKey);
  if (it == mTable.end()) return std::nullopt;
  return it->second;
}

void CustomSettingsManager::Set(std::string_view inKey, Value inValue) {
  mTable.insert_or_assign(std::string(inKey), std::move(inValue));
}

bool CustomSettingsManager::GetBool(std::string_view inKey, bool inFallback) const {
  auto v = Find(inKey);
  if (v && std::holds_alternative<bool>(*v)) return std::get<bool>(*v);
  return inFallback;
}

long CustomSettingsManager::GetLong(std::string_view inKey, long inFallback) const {
  auto v = Find(inKey);
  if (!v) return inFallback;
  if (std::holds_alternative<long>(*v)) return std::get<long>(*v);
  if (std::holds_alternative<double>(*v)) return static_cast<long>(std::get<double>(*v));
  return inFallback;
}

double CustomSettingsManager::GetDouble(std::string_view inKey, double inFallback) const {
  auto v = Find(inKey);
  if (!v) return inFallback;
  if (std::holds_alternative<double>(*v)) return std::get<double>(*v);
  if (std::holds_alternative<long>(*v)) return static_cast<double>(std::get<long>(*v));
  return inFallback;
}

std::string CustomSettingsManager::GetString(std::string_view inKey, const std::string& inFallback) const {
  auto v = Find(inKey);
  if (v && std::holds_alternative<std::string>(*v)) return std::get<std::string>(*v);
  return inFallback;
}

}  // namespace norvik::ui
