// A native control hosted in a view tree: shown only while every view above
// it is shown, and clipped by the views it sits in.
#include <gtest/gtest.h>

#include "support/ui/NativeWindowTestSupport.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_OSSubViewAdapter.h"

namespace norvik::ui::test {
namespace {

using OSSubViewAdapterTest = NativeWindowTest;


TEST_F(OSSubViewAdapterTest, AControlUnderAHiddenParentIsHiddenAndShowsAgainWithIt) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 300, 300));
  auto parent = AddView(window.get(), "parent", 20, 20, 200, 200);
  UI_OSSubViewAdapterP adapter(new UI_OSSubViewAdapter);
  adapter->UI_SetLocalRectF(UI_Node::RectF(10, 10, 80, 30));
  adapter->UI_Show(true);
  parent->ChildPushBack(adapter);
  OS_WindowP control(new OS_ViewContainer(false));
  adapter->SetOSView(control);
  ASSERT_TRUE(adapter->IsOSChildViewValid());
  ASSERT_EQ(adapter->GetOSView(), control.get());
  EXPECT_TRUE(mLayer.IsWindowVisible(control->GetHandle()));

  parent->UI_Show(false);
  EXPECT_FALSE(mLayer.IsWindowVisible(control->GetHandle()));
  parent->UI_Show(true);
  EXPECT_TRUE(mLayer.IsWindowVisible(control->GetHandle()));
  adapter->UI_Show(false);
  EXPECT_FALSE(mLayer.IsWindowVisible(control->GetHandle()));
}

TEST_F(OSSubViewAdapterTest, TheControlSitsOverItsAdapterOnTheScreen) {
  auto window = MakeTopLevel(OS_Rect(100, 100, 300, 300));
  auto parent = AddView(window.get(), "parent", 20, 20, 200, 200);
  UI_OSSubViewAdapterP adapter(new UI_OSSubViewAdapter);
  adapter->UI_SetLocalRectF(UI_Node::RectF(10, 10, 80, 30));
  adapter->UI_Show(true);
  parent->ChildPushBack(adapter);
  OS_WindowP control(new OS_ViewContainer(false));
  adapter->SetOSView(control);
  EXPECT_EQ(mLayer.GetWindowRect(control->GetHandle()), OS_Rect(130, 130, 80, 30));
}

TEST_F(OSSubViewAdapterTest, AControlPartlyOutsideItsParentIsClippedButStaysInPlace) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 300, 300));
  auto parent = AddView(window.get(), "parent", 20, 20, 100, 100);
  UI_OSSubViewAdapterP adapter(new UI_OSSubViewAdapter);
  adapter->UI_SetLocalRectF(UI_Node::RectF(-10, 50, 80, 30));
  adapter->UI_Show(true);
  parent->ChildPushBack(adapter);
  OS_WindowP control(new OS_ViewContainer(false));
  adapter->SetOSView(control);
  // The container shows only the part inside the parent...
  EXPECT_EQ(mLayer.GetWindowRect(adapter->GetOSViewContainer()->GetHandle()), OS_Rect(20, 70, 70, 30));
  // ...and the control keeps its full size at its place on the screen.
  EXPECT_EQ(mLayer.GetWindowRect(control->GetHandle()), OS_Rect(10, 70, 80, 30));
}

TEST_F(OSSubViewAdapterTest, AnAdapterWithoutAChainAnswersNoControl) {
  UI_OSSubViewAdapterP adapter(new UI_OSSubViewAdapter);
  EXPECT_FALSE(adapter->HasOSChildView());
  EXPECT_FALSE(adapter->IsOSChildViewValid());
  EXPECT_EQ(adapter->GetOSView(), nullptr);
  // A first child of the wrong class is a broken chain, reported as such.
  adapter->ChildPushBack(new OS_ViewContainer(false));
  EXPECT_THROW(adapter->GetTransformContainer(), tarsel::config::Exception);
}

}  // namespace
}  // namespace norvik::ui::test
