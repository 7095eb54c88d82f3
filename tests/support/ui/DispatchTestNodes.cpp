#include "support/ui/DispatchTestNodes.h"

namespace norvik::ui::test {

std::vector<std::string> EventLog::Texts() const {
  std::vector<std::string> out;
  for (const EventRecord& r : mRecords) out.push_back(r.Text());
  return out;
}

std::vector<std::string> EventLog::Texts(const std::string& inKind) const {
  std::vector<std::string> out;
  for (const EventRecord& r : mRecords) {
    if (r.kind == inKind) out.push_back(r.Text());
  }
  return out;
}

EventRecord EventLog::Find(const std::string& inNode, const std::string& inKind) const {
  for (const EventRecord& r : mRecords) {
    if (r.node == inNode && r.kind == inKind) return r;
  }
  ADD_FAILURE() << "no " << inKind << " event was seen by " << inNode;
  return {};
}

EventView::EventView(const char* inName, EventLog* inLog) : mLog(inLog) { UI_SetNodeID(inName); }

EventView::~EventView() {
  if (destroyedFlag) *destroyedFlag = true;
}

void EventView::Log(const char* inKind, const UI_Node* inTarget, const PointF& inPosition, int inAction) {
  std::string target = inTarget ? std::string(inTarget->UI_GetNodeID().c_str()) : std::string("-");
  mLog->Add({std::string(UI_GetNodeID().c_str()), inKind, target, inPosition, inAction});
}

bool EventView::UI_DoMouseEvent(UI_Node* inTarget, const MouseEvent& inEvent) {
  Log("mouse", inTarget, inEvent.GetPosition(), inEvent.GetAction());
  return onMouse ? onMouse(inTarget, inEvent) : handlesMouse;
}

bool EventView::UI_DoPreMouseEvent(UI_Node* inTarget, const MouseEvent& inEvent) {
  Log("pre", inTarget, inEvent.GetPosition(), inEvent.GetAction());
  return onPreMouse ? onPreMouse(inTarget, inEvent) : handlesPreMouse;
}

bool EventView::UI_DoCursor(UI_Node* inTarget, const PointF& inPoint, ModKeys inModKeys) {
  Log("cursor", inTarget, inPoint, 0);
  return onCursor ? onCursor(inTarget, inPoint, inModKeys) : handlesCursor;
}

bool EventView::UI_DoKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) {
  Log("key", inTarget, PointF(), inEvent.GetAction());
  return onKey ? onKey(inTarget, inEvent) : handlesKey;
}

bool EventView::UI_DoPreKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) {
  Log("prekey", inTarget, PointF(), inEvent.GetAction());
  return onPreKey ? onPreKey(inTarget, inEvent) : handlesPreKey;
}

bool EventView::UI_InvalidateOnMouseOverChange(bool inIsLeaf) const {
  return inIsLeaf ? invalidateWhenLeaf : invalidateWhenOnChain;
}

void EventView::UI_MouseOverChanged(bool inEntering) {
  Log(inEntering ? "over+" : "over-", nullptr, PointF(), 0);
  if (onMouseOverChanged) onMouseOverChanged(inEntering);
}

void EventView::UI_Invalidate(const RectL* inRect, unsigned long inFlags) {
  ++invalidations;
  UI_SubView::UI_Invalidate(inRect, inFlags);
}

UI_Node* EventView::UI_GetMouseProxy(MouseEvent* ioEvent) {
  if (!proxy) return this;
  if (ioEvent) ioEvent->SetPosition(ioEvent->GetPosition() + proxyOffset);
  return proxy;
}

EventViewP MakeEventView(const char* inName, EventLog* inLog, float inX, float inY, float inW, float inH,
                         UI_Node* inParent) {
  EventViewP v(new EventView(inName, inLog));
  v->UI_SetLocalRectF(tarsel::geom::RectT<float>(inX, inY, inW, inH));
  v->UI_Show(true);
  if (inParent) inParent->ChildPushBack(v);
  return v;
}

LoggingCapture::LoggingCapture(UI_Node* inNode, const MouseEvent& inInitial, std::vector<std::string>* inLog,
                               const char* inName)
    : InputCapture(UI_NodeP(inNode), inInitial), mLog(inLog), mName(inName) {}

void LoggingCapture::Begin() {
  ++beginCount;
  mLog->push_back(mName + ".Begin");
}

void LoggingCapture::End() {
  ++endCount;
  cancelledAtEnd = HasBeenCancelled();
  mLog->push_back(mName + (HasBeenCancelled() ? ".End(cancelled)" : ".End"));
  if (onEnd) onEnd();
}

bool LoggingCapture::DoMouseEvent(const MouseEvent& inEvent) {
  mousePositions.push_back(inEvent.GetPosition());
  mLog->push_back(mName + ".Mouse" + std::to_string(inEvent.GetAction()));
  return onMouse ? onMouse(inEvent) : handlesMouse;
}

bool LoggingCapture::DoKeyboardEvent(const KeyboardEvent& inEvent) {
  mLog->push_back(mName + ".Key" + std::to_string(inEvent.GetAction()));
  return handlesKey;
}

bool LoggingCapture::DoCursor(const PointF& inPoint, tarsel::utility::Flags<unsigned char> inModKeys) {
  cursorPositions.push_back(inPoint);
  cursorModKeys.push_back(inModKeys);
  return handlesCursor;
}

MouseEvent MouseAt(MouseEvent::Action inAction, const PointF& inPoint, int inButton, int inClicks,
                   ModifierKeys inMods) {
  unsigned message = inAction == MouseEvent::kActionButtonDown ? kOSMsgLeftButtonDown
                     : inAction == MouseEvent::kActionButtonUp ? kOSMsgLeftButtonUp
                                                               : kOSMsgMouseMove;
  return MouseEvent(inAction, inButton, inClicks, inPoint, inMods, OS_Event(1, message, 0, 0));
}

KeyboardEvent KeyDownEvent(short inOSCode, unsigned short inCharacter, ModifierKeys inMods, bool inRepeat) {
  return KeyboardEvent(KeyboardEvent::kActionKeyDown, inCharacter, inOSCode, inMods, inRepeat,
                       OS_Event(1, kOSMsgKeyDown, static_cast<std::uintptr_t>(inOSCode), 0));
}

KeyboardEvent KeyUpEvent(short inOSCode, unsigned short inCharacter, ModifierKeys inMods) {
  return KeyboardEvent(KeyboardEvent::kActionKeyUp, inCharacter, inOSCode, inMods, false,
                       OS_Event(1, kOSMsgKeyUp, static_cast<std::uintptr_t>(inOSCode), 0));
}

KeyboardEvent CharEvent(unsigned short inCharacter, ModifierKeys inMods) {
  return KeyboardEvent(std::vector<unsigned short>{inCharacter}, inMods, false,
                       OS_Event(1, kOSMsgChar, inCharacter, 0));
}

DispatchTest::DispatchTest() : root(MakeEventView("root", &log, 0, 0, 200, 200)) {}

DispatchTest::~DispatchTest() { manager.EndInputCapture(true); }

}  // namespace norvik::ui::test
