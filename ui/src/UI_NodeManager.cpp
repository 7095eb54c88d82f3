#include "ui/UI_NodeManager.h"

#include <algorithm>

#include <boost/make_shared.hpp>

#include "drawbot/DrawHelpers.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_Node.h"
#include "ui/UI_Window.h"

namespace norvik::ui {

namespace {
UI_NodeManager* gManager = nullptr;

// The drawing layer reads its switches ("norvik.utils.FontDependentBaselines")
// from the manager in charge when it asks, and gets its default without one.
bool ReadManagerSetting(char const* inKey, bool inDefault) {
  const CustomSettingsManager* settings = gManager ? gManager->GetCustomSettingsManager() : nullptr;
  return settings ? settings->GetBool(inKey, inDefault) : inDefault;
}

[[maybe_unused]] const bool sSettingReaderInstalled = (drawbot::SetBoolSettingReader(&ReadManagerSetting), true);
}  // namespace

UI_NodeManager::UI_NodeManager()
    : mCustomSettingsManager(std::make_unique<CustomSettingsManager>()),
      mExecutor(tarsel::threads::RegisterCurrentThreadAsMainThread()) {
  gManager = this;
}

UI_NodeManager::~UI_NodeManager() {
  EndInputCapture(true);
  if (gManager == this) gManager = nullptr;
}

UI_NodeManager* UI_NodeManager::Get(bool) { return gManager; }

const UI_NodeManager* UI_NodeManager::GetConst(bool) { return gManager; }

void UI_NodeManager::Set(UI_NodeManager* inManager) { gManager = inManager; }

void UI_NodeManager::SetKeyboardFocusLeafNode(UI_Node* inNode) {
  mPreviousKeyboardFocusLeaf = mKeyboardFocusLeaf;
  mKeyboardFocusLeaf = inNode;
}

ResourceManager& UI_NodeManager::GetResourceManager() const {
  if (!mResourceManager) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/utility/Error/ResourceUtils/UnableToAccessResource="
                               "Unable to access resource.");
  }
  return *mResourceManager;
}

UI_NodeManager::PlatformWindow UI_NodeManager::GetSuspendOSMouseActivatePlatformWindow() const {
  return mOSMouseActivateSuspends.empty() ? nullptr : mOSMouseActivateSuspends.back();
}

// ---------------------------------------------------------------------- seams

void UI_NodeManager::SetToolTipManager(std::unique_ptr<UI_ToolTipManager> inManager) {
  mToolTipManager = std::move(inManager);
}

void UI_NodeManager::SetResourceManager(std::unique_ptr<ResourceManager> inManager) {
  mResourceManager = std::move(inManager);
}

void UI_NodeManager::SetCustomSettingsManager(std::unique_ptr<CustomSettingsManager> inManager) {
  mCustomSettingsManager = std::move(inManager);
}

void UI_NodeManager::SetDrawbotImageResourceCache(std::unique_ptr<DrawbotImageResourceCache> inCache) {
  mImageCache = std::move(inCache);
}

void UI_NodeManager::SetOSDrawSupplier(std::shared_ptr<drawbot::SupplierInterface> inSupplier) {
  mOSSupplier = std::move(inSupplier);
}

void UI_NodeManager::TerminateDrawing() { mImageCache.reset(); }

// --------------------------------------------------------------- input capture

void UI_NodeManager::BeginInputCapture(const InputCaptureP& inCapture) {
  // A new gesture cancels a running one.
  EndInputCapture(true);
  mInputCapture = inCapture;
  if (inCapture) inCapture->InvokeBegin();
}

void UI_NodeManager::EndInputCapture(bool inCancelled) {
  // Taken out first: calls made from the capture's End see no capture.
  InputCaptureP capture;
  capture.swap(mInputCapture);
  if (!capture) return;
  capture->InvokeEnd(inCancelled);
  capture.reset();
  // Hover states may have changed while the gesture had the mouse.
  UI_Node::UI_InvalidateMouseOverNodes();
}

// --------------------------------------------------------------------- filters

void UI_NodeManager::AddMouseEventFilterNode(UI_Node* inNode) {
  if (inNode) mMouseFilters.insert(mMouseFilters.begin(), inNode);
}

void UI_NodeManager::AddKeyboardEventFilterNode(UI_Node* inNode) {
  if (inNode) mKeyboardFilters.insert(mKeyboardFilters.begin(), inNode);
}

void UI_NodeManager::RemoveMouseEventFilterNode(UI_Node* inNode) {
  auto it = std::find(mMouseFilters.begin(), mMouseFilters.end(), inNode);
  if (it != mMouseFilters.end()) mMouseFilters.erase(it);
}

