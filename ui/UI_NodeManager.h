#pragma once
// UI_NodeManager is the one process-wide object of the view system: the
// mouse-over and focus leaves, filter nodes, the modal stack, the active input
// capture, the counters behind the scoped guards, the shared sub-managers, the
// draw cache seed and the timer id source.
//
// Node pointers stored here are plain and non-owning. They stay valid because
// UI_Container::ChildRemove calls ReplaceInAllCachedNodes and the node's
// destructor clears whatever still points at it.
//
// Seams filled by later work, all optional so that the manager runs with no
// platform at all: the tool tip manager, the resource manager, the image
// cache and the OS drawing supplier are held here and set by the platform's
// construction (OS_NodeManager) or by a test.
#include <cstdint>
#include <memory>
#include <set>
#include <utility>
#include <vector>

#include <boost/function.hpp>
#include <boost/intrusive_ptr.hpp>
#include <boost/noncopyable.hpp>
#include <boost/shared_ptr.hpp>

#include "tarsel/Flags.h"
#include "tarsel/PointT.h"
#include "tarsel/Threads.h"
#include "ui/CustomSettingsManager.h"
#include "ui/DrawbotImageResourceCache.h"
#include "ui/InputCapture.h"
#include "ui/ResourceManager.h"
#include "ui/UI_ToolTipManager.h"

namespace norvik::drawbot {
class SupplierInterface;
}

namespace norvik::ui {

class UI_Node;
using UI_NodeP = boost::intrusive_ptr<UI_Node>;
class OS_EditText;
class KeyboardEvent;
class OS_FocusPlatform;

class UI_NodeManager : private boost::noncopyable {
 public:
  using PlatformWindow = void*;
  using BoolFunction = boost::shared_ptr<void (*)(bool)>;
  using UserResizeFunction = boost::shared_ptr<void (*)(bool, UI_Node*, bool)>;
  // Makes the host of a text edit and the edit itself for a control.
  using EditTextCreationFunction =
      boost::function<void(int inType, UI_Node* inControl, UI_Node* inParent, UI_NodeP& outHost,
                            OS_EditText*& outEdit)>;

  UI_NodeManager();
  virtual ~UI_NodeManager();

  static UI_NodeManager* Get(bool inMayBeNull = true);
  static const UI_NodeManager* GetConst(bool inMayBeNull = true);
  static void Set(UI_NodeManager* inManager);

  // ---- accessors ----
  UI_Node* GetMouseOverLeafNode() const { return mMouseOverLeaf; }
  void SetMouseOverLeafNode(UI_Node* inNode) { mMouseOverLeaf = inNode; }
  UI_Node* GetMouseOverRootNode() const { return mMouseOverRoot; }
  void SetMouseOverRootNode(UI_Node* inNode) { mMouseOverRoot = inNode; }
  UI_Node* GetKeyboardFocusLeafNode() const { return mKeyboardFocusLeaf; }
  // The current leaf moves to the previous field.
  void SetKeyboardFocusLeafNode(UI_Node* inNode);
  UI_Node* GetPreviousKeyboardFocusLeafNode() const { return mPreviousKeyboardFocusLeaf; }
  void SetPreviousKeyboardFocusLeafNode(UI_Node* inNode) { mPreviousKeyboardFocusLeaf = inNode; }
  bool IsApplicationFrontmost() const { return mApplicationFrontmost; }
  UI_ToolTipManager* GetToolTipManager() const { return mToolTipManager.get(); }
  CustomSettingsManager* GetCustomSettingsManager() const { return mCustomSettingsManager.get(); }
  DrawbotImageResourceCache* GetDrawbotImageResourceCache() const { return mImageCache.get(); }
  drawbot::SupplierInterface* GetOSDrawSupplier() const { return mOSSupplier.get(); }
  // The resource image of this name for inSupplier, through the image cache
  // and the resource manager; it stays valid while the cache holds it. A
  // missing cache is a contract violation; a missing image raises the
  // resource error naming it.
  const drawbot::ImageInterface* GetImage(const drawbot::SupplierInterface* inSupplier, const UTF8String& inName,
                                          drawbot::ImageFileType inFileType) const;
  // Raises "Unable to access resource." when there is no resource manager.
  ResourceManager& GetResourceManager() const;
  const InputCaptureP& GetInputCapture() const { return mInputCapture; }
  bool HasInputCapture() const { return mInputCapture != nullptr; }
  std::size_t GetMouseEventFiltersSize() const { return mMouseFilters.size(); }
  std::size_t GetKeyboardEventFiltersSize() const { return mKeyboardFilters.size(); }
  const std::vector<UI_Node*>& GetMouseEventFilters() const { return mMouseFilters; }
  const std::vector<UI_Node*>& GetKeyboardEventFilters() const { return mKeyboardFilters; }
  bool IsUpdatingFocus() const { return mUpdatingFocus > 0; }
  bool IsSuspendingOSFocusChanges() const { return mSuspendOSFocus > 0; }
  bool IsSuspendingMouseOverUpdates() const { return mSuspendMouseOver > 0; }
  bool IsGroupingFocusChanges() const { return mGroupingFocus > 0; }
  bool IsUserResizing() const { return mUserResizing > 0; }
  bool IsSuspendingOSMouseActivates() const { return !mOSMouseActivateSuspends.empty(); }
  PlatformWindow GetSuspendOSMouseActivatePlatformWindow() const;
  bool HasModalWindow() const { return !mModalStack.empty(); }
  UI_Node* GetModalWindow() const { return mModalStack.empty() ? nullptr : mModalStack.back().first; }
  const std::vector<std::pair<UI_Node*, UI_Node*>>& GetModalStack() const { return mModalStack; }
  void SetBlockDialogsFromStealingHotTextEditTextKeys(bool inBlock) {
    mBlockDialogsFromStealingHotTextEditTextKeys = inBlock;
  }
  bool IsBlockingDialogsFromStealingHotTextEditTextKeys() const {
    return mBlockDialogsFromStealingHotTextEditTextKeys;
  }
  bool IsNRKPopupMenuOnscreen() const { return mPopupMenuOnscreen > 0; }
  void SetNRKPopupMenuOnscreen(bool inOnscreen) { mPopupMenuOnscreen += inOnscreen ? 1 : -1; }
  void EnableMnemonics() { mMnemonicsEnabled = true; }
  void DisableMnemonics() { mMnemonicsEnabled = false; }
  bool IsMnemonicEnabled() const { return mMnemonicsEnabled; }
  tarsel::utility::Flags<unsigned char> GetLastModKeys() const { return mLastModKeys; }
  void SetLastModKeys(tarsel::utility::Flags<unsigned char> inKeys) { mLastModKeys = inKeys; }

