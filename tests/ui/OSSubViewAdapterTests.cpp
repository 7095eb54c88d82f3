// A native control hosted in a view tree: shown only while every view above
// it is shown, and clipped by the views it sits in.
#include <gtest/gtest.h>

#include "support/ui/NativeWindowTestSupport.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_OSSubViewAdapter.h"

namespace norvik::ui::test {
namespace {

// A top-level window with a "parent" view at (20, 20) and, in it, an adapter
// at inAdapterRect hosting a native control.
class OSSubViewAdapterTest : public NativeWindowTest {
 protected:
  void Host(const OS_Rect& inWindowRect, float inParentSize, const UI_Node::RectF& inAdapterRect) {
    window = MakeTopLevel(inWindowRect);
    parent = AddView(window.get(), "parent", 20, 20, inParentSize, inParentSize);
    adapter = new UI_OSSubViewAdapter;
    adapter->UI_SetLocalRectF(inAdapterRect);
    adapter->UI_Show(true);
    parent->ChildPushBack(adapter);
    control = new OS_ViewContainer(false);
    adapter->SetOSView(control);
  }
  bool ControlVisible() { return mLayer.IsWindowVisible(control->GetHandle()); }

  OS_TopLevelViewContainerP window;
  InputRecorderViewP parent;
  UI_OSSubViewAdapterP adapter;
  OS_WindowP control;
};

TEST_F(OSSubViewAdapterTest, AControlUnderAHiddenParentIsHiddenAndShowsAgainWithIt) {
  Host(OS_Rect(0, 0, 300, 300), 200, UI_Node::RectF(10, 10, 80, 30));
  ASSERT_TRUE(adapter->IsOSChildViewValid());
  ASSERT_EQ(adapter->GetOSView(), control.get());
  EXPECT_TRUE(ControlVisible());

  parent->UI_Show(false);
  EXPECT_FALSE(ControlVisible());
  parent->UI_Show(true);
  EXPECT_TRUE(ControlVisible());
  adapter->UI_Show(false);
  EXPECT_FALSE(ControlVisible());
}

TEST_F(OSSubViewAdapterTest, TheControlSitsOverItsAdapterOnTheScreen) {
  Host(OS_Rect(100, 100, 300, 300), 200, UI_Node::RectF(10, 10, 80, 30));
  EXPECT_EQ(mLayer.GetWindowRect(control->GetHandle()), OS_Rect(130, 130, 80, 30));
}

TEST_F(OSSubViewAdapterTest, AControlPartlyOutsideItsParentIsClippedButStaysInPlace) {
  Host(OS_Rect(0, 0, 300, 300), 100, UI_Node::RectF(-10, 50, 80, 30));
  // The container shows only the part inside the parent...
  EXPECT_EQ(mLayer.GetWindowRect(adapter->GetOSViewContainer()->GetHandle()), OS_Rect(20, 70, 70, 30));
  // ...and the control keeps its full size at its place on the screen.
  EXPECT_EQ(mLayer.GetWindowRect(control->GetHandle()), OS_Rect(10, 70, 80, 30));
}

TEST_F(OSSubViewAdapterTest, AnAdapterWithoutAChainAnswersNoControl) {
  adapter = new UI_OSSubViewAdapter;
  EXPECT_FALSE(adapter->HasOSChildView());
  EXPECT_FALSE(adapter->IsOSChildViewValid());
  EXPECT_EQ(adapter->GetOSView(), nullptr);
  // A first child of the wrong class is a broken chain, reported as such.
  adapter->ChildPushBack(new OS_ViewContainer(false));
  EXPECT_THROW(adapter->GetTransformContainer(), tarsel::config::Exception);
}

}  // namespace
}  // namespace norvik::ui::test
