#pragma once
// The manager the application creates. It adds the platform's construction:
// the platform layer fills the manager's seams (tool tips, resources, image
// cache, drawing supplier) through the setters of UI_NodeManager. Built with
// no platform, it is a fully working portable manager.
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

class OS_NodeManager : public UI_NodeManager {
 public:
  OS_NodeManager() = default;
  ~OS_NodeManager() override = default;
};

}  // namespace norvik::ui
