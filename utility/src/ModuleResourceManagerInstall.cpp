// Installs the maker of the library's own resource manager into ui when the
// library is loaded, so that every OS_NodeManager reads the toolkit's
// pictures and shows its cursors.
#include "ui/ModuleResourceManager.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {

namespace {
std::unique_ptr<ui::ResourceManager> MakeLibraryResourceManager() {
  return std::make_unique<OS_ResourceManager>(tarsel::resources::kThisModule);
}

[[maybe_unused]] const ui::ResourceManagerMaker sPreviousMaker =
    ui::InstallModuleResourceManagerMaker(&MakeLibraryResourceManager);
}  // namespace

}  // namespace norvik::utility
