// Tool tips and labels that change with the modifier keys. The keys come
// from real keyboard events: the keyboard dispatch hands every event's
// modifiers to the process's modifier key notifier, which tells the buttons.
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "controls/UI_TextButton.h"
#include "support/controls/ControlTestSupport.h"
#include "support/ui/KeyCodes.h"
#include "ui/UI_ModKeyNotifier.h"

namespace norvik::controls::test {
namespace {

namespace keys = ui::test::keys;

class ModifiedToolTipTest : public ControlTest {
 protected:
  ModifiedToolTipTest() {
    // The notifier lives for the whole process; each test starts with no key held.
    ui::UI_ModKeyNotifier::Get().DispatchModKeyEvent(ModKeys());
    button = Add(new UI_TextButton(u"Render"), RectF(10, 10, 80, 20));
    button->InsertModifiedToolTip(ModKeys(), u"Render the sequence");
    button->InsertModifiedToolTip(ModKeys(ui::kModKeyShift), u"Render all sequences");
    button->InsertModifiedToolTip(ModKeys(ui::kModKeyAlt), u"Render in the background");
  }
  ~ModifiedToolTipTest() override { ui::UI_ModKeyNotifier::Get().DispatchModKeyEvent(ModKeys()); }

  // A key going down or up with inHeld as the modifiers held afterwards.
  void Hold(short inKey, unsigned char inHeld) { KeyDown(root.get(), inKey, 0, ModKeys(inHeld)); }
  void Release(short inKey, unsigned char inHeld) { KeyUp(root.get(), inKey, 0, ModKeys(inHeld)); }

  UI_TextButtonP button;
};

TEST_F(ModifiedToolTipTest, HoldingAModifierShowsItsToolTipAndReleasingItTheBaseOne) {
  Hold(keys::kShift, ui::kModKeyShift);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render all sequences");
  EXPECT_EQ(button->UI_GetToolTipWidth(), 400);
  Release(keys::kShift, 0);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render the sequence");
  Hold(keys::kAlt, ui::kModKeyAlt);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render in the background");
}

TEST_F(ModifiedToolTipTest, ACombinationWithoutItsOwnEntryShowsTheBaseToolTip) {
  Hold(keys::kShift, ui::kModKeyShift);
  Hold(keys::kAlt, ui::kModKeyShift | ui::kModKeyAlt);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render the sequence");
}

TEST_F(ModifiedToolTipTest, ATextButtonSwapsItsLabelAmongItsModifiedNames) {
  button->InsertModifiedName(ModKeys(ui::kModKeyShift), u"Render All");
  button->InsertModifiedName(ModKeys(ui::kModKeyAlt), u"Render Later");
  Hold(keys::kShift, ui::kModKeyShift);
  EXPECT_EQ(button->GetText(), u"Render All");
  Release(keys::kShift, 0);
  EXPECT_EQ(button->GetText(), u"Render");
  Hold(keys::kAlt, ui::kModKeyAlt | ui::kModKeyCapsLock);
  EXPECT_EQ(button->GetText(), u"Render Later") << "Caps Lock is no modifier of the names";
}

TEST_F(ModifiedToolTipTest, ADeletedButtonIsNoLongerToldAndTheOthersStillAre) {
  std::vector<unsigned char> heard;
  auto listener = boost::make_shared<boost::function<void(ui::ModifierKeys)>>(
      [&heard](ui::ModifierKeys inKeys) { heard.push_back(inKeys.Get()); });
  ui::UI_ModKeyNotifier::Get().InstallModKeyChangedFunction(listener);
  root->ChildRemove(button.get());
  button.reset();
  Hold(keys::kShift, ui::kModKeyShift);
  Release(keys::kShift, 0);
  *listener = [](ui::ModifierKeys) {};
  EXPECT_EQ(heard, (std::vector<unsigned char>{ui::kModKeyShift, 0}));
}

}  // namespace
}  // namespace norvik::controls::test