void UI_NodeManager::RemoveKeyboardEventFilterNode(UI_Node* inNode) {
  auto it = std::find(mKeyboardFilters.begin(), mKeyboardFilters.end(), inNode);
  if (it != mKeyboardFilters.end()) mKeyboardFilters.erase(it);
}

bool UI_NodeManager::DispatchCursorToMouseOverRootNode(tarsel::utility::Flags<unsigned char> inModKeys) {
  if (!mMouseOverRoot) return false;
  UI_NodeP root(mMouseOverRoot);
  tarsel::geom::PointT<long> local = root->UI_GlobalToLocal(GetGlobalMousePosition());
  return root->UI_DispatchCursor(tarsel::geom::PointT<float>(local), inModKeys, false);
}

// --------------------------------------------------------------- notifications

void UI_NodeManager::InstallApplicationActivationChangedFunction(const BoolFunction& inF) {
  mApplicationActivationFunctions.push_back(inF);
}

void UI_NodeManager::InstallTextEditFocusChangedFunction(const BoolFunction& inF) {
  mTextEditFocusFunctions.push_back(inF);
}

void UI_NodeManager::InstallUserResizeFunction(const UserResizeFunction& inF) {
  mUserResizeFunctions.push_back(inF);
}

void UI_NodeManager::UnregisterFunctions() {
  mApplicationActivationFunctions.clear();
  mTextEditFocusFunctions.clear();
  mUserResizeFunctions.clear();
}

void UI_NodeManager::NotifyApplicationActivationChanged(bool inFrontmost) {
  const auto copy = mApplicationActivationFunctions;
  for (const BoolFunction& f : copy) {
    if (f && *f) (*f)(inFrontmost);
  }
}

void UI_NodeManager::NotifyTextEditFocusChanged(bool inFocused) {
  const auto copy = mTextEditFocusFunctions;
  for (const BoolFunction& f : copy) {
    if (f && *f) (*f)(inFocused);
  }
}

void UI_NodeManager::NotifyUserResize(bool inStarting, UI_Node* inWindow, bool inFromOS) {
  const auto copy = mUserResizeFunctions;
  for (const UserResizeFunction& f : copy) {
    if (f && *f) (*f)(inStarting, inWindow, inFromOS);
  }
}

// ---------------------------------------------------------- edit text creation

void UI_NodeManager::InstallEditTextCreationFunction(const EditTextCreationFunction& inF) {
  mEditTextCreationFunction = boost::make_shared<EditTextCreationFunction>(inF);
}

void UI_NodeManager::CreateEditText(int inType, UI_Node* inControl, UI_Node* inParent, UI_NodeP& outHost,
                                    OS_EditText*& outEdit) {
  if (mEditTextCreationFunction && !mEditTextCreationFunction->empty()) {
    (*mEditTextCreationFunction)(inType, inControl, inParent, outHost, outEdit);
    return;
  }
  // The native text field is the platform's; a manager built without one cannot make it.
  tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                             "$$$/norvik/ui/Error/NoNativeTextField=No native text field is available.");
}

// ----------------------------------------------------------------- modal stack

void UI_NodeManager::PushModalWindow(UI_Node* inWindow) {
  if (!mModalStack.empty() && mModalStack.back().first == inWindow) return;
  mModalStack.emplace_back(inWindow, mKeyboardFocusLeaf);
}

void UI_NodeManager::PopModalWindow(UI_Node* inWindow) {
  if (mModalStack.empty() || mModalStack.back().first != inWindow) return;
  const std::pair<UI_Node*, UI_Node*> entry = mModalStack.back();
  mModalStack.pop_back();
  ScUpdatingFocus updating(this);
  if (!mModalStack.empty()) {
    // The native activation, not a node-side notice: the window beneath
    // must really become the active one again.
    UI_NodeP top(mModalStack.back().first);
    if (auto* window = dynamic_cast<UI_Window*>(top.get())) window->UI_Activate();
  }
  if (entry.second) {
    UI_NodeP saved(entry.second);
    saved->UI_GainKeyboardFocus(kFocusChangeRestore);
  } else {
    mPreviousKeyboardFocusLeaf = mKeyboardFocusLeaf;
    mKeyboardFocusLeaf = nullptr;
  }
}

// ----------------------------------------------------------- cached pointers

bool UI_NodeManager::MatchesReplacement(const UI_Node* inCached, const UI_Node* inNode,
                                        const UI_Node* inReplacement, bool inIncludeChildren) {
  if (inCached == inNode) return true;
  return inIncludeChildren && inCached && inReplacement && inCached != inReplacement &&
         inCached->UI_IsChildOf(*inReplacement);
}

