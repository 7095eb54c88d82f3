#pragma once
// Puts keyboard focus back where it was when the lock was taken. Wrap work
// that may move focus as a side effect (rebuilding a panel, showing and
// hiding views) in a KeyFocusLock, and the node that had focus gets it back,
// as a restore, when the lock goes out of scope.
#include <boost/core/noncopyable.hpp>
#include <boost/intrusive_ptr.hpp>

namespace norvik::ui {
class UI_Node;
}

namespace norvik::utility {

class KeyFocusLock : private boost::noncopyable {
 public:
  KeyFocusLock();
  ~KeyFocusLock();

  // The node that will get focus back, or null when nothing had focus.
  ui::UI_Node* GetLockedNode() const { return mNode.get(); }

 private:
  // Held strongly: the node may leave the tree while the lock is alive. It
  // is asked to take focus back wherever it now stands; whether it can is
  // its own answer.
  boost::intrusive_ptr<ui::UI_Node> mNode;
};

}  // namespace norvik::utility
