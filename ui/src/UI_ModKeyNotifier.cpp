#include "ui/UI_ModKeyNotifier.h"

#include <boost/make_shared.hpp>

#include "ui/InputPlatform.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

UI_ModKeyNotifier::UI_ModKeyNotifier()
    : mAppChangedFunction(boost::make_shared<void (*)(bool)>(&UI_ModKeyNotifier::AppChanged)) {
  SubscribeToApplicationActivation();
}

UI_ModKeyNotifier& UI_ModKeyNotifier::Get() {
  static UI_ModKeyNotifier sNotifier;
  sNotifier.SubscribeToApplicationActivation();
  return sNotifier;
}

const UI_ModKeyNotifier& UI_ModKeyNotifier::GetConst() { return Get(); }

// Managers come and go (a test makes one per case); the notifier follows the
// current one. The manager holds a copy of the subscription for as long as it
// lives, so a count of one means that no manager has it.
void UI_ModKeyNotifier::SubscribeToApplicationActivation() {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (manager && mAppChangedFunction.use_count() == 1)
    manager->InstallApplicationActivationChangedFunction(mAppChangedFunction);
}

void UI_ModKeyNotifier::InstallModKeyChangedFunction(const ModKeyChangedFunction& inFunction) {
  mFunctions.push_back(inFunction);
}

void UI_ModKeyNotifier::DispatchModKeyEvent(ModifierKeys inModKeys) {
  if (inModKeys == mModKeys) return;
  UI_FireCallbackList(mFunctions, inModKeys);
  mModKeys = inModKeys;
}

void UI_ModKeyNotifier::AppChanged(bool inFrontmost) {
  if (inFrontmost) Get().DispatchModKeyEvent(utility::GetCurrentModKeys());
}

}  // namespace norvik::ui
