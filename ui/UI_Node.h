#pragma once
// UI_Node is every element on screen: a reference-counted object in a tree that
// knows its rectangle and its scale-and-translate matrix relative to its
// parent, its show and enable state, and the callbacks that hosts install.
//
// Ownership: a parent holds its children by strong reference; the parent
// pointer is plain. The manager's cached pointers into the tree are plain too,
// and are kept valid by UI_NodeManager::ReplaceInAllCachedNodes and by this
// class's destructor.
//
// Every walk that calls out to overridable code or to a callback holds a strong
// reference to the node it is on, because the callee may remove or delete it.
#include <cstdint>
#include <list>
#include <memory>
#include <utility>
#include <vector>

#include <boost/any.hpp>
#include <boost/function.hpp>
#include <boost/intrusive_ptr.hpp>
#include <boost/shared_ptr.hpp>

#include "tarsel/Flags.h"
#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/ScaleMatrixT.h"
#include "tarsel/UTFString.h"
#include "ui/FocusChangeReason.h"
#include "ui/Placeable.h"
#include "ui/Theme.h"
#include "ui/UI_NodeBase.h"

namespace norvik::drawbot {
struct ColorRGBA;
class CacheInterface;
class Drawbot;
class SupplierInterface;
class SurfaceInterface;
}  // namespace norvik::drawbot

namespace norvik::datatransfer {
class OS_ReceiveData;
}

namespace norvik::ui {

class MouseEvent;
class KeyboardEvent;
class OS_Event;
class UI_NodeTimerManager;

class UI_Node : public UI_NodeBase {
 public:
  using PointF = tarsel::geom::PointT<float>;
  using PointL = tarsel::geom::PointT<long>;
  using RectF = tarsel::geom::RectT<float>;
  using RectL = tarsel::geom::RectT<long>;
  using Matrix = tarsel::geom::ScaleMatrixT<float>;
  using StateFlags = tarsel::utility::Flags<unsigned long>;
  using ModKeys = tarsel::utility::Flags<unsigned char>;

  enum NodeChange {
    kNodeChangeParent = 0,
    kNodeChangeGeometry = 1,
    kNodeChangeVisibility = 3,
    kNodeChangeWindowMoved = 4
  };
  enum WindowActivation { kWindowActive = 0, kWindowActivatedByClick = 1, kWindowInactive = 2 };
  enum DrawCachePolicy { kDrawCacheDefault = 0, kDrawCacheNever = 1, kDrawCacheAlways = 2 };

  // Values of the state flags.
  static constexpr unsigned long kStateMouseOver = 2;
  static constexpr unsigned long kStateSelfDisabled = 4;
  static constexpr unsigned long kStateParentDisabled = 8;
  static constexpr unsigned long kStateFirstChanceMouse = 16;

  // Invalidation flag: the node's own rendering did not change (matrix moves).
  static constexpr unsigned long kInvalidateKeepRendering = 1;

  using TimerFunction = boost::shared_ptr<boost::function<bool(long)>>;
  using FocusChangedFunction = boost::shared_ptr<boost::function<void(UI_Node*, FocusChangeReason)>>;
  using VoidFunction = boost::shared_ptr<boost::function<void()>>;
  using BeforeFocusChangeFunction = boost::shared_ptr<boost::function<void(bool, FocusChangeReason)>>;
  using CustomDrawFunction = boost::shared_ptr<boost::function<bool(UI_Node const*, drawbot::Drawbot*)>>;
  using CustomMouseFunction = boost::shared_ptr<boost::function<bool(UI_Node*, MouseEvent const&, bool&)>>;
  using CustomKeyboardFunction =
      boost::shared_ptr<boost::function<bool(UI_Node*, KeyboardEvent const&, bool&)>>;
  using CustomCursorFunction =
      boost::shared_ptr<boost::function<bool(UI_Node*, PointF const&, ModKeys, bool&)>>;
  using OSControlClipRects = std::vector<std::pair<UI_Node const*, RectF>>;