void UI_NodeManager::ReplaceInAllCachedNodes(UI_Node* inNode, UI_Node* inReplacement, bool inIncludeChildren) {
  UI_NodeProtector protectReplacement(inReplacement);
  if (MatchesReplacement(mMouseOverLeaf, inNode, inReplacement, inIncludeChildren)) {
    mMouseOverLeaf = inReplacement;
    if (mToolTipManager && inNode && mToolTipManager->GetToolTipNode() == inNode) mToolTipManager->DisposeToolTip();
  }
  if (MatchesReplacement(mMouseOverRoot, inNode, inReplacement, inIncludeChildren)) {
    mMouseOverRoot = inReplacement;
  }
  if (MatchesReplacement(mKeyboardFocusLeaf, inNode, inReplacement, inIncludeChildren)) {
    ScUpdatingFocus updating(this);
    if (inReplacement) {
      inReplacement->UI_GainKeyboardFocus(kFocusChangeHandOver);
    } else {
      mPreviousKeyboardFocusLeaf = mKeyboardFocusLeaf;
      mKeyboardFocusLeaf = nullptr;
    }
  }
  if (MatchesReplacement(mPreviousKeyboardFocusLeaf, inNode, inReplacement, inIncludeChildren)) {
    ScUpdatingFocus updating(this);
    mPreviousKeyboardFocusLeaf = inReplacement;
  }
  ReplaceWindowFocusNode(inNode, inReplacement, inIncludeChildren);
}

void UI_NodeManager::ReplaceWindowFocusNode(UI_Node* inNode, UI_Node* inReplacement, bool inIncludeChildren) {
  for (auto& entry : mModalStack) {
    if (MatchesReplacement(entry.second, inNode, inReplacement, inIncludeChildren)) {
      entry.second = inReplacement;
      return;
    }
  }
}

void UI_NodeManager::ForgetNode(UI_Node* inNode) {
  if (mMouseOverLeaf == inNode) {
    mMouseOverLeaf = nullptr;
    if (mToolTipManager && mToolTipManager->GetToolTipNode() == inNode) mToolTipManager->DisposeToolTip();
  }
  if (mMouseOverRoot == inNode) mMouseOverRoot = nullptr;
  if (mKeyboardFocusLeaf == inNode) {
    ScUpdatingFocus updating(this);
    mPreviousKeyboardFocusLeaf = mKeyboardFocusLeaf;
    mKeyboardFocusLeaf = nullptr;
  }
  if (mPreviousKeyboardFocusLeaf == inNode) {
    ScUpdatingFocus updating(this);
    mPreviousKeyboardFocusLeaf = nullptr;
  }
  for (auto& entry : mModalStack) {
    if (entry.second == inNode) {
      entry.second = nullptr;
      break;
    }
  }
  // Filters and the resize set are not covered by the hand-over rule, but a
  // dead pointer in them would be used by the next event; drop those too.
  RemoveMouseEventFilterNode(inNode);
  RemoveKeyboardEventFilterNode(inNode);
}

void UI_NodeManager::SetApplicationFrontmost(bool inFrontmost) {
  mApplicationFrontmost = inFrontmost;
  if (mUpdatingFocus < 1) {
    if (inFrontmost) {
      if (UI_NodeP previous = mPreviousKeyboardFocusLeaf) previous->UI_GainKeyboardFocus(kFocusChangeRestore);
    } else if (mKeyboardFocusLeaf) {
      UI_NodeP root(mKeyboardFocusLeaf->UI_GetRootNode());
      root->UI_UpdateKeyboardFocusStateDueToLoss();
    }
  }
  NotifyApplicationActivationChanged(inFrontmost);
}

// ---------------------------------------------------------------- user resizing

void UI_NodeManager::BeginUserResizing(UI_Node* inWindow, bool inFromOS) {
  ++mUserResizing;
  NotifyUserResize(true, inWindow, inFromOS);
}

void UI_NodeManager::EndUserResizing(UI_Node* inWindow, bool inFromOS) {
  --mUserResizing;
  if (mUserResizing < 1) {
    InvalidateResizedNodes();
    NotifyUserResize(false, inWindow, inFromOS);
  }
}

bool UI_NodeManager::InvalidateNodeAfterUserResize(UI_Node* inNode) {
  if (mUserResizing < 1 || !inNode) return false;
  mResizedNodes.insert(UI_NodeP(inNode));
  return true;
}

void UI_NodeManager::InvalidateResizedNodes() {
  std::set<UI_NodeP> nodes;
  nodes.swap(mResizedNodes);
  for (const UI_NodeP& node : nodes) node->UI_Invalidate(nullptr, 0);
}

}  // namespace norvik::ui
