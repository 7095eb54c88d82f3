#pragma once
// Tells interested parties when the modifier keys change: every keyboard
// event passes its modifiers through DispatchModKeyEvent, and the functions
// installed here run when they differ from the last ones seen. When the
// application comes back to the front, the keyboard's current state is
// dispatched, so that a key released in the background is noticed.
#include <vector>

#include <boost/function.hpp>
#include <boost/noncopyable.hpp>
#include <boost/shared_ptr.hpp>

#include "ui/ModifierKeys.h"

namespace norvik::ui {

class UI_ModKeyNotifier : private boost::noncopyable {
 public:
  using ModKeyChangedFunction = boost::shared_ptr<boost::function<void(ModifierKeys)>>;

  // The one notifier, built at first use. Each call also makes sure that the
  // current manager tells it of application activation.
  static UI_ModKeyNotifier& Get();
  static const UI_ModKeyNotifier& GetConst();

  // Appends a function of the new modifiers; a null entry is skipped.
  void InstallModKeyChangedFunction(const ModKeyChangedFunction& inFunction);
  // Calls every function in order when inModKeys differ from the stored
  // modifiers, then stores them.
  void DispatchModKeyEvent(ModifierKeys inModKeys);
  ModifierKeys GetModKeys() const { return mModKeys; }

  // Application activation: coming to the front dispatches the current keys.
  static void AppChanged(bool inFrontmost);

 private:
  UI_ModKeyNotifier();
  void SubscribeToApplicationActivation();

  std::vector<ModKeyChangedFunction> mFunctions;
  ModifierKeys mModKeys;
  // The subscription handed to the manager; while a manager holds it, its
  // count is above one.
  boost::shared_ptr<void (*)(bool)> mAppChangedFunction;
};

}  // namespace norvik::ui
