#pragma once
// Doubles for event dispatch tests: a view that writes every event it sees
// into a shared log, answers as a test tells it, and can run a test's code in
// the middle of a handler (to delete nodes, remove filters, end captures).
#include <functional>
#include <string>
#include <vector>

#include <boost/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include "support/ui/FakeInputPlatform.h"
#include "tarsel/PointT.h"
#include "ui/InputCapture.h"
#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"
#include "ui/OS_NodeManager.h"
#include "ui/UI_SubView.h"

namespace norvik::ui::test {

using PointF = tarsel::geom::PointT<float>;

// One thing a node saw: which node, what kind of event, for which target,
// and where (in the receiving node's coordinates).
struct EventRecord {
  std::string node;
  std::string kind;    // "mouse", "pre", "cursor", "key", "prekey", "over+", "over-"
  std::string target;  // the target's id, or "-" for none
  PointF position;
  int action = 0;

  std::string Text() const { return node + "." + kind + "(" + target + ")"; }
};

class EventLog {
 public:
  void Add(EventRecord inRecord) { mRecords.push_back(std::move(inRecord)); }
  const std::vector<EventRecord>& Records() const { return mRecords; }
  // "node.kind(target)" for every record, in order.
  std::vector<std::string> Texts() const;
  // The texts of the records of one kind.
  std::vector<std::string> Texts(const std::string& inKind) const;
  // The first record of inNode and inKind; fails the test when there is none.
  EventRecord Find(const std::string& inNode, const std::string& inKind) const;
  void Clear() { mRecords.clear(); }

 private:
  std::vector<EventRecord> mRecords;
};

class EventView : public UI_SubView {
 public:
  using MouseHook = std::function<bool(UI_Node*, const MouseEvent&)>;
  using KeyHook = std::function<bool(UI_Node*, const KeyboardEvent&)>;
  using CursorHook = std::function<bool(UI_Node*, const PointF&, ModKeys)>;

  EventView(const char* inName, EventLog* inLog);
  ~EventView() override;

  bool UI_DoMouseEvent(UI_Node* inTarget, const MouseEvent& inEvent) override;
  bool UI_DoPreMouseEvent(UI_Node* inTarget, const MouseEvent& inEvent) override;
  bool UI_DoCursor(UI_Node* inTarget, const PointF& inPoint, ModKeys inModKeys) override;
  bool UI_DoKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) override;
  bool UI_DoPreKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) override;
  bool UI_InvalidateOnMouseOverChange(bool inIsLeaf) const override;
  void UI_MouseOverChanged(bool inEntering) override;
  void UI_Invalidate(const RectL* inRect, unsigned long inFlags) override;
  bool UI_ReceivesEventsFromOS() const override { return receivesEventsFromOS; }
  bool UI_DispatchKeyboardCharEventToParent() const override { return passCharsToParent; }
  UI_Node* UI_GetMouseProxy(MouseEvent* ioEvent) override;
  void UI_SetCapture() override { ++setCaptureCount; }
  void UI_ReleaseCapture() override { ++releaseCaptureCount; }

  // What the handlers answer when no hook is set.
  bool handlesMouse = false;
  bool handlesPreMouse = false;
  bool handlesCursor = false;
  bool handlesKey = false;
  bool handlesPreKey = false;
  // Hooks run inside the handlers, after the event is logged; their answer
  // replaces the flag above.
  MouseHook onMouse;
  MouseHook onPreMouse;
  KeyHook onKey;
  KeyHook onPreKey;
  CursorHook onCursor;
  std::function<void(bool)> onMouseOverChanged;

  bool receivesEventsFromOS = false;
  bool passCharsToParent = true;
  // Answers for UI_InvalidateOnMouseOverChange(true) and (false).
  bool invalidateWhenLeaf = false;
  bool invalidateWhenOnChain = false;
  // When set, mouse events for this node go to the proxy, moved by proxyOffset.
  UI_Node* proxy = nullptr;
  PointF proxyOffset;
  int setCaptureCount = 0;
  int releaseCaptureCount = 0;
  int invalidations = 0;
  // Set to true by the destructor, for tests that delete nodes mid-dispatch.
  bool* destroyedFlag = nullptr;

 private:
  void Log(const char* inKind, const UI_Node* inTarget, const PointF& inPosition, int inAction);

  EventLog* mLog;
};

using EventViewP = boost::intrusive_ptr<EventView>;

// A shown view of the given rectangle, added to inParent when there is one.
EventViewP MakeEventView(const char* inName, EventLog* inLog, float inX, float inY, float inW, float inH,
                         UI_Node* inParent = nullptr);

// A capture that logs what it receives and answers as told.
class LoggingCapture : public InputCapture {
 public:
  LoggingCapture(UI_Node* inNode, const MouseEvent& inInitial, std::vector<std::string>* inLog,
                 const char* inName = "capture");

  void Begin() override;
  void End() override;
  bool DoMouseEvent(const MouseEvent& inEvent) override;
  bool DoKeyboardEvent(const KeyboardEvent& inEvent) override;
  bool DoCursor(const PointF& inPoint, tarsel::utility::Flags<unsigned char> inModKeys) override;

  bool handlesMouse = false;
  bool handlesKey = false;
  bool handlesCursor = false;
  std::function<bool(const MouseEvent&)> onMouse;
  std::function<void()> onEnd;
  std::vector<PointF> mousePositions;
  std::vector<PointF> cursorPositions;
  std::vector<ModifierKeys> cursorModKeys;
  int beginCount = 0;
  int endCount = 0;
  bool cancelledAtEnd = false;

 private:
  std::vector<std::string>* mLog;
  std::string mName;
};

using LoggingCaptureP = boost::intrusive_ptr<LoggingCapture>;

// Event makers: a native message is attached so that events look real.
MouseEvent MouseAt(MouseEvent::Action inAction, const PointF& inPoint, int inButton = MouseEvent::kButtonLeft,
                   int inClicks = 1, ModifierKeys inMods = {});
KeyboardEvent KeyDownEvent(short inOSCode, unsigned short inCharacter, ModifierKeys inMods = {},
                           bool inRepeat = false);
KeyboardEvent KeyUpEvent(short inOSCode, unsigned short inCharacter, ModifierKeys inMods = {});
KeyboardEvent CharEvent(unsigned short inCharacter, ModifierKeys inMods = {});

// A manager, a fake input platform, and a window-sized root view "root" at
// the origin (200 x 200). A capture still running at the end is cancelled
// while the tree is alive.
class DispatchTest : public ::testing::Test {
 protected:
  DispatchTest();
  ~DispatchTest() override;

  EventViewP View(const char* inName, float inX, float inY, float inW, float inH, UI_Node* inParent) {
    return MakeEventView(inName, &log, inX, inY, inW, inH, inParent);
  }
  LoggingCaptureP Capture(UI_Node* inNode, const MouseEvent& inInitial, const char* inName = "capture") {
    return LoggingCaptureP(new LoggingCapture(inNode, inInitial, &captureLog, inName));
  }

  std::vector<std::string> captureLog;
  OS_NodeManager manager;
  FakeInputPlatform platform;
  EventLog log;
  EventViewP root;
};

}  // namespace norvik::ui::test