  UI_Node();
  ~UI_Node() override;

  // ---- virtual operations, in slot order ----
  virtual bool UI_IsSubView() const { return false; }
  virtual Matrix UI_GetSelfToParentMatrix() const = 0;
  virtual bool UI_HitTest(const PointF& inPoint) const;
  virtual RectL UI_GetLocalRect() const = 0;
  virtual RectF UI_GetLocalRectF(bool inInParent) const = 0;
  virtual void UI_SetLocalRect(const RectL& inRect) = 0;
  virtual void UI_SetLocalRectF(const RectF& inRect) = 0;
  virtual void UI_Show(bool inShow) = 0;
  virtual bool UI_IsShown() const = 0;
  virtual bool UI_AreAllParentsVisible() const;
  // inRect null means the whole node; see kInvalidateKeepRendering.
  virtual void UI_Invalidate(const RectL* inRect, unsigned long inFlags);
  // Paints pending invalidations at once when inFlags has bit 1
  // (kUpdateNowImmediate); without it the update waits for the loop.
  virtual void UI_UpdateNow(unsigned long inFlags) = 0;
  static constexpr unsigned long kUpdateNowImmediate = 1;
  virtual void UI_SetOpacity(float inOpacity) = 0;
  virtual bool UI_IsChild(const UI_NodeP& inNode) const;
  virtual void UI_SetParent(UI_Container* inParent);
  virtual bool UI_SupportsDrawbot() const { return false; }
  virtual void UI_Draw(drawbot::Drawbot* inDrawbot);
  virtual void UI_NotifyBeforeFocusChangeWithOS(bool inGaining, FocusChangeReason inReason);
  virtual bool UI_UseDrawbotCache(drawbot::Drawbot* inDrawbot) const;
  virtual void UI_GetDrawSegments(std::vector<RectL>& outSegments) const;
  virtual drawbot::SupplierInterface* UI_GetDrawSupplier() const;
  // In the event handlers, inTarget is the leaf the event went to (null on the
  // first-chance pass) and the position is in this node's coordinates.
  virtual bool UI_DoPreMouseEvent(UI_Node* /*inTarget*/, const MouseEvent&) { return false; }
  virtual bool UI_DoMouseEvent(UI_Node* /*inTarget*/, const MouseEvent&) { return false; }
  virtual bool UI_DoMouseActivate(const MouseEvent&) { return false; }
  virtual bool UI_DoCursor(UI_Node* /*inTarget*/, const PointF&, ModKeys) { return false; }
  virtual bool UI_InvalidateOnMouseOverChange(bool /*inIsLeaf*/) const { return false; }
  // State flag 2; with inLeafOnly also that this node is the mouse-over leaf.
  virtual bool UI_IsMouseOver(bool inLeafOnly = false) const;
  virtual bool UI_DoPreKeyboardEvent(UI_Node* /*inTarget*/, const KeyboardEvent&) { return false; }
  virtual bool UI_DoKeyboardEvent(UI_Node* /*inTarget*/, const KeyboardEvent&) { return false; }
  virtual bool UI_InvalidateOnKeyboardFocusChange(bool /*inIsLeaf*/) const { return false; }
  virtual bool UI_WantsKeyboardFocus() const { return false; }
  virtual bool UI_WantsKeyboardFocusFromAdvance() const { return false; }
  virtual bool UI_GainKeyboardFocus(FocusChangeReason inReason);
  virtual void UI_PrepareForKeyboardFocusFromAdvance(UI_Node* inNode);
  virtual void UI_LoseKeyboardFocus();
  virtual void UI_UpdateKeyboardFocusStateDueToLoss();
  virtual bool UI_HasKeyboardFocus(bool inLeafOnly) const;
  virtual bool UI_DoTimerNotify(long inTimerID);
  virtual void UI_SetCapture() = 0;
  virtual void UI_ReleaseCapture() = 0;
  virtual bool UI_ReceivesEventsFromOS() const = 0;
  virtual const UTF16String& UI_GetToolTip() const;
  virtual long UI_GetToolTipWidth() const;
  virtual void UI_SetToolTip(const UTF16String& inText, long inWidth);
  virtual PointF UI_GetRecommendedSize() const { return PointF(0, 0); }
  virtual void UI_SetDropTarget(bool) {}
  virtual bool UI_WantsDragDropEvents() const { return false; }
  virtual bool UI_HandleDragEnter(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                  unsigned long& outEffect);
  virtual bool UI_HandleDragOver(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                 unsigned long& outEffect);
  virtual void UI_HandleDragLeave(datatransfer::OS_ReceiveData*) {}
  virtual bool UI_HandleDrop(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                             unsigned long& outEffect);
  virtual void CommitChangeTransaction() {}
  // The placeable interface. measure and measure_vertical must be overridden
  // by nodes that take part in a layout; the base versions raise.
  virtual void measure(halvorn::extents_t& outExtents);
  virtual void measure_vertical(halvorn::extents_t& ioExtents, const halvorn::place_data_t& inPlace);
  virtual void place(const halvorn::place_data_t& inPlace);
  virtual const halvorn::place_data_t& get_placement();
  // Stores a copy of the value.
  virtual void SetUserData(const boost::any& inData) { mUserData = inData; }
  virtual const boost::any& GetUserData() const { return mUserData; }
  virtual void UI_ActivationChanged(WindowActivation inActivation);
  virtual void UI_SizeChanged(const RectF& inLocalRect);
  virtual void UI_DisabledStateChanged();
  virtual void UI_NodeChanged(NodeChange) {}
  virtual void UI_HandleOSEvent(OS_Event* inEvent) = 0;
  // The cursor walk: an active capture, then towards the leaf and back to the root.
  virtual bool UI_DispatchCursor(const PointF& inPoint, ModKeys inModKeys, bool inSkipOSChildren);
  virtual bool UI_DispatchEvent(OS_Event* inEvent) = 0;
  virtual bool UI_DispatchKeyboardCharEventToParent() const { return true; }
  virtual void UI_GetOSControlClipRects(OSControlClipRects& ioRects) const;
  virtual void UI_MouseOverChanged(bool) {}
  virtual void UI_FocusChanged(FocusChangeReason inReason);
  virtual void UI_SetKeyboardFocusWithOS() = 0;
  virtual void UI_ClearKeyboardFocusWithOS() {}
  virtual bool UI_IsDrawbotCacheValid(const drawbot::SurfaceInterface& inSurface) const;
  // The node that receives this node's mouse events; it may rewrite ioEvent
  // (which may be null) for the proxy.
  virtual UI_Node* UI_GetMouseProxy(MouseEvent* /*ioEvent*/) { return this; }
  virtual UI_NodeTimerManager* UI_GetTimerManager(bool inFlag);
  virtual const UI_NodeTimerManager* UI_GetTimerManager(bool inFlag) const;
  virtual bool UI_DisplaysToolTipForChild(const UI_Node*) const { return false; }

