#pragma once
// UI_NodeBase joins the three roots of every node: the shared reference count,
// the child container and the theme client, in that order.
#include "tarsel/RefCountedObject.h"
#include "ui/ThemeClient.h"
#include "ui/UI_Container.h"

namespace norvik::ui {

class UI_NodeBase : public tarsel::utility::RefCountedObject, public UI_Container, public ThemeClient {
 public:
  ~UI_NodeBase() override = default;
};

}  // namespace norvik::ui
