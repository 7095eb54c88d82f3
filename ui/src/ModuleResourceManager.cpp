#include "ui/ModuleResourceManager.h"

namespace norvik::ui {

namespace {
// Constant-initialised, so a registration from another object's static
// initialiser finds it ready whatever the order of initialisation.
ResourceManagerMaker gMaker = nullptr;
}  // namespace

ResourceManagerMaker InstallModuleResourceManagerMaker(ResourceManagerMaker inMaker) {
  ResourceManagerMaker previous = gMaker;
  gMaker = inMaker;
  return previous;
}

std::unique_ptr<ResourceManager> NewModuleResourceManager() { return gMaker ? gMaker() : nullptr; }

}  // namespace norvik::ui