  // ---- the node as its parent's child ----
  bool IsANode() const override { return true; }
  // Each empties the tab order cache and invalidates this node.
  void ChildAdded(UI_Node* inChild) override;
  void ChildRemoved(UI_Node* inChild) override;
  void ChildOrderChanged() override;

  // ---- tree walking ----
  UI_Container* UI_GetParentContainer() const { return mParent; }
  UI_Node* UI_GetParentNode() const { return mParent ? mParent->GetAsANode() : nullptr; }
  UI_Node* UI_GetRootNode();
  UI_Container* UI_GetRootContainer();
  UI_Node* UI_GetParentEventRecipientNode() const;
  // Root first, this node last.
  std::vector<UI_Node*> UI_GetNodeParents();
  // True when this node is below inNode at any depth; false for inNode itself.
  bool UI_IsChildOf(const UI_Node& inNode) const;

  // ---- identity ----
  const UTF8String& UI_GetNodeID() const { return mNodeID; }
  void UI_SetNodeID(const UTF8String& inID) { mNodeID = inID; }
  int UI_GetIndex() const { return mIndex; }
  void UI_SetIndex(int inIndex) { mIndex = inIndex; }
  iterator UI_ChildFindFromID(const UTF8String& inID);
  UI_Node* UI_ChildGetFromID(const UTF8String& inID);
  StateFlags UI_GetStateFlags() const { return mStateFlags; }
  void UI_SetStateFlags(StateFlags inFlags) { mStateFlags = inFlags; }

