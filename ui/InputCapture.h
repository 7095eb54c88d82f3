#pragma once
// An input capture takes the mouse and keyboard first while a gesture runs
// (a button press, a slider drag). The manager holds the active one and starts
// and ends it through InvokeBegin and InvokeEnd. The node, the events and the
// platform capture of a gesture are added by the capture work on top of this.
#include <boost/intrusive_ptr.hpp>

#include "tarsel/RefCountedObject.h"

namespace norvik::ui {

class InputCapture : public tarsel::utility::RefCountedObject {
 public:
  ~InputCapture() override = default;

  virtual void Begin() {}
  // The gesture ends; HasBeenCancelled tells how.
  virtual void End() {}

  void Cancel() { mCancelled = true; }
  bool HasBeenCancelled() const { return mCancelled; }

  // Used by the manager only.
  void InvokeBegin() {
    mBegun = true;
    Begin();
  }
  void InvokeEnd(bool inCancelled) {
    if (inCancelled) mCancelled = true;
    if (mBegun && !mEnded) {
      mEnded = true;
      End();
    }
  }

 protected:
  bool mCancelled = false;
  bool mBegun = false;
  bool mEnded = false;
};

using InputCaptureP = boost::intrusive_ptr<InputCapture>;

}  // namespace norvik::ui