  // The executor of the main thread, which registered itself when this
  // manager was made; other threads post work to the UI through it.
  tarsel::threads::AsyncEventLoopAdaptorPtr GetExecutor() const { return mExecutor; }

  // ---- seams ----
  void SetToolTipManager(std::unique_ptr<UI_ToolTipManager> inManager);
  void SetResourceManager(std::unique_ptr<ResourceManager> inManager);
  void SetCustomSettingsManager(std::unique_ptr<CustomSettingsManager> inManager);
  void SetDrawbotImageResourceCache(std::unique_ptr<DrawbotImageResourceCache> inCache);
  void SetOSDrawSupplier(std::shared_ptr<drawbot::SupplierInterface> inSupplier);
  // Destroys the image cache before the drawing back end goes away.
  void TerminateDrawing();

  // ---- timers ----
  // The reserved id of the tool tip timer.
  static long GetTooltipTimerID() { return -1; }
  // Internal timer ids: -2, -3, ... never -1 and never an application's positive id.
  long GetUniqueTimerID() { return mNextTimerID--; }

  // ---- draw cache seed ----
  std::uint64_t GetDrawbotCacheSeed() const { return mDrawbotCacheSeed; }
  void IncrementDrawbotCacheSeed() { ++mDrawbotCacheSeed; }

  // ---- input capture ----
  void BeginInputCapture(const InputCaptureP& inCapture);
  // Ends the active capture, if any, after taking it out of the manager.
  void EndInputCapture(bool inCancelled);
  // The capture, or null when there is none, when it has been cancelled, or
  // when inNode is given and is not the capture's node.
  InputCapture* GetActiveInputCapture(const UI_Node* inNode) const;

  // ---- keyboard ----
  // Refreshes the cursor when the modifiers changed, then runs the keyboard
  // filters, newest first; true when one of them took the key.
  bool DispatchPreKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent);
  // Whether a key activates a focused control: Space, or Ctrl with Return or
  // the keypad's Enter, going down; Space, Return or Enter coming up.
  static bool CompareControlActivateShortcut(const KeyboardEvent& inEvent);

  // ---- filters: newest first; a null node is ignored ----
  void AddMouseEventFilterNode(UI_Node* inNode);
  void AddKeyboardEventFilterNode(UI_Node* inNode);
  void RemoveMouseEventFilterNode(UI_Node* inNode);
  void RemoveKeyboardEventFilterNode(UI_Node* inNode);

