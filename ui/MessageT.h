#pragma once
// Messages and notification lists: how nodes and controls tell their clients
// that something happened.
//
// A message is a small polymorphic record naming its subject; the messages of
// the controls derive from MessageT<UI_Node> or MessageT<const UI_Node>.
//
// A notification list holds boost::function objects by boost::shared_ptr.
// Installing appends; firing calls the entries in order. An entry whose shared
// pointer is null is skipped, so that a client that keeps its pointer can turn
// its entry off by emptying it (reset()). An entry that holds a boost::function
// which is itself empty is not skipped: calling it throws the standard
// boost::bad_function_call ("call to empty boost::function"), because that is a
// client error and not a way of switching an entry off.
//
// Firing works on a snapshot of the list: a callback may install further
// entries, or destroy the object that owns the list, without disturbing the
// pass in progress. Entries installed during a pass are first called by the
// next one.
#include <cstddef>
#include <utility>
#include <vector>

#include <boost/core/noncopyable.hpp>
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

namespace norvik::ui {

class UI_Node;

template <class T>
class MessageT : private boost::noncopyable {
 public:
  explicit MessageT(T* inSubject = nullptr) : mSubject(inSubject) {}
  virtual ~MessageT() = default;

  T* GetSubject() const { return mSubject; }
  void SetSubject(T* inSubject) { mSubject = inSubject; }

 private:
  T* mSubject;
};

using UI_NodeMessage = MessageT<UI_Node>;
using UI_ConstNodeMessage = MessageT<const UI_Node>;

// Calls every live entry of inList in order with inArgs. Works on any sequence
// of boost::shared_ptr<boost::function<...>>, so that a class may keep its
// lists in whatever container its layout asks for.
template <class List, class... Args>
void NotifyAll(const List& inList, Args&&... inArgs) {
  if (inList.empty()) return;
  const std::vector<typename List::value_type> snapshot(inList.begin(), inList.end());
  for (const auto& entry : snapshot) {
    if (entry) (*entry)(inArgs...);
  }
}

// Calls the live entries of inList in order until one answers true; returns
// whether one did. An empty list answers false.
template <class List, class... Args>
bool NotifyUntilTrue(const List& inList, Args&&... inArgs) {
  if (inList.empty()) return false;
  const std::vector<typename List::value_type> snapshot(inList.begin(), inList.end());
  for (const auto& entry : snapshot) {
    if (entry && (*entry)(inArgs...)) return true;
  }
  return false;
}

// A list of shared notification functions of one signature.
template <class Signature>
class NotificationList {
 public:
  using Function = boost::function<Signature>;
  using FunctionP = boost::shared_ptr<Function>;
  using Storage = std::vector<FunctionP>;

  // Appends inFunction; a null pointer is kept too and skipped when firing,
  // so that the order of installation stays what the clients saw.
  void Install(FunctionP inFunction) { mFunctions.push_back(std::move(inFunction)); }

  template <class... Args>
  void Notify(Args&&... inArgs) const {
    NotifyAll(mFunctions, std::forward<Args>(inArgs)...);
  }

  template <class... Args>
  bool NotifyUntilTrue(Args&&... inArgs) const {
    return ui::NotifyUntilTrue(mFunctions, std::forward<Args>(inArgs)...);
  }

  // Drops every entry at once; entries are never removed one by one.
  void Clear() { mFunctions.clear(); }

  std::size_t size() const { return mFunctions.size(); }
  bool empty() const { return mFunctions.empty(); }
  const Storage& GetFunctions() const { return mFunctions; }

 private:
  Storage mFunctions;
};

// Wraps a callable into the shared form that Install... operations take.
template <class Signature, class Callable>
boost::shared_ptr<boost::function<Signature>> MakeNotification(Callable&& inCallable) {
  return boost::shared_ptr<boost::function<Signature>>(
      new boost::function<Signature>(std::forward<Callable>(inCallable)));
}

}  // namespace norvik::ui
