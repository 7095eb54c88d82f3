#pragma once
// A gesture (dragging a thumb, scrubbing a number, resizing a column) is an
// object derived from InputCapture that a control hands to the manager. From
// BeginInputCapture until the capture ends, it receives every mouse, cursor,
// keyboard and timer event, wherever the pointer is, and the node tree sees
// none of them. A gesture ends by itself when the button that started it
// comes up, on Escape, when another gesture begins, or when the platform
// takes the mouse capture away.
//
// The manager starts and ends a capture through InvokeBegin and InvokeEnd;
// End runs exactly once for a capture that began, and the manager has already
// forgotten the capture when it runs.
#include <memory>

#include <boost/intrusive_ptr.hpp>

#include "tarsel/Flags.h"
#include "tarsel/PointT.h"
#include "tarsel/RefCountedObject.h"
#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"

namespace norvik::ui {

class UI_Node;
class UI_SuspendToolTips;

class InputCapture : public tarsel::utility::RefCountedObject {
 public:
  InputCapture(boost::intrusive_ptr<UI_Node> inNode, const MouseEvent& inInitialEvent);
  // Releases the platform's mouse capture if it is still held.
  ~InputCapture() override;
  InputCapture(const InputCapture&) = delete;
  InputCapture& operator=(const InputCapture&) = delete;

  virtual void Begin() {}
  // The gesture ends; HasBeenCancelled tells how.
  virtual void End() {}
  // inEvent's position is in the capture node's coordinates. Answers whether
  // the capture used the event; an unused release of the starting button
  // ends the gesture.
  virtual bool DoMouseEvent(const MouseEvent& /*inEvent*/) { return false; }
  // An unused Escape without modifiers cancels the gesture.
  virtual bool DoKeyboardEvent(const KeyboardEvent& /*inEvent*/) { return false; }
  // False leaves the platform's default cursor.
  virtual bool DoCursor(const tarsel::geom::PointT<float>& /*inPoint*/,
                        tarsel::utility::Flags<unsigned char> /*inModKeys*/) {
    return false;
  }
  virtual bool DoTimerNotify(long /*inTimerID*/) { return false; }

  // Marks the capture cancelled: the manager keeps it, but no longer treats it
  // as active, so events go to the tree again until it is ended.
  void Cancel() { mCancelled = true; }
  bool HasBeenCancelled() const { return mCancelled; }
  UI_Node* GetNode() const { return mNode.get(); }
  const MouseEvent& GetInitialMouseEvent() const { return mInitialMouseEvent; }
  // The last event delivered other than a mouse-over update.
  const MouseEvent& GetPreviousMouseEvent() const { return mPreviousMouseEvent; }
  bool HasBegun() const { return mBegun; }
  bool HasEnded() const { return mEnded; }

  // Used by the manager only.
  void InvokeBegin();
  void InvokeEnd(bool inCancelled);

 private:
  friend class UI_Node;  // captured dispatch keeps mPreviousMouseEvent

  bool mCancelled = false;
  bool mBegun = false;
  bool mEnded = false;
  bool mSetCapture = false;
  MouseEvent mInitialMouseEvent;
  MouseEvent mPreviousMouseEvent;
  boost::intrusive_ptr<UI_Node> mNode;
  std::unique_ptr<UI_SuspendToolTips> mSuspendToolTips;
};

using InputCaptureP = boost::intrusive_ptr<InputCapture>;

}  // namespace norvik::ui
