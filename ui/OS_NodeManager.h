#pragma once
// The manager the application creates, once, on its main thread. It comes
// wired with the platform's construction, in this order:
//   1. the resource manager over the library's own resources, from the maker
//      that the utility layer installs (see ModuleResourceManager.h: the
//      resource reader and the cursors live above ui, so ui asks for it
//      through that registration rather than naming the class; a program
//      linked without the utility layer gets no resource manager);
//   2. the image cache, which decodes each named picture once per supplier;
//   3. the platform's drawing supplier. It is the process's one supplier,
//      owned by the back end: the manager holds a reference to it, and
//      dropping the manager never destroys it.
// Every part can still be replaced or removed through the setters of
// UI_NodeManager.
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

class OS_NodeManager : public UI_NodeManager {
 public:
  OS_NodeManager();
  ~OS_NodeManager() override = default;

  // The pointer as the native layer reports it now.
  tarsel::geom::PointT<long> GetGlobalMousePosition() const override;
};

}  // namespace norvik::ui