  // ---- coordinates ----
  PointL UI_LocalToGlobal(const PointL& inPoint) const;
  PointL UI_GlobalToLocal(const PointL& inPoint) const;
  RectL UI_LocalToGlobal(const RectL& inRect) const;
  RectL UI_GlobalToLocal(const RectL& inRect) const;
  PointF UI_LocalToGlobalF(const PointF& inPoint) const;
  PointF UI_GlobalToLocalF(const PointF& inPoint) const;
  RectF UI_LocalToGlobalF(const RectF& inRect) const;
  RectF UI_GlobalToLocalF(const RectF& inRect) const;
  static Matrix UI_GetSelfToRootMatrix(const UI_Node* inNode);
  // Raises "Parent not found." when inStop is not null and not an ancestor.
  static Matrix UI_GetSelfToSpecificParentMatrix(const UI_Node* inNode, const UI_Node* inStop);
  // Halves go towards positive infinity: 1.5 -> 2, -1.5 -> -1.
  static long UI_RoundToLong(float inValue);
  // Floor of the near edges, ceiling of the far edges.
  static RectL UI_EnclosingRect(const RectF& inRect);

  // ---- enable state ----
  void UI_SetDisabled(bool inDisable);
  void UI_SetEnabled(bool inEnable) { UI_SetDisabled(!inEnable); }
  bool UI_IsDisabled() const { return mStateFlags.TestAny(kStateSelfDisabled | kStateParentDisabled); }
  bool UI_IsEnabled() const { return !UI_IsDisabled(); }
  // Changes only this node's own flag; the children are not told.
  void UI_SetSelfDisabled(bool inDisable);
  // Flips the inherited flag of this node only.
  void UI_SetParentDisabled(bool inDisabled);
  void UI_DispatchParentDisabledChange(bool inSkipSelf, bool inDisabled);

  // ---- show state ----
  void UI_Hide(bool inHide) { UI_Show(!inHide); }
  bool UI_IsHidden() const { return !UI_IsShown(); }

  // ---- callbacks ----
  // The callbacks, tool tip, timers and placement of a node live in a side
  // block that the node allocates the first time one is set: most nodes
  // never use them, and a bare node stays small.
  void UI_SetCustomDrawFunction(const CustomDrawFunction& inF);
  const CustomDrawFunction& UI_GetCustomDrawFunction() const;
  void UI_SetCustomMouseEventFunction(const CustomMouseFunction& inF);
  const CustomMouseFunction& UI_GetCustomMouseEventFunction() const;
  void UI_SetCustomPreMouseEventFunction(const CustomMouseFunction& inF);
  const CustomMouseFunction& UI_GetCustomPreMouseEventFunction() const;
  void UI_SetCustomKeyboardEventFunction(const CustomKeyboardFunction& inF);
  const CustomKeyboardFunction& UI_GetCustomKeyboardEventFunction() const;
  void UI_SetCustomDoCursorFunction(const CustomCursorFunction& inF);
  const CustomCursorFunction& UI_GetCustomDoCursorFunction() const;
  void InstallTimerFunction(const TimerFunction& inF);
  void InstallFocusChangedFunction(const FocusChangedFunction& inF);
  void InstallSizeChangedFunction(const VoidFunction& inF);
  void InstallDisabledChangedFunction(const VoidFunction& inF);
  void InstallBeforeFocusChangeFunction(const BeforeFocusChangeFunction& inF);
  void NotifyFocusChanged(UI_Node* inNode, FocusChangeReason inReason);

