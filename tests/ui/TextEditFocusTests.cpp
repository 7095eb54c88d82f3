// Whether focus sits inside a hosted text field: the walk starts at the
// parent of the focus leaf and asks the registered recognition test.
#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {
namespace {

// Stands for a native text field's container in these tests.
class FakeTextField : public test::FocusableView {};

bool IsFakeTextField(const UI_Node* inNode) { return dynamic_cast<const FakeTextField*>(inNode) != nullptr; }

class TextEditFocusTest : public ::testing::Test {
 protected:
  TextEditFocusTest() : mWindow(new test::TestWindowNode), mField(new FakeTextField),
                        mInner(new test::FocusableView), mPlain(new test::FocusableView) {
    mWindow->ChildPushBack(mField);
    mField->ChildPushBack(mInner);
    mWindow->ChildPushBack(mPlain);
    UI_Node::SetTextEditControlTest(&IsFakeTextField);
  }
  ~TextEditFocusTest() override { UI_Node::SetTextEditControlTest(nullptr); }

  UI_NodeManager mManager;
  boost::intrusive_ptr<test::TestWindowNode> mWindow;
  boost::intrusive_ptr<FakeTextField> mField;
  boost::intrusive_ptr<test::FocusableView> mInner;
  boost::intrusive_ptr<test::FocusableView> mPlain;
};

TEST_F(TextEditFocusTest, OnlyFocusBelowARegisteredTextFieldCounts) {
  ASSERT_TRUE(mInner->UI_GainKeyboardFocus(kFocusChangeMouse));
  EXPECT_TRUE(UI_Node::UI_TextEditControlHasFocus());
  ASSERT_TRUE(mPlain->UI_GainKeyboardFocus(kFocusChangeMouse));
  EXPECT_FALSE(UI_Node::UI_TextEditControlHasFocus()) << "outside any text field";
  ASSERT_TRUE(mField->UI_GainKeyboardFocus(kFocusChangeMouse));
  EXPECT_FALSE(UI_Node::UI_TextEditControlHasFocus()) << "the focus leaf itself is not tested";
  ASSERT_TRUE(mInner->UI_GainKeyboardFocus(kFocusChangeMouse));
  UI_Node::SetTextEditControlTest(nullptr);
  EXPECT_FALSE(UI_Node::UI_TextEditControlHasFocus()) << "no registered test";
}

}  // namespace
}  // namespace norvik::ui