  // ---- cursor ----
  // The mouse position in global coordinates. The platform's manager answers
  // the real position; the portable manager answers the last one stored.
  virtual tarsel::geom::PointT<long> GetGlobalMousePosition() const { return mGlobalMousePosition; }
  void SetGlobalMousePosition(tarsel::geom::PointT<long> inPoint) { mGlobalMousePosition = inPoint; }
  bool DispatchCursorToMouseOverRootNode(tarsel::utility::Flags<unsigned char> inModKeys);

  // ---- notifications; a null entry is skipped ----
  void InstallApplicationActivationChangedFunction(const BoolFunction& inF);
  void InstallTextEditFocusChangedFunction(const BoolFunction& inF);
  void InstallUserResizeFunction(const UserResizeFunction& inF);
  void UnregisterFunctions();
  void NotifyApplicationActivationChanged(bool inFrontmost);
  void NotifyTextEditFocusChanged(bool inFocused);
  void NotifyUserResize(bool inStarting, UI_Node* inWindow, bool inFromOS);

  // ---- edit text creation ----
  void InstallEditTextCreationFunction(const EditTextCreationFunction& inF);
  // With a hook installed the hook alone does the work. Without one the
  // native text field of the platform is used; with no platform this raises.
  void CreateEditText(int inType, UI_Node* inControl, UI_Node* inParent, UI_NodeP& outHost,
                      OS_EditText*& outEdit);

  // ---- modal stack ----
  void PushModalWindow(UI_Node* inWindow);
  // Ignored unless inWindow is on top.
  void PopModalWindow(UI_Node* inWindow);

  // ---- keeping cached pointers valid ----
  // Every cached pointer equal to inNode becomes inReplacement; with
  // inIncludeChildren, so does every one below inReplacement.
  void ReplaceInAllCachedNodes(UI_Node* inNode, UI_Node* inReplacement, bool inIncludeChildren);
  void ReplaceWindowFocusNode(UI_Node* inNode, UI_Node* inReplacement, bool inIncludeChildren);
  // Called by the node's destructor.
  void ForgetNode(UI_Node* inNode);

  void SetApplicationFrontmost(bool inFrontmost);

  // ---- focus ----
  // The platform's answers to focus questions; null runs focus inside the
  // tree alone. The caller keeps ownership.
  void SetFocusPlatform(OS_FocusPlatform* inPlatform) { mFocusPlatform = inPlatform; }
  OS_FocusPlatform* GetFocusPlatform() const { return mFocusPlatform; }
  // Takes focus out of the tree of the focus leaf (from its root).
  void LoseKeyboardFocus();

  // ---- user resizing ----
  void BeginUserResizing(UI_Node* inWindow, bool inFromOS);
  void EndUserResizing(UI_Node* inWindow, bool inFromOS);
  // During a resize, remembers inNode for a repaint at the end and answers true.
  bool InvalidateNodeAfterUserResize(UI_Node* inNode);
  void InvalidateResizedNodes();

  // ---- scoped guards ----
  class SuspendOSFocusUpdates {
   public:
    explicit SuspendOSFocusUpdates(UI_NodeManager* inManager = Get());
    SuspendOSFocusUpdates(SuspendOSFocusUpdates&& ioOther) noexcept;
    SuspendOSFocusUpdates& operator=(SuspendOSFocusUpdates&& ioOther) noexcept;
    ~SuspendOSFocusUpdates();

   private:
    UI_NodeManager* mManager;
  };
  class SuspendMouseOverUpdates {
   public:
    explicit SuspendMouseOverUpdates(UI_NodeManager* inManager = Get());
    SuspendMouseOverUpdates(SuspendMouseOverUpdates&& ioOther) noexcept;
    SuspendMouseOverUpdates& operator=(SuspendMouseOverUpdates&& ioOther) noexcept;
    ~SuspendMouseOverUpdates();

   private:
    UI_NodeManager* mManager;
  };
  // Pops the top of the stack when it ends, whatever window that is.
  class SuspendOSMouseActivates {
   public:
    SuspendOSMouseActivates(UI_NodeManager* inManager, PlatformWindow inWindow);
    SuspendOSMouseActivates(SuspendOSMouseActivates&& ioOther) noexcept;
    SuspendOSMouseActivates& operator=(SuspendOSMouseActivates&& ioOther) noexcept;
    ~SuspendOSMouseActivates();

   private:
    UI_NodeManager* mManager;
  };
  class SetModalWindow {
   public:
    SetModalWindow(UI_NodeManager* inManager, UI_Node* inWindow);
    SetModalWindow(SetModalWindow&& ioOther) noexcept;
    SetModalWindow& operator=(SetModalWindow&& ioOther) noexcept;
    ~SetModalWindow();