  void UI_SetTabOrderWeight(std::uint64_t inWeight) { mTabOrderWeight = inWeight; }
  std::uint64_t UI_GetTabOrderWeight() const { return mTabOrderWeight; }
  // Calls UI_NodeChanged on this node and then on the whole subtree.
  void UI_DispatchNodeChange(NodeChange inChange);

  // ---- keyboard focus beyond the node's own chain ----
  static UI_Node* UI_GetKeyboardFocusLeafNode();
  static UI_Node* UI_GetPreviousKeyboardFocusNode();
  // Tells the platform that inNode's window holds focus.
  static void UI_SetKeyboardFocusLeafNode(UI_Node* inNode);
  static void UI_ClearPreviousKeyboardFocus();
  // True when a node from the parent of the focus leaf upwards is a hosted
  // native text field; the leaf itself is not tested. The text-field class
  // registers how to recognise one (SetTextEditControlTest), so the node core
  // does not depend on it; with nothing registered the answer is false.
  static bool UI_TextEditControlHasFocus();
  using TextEditControlTest = bool (*)(const UI_Node* inNode);
  static void SetTextEditControlTest(TextEditControlTest inTest);
  // Depth first in child order, the first descendant that wants focus.
  UI_Node* UI_GetFirstFocusableChildNode();
  // Tab and Shift+Tab on key down move focus on from inTarget (or from the
  // start of inSelf when inTarget has no parent) and answer true.
  static bool UI_DoAdvanceKeyboardFocus(UI_Container* inSelf, UI_Node* inTarget, const KeyboardEvent& inEvent);
  // Moves focus to the next (or previous) node in tab order after child
  // inIndex of inParent; true when some node took it.
  static bool UI_AdvanceFocus(bool inForward, int inIndex, UI_Container* inParent);
  // The native set-focus and kill-focus messages of a window node. The
  // handle is the platform's OS_WindowHandle of the window receiving focus.
  static void UI_OSSetFocus(UI_Node* inWindow, bool inSuspendOS);
  static void UI_OSKillFocus(UI_Node* inWindow, std::uintptr_t inNextHandle);

  // ---- timers ----
  // Installs (or replaces) this node's timer inTimerID; without a window
  // above, nothing happens.
  void UI_InstallTimer(float inSeconds, long inTimerID);
  bool UI_RemoveTimer(long inTimerID, bool inFlag);
  void UI_RemoveAllTimers();
  void UI_InstallTimerNotifyFunction(TimerFunction inFunction);
  // On the window that received a timer message: routes the timer with key
  // inTimerKey to its node; false when it is not one of this window's.
  bool UI_DispatchPossibleTimer(long inTimerKey);

  // ---- mouse dispatch ----
  using NodeChain = std::vector<UI_NodeP>;
  // Entry from a native window: the mouse proxy's copy of the event goes to
  // UI_DispatchMouseEventToTarget.
  bool UI_DispatchMouseEvent(const MouseEvent& inEvent, bool inSkipOSChildren);
  // The recorder, an active capture, then towards the leaf and back to the root.
  static bool UI_DispatchMouseEventToTarget(UI_Node* inNode, const MouseEvent& inEvent, bool inSkipOSChildren);
  // Answers whether a node handled the event, and the deepest node hit.
  std::pair<bool, UI_NodeP> UI_DispatchMouseEventTowardsLeaf(const MouseEvent& inEvent, bool inSkipOSChildren);
  bool UI_DispatchMouseEventTowardsRoot(UI_Node* inLeaf, const MouseEvent& inEvent);
  // The custom mouse function, then UI_DoMouseEvent.
  static bool UI_DispatchMouseEventToLeaf(UI_Node* inNode, UI_Node* inLeaf, const MouseEvent& inEvent);
  // The mouse filters, newest first.
  static bool UI_DispatchPreMouseEvent(UI_Node* inLeaf, const MouseEvent& inEvent);
  static bool UI_DispatchCapturedMouseEvent(UI_Node* inNode, const MouseEvent& inEvent);

