#pragma once
// The resource manager over the library's own resources, made on request.
//
// Reading the library's resource table and making its cursors is the work of
// the utility layer, which sits above ui. That layer installs its maker here
// when the library is loaded (a static registration in its own objects), so
// that ui can build a resource manager without naming anything above it. A
// program linked from ui and the layers below only has no maker, and
// NewModuleResourceManager answers null there.
#include <memory>

#include "ui/ResourceManager.h"

namespace norvik::ui {

using ResourceManagerMaker = std::unique_ptr<ResourceManager> (*)();

// Installs inMaker (null removes it) and answers the one it replaces.
ResourceManagerMaker InstallModuleResourceManagerMaker(ResourceManagerMaker inMaker);

// A new resource manager over the library's own module, or null when no maker
// is installed.
std::unique_ptr<ResourceManager> NewModuleResourceManager();

}  // namespace norvik::ui
