// Tool tips and labels that change with the modifier keys. The keys come
// from real keyboard events: the keyboard dispatch hands every event's
// modifiers to the process's modifier key notifier, which tells the buttons.
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "controls/UI_TextButton.h"
#include "support/controls/ControlTestSupport.h"
#include "ui/UI_ModKeyNotifier.h"

namespace norvik::controls::test {
namespace {

constexpr short kShiftKey = 16;
constexpr short kAltKey = 18;

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
  Hold(kShiftKey, ui::kModKeyShift);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render all sequences");
  EXPECT_EQ(button->UI_GetToolTipWidth(), 400);
  Release(kShiftKey, 0);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render the sequence");
  Hold(kAltKey, ui::kModKeyAlt);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render in the background");
}

TEST_F(ModifiedToolTipTest, KeysOutsideTheButtonsModifiersAreIgnored) {
  Hold(kShiftKey, ui::kModKeyShift | ui::kModKeyCtrl);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render all sequences") << "Ctrl has no tool tip of its own";
}

TEST_F(ModifiedToolTipTest, ACombinationWithoutItsOwnEntryShowsTheBaseToolTip) {
  Hold(kShiftKey, ui::kModKeyShift);
  Hold(kAltKey, ui::kModKeyShift | ui::kModKeyAlt);
  EXPECT_EQ(button->UI_GetToolTip(), u"Render the sequence");
}

TEST_F(ModifiedToolTipTest, TheFirstToolTipIsTheBaseOneWhateverItsKeys) {
  UI_TextButtonP other = Add(new UI_TextButton(u"Stop"), RectF(10, 40, 80, 20));
  other->InsertModifiedToolTip(ModKeys(ui::kModKeyAlt), u"Stop after this frame");
  Hold(kAltKey, ui::kModKeyAlt);
  Release(kAltKey, 0);
  EXPECT_EQ(other->UI_GetToolTip(), u"Stop after this frame");
}

TEST_F(ModifiedToolTipTest, ATextButtonSwapsItsLabelAmongItsModifiedNames) {
  button->InsertModifiedName(ModKeys(ui::kModKeyShift), u"Render All");
  button->InsertModifiedName(ModKeys(ui::kModKeyAlt), u"Render Later");
  Hold(kShiftKey, ui::kModKeyShift);
  EXPECT_EQ(button->GetText(), u"Render All");
  Release(kShiftKey, 0);
  EXPECT_EQ(button->GetText(), u"Render");
  Hold(kAltKey, ui::kModKeyAlt | ui::kModKeyCapsLock);
  EXPECT_EQ(button->GetText(), u"Render Later") << "Caps Lock is no modifier of the names";
}

TEST_F(ModifiedToolTipTest, ADeletedButtonIsNoLongerToldAndTheOthersStillAre) {
  std::vector<unsigned char> heard;
  auto listener = boost::make_shared<boost::function<void(ui::ModifierKeys)>>(
      [&heard](ui::ModifierKeys inKeys) { heard.push_back(inKeys.Get()); });
  ui::UI_ModKeyNotifier::Get().InstallModKeyChangedFunction(listener);
  root->ChildRemove(button.get());
  button.reset();
  Hold(kShiftKey, ui::kModKeyShift);
  Release(kShiftKey, 0);
  *listener = [](ui::ModifierKeys) {};
  EXPECT_EQ(heard, (std::vector<unsigned char>{ui::kModKeyShift, 0}));
}

}  // namespace
}  // namespace norvik::controls::test