  // ---- mouse over ----
  void UI_UpdateMouseOverState(const MouseEvent& inEvent);
  // Makes this node the mouse-over leaf; inEvent, in this node's coordinates,
  // is what the nodes that the mouse leaves hear.
  void UI_SetMouseOverLeafNode(const MouseEvent* inEvent);
  // Enters or leaves the nodes [inFirst, inLast) of a root-first chain;
  // inEvent's position is global here.
  static void UI_SetMouseOverState(bool inEntering, const MouseEvent* inEvent, NodeChain::const_iterator inFirst,
                                   NodeChain::const_iterator inLast, UI_Node* inLeaf);
  // The mouse left inNode's native window; inEvent is in inNode's coordinates.
  static void UI_MouseExited(const MouseEvent* inEvent, UI_Node* inNode);
  static void UI_InvalidateMouseOverNodes();

  // ---- cursor ----
  std::pair<bool, UI_NodeP> UI_DispatchCursorTowardsLeaf(const PointF& inPoint, ModKeys inModKeys,
                                                         bool inSkipOSChildren);
  bool UI_DispatchCursorTowardsRoot(UI_Node* inLeaf, const PointF& inPoint, ModKeys inModKeys);
  static bool UI_DispatchCapturedCursor(UI_Node* inNode, const PointF& inPoint, ModKeys inModKeys);

  // ---- keyboard dispatch ----
  // The recorder, the modifier notifier, an active capture, the keyboard
  // filters, then inNode and each ancestor until one handles the key.
  static bool UI_DispatchKeyboardEvent(UI_Node* inNode, const KeyboardEvent& inEvent);
  // The custom keyboard function, then UI_DoKeyboardEvent.
  static bool UI_DispatchKeyboardEventToNode(UI_Node* inNode, UI_Node* inTarget, const KeyboardEvent& inEvent);
  static bool UI_DispatchCapturedKeyboardEvent(UI_Node* inNode, const KeyboardEvent& inEvent);

  // ---- tool tips ----
  // The node whose tip shows for inNode: inNode itself when it has a tip, else
  // the nearest ancestor with a tip that displays tips for its children. Null
  // while an input capture is active.
  static UI_Node* UI_GetToolTipForDisplay(UI_Node* inNode);

  // ---- drawing cache ----
  // Drops this node's cached rendering (unless inKeepCache) and its ancestors',
  // at most once between two stored caches: see the manager's seed.
  void UI_InvalidateDrawbotCache(bool inKeepCache);
  void UI_SetDrawbotCache(const boost::intrusive_ptr<drawbot::CacheInterface>& inCache);
  const boost::intrusive_ptr<drawbot::CacheInterface>& UI_GetDrawbotCache() const { return mDrawbotCache; }
  std::uint64_t UI_GetDrawbotCacheInvalidatedSeed() const { return mDrawbotCacheInvalidatedSeed; }
  void UI_SetDrawCachePolicy(DrawCachePolicy inPolicy) { mDrawCachePolicy = inPolicy; }
  DrawCachePolicy UI_GetDrawCachePolicy() const { return mDrawCachePolicy; }
  void UI_SetClipToSelfEnabled(bool inClip) { mClipToSelf = inClip; }
  bool UI_GetClipToSelfEnabled() const { return mClipToSelf; }

