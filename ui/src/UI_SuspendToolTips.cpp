#include "ui/UI_SuspendToolTips.h"

#include "ui/UI_ToolTipManager.h"

namespace norvik::ui {

int UI_SuspendToolTips::sSuspendCount = 0;

UI_SuspendToolTips::UI_SuspendToolTips(UI_ToolTipManager* inManager) {
  if (inManager) inManager->DisposeToolTip();
  ++sSuspendCount;
}

UI_SuspendToolTips::~UI_SuspendToolTips() { --sSuspendCount; }

}  // namespace norvik::ui
