// KeyFocusLock: focus comes back to the node that had it when the lock was
// taken, as a restore, whatever happened in between.
#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "ui/UI_NodeManager.h"
#include "utility/KeyFocusLock.h"

namespace norvik::utility {
namespace {

using ui::test::AddView;
using ui::test::FocusLeafID;
using ui::test::FocusLog;

class KeyFocusLockTest : public ::testing::Test {
 protected:
  KeyFocusLockTest() : mWindow(new ui::test::TestWindowNode) {
    mA = AddView(*mWindow, "a", &mLog);
    mB = AddView(*mWindow, "b", &mLog);
  }

  ui::UI_NodeManager mManager;
  FocusLog mLog;
  boost::intrusive_ptr<ui::test::TestWindowNode> mWindow;
  ui::test::FocusableViewP mA;
  ui::test::FocusableViewP mB;
};

TEST_F(KeyFocusLockTest, FocusMovedInsideTheLockComesBackAsARestoreAndWithoutFocusAtTheStartNothingComesBack) {
  {
    KeyFocusLock lock;
    EXPECT_EQ(lock.GetLockedNode(), nullptr);
    mB->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  }
  EXPECT_EQ(FocusLeafID(), "b");
  mA->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  {
    KeyFocusLock lock;
    EXPECT_EQ(lock.GetLockedNode(), mA.get());
    mB->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
    ASSERT_EQ(FocusLeafID(), "b");
    mLog.clear();
  }
  EXPECT_EQ(FocusLeafID(), "a");
  EXPECT_TRUE(mA->UI_HasKeyboardFocus(true));
  EXPECT_EQ(mLog, (FocusLog{{"b", ui::kFocusChangeRestore, false}, {"a", ui::kFocusChangeRestore, true}}));
}

TEST_F(KeyFocusLockTest, ANodeMovedToAnotherWindowStillTakesFocusBack) {
  boost::intrusive_ptr<ui::test::TestWindowNode> other(new ui::test::TestWindowNode);
  mA->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  {
    KeyFocusLock lock;
    ui::UI_NodeP keep = mWindow->ChildRemove(mA.get());
    ASSERT_EQ(FocusLeafID(), "window") << "removal hands focus to the old window";
    other->ChildPushBack(keep);
  }
  EXPECT_EQ(FocusLeafID(), "a");
}

}  // namespace
}  // namespace norvik::utility