  // ---- draw traversal ----
  // Each child in child order, so later children paint over earlier ones.
  void UI_DispatchDrawToChildren(drawbot::Drawbot* inDrawbot);
  // One child in its own coordinates. Native windows, hidden children,
  // children scaled to nothing and children outside the clip are skipped
  // before any work on their subtree.
  void UI_DispatchDrawToChild(UI_Node* inChild, drawbot::Drawbot* inDrawbot);
  // Draws through the node's cache when its policy caches, rebuilding a stale one.
  void UI_DrawAndCache(drawbot::Drawbot* inDrawbot, bool inFromRoot, const drawbot::ColorRGBA* inBackground);
  // From a root: background, then the children (the root's own UI_Draw is not
  // called). Otherwise the custom draw function or UI_Draw.
  void UI_DrawSelf(drawbot::Drawbot* inDrawbot, bool inFromRoot, const drawbot::ColorRGBA* inBackground);
  // The custom draw function when it answers true, else UI_Draw.
  void UI_DispatchDraw(drawbot::Drawbot* inDrawbot);
  // The entry of a native paint. With inUseBuffer the tree draws into a
  // buffered reference surface, flushed at the end.
  void UI_DispatchDrawFromRoot(const drawbot::ColorRGBA* inBackground, drawbot::Drawbot* inDrawbot,
                               bool inUseBuffer);
  // Cuts the rectangles of hosted native controls out of the clip (even-odd),
  // so that drawing never paints over them.
  void UI_ClipOSControls(drawbot::Drawbot* inDrawbot);
  static void UI_ClipToRect(const RectF& inRect, drawbot::Drawbot* inDrawbot);

  // Theme supplier of a node: the nearest active theme owner up the tree.
  ThemeP UI_DefaultThemeSupplier() const override;

  // While the user resizes a window, the repaint of a node is deferred to the
  // end of the resize; answers whether it was.
  bool UI_PerformUserResizingDraw();

  const std::list<long>& UI_GetTimerIDs() const;
  std::list<long>& UI_GetTimerIDs();
  void UI_SetClientOSEventFunction(void (*inFunc)(OS_Event*)) { mClientOSEventFunc = inFunc; }

 protected:
  friend class UI_Container;
  friend class UI_NodeManager;

  // Runs the focus change of one side of the chain; see UI_GainKeyboardFocus.
  static void UI_SetKeyboardFocusState(bool inGaining, const std::vector<UI_NodeP>& inTail, UI_Node* inLeaf,
                                       std::vector<UI_NodeP>& ioChanged, FocusChangeReason inReason);
  static void UI_DispatchFocusChange(const std::vector<UI_NodeP>& inChanged, FocusChangeReason inReason);

  struct Extras;
  // The side block, created on first write; a node without one reads as
  // having an empty one.
  Extras& UI_GetExtras();
  const Extras& UI_ReadExtras() const;

  std::unique_ptr<Extras> mExtras;
  void (*mClientOSEventFunc)(OS_Event*) = nullptr;
  UI_Container* mParent = nullptr;
  int mIndex = -1;
  StateFlags mStateFlags;
  UTF8String mNodeID;
  bool mHasKeyboardFocus = false;
  boost::intrusive_ptr<drawbot::CacheInterface> mDrawbotCache;
  std::uint64_t mCacheThemeChangeCount = 0;
  ThemeP mCacheTheme;
  DrawCachePolicy mDrawCachePolicy = kDrawCacheDefault;
  bool mClipToSelf = false;
  // Starts at a value the seed never takes, so the constructor's invalidation runs.
  std::uint64_t mDrawbotCacheInvalidatedSeed = ~std::uint64_t(0);
  boost::any mUserData;
  std::uint64_t mTabOrderWeight = 0;
};

// Keeps a node alive across a call-out that may remove or delete it. A node
// that nobody owns yet (one still running its constructor) is left alone:
// taking and dropping its first reference would delete it.
class UI_NodeProtector {
 public:
  explicit UI_NodeProtector(UI_Node* inNode) : mNode(inNode && inNode->GetRefCount() > 0 ? inNode : nullptr) {}

 private:
  UI_NodeP mNode;
};

// Calls every entry of a callback list in order, on a copy of the list so that
// a callback may install or remove entries. A null entry is skipped; an entry
// holding an empty function raises boost::bad_function_call.
template <typename List, typename... Args>
void UI_FireCallbackList(const List& inList, Args&&... inArgs) {
  const List copy(inList);
  for (const auto& entry : copy) {
    if (entry) (*entry)(inArgs...);
  }
}

}  // namespace norvik::ui
