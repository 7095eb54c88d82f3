#pragma once
// The messages that controls send to their listeners. Two families: those
// whose subject may be changed by the listener (UI_ControlMessage) and those
// that only look at it (UI_ConstControlMessage). The control is found from
// the message's node by a dynamic cast, so a message built for a plain node
// has a null control.
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "tarsel/Flags.h"
#include "ui/MessageT.h"
#include "ui/MouseEvent.h"

namespace norvik::drawbot {
class ImageInterface;
}

namespace norvik::controls {

class UI_ControlView;
using ModKeys = tarsel::utility::Flags<unsigned char>;

class UI_ControlMessage : public ui::MessageT<ui::UI_Node> {
 public:
  explicit UI_ControlMessage(ui::UI_Node* inNode);
  UI_ControlView* GetControl() const { return mControl; }
  // Also makes the control the message's subject, so that a composite can
  // pass a child's message on as its own.
  void SetControl(UI_ControlView* inControl);

 private:
  UI_ControlView* mControl;
};

class UI_ConstControlMessage : public ui::MessageT<const ui::UI_Node> {
 public:
  explicit UI_ConstControlMessage(const ui::UI_Node* inNode);
  const UI_ControlView* GetControl() const { return mControl; }

 private:
  const UI_ControlView* mControl;
};

class UI_ControlChangedMessage : public UI_ControlMessage {
 public:
  using UI_ControlMessage::UI_ControlMessage;
};

class UI_ButtonChangedMessage : public UI_ControlChangedMessage {
 public:
  UI_ButtonChangedMessage(ui::UI_Node* inNode, ModKeys inModKeys)
      : UI_ControlChangedMessage(inNode), mModKeys(inModKeys) {}
  ModKeys GetModKeys() const { return mModKeys; }

 private:
  ModKeys mModKeys;
};

class UI_InteractiveControlChangedMessage : public UI_ControlMessage {
 public:
  enum ChangeMessage { kBegin = 0, kContinue = 1, kFinish = 2, kCancel = 3 };

  UI_InteractiveControlChangedMessage(ui::UI_Node* inNode, ChangeMessage inChange, ModKeys inModKeys)
      : UI_ControlMessage(inNode), mChange(inChange), mModKeys(inModKeys) {}
  ChangeMessage GetChangeMessage() const { return mChange; }
  ModKeys GetModKeys() const { return mModKeys; }

 private:
  ChangeMessage mChange;
  ModKeys mModKeys;
};

class UI_HoverMessage : public UI_ControlMessage {
 public:
  UI_HoverMessage(ui::UI_Node* inNode, const ui::MouseEvent& inEvent)
      : UI_ControlMessage(inNode), mEvent(inEvent) {}
  const ui::MouseEvent& GetMouseEvent() const { return mEvent; }
  bool IsAction(ui::MouseEvent::Action inAction) const { return mEvent.IsAction(inAction); }

 private:
  ui::MouseEvent mEvent;
};

// Sent by a picture control to the one listener that supplies its image:
// the listener reads the state and keys and answers with SetImage.
class UI_PictureSupplyMessage : public UI_ConstControlMessage {
 public:
  UI_PictureSupplyMessage(const ui::UI_Node* inNode, ModKeys inModKeys)
      : UI_ConstControlMessage(inNode), mModKeys(inModKeys) {}
  tarsel::utility::Flags<unsigned long> GetStateFlags() const { return mStateFlags; }
  void SetStateFlags(tarsel::utility::Flags<unsigned long> inFlags) { mStateFlags = inFlags; }
  ModKeys GetModKeys() const { return mModKeys; }
  const drawbot::ImageInterface* GetImage() const { return mImage; }
  void SetImage(const drawbot::ImageInterface* inImage) { mImage = inImage; }

 private:
  tarsel::utility::Flags<unsigned long> mStateFlags;
  ModKeys mModKeys;
  const drawbot::ImageInterface* mImage = nullptr;
};

using ControlChangedFunction = boost::function<void(UI_ControlChangedMessage*)>;
using ControlChangedFunctionP = boost::shared_ptr<ControlChangedFunction>;
using HoverFunction = boost::function<void(UI_HoverMessage*)>;
using HoverFunctionP = boost::shared_ptr<HoverFunction>;
using InteractiveFunction = boost::function<void(UI_InteractiveControlChangedMessage*)>;
using InteractiveFunctionP = boost::shared_ptr<InteractiveFunction>;

}  // namespace norvik::controls