   private:
    UI_NodeManager* mManager;
    UI_Node* mWindow;
  };
  class NotifyUserResizing : private boost::noncopyable {
   public:
    NotifyUserResizing(UI_NodeManager* inManager, UI_Node* inWindow);
    ~NotifyUserResizing();

   private:
    UI_NodeManager* mManager;
    UI_Node* mWindow;
  };
  class AddAndRemoveMouseEventFilterNode : private boost::noncopyable {
   public:
    AddAndRemoveMouseEventFilterNode(UI_NodeManager* inManager, UI_Node* inNode);
    ~AddAndRemoveMouseEventFilterNode();

   private:
    UI_NodeManager* mManager;
    UI_Node* mNode;
  };
  class AddAndRemoveKeyboardEventFilterNode : private boost::noncopyable {
   public:
    AddAndRemoveKeyboardEventFilterNode(UI_NodeManager* inManager, UI_Node* inNode);
    ~AddAndRemoveKeyboardEventFilterNode();

   private:
    UI_NodeManager* mManager;
    UI_Node* mNode;
  };

  // While the outermost of these lives, focus moves only the leaf: no flag
  // changes and nobody is told. Focus leaves the tree when it starts and comes
  // back to the last leaf (or, with inRestore, to the leaf of the start if
  // that is still shown) when it ends. Nested ones are inert.
  class GroupingFocusChanges : private boost::noncopyable {
   public:
    GroupingFocusChanges(UI_NodeManager* inManager, bool inRestore);
    ~GroupingFocusChanges();

   private:
    UI_NodeManager* mManager = nullptr;
    UI_NodeP mRestore;
  };

  // Raises the updating-focus counter for its lifetime.
  class ScUpdatingFocus : private boost::noncopyable {
   public:
    explicit ScUpdatingFocus(UI_NodeManager* inManager) : mManager(inManager) {
      if (mManager) ++mManager->mUpdatingFocus;
    }
    ~ScUpdatingFocus() {
      if (mManager) --mManager->mUpdatingFocus;
    }

   private:
    UI_NodeManager* mManager;
  };

 private:
  // The test of ReplaceInAllCachedNodes for one cached pointer.
  static bool MatchesReplacement(const UI_Node* inCached, const UI_Node* inNode, const UI_Node* inReplacement,
                                 bool inIncludeChildren);

  std::vector<UI_Node*> mMouseFilters;
  std::vector<UI_Node*> mKeyboardFilters;
  UI_Node* mMouseOverLeaf = nullptr;
  UI_Node* mMouseOverRoot = nullptr;
  UI_Node* mKeyboardFocusLeaf = nullptr;
  UI_Node* mPreviousKeyboardFocusLeaf = nullptr;
  std::vector<PlatformWindow> mOSMouseActivateSuspends;
  std::vector<std::pair<UI_Node*, UI_Node*>> mModalStack;
  InputCaptureP mInputCapture;
  int mUpdatingFocus = 0;
  int mSuspendOSFocus = 0;
  int mSuspendMouseOver = 0;
  int mGroupingFocus = 0;
  int mUserResizing = 0;
  bool mApplicationFrontmost = true;
  int mPopupMenuOnscreen = 0;
  std::unique_ptr<UI_ToolTipManager> mToolTipManager;
  std::unique_ptr<ResourceManager> mResourceManager;
  std::unique_ptr<CustomSettingsManager> mCustomSettingsManager;
  std::unique_ptr<DrawbotImageResourceCache> mImageCache;
  std::set<UI_NodeP> mResizedNodes;
  long mNextTimerID = -2;
  std::vector<BoolFunction> mApplicationActivationFunctions;
  std::vector<BoolFunction> mTextEditFocusFunctions;
  std::vector<UserResizeFunction> mUserResizeFunctions;
  tarsel::utility::Flags<unsigned char> mLastModKeys;
  tarsel::threads::AsyncEventLoopAdaptorPtr mExecutor;
  bool mMnemonicsEnabled = false;
  bool mBlockDialogsFromStealingHotTextEditTextKeys = false;
  std::uint64_t mDrawbotCacheSeed = 0;
  boost::shared_ptr<EditTextCreationFunction> mEditTextCreationFunction;
  std::shared_ptr<drawbot::SupplierInterface> mOSSupplier;
  tarsel::geom::PointT<long> mGlobalMousePosition;
  OS_FocusPlatform* mFocusPlatform = nullptr;

  friend class UI_Node;
};

}  // namespace norvik::ui
